#include "platform/afx/core/Wnd.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/base/Exception.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QScreen>
#include <QTest>
#include <QWidget>

#include <functional>

namespace {

constexpr COLORREF plainRed = RGB(255, 0, 0);
constexpr COLORREF plainGreen = RGB(0, 255, 0);
constexpr COLORREF plainBlue = RGB(0, 0, 255);

/// A window with a green background that paints what the test says.
class TestWindow : public CWnd {
public:
    explicit TestWindow(CWnd* parent = nullptr, const CRect& rect = CRect(20, 20, 220, 170)) {
        static CBrush green(plainGreen);
        const DWORD style = parent ? WS_CHILD | WS_VISIBLE : WS_OVERLAPPEDWINDOW | WS_VISIBLE;
        CreateEx(0, AfxRegisterWndClass(0, nullptr, green), "test", style, rect.left, rect.top, rect.Width(),
                 rect.Height(), parent ? parent->m_hWnd : nullptr, nullptr);
    }
    ~TestWindow() override {
        DestroyWindow();
    }
    std::function<void(CPaintDC&)> onPaint;
    int paints = 0;

protected:
    void OnPaint() {
        CPaintDC dc(this);
        ++paints;
        if (onPaint) {
            onPaint(dc);
        }
    }
    DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(TestWindow, CWnd)
ON_WM_PAINT()
END_MESSAGE_MAP()

/// Lets everything be painted that waits to be painted. The toolkit puts updates off by some milliseconds; a paint that
/// came as late as that would fall into the middle of a test on a slow machine.
void settle() {
    QTest::qWait(0);
    QApplication::sendPostedEvents();
    QApplication::processEvents();
    for (QWidget* top : QApplication::topLevelWidgets()) {
        QEvent update(QEvent::UpdateRequest);
        QApplication::sendEvent(top, &update);
    }
}

class WindowDc : public testing::Test {
protected:
    WindowDc() {
        settle();
    }
    /// What the screen shows at a point of a window's client area.
    static COLORREF shown(const CWnd& window, int x, int y) {
        CPoint point(x, y);
        window.ClientToScreen(&point);
        QWidget* top = tvx::afx::peerOf(window.m_hWnd)->window();
        const QImage image = top->screen()->grabWindow(top->winId()).toImage();
        const QColor color = image.pixelColor(top->mapFromGlobal(QPoint(point.x, point.y)));
        return RGB(color.red(), color.green(), color.blue());
    }
    TestWindow window;
};

TEST_F(WindowDc, PaintsOverABackgroundThatWasErased) {
    window.onPaint = [](CPaintDC& dc) {
        EXPECT_FALSE(dc.m_ps.fErase) << "the background brush has erased it";
        EXPECT_EQ(CRect(dc.m_ps.rcPaint), CRect(5, 5, 30, 30));
        EXPECT_EQ(dc.GetPixel(6, 6), plainGreen);
        dc.FillSolidRect(0, 0, 20, 20, plainRed);
    };
    {
        CClientDC dc(&window);
        dc.FillSolidRect(0, 0, 100, 100, plainBlue);
    }
    window.InvalidateRect(CRect(5, 5, 30, 30));
    window.UpdateWindow();
    EXPECT_EQ(shown(window, 10, 10), plainRed);
    EXPECT_EQ(shown(window, 25, 25), plainGreen);
    EXPECT_EQ(shown(window, 2, 2), plainBlue) << "the rest was not invalid";
}

TEST_F(WindowDc, DrawsAtAnyTimeThroughEachKindOfContext) {
    const int paints = window.paints;
    {
        CClientDC dc(&window);
        dc.FillSolidRect(0, 0, 10, 10, plainRed);
    }
    EXPECT_EQ(shown(window, 5, 5), plainRed);
    CDC* dc = window.GetDC();
    ASSERT_NE(dc, nullptr);
    dc->FillSolidRect(10, 0, 10, 10, plainBlue);
    EXPECT_EQ(window.ReleaseDC(dc), 1);
    EXPECT_EQ(shown(window, 15, 5), plainBlue);
    settle();
    EXPECT_EQ(window.paints, paints);
    EXPECT_EQ(shown(window, 5, 5), plainRed);
}

TEST_F(WindowDc, OfTheWholeWindowBeginsAtTheFrame) {
    CRect frame;
    window.GetWindowRect(&frame);
    CPoint client(0, 0);
    window.ClientToScreen(&client);
    {
        CWindowDC dc(&window);
        dc.FillSolidRect(client.x - frame.left + 3, client.y - frame.top + 4, 5, 5, plainRed);
    }
    EXPECT_EQ(shown(window, 3, 4), plainRed);
    EXPECT_EQ(shown(window, 2, 4), plainGreen);
}

TEST_F(WindowDc, OfAChildStaysInsideIt) {
    TestWindow child(&window, CRect(50, 50, 90, 90));
    settle();
    {
        CClientDC inner(&child);
        inner.FillSolidRect(-50, -50, 500, 500, plainBlue);
        CClientDC outer(&window);
        outer.FillSolidRect(0, 0, 200, 100, plainRed);
    }
    EXPECT_EQ(shown(window, 60, 60), plainBlue);
    EXPECT_EQ(shown(window, 49, 60), plainRed);
}

TEST_F(WindowDc, NeedsAWindow) {
    CWnd none;
    EXPECT_THROW(CClientDC{&none}, CResourceException*);
    EXPECT_EQ(GetDC(reinterpret_cast<HWND>(std::uintptr_t{0x7777})), nullptr);
    EXPECT_EQ(ReleaseDC(nullptr, nullptr), 0);
    EXPECT_EQ(BeginPaint(nullptr, nullptr), nullptr);
    EXPECT_FALSE(EndPaint(nullptr, nullptr));
    CClientDC screen(nullptr);
    EXPECT_GT(screen.GetTextExtent("x", 1).cx, 0);
    EXPECT_EQ(screen.GetDeviceCaps(HORZRES), GetSystemMetrics(SM_CXSCREEN));
    EXPECT_EQ(screen.GetPixel(0, 0), CLR_INVALID);
}

TEST_F(WindowDc, OutlivesItsWindowHarmlessly) {
    const std::size_t before = tvx::afx::contextCount();
    {
        CClientDC dc(&window);
        window.DestroyWindow();
        EXPECT_TRUE(dc.Rectangle(0, 0, 10, 10));
        EXPECT_EQ(dc.GetPixel(0, 0), CLR_INVALID);
    }
    EXPECT_EQ(tvx::afx::contextCount(), before);
}

TEST_F(WindowDc, PaintsNothingOutsideOfAPaintMessage) {
    {
        CPaintDC dc(&window);
        EXPECT_TRUE(CRect(dc.m_ps.rcPaint).IsRectEmpty());
        dc.FillSolidRect(0, 0, 50, 50, plainRed);
    }
    EXPECT_EQ(shown(window, 5, 5), plainGreen);
}

TEST_F(WindowDc, LeavesNoContextBehind) {
    const std::size_t before = tvx::afx::contextCount();
    for (int i = 0; i < 5; ++i) {
        window.Invalidate();
        window.UpdateWindow();
        CClientDC client(&window);
        CWindowDC whole(&window);
        CDC memory;
        memory.CreateCompatibleDC(&client);
        window.ReleaseDC(window.GetDC());
    }
    EXPECT_EQ(tvx::afx::contextCount(), before);
}

} // namespace
