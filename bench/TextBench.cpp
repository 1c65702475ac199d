// Messages and splitting, beside what the toolkit offers for the same.
#include "s/Msg.h"
#include "s/String.h"

#include <QString>
#include <QStringList>

#include <benchmark/benchmark.h>
#include <memory>
#include <string>

namespace {

constexpr const char* format = "%1 : Help file for this package was not installed or does not have read permission.\n"
                               "Context sensitive help would be unavailable.\nPlease check if %2 are installed.";

void expandMessage(benchmark::State& state) {
    for (auto _ : state) {
        Gui_Msg message(format);
        message << "board"
                << "the help files";
        benchmark::DoNotOptimize(static_cast<const char*>(message));
    }
}
BENCHMARK(expandMessage);

/// From and to UTF-8, as a program with narrow texts has to.
void expandMessageWithTheToolkit(benchmark::State& state) {
    for (auto _ : state) {
        const QString text = QString::fromUtf8(format).arg(QStringLiteral("board"), QStringLiteral("the help files"));
        benchmark::DoNotOptimize(text.toUtf8().constData());
    }
}
BENCHMARK(expandMessageWithTheToolkit);

std::string megabyte() {
    std::string text;
    while (text.size() < 1u << 20) {
        text += "/usr/share/drawings/gear" + std::to_string(text.size()) + ";";
    }
    return text;
}

void splitMegabyte(benchmark::State& state) {
    const Gui_String text(megabyte().c_str());
    for (auto _ : state) {
        benchmark::DoNotOptimize(std::unique_ptr<CStringArray>(text.GetStringArray(";", 1, 0))->GetSize());
    }
}
BENCHMARK(splitMegabyte)->Unit(benchmark::kMillisecond);

void splitMegabyteWithTheToolkit(benchmark::State& state) {
    const QString text = QString::fromStdString(megabyte());
    for (auto _ : state) {
        benchmark::DoNotOptimize(text.split(u';', Qt::SkipEmptyParts).size());
    }
}
BENCHMARK(splitMegabyteWithTheToolkit)->Unit(benchmark::kMillisecond);

/// A separator outside ASCII is compared character by character.
void splitMegabyteAtWideCharacters(benchmark::State& state) {
    const Gui_String text(megabyte().c_str());
    for (auto _ : state) {
        benchmark::DoNotOptimize(std::unique_ptr<CStringArray>(text.GetStringArray("¤;", 1, 1))->GetSize());
    }
}
BENCHMARK(splitMegabyteAtWideCharacters)->Unit(benchmark::kMillisecond);

} // namespace
