#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"

#include <QScreen>
#include <QTest>

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

/// A window that counts the messages and notes the paint requests that reach it.
class Counting : public CWnd {
public:
    int messages = 0;
    std::vector<CRect> painted;

protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        ++messages;
        return CWnd::WindowProc(message, wParam, lParam);
    }
    afx_msg void OnPaint() {
        const CPaintDC dc(this);
        painted.emplace_back(dc.m_ps.rcPaint);
    }
    DECLARE_MESSAGE_MAP()
};

// clang-format off
BEGIN_MESSAGE_MAP(Counting, CWnd)
    ON_WM_PAINT()
END_MESSAGE_MAP()
// clang-format on

class Wnd : public testing::Test {
protected:
    Wnd() {
        frame.CreateEx(0, AfxRegisterWndClass(CS_DBLCLKS), "Wnd test", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 10, 10, 300,
                       200, nullptr, nullptr);
        EXPECT_TRUE(QTest::qWaitForWindowExposed(tvx::afx::peerOf(frame.m_hWnd)));
        view.Create(nullptr, "view", WS_VISIBLE, CRect(0, 0, 100, 80), &frame, 1);
    }
    ~Wnd() override {
        frame.DestroyWindow();
    }
    static CSize clientSize(const CWnd& window) {
        CRect rect;
        window.GetClientRect(&rect);
        return rect.Size();
    }

    CWnd frame;
    Counting view;
};

TEST_F(Wnd, StylesAreSeenAtOnceAndToldByEveryCall) {
    EXPECT_EQ(clientSize(view), CSize(100, 80));
    EXPECT_TRUE(view.ModifyStyle(0, WS_BORDER));
    EXPECT_FALSE(view.ModifyStyle(0, WS_BORDER)) << "nothing changed";
    EXPECT_EQ(clientSize(view), CSize(98, 78));
    EXPECT_NE(GetWindowLong(view, GWL_STYLE) & WS_BORDER, 0);
    EXPECT_TRUE(view.ModifyStyle(WS_BORDER, WS_VSCROLL, SWP_FRAMECHANGED));
    EXPECT_EQ(view.GetStyle() & (WS_BORDER | WS_VSCROLL), DWORD{WS_VSCROLL});
    EXPECT_LT(clientSize(view).cx, 98);
    EXPECT_EQ(SetWindowLong(view, GWL_EXSTYLE, WS_EX_CLIENTEDGE), 0);
    EXPECT_EQ(view.GetExStyle(), DWORD{WS_EX_CLIENTEDGE});
    EXPECT_LT(clientSize(view).cy, 80);
    EXPECT_EQ(SetWindowLong(view, GWL_USERDATA, 7), 0);
    EXPECT_EQ(GetWindowLong(view, GWL_USERDATA), 7);
    EXPECT_EQ(GetWindowLong(view, -99), 0);
    EXPECT_EQ(view.SetDlgCtrlID(20), 1);
    EXPECT_EQ(frame.GetDlgItem(20), &view);
    EXPECT_EQ(frame.GetDlgItem(1), nullptr);
}

TEST_F(Wnd, TheRectangleAroundAClientAreaHasItsFrame) {
    view.ModifyStyleEx(0, WS_EX_CLIENTEDGE);
    CRect rect(50, 40, 150, 90);
    view.CalcWindowRect(&rect);
    EXPECT_LT(rect.left, 50);
    EXPECT_LT(rect.top, 40);
    view.MoveWindow(&rect);
    EXPECT_EQ(clientSize(view), CSize(100, 50));
    CPoint corner(0, 0);
    view.MapWindowPoints(&frame, &corner, 1);
    EXPECT_EQ(corner, CPoint(50, 40));
}

TEST_F(Wnd, ObjectsComeAndGoWithoutTheirWindow) {
    EXPECT_EQ(CWnd().GetSafeHwnd(), nullptr);
    CWnd edit;
    ASSERT_TRUE(edit.Create("Edit", "text", WS_VISIBLE, CRect(0, 90, 80, 110), &frame, 5));
    const HWND handle = edit.Detach();
    Counting mine;
    ASSERT_TRUE(mine.SubclassWindow(handle));
    EXPECT_EQ(mine.GetSafeHwnd(), handle);
    EXPECT_EQ(mine.GetWindowTextLength(), 4);
    EXPECT_EQ(mine.messages, 1);
    EXPECT_EQ(mine.UnsubclassWindow(), handle);
    EXPECT_EQ(GetWindowTextLengthA(handle), 4);
    EXPECT_EQ(mine.messages, 1) << "the class answers alone again";
    EXPECT_EQ(mine.UnsubclassWindow(), nullptr);
}

TEST_F(Wnd, FontsReachTheControl) {
    CWnd edit;
    ASSERT_TRUE(edit.Create("Edit", "text", WS_VISIBLE, CRect(0, 90, 80, 110), &frame, 5));
    EXPECT_EQ(edit.GetFont(), nullptr);
    CFont font;
    font.CreateFont(-23, 0, 0, 0, FW_BOLD, FALSE, FALSE, FALSE, DEFAULT_CHARSET, 0, 0, 0, 0, "Arial");
    edit.SetFont(&font);
    EXPECT_EQ(edit.GetFont(), &font);
    EXPECT_EQ(tvx::afx::peerOf(edit.m_hWnd)->font().pixelSize(), 23);
    edit.DestroyWindow();
}

TEST_F(Wnd, TheTreeIsWalkedInOrder) {
    CWnd second, third, inner;
    second.Create(nullptr, "second", WS_VISIBLE, CRect(100, 0, 200, 80), &frame, 2);
    third.Create("Static", "third", 0, CRect(0, 80, 200, 100), &frame, 3);
    inner.Create(nullptr, "inner", WS_VISIBLE, CRect(10, 10, 20, 20), &second, 4);
    std::vector<int> ids;
    for (const CWnd* child = frame.GetTopWindow(); child; child = child->GetNextWindow()) {
        ids.push_back(child->GetDlgCtrlID());
    }
    EXPECT_EQ(ids, (std::vector<int>{1, 2, 3}));
    EXPECT_EQ(third.GetNextWindow(GW_HWNDPREV), &second);

    static std::vector<int> told;
    told.clear();
    const WNDENUMPROC tell = [](HWND window, LPARAM last) -> BOOL {
        told.push_back(::GetDlgCtrlID(window));
        return told.back() != last;
    };
    EXPECT_TRUE(EnumChildWindows(frame, tell, 0));
    EXPECT_EQ(told, (std::vector<int>{1, 2, 4, 3})) << "children with theirs";
    told.clear();
    EXPECT_FALSE(EnumChildWindows(frame, tell, 4));
    EXPECT_EQ(told, (std::vector<int>{1, 2, 4})) << "until it has had enough";

    const struct {
        CPoint point;
        HWND found;
    } points[] = {{{99, 10}, view}, {{100, 10}, second}, {{115, 15}, second}, {{10, 90}, third}, {{250, 10}, frame}};
    for (const auto& [point, found] : points) {
        EXPECT_EQ(ChildWindowFromPoint(frame, point), found) << point.x;
    }
    EXPECT_EQ(ChildWindowFromPoint(frame, {-1, 10}), nullptr);
    frame.DestroyWindow();
}

TEST_F(Wnd, TopLevelWindowsAreFoundByClassAndCaption) {
    char name[100];
    ASSERT_GT(GetClassNameA(frame, name, sizeof(name)), 0);
    EXPECT_EQ(CWnd::FindWindow(name, "Wnd test"), &frame);
    EXPECT_EQ(CWnd::FindWindow(nullptr, "Wnd test"), &frame);
    EXPECT_EQ(CWnd::FindWindow("Edit", "Wnd test"), nullptr);
    EXPECT_EQ(CWnd::FindWindow(nullptr, "view"), nullptr) << "children are not looked at";
    CWnd popup;
    EXPECT_EQ(view.GetOwner(), &frame);
    view.SetOwner(&popup);
    EXPECT_EQ(view.GetOwner(), &popup);
    EXPECT_EQ(view.GetParent(), &frame);
    view.SetOwner(nullptr);
    EXPECT_EQ(view.GetOwner(), &frame);
}

TEST_F(Wnd, RepaintsWhatIsAskedForAndNothingWhileItIsNotTo) {
    view.UpdateWindow();
    view.painted.clear();
    CRgn region;
    region.CreateRectRgn(10, 10, 30, 40);
    const CRect rect(50, 50, 60, 60);
    EXPECT_TRUE(view.RedrawWindow(&rect));
    EXPECT_TRUE(view.RedrawWindow(nullptr, &region));
    EXPECT_TRUE(view.RedrawWindow(&rect, &region));
    const CRect both(10, 10, 30, 40);
    EXPECT_EQ(view.painted, (std::vector<CRect>{rect, both, both}));
    view.painted.clear();
    view.SetRedraw(FALSE);
    view.Invalidate();
    view.UpdateWindow();
    EXPECT_TRUE(view.painted.empty());
    view.SetRedraw(TRUE);
    view.UpdateWindow();
    EXPECT_EQ(view.painted, (std::vector<CRect>{CRect(0, 0, 100, 80)}));
}

TEST_F(Wnd, TheCaretIsSeenWhileItIsShown) {
    CWnd sheet;
    ASSERT_TRUE(sheet.Create(AfxRegisterWndClass(0, nullptr, static_cast<HBRUSH>(GetStockObject(WHITE_BRUSH))), "",
                             WS_VISIBLE, CRect(100, 0, 200, 80), &frame, 2));
    const auto isMarked = [&](int x, int y) {
        const QImage picture = tvx::afx::peerOf(sheet.m_hWnd)->grab().toImage();
        return picture.pixelColor(x, y) == QPalette().color(QPalette::WindowText);
    };
    EXPECT_FALSE(ShowCaret(frame)) << "there is none";
    sheet.CreateGrayCaret(3, 12);
    CWnd::SetCaretPos(CPoint(20, 30));
    EXPECT_EQ(CWnd::GetCaretPos(), CPoint(20, 30));
    EXPECT_FALSE(isMarked(21, 35));
    sheet.ShowCaret();
    EXPECT_TRUE(isMarked(20, 30) && isMarked(22, 41));
    EXPECT_FALSE(isMarked(23, 30) || isMarked(20, 42));
    sheet.HideCaret();
    sheet.HideCaret();
    sheet.ShowCaret();
    EXPECT_FALSE(isMarked(21, 35)) << "hidden twice";
    sheet.ShowCaret();
    EXPECT_TRUE(isMarked(21, 35));

    CBitmap bitmap;
    ASSERT_TRUE(bitmap.CreateBitmap(8, 4, 1, 1, nullptr));
    sheet.CreateCaret(&bitmap);
    sheet.ShowCaret();
    EXPECT_TRUE(isMarked(7, 3));
    EXPECT_FALSE(isMarked(8, 3) || isMarked(21, 35)) << "there is one caret";
    EXPECT_FALSE(HideCaret(GetDesktopWindow())) << "it is another window's";
    EXPECT_TRUE(DestroyCaret());
    EXPECT_FALSE(DestroyCaret());
    EXPECT_FALSE(isMarked(7, 3));
    frame.DestroyWindow();
}

TEST_F(Wnd, ButtonsAreMarkedAndReachedByGroup) {
    const struct {
        int id;
        DWORD style;
    } buttons[] = {{11, BS_AUTORADIOBUTTON | WS_GROUP},
                   {12, BS_AUTORADIOBUTTON | WS_DISABLED},
                   {13, BS_AUTORADIOBUTTON},
                   {14, BS_AUTO3STATE | WS_GROUP}};
    std::vector<CWnd> windows(std::size(buttons));
    for (std::size_t i = 0; i < windows.size(); ++i) {
        const int top = 90 + static_cast<int>(i) * 20;
        ASSERT_TRUE(windows[i].Create("Button", "", buttons[i].style | WS_VISIBLE, CRect(0, top, 80, top + 20), &frame,
                                      static_cast<UINT>(buttons[i].id)));
    }
    for (const UINT mark : {1U, 2U, 0U}) {
        frame.CheckDlgButton(14, mark);
        EXPECT_EQ(frame.IsDlgButtonChecked(14), mark);
    }
    EXPECT_EQ(frame.GetNextDlgGroupItem(&windows[0]), &windows[2]) << "over the disabled one";
    EXPECT_EQ(frame.GetNextDlgGroupItem(&windows[2]), &windows[0]) << "round and round";
    EXPECT_EQ(frame.GetNextDlgGroupItem(&windows[0], TRUE), &windows[2]);
    EXPECT_EQ(frame.GetNextDlgGroupItem(nullptr), nullptr);
    frame.DestroyWindow();
}

TEST_F(Wnd, FirstSizesFitTheScreen) {
    CWnd large;
    ASSERT_TRUE(
        large.CreateEx(0, AfxRegisterWndClass(0), "large", WS_OVERLAPPEDWINDOW, 50, 50, 5000, 4000, nullptr, nullptr));
    large.ShowWindow(SW_SHOW);
    const QWidget* widget = tvx::afx::peerOf(large.m_hWnd);
    EXPECT_TRUE(QTest::qWaitFor([&] { return widget->frameGeometry() == widget->screen()->availableGeometry(); }));
    large.MoveWindow(0, 0, 5000, 4000);
    EXPECT_EQ(widget->frameGeometry().width(), 5000) << "later ones are as they are asked for";
    large.DestroyWindow();
}

} // namespace
