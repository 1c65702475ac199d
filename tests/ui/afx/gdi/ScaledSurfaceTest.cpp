#include "platform/afx/core/detail/WindowSurface.h"
#include "platform/afx/gdi/Dc.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QPainter>
#include <QScreen>
#include <QTest>
#include <QWidget>

using namespace tvx::afx;

namespace {

class GreenWidget : public QWidget {
protected:
    void paintEvent(QPaintEvent*) override {
        QPainter(this).fillRect(rect(), QColor(0, 255, 0));
    }
};

/// On a display with two pixels for one, window pixels are not the store's pixels: drawing goes through a copy.
TEST(ScaledSurface, DrawsAndReadsInUnscaledPixels) {
    GreenWidget window;
    window.resize(100, 80);
    window.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&window));
    QApplication::processEvents();
    ASSERT_EQ(window.devicePixelRatio(), 2);
    CDC dc;
    dc.Attach(addContext(std::make_shared<DeviceContext>(
        DcKind::Window,
        std::make_unique<WindowTarget>(window, WindowPart::Client, [&window] { return window.rect(); }))));
    EXPECT_EQ(dc.GetPixel(50, 50), RGB(0, 255, 0));
    dc.FillSolidRect(10, 10, 20, 20, RGB(255, 0, 0));
    dc.PatBlt(20, 10, 10, 20, DSTINVERT);
    EXPECT_EQ(dc.GetPixel(10, 10), RGB(255, 0, 0));
    EXPECT_EQ(dc.GetPixel(29, 29), RGB(0, 255, 255));
    EXPECT_EQ(dc.GetPixel(30, 29), RGB(0, 255, 0));
    dc.DeleteDC();
    const QImage screen = window.screen()->grabWindow(window.winId()).toImage();
    EXPECT_EQ(screen.pixelColor(20, 20), QColor(255, 0, 0));
    EXPECT_EQ(screen.pixelColor(39, 59), QColor(255, 0, 0));
    EXPECT_EQ(screen.pixelColor(59, 59), QColor(0, 255, 255));
    EXPECT_EQ(screen.pixelColor(60, 59), QColor(0, 255, 0));
}

} // namespace

int main(int argc, char** argv) {
    setenv("QT_SCALE_FACTOR", "2", 1);
    testing::InitGoogleTest(&argc, argv);
    const QApplication application(argc, argv);
    return RUN_ALL_TESTS();
}
