#include "s/Process.h"

#include <gtest/gtest.h>

#include <csignal>
#include <limits>
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

} // namespace

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
    for (const unsigned long none : {0UL, 0x7FFFFFFFUL, 0xFFFFFFFFUL, std::numeric_limits<unsigned long>::max()})
        EXPECT_EQ(Gui_Process::IsActive(none), 0) << none;
    // Numbers of threads are drawn from the same row.
    std::thread([] { EXPECT_EQ(Gui_Process::IsActive(static_cast<unsigned long>(::gettid())), 0); }).join();
}

TEST(ProcessExitCodes, AreClassified) {
    EXPECT_EQ(Gui_Process::IsAbortExitCode(0xC000013A), 1);
    EXPECT_EQ(Gui_Process::IsCrashExitCode(0xC000013A), 0);
    for (const unsigned long crash : {0xC0000005UL, 0x80000003UL, 0x40000000UL})
        EXPECT_EQ(Gui_Process::IsCrashExitCode(crash), 1) << crash;
    for (const unsigned long code : {0x3FFFFFFFUL, 0UL, 1UL}) {
        EXPECT_EQ(Gui_Process::IsCrashExitCode(code), 0) << code;
        EXPECT_EQ(Gui_Process::IsAbortExitCode(code), 0) << code;
    }
}
