// Displays with more than one pixel for a unit of the host's, a whole and a broken number.
#include "platform/afx/core/detail/BrokenPixels.h"
#include "platform/afx/core/detail/WindowSurface.h"
#include "platform/afx/gdi/Dc.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QBackingStore>
#include <QMenuBar>
#include <QPaintEvent>
#include <QPainter>
#include <QScreen>
#include <QTemporaryFile>
#include <QTest>
#include <QWidget>

#include <cmath>
#include <functional>

using namespace tvx::afx;

namespace {

constexpr COLORREF plainRed = RGB(255, 0, 0);
constexpr COLORREF plainGreen = RGB(0, 255, 0);

class GreenWidget : public QWidget {
public:
    QRegion painted;

protected:
    void paintEvent(QPaintEvent* event) override {
        painted |= event->region();
        QPainter(this).fillRect(rect(), QColor(0, 255, 0));
    }
};

/// The parameter is the ratio of a screen that main() below makes.
class ScaledSurface : public testing::TestWithParam<double> {
protected:
    ScaledSurface() {
        for (const QScreen* screen : QGuiApplication::screens()) {
            if (screen->devicePixelRatio() == GetParam()) {
                window.setGeometry(QRect(screen->geometry().topLeft() + QPoint(10, 10), QSize(100, 80)));
            }
        }
        window.show();
        EXPECT_TRUE(QTest::qWaitForWindowExposed(&window));
        QApplication::processEvents();
        EXPECT_EQ(window.devicePixelRatio(), GetParam());
    }
    void open(CDC& dc) {
        dc.Attach(addContext(std::make_shared<DeviceContext>(
            DcKind::Window,
            std::make_unique<WindowTarget>(window, WindowPart::Client, [this] { return window.rect(); }))));
    }
    /// The window's pixels.
    [[nodiscard]] QImage screen() const {
        return dynamic_cast<QImage*>(window.backingStore()->paintDevice())->copy();
    }
    /// The pixel with which a unit begins: of an edge in the middle of a pixel the pixel lies behind.
    [[nodiscard]] int pixel(int unit) const {
        return static_cast<int>(std::ceil(unit * window.devicePixelRatio() - 0.5));
    }
    GreenWidget window;
};

TEST_P(ScaledSurface, DrawsAndReadsTheWholeBlocksOfUnits) {
    CDC dc;
    open(dc);
    EXPECT_EQ(dc.GetPixel(50, 50), plainGreen);
    dc.FillSolidRect(11, 11, 20, 20, plainRed);
    dc.PatBlt(21, 11, 10, 20, DSTINVERT);
    dc.SetPixelV(41, 41, plainRed);
    EXPECT_EQ(dc.GetPixel(11, 11), plainRed);
    EXPECT_EQ(dc.GetPixel(30, 30), RGB(0, 255, 255));
    EXPECT_EQ(dc.GetPixel(31, 30), plainGreen);
    CRect box;
    dc.GetClipBox(box);
    EXPECT_EQ(box, CRect(0, 0, 100, 80));
    dc.DeleteDC();
    const QImage shown = screen();
    EXPECT_EQ(shown.pixelColor(pixel(11) - 1, 40), QColor(Qt::green));
    EXPECT_EQ(shown.pixelColor(pixel(11), pixel(11)), QColor(Qt::red));
    EXPECT_EQ(shown.pixelColor(pixel(21) - 1, pixel(31) - 1), QColor(Qt::red));
    EXPECT_EQ(shown.pixelColor(pixel(21), pixel(31) - 1), QColor(Qt::cyan));
    EXPECT_EQ(shown.pixelColor(pixel(31), pixel(31) - 1), QColor(Qt::green));
    EXPECT_EQ(shown.pixelColor(pixel(41), pixel(41)), QColor(Qt::red));
    EXPECT_EQ(shown.pixelColor(pixel(42) - 1, pixel(42) - 1), QColor(Qt::red));
    EXPECT_EQ(shown.pixelColor(pixel(42), pixel(41)), QColor(Qt::green));
}

TEST_P(ScaledSurface, DrawsWholeBlocksOnTheMenuBarOfAWholeWindow) {
    QMenuBar bar(&window);
    bar.setGeometry(0, 0, 100, 25);
    bar.show();
    QApplication::processEvents();
    CDC dc;
    dc.Attach(addContext(std::make_shared<DeviceContext>(
        DcKind::Window, std::make_unique<WindowTarget>(window, WindowPart::Whole, [this] { return window.rect(); }))));
    dc.FillSolidRect(11, 11, 10, 20, plainRed);
    dc.DeleteDC();
    const QImage shown = screen();
    EXPECT_EQ(shown.pixelColor(pixel(11), pixel(11)), QColor(Qt::red));
    EXPECT_EQ(shown.pixelColor(pixel(21) - 1, pixel(31) - 1), QColor(Qt::red));
    EXPECT_NE(shown.pixelColor(pixel(11) - 1, pixel(11)), QColor(Qt::red));
    EXPECT_EQ(shown.pixelColor(pixel(21), pixel(31) - 1), QColor(Qt::green));
}

/// What a host can draw with a pen, each with a filling where there is one.
const std::pair<const char*, std::function<void(CDC&)>> shapes[] = {
    {"slanted line", [](CDC& dc) { dc.MoveTo(70, 12), dc.LineTo(11, 45); }},
    {"lines",
     [](CDC& dc) {
         const POINT points[] = {{10, 10}, {60, 10}, {60, 50}, {20, 60}, {10, 11}};
         dc.Polyline(points, 5);
     }},
    {"rectangle", [](CDC& dc) { dc.Rectangle(11, 11, 62, 41); }},
    {"round rectangle", [](CDC& dc) { dc.RoundRect(11, 11, 62, 41, 15, 11); }},
    {"ellipse", [](CDC& dc) { dc.Ellipse(11, 11, 62, 41); }},
    {"polygon",
     [](CDC& dc) {
         const POINT points[] = {{10, 10}, {60, 21}, {31, 60}};
         dc.Polygon(points, 3);
     }},
    {"arc", [](CDC& dc) { dc.Arc(11, 11, 62, 61, 62, 30, 11, 33); }},
    {"pie", [](CDC& dc) { dc.Pie(11, 11, 62, 61, 62, 30, 11, 33); }},
    {"chord", [](CDC& dc) { dc.Chord(11, 11, 62, 61, 62, 30, 11, 33); }},
    {"focus", [](CDC& dc) { dc.DrawFocusRect(CRect(11, 11, 62, 41)); }},
};

TEST_P(ScaledSurface, TakesBackWhatIsDrawnTwiceByExclusiveOr) {
    const QImage before = screen();
    for (const int style : {PS_SOLID, PS_DASH, PS_DASHDOT, PS_INSIDEFRAME}) {
        for (const int width : {1, 3}) {
            for (const auto& [name, draw] : shapes) {
                CDC dc;
                open(dc);
                CPen pen(style, width, plainRed);
                CPen* old = dc.SelectObject(&pen);
                dc.SetROP2(R2_NOTXORPEN);
                draw(dc);
                EXPECT_NE(screen(), before) << name;
                draw(dc);
                EXPECT_EQ(screen(), before) << name << ", style " << style << ", width " << width;
                dc.SelectObject(old);
            }
        }
    }
}

TEST_P(ScaledSurface, DrawsSlantedAndRoundShapesFinerThanUnits) {
    for (const auto& [name, draw] : shapes) {
        if (std::string_view(name) == "rectangle" || std::string_view(name) == "focus") {
            continue;
        }
        window.repaint();
        CDC dc;
        open(dc);
        draw(dc);
        dc.DeleteDC();
        const QImage shown = screen();
        bool finer = false;
        for (int y = 0; y < 79 && !finer; ++y) {
            for (int x = 0; x < 99 && !finer; ++x) {
                finer = pixel(x + 1) - pixel(x) == 2 &&
                        shown.pixel(pixel(x), pixel(y)) != shown.pixel(pixel(x) + 1, pixel(y));
            }
        }
        EXPECT_TRUE(finer) << name;
    }
}

TEST_P(ScaledSurface, LeavesNoGapsBetweenLinesSideBySide) {
    CDC dc;
    open(dc);
    CPen pen(PS_SOLID, 1, plainRed);
    CPen* old = dc.SelectObject(&pen);
    for (int at = 5; at < 45; ++at) {
        dc.MoveTo(5, at);
        dc.LineTo(25, at);
        dc.MoveTo(30 + at, 5);
        dc.LineTo(30 + at, 25);
    }
    dc.SelectObject(old);
    dc.DeleteDC();
    const QImage shown = screen();
    const auto isAll = [&](const CRect& units) {
        const QImage part = shown.copy(QRect(QPoint(pixel(units.left), pixel(units.top)),
                                             QPoint(pixel(units.right) - 1, pixel(units.bottom) - 1)));
        QImage red(part.size(), QImage::Format_RGB32);
        red.fill(Qt::red);
        return part == red;
    };
    EXPECT_TRUE(isAll(CRect(5, 5, 25, 45)));
    EXPECT_TRUE(isAll(CRect(35, 5, 75, 25)));
    EXPECT_EQ(shown.pixelColor(pixel(25), pixel(10)), QColor(Qt::green)) << "the last point is left out";
}

TEST_P(ScaledSurface, LosesNothingByWayOfACompatibleBitmap) {
    CDC dc, memory;
    open(dc);
    CBitmap bitmap;
    bitmap.CreateCompatibleBitmap(&dc, 100, 80);
    memory.CreateCompatibleDC(&dc);
    CBitmap* old = memory.SelectObject(&bitmap);
    BITMAP description;
    bitmap.GetBitmap(&description);
    EXPECT_EQ(CSize(description.bmWidth, description.bmHeight), CSize(100, 80));
    const auto draw = [](CDC& target) {
        target.FillSolidRect(0, 0, 100, 80, plainGreen);
        target.Ellipse(11, 11, 62, 41);
        target.TextOut(11, 50, "Sharp", 5);
    };
    draw(dc);
    const QImage direct = screen();
    draw(memory);
    dc.FillSolidRect(0, 0, 100, 80, plainRed);
    dc.BitBlt(0, 0, 100, 80, &memory, 0, 0, SRCCOPY);
    EXPECT_EQ(screen(), direct);
    std::vector<BYTE> bits(std::size_t{4} * 100 * 80);
    EXPECT_EQ(bitmap.GetBitmapBits(static_cast<DWORD>(bits.size()), bits.data()), bits.size());
    EXPECT_EQ(bits[1], 255) << "green";
    EXPECT_EQ(bitmap.SetBitmapBits(static_cast<DWORD>(bits.size()), bits.data()), bits.size());
    EXPECT_EQ(memory.GetPixel(99, 79), plainGreen);
    memory.SelectObject(old);
}

TEST_P(ScaledSurface, PaintsIntoPicturesThatAreTakenOfTheWindow) {
    class PaintedByContext : public QWidget {
    public:
        using QWidget::QWidget;

    protected:
        void paintEvent(QPaintEvent* event) override {
            CDC dc;
            dc.Attach(addContext(std::make_shared<DeviceContext>(
                DcKind::Paint, std::make_unique<PaintTarget>(*this, event->region(), [this] { return rect(); }))));
            dc.PatBlt(0, 0, 20, 20, DSTINVERT);
        }
    } child(&window);
    child.setGeometry(21, 21, 40, 40);
    child.show();
    QApplication::processEvents();
    const QImage picture = window.grab().toImage();
    EXPECT_EQ(picture.pixelColor(pixel(25), pixel(25)), QColor(Qt::magenta));
    EXPECT_EQ(picture.pixelColor(pixel(45), pixel(25)), QColor(Qt::green));
}

TEST_P(ScaledSurface, RepaintsTheEdgesThatTheToolkitLeavesOut) {
    class Moving : public QWidget {
    public:
        using QWidget::QWidget;

    protected:
        bool event(QEvent* event) override {
            repaintBrokenEdges(*this, *event);
            return QWidget::event(event);
        }
    } child(&window);
    child.setGeometry(21, 21, 10, 10);
    child.show();
    QApplication::processEvents();
    const bool broken = GetParam() == 1.5;
    for (const auto& change : std::initializer_list<std::function<void()>>{
             [&] { child.move(51, 51); }, [&] { child.resize(5, 5); }, [&] { child.hide(); }}) {
        const QRect before = child.geometry();
        window.painted = QRegion();
        change();
        QApplication::processEvents();
        EXPECT_TRUE(window.painted.contains(before.bottomRight()));
        EXPECT_EQ(window.painted.contains(before.bottomRight() + QPoint(1, 1)), broken);
    }
    const QRegion part(QRect(11, 11, 5, 5));
    EXPECT_EQ(withBrokenPixels(window, part), broken ? QRegion(QRect(10, 10, 7, 7)) : part);
}

INSTANTIATE_TEST_SUITE_P(OnScreens, ScaledSurface, testing::Values(2, 1.5));

} // namespace

int main(int argc, char** argv) {
    QTemporaryFile screens;
    screens.open();
    screens.write(R"({"screens": [{"name": "twice", "x": 0, "y": 0, "width": 1600, "height": 1200},
        {"name": "broken", "x": 1600, "y": 0, "width": 1200, "height": 900}]})");
    screens.close();
    qputenv("QT_QPA_PLATFORM", "offscreen:configfile=" + screens.fileName().toLocal8Bit());
    qputenv("QT_SCREEN_SCALE_FACTORS", "twice=2;broken=1.5");
    testing::InitGoogleTest(&argc, argv);
    const QApplication application(argc, argv);
    return RUN_ALL_TESTS();
}
