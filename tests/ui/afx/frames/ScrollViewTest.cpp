#include "platform/afx/frames/ScrollView.h"
#include "tests/ui/afx/frames/FrameTesting.h"

using namespace frametest;

namespace {

class Drawing : public CScrollView {
public:
    void OnDraw(CDC* dc) override {
        dc->FillSolidRect(0, 0, 10, 10, RGB(0, 0, 255));
        dc->FillSolidRect(0, 500, 10, 10, RGB(0, 128, 0));
    }
};

class Scrolling : public FrameTest {
protected:
    void SetUp() override {
        FrameTest::SetUp();
        frame = new CFrameWnd;
        ASSERT_TRUE(frame->Create(nullptr, "scrolls", WS_OVERLAPPEDWINDOW, CRect(0, 0, 300, 250)));
        view = new Drawing;
        ASSERT_TRUE(
            view->Create(nullptr, nullptr, WS_CHILD | WS_VISIBLE, CRect(0, 0, 0, 0), frame, AFX_IDW_PANE_FIRST));
        AfxGetApp()->m_pMainWnd = frame;
        view->SetScrollSizes(MM_TEXT, CSize(1000, 2000), CSize(100, 100), CSize(10, 10));
        frame->InitialUpdateFrame(nullptr, TRUE);
        ASSERT_TRUE(QTest::qWaitForWindowActive(widgetOf(*frame)));
        settle();
    }
    QRgb pixel(int x, int y) const {
        return tvx::afx::peerOf(view->m_hWnd)->grab().toImage().pixel(x, y);
    }
    CFrameWnd* frame = nullptr;
    Drawing* view = nullptr;
};

} // namespace

TEST_F(Scrolling, BarsShowWhatIsThere) {
    CRect client;
    view->GetClientRect(&client);
    SCROLLINFO info{};
    info.cbSize = sizeof(info);
    EXPECT_TRUE(view->GetScrollInfo(SB_VERT, &info));
    EXPECT_EQ(info.nMax, 1999);
    EXPECT_EQ(info.nPage, static_cast<UINT>(client.Height()));
    EXPECT_NE(view->GetStyle() & WS_HSCROLL, 0U);
    view->SetScrollSizes(MM_TEXT, CSize(50, 50));
    EXPECT_EQ(view->GetStyle() & (WS_HSCROLL | WS_VSCROLL), 0U);
}

TEST_F(Scrolling, KeysAndWheel) {
    key(Qt::Key_Down);
    EXPECT_EQ(view->GetScrollPosition(), CPoint(0, 10));
    key(Qt::Key_PageDown);
    key(Qt::Key_Right);
    EXPECT_EQ(view->GetScrollPosition(), CPoint(10, 110));
    key(Qt::Key_End);
    CRect client;
    view->GetClientRect(&client);
    EXPECT_EQ(view->GetScrollPosition().y, 2000 - client.Height());
    key(Qt::Key_Home);
    EXPECT_EQ(view->GetScrollPosition(), CPoint(10, 0));
    view->SendMessage(WM_MOUSEWHEEL, MAKEWPARAM(0, -120));
    EXPECT_EQ(view->GetScrollPosition().y, 30);
    view->SendMessage(WM_MOUSEWHEEL, MAKEWPARAM(0, 120));
    EXPECT_EQ(view->GetScrollPosition().y, 0);
}

TEST_F(Scrolling, DrawsTheScrolledPart) {
    EXPECT_EQ(pixel(5, 5), qRgb(0, 0, 255));
    view->ScrollToPosition(CPoint(0, 500));
    settle();
    EXPECT_EQ(view->GetDeviceScrollPosition(), CPoint(0, 500));
    EXPECT_EQ(view->GetScrollPos(SB_VERT), 500);
    EXPECT_EQ(pixel(5, 5), qRgb(0, 128, 0));
    view->ScrollToPosition(CPoint(9999, 9999));
    CRect client;
    view->GetClientRect(&client);
    EXPECT_EQ(view->GetScrollPosition(), CPoint(1000 - client.Width(), 2000 - client.Height()));
}

TEST_F(Scrolling, ClimbsWithTheUnitsOfTheMapping) {
    view->SetScrollSizes(MM_LOENGLISH, CSize(1000, 2000)); // hundredths of an inch, upwards
    view->ScrollToPosition(CPoint(100, -100));
    EXPECT_EQ(view->GetDeviceScrollPosition(), CPoint(96, 96));
    EXPECT_EQ(view->GetScrollPosition(), CPoint(100, -100));
    EXPECT_EQ(view->GetTotalSize(), CSize(1000, 2000));
    int mode = 0;
    CSize total;
    CSize page;
    CSize line;
    view->GetDeviceScrollSizes(mode, total, page, line);
    EXPECT_EQ(mode, MM_LOENGLISH);
    EXPECT_EQ(total, CSize(960, 1920));
    EXPECT_EQ(page, CSize(96, 192));
    EXPECT_EQ(line, CSize(9, 19));
}

TEST_F(Scrolling, FitsTheFrameToTheDrawing) {
    const auto fitted = [this](CSize drawing, BOOL shrinkOnly) {
        view->SetScrollSizes(MM_TEXT, drawing);
        view->ResizeParentToFit(shrinkOnly);
        settle();
        CRect client;
        view->GetClientRect(&client);
        return client.Size();
    };
    EXPECT_EQ(fitted(CSize(200, 150), TRUE), CSize(200, 150));
    EXPECT_EQ(fitted(CSize(400, 350), FALSE), CSize(400, 350));
    EXPECT_EQ(fitted(CSize(200, 2000), TRUE).cx, 200) << "beside the bar that stays";
    EXPECT_EQ(view->GetStyle() & (WS_HSCROLL | WS_VSCROLL), DWORD{WS_VSCROLL});
    EXPECT_EQ(fitted(CSize(400, 350), FALSE), CSize(400, 350));
    EXPECT_EQ(view->GetStyle() & (WS_HSCROLL | WS_VSCROLL), 0U) << "nothing is left to scroll";
    // Beside and below a smaller drawing, and nowhere else.
    view->SetScrollSizes(MM_TEXT, CSize(100, 50));
    CClientDC screen(view);
    CDC dc;
    dc.CreateCompatibleDC(&screen);
    CBitmap bitmap;
    bitmap.CreateCompatibleBitmap(&screen, 400, 350);
    CBitmap* before = dc.SelectObject(&bitmap);
    dc.FillSolidRect(0, 0, 400, 350, RGB(255, 255, 255));
    CBrush brush(RGB(255, 0, 0));
    view->FillOutsideRect(&dc, &brush);
    EXPECT_EQ(dc.GetPixel(99, 49), RGB(255, 255, 255));
    EXPECT_EQ(dc.GetPixel(100, 49), RGB(255, 0, 0));
    EXPECT_EQ(dc.GetPixel(99, 50), RGB(255, 0, 0));
    EXPECT_EQ(dc.GetPixel(399, 349), RGB(255, 0, 0));
    dc.SelectObject(before);
}

TEST_F(Scrolling, StaysInsideWhenTheDrawingShrinks) {
    view->ScrollToPosition(CPoint(700, 1500));
    view->SetScrollSizes(MM_TEXT, CSize(1000, 600), CSize(100, 100), CSize(10, 10));
    CRect client;
    view->GetClientRect(&client);
    EXPECT_EQ(view->GetScrollPosition(), CPoint(700, 600 - client.Height()));
}
