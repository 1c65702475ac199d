// File names: taking apart and putting together, and asking the file system, beside what the system and the toolkit do.
#include "s/FileName.h"

#include <QFileInfo>
#include <QString>

#include <benchmark/benchmark.h>
#include <filesystem>
#include <fstream>
#include <string>
#include <sys/stat.h>
#include <vector>

namespace {

constexpr const char* sample = "C:\\projects\\machines\\gear box\\drawings\\sheet 12.final.brd";
constexpr const char* systemSample = "/projects/machines/gear box/drawings/sheet 12.final.brd";

void parseAndCompose(benchmark::State& state) {
    Gui_FileName::SetUncFlag(static_cast<int>(state.range(0)));
    for (auto _ : state) {
        const Gui_FileName name(sample);
        benchmark::DoNotOptimize(name.GetFullName());
    }
    Gui_FileName::SetUncFlag(1);
}
BENCHMARK(parseAndCompose)->ArgName("networkNames")->Arg(0)->Arg(1);

void parseAndComposeWithTheStandardLibrary(benchmark::State& state) {
    for (auto _ : state) {
        const std::filesystem::path name(systemSample);
        const auto folder = name.parent_path();
        const auto base = name.stem();
        const auto extension = name.extension();
        benchmark::DoNotOptimize((folder / base).concat(extension.native()).native());
    }
}
BENCHMARK(parseAndComposeWithTheStandardLibrary);

void parseAndComposeWithTheToolkit(benchmark::State& state) {
    const QString text = QString::fromUtf8(systemSample);
    for (auto _ : state) {
        const QFileInfo name(text);
        benchmark::DoNotOptimize(name.path() + '/' + name.completeBaseName() + '.' + name.suffix());
    }
}
BENCHMARK(parseAndComposeWithTheToolkit);

/// A folder with 10,000 files.
class ManyFiles {
public:
    ManyFiles() {
        std::string pattern = (std::filesystem::temp_directory_path() / "names.XXXXXX").string();
        m_folder = ::mkdtemp(pattern.data());
        for (int i = 0; i < 10000; ++i) {
            m_files.push_back(m_folder + "/drawing " + std::to_string(i) + ".brd");
            std::ofstream(m_files.back()).put('x');
        }
    }
    ~ManyFiles() {
        std::filesystem::remove_all(m_folder);
    }
    const std::vector<std::string>& files() const {
        return m_files;
    }

private:
    std::string m_folder;
    std::vector<std::string> m_files;
};

const std::vector<std::string>& files() {
    static const ManyFiles many;
    return many.files();
}

void existenceOf10000(benchmark::State& state) {
    std::vector<Gui_FileName> names;
    for (const std::string& file : files()) {
        names.emplace_back(("C:" + file).c_str());
    }
    for (auto _ : state) {
        for (const Gui_FileName& name : names) {
            benchmark::DoNotOptimize(name.Exists());
        }
    }
}
BENCHMARK(existenceOf10000)->Unit(benchmark::kMillisecond);

/// With the names made anew each time, as a host that walks a list of texts does.
void existenceOf10000Texts(benchmark::State& state) {
    for (auto _ : state) {
        for (const std::string& file : files()) {
            benchmark::DoNotOptimize(Gui_FileName(file.c_str()).Exists());
        }
    }
}
BENCHMARK(existenceOf10000Texts)->Unit(benchmark::kMillisecond);

void existenceOf10000WithStat(benchmark::State& state) {
    for (auto _ : state) {
        for (const std::string& file : files()) {
            struct stat status{};
            benchmark::DoNotOptimize(::stat(file.c_str(), &status));
        }
    }
}
BENCHMARK(existenceOf10000WithStat)->Unit(benchmark::kMillisecond);

void existenceOf10000WithTheToolkit(benchmark::State& state) {
    std::vector<QString> names;
    for (const std::string& file : files()) {
        names.push_back(QString::fromStdString(file));
    }
    for (auto _ : state) {
        for (const QString& name : names) {
            benchmark::DoNotOptimize(QFileInfo::exists(name));
        }
    }
}
BENCHMARK(existenceOf10000WithTheToolkit)->Unit(benchmark::kMillisecond);

/// One that is missing: the folder's 10,000 entries are gone through for one that differs in case.
void existenceOfAMissingOne(benchmark::State& state) {
    const Gui_FileName name(("C:" + files().front() + "x").c_str());
    for (auto _ : state) {
        benchmark::DoNotOptimize(name.Exists());
    }
}
BENCHMARK(existenceOfAMissingOne)->Unit(benchmark::kMicrosecond);

} // namespace
