// Windows of children, under a real window manager.
#include "s/Process.h"

#include "platform/afx/core/WindowCalls.h"
#include "tests/desktop/afx/Peer.h"

#include <gtest/gtest.h>

#include <string>

namespace {

/// A child with a window that is on the screen.
class WindowChild {
public:
    WindowChild() {
        started = process.Run("\"" TVX_TEST_PEER "\"", nullptr, 1, 0) == 1;
        CString text;
        // It writes its window's handle.
        while (text.Find('\n') < 0 && process.IsActive()) {
            process.GetOutput(text);
        }
        if (text.Find('\n') > 0) {
            window = reinterpret_cast<HWND>(std::stoul(text.GetString()));
        }
        shown = becomesTrue([this] { return GetForegroundWindow() == window; });
    }

    Gui_Process process;
    HWND window = nullptr;
    bool started = false;
    bool shown = false;
};

} // namespace

TEST(ProcessWindows, ComeToTheFront) {
    WindowChild first;
    WindowChild second;
    ASSERT_TRUE(first.shown && second.shown);
    EXPECT_EQ(first.process.ShowMainWindow(), 0);
    EXPECT_TRUE(becomesTrue([&] { return GetForegroundWindow() == first.window; }));
    EXPECT_EQ(second.process.ShowMainWindow(), 0);
    EXPECT_TRUE(becomesTrue([&] { return GetForegroundWindow() == second.window; }));
    EXPECT_EQ(first.process.GetError(), 0u);
}

TEST(ProcessWindows, AreRestoredAndStayMaximised) {
    WindowChild child;
    ASSERT_TRUE(child.shown);
    ShowWindow(child.window, SW_SHOWMAXIMIZED);
    ASSERT_TRUE(becomesTrue([&] { return IsZoomed(child.window) != FALSE; }));
    EXPECT_EQ(child.process.ShowMainWindow(), 0);
    EXPECT_TRUE(IsZoomed(child.window));
    ShowWindow(child.window, SW_MINIMIZE);
    ASSERT_TRUE(becomesTrue([&] { return IsIconic(child.window) != FALSE; }));
    EXPECT_EQ(child.process.ShowMainWindow(), 0);
    EXPECT_TRUE(becomesTrue([&] { return !IsIconic(child.window) && GetForegroundWindow() == child.window; }));
}

TEST(ProcessWindows, OfAnEndedChildAreNotLookedFor) {
    Gui_Process none;
    EXPECT_EQ(none.ShowMainWindow(), 0);
    WindowChild child;
    ASSERT_TRUE(child.shown);
    child.process.Terminate(0);
    child.process.Wait(0xFFFFFFFF);
    EXPECT_EQ(child.process.ShowMainWindow(), 0);
    EXPECT_EQ(child.process.GetExitCode(), 0u);
}
