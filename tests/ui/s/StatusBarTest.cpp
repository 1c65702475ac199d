// The library's status bar: tips of panes, panes that fit their texts.
#include "s/StatusBar.h"

#include "tests/ui/afx/Tips.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <iterator>

namespace {

constexpr UINT panes[] = {ID_SEPARATOR, ID_INDICATOR_CAPS, ID_INDICATOR_NUM};
constexpr unsigned int tips[] = {0, 501, 502, 501};

class StatusBar : public testing::Test {
protected:
    void SetUp() override {
        frame = new CFrameWnd; // deletes itself
        frame->Create(nullptr, "Status", WS_OVERLAPPEDWINDOW, CRect(20, 20, 520, 220));
        make();
        ASSERT_EQ(bar.SetToolTips(tips, 4), 1) << "one more than there are panes; they have no places yet";
        frame->RecalcLayout();
        ASSERT_GT(place(1).left, 300) << "known before the frame is shown";
        frame->ShowWindow(SW_SHOW);
        ASSERT_TRUE(waitForActive(*frame));
        settle();
    }
    void TearDown() override {
        QToolTip::hideText();
        frame->DestroyWindow();
    }
    void make() {
        ASSERT_TRUE(bar.Create(frame));
        ASSERT_TRUE(bar.SetIndicators(panes, std::size(panes)));
        widget()->setStyle(&style);
    }
    /// Lets the frame lay itself out.
    void settle() const {
        frame->RecalcLayout();
        QApplication::processEvents();
    }
    QWidget* widget() const {
        return tvx::afx::peerOf(bar.m_hWnd);
    }
    CRect place(int pane) const {
        CRect rect;
        bar.GetItemRect(pane, &rect);
        return rect;
    }
    /// Leaves the pointer over a pane and tells whether a tip comes up; the empty text: whether none does.
    bool tells(int pane, const char* text) {
        rest(*tvx::afx::peerOf(frame->m_hWnd), QPoint(5, 5));
        const CPoint point = place(pane).CenterPoint();
        rest(*widget(), QPoint(point.x, point.y));
        return isTip(text);
    }
    int widthOf(int pane) const {
        UINT id = 0;
        UINT paneStyle = 0;
        int width = 0;
        bar.GetPaneInfo(pane, id, paneStyle, width);
        EXPECT_EQ(id, panes[pane]);
        return width;
    }
    int measured(const char* text) const {
        CClientDC dc(nullptr);
        dc.SelectObject(bar.GetFont());
        return dc.GetTextExtent(text).cx;
    }
    QuickTips style;
    Gui_StatusBar bar;
    CFrameWnd* frame = nullptr;
};

} // namespace

TEST_F(StatusBar, TellsOfPanesByTips) {
    EXPECT_TRUE(tells(0, ""));
    EXPECT_TRUE(tells(1, "501"));
    EXPECT_TRUE(tells(2, "502"));
    bar.ChangeTooltipText(2, 600U);
    EXPECT_TRUE(tells(2, "a text of the resources"));
    bar.ChangeTooltipText(2, 4711U);
    EXPECT_TRUE(tells(2, ""));
    bar.EnableTooltips(0);
    EXPECT_TRUE(tells(1, ""));
    bar.OnUpdateCmdUI(frame, FALSE);
    bar.ReactivateTooltips();
    const CRect before = place(1);
    frame->SetWindowPos(nullptr, 0, 0, 700, 220, SWP_NOMOVE | SWP_NOZORDER);
    settle();
    ASSERT_GT(place(1).left, before.right);
    EXPECT_TRUE(tells(1, ""));
    bar.EnableTooltips(1);
    EXPECT_TRUE(tells(1, "501")) << "where the pane is now";
    frame->SetWindowPos(nullptr, 0, 0, 500, 220, SWP_NOMOVE | SWP_NOZORDER);
    settle();
    EXPECT_TRUE(tells(1, "501"));
}

TEST_F(StatusBar, IsSetUpAnewForAnotherWindow) {
    Gui_StatusBar without;
    EXPECT_EQ(without.SetToolTips(tips, 3), 0) << "no window";
    const unsigned int others[] = {600, 0};
    ASSERT_EQ(bar.SetToolTips(others, 2), 1);
    EXPECT_TRUE(tells(0, "a text of the resources"));
    EXPECT_TRUE(tells(1, ""));
    bar.DestroyWindow();
    make();
    settle();
    bar.ChangeTooltipText(0, "none yet");
    EXPECT_TRUE(tells(0, ""));
    bar.SetPaneTextEx(1, "wider than before", TRUE);
    ASSERT_EQ(bar.SetToolTips(tips, 3), 1);
    EXPECT_TRUE(tells(1, "501"));
}

TEST_F(StatusBar, PanesFitTheirTexts) {
    CFont large;
    large.CreatePointFont(160, "MS Shell Dlg");
    for (CFont* font : {bar.GetFont(), &large}) {
        bar.SetFont(font);
        settle();
        EXPECT_TRUE(bar.SetPaneTextEx(1, "a longer text", TRUE));
        EXPECT_EQ(widthOf(1), measured("a longer text") + 2);
        EXPECT_EQ(bar.GetPaneText(1), "a longer text");
        const CRect wide = place(1);
        EXPECT_TRUE(tells(1, "501")) << "all of the pane, and the text is not cut off";
        EXPECT_TRUE(bar.SetPaneTextEx(1, "a longer text", TRUE));
        EXPECT_EQ(place(1), wide);
        EXPECT_TRUE(bar.SetPaneTextEx(1, "i", TRUE));
        EXPECT_EQ(widthOf(1), measured("i") + 2);
        EXPECT_LT(place(1).Width(), wide.Width());
    }
    EXPECT_TRUE(bar.SetPaneTextEx(1, 600U, TRUE));
    EXPECT_EQ(widthOf(1), measured("a text of the resources") + 2);
    EXPECT_TRUE(bar.SetPaneText(1, 501U, TRUE));
    EXPECT_EQ(bar.GetPaneText(1), "501");
    EXPECT_TRUE(bar.SetPaneText(1, "a text that the pane is much too narrow for", TRUE));
    EXPECT_TRUE(tells(1, "501\na text that the pane is much too narrow for"));
    bar.SetPaneInfo(2, panes[2], SBPS_NORMAL, 200);
    EXPECT_TRUE(tells(1, "501\na text that the pane is much too narrow for")) << "where the pane is now";
    EXPECT_FALSE(bar.SetPaneTextEx(3, "none", TRUE));
}
