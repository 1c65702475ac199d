// Reading the installation's file, beside the same work by the standard library and by the toolkit.
#include "s/Version.h"

#include <QDateTime>
#include <QFile>
#include <QHash>
#include <QLocale>

#include <benchmark/benchmark.h>
#include <cstdlib>
#include <ctime>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <string>
#include <sys/stat.h>
#include <unistd.h>
#include <unordered_map>

namespace {

/// An installation whose file has 10,000 lines for 2,500 keys, each line newer than those before.
class Installation {
public:
    Installation() {
        std::string pattern = (std::filesystem::temp_directory_path() / "tvx-bench.XXXXXX").string();
        m_root = ::mkdtemp(pattern.data());
        m_path = m_root + "/fileset.txt";
        std::ofstream file(m_path);
        for (int i = 0; i < 10000; ++i) {
            file << "Mon Jan " << (i / 3600 < 1 ? " " : "") << 1 + i / 3600 << " " << i / 3600 % 24 << ":"
                 << i / 60 % 60 << ":" << i % 60 << " GMT 2026::package" << i % 2500 << "=/opt/tarvex/packages/p" << i
                 << "/setup.bin\n";
        }
        file.close();
        ::setenv("TARVEX", m_root.c_str(), 1);
        ::unsetenv("MYTARVEX");
    }
    ~Installation() {
        std::filesystem::remove_all(m_root);
    }
    Installation(const Installation&) = delete;
    Installation& operator=(const Installation&) = delete;

    const std::string& path() const {
        return m_path;
    }
    /// Makes the file newer.
    void touch() {
        const timespec stamps[] = {{++m_time, 0}, {m_time, 0}};
        ::utimensat(AT_FDCWD, m_path.c_str(), stamps, 0);
    }

private:
    std::string m_root;
    std::string m_path;
    static inline long m_time = 1700000000;
};

void loadFile(benchmark::State& state) {
    Installation installation;
    for (auto _ : state) {
        installation.touch();
        benchmark::DoNotOptimize(Gui_InstallInfo::GetValue("package7"));
    }
    state.SetItemsProcessed(state.iterations() * 10000);
}
BENCHMARK(loadFile)->Unit(benchmark::kMillisecond);

/// What each question costs while nothing has changed: the file is opened and its time is asked.
void askUnchangedFile(benchmark::State& state) {
    Installation installation;
    installation.touch();
    for (auto _ : state) {
        benchmark::DoNotOptimize(Gui_InstallInfo::GetValue("package7"));
    }
}
BENCHMARK(askUnchangedFile);

void loadFileWithTheStandardLibrary(benchmark::State& state) {
    const Installation installation;
    for (auto _ : state) {
        std::unordered_map<std::string, std::pair<std::string, std::time_t>> values;
        std::ifstream file(installation.path());
        for (std::string line; std::getline(file, line);) {
            const std::size_t mark = line.find("::");
            const std::size_t equals = line.find('=', mark);
            std::tm local{};
            strptime(line.c_str(), "%a %b %e %H:%M:%S GMT %Y", &local);
            const std::time_t time = std::mktime(&local);
            auto& value = values[line.substr(mark + 2, equals - mark - 2)];
            if (time >= value.second) {
                value = {line.substr(equals + 1), time};
            }
        }
        benchmark::DoNotOptimize(values);
    }
    state.SetItemsProcessed(state.iterations() * 10000);
}
BENCHMARK(loadFileWithTheStandardLibrary)->Unit(benchmark::kMillisecond);

void loadFileWithTheToolkit(benchmark::State& state) {
    const Installation installation;
    const QLocale english = QLocale::c();
    for (auto _ : state) {
        QHash<QString, std::pair<QString, QDateTime>> values;
        QFile file(QString::fromStdString(installation.path()));
        file.open(QIODevice::ReadOnly | QIODevice::Text);
        while (!file.atEnd()) {
            const QString line = QString::fromUtf8(file.readLine());
            const qsizetype mark = line.indexOf(QStringLiteral("::"));
            const qsizetype equals = line.indexOf(u'=', mark);
            const QDateTime time =
                english.toDateTime(line.left(mark).simplified(), QStringLiteral("ddd MMM d H:m:s 'GMT' yyyy"));
            auto& value = values[line.mid(mark + 2, equals - mark - 2)];
            if (!value.second.isValid() || time >= value.second) {
                value = {line.mid(equals + 1).trimmed(), time};
            }
        }
        benchmark::DoNotOptimize(values);
    }
    state.SetItemsProcessed(state.iterations() * 10000);
}
BENCHMARK(loadFileWithTheToolkit)->Unit(benchmark::kMillisecond);

} // namespace
