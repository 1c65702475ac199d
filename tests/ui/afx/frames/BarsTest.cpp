#include "tests/ui/afx/frames/FrameTesting.h"

#include <QToolBar>
#include <QToolButton>

using namespace frametest;

namespace {

class Bars : public FrameTest {
protected:
    void SetUp() override {
        FrameTest::SetUp();
        frame = &openNote();
        tools = qobject_cast<QToolBar*>(frame->tools.GetState()->widget());
        ASSERT_NE(tools, nullptr);
    }
    QToolButton* button(UINT id) const {
        return qobject_cast<QToolButton*>(tools->widgetForAction(tools->actions()[frame->tools.CommandToIndex(id)]));
    }
    NoteFrame* frame = nullptr;
    QToolBar* tools = nullptr;
};

} // namespace

TEST_F(Bars, ToolBarIsMadeFromItsResource) {
    EXPECT_EQ(frame->tools.GetCount(), 5);
    EXPECT_EQ(frame->tools.GetItemID(0), UINT{ID_TEST_DRAW});
    EXPECT_EQ(frame->tools.GetItemID(2), 0U);
    EXPECT_EQ(frame->tools.CommandToIndex(ID_TEST_GRID), 3);
    EXPECT_EQ(frame->tools.CommandToIndex(4711), -1);
    EXPECT_EQ(button(ID_TEST_GRID)->toolTip(), QString("Grid"));
    const QImage icon = button(ID_TEST_LOCKED)->icon().pixmap(16, 15).toImage();
    EXPECT_EQ(icon.pixelColor(8, 7), QColor(0, 128, 0));
    EXPECT_EQ(icon.pixelColor(0, 0).alpha(), 0) << "the background is transparent";
    EXPECT_FALSE(CToolBar().LoadToolBar(4711));
}

TEST_F(Bars, PicturesAreSeenOnADarkDesktop) {
    const std::vector<DWORD> pixels(std::size_t{64} * 15, 0x202020);
    const HBITMAP dark = CreateBitmap(64, 15, 1, 32, pixels.data());
    frame->tools.SetBitmap(dark);
    const auto shown = [this] {
        return button(ID_TEST_LOCKED)->icon().pixmap(16, 15).toImage().pixelColor(8, 7).lightness();
    };
    const QPalette before = QApplication::palette();
    EXPECT_EQ(shown(), 32);
    QApplication::setPalette(QPalette(QColor(50, 50, 50), QColor(40, 40, 40)));
    EXPECT_EQ(shown(), 223);
    for (const auto* close : tvx::afx::peerOf(frame->tools.m_hWnd)->findChildren<QToolButton*>()) {
        if (close->accessibleName() == "Close") {
            const QImage cross = close->icon().pixmap(16, 16).toImage();
            EXPECT_GT(cross.pixelColor(cross.rect().center()).lightness(), 200) << "of a floating bar";
        }
    }
    QApplication::setPalette(before);
    EXPECT_EQ(shown(), 32);
    DeleteObject(dark);
}

TEST_F(Bars, ButtonsFollowTheirCommands) {
    EXPECT_TRUE(button(ID_TEST_DRAW)->isEnabled());
    EXPECT_FALSE(button(ID_TEST_LOCKED)->isEnabled());
    EXPECT_FALSE(button(ID_TEST_ORPHAN)->isEnabled()) << "nobody handles it";
    EXPECT_FALSE(button(ID_TEST_GRID)->isChecked());
    QTest::mouseClick(button(ID_TEST_GRID), Qt::LeftButton);
    QTest::mouseClick(button(ID_TEST_DRAW), Qt::LeftButton);
    EXPECT_EQ(journal(), (std::vector<std::string>{"grid", "draw"}));
    idle();
    EXPECT_TRUE(button(ID_TEST_GRID)->isChecked());
    view().grid = false;
    CFrameWnd::UpdateAllFrames(frame);
    EXPECT_TRUE(button(ID_TEST_GRID)->isChecked()) << "left out";
    CFrameWnd::UpdateAllFrames(nullptr);
    EXPECT_FALSE(button(ID_TEST_GRID)->isChecked());
    EXPECT_EQ(CWnd::GetFocus(), &view()) << "buttons do not take the keyboard";
}

TEST_F(Bars, ButtonsAreToldAndAskedAbout) {
    UINT id = 0;
    UINT style = 0;
    int image = 0;
    frame->tools.GetButtonInfo(3, id, style, image);
    EXPECT_EQ(std::tuple(id, style & 0xFFFF, image), std::tuple(UINT{ID_TEST_GRID}, UINT{TBBS_CHECKBOX}, 2));
    frame->tools.GetButtonInfo(99, id, style, image);
    EXPECT_EQ(std::tuple(id, style, image), std::tuple(0U, 0U, 0));
    EXPECT_TRUE(frame->tools.SetButtonText(3, "Raster"));
    EXPECT_FALSE(frame->tools.SetButtonText(99, "none"));
    EXPECT_EQ(frame->tools.GetButtonText(3), "Raster");
    EXPECT_EQ(frame->tools.GetButtonText(0), "");
    EXPECT_EQ(button(ID_TEST_GRID)->text(), QString("Raster"));
    EXPECT_EQ(button(ID_TEST_GRID)->toolButtonStyle(), Qt::ToolButtonTextUnderIcon);
    frame->tools.SetHeight(90);
    settle();
    EXPECT_EQ(tools->height(), 90);
}

TEST_F(Bars, PlaceForAControl) {
    frame->tools.SetButtonInfo(2, 5000, TBBS_SEPARATOR, 90);
    settle();
    CRect place;
    frame->tools.GetItemRect(2, &place);
    EXPECT_EQ(place.Width(), 90);
    CRect next;
    frame->tools.GetItemRect(3, &next);
    EXPECT_GE(next.left, place.right);
}

TEST_F(Bars, PromptUnderThePointer) {
    QTest::mouseMove(button(ID_TEST_GRID));
    settle();
    EXPECT_EQ(frame->status.GetPaneText(0), "Shows the grid");
    QTest::mouseMove(tvx::afx::peerOf(view().m_hWnd), QPoint(100, 100));
    settle();
    EXPECT_EQ(frame->status.GetPaneText(0), "Ready");
}

TEST_F(Bars, AreHiddenAndShownByTheirCommands) {
    CRect before;
    view().GetClientRect(&before);
    QMenu* menu = clickBar(*frame, "View");
    ASSERT_NE(menu, nullptr);
    EXPECT_TRUE(itemOf(*menu, "Tool Bar")->isChecked());
    clickItem(*menu, "Tool Bar");
    EXPECT_FALSE(frame->tools.IsVisible());
    settle();
    CRect after;
    view().GetClientRect(&after);
    EXPECT_GT(after.Height(), before.Height());
    frame->ShowControlBar(&frame->tools, TRUE, TRUE);
    EXPECT_TRUE(frame->tools.IsVisible()) << "counts at once";
    EXPECT_TRUE(tools->isHidden()) << "shown when idle";
    idle();
    EXPECT_FALSE(tools->isHidden());
}

TEST_F(Bars, DockAndFloat) {
    EXPECT_EQ(frame->tools.GetDockSide(), UINT{AFX_IDW_DOCKBAR_TOP});
    frame->DockControlBar(&frame->tools, AFX_IDW_DOCKBAR_LEFT);
    settle();
    EXPECT_EQ(frame->tools.GetDockSide(), UINT{AFX_IDW_DOCKBAR_LEFT});
    EXPECT_EQ(frame->tools.GetBarStyle() & CBRS_ALIGN_ANY, DWORD{CBRS_ALIGN_LEFT});
    EXPECT_GT(tools->height(), tools->width());
    frame->FloatControlBar(&frame->tools, CPoint(200, 200));
    settle();
    EXPECT_TRUE(frame->tools.IsFloating());
    EXPECT_TRUE(tools->isVisible());
    EXPECT_FALSE(tools->windowTitle().isEmpty());
    EXPECT_FALSE(tools->windowTitle().contains('\n'));
    frame->tools.SetWindowText("Shapes");
    EXPECT_EQ(tools->windowTitle(), QString("Shapes"));
    QTest::mouseClick(button(ID_TEST_DRAW), Qt::LeftButton);
    EXPECT_TRUE(noted("draw"));
    const auto buttons = tools->findChildren<QToolButton*>(QString(), Qt::FindDirectChildrenOnly);
    const auto closer = std::find_if(buttons.begin(), buttons.end(), [](const QToolButton* each) {
        return each->accessibleName() == QString("Close");
    });
    ASSERT_NE(closer, buttons.end());
    EXPECT_TRUE(tools->rect().contains((*closer)->geometry()));
    EXPECT_GE(button(ID_TEST_DRAW)->y(), (*closer)->geometry().bottom()) << "the buttons stand below the caption";
    EXPECT_LE(button(ID_TEST_ORPHAN)->geometry().bottom(), tools->height());
    QTest::mouseClick(*closer, Qt::LeftButton);
    settle();
    ASSERT_TRUE(::IsWindow(frame->tools.m_hWnd)) << "a close request hides it, nothing more";
    EXPECT_FALSE(frame->tools.IsVisible());
    frame->ShowControlBar(&frame->tools, TRUE, FALSE);
    EXPECT_TRUE(tools->isVisible());
    QTest::mouseDClick(tools, Qt::LeftButton, Qt::NoModifier, QPoint(20, 8));
    settle();
    EXPECT_FALSE(frame->tools.IsFloating()) << "a double click on the caption";
    EXPECT_FALSE((*closer)->isVisible());
    const auto choose = [&](const QString& item) {
        later([item] { clickItem(*openMenu(), item); });
        frame->tools.SendMessage(WM_CONTEXTMENU, reinterpret_cast<WPARAM>(frame->tools.m_hWnd), MAKELPARAM(-1, -1));
        settle();
    };
    frame->FloatControlBar(&frame->tools, CPoint(200, 200));
    choose("Close");
    EXPECT_FALSE(frame->tools.IsVisible());
    frame->ShowControlBar(&frame->tools, TRUE, FALSE);
    choose("Dock");
    EXPECT_FALSE(frame->tools.IsFloating());
    frame->DockControlBar(&frame->tools, AFX_IDW_DOCKBAR_BOTTOM);
    settle();
    EXPECT_EQ(button(ID_TEST_DRAW)->y(), tools->height() - 1 - button(ID_TEST_DRAW)->geometry().bottom())
        << "without room for a caption";
    EXPECT_EQ(frame->GetControlBar(AFX_IDW_TOOLBAR), &frame->tools);
    EXPECT_EQ(frame->GetControlBar(4711), nullptr);
}
