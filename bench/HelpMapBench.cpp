// A help map of 100,000 sections (12.4 MB) beside the same text read as an INI file by the toolkit and by GLib, and
// beside the least that any reader must do: look for the lines of the mapped file and index its headers.
#include "s/HelpMap.h"

#include <QSettings>
#include <QString>

#include <benchmark/benchmark.h>
#include <bit>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <functional>
#include <glib.h>
#include <malloc.h>
#include <string>
#include <string_view>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

namespace {

namespace fs = std::filesystem;

constexpr int sectionCount = 100000;

/// An installation whose map names web addresses, so that looking a record up asks for no files.
class Installation {
public:
    Installation() {
        std::string name = (fs::temp_directory_path() / "help-map-bench.XXXXXX").string();
        m_folder = mkdtemp(name.data());
        fs::create_directories(m_folder / "share/helpmap");
        fs::create_directories(m_folder / "doc/usenglish/design");
        fs::create_directories(m_folder / "doc/german");
        std::ofstream(m_folder / "doc/usenglish/design/intro.htm") << "text";
        std::ofstream map(mapName());
        for (int i = 0; i < sectionCount; ++i) {
            map << "[topic " << i << "]\ntype = url\nfile = https://docs.example.com/design/page" << i << ".htm#part"
                << i % 50 << "\ntitle = Placing components, part " << i << "\n\n";
        }
        map.close();
        ::setenv("TARVEX", m_folder.c_str(), 1);
        ::setenv("MYTARVEX", (m_folder / "none").c_str(), 1);
        ::setenv("TVX_REGISTRY", (m_folder / "registry.db").c_str(), 1);
    }
    ~Installation() {
        fs::remove_all(m_folder);
    }
    Installation(const Installation&) = delete;
    Installation& operator=(const Installation&) = delete;

    const fs::path& folder() const {
        return m_folder;
    }
    std::string mapName() const {
        return (m_folder / "share/helpmap/big.map").string();
    }

private:
    fs::path m_folder;
};

const Installation& installation() {
    static const Installation one;
    return one;
}

/// What is allocated, in megabytes.
double allocated() {
    const struct mallinfo2 info = ::mallinfo2();
    return static_cast<double>(info.uordblks + info.hblkhd) / 1e6;
}

void requireOk(benchmark::State& state, bool isOk) {
    if (!isOk) {
        state.SkipWithError("the file was not read");
    }
}

/// The floor.
class FlatIndex {
public:
    explicit FlatIndex(const std::string& name) : m_slots(std::bit_ceil(sectionCount * 2U)) {
        const int file = ::open(name.c_str(), O_RDONLY | O_CLOEXEC);
        struct stat status{};
        ::fstat(file, &status);
        m_size = static_cast<std::size_t>(status.st_size);
        m_text = static_cast<const char*>(::mmap(nullptr, m_size, PROT_READ, MAP_PRIVATE | MAP_POPULATE, file, 0));
        ::close(file);
        for (const char *at = m_text, *const end = m_text + m_size; at < end;) {
            const auto* stop = static_cast<const char*>(std::memchr(at, '\n', static_cast<std::size_t>(end - at)));
            stop = stop ? stop : end;
            if (*at == '[') {
                add({at + 1, static_cast<std::size_t>(stop - at - 2)});
            }
            at = stop + 1;
        }
    }
    ~FlatIndex() {
        ::munmap(const_cast<char*>(m_text), m_size);
    }
    FlatIndex(const FlatIndex&) = delete;
    FlatIndex& operator=(const FlatIndex&) = delete;

    std::string_view find(std::string_view key) const {
        std::size_t at = hash(key);
        while (!m_slots[at].empty() && m_slots[at] != key) {
            at = (at + 1) & (m_slots.size() - 1);
        }
        return m_slots[at];
    }

private:
    std::size_t hash(std::string_view key) const {
        return std::hash<std::string_view>()(key) & (m_slots.size() - 1);
    }
    void add(std::string_view key) {
        std::size_t at = hash(key);
        while (!m_slots[at].empty()) {
            at = (at + 1) & (m_slots.size() - 1);
        }
        m_slots[at] = key;
    }

    const char* m_text = nullptr;
    std::size_t m_size = 0;
    std::vector<std::string_view> m_slots;
};

// --- reading all of it ---

void read(benchmark::State& state) {
    const std::string name = installation().mapName();
    double memory = 0;
    for (auto _ : state) {
        const double before = allocated();
        Gui_HelpMap map;
        requireOk(state, map.Read(name));
        memory = allocated() - before;
    }
    state.counters["MB"] = memory;
}
BENCHMARK(read)->Unit(benchmark::kMillisecond);

void readWithAFlatIndex(benchmark::State& state) {
    const std::string name = installation().mapName();
    for (auto _ : state) {
        const FlatIndex index(name);
        benchmark::DoNotOptimize(index.find("topic 1"));
    }
}
BENCHMARK(readWithAFlatIndex)->Unit(benchmark::kMillisecond);

void readWithGlib(benchmark::State& state) {
    const std::string name = installation().mapName();
    double memory = 0;
    for (auto _ : state) {
        const double before = allocated();
        GKeyFile* const file = g_key_file_new();
        requireOk(state, g_key_file_load_from_file(file, name.c_str(), G_KEY_FILE_NONE, nullptr) != 0);
        memory = allocated() - before;
        g_key_file_free(file);
    }
    state.counters["MB"] = memory;
}
BENCHMARK(readWithGlib)->Unit(benchmark::kMillisecond);

/// It keeps what it has read for the next object of the same file, so each gets a file of its own.
void readWithTheToolkit(benchmark::State& state) {
    const std::string name = installation().mapName();
    static int i = 0;
    for (auto _ : state) {
        state.PauseTiming();
        const std::string copy = name + std::to_string(i++);
        fs::create_hard_link(name, copy);
        state.ResumeTiming();
        {
            const QSettings settings(QString::fromStdString(copy), QSettings::IniFormat);
            requireOk(state, settings.contains(QStringLiteral("topic 1/file")));
        }
        state.PauseTiming();
        fs::remove(copy);
        state.ResumeTiming();
    }
}
BENCHMARK(readWithTheToolkit)->Unit(benchmark::kMillisecond)->Iterations(5);

// --- looking one record up: topics far from each other, as help is asked for ---

int nextTopic(int topic) {
    return (topic + 61843) % sectionCount;
}

void lookUp(benchmark::State& state) {
    Gui_HelpMap map;
    requireOk(state, map.Read(installation().mapName()));
    int topic = 0;
    for (auto _ : state) {
        topic = nextTopic(topic);
        benchmark::DoNotOptimize(map.Find("topic", std::to_string(topic)));
    }
}
BENCHMARK(lookUp);

/// With the record made.
void lookUpAndResolve(benchmark::State& state) {
    Gui_HelpMap map;
    requireOk(state, map.Read(installation().mapName()));
    Port::StringBase<char> type;
    unsigned int topic = 0;
    for (auto _ : state) {
        topic = static_cast<unsigned int>(nextTopic(static_cast<int>(topic)));
        benchmark::DoNotOptimize(map.LookupContext(topic, type));
    }
}
BENCHMARK(lookUpAndResolve);

void lookUpInAFlatIndex(benchmark::State& state) {
    const FlatIndex index(installation().mapName());
    int topic = 0;
    for (auto _ : state) {
        topic = nextTopic(topic);
        benchmark::DoNotOptimize(index.find("topic " + std::to_string(topic)));
    }
}
BENCHMARK(lookUpInAFlatIndex);

void lookUpWithGlib(benchmark::State& state) {
    GKeyFile* const file = g_key_file_new();
    g_key_file_load_from_file(file, installation().mapName().c_str(), G_KEY_FILE_NONE, nullptr);
    int topic = 0;
    for (auto _ : state) {
        topic = nextTopic(topic);
        g_free(g_key_file_get_string(file, ("topic " + std::to_string(topic)).c_str(), "file", nullptr));
    }
    g_key_file_free(file);
}
BENCHMARK(lookUpWithGlib);

void lookUpWithTheToolkit(benchmark::State& state) {
    const QSettings settings(QString::fromStdString(installation().mapName()), QSettings::IniFormat);
    int topic = 0;
    for (auto _ : state) {
        topic = nextTopic(topic);
        benchmark::DoNotOptimize(settings.value("topic " + QString::number(topic) + "/file").toString().toUtf8());
    }
}
BENCHMARK(lookUpWithTheToolkit);

// --- finding a document's file: the user's settings are asked, then the files of two roots in two languages ---

void locateDocument(benchmark::State& state, const char* name) {
    installation();
    ::setenv("LC_ALL", "de_DE.UTF-8", 1);
    const Gui_HelpMap map;
    for (auto _ : state) {
        benchmark::DoNotOptimize(map.LocateDocument(name));
    }
}
BENCHMARK_CAPTURE(locateDocument, inAmericanEnglish, "design/intro.htm#start");
BENCHMARK_CAPTURE(locateDocument, nowhere, "design/none.htm");

/// The floor of the last: the system is asked for the same five names.
void locateByAccess(benchmark::State& state) {
    const std::string root = installation().folder().string();
    for (auto _ : state) {
        for (const char* below :
             {"/none/doc/german/", "/doc/german/", "/none/doc/usenglish/", "/doc/usenglish/", "/"}) {
            benchmark::DoNotOptimize(::access((root + below + "design/none.htm").c_str(), F_OK));
        }
    }
}
BENCHMARK(locateByAccess);

} // namespace
