// Frames end where they were asked to, though the window manager puts its borders around them only when they are shown.
#include "platform/afx/core/App.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/DesktopAnswers.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/dialogs/Dialog.h"
#include "platform/afx/frames/Frame.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "tests/ui/afx/dialogs/DialogTestIds.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QScreen>
#include <QTest>
#include <QTimer>
#include <QWidget>
#include <QWindow>

#include <csignal>
#include <cstdlib>
#include <memory>
#include <string>

using namespace tvx::afx;

namespace {

CWinApp testApplication("Placement tests");

constexpr int patience = 5000;

/// What a rectangle is called in failures.
std::string words(const CRect& rect) {
    return std::to_string(rect.left) + "," + std::to_string(rect.top) + " to " + std::to_string(rect.right) + "," +
           std::to_string(rect.bottom);
}

WINDOWPLACEMENT placementOf(const CWnd& window) {
    WINDOWPLACEMENT placement{};
    EXPECT_TRUE(window.GetWindowPlacement(&placement));
    return placement;
}

WINDOWPLACEMENT placementFor(const CRect& rect, UINT command, UINT flags = 0) {
    WINDOWPLACEMENT placement{};
    placement.length = sizeof(WINDOWPLACEMENT);
    placement.showCmd = command;
    placement.flags = flags;
    placement.rcNormalPosition = rect;
    return placement;
}

class TestFrame : public CFrameWnd {
protected:
    void PostNcDestroy() override {}
};

class FramesOnDesktop : public testing::Test {
protected:
    FramesOnDesktop() {
        ensureGui();
        make();
    }
    ~FramesOnDesktop() override {
        frame->DestroyWindow();
    }
    /// A new frame in place of the old one, as at another start of the application.
    void make() {
        if (frame) {
            frame->DestroyWindow();
        }
        frame = std::make_unique<TestFrame>();
        ASSERT_TRUE(frame->Create(nullptr, "Frame"));
    }
    CRect frameRect() const {
        CRect rect;
        frame->GetWindowRect(rect);
        return rect;
    }
    /// Waits until the frame stands at a rectangle, its borders included, for the framework and for the display server,
    /// and the window manager has nothing left to do.
    void standsAt(const CRect& rect) const {
        const auto is = [&] { return framed() && frameRect() == rect && onScreen() == rect; };
        const bool stands = QTest::qWaitFor([&] { return is() && answered() && is(); }, patience);
        EXPECT_TRUE(stands) << words(frameRect()) << ", on the screen " << words(onScreen()) << ", not " << words(rect);
    }
    static bool answered() {
        QTimer timer;
        bool over = false;
        timer.setSingleShot(true);
        QObject::connect(&timer, &QTimer::timeout, [&over] { over = true; });
        EXPECT_EQ(startWhenDesktopHasAnswered(timer), Told::ByManager);
        return QTest::qWaitFor([&over] { return over; }, patience);
    }
    bool framed() const {
        const QWindow* native = frame->GetState()->widget()->windowHandle();
        return native && native->isExposed() && native->frameMargins().top() > 0;
    }
    /// The frame as the display server tells it.
    CRect onScreen() const {
        return fromQt(frame->GetState()->widget()->windowHandle()->frameGeometry());
    }
    bool fillsScreen() const {
        return QTest::qWaitFor([&] { return framed() && frameRect().Width() >= ::GetSystemMetrics(SM_CXSCREEN); },
                               patience);
    }
    bool becomes(UINT command) const {
        return QTest::qWaitFor([&] { return placementOf(*frame).showCmd == command; }, patience);
    }
    std::unique_ptr<TestFrame> frame;
};

const CRect givenPlace(90, 70, 690, 520);

/// Halts the window manager for a while, as a machine with other work does.
class HaltedManager {
public:
    HaltedManager() : m_process(std::atoi(std::getenv("TVX_WINDOW_MANAGER"))) {
        EXPECT_EQ(kill(m_process, SIGSTOP), 0);
    }
    ~HaltedManager() {
        kill(m_process, SIGCONT);
    }
    HaltedManager(const HaltedManager&) = delete;
    HaltedManager& operator=(const HaltedManager&) = delete;

private:
    pid_t m_process;
};

/// As long as a user takes for something else; windows must get right whenever the window manager goes on.
constexpr int meanwhile = 500;

} // namespace

TEST_F(FramesOnDesktop, PlacedBeforeTheFirstShowStandAtTheRectangle) {
    const auto placement = placementFor(CRect(0, 0, 600, 400), SW_SHOWNORMAL);
    ASSERT_TRUE(frame->SetWindowPlacement(&placement));
    standsAt(CRect(0, 0, 600, 400));
    make();
    frame->MoveWindow(givenPlace);
    EXPECT_EQ(frameRect(), givenPlace) << "also before it is shown";
    frame->ShowWindow(SW_SHOW);
    standsAt(givenPlace);
}

TEST_F(FramesOnDesktop, SavedAndRestoredAgainAndAgainStayWhereTheyAre) {
    auto placement = placementFor(givenPlace, SW_SHOWNORMAL);
    for (int i = 0; i < 4; ++i) {
        ASSERT_TRUE(frame->SetWindowPlacement(&placement));
        standsAt(givenPlace);
        placement = placementOf(*frame);
        EXPECT_EQ(CRect(placement.rcNormalPosition), givenPlace);
        make();
    }
}

TEST_F(FramesOnDesktop, MaximizedRememberWhereTheyGoBackTo) {
    auto placement = placementFor(givenPlace, SW_SHOWMAXIMIZED);
    for (int i = 0; i < 2; ++i) {
        ASSERT_TRUE(frame->SetWindowPlacement(&placement));
        ASSERT_TRUE(becomes(SW_SHOWMAXIMIZED));
        ASSERT_TRUE(fillsScreen());
        placement = placementOf(*frame);
        EXPECT_EQ(CRect(placement.rcNormalPosition), givenPlace) << words(placement.rcNormalPosition);
        frame->ShowWindow(SW_RESTORE);
        standsAt(givenPlace);
        make();
    }
}

TEST_F(FramesOnDesktop, MaximizedByTheWindowManagerRememberTheirLastPlace) {
    frame->ShowWindow(SW_SHOW);
    frame->MoveWindow(CRect(10, 20, 500, 400));
    standsAt(CRect(10, 20, 500, 400));
    frame->MoveWindow(givenPlace);
    standsAt(givenPlace);
    frame->GetState()->widget()->windowHandle()->showMaximized();
    ASSERT_TRUE(becomes(SW_SHOWMAXIMIZED));
    ASSERT_TRUE(fillsScreen());
    EXPECT_EQ(CRect(placementOf(*frame).rcNormalPosition), givenPlace) << words(placementOf(*frame).rcNormalPosition);
    frame->ShowWindow(SW_RESTORE);
    standsAt(givenPlace);
    EXPECT_EQ(placementOf(*frame).showCmd, UINT{SW_SHOWNORMAL});
}

TEST_F(FramesOnDesktop, PlacedWhileMaximizedGoBackToTheNewRectangle) {
    frame->ShowWindow(SW_SHOWMAXIMIZED);
    ASSERT_TRUE(fillsScreen());
    auto placement = placementFor(givenPlace, SW_SHOWMAXIMIZED);
    ASSERT_TRUE(frame->SetWindowPlacement(&placement));
    EXPECT_EQ(CRect(placementOf(*frame).rcNormalPosition), givenPlace);
    placement.showCmd = SW_SHOWNORMAL;
    ASSERT_TRUE(frame->SetWindowPlacement(&placement));
    standsAt(givenPlace);
}

TEST_F(FramesOnDesktop, ShownAndMovedBeforeTheWindowManagerComesToItStandAtTheLastRectangle) {
    {
        const HaltedManager halted;
        const auto placement = placementFor(CRect(10, 20, 500, 400), SW_SHOWNORMAL);
        ASSERT_TRUE(frame->SetWindowPlacement(&placement));
        QTest::qWait(meanwhile);
        frame->MoveWindow(givenPlace);
        QTest::qWait(meanwhile);
    }
    standsAt(givenPlace);
    EXPECT_EQ(CRect(placementOf(*frame).rcNormalPosition), givenPlace);
}

TEST_F(FramesOnDesktop, PlacedWhileMaximizedGoBackToTheNewRectangleAlsoLate) {
    frame->ShowWindow(SW_SHOWMAXIMIZED);
    ASSERT_TRUE(fillsScreen());
    {
        const HaltedManager halted;
        const auto placement = placementFor(givenPlace, SW_SHOWNORMAL);
        ASSERT_TRUE(frame->SetWindowPlacement(&placement));
        QTest::qWait(meanwhile);
        EXPECT_EQ(CRect(placementOf(*frame).rcNormalPosition), givenPlace);
    }
    standsAt(givenPlace);
    {
        const HaltedManager halted;
        frame->ShowWindow(SW_SHOWMAXIMIZED);
        QTest::qWait(meanwhile);
    }
    ASSERT_TRUE(fillsScreen());
    EXPECT_EQ(CRect(placementOf(*frame).rcNormalPosition), givenPlace);
}

TEST_F(FramesOnDesktop, MaximizedAgainBeforeTheWindowManagerHasRestoredThemFillTheScreen) {
    frame->ShowWindow(SW_SHOWMAXIMIZED);
    ASSERT_TRUE(fillsScreen());
    {
        const HaltedManager halted;
        const auto placement = placementFor(givenPlace, SW_SHOWNORMAL);
        ASSERT_TRUE(frame->SetWindowPlacement(&placement));
        frame->ShowWindow(SW_SHOWMAXIMIZED);
    }
    ASSERT_TRUE(answered());
    EXPECT_TRUE(fillsScreen()) << words(frameRect()) << ", on the screen " << words(onScreen());
    EXPECT_EQ(CRect(placementOf(*frame).rcNormalPosition), givenPlace);
}

TEST_F(FramesOnDesktop, MinimizedSayWhetherTheyWereMaximized) {
    auto placement = placementFor(givenPlace, SW_SHOWMAXIMIZED);
    ASSERT_TRUE(frame->SetWindowPlacement(&placement));
    ASSERT_TRUE(becomes(SW_SHOWMAXIMIZED));
    frame->ShowWindow(SW_MINIMIZE);
    ASSERT_TRUE(becomes(SW_SHOWMINIMIZED));
    placement = placementOf(*frame);
    EXPECT_EQ(placement.flags, UINT{WPF_RESTORETOMAXIMIZED});
    EXPECT_EQ(CRect(placement.rcNormalPosition), givenPlace);
    make();
    ASSERT_TRUE(frame->SetWindowPlacement(&placement));
    ASSERT_TRUE(becomes(SW_SHOWMINIMIZED));
    frame->ShowWindow(SW_RESTORE);
    ASSERT_TRUE(becomes(SW_SHOWMAXIMIZED));
    EXPECT_EQ(CRect(placementOf(*frame).rcNormalPosition), givenPlace);
}

TEST_F(FramesOnDesktop, PlacedOffTheScreenComeBackToIt) {
    const auto placement = placementFor(CRect(5000, 4000, 5600, 4400), SW_SHOWNORMAL);
    ASSERT_TRUE(frame->SetWindowPlacement(&placement));
    const QRect screen = QGuiApplication::primaryScreen()->availableGeometry();
    standsAt(CRect(screen.right() + 1 - 600, screen.bottom() + 1 - 400, screen.right() + 1, screen.bottom() + 1));
}

namespace {

class LaidOutDialog : public CDialog {
protected:
    BOOL OnInitDialog() override {
        CDialog::OnInitDialog();
        return SetWindowPos(nullptr, 0, 0, 420, 260, SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
    }
};

} // namespace

TEST_F(FramesOnDesktop, HaveDialogsOverTheirMiddleInTheWholeSizeThatTheyGaveThemselves) {
    frame->MoveWindow(givenPlace);
    frame->ShowWindow(SW_SHOW);
    standsAt(givenPlace);
    LaidOutDialog dialog;
    ASSERT_TRUE(dialog.Create(IDD_EMPTY, frame.get()));
    dialog.ShowWindow(SW_SHOW);
    const QWidget& widget = *dialog.GetState()->widget();
    const CSize size(420, 260);
    const CRect wanted(givenPlace.CenterPoint() - CSize(size.cx / 2, size.cy / 2), size);
    const auto onScreen = [&] { return fromQt(widget.windowHandle()->frameGeometry()); };
    const auto framed = [&] { return widget.windowHandle()->frameMargins().top() > 0; };
    EXPECT_TRUE(QTest::qWaitFor([&] { return framed() && onScreen() == wanted; }, patience)) << words(onScreen());
    dialog.DestroyWindow();
}

TEST_F(FramesOnDesktop, KeepTheKeyboardWhenAWindowIsShownWithoutActivation) {
    frame->ShowWindow(SW_SHOW);
    ASSERT_TRUE(QTest::qWaitForWindowActive(frame->GetState()->widget()));
    CDialog dialog;
    ASSERT_TRUE(dialog.Create(IDD_EMPTY, frame.get()));
    dialog.ShowWindow(SW_SHOWNOACTIVATE);
    QWidget& widget = *dialog.GetState()->widget();
    const auto mayBeGiven = [&] { return (widget.windowHandle()->flags() & Qt::WindowDoesNotAcceptFocus) == 0; };
    ASSERT_TRUE(QTest::qWaitFor([&] { return widget.windowHandle()->isExposed() && mayBeGiven(); }, patience));
    EXPECT_TRUE(frame->GetState()->widget()->isActiveWindow());
    dialog.SetActiveWindow();
    EXPECT_TRUE(QTest::qWaitFor([&] { return widget.isActiveWindow(); }, patience));
    dialog.DestroyWindow();
}

TEST(DialogsOnDesktop, KeepTheirInsideAndStandWhereTheyStood) {
    CDialog dialog;
    ASSERT_TRUE(dialog.Create(IDD_EMPTY));
    const auto client = [&dialog] {
        CRect now;
        dialog.GetClientRect(now);
        return now;
    };
    const auto rect = [&dialog] {
        CRect now;
        dialog.GetWindowRect(now);
        return now;
    };
    const auto framed = [&] { return rect().Width() > client().Width(); };
    const CRect inside = client();
    const CSize outside = rect().Size();
    EXPECT_TRUE(framed()) << "borders count before they are there";
    dialog.MoveWindow(200, 150, outside.cx, outside.cy);
    dialog.ShowWindow(SW_SHOWNOACTIVATE);
    const QWindow& native = *dialog.GetState()->widget()->windowHandle();
    ASSERT_TRUE(QTest::qWaitFor([&] { return native.frameMargins().top() > 0; }, patience));
    ASSERT_TRUE(QTest::qWaitFor([&] { return rect() == CRect(CPoint(200, 150), outside); }, patience)) << words(rect());
    EXPECT_EQ(client(), inside) << "the borders are around it, not in it: " << words(client());
    const WINDOWPLACEMENT placement = placementOf(dialog);
    dialog.DestroyWindow();
    ASSERT_TRUE(dialog.Create(IDD_EMPTY));
    ASSERT_TRUE(dialog.SetWindowPlacement(&placement));
    EXPECT_TRUE(QTest::qWaitFor([&] { return rect() == CRect(placement.rcNormalPosition) && framed(); }, patience))
        << words(rect());
    EXPECT_EQ(client(), inside) << words(client());
    dialog.DestroyWindow();
}
