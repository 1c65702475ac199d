#include "s/Process.h"

#include "Children.h"
#include "platform/win/Error.h"

#include <gtest/gtest.h>

#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <limits>
#include <pty.h>
#include <string>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace {

/// A child that waits for a signal.
pid_t forkSleeper() {
    const pid_t child = ::fork();
    if (child == 0) {
        ::pause();
        ::_exit(0);
    }
    return child;
}

/// All that a captured child writes until it has ended.
std::string drain(Gui_Process& process) {
    std::string text;
    CString piece;
    while (process.IsActive() || process.HasOutput()) {
        while (process.GetOutput(piece)) {
            text += std::string(piece.GetString(), static_cast<std::size_t>(piece.GetLength()));
        }
        process.Wait(2);
    }
    return text;
}

/// Waits for a line that a captured child writes.
std::string firstLine(Gui_Process& process) {
    std::string text;
    CString piece;
    while (text.find('\n') == std::string::npos && (process.IsActive() || process.HasOutput())) {
        if (process.GetOutput(piece)) {
            text += piece.GetString();
        }
    }
    return text.substr(0, text.find('\n'));
}

void awaitEnd(unsigned long processId) {
    while (Gui_Process::IsActive(processId)) {
        ::usleep(1000);
    }
}

std::size_t openDescriptors() {
    std::size_t count = 0;
    for ([[maybe_unused]] const auto& entry : std::filesystem::directory_iterator("/proc/self/fd")) {
        ++count;
    }
    return count;
}

} // namespace

TEST(Process, HoldsNothingAtFirst) {
    Gui_Process process;
    CString text("kept");
    EXPECT_EQ(process.GetExitCode(), 0xFFFFFFFF);
    EXPECT_EQ(process.IsActive(), 0);
    EXPECT_EQ(process.HasOutput(), 0);
    EXPECT_EQ(process.GetOutput(text), 0);
    EXPECT_STREQ(text, "kept");
    EXPECT_EQ(process.Terminate(1), 0);
    EXPECT_EQ(process.Wait(0xFFFFFFFF), 0xFFFFFFFF);
    EXPECT_EQ(process.GetMainThreadId(), 0u);
    EXPECT_EQ(process.GetProcessHandle(), reinterpret_cast<void*>(-1));
    EXPECT_EQ(process.GetError(), 0u);
}

TEST(Process, GivesItsOutputAndItsEnd) {
    Gui_Process process;
    ASSERT_EQ(process.Run("printf abc", nullptr, 1, 1), 1);
    EXPECT_EQ(process.GetProcessId(), process.GetMainThreadId());
    EXPECT_EQ(process.Wait(0xFFFFFFFF), 0u);
    EXPECT_EQ(process.HasOutput(), 1);
    CString text("replaced");
    EXPECT_EQ(process.GetOutput(text), 1);
    EXPECT_STREQ(text, "abc");
    EXPECT_EQ(process.GetOutput(text), 0);
    EXPECT_EQ(process.GetError(), ERROR_BROKEN_PIPE);
    EXPECT_STREQ(text, "abc");
    EXPECT_EQ(process.GetExitCode(), 0u);
    EXPECT_EQ(process.GetError(), 0u);
}

TEST(Process, RefusesASecondChild) {
    Gui_Process process;
    ASSERT_EQ(process.Run("sleep 1000", nullptr, 0, 0), 1);
    const unsigned long first = process.GetProcessId();
    EXPECT_EQ(process.Run("sleep 1000", nullptr, 0, 0), 0);
    EXPECT_EQ(process.GetError(), 0u);
    EXPECT_EQ(process.IsActive(), 1);
    EXPECT_EQ(process.Wait(0), 258u);
    process.Release();
    EXPECT_EQ(process.GetExitCode(), 0xFFFFFFFF);
    awaitEnd(first);
    EXPECT_EQ(process.Run("true", nullptr, 0, 0), 1) << "an object can be used again";
}

TEST(Process, AFailedStartLeavesNothing) {
    awaitReleased();
    const std::size_t before = openDescriptors();
    Gui_Process process;
    for (int round = 0; round < 20; ++round) {
        EXPECT_EQ(process.Run("no-such-program", nullptr, 1, 0), 0);
        EXPECT_EQ(process.GetError(), ERROR_FILE_NOT_FOUND);
        EXPECT_EQ(process.Run("true", "/no/such/folder", 1, 0), 0);
        EXPECT_EQ(process.GetError(), ERROR_DIRECTORY);
        EXPECT_EQ(process.GetExitCode(), 0xFFFFFFFF);
    }
    EXPECT_EQ(process.Run(nullptr, nullptr, 0, 0), 0);
    EXPECT_EQ(process.GetError(), ERROR_INVALID_PARAMETER);
    EXPECT_EQ(openDescriptors(), before);
    EXPECT_FALSE(hasChildren());
}

TEST(Process, TerminatesAChildThatIgnoresIt) {
    Gui_Process process;
    ASSERT_EQ(process.Run("sh -c \"trap '' TERM INT HUP; echo ready; exec sleep 1000\"", nullptr, 1, 0), 1);
    EXPECT_EQ(firstLine(process), "ready");
    ::kill(static_cast<pid_t>(process.GetProcessId()), SIGTERM);
    EXPECT_EQ(process.Terminate(42), 1);
    EXPECT_EQ(process.Wait(0xFFFFFFFF), 0u);
    EXPECT_EQ(process.GetExitCode(), 42u);
    EXPECT_EQ(process.Terminate(43), 0);
    EXPECT_EQ(process.GetError(), ERROR_ACCESS_DENIED);
    EXPECT_EQ(process.GetExitCode(), 42u);
}

TEST(Process, ReleasePoliciesDecideWhatBecomesOfTheChild) {
    unsigned long captured = 0;
    unsigned long left = 0;
    unsigned long ended = 0;
    {
        Gui_Process process;
        process.SetReleasePolicy(Gui_Process::LeaveRunning, 0);
        ASSERT_EQ(process.Run("sleep 1000", nullptr, 1, 0), 1);
        process.SetReleasePolicy(Gui_Process::LeaveRunning, 0);
        captured = process.GetProcessId();
        Gui_Process other;
        ASSERT_EQ(other.Run("sleep 1000", nullptr, 0, 0), 1);
        ended = other.GetProcessId();
        Gui_Process third;
        ASSERT_EQ(third.RunWaitForWindow("sleep 1000", nullptr, 10), 1);
        left = third.GetProcessId();
    }
    awaitEnd(captured);
    awaitEnd(ended);
    EXPECT_EQ(Gui_Process::IsActive(left), 1);
    ::kill(static_cast<pid_t>(left), SIGKILL);
    awaitReleased();
    EXPECT_FALSE(hasChildren());
}

TEST(Process, DrainsMuchOutput) {
    Gui_Process process;
    ASSERT_EQ(process.Run("sh -c \"yes 0123456789 | head -c 20000000; echo end >&2; exit 7\"", nullptr, 1, 0), 1);
    const std::string text = drain(process);
    EXPECT_EQ(text.size(), 20000004u);
    EXPECT_EQ(text.substr(0, 12), "0123456789\n0");
    EXPECT_TRUE(text.ends_with("end\n"));
    EXPECT_EQ(process.GetExitCode(), 7u);
}

TEST(Process, KeepsEveryByteOfItsOutput) {
    Gui_Process process;
    ASSERT_EQ(process.Run(R"(printf "a\000b\r\n\377\303")", nullptr, 1, 0), 1);
    EXPECT_EQ(drain(process), std::string("a\0b\r\n\xFF\xC3", 7));
}

TEST(Process, GrandchildrenMayHoldThePipe) {
    Gui_Process process;
    ASSERT_EQ(process.Run("sh -c \"sleep 1000 & echo $!\"", nullptr, 1, 0), 1);
    const std::string grandchild = firstLine(process);
    EXPECT_EQ(process.Wait(0xFFFFFFFF), 0u);
    CString text;
    EXPECT_EQ(process.GetOutput(text), 0);
    EXPECT_EQ(process.GetError(), 0u) << "more can come";
    EXPECT_EQ(process.GetExitCode(), 0u);
    const auto id = static_cast<pid_t>(std::stol(grandchild));
    ::kill(id, SIGKILL);
    awaitEnd(static_cast<unsigned long>(id));
    EXPECT_EQ(process.GetOutput(text), 0);
    EXPECT_EQ(process.GetError(), ERROR_BROKEN_PIPE);
}

TEST(Process, StandardInputEndsWithTheRelease) {
    const std::filesystem::path proof = std::filesystem::temp_directory_path() / "ended";
    Gui_Process process;
    // Shells give what runs behind them the null device to read; the third descriptor is the pipe all the same.
    const std::string script = "exec 3<&0; (cat <&3; touch " + proof.string() + ") & echo $!";
    ASSERT_EQ(process.Run(("sh -c \"" + script + "\"").c_str(), nullptr, 1, 0), 1);
    const std::string reader = firstLine(process);
    EXPECT_EQ(Gui_Process::IsActive(std::stoul(reader)), 1) << "waits for input";
    EXPECT_EQ(process.Wait(0xFFFFFFFF), 0u) << "terminated, the shell would take its reader along";
    process.Release();
    awaitEnd(std::stoul(reader));
    EXPECT_TRUE(std::filesystem::exists(proof));
}

TEST(Process, HundredsOfChildrenLeaveNothingBehind) {
    {
        Gui_Process first;
        first.Run("true", nullptr, 1, 0);
    }
    awaitReleased();
    const std::size_t before = openDescriptors();
    for (int index = 0; index < 400; ++index) {
        Gui_Process process;
        if (index % 2 == 0) {
            process.SetReleasePolicy(Gui_Process::LeaveRunning, 0);
        }
        ASSERT_EQ(process.Run(index % 3 == 0 ? "sleep 0.05" : "true", nullptr, index % 4 == 0, 0), 1) << index;
        if (index % 5 == 0) {
            process.Wait(0xFFFFFFFF);
        }
    }
    awaitReleased();
    EXPECT_FALSE(hasChildren());
    EXPECT_EQ(openDescriptors(), before);
}

TEST(Process, OutlivesTheHostAndItsTerminal) {
    int terminal = -1;
    int pipe[2];
    ASSERT_EQ(::pipe(pipe), 0);
    const pid_t host = ::forkpty(&terminal, nullptr, nullptr, nullptr);
    if (host == 0) {
        Gui_Process process;
        process.RunWaitForWindow("sleep 1000", nullptr, 0);
        const unsigned long id = process.GetProcessId();
        [[maybe_unused]] const auto written = ::write(pipe[1], &id, sizeof id);
        for (;;) {
            ::pause();
        }
    }
    unsigned long id = 0;
    ASSERT_EQ(::read(pipe[0], &id, sizeof id), static_cast<ssize_t>(sizeof id));
    ::close(terminal); // hangs up
    int status = 0;
    ASSERT_EQ(::waitpid(host, &status, 0), host);
    EXPECT_EQ(WTERMSIG(status), SIGHUP);
    EXPECT_EQ(Gui_Process::IsActive(id), 1);
    ::kill(static_cast<pid_t>(id), SIGKILL);
    ::close(pipe[0]);
    ::close(pipe[1]);
}

TEST(ProcessLiveness, EndedProcessIsNotAlive) {
    const pid_t child = forkSleeper();
    EXPECT_EQ(Gui_Process::IsActive(static_cast<unsigned long>(child)), 1);
    ::kill(child, SIGKILL);
    siginfo_t status;
    ASSERT_EQ(::waitid(P_PID, static_cast<id_t>(child), &status, WEXITED | WNOWAIT), 0);
    EXPECT_EQ(Gui_Process::IsActive(static_cast<unsigned long>(child)), 0) << "a zombie";
    ::waitpid(child, nullptr, 0);
    EXPECT_EQ(Gui_Process::IsActive(static_cast<unsigned long>(child)), 0);
}

TEST(ProcessLiveness, KnowsProcessesOfOthersAndNumbersThatAreNone) {
    EXPECT_EQ(Gui_Process::IsActive(static_cast<unsigned long>(::getpid())), 1);
    EXPECT_EQ(Gui_Process::IsActive(1), 1);
    for (const unsigned long none : {0UL, 0x7FFFFFFFUL, 0xFFFFFFFFUL, std::numeric_limits<unsigned long>::max()}) {
        EXPECT_EQ(Gui_Process::IsActive(none), 0) << none;
    }
    // Numbers of threads are drawn from the same row.
    std::thread([] { EXPECT_EQ(Gui_Process::IsActive(static_cast<unsigned long>(::gettid())), 0); }).join();
}

TEST(ProcessExitCodes, AreClassified) {
    EXPECT_EQ(Gui_Process::IsAbortExitCode(0xC000013A), 1);
    EXPECT_EQ(Gui_Process::IsCrashExitCode(0xC000013A), 0);
    for (const unsigned long crash : {0xC0000005UL, 0x80000003UL, 0x40000000UL}) {
        EXPECT_EQ(Gui_Process::IsCrashExitCode(crash), 1) << crash;
    }
    for (const unsigned long code : {0x3FFFFFFFUL, 0UL, 1UL}) {
        EXPECT_EQ(Gui_Process::IsCrashExitCode(code), 0) << code;
        EXPECT_EQ(Gui_Process::IsAbortExitCode(code), 0) << code;
    }
}
