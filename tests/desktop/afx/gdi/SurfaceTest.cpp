// What is drawn outside of paint events really comes to a display's screen. The offscreen platform cannot tell: its
// screen is the windows' own pixels, shown or not.
#include "platform/afx/core/detail/WindowSurface.h"
#include "platform/afx/gdi/Dc.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QScreen>
#include <QTest>
#include <QWidget>

using namespace tvx::afx;

namespace {

constexpr int patience = 5000;

HDC openContext(QWidget& widget) {
    return addContext(std::make_shared<DeviceContext>(
        DcKind::Window,
        std::make_unique<WindowTarget>(widget, WindowPart::Client, [&widget] { return widget.rect(); })));
}

QColor shown(const QWidget& widget, int x, int y) {
    return widget.screen()->grabWindow(0).toImage().pixelColor(widget.mapToGlobal(QPoint(x, y)));
}

/// Waits until the screen shows a colour at a point.
bool becomes(const QWidget& widget, QPoint point, const QColor& color) {
    return QTest::qWaitFor([&] { return shown(widget, point.x(), point.y()) == color; }, patience);
}

class SurfaceOnScreen : public testing::Test {
protected:
    SurfaceOnScreen() {
        window.setStyleSheet(QStringLiteral("background: #00ff00"));
        window.setGeometry(100, 100, 300, 200);
        window.show();
        EXPECT_TRUE(QTest::qWaitForWindowExposed(&window));
        EXPECT_TRUE(becomes(window, QPoint(290, 190), Qt::green));
    }
    QWidget window;
};

TEST_F(SurfaceOnScreen, ShowsDrawingWhenTheContextIsReleased) {
    CDC dc;
    dc.Attach(openContext(window));
    dc.FillSolidRect(10, 10, 20, 20, RGB(255, 0, 0));
    dc.DeleteDC();
    EXPECT_TRUE(becomes(window, QPoint(15, 15), Qt::red));
    EXPECT_EQ(shown(window, 9, 15), QColor(Qt::green));
}

TEST_F(SurfaceOnScreen, ShowsDrawingOfAContextThatIsKeptOpen) {
    CDC dc;
    dc.Attach(openContext(window));
    dc.FillSolidRect(10, 10, 20, 20, RGB(0, 0, 255));
    EXPECT_TRUE(becomes(window, QPoint(15, 15), Qt::blue));
    window.resize(500, 400);
    EXPECT_TRUE(becomes(window, QPoint(490, 390), Qt::green));
    dc.FillSolidRect(400, 300, 20, 20, RGB(255, 0, 0));
    EXPECT_TRUE(becomes(window, QPoint(410, 310), Qt::red));
    EXPECT_EQ(dc.GetPixel(410, 310), RGB(255, 0, 0));
}

TEST_F(SurfaceOnScreen, ShowsDrawingBesideAndInNativeWindows) {
    QWidget left(&window);
    left.setGeometry(0, 0, 100, 200);
    QWidget right(&window);
    right.setGeometry(100, 0, 200, 200);
    for (QWidget* child : {&left, &right}) {
        child->setAttribute(Qt::WA_NativeWindow);
        child->show();
        EXPECT_TRUE(child->internalWinId());
    }
    EXPECT_TRUE(becomes(window, QPoint(150, 100), Qt::green));
    QApplication::processEvents();
    CDC dc;
    dc.Attach(openContext(right));
    dc.FillSolidRect(10, 10, 20, 20, RGB(255, 0, 0));
    dc.DeleteDC();
    EXPECT_TRUE(becomes(right, QPoint(15, 15), Qt::red));
    EXPECT_EQ(shown(right, 9, 15), QColor(Qt::green));
}

} // namespace

int main(int argc, char** argv) {
    testing::InitGoogleTest(&argc, argv);
    if (GTEST_FLAG_GET(list_tests)) {
        return RUN_ALL_TESTS(); // which has to work without a display
    }
    const QApplication application(argc, argv);
    return RUN_ALL_TESTS();
}
