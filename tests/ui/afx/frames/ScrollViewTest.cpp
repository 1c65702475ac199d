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
}

TEST_F(Scrolling, StaysInsideWhenTheDrawingShrinks) {
    view->ScrollToPosition(CPoint(700, 1500));
    view->SetScrollSizes(MM_TEXT, CSize(1000, 600), CSize(100, 100), CSize(10, 10));
    CRect client;
    view->GetClientRect(&client);
    EXPECT_EQ(view->GetScrollPosition(), CPoint(700, 600 - client.Height()));
}
