// Starting, draining and watching children, beside the toolkit's class and the system's own calls.
//
// The draining cases are pinned: writer and reader on one core ("same") or on two ("other"). Placement by the scheduler
// moves the results by a factor of three.
#include "afxwin.h"
#include "bench/SystemCalls.h"
#include "platform/win/Process.h"
#include "platform/win/detail/ProcessObject.h"
#include "platform/win/detail/RegistryStore.h"
#include "s/BrowserHelp.h"
#include "s/Process.h"
#include "s/Profile.h"

#include <QProcess>

#include <benchmark/benchmark.h>
#include <csignal>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <functional>
#include <memory>
#include <poll.h>
#include <sched.h>
#include <spawn.h>
#include <string>
#include <sys/ioctl.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>
#include <vector>

namespace {

/// Memory of a process that has worked for a while, touched, so that copying its page tables costs what it costs.
void growTo200Megabytes() {
    static std::vector<char> memory;
    if (memory.empty()) {
        memory.assign(200U << 20, 'x');
    }
    benchmark::DoNotOptimize(memory.data());
}

void pin(int core) {
    cpu_set_t set;
    CPU_ZERO(&set);
    CPU_SET(core, &set);
    ::sched_setaffinity(0, sizeof set, &set);
}

// Starting: until the program runs. Its end is awaited outside the measured time. "calls" are those of the system,
// which count where each of them is slow, as in sandboxes.

void countCalls(benchmark::State& state, const std::function<void()>& work) {
    state.counters["calls"] = static_cast<double>(SystemCalls::of(work));
}

void runOurs(int capture) {
    Gui_Process process;
    SystemCalls::mark();
    process.Run("/bin/true", nullptr, capture, 1);
    SystemCalls::mark();
    process.Wait(0xFFFFFFFF);
}

void startOurs(benchmark::State& state, int capture) {
    growTo200Megabytes();
    for (auto _ : state) {
        Gui_Process process;
        process.Run("/bin/true", nullptr, capture, 1);
        state.PauseTiming();
        process.Wait(0xFFFFFFFF);
        process.Release();
        state.ResumeTiming();
    }
    countCalls(state, [capture] { runOurs(capture); });
}
BENCHMARK_CAPTURE(startOurs, alone, 0)->Unit(benchmark::kMicrosecond)->UseRealTime();
BENCHMARK_CAPTURE(startOurs, captured, 1)->Unit(benchmark::kMicrosecond)->UseRealTime();

pid_t spawn() {
    char name[] = "/bin/true";
    char* arguments[] = {name, nullptr};
    pid_t child = 0;
    ::posix_spawn(&child, name, nullptr, nullptr, arguments, environ);
    return child;
}

void startPosixSpawn(benchmark::State& state) {
    growTo200Megabytes();
    for (auto _ : state) {
        const pid_t child = spawn();
        state.PauseTiming();
        ::waitpid(child, nullptr, 0);
        state.ResumeTiming();
    }
    countCalls(state, [] {
        SystemCalls::mark();
        const pid_t child = spawn();
        SystemCalls::mark();
        ::waitpid(child, nullptr, 0);
    });
}
BENCHMARK(startPosixSpawn)->Unit(benchmark::kMicrosecond)->UseRealTime();

void startToolkit(benchmark::State& state) {
    growTo200Megabytes();
    for (auto _ : state) {
        QProcess process;
        process.start(QStringLiteral("/bin/true"), {});
        process.waitForStarted();
        state.PauseTiming();
        process.waitForFinished();
        state.ResumeTiming();
    }
}
BENCHMARK(startToolkit)->Unit(benchmark::kMicrosecond)->UseRealTime();

/// A settings store and an installation with help on one topic, in a folder of their own.
class HelpInstallation {
public:
    HelpInstallation() {
        std::string name = (std::filesystem::temp_directory_path() / "tvx-bench-help.XXXXXX").string();
        m_folder = ::mkdtemp(name.data());
        std::filesystem::create_directories(m_folder / "share/helpmap");
        std::filesystem::create_directories(m_folder / "doc/usenglish");
        std::ofstream(m_folder / "share/helpmap/bench.map") << "[topic 1001]\nfile = page.htm#part\n";
        std::ofstream(m_folder / "doc/usenglish/page.htm") << "text";
        ::setenv("TARVEX", m_folder.c_str(), 1);
        ::setenv("TVX_REGISTRY", (m_folder / "registry.db").c_str(), 1);
        Gui_Profile::WriteWebBrowserName("/bin/true --new \"%1\"");
    }
    ~HelpInstallation() {
        tvx::registry::closeStores();
        std::filesystem::remove_all(m_folder);
    }
    HelpInstallation(const HelpInstallation&) = delete;
    HelpInstallation& operator=(const HelpInstallation&) = delete;

private:
    std::filesystem::path m_folder;
};

/// Measures a start until the browser runs; its end is awaited outside the measured time.
void startBrowser(benchmark::State& state, const std::function<int()>& start) {
    growTo200Megabytes();
    auto& released = tvx::win::ReleasedChildren::instance();
    for (auto _ : state) {
        if (!start()) {
            state.SkipWithError("the browser did not start");
        }
        state.PauseTiming();
        while (released.count() > 0) {
            tvx::win::waitReadable(released.bell(), INFINITE);
            released.collect();
        }
        state.ResumeTiming();
    }
}

/// A browser opened on an address: the settings are looked into, the command line is put together, the program starts.
void startWebBrowser(benchmark::State& state) {
    const HelpInstallation installation;
    startBrowser(state,
                 [] { return Gui_Process().RunWebBrowser("file:///usr/share/doc/index.html", nullptr, 1, 5000); });
}
BENCHMARK(startWebBrowser)->Unit(benchmark::kMicrosecond)->UseRealTime();

/// A help request from the application's entry on: the record is looked up, the document located, the browser started.
void startHelpRequest(benchmark::State& state) {
    const HelpInstallation installation;
    Gui_BrowserHelp help;
    help.SetHelpMapFileName("bench.map");
    startBrowser(state, [&help] { return help.BrowserHelp(1001, HELP_CONTEXT); });
}
BENCHMARK(startHelpRequest)->Unit(benchmark::kMicrosecond)->UseRealTime();

// Draining 256 MiB. The range is 0 for small blocks ("head"), 1 for blocks of 1 MiB ("dd"), and 0 for one core, 1 for
// two.

constexpr std::int64_t amount = 256LL << 20;

std::string writer(const benchmark::State& state) {
    const std::string command =
        state.range(0) == 0 ? "head -c 268435456 /dev/zero" : "dd if=/dev/zero bs=1M count=256 status=none";
    return "taskset -c " + std::to_string(state.range(1)) + " " + command;
}

void report(benchmark::State& state, std::int64_t bytes) {
    if (bytes != amount * static_cast<std::int64_t>(state.iterations())) {
        state.SkipWithError("not all was read");
    }
    state.SetBytesProcessed(bytes);
}

void drainOurs(benchmark::State& state) {
    pin(0);
    std::int64_t bytes = 0;
    for (auto _ : state) {
        Gui_Process process;
        process.Run(writer(state).c_str(), nullptr, 1, 1);
        CString chunk;
        // GetOutput never waits; where the event loop would wait for the pipe, the processor goes to the writer.
        while (process.GetOutput(chunk) || process.GetError() == 0) {
            if (process.GetError() == 0 && chunk.IsEmpty()) {
                std::this_thread::yield();
            }
            bytes += chunk.GetLength();
            chunk.ReleaseBuffer(0);
        }
    }
    report(state, bytes);
}

/// The peek and read of the layer, woken by the pipe.
void drainLayer(benchmark::State& state) {
    pin(0);
    std::int64_t bytes = 0;
    for (auto _ : state) {
        const SECURITY_ATTRIBUTES inheritable{sizeof inheritable, nullptr, TRUE};
        HANDLE readEnd = nullptr;
        HANDLE writeEnd = nullptr;
        CreatePipe(&readEnd, &writeEnd, &inheritable, 0);
        STARTUPINFOA startup;
        startup.dwFlags = STARTF_USESTDHANDLES;
        startup.hStdOutput = startup.hStdError = writeEnd;
        PROCESS_INFORMATION child;
        std::string line = writer(state);
        CreateProcessA(nullptr, line.data(), nullptr, nullptr, TRUE, 0, nullptr, nullptr, &startup, &child);
        CloseHandle(writeEnd);
        std::vector<char> buffer(1 << 20);
        DWORD waiting = 0;
        while (WaitForSingleObject(readEnd, INFINITE) == WAIT_OBJECT_0 &&
               PeekNamedPipe(readEnd, nullptr, 0, nullptr, &waiting, nullptr)) {
            DWORD count = 0;
            ReadFile(readEnd, buffer.data(), waiting, &count, nullptr);
            bytes += count;
        }
        for (const HANDLE handle : {readEnd, child.hProcess, child.hThread}) {
            CloseHandle(handle);
        }
    }
    report(state, bytes);
}

void drainRawLoop(benchmark::State& state) {
    pin(0);
    std::int64_t bytes = 0;
    for (auto _ : state) {
        int ends[2];
        if (::pipe2(ends, O_CLOEXEC) != 0) {
            return state.SkipWithError("no pipe");
        }
        ::fcntl(ends[0], F_SETPIPE_SZ, 1 << 20);
        posix_spawn_file_actions_t actions;
        ::posix_spawn_file_actions_init(&actions);
        ::posix_spawn_file_actions_adddup2(&actions, ends[1], 1);
        std::string line = writer(state);
        char shell[] = "/bin/sh";
        char option[] = "-c";
        line = "exec " + line;
        char* arguments[] = {shell, option, line.data(), nullptr};
        pid_t child = 0;
        ::posix_spawn(&child, shell, &actions, nullptr, arguments, environ);
        ::posix_spawn_file_actions_destroy(&actions);
        ::close(ends[1]);
        std::vector<char> buffer(1 << 20);
        pollfd entry{ends[0], POLLIN, 0};
        while (::poll(&entry, 1, -1) > 0) {
            int waiting = 0;
            ::ioctl(ends[0], FIONREAD, &waiting);
            const ssize_t count = ::read(ends[0], buffer.data(), static_cast<std::size_t>(std::max(waiting, 1)));
            if (count <= 0) {
                break;
            }
            bytes += count;
        }
        ::close(ends[0]);
        ::waitpid(child, nullptr, 0);
    }
    report(state, bytes);
}

void drainToolkit(benchmark::State& state) {
    pin(0);
    std::int64_t bytes = 0;
    for (auto _ : state) {
        QProcess process;
        process.startCommand(QString::fromStdString(writer(state)));
        while (process.waitForReadyRead(-1)) {
            bytes += process.readAllStandardOutput().size();
        }
        process.waitForFinished(-1);
        bytes += process.readAllStandardOutput().size();
    }
    report(state, bytes);
}

void placements(benchmark::internal::Benchmark* bench) {
    bench->ArgNames({"big", "other"})->ArgsProduct({{0, 1}, {0, 1}});
    bench->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);
}
BENCHMARK(drainOurs)->Apply(placements);
BENCHMARK(drainLayer)->Apply(placements);
BENCHMARK(drainRawLoop)->Apply(placements);
BENCHMARK(drainToolkit)->Apply(placements);

// Whether a process is alive.

void aliveById(benchmark::State& state) {
    const auto parent = static_cast<unsigned long>(::getppid());
    for (auto _ : state) {
        benchmark::DoNotOptimize(Gui_Process::IsActive(parent));
    }
    countCalls(state, [parent] {
        SystemCalls::mark();
        Gui_Process::IsActive(parent);
        SystemCalls::mark();
    });
}
BENCHMARK(aliveById);

void aliveByKill(benchmark::State& state) {
    const pid_t parent = ::getppid();
    for (auto _ : state) {
        benchmark::DoNotOptimize(::kill(parent, 0));
    }
}
BENCHMARK(aliveByKill);

void aliveHeldChild(benchmark::State& state) {
    Gui_Process process;
    process.Run("sleep 1000", nullptr, 0, 1);
    for (auto _ : state) {
        benchmark::DoNotOptimize(process.IsActive());
    }
}
BENCHMARK(aliveHeldChild);

} // namespace
