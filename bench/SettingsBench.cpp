// The settings store beside the toolkit's settings and beside the database below it, with 200 and 5,000 values. All
// write so that other processes see it and a power failure does not undo it (the toolkit: see its peers' comments).
#include "platform/win/Registry.h"
#include "platform/win/detail/RegistryStore.h"

#include <QSettings>
#include <QString>

#include <algorithm>
#include <array>
#include <benchmark/benchmark.h>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sqlite3.h>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace {

constexpr const char* keyPath = "Software\\Tarvex\\bench\\Settings";

/// A folder on a real disk (TMPDIR, else the current one); memory file systems know no durable write.
class Folder {
public:
    Folder() {
        const char* place = std::getenv("TMPDIR");
        std::string name = std::string(place ? place : ".") + "/settings-bench.XXXXXX";
        m_folder = mkdtemp(name.data());
    }
    ~Folder() {
        tvx::registry::closeStores();
        fs::remove_all(m_folder);
    }
    Folder(const Folder&) = delete;
    Folder& operator=(const Folder&) = delete;

    std::string operator/(const char* name) const {
        return (m_folder / name).string();
    }

private:
    fs::path m_folder;
};

std::string valueName(std::int64_t i) {
    return "entry" + std::to_string(i);
}

std::string valueText(std::int64_t i) {
    return "44,1,-1,-1,-32000,-32000,100,120,900," + std::to_string(100'000 + i % 900'000);
}

HKEY openKey() {
    HKEY key = nullptr;
    if (RegCreateKeyExA(HKEY_CURRENT_USER, keyPath, 0, nullptr, 0, KEY_READ | KEY_WRITE, nullptr, &key, nullptr) != 0) {
        std::abort();
    }
    return key;
}

LSTATUS writeValue(HKEY key, const std::string& name, const std::string& text) {
    return RegSetValueExA(key, name.c_str(), 0, REG_SZ, reinterpret_cast<const BYTE*>(text.c_str()),
                          static_cast<DWORD>(text.size() + 1));
}

void fillStore(const Folder& folder, std::int64_t count) {
    tvx::registry::closeStores();
    setenv("TVX_REGISTRY", (folder / "registry.db").c_str(), 1);
    tvx::RegistryTransaction transaction;
    const HKEY key = transaction.begin() == 0 ? openKey() : nullptr;
    for (std::int64_t i = 0; i < count; ++i) {
        if (writeValue(key, valueName(i), valueText(i)) != 0) {
            std::abort();
        }
    }
    if (transaction.commit() != 0) {
        std::abort();
    }
    RegCloseKey(key);
}

void fillSettings(QSettings& settings, std::int64_t count) {
    for (std::int64_t i = 0; i < count; ++i) {
        settings.setValue("bench/" + QString::number(i), QString::fromStdString(valueText(i)));
    }
    settings.sync();
}

/// The database by itself, with the simplest table there is.
class Database {
public:
    explicit Database(const std::string& file) {
        sqlite3_open(file.c_str(), &m_database);
        sqlite3_busy_timeout(m_database, 5000);
        run("PRAGMA journal_mode = WAL; PRAGMA synchronous = FULL;"
            "CREATE TABLE IF NOT EXISTS v (k TEXT PRIMARY KEY, d BLOB) WITHOUT ROWID");
        sqlite3_prepare_v2(m_database, "SELECT d FROM v WHERE k = ?1", -1, &m_select, nullptr);
        sqlite3_prepare_v2(m_database, "INSERT INTO v VALUES (?1, ?2) ON CONFLICT (k) DO UPDATE SET d = excluded.d", -1,
                           &m_insert, nullptr);
    }
    ~Database() {
        sqlite3_finalize(m_select);
        sqlite3_finalize(m_insert);
        sqlite3_close(m_database);
    }
    Database(const Database&) = delete;
    Database& operator=(const Database&) = delete;

    void run(const char* sql) {
        sqlite3_exec(m_database, sql, nullptr, nullptr, nullptr);
    }
    void fill(std::int64_t count) {
        run("BEGIN");
        for (std::int64_t i = 0; i < count; ++i) {
            write(valueName(i), valueText(i));
        }
        run("COMMIT");
    }
    std::string read(const std::string& name) {
        sqlite3_bind_text(m_select, 1, name.c_str(), -1, SQLITE_STATIC);
        std::string text;
        if (sqlite3_step(m_select) == SQLITE_ROW) {
            text.assign(static_cast<const char*>(sqlite3_column_blob(m_select, 0)),
                        static_cast<std::size_t>(sqlite3_column_bytes(m_select, 0)));
        }
        sqlite3_reset(m_select);
        return text;
    }
    bool write(const std::string& name, const std::string& text) {
        sqlite3_bind_text(m_insert, 1, name.c_str(), -1, SQLITE_STATIC);
        sqlite3_bind_blob(m_insert, 2, text.c_str(), static_cast<int>(text.size() + 1), SQLITE_STATIC);
        const bool done = sqlite3_step(m_insert) == SQLITE_DONE;
        sqlite3_reset(m_insert);
        return done;
    }

private:
    sqlite3* m_database = nullptr;
    sqlite3_stmt* m_select = nullptr;
    sqlite3_stmt* m_insert = nullptr;
};

// --- read one value, seeing what others wrote ---

void read(benchmark::State& state) {
    const Folder folder;
    fillStore(folder, state.range(0));
    const HKEY key = openKey();
    std::array<BYTE, 256> buffer{};
    std::int64_t i = 0;
    for (auto _ : state) {
        DWORD size = buffer.size();
        benchmark::DoNotOptimize(
            RegQueryValueExA(key, valueName(i++ % 50).c_str(), nullptr, nullptr, buffer.data(), &size));
    }
    RegCloseKey(key);
}
BENCHMARK(read)->Arg(200)->Arg(5000)->Unit(benchmark::kMicrosecond);

/// Each value the first time after somebody's write: nothing can be answered from memory.
void readAfterAWrite(benchmark::State& state) {
    const Folder folder;
    fillStore(folder, state.range(0));
    const HKEY key = openKey();
    std::array<BYTE, 256> buffer{};
    std::int64_t i = 0;
    for (auto _ : state) {
        if (i % 50 == 0) {
            state.PauseTiming();
            writeValue(key, "other", valueText(i));
            state.ResumeTiming();
        }
        DWORD size = buffer.size();
        benchmark::DoNotOptimize(
            RegQueryValueExA(key, valueName(i++ % 50).c_str(), nullptr, nullptr, buffer.data(), &size));
    }
    RegCloseKey(key);
}
BENCHMARK(readAfterAWrite)->Arg(200)->Arg(5000)->Unit(benchmark::kMicrosecond);

void readWithTheDatabaseAlone(benchmark::State& state) {
    const Folder folder;
    Database database(folder / "raw.db");
    database.fill(state.range(0));
    std::int64_t i = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(database.read(valueName(i++ % 50)));
    }
}
BENCHMARK(readWithTheDatabaseAlone)->Arg(200)->Arg(5000)->Unit(benchmark::kMicrosecond);

void readWithTheToolkit(benchmark::State& state) {
    const Folder folder;
    QSettings settings(QString::fromStdString(folder / "settings.ini"), QSettings::IniFormat);
    fillSettings(settings, state.range(0));
    std::int64_t i = 0;
    for (auto _ : state) {
        settings.sync(); // else it does not see what others wrote
        benchmark::DoNotOptimize(settings.value("bench/" + QString::number(i++ % 50)).toString().toUtf8());
    }
}
BENCHMARK(readWithTheToolkit)->Arg(200)->Arg(5000)->Unit(benchmark::kMicrosecond);

// --- write one value for others and for good ---
// Each time another text than before (the same one costs the database nothing), and all as many times (a log that grows
// is dearer to write than one that is used again).

void write(benchmark::State& state) {
    const Folder folder;
    fillStore(folder, state.range(0));
    const HKEY key = openKey();
    std::int64_t i = 0;
    for (auto _ : state) {
        if (++i; writeValue(key, valueName(i % state.range(0)), valueText(i + 7)) != 0) {
            state.SkipWithError("not written");
        }
    }
    RegCloseKey(key);
}
BENCHMARK(write)->Arg(200)->Arg(5000)->Unit(benchmark::kMicrosecond)->UseRealTime()->Iterations(1500);

void writeWithTheDatabaseAlone(benchmark::State& state) {
    const Folder folder;
    Database database(folder / "raw.db");
    database.fill(state.range(0));
    std::int64_t i = 0;
    for (auto _ : state) {
        if (++i; !database.write(valueName(i % state.range(0)), valueText(i + 7))) {
            state.SkipWithError("not written");
        }
    }
}
BENCHMARK(writeWithTheDatabaseAlone)
    ->Arg(200)
    ->Arg(5000)
    ->Unit(benchmark::kMicrosecond)
    ->UseRealTime()
    ->Iterations(1500);

/// Its sync() writes a new file and renames it.
void writeWithTheToolkit(benchmark::State& state) {
    const Folder folder;
    QSettings settings(QString::fromStdString(folder / "settings.ini"), QSettings::IniFormat);
    fillSettings(settings, state.range(0));
    std::int64_t i = 0;
    for (auto _ : state) {
        ++i;
        settings.setValue("bench/" + QString::number(i % state.range(0)), QString::fromStdString(valueText(i + 7)));
        settings.sync();
    }
}
BENCHMARK(writeWithTheToolkit)->Arg(200)->Arg(5000)->Unit(benchmark::kMicrosecond)->UseRealTime()->Iterations(100);

void writeHundredTogether(benchmark::State& state) {
    const Folder folder;
    fillStore(folder, 200);
    const HKEY key = openKey();
    std::int64_t round = 0;
    for (auto _ : state) {
        ++round;
        tvx::RegistryTransaction transaction;
        if (transaction.begin() != 0) {
            state.SkipWithError("not begun");
        }
        for (std::int64_t i = 0; i < 100; ++i) {
            writeValue(key, valueName(i), valueText(i + round));
        }
        if (transaction.commit() != 0) {
            state.SkipWithError("not written");
        }
    }
    RegCloseKey(key);
}
BENCHMARK(writeHundredTogether)->Unit(benchmark::kMicrosecond)->UseRealTime();

// --- two processes write 2,000 values each ---

constexpr int processes = 2;
constexpr int writesEach = 2000;

/// Does the writes of one process. Answers the time of the worst one, in milliseconds; negative when one failed.
template <typename Write>
double worstOf(int process, Write write) {
    double worst = 0;
    for (int i = 0; i < writesEach; ++i) {
        const auto begin = std::chrono::steady_clock::now();
        if (!write(std::to_string(process) + "." + std::to_string(i), valueText(i))) {
            return -1;
        }
        const std::chrono::duration<double, std::milli> taken = std::chrono::steady_clock::now() - begin;
        worst = std::max(worst, taken.count());
    }
    return worst;
}

double writeToStore(int process) {
    const HKEY key = openKey();
    return worstOf(
        process, [key](const std::string& name, const std::string& text) { return writeValue(key, name, text) == 0; });
}

double collect(int from) {
    double worst = 0;
    for (int process = 0; process < processes; ++process) {
        double one = -1;
        if (::read(from, &one, sizeof one) != sizeof one || one < 0) {
            return -1;
        }
        worst = std::max(worst, one);
        wait(nullptr);
    }
    return worst;
}

int countLost() {
    int lost = 0;
    const HKEY key = openKey();
    for (int process = 0; process < processes; ++process) {
        for (int i = 0; i < writesEach; ++i) {
            lost += RegQueryValueExA(key, (std::to_string(process) + "." + std::to_string(i)).c_str(), nullptr, nullptr,
                                     nullptr, nullptr) != 0
                        ? 1
                        : 0;
        }
    }
    RegCloseKey(key);
    return lost;
}

/// Lets each process write with `body` and answers the worst time of all.
template <typename Body>
double runProcesses(Body body) {
    std::array<int, 2> ends{};
    if (pipe(ends.data()) != 0) {
        std::abort();
    }
    for (int process = 0; process < processes; ++process) {
        if (fork() == 0) {
            const double own = body(process);
            _exit(::write(ends[1], &own, sizeof own) == sizeof own ? 0 : 1);
        }
    }
    const double worst = collect(ends[0]);
    close(ends[0]);
    close(ends[1]);
    return worst;
}

void twoProcessesWrite(benchmark::State& state) {
    double worst = 0;
    int lost = 0;
    for (auto _ : state) {
        const Folder folder;
        fillStore(folder, 200);
        const double slowest = runProcesses(&writeToStore);
        if (slowest < 0) {
            state.SkipWithError("not written");
        }
        worst = std::max(worst, slowest);
        lost += countLost();
    }
    state.counters["lost"] = lost;
    state.counters["worst_ms"] = worst;
}
BENCHMARK(twoProcessesWrite)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

void twoProcessesWriteWithTheDatabaseAlone(benchmark::State& state) {
    double worst = 0;
    for (auto _ : state) {
        const Folder folder;
        Database(folder / "raw.db").fill(200);
        const double slowest = runProcesses([&](int process) {
            Database own(folder / "raw.db");
            return worstOf(process,
                           [&](const std::string& name, const std::string& text) { return own.write(name, text); });
        });
        if (slowest < 0) {
            state.SkipWithError("not written");
        }
        worst = std::max(worst, slowest);
    }
    state.counters["worst_ms"] = worst;
}
BENCHMARK(twoProcessesWriteWithTheDatabaseAlone)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

// --- the command of the desktop's default browser ---

/// A desktop with one browser, the same for the whole run: its library reads the environment once.
void useDesktop() {
    static const Folder folder;
    const fs::path applications = fs::path(folder / "data") / "applications";
    fs::create_directories(applications);
    std::ofstream(applications / "x.desktop") << "[Desktop Entry]\nType=Application\nName=x\nExec=true %u\n"
                                                 "MimeType=text/html;\n";
    std::ofstream(applications / "mimeinfo.cache") << "[MIME Cache]\ntext/html=x.desktop;\n";
    setenv("XDG_DATA_HOME", (folder / "data").c_str(), 1);
    setenv("TVX_REGISTRY", (folder / "registry.db").c_str(), 1);
}

/// Reads as the library does: the class of the extension, then the command of the class.
bool readBrowser() {
    char text[1024];
    for (const char* name : {".htm", "tarvex.desktop.text-html\\shell\\open\\command"}) {
        HKEY key = nullptr;
        DWORD size = sizeof text;
        if (RegOpenKeyExA(HKEY_CLASSES_ROOT, name, 0, KEY_READ, &key) != 0 ||
            RegQueryValueExA(key, "", nullptr, nullptr, reinterpret_cast<BYTE*>(text), &size) != 0) {
            return false;
        }
        RegCloseKey(key);
    }
    return true;
}

/// In a process that has asked the desktop nothing before: with the loading of its library and of all entries.
void readBrowserFirst(benchmark::State& state) {
    useDesktop();
    for (auto _ : state) {
        std::array<int, 2> ends{};
        double seconds = -1;
        if (pipe(ends.data()) != 0) {
            std::abort();
        }
        if (fork() == 0) {
            const auto begin = std::chrono::steady_clock::now();
            const bool isRead = readBrowser();
            const std::chrono::duration<double> taken = std::chrono::steady_clock::now() - begin;
            seconds = isRead ? taken.count() : -1;
            _exit(::write(ends[1], &seconds, sizeof seconds) == sizeof seconds ? 0 : 1);
        }
        if (::read(ends[0], &seconds, sizeof seconds) != sizeof seconds || seconds < 0) {
            state.SkipWithError("not read");
        }
        wait(nullptr);
        close(ends[0]);
        close(ends[1]);
        state.SetIterationTime(seconds);
    }
}
BENCHMARK(readBrowserFirst)->Unit(benchmark::kMicrosecond)->UseManualTime();

void readBrowserAgain(benchmark::State& state) {
    useDesktop();
    for (auto _ : state) {
        if (!readBrowser()) {
            state.SkipWithError("not read");
        }
    }
}
BENCHMARK(readBrowserAgain)->Unit(benchmark::kMicrosecond);

} // namespace
