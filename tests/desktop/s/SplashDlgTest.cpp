// The splash window under a real window manager, which takes its time to bring up a window.
#include "s/SplashDlg.h"

#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "tests/ui/s/WindowTestApp.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QScreen>
#include <QTest>

#include <cstdlib>
#include <string>

namespace {

/// A pixel of the screen that belongs to the picture's dark part.
bool isPictureSeen(const CRect& place) {
    const QImage seen = qApp->primaryScreen()->grabWindow(0, place.left + 20, place.top + 8, 1, 1).toImage();
    const QColor color = seen.pixelColor(0, 0);
    return color.blue() > color.red() + 30 && color.lightness() < 100;
}

bool becomesActive(const CWnd& window) {
    return QTest::qWaitFor([&] { return CWnd::GetActiveWindow() == &window; });
}

CFrameWnd* makeFrame(const CRect& rect) {
    auto* frame = new CFrameWnd;
    EXPECT_TRUE(frame->Create(nullptr, "Main", WS_OVERLAPPEDWINDOW, rect));
    return frame;
}

} // namespace

TEST(SplashOnDesktop, IsSeenAtOnceAndStaysInFrontWithoutTheKeyboard) {
    windowTestApp.SetRegistryKey("Maker");
    Gui_SplashDlg splash(nullptr);
    ASSERT_EQ(splash.Create(nullptr), 1);
    CRect place;
    splash.GetWindowRect(&place);
    EXPECT_TRUE(isPictureSeen(place)) << "before the application asks for events";
    CFrameWnd* frame = makeFrame(CRect(place.left - 60, place.top - 60, place.right + 60, place.bottom + 60));
    windowTestApp.m_pMainWnd = frame;
    frame->ShowWindow(SW_SHOW);
    ASSERT_TRUE(becomesActive(*frame));
    frame->UpdateWindow();
    EXPECT_TRUE(isPictureSeen(place));
    // Dragged by its caption, which the window manager draws: no press comes to the application.
    CRect outside;
    frame->GetWindowRect(&outside);
    splash.SendMessage(WM_TIMER, 1);
    splash.SendMessage(WM_TIMER, 1); // it stands still
    const std::string caption = std::to_string(outside.left + 150) + " " + std::to_string(outside.top + 8);
    const std::string drag = "xdotool mousemove --sync " + caption +
                             " mousedown 1 mousemove_relative --sync 10 10 mousemove_relative --sync 30 30 mouseup 1";
    ASSERT_EQ(std::system(drag.c_str()), 0);
    EXPECT_TRUE(QTest::qWaitFor([&] { return splash.m_hWnd == nullptr; }));
    windowTestApp.m_pMainWnd = nullptr;
    frame->DestroyWindow();
}
