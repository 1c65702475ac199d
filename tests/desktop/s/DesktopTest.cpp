// How one application brings another's window forward, under a real window manager.
#include "s/Desktop.h"

#include "tests/desktop/afx/Peer.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

namespace {

unsigned long idOf(HWND window) {
    return Gui_Desktop::GetDialogWindowID(window);
}

} // namespace

TEST(Desktop, BringsAMinimisedWindowOfAnotherProcessForward) {
    const Peer first;
    const Peer second;
    ASSERT_TRUE(first.shown && second.shown);
    ShowWindow(first.window, SW_MINIMIZE);
    ASSERT_TRUE(becomesTrue([&] { return IsIconic(first.window); }));
    ASSERT_EQ(GetForegroundWindow(), second.window);
    EXPECT_EQ(Gui_Desktop::ShowWindow(idOf(first.window)), 1);
    EXPECT_FALSE(IsIconic(first.window));
    EXPECT_TRUE(becomesTrue([&] { return GetForegroundWindow() == first.window; }));
    EXPECT_EQ(Gui_Desktop::ShowWindow(idOf(second.window)), 1);
    EXPECT_TRUE(becomesTrue([&] { return GetForegroundWindow() == second.window; }));
    EXPECT_EQ(Gui_Desktop::ShowWindow(idOf(second.window)), 1) << "it is in front already";
}

TEST(Desktop, BringsAWindowForwardFromAnApplicationWithWindowsOfItsOwn) {
    const Peer peer;
    ASSERT_TRUE(peer.shown);
    auto* frame = new CFrameWnd; // deletes itself with its window
    ASSERT_TRUE(frame->Create(nullptr, "own", WS_OVERLAPPEDWINDOW, CRect(100, 100, 400, 300)));
    frame->ShowWindow(SW_SHOW);
    const auto isInFront = [&](HWND window) {
        return becomesTrue([window] {
            MSG message;
            while (PeekMessage(&message, nullptr, 0, 0, PM_REMOVE)) {
                DispatchMessage(&message);
            }
            return GetForegroundWindow() == window;
        });
    };
    ASSERT_TRUE(isInFront(frame->m_hWnd));
    EXPECT_EQ(Gui_Desktop::ShowWindow(idOf(peer.window)), 1);
    EXPECT_TRUE(isInFront(peer.window));
    EXPECT_EQ(Gui_Desktop::ShowWindow(idOf(frame->m_hWnd)), 1);
    EXPECT_TRUE(isInFront(frame->m_hWnd));
    frame->DestroyWindow();
    EXPECT_TRUE(isInFront(peer.window));
}

TEST(Desktop, GoesToTheDesktopThatAWindowIsOn) {
    const Peer first;
    const Peer second;
    ASSERT_TRUE(first.shown && second.shown);
    const auto run = [](const std::string& command) { return std::system(command.c_str()) == 0; };
    const std::string id = std::to_string(idOf(first.window));
    const auto answers = [&](const std::string& question, int answer) {
        return becomesTrue([&] { return run("test $(xdotool " + question + ") = " + std::to_string(answer)); });
    };
    const auto isOn = [&](int desktop) { return answers("get_desktop", desktop); };
    ASSERT_TRUE(run("xdotool set_num_desktops 2 && xdotool set_desktop_for_window " + id + " 1"));
    ASSERT_TRUE(answers("get_desktop_for_window " + id, 1));
    ASSERT_TRUE(becomesTrue([&] { return GetForegroundWindow() == second.window; }));
    ASSERT_TRUE(isOn(0));
    EXPECT_FALSE(IsIconic(first.window));
    EXPECT_EQ(Gui_Desktop::ShowWindow(idOf(first.window)), 1);
    EXPECT_TRUE(isOn(1));
    EXPECT_TRUE(becomesTrue([&] { return GetForegroundWindow() == first.window; }));
    EXPECT_EQ(Gui_Desktop::ShowWindow(idOf(second.window)), 1);
    EXPECT_TRUE(isOn(0));
}

TEST(Desktop, KnowsNoWindowWhereThereIsNone) {
    Peer peer;
    ASSERT_TRUE(peer.shown);
    const unsigned long closed = idOf(peer.window);
    peer.end();
    ASSERT_TRUE(becomesTrue([closed] { return Gui_Desktop::ShowWindow(closed) == 0; }));
    for (const unsigned long garbage : {0UL, 1UL, 0xFFFFFFFFUL, 0x80000000UL, ~0UL, 0x100000000UL + closed}) {
        EXPECT_EQ(Gui_Desktop::ShowWindow(garbage), 0) << garbage;
    }
    EXPECT_EQ(Gui_Desktop::GetMainWindowID(), 0u);
    EXPECT_EQ(Gui_Desktop::GetDisplay(), nullptr);
}
