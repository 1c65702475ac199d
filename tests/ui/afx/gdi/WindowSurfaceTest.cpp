#include "platform/afx/core/detail/WindowSurface.h"
#include "platform/afx/gdi/Dc.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QGroupBox>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenuBar>
#include <QPaintEvent>
#include <QPainter>
#include <QScreen>
#include <QTest>
#include <QVBoxLayout>

#include <functional>
#include <memory>

using namespace tvx::afx;

namespace {

constexpr COLORREF plainRed = RGB(255, 0, 0);
constexpr COLORREF plainGreen = RGB(0, 255, 0);
constexpr COLORREF plainBlue = RGB(0, 0, 255);

/// A widget that paints itself green, or as the test says.
class Canvas : public QWidget {
public:
    explicit Canvas(QWidget* parent = nullptr) : QWidget(parent) {
        setAttribute(Qt::WA_OpaquePaintEvent);
    }
    std::function<void(const QRegion&)> onPaint;
    int paints = 0;

protected:
    void paintEvent(QPaintEvent* event) override {
        ++paints;
        if (onPaint) {
            onPaint(event->region());
        } else {
            QPainter(this).fillRect(rect(), QColor(0, 255, 0));
        }
    }
};

/// A context on a widget, as the window core makes them.
class WidgetDc : public CDC {
public:
    explicit WidgetDc(QWidget& widget, WindowPart part = WindowPart::Client)
        : WidgetDc(std::make_unique<WindowTarget>(widget, part, [&widget] { return widget.rect(); }), DcKind::Window) {}
    WidgetDc(std::unique_ptr<DrawTarget> target, DcKind kind) {
        Attach(addContext(std::make_shared<DeviceContext>(kind, std::move(target))));
    }
};

/// A paint context, to be used in `onPaint`.
class WidgetPaintDc : public WidgetDc {
public:
    WidgetPaintDc(QWidget& widget, const QRegion& update)
        : WidgetDc(std::make_unique<PaintTarget>(widget, update, [&widget] { return widget.rect(); }), DcKind::Paint) {}
};

/// What the screen shows of a window.
COLORREF shown(const QWidget& window, int x, int y) {
    const QImage screen = window.screen()->grabWindow(window.window()->winId()).toImage();
    const QColor color = screen.pixelColor(window.mapTo(window.window(), QPoint(x, y)));
    return RGB(color.red(), color.green(), color.blue());
}

class Surface : public testing::Test {
protected:
    Surface() {
        window.resize(200, 150);
        window.show();
        EXPECT_TRUE(QTest::qWaitForWindowExposed(&window));
        settle();
    }
    /// Lets the toolkit paint what is waiting to be painted.
    static void settle() {
        QTest::qWait(0);
        QApplication::sendPostedEvents();
        QApplication::processEvents();
    }
    Canvas window;
};

TEST_F(Surface, ShowsDrawingAtOnceAndUntilThePartIsInvalidated) {
    const int paints = window.paints;
    {
        WidgetDc dc(window);
        dc.FillSolidRect(10, 10, 20, 20, plainRed);
        EXPECT_EQ(dc.GetPixel(10, 10), plainRed);
        EXPECT_EQ(dc.GetPixel(9, 10), plainGreen) << "what the toolkit painted can be read";
    }
    EXPECT_EQ(shown(window, 15, 15), plainRed);
    settle();
    EXPECT_EQ(window.paints, paints);
    EXPECT_EQ(shown(window, 29, 29), plainRed);
    window.update(0, 0, 20, 20);
    settle();
    EXPECT_EQ(shown(window, 15, 15), plainGreen);
    EXPECT_EQ(shown(window, 25, 25), plainRed) << "outside the invalid part it stays";
}

TEST_F(Surface, ShowsTheDrawingOfAContextThatIsKeptOpen) {
    WidgetDc dc(window);
    dc.FillSolidRect(0, 0, 5, 5, plainRed);
    settle();
    EXPECT_EQ(shown(window, 2, 2), plainRed);
    window.update();
    settle();
    EXPECT_EQ(dc.GetPixel(2, 2), plainGreen) << "painted by the toolkit in between";
    dc.FillSolidRect(0, 0, 5, 5, plainBlue);
    EXPECT_EQ(dc.GetPixel(2, 2), plainBlue);
}

TEST_F(Surface, FollowsAWindowThatIsResizedWhileAContextIsOpen) {
    WidgetDc dc(window);
    for (const QSize size : {QSize(400, 300), QSize(50, 40), QSize(800, 600)}) {
        window.resize(size);
        dc.FillSolidRect(0, 0, 1000, 1000, plainRed); // before the toolkit made new pixels
        settle();
        dc.FillSolidRect(size.width() - 5, size.height() - 5, 5, 5, plainBlue);
        EXPECT_EQ(dc.GetPixel(size.width() - 1, size.height() - 1), plainBlue);
        EXPECT_EQ(dc.GetPixel(size.width(), 0), CLR_INVALID);
        EXPECT_EQ(shown(window, size.width() - 2, size.height() - 2), plainBlue);
    }
}

TEST_F(Surface, DropsDrawingOnHiddenWindows) {
    WidgetDc dc(window);
    window.hide();
    EXPECT_TRUE(dc.Rectangle(0, 0, 10, 10));
    EXPECT_TRUE(dc.TextOut(0, 0, "x", 1));
    EXPECT_EQ(dc.GetPixel(0, 0), CLR_INVALID);
    EXPECT_GT(dc.GetTextExtent("x", 1).cx, 0) << "text can be measured all the same";
    RECT box;
    EXPECT_EQ(dc.GetClipBox(&box), NULLREGION);
    window.show();
    settle();
    dc.FillSolidRect(0, 0, 5, 5, plainRed);
    EXPECT_EQ(dc.GetPixel(0, 0), plainRed);
    Canvas never;
    WidgetDc early(never);
    EXPECT_TRUE(early.Rectangle(0, 0, 10, 10));
}

TEST_F(Surface, OutlivesItsWindow) {
    auto gone = std::make_unique<Canvas>();
    gone->show();
    settle();
    WidgetDc dc(*gone);
    dc.FillSolidRect(0, 0, 5, 5, plainRed);
    gone.reset();
    EXPECT_TRUE(dc.Rectangle(0, 0, 10, 10));
    EXPECT_EQ(dc.GetPixel(0, 0), CLR_INVALID);
    EXPECT_TRUE(dc.DeleteDC());
    settle();
}

TEST_F(Surface, ServesSeveralContextsAtOnce) {
    Canvas child(&window);
    child.setGeometry(50, 50, 40, 40);
    child.show();
    settle();
    WidgetDc first(window), second(window), inner(child);
    first.FillSolidRect(0, 0, 10, 10, plainRed);
    second.BitBlt(10, 0, 10, 10, &first, 0, 0, SRCCOPY);
    inner.BitBlt(0, 0, 10, 10, &second, 10, 0, SRCCOPY);
    first.FillSolidRect(5, 0, 10, 10, plainBlue);
    EXPECT_EQ(second.GetPixel(4, 0), plainRed);
    EXPECT_EQ(second.GetPixel(14, 0), plainBlue);
    EXPECT_EQ(second.GetPixel(15, 0), plainRed);
    EXPECT_EQ(inner.GetPixel(0, 0), plainRed);
    inner.DeleteDC();
    EXPECT_EQ(shown(child, 0, 0), plainRed);
}

TEST_F(Surface, LeavesChildWindowsAlone) {
    Canvas child(&window);
    child.setGeometry(50, 50, 40, 40);
    QWidget clear(&window); // a child that the toolkit does not count as opaque
    clear.setGeometry(100, 50, 20, 20);
    QGroupBox box(&window);
    box.setGeometry(0, 100, 100, 50);
    for (QWidget* widget : {static_cast<QWidget*>(&child), &clear, static_cast<QWidget*>(&box)}) {
        widget->show();
    }
    settle();
    {
        WidgetDc dc(window);
        dc.FillSolidRect(0, 0, 200, 150, plainRed);
        EXPECT_EQ(dc.GetPixel(60, 60), CLR_INVALID);
        EXPECT_EQ(dc.GetPixel(105, 55), CLR_INVALID);
        EXPECT_FALSE(dc.RectVisible(CRect(55, 55, 80, 80)));
    }
    EXPECT_EQ(shown(window, 60, 60), plainGreen);
    EXPECT_EQ(shown(window, 49, 60), plainRed);
    EXPECT_EQ(shown(window, 105, 55), plainGreen);
    EXPECT_EQ(shown(window, 50, 125), plainRed) << "a group box only stands around its controls";
    WidgetDc inner(child);
    inner.FillSolidRect(-100, -100, 500, 500, plainBlue);
    inner.DeleteDC();
    EXPECT_EQ(shown(window, 60, 60), plainBlue);
    EXPECT_EQ(shown(window, 49, 60), plainRed) << "a child draws inside of itself only";
    child.hide();
    settle();
    WidgetDc again(window);
    again.FillSolidRect(0, 0, 200, 150, plainRed);
    EXPECT_EQ(again.GetPixel(60, 60), plainRed) << "a hidden child covers nothing";
}

TEST_F(Surface, DoesNotDrawOverDocumentsInFront) {
    QMdiArea area(&window);
    area.setGeometry(0, 0, 200, 150);
    QMdiSubWindow* back = area.addSubWindow(new Canvas);
    QMdiSubWindow* front = area.addSubWindow(new Canvas);
    back->setGeometry(0, 0, 120, 120);
    front->setGeometry(60, 60, 120, 80);
    area.show();
    back->show();
    front->show();
    area.setActiveSubWindow(front);
    settle();
    WidgetDc dc(*back->widget());
    const QPoint covered = back->widget()->mapFrom(&area, QPoint(70, 70));
    dc.FillSolidRect(0, 0, 200, 200, plainRed);
    EXPECT_EQ(dc.GetPixel(covered.x(), covered.y()), CLR_INVALID);
    EXPECT_EQ(dc.GetPixel(5, 5), plainRed);
    front->setMask(front->mask() - QRect(10, 10, 1, 1));
    EXPECT_NE(dc.GetPixel(covered.x(), covered.y()), CLR_INVALID) << "seen through a corner cut out of the other";
    front->clearMask();
    area.setActiveSubWindow(back);
    settle();
    EXPECT_NE(dc.GetPixel(covered.x(), covered.y()), CLR_INVALID);
}

TEST_F(Surface, CoversTheMenuBarInContextsOfWholeWindows) {
    QMenuBar bar(&window);
    bar.setGeometry(0, 0, 200, 20);
    bar.show();
    settle();
    WidgetDc client(window), whole(window, WindowPart::Whole);
    client.FillSolidRect(0, 0, 200, 30, plainRed);
    EXPECT_EQ(client.GetPixel(5, 5), CLR_INVALID);
    whole.FillSolidRect(0, 0, 10, 10, plainBlue);
    EXPECT_EQ(whole.GetPixel(5, 5), plainBlue);
    whole.DeleteDC();
    EXPECT_EQ(shown(window, 5, 5), plainBlue);
    EXPECT_EQ(shown(window, 5, 25), plainRed);
}

TEST_F(Surface, PaintsOnlyWhatNeedsPainting) {
    window.onPaint = [&](const QRegion& update) {
        WidgetPaintDc dc(window, update);
        dc.FillSolidRect(0, 0, 200, 150, plainBlue);
        EXPECT_EQ(dc.GetPixel(50, 50), CLR_INVALID);
        EXPECT_EQ(dc.GetPixel(5, 5), plainBlue);
    };
    window.update(0, 0, 10, 10);
    settle();
    EXPECT_EQ(shown(window, 5, 5), plainBlue);
    EXPECT_EQ(shown(window, 15, 5), plainGreen);
}

TEST_F(Surface, AllowsOtherContextsInsideAPaintEvent) {
    Canvas other;
    other.resize(50, 50);
    other.show();
    settle();
    window.onPaint = [&](const QRegion& update) {
        WidgetPaintDc dc(window, update);
        dc.FillSolidRect(0, 0, 200, 150, plainBlue);
        WidgetDc client(window), elsewhere(other);
        client.FillSolidRect(100, 100, 5, 5, plainRed); // outside the part that needs painting
        EXPECT_EQ(client.GetPixel(5, 5), plainBlue);
        client.DeleteDC();
        elsewhere.FillSolidRect(0, 0, 5, 5, plainRed);
        dc.SetPixelV(1, 1, plainRed);
        QPainter painter(&window); // the toolkit's own painting goes on beside it
        painter.fillRect(2, 2, 1, 1, Qt::red);
    };
    window.update(0, 0, 10, 10);
    settle();
    EXPECT_EQ(shown(window, 1, 1), plainRed);
    EXPECT_EQ(shown(window, 2, 2), plainRed);
    EXPECT_EQ(shown(window, 3, 3), plainBlue);
    EXPECT_EQ(shown(window, 102, 102), plainRed) << "shown although the toolkit did not paint there";
    EXPECT_EQ(shown(other, 2, 2), plainRed);
}

TEST_F(Surface, PaintsIntoPicturesThatAreTakenOfTheWindow) {
    Canvas child(&window);
    child.setGeometry(50, 50, 40, 40);
    child.onPaint = [&](const QRegion& update) {
        WidgetPaintDc dc(child, update);
        dc.FillSolidRect(0, 0, 20, 40, plainBlue);
        dc.PatBlt(20, 0, 20, 20, DSTINVERT);
    };
    child.setAttribute(Qt::WA_OpaquePaintEvent, false);
    child.show();
    settle();
    EXPECT_EQ(shown(child, 5, 5), plainBlue);
    const QImage picture = window.grab().toImage();
    EXPECT_EQ(picture.pixelColor(55, 55), QColor(0, 0, 255));
    EXPECT_EQ(picture.pixelColor(75, 55), QColor(255, 0, 255)) << "what lies behind was inverted";
    EXPECT_EQ(picture.pixelColor(75, 75), QColor(0, 255, 0));
    const QImage alone = child.grab().toImage();
    EXPECT_EQ(alone.pixelColor(5, 5), QColor(0, 0, 255));
}

TEST_F(Surface, DrawsNothingWithAPaintContextOutsideOfPainting) {
    WidgetPaintDc dc(window, QRegion());
    EXPECT_TRUE(dc.Rectangle(0, 0, 10, 10));
    dc.DeleteDC();
    EXPECT_EQ(shown(window, 5, 5), plainGreen);
}

TEST_F(Surface, ErasesExclusiveOrTracksOnTheScreen) {
    const QImage before = window.screen()->grabWindow(window.winId()).toImage();
    for (int round = 0; round < 2; ++round) {
        WidgetDc dc(window);
        dc.SetROP2(R2_NOT);
        dc.SelectStockObject(NULL_BRUSH);
        dc.Rectangle(20, 20, 120, 90);
        dc.DrawFocusRect(CRect(10, 10, 60, 60));
        dc.DeleteDC();
        EXPECT_EQ(window.screen()->grabWindow(window.winId()).toImage() == before, round == 1);
    }
}

} // namespace
