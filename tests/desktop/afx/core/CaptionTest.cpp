// What the window manager does for windows that draw their caption themselves; the mouse is the display's.
#include "tests/ui/afx/CaptionTesting.h"

#include <QProcess>
#include <QScreen>

#include <gtest/gtest.h>

using namespace captiontest;

namespace {

class CaptionOnDesktop : public testing::Test {
protected:
    CaptionOnDesktop() {
        window.on[WM_GETMINMAXINFO] = [](LPARAM info, LRESULT&) {
            reinterpret_cast<MINMAXINFO*>(info)->ptMinTrackSize = {300, 200};
            return true;
        };
        window.on[WM_SYSCOMMAND] = nullptr;
        window.CreateEx(WS_EX_OWNCAPTION, AfxRegisterWndClass(CS_DBLCLKS), "Caption", WS_OVERLAPPEDWINDOW, start.x(),
                        start.y(), start.width(), start.height(), nullptr, nullptr);
        window.ShowWindow(SW_SHOW);
        EXPECT_TRUE(QTest::qWaitForWindowActive(&widgetOf(window)));
        expectPlace(start);
    }
    ~CaptionOnDesktop() override {
        window.DestroyWindow();
    }
    /// Has the user do something with the mouse.
    static void run(const QString& acts) {
        QProcess tool;
        tool.start("xdotool", acts.split(' '));
        EXPECT_TRUE(QTest::qWaitFor([&] { return tool.state() == QProcess::NotRunning; }));
        EXPECT_EQ(tool.exitCode(), 0);
    }
    /// Brings the pointer to a point of the window.
    void pointTo(QPoint at) const {
        const QPoint screen = widgetOf(window).mapToGlobal(at);
        run(QString("mousemove %1 %2").arg(screen.x()).arg(screen.y()));
        EXPECT_TRUE(QTest::qWaitFor([&] { return QCursor::pos() == screen; }));
    }
    /// Drags from a point of the window, in steps as a hand does.
    void drag(QPoint from, QPoint by, const std::function<void()>& meanwhile = [] {}) const {
        pointTo(from);
        run("mousedown 1");
        for (int i = 0; i < 4; ++i) {
            run(QString("mousemove_relative -- %1 %2").arg(by.x() / 4).arg(by.y() / 4));
        }
        meanwhile();
        run("mouseup 1");
    }
    /// The same, released when the window is seen to follow: the display loses a release that comes while the window
    /// manager still holds the press.
    void dragSeen(QPoint from, QPoint by) const {
        const QRect before = place();
        drag(from, by, [&] { EXPECT_TRUE(QTest::qWaitFor([&] { return place() != before; })); });
    }
    [[nodiscard]] QRect place() const {
        return placeOf(window);
    }
    void expectPlace(const QRect& wanted) const {
        EXPECT_TRUE(QTest::qWaitFor([&] { return place() == wanted; }))
            << place().x() << " " << place().y() << " " << place().width() << " " << place().height();
    }
    const QRect start{200, 120, 400, 300};
    Probe<CWnd> window;
};

TEST_F(CaptionOnDesktop, IsMovedOnlyWhenTheMouseHasGoneAWay) {
    drag(QPoint(120, 12), QPoint(4, 4));
    EXPECT_EQ(place(), start);
    window.on[WM_NCACTIVATE] = nullptr;
    drag(QPoint(200, 12), QPoint(120, 80), [] {
        EXPECT_TRUE(QTest::qWaitFor([] { return !QApplication::activeWindow(); })) << "as the toolkit sees it";
    });
    EXPECT_TRUE(QTest::qWaitForWindowActive(&widgetOf(window)));
    EXPECT_EQ(window.of(WM_NCACTIVATE), std::vector<WPARAM>{}) << "the window stays the active one";
    EXPECT_TRUE(QTest::qWaitFor([&] { return place().x() >= start.x() + 90 && place().y() >= start.y() + 50; }));
    EXPECT_EQ(place().size(), start.size());
    EXPECT_EQ(CWnd::GetCapture(), nullptr);
    // The first press after that is an ordinary one.
    pointTo(middleOf(window, HTMINBUTTON));
    run("click 1");
    EXPECT_TRUE(QTest::qWaitFor([&] { return window.IsIconic() != FALSE; }));
    window.ShowWindow(SW_RESTORE);
    EXPECT_TRUE(QTest::qWaitFor([&] { return window.IsIconic() == FALSE && widgetOf(window).isActiveWindow(); }));
}

TEST_F(CaptionOnDesktop, EdgesKeepToTheLeastSize) {
    dragSeen(QPoint(399, 299), QPoint(-40, -20));
    EXPECT_TRUE(QTest::qWaitFor([&] { return place().width() < 370 && place().height() < 290; }));
    dragSeen(QPoint(place().width() - 1, place().height() - 1), QPoint(-200, -200));
    expectPlace(QRect(start.topLeft(), QSize(300, 200)));
    dragSeen(QPoint(0, 100), QPoint(-60, 0));
    EXPECT_TRUE(QTest::qWaitFor([&] { return place().x() < start.x() - 30; }));
    EXPECT_EQ(place().right(), start.x() + 299);
}

TEST_F(CaptionOnDesktop, ADoubleClickFillsTheScreenAndTakesItBack) {
    pointTo(QPoint(200, 12));
    run("click --repeat 2 --delay 20 1");
    EXPECT_TRUE(QTest::qWaitFor([&] {
        return window.IsZoomed() && widgetOf(window).geometry() == widgetOf(window).screen()->availableGeometry();
    }));
    EXPECT_EQ(partAt(window, QPoint(0, 100)), HTCLIENT) << "no border";
    pointTo(QPoint(200, 12));
    run("click --repeat 2 --delay 20 1");
    expectPlace(start);
    window.ShowWindow(SW_SHOWMAXIMIZED);
    EXPECT_TRUE(
        QTest::qWaitFor([&] { return widgetOf(window).geometry() == widgetOf(window).screen()->availableGeometry(); }));
    window.seen.clear();
    window.on[WM_SYSCOMMAND] = [](LPARAM, LRESULT&) { return true; };
    run("mousemove 5000 0");
    run("click 1");
    EXPECT_TRUE(QTest::qWaitFor([&] { return window.of(WM_SYSCOMMAND) == std::vector<WPARAM>{SC_CLOSE}; }))
        << "the screen's corner is the close button's";
}

TEST_F(CaptionOnDesktop, APressThatAHandlerTakesIsReleasedOutside) {
    std::vector<QPoint> released;
    window.on[WM_NCLBUTTONDOWN] = [&](LPARAM, LRESULT&) {
        window.SetCapture();
        return true;
    };
    window.on[WM_LBUTTONUP] = [&](LPARAM at, LRESULT&) {
        released.push_back(window.GetState()->clientToScreen(pointOf(at)));
        ReleaseCapture();
        return true;
    };
    drag(QPoint(200, 12), QPoint(-280, -100));
    EXPECT_TRUE(QTest::qWaitFor([&] { return !released.empty(); }));
    EXPECT_EQ(released, std::vector<QPoint>{start.topLeft() + QPoint(-80, -88)});
    EXPECT_EQ(place(), start);
}

} // namespace
