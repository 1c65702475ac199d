// The splash window: where it stands, what it shows, and what makes it go.
#include "s/SplashDlg.h"

#include "s/Profile.h"
#include "s/SplashTime.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"
#include "tests/ui/afx/frames/SettingsFolder.h"
#include "tests/ui/s/WindowTestApp.h"
#include "tests/unit/SavedEnvironment.h"

#include <gtest/gtest.h>

#include <QEventLoop>
#include <QImage>

#include <algorithm>
#include <ctime>
#include <filesystem>
#include <fstream>
#include <string>

namespace {

constexpr CSize picture{332, 260};

class SplashDlg : public testing::Test {
protected:
    void SetUp() override {
        windowTestApp.SetRegistryKey("Maker");
        windowTestApp.version = "1.2";
        m_screen = CSize(GetSystemMetrics(SM_CXSCREEN), GetSystemMetrics(SM_CYSCREEN));
    }
    /// Remembers a main window that stood in a rectangle.
    static void save(const CRect& rect, UINT state = SW_SHOWNORMAL) {
        WINDOWPLACEMENT placement{};
        placement.length = sizeof placement;
        placement.showCmd = state;
        placement.rcNormalPosition = rect;
        Gui_Profile::WriteWindowPlacement(placement, nullptr, nullptr);
    }
    CPoint centre() const {
        return {(m_screen.cx - picture.cx) / 2, (m_screen.cy - picture.cy) / 2};
    }
    /// Where the splash window comes up.
    static CRect shown() {
        Gui_SplashDlg splash(nullptr);
        EXPECT_EQ(splash.Create(nullptr), 1);
        EXPECT_TRUE(splash.IsWindowVisible());
        EXPECT_TRUE((splash.GetExStyle() & WS_EX_TOPMOST) != 0);
        CRect rect;
        splash.GetWindowRect(&rect);
        EXPECT_EQ(rect.Size(), picture);
        return rect;
    }

    SettingsFolder m_settings;
    SavedEnvironment m_environment;
    CSize m_screen;
};

/// The columns, first and last, that dark text takes in some rows of the picture, within its edges.
std::pair<int, int> inkIn(const QImage& image, int top, int bottom) {
    int first = image.width();
    int last = -1;
    for (int y = top; y < bottom; ++y) {
        for (int x = 3; x < image.width() - 3; ++x) {
            if (qGray(image.pixel(x, y)) < 100) {
                first = std::min(first, x);
                last = std::max(last, x);
            }
        }
    }
    return {first, last};
}

QImage pictureOf(const CWnd& window) {
    return tvx::afx::peerOf(window.m_hWnd)->grab().toImage();
}

} // namespace

TEST_F(SplashDlg, StandsOverTheMiddleOfTheSavedWindow) {
    EXPECT_EQ(shown().TopLeft(), centre()) << "nothing is saved";
    const CRect window(60, 250, 501, 700);
    const struct {
        CRect rect;
        UINT state;
        CPoint corner;
    } rows[] = {
        {window, SW_SHOWNORMAL, {60 + 441 / 2 - 166, 250 + 225 - 130}},
        {window, SW_SHOWMINIMIZED, centre()},
        {window, SW_SHOWMAXIMIZED, centre()},
        {{-300, 250, 100, 700}, SW_SHOWNORMAL, centre()},                          // left of the screen
        {{60, -200, 501, 200}, SW_SHOWNORMAL, centre()},                           // above it
        {{m_screen.cx, 250, m_screen.cx + 332, 700}, SW_SHOWNORMAL, centre()},     // at its right edge
        {{60, m_screen.cy + 35, 501, m_screen.cy + 225}, SW_SHOWNORMAL, centre()}, // at its lower edge
        {{m_screen.cx - 1, 250, m_screen.cx + 331, 510},
         SW_SHOWNORMAL,
         {m_screen.cx - 1, 250}},                                                              // before its right edge
        {{60, m_screen.cy - 1, 392, m_screen.cy + 259}, SW_SHOWNORMAL, {60, m_screen.cy - 1}}, // before its lower edge
        {{-1, 0, 331, 260}, SW_SHOWNORMAL, centre()},
        {{0, 1, 332, 261}, SW_SHOWNORMAL, {0, 1}},
    };
    for (const auto& row : rows) {
        save(row.rect, row.state);
        EXPECT_EQ(shown().TopLeft(), row.corner) << row.rect.left << "," << row.rect.top << " state " << row.state;
    }
}

TEST_F(SplashDlg, GoesAtTheFirstPress) {
    const struct {
        UINT message;
        bool goes;
    } rows[] = {{WM_KEYDOWN, true},     {WM_SYSKEYDOWN, true},
                {WM_LBUTTONDOWN, true}, {WM_RBUTTONDOWN, true},
                {WM_MBUTTONDOWN, true}, {0xA1, true},
                {0xA4, true},           {0xA7, true},
                {WM_MOUSEMOVE, false},  {WM_NCMOUSEMOVE, false},
                {WM_KEYUP, false},      {WM_LBUTTONUP, false},
                {WM_MOUSEWHEEL, false}, {WM_TIMER, false},
                {WM_CHAR, false}};
    for (const auto& row : rows) {
        Gui_SplashDlg splash(nullptr);
        ASSERT_EQ(splash.Create(nullptr), 1);
        MSG message{splash.m_hWnd, row.message, 0, 0, 0, {}};
        splash.CheckMessage(&message, nullptr);
        EXPECT_EQ(splash.m_hWnd == nullptr, row.goes) << row.message;
        EXPECT_EQ(splash.CheckTimeout(nullptr), row.goes ? 0 : 1) << row.message;
        splash.CheckMessage(&message, nullptr);
        splash.Destroy();
        EXPECT_EQ(splash.CheckTimeout(nullptr), 0);
        EXPECT_EQ(splash.Create(nullptr), 1) << "it can be shown again";
    }
}

TEST_F(SplashDlg, GoesInTheFourthSecondWithoutAnyInput) {
    EXPECT_FALSE(IsSplashOver(100, 103));
    EXPECT_TRUE(IsSplashOver(100, 104));
    Gui_SplashDlg splash(nullptr);
    ASSERT_EQ(splash.Create(nullptr), 1);
    const std::time_t begin = std::time(nullptr);
    EXPECT_EQ(splash.CheckTimeout(nullptr), 1);
    QEventLoop loop;
    windowTestApp.idle = [&] {
        if (splash.CheckTimeout(nullptr) == 0) {
            loop.quit();
        }
    };
    loop.exec();
    windowTestApp.idle = nullptr;
    EXPECT_GE(std::time(nullptr) - begin, 3);
    EXPECT_EQ(splash.m_hWnd, nullptr);
}

TEST_F(SplashDlg, GivesWayToDialogsAndMessageBoxes) {
    Gui_SplashDlg splash(nullptr);
    ASSERT_EQ(splash.Create(nullptr), 1);
    BoxAnswer answer;
    AfxMessageBox("The settings cannot be read.");
    EXPECT_EQ(splash.m_hWnd, nullptr);

    ASSERT_EQ(splash.Create(nullptr), 1);
    Gui_SplashDlg other(nullptr); // any dialog does
    ASSERT_EQ(other.Create(nullptr), 1);
    EXPECT_EQ(splash.m_hWnd, nullptr);
    EXPECT_NE(other.m_hWnd, nullptr);
}

TEST_F(SplashDlg, GoesWhenTheUserMovesTheMainWindow) {
    CFrameWnd* frame = new CFrameWnd;
    ASSERT_TRUE(frame->Create(nullptr, "Main", WS_OVERLAPPEDWINDOW, CRect(10, 10, 300, 300)));
    windowTestApp.m_pMainWnd = frame;
    Gui_SplashDlg splash(nullptr);
    ASSERT_EQ(splash.Create(nullptr), 1);
    frame->ShowWindow(SW_SHOW);
    ASSERT_TRUE(waitForActive(*frame));
    frame->MoveWindow(20, 20, 290, 290); // as the start does, which puts it where it was
    splash.SendMessage(WM_TIMER, 1);
    splash.SendMessage(WM_TIMER, 1);
    EXPECT_NE(splash.m_hWnd, nullptr);
    frame->MoveWindow(50, 50, 290, 290);
    splash.SendMessage(WM_TIMER, 1);
    EXPECT_EQ(splash.m_hWnd, nullptr);
    windowTestApp.m_pMainWnd = nullptr;
    frame->DestroyWindow();
}

TEST_F(SplashDlg, WritesItsLinesCentredOrFromTheLeftMargin) {
    const auto folder = std::filesystem::temp_directory_path() / "splash-installation";
    std::filesystem::create_directories(folder);
    std::ofstream(folder / "fileset.txt") << "::version=10.1\n";
    setenv("TARVEX", folder.c_str(), 1);
    unsetenv("MYTARVEX");
    windowTestApp.version = "10.1.0.123456 of the year before the last one, for all";
    Gui_SplashDlg splash(nullptr);
    ASSERT_EQ(splash.Create(nullptr), 1);
    const QImage image = pictureOf(splash);
    for (const int top : {115, 147, 213, 233}) {
        const auto [first, last] = inkIn(image, top, top + 20);
        EXPECT_NEAR(first + last, 2 * 100, 3) << top; // the middle is at 100
        EXPECT_GT(first, 0) << top;
    }
    const auto [first, last] = inkIn(image, 169, 189);
    EXPECT_NEAR(first, 10, 2);
    EXPECT_GT(last, 200);
    EXPECT_LT(last, picture.cx - 2) << "all of it can be read";
    std::filesystem::remove_all(folder);
}
