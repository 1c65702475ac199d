// Children whose output is shown as it comes.
#include "s/Process.h"

#include "platform/afx/core/HandleWatch.h"
#include "platform/win/Error.h"
#include "platform/win/Pipe.h"
#include "platform/win/detail/ProcessObject.h"
#include "s/Edit.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <csignal>
#include <ctime>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <string>
#include <sys/stat.h>

namespace {

using Clock = std::chrono::steady_clock;
using Milliseconds = std::chrono::duration<double, std::milli>;

constexpr UINT outputMessage = WM_APP + 7;

/// What this thread has used.
Milliseconds processorTime() {
    timespec now{};
    ::clock_gettime(CLOCK_THREAD_CPUTIME_ID, &now);
    return std::chrono::seconds(now.tv_sec) + std::chrono::nanoseconds(now.tv_nsec);
}

/// A window with a log of a child's output, as a host has it.
class LogWindow : public CWnd {
public:
    LogWindow() {
        CreateEx(0, nullptr, "", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 20, 20, 600, 400, nullptr, nullptr);
        edit.Create(WS_CHILD | WS_VISIBLE | WS_VSCROLL | ES_MULTILINE | ES_AUTOHSCROLL, CRect(0, 0, 580, 380), this, 1);
    }

    /// Starts a child and shows what it writes until it has ended.
    bool show(const std::string& commandLine) {
        ended = false;
        started = Clock::now();
        return process.Run(commandLine.c_str(), nullptr, 1, 1) && process.NotifyWindow(m_hWnd, outputMessage);
    }
    [[nodiscard]] bool waitForEnd(int limit = 60000) const {
        return QTest::qWaitFor([this] { return ended; }, limit);
    }
    std::string text() const {
        return textOf(&edit);
    }

    Gui_Edit edit;
    Gui_Process process;
    int messages = 0;
    bool ended = false;
    Clock::time_point started;
    Milliseconds longest{0};
    Milliseconds longestWork{0}; ///< without the time that other programs had the processor

protected:
    LRESULT OnOutput(WPARAM, LPARAM) {
        const auto begin = Clock::now();
        const Milliseconds work = processorTime();
        ++messages;
        process.AppendOutput(edit, nullptr);
        process.GetExitCode();
        ended = !process.NotifyWindow(m_hWnd, outputMessage);
        longest = std::max(longest, Milliseconds(Clock::now() - begin));
        longestWork = std::max(longestWork, processorTime() - work);
        return 0;
    }
    DECLARE_MESSAGE_MAP()
};

// clang-format off
BEGIN_MESSAGE_MAP(LogWindow, CWnd)
    ON_MESSAGE(outputMessage, &LogWindow::OnOutput)
END_MESSAGE_MAP()
// clang-format on

/// Measures how long the event loop does not come round.
class Heartbeat {
public:
    Heartbeat() {
        QObject::connect(&m_timer, &QTimer::timeout, [this] {
            longest = std::max(longest, Milliseconds(Clock::now() - m_last));
            m_last = Clock::now();
        });
        m_timer.start(1);
    }
    Milliseconds longest{0};

private:
    QTimer m_timer;
    Clock::time_point m_last = Clock::now();
};

} // namespace

TEST(ProcessOutput, LeavesEverythingAloneWhenNothingWaits) {
    LogWindow window;
    window.edit.SetWindowText("before");
    CString chunk("kept");
    EXPECT_EQ(window.process.AppendOutput(window.edit, &chunk), 0);
    ASSERT_EQ(window.process.Run("sleep 1000", nullptr, 1, 1), 1);
    EXPECT_EQ(window.process.AppendOutput(window.edit, &chunk), 0);
    EXPECT_EQ(window.text(), "before");
    EXPECT_STREQ(chunk, "kept");
}

TEST(ProcessOutput, IsAppendedAndTheLastChunkTold) {
    LogWindow window;
    window.edit.SetWindowText("before\r\n");
    ASSERT_EQ(window.process.Run("printf abc", nullptr, 1, 1), 1);
    window.process.Wait(0xFFFFFFFF);
    CString chunk;
    EXPECT_EQ(window.process.AppendOutput(window.edit, &chunk), 1);
    EXPECT_EQ(window.text(), "before\r\nabc");
    EXPECT_STREQ(chunk, "abc");
    EXPECT_EQ(window.process.GetError(), ERROR_BROKEN_PIPE);
}

TEST(ProcessOutput, WakesTheWindowUntilTheEnd) {
    LogWindow window;
    ASSERT_TRUE(window.show("sh -c \"echo one; echo two >&2; exit 5\""));
    ASSERT_TRUE(window.waitForEnd());
    EXPECT_EQ(window.text(), "one\r\ntwo\r\n");
    EXPECT_EQ(window.process.GetExitCode(), 5u);
    EXPECT_EQ(window.process.NotifyWindow(window.m_hWnd, outputMessage), 0);
    window.process.Release();
    // A child that says nothing wakes the window by its end alone, and one that closes its output is not the end.
    ASSERT_TRUE(window.show("sh -c \"exec >&- 2>&-; exit 6\""));
    ASSERT_TRUE(window.waitForEnd());
    EXPECT_EQ(window.process.GetExitCode(), 6u);
}

namespace {

/// Lets a child wait at a place of its script until it is told to go on.
class Gate {
public:
    Gate() : m_name((std::filesystem::temp_directory_path() / "gate").string()) {
        EXPECT_EQ(::mkfifo(m_name.c_str(), 0600), 0);
    }
    ~Gate() {
        std::filesystem::remove(m_name);
    }
    std::string script(const std::string& before, const std::string& behind) const {
        return "sh -c \"" + before + "; cat " + m_name + "; " + behind + "\"";
    }
    void open() const {
        std::ofstream(m_name).flush();
    }

private:
    std::string m_name;
};

/// Starts a child and appends the first piece that it writes. The result is that of the call.
int appendFirst(LogWindow& window, const std::string& commandLine) {
    EXPECT_EQ(window.process.Run(commandLine.c_str(), nullptr, 1, 1), 1);
    while (!window.process.HasOutput()) {
        window.process.Wait(1);
    }
    return window.process.AppendOutput(window.edit, nullptr);
}

} // namespace

TEST(ProcessOutput, IsNotCutInCharactersAndLineEnds) {
    const struct {
        const char* first;
        const char* second;
        const char* shown;
        const char* whole;
    } cases[] = {
        {"gr\\303", "\\274n", "gr", "grün"},
        {"a\\r", "\\nb", "a", "a\r\nb"},
        {"\\360\\237\\230", "\\200", "", "\U0001F600"},
    };
    for (const auto& [first, second, shown, whole] : cases) {
        const Gate gate;
        LogWindow window;
        const std::string printf = "printf '";
        EXPECT_EQ(appendFirst(window, gate.script(printf + first + "'", printf + second + "'")), *shown ? 1 : 0);
        EXPECT_EQ(window.text(), shown);
        EXPECT_EQ(window.process.HasOutput(), 1) << "the rest waits";
        gate.open();
        window.process.Wait(0xFFFFFFFF);
        EXPECT_EQ(window.process.AppendOutput(window.edit, nullptr), 1);
        EXPECT_EQ(window.text(), whole);
        EXPECT_EQ(window.process.HasOutput(), 0);
    }
}

TEST(ProcessOutput, WhatWaitsForItsRestIsNotLost) {
    const Gate gate;
    LogWindow window;
    EXPECT_EQ(appendFirst(window, gate.script("sleep 1000 & printf 'a\\r'", "true")), 1);
    EXPECT_EQ(window.text(), "a");
    gate.open();
    window.process.Wait(0xFFFFFFFF);
    EXPECT_FALSE(window.process.IsActive());
    EXPECT_TRUE(window.process.HasOutput());
    EXPECT_TRUE(window.process.NotifyWindow(window.m_hWnd, outputMessage));
    ASSERT_TRUE(QTest::qWaitFor([&] { return window.messages == 1; })); // though a grandchild holds the pipe
    EXPECT_EQ(window.text(), "a\r\n");
    EXPECT_FALSE(window.process.HasOutput());
    ::kill(-static_cast<pid_t>(window.process.GetProcessId()), SIGKILL);
    window.process.Release();

    // Neither from who reads it another way.
    CString text;
    EXPECT_EQ(appendFirst(window, gate.script("printf 'b\\303'", "true")), 1);
    EXPECT_EQ(window.process.GetOutput(text), 1);
    EXPECT_EQ(text, "\xC3");
    EXPECT_FALSE(window.process.HasOutput());
    window.process.Release();

    // Nor is it waited for without end.
    ASSERT_TRUE(window.show("sh -c \"printf 'c\\r'; exec sleep 1000\""));
    EXPECT_TRUE(QTest::qWaitFor([&] { return window.text() == "a\r\nbc\r\n"; }));
}

TEST(ProcessOutput, KeepsTheEndOfWhatIsMoreThanTheLimit) {
    LogWindow window;
    window.edit.SetLimitText(20);
    ASSERT_TRUE(window.show("sh -c \"yes 12345678 | head -c 4999995; printf '<the end>'\""));
    ASSERT_TRUE(window.waitForEnd());
    EXPECT_LE(window.edit.GetTextLength(), 20);
    EXPECT_TRUE(window.text().ends_with("78\r\n<the end>")) << window.text();
}

TEST(ProcessOutput, ComesAtMostOnceAFrame) {
    LogWindow window;
    ASSERT_TRUE(window.show("sh -c \"for i in 1 2 3 4 5 6 7 8 9 10 11 12 13 14 15 16 17 18 19 20; do echo $i; done\""));
    ASSERT_TRUE(window.waitForEnd());
    const Milliseconds took = Clock::now() - window.started;
    EXPECT_LE((window.messages - 1) * 16, took.count());
    EXPECT_GE(window.messages, 1);
}

TEST(ProcessOutput, ALotOfItLeavesTheWindowResponsive) {
    LogWindow window;
    const Heartbeat heartbeat;
    constexpr const char* line = "Meshing part 3 of 12: 48291 elements, 0 of them degenerate, quality 0.87 to 0.99";
    ASSERT_TRUE(window.show("sh -c \"yes '" + std::string(line) + "' | head -c 67108864\""));
    ASSERT_TRUE(window.waitForEnd(100000));
    const Milliseconds took = Clock::now() - window.started;
    std::cout << "64 MiB in " << took.count() / 1000 << " s, " << window.messages << " messages, longest handler "
              << window.longest.count() << " ms (" << window.longestWork.count()
              << " ms of work), longest wait for the loop " << heartbeat.longest.count() << " ms\n";
    EXPECT_TRUE(window.text().find(line) != std::string::npos);
}

TEST(ProcessOutput, RequestsEndWithTheirChildAndTheirWindow) {
    LogWindow window;
    ASSERT_TRUE(window.show("sleep 1000"));
    window.process.Release();
    EXPECT_FALSE(window.process.NotifyWindow(window.m_hWnd, outputMessage)) << "no child";
    ASSERT_TRUE(window.show("sleep 1000"));
    EXPECT_EQ(window.process.NotifyWindow(nullptr, outputMessage), 0);
    Gui_Process other;
    {
        LogWindow closed;
        ASSERT_EQ(other.Run("sh -c \"sleep 0.05; echo late\"", nullptr, 1, 1), 1);
        ASSERT_EQ(other.NotifyWindow(closed.m_hWnd, outputMessage), 1);
    }
    other.Wait(0xFFFFFFFF);
    QTest::qWait(0);
    window.process.Terminate(1);
    ASSERT_TRUE(window.waitForEnd());
    EXPECT_EQ(window.messages, 1);
}

TEST(ProcessEnd, ReleasedChildrenAreCollectedByTheLoop) {
    {
        Gui_Process process;
        process.SetReleasePolicy(Gui_Process::LeaveRunning, 0);
        ASSERT_EQ(process.Run("sleep 0.1", nullptr, 0, 0), 1);
    }
    auto& released = tvx::win::ReleasedChildren::instance();
    EXPECT_GE(released.count(), 1u);
    EXPECT_TRUE(QTest::qWaitFor([&] { return released.count() == 0; }));
}
