// What one process does with the windows of another, under a real window manager.
#include "platform/afx/core/WindowCalls.h"
#include "platform/win/Desktop.h"
#include "platform/win/Error.h"
#include "platform/win/Thread.h"
#include "tests/desktop/afx/Peer.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <string>
#include <vector>

namespace {

HWND handle(std::uintptr_t number) {
    return reinterpret_cast<HWND>(number);
}

std::vector<HWND> collect(const std::function<BOOL(WNDENUMPROC, LPARAM)>& enumerate) {
    std::vector<HWND> found;
    const auto add = [](HWND window, LPARAM list) -> BOOL {
        reinterpret_cast<std::vector<HWND>*>(list)->push_back(window);
        return TRUE;
    };
    EXPECT_TRUE(enumerate(add, reinterpret_cast<LPARAM>(&found)));
    return found;
}

std::vector<HWND> windowsOfThread(DWORD thread) {
    return collect([thread](WNDENUMPROC add, LPARAM list) { return EnumThreadWindows(thread, add, list); });
}

std::vector<HWND> allWindows() {
    return collect([](WNDENUMPROC add, LPARAM list) { return EnumWindows(add, list); });
}

bool becomesIconic(HWND window) {
    return becomesTrue([window] { return IsIconic(window); });
}

bool comesToTheFront(HWND window) {
    return becomesTrue([window] { return GetForegroundWindow() == window; });
}

} // namespace

TEST(DesktopCalls, RestoreAndRaiseAMinimisedWindow) {
    const Peer first;
    const Peer second;
    ASSERT_TRUE(first.shown && second.shown);
    EXPECT_EQ(allWindows(), (std::vector{second.window, first.window}));
    EXPECT_TRUE(ShowWindow(first.window, SW_MINIMIZE));
    ASSERT_TRUE(becomesIconic(first.window));
    EXPECT_TRUE(comesToTheFront(second.window));

    EXPECT_TRUE(ShowWindow(first.window, SW_RESTORE));
    EXPECT_FALSE(IsIconic(first.window));
    EXPECT_TRUE(comesToTheFront(first.window));
    EXPECT_TRUE(becomesTrue([&] { return allWindows() == std::vector{first.window, second.window}; }));

    EXPECT_TRUE(SetForegroundWindow(second.window));
    EXPECT_TRUE(comesToTheFront(second.window));
}

TEST(DesktopCalls, RestoreAMaximisedWindowToItsSizeBefore) {
    const Peer peer;
    ASSERT_TRUE(peer.shown);
    const auto zoomed = [&] { return IsZoomed(peer.window) != FALSE; };
    EXPECT_FALSE(zoomed());
    ShowWindow(peer.window, SW_SHOWMAXIMIZED);
    ASSERT_TRUE(becomesTrue(zoomed));
    // Minimised, it keeps its state.
    ShowWindow(peer.window, SW_MINIMIZE);
    ASSERT_TRUE(becomesIconic(peer.window));
    ShowWindow(peer.window, SW_RESTORE);
    EXPECT_TRUE(zoomed());
    ShowWindow(peer.window, SW_RESTORE);
    EXPECT_TRUE(becomesTrue([&] { return !zoomed(); }));
}

TEST(DesktopCalls, TellWhoseWindowItIs) {
    const Peer peer;
    const Peer other;
    ASSERT_TRUE(peer.shown && other.shown);
    const auto number = static_cast<DWORD>(peer.process);
    DWORD process = 0;
    EXPECT_EQ(GetWindowThreadProcessId(peer.window, &process), number);
    EXPECT_EQ(process, number);
    EXPECT_EQ(windowsOfThread(number), std::vector{peer.window});
    EXPECT_TRUE(windowsOfThread(GetCurrentThreadId()).empty());
    EXPECT_EQ(GetParent(peer.window), nullptr);
    char name[8] = "";
    EXPECT_GT(GetClassNameA(peer.window, name, sizeof name), 0);
    EXPECT_TRUE(AttachThreadInput(GetCurrentThreadId(), number, TRUE));
    EXPECT_FALSE(AttachThreadInput(number, number, TRUE));
}

TEST(DesktopCalls, KnowNoWindowWhereThereIsNone) {
    Peer peer;
    ASSERT_TRUE(peer.shown);
    const HWND closed = peer.window;
    // Any process may have helpers that are never shown; the next ids of the peer are such or none.
    const auto helper = reinterpret_cast<std::uintptr_t>(closed) - 1;
    peer.end();
    ASSERT_TRUE(becomesTrue([closed] { return !IsWindow(closed); }));
    for (const HWND window : {handle(0), handle(1), handle(helper), closed, handle(0x1FFFFFFF), handle(0x80000001),
                              handle(0xFFFFFFFF), handle(0x7FFFFFFFFFFFFFFF)}) {
        SetLastError(0);
        EXPECT_FALSE(IsWindow(window)) << window;
        EXPECT_FALSE(IsIconic(window)) << window;
        EXPECT_FALSE(ShowWindow(window, SW_RESTORE)) << window;
        EXPECT_EQ(GetLastError(), ERROR_INVALID_WINDOW_HANDLE) << window;
        EXPECT_FALSE(SetForegroundWindow(window)) << window;
        EXPECT_EQ(GetWindowThreadProcessId(window, nullptr), 0u) << window;
    }
    EXPECT_TRUE(allWindows().empty());
    EXPECT_EQ(GetForegroundWindow(), nullptr);
}

TEST(DesktopCalls, AskAnotherDisplayOrNoneAsTheEnvironmentSays) {
    const Peer peer;
    ASSERT_TRUE(peer.shown);
    const std::string display = std::getenv("DISPLAY");
    for (const char* other : {"", ":4711", "garbage"}) {
        setenv("DISPLAY", other, 1);
        EXPECT_FALSE(IsWindow(peer.window)) << other;
        EXPECT_FALSE(ShowWindow(peer.window, SW_RESTORE)) << other;
        EXPECT_TRUE(allWindows().empty()) << other;
    }
    setenv("DISPLAY", display.c_str(), 1);
    EXPECT_TRUE(IsWindow(peer.window));
}
