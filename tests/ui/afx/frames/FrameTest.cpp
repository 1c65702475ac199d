#include "tests/ui/afx/frames/FrameTesting.h"

#include <QWindow>

using namespace frametest;

using Frame = FrameTest;

TEST_F(Frame, ShowsMenuViewAndTitle) {
    NoteFrame& frame = openNote();
    EXPECT_EQ(titleOf(frame), "Note - Frame Test");
    EXPECT_EQ(widgetOf(frame)->centralWidget(), view().GetState()->widget());
    const auto* bar = qobject_cast<QMenuBar*>(widgetOf(frame)->menuWidget());
    ASSERT_NE(bar, nullptr);
    EXPECT_EQ(bar->actions().size(), 3);
    EXPECT_EQ(CWnd::GetFocus(), &view());
    CRect client;
    view().GetClientRect(&client);
    EXPECT_GT(client.Width(), 300);
    const QImage shown = widgetOf(frame)->grab().toImage();
    const QPoint corner = tvx::afx::peerOf(view().m_hWnd)->mapTo(widgetOf(frame), QPoint(0, 0));
    EXPECT_EQ(shown.pixel(corner + QPoint(15, 15)), qRgb(255, 0, 0));
    EXPECT_EQ(shown.pixel(corner + QPoint(50, 50)), qRgb(255, 255, 255));
}

TEST_F(Frame, FollowsItsSize) {
    NoteFrame& frame = openNote();
    CRect before;
    view().GetClientRect(&before);
    CRect outer;
    frame.GetWindowRect(&outer);
    frame.SetWindowPos(nullptr, 0, 0, outer.Width() - 100, outer.Height() - 50, SWP_NOMOVE | SWP_NOZORDER);
    settle();
    CRect after;
    view().GetClientRect(&after);
    EXPECT_EQ(after.Width(), before.Width() - 100);
    EXPECT_EQ(after.Height(), before.Height() - 50);
}

namespace {

/// Ends itself when it gets a new size or place.
class ShyFrame : public CFrameWnd {
public:
    bool shy = false;

protected:
    void OnSize(UINT type, int cx, int cy) {
        CFrameWnd::OnSize(type, cx, cy);
        if (shy) {
            DestroyWindow();
        }
    }
    void PostNcDestroy() override {}
    DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(ShyFrame, CFrameWnd)
ON_WM_SIZE()
END_MESSAGE_MAP()

/// Keeps to itself what a window hears of its size, as the toolkit does with a size that it told before.
class Withholding : public QObject {
protected:
    bool eventFilter(QObject*, QEvent* event) override {
        return event->type() == QEvent::Resize;
    }
};

} // namespace

TEST_F(Frame, HearsOfASizeThatTheToolkitKeptToItself) {
    NoteFrame& frame = openNote();
    const QWidget& widget = *widgetOf(frame);
    const QSize before = widget.size();
    const QSize size = before + QSize(80, 60);
    {
        Withholding withholding;
        widget.windowHandle()->installEventFilter(&withholding);
        widget.windowHandle()->resize(size);
        settle();
    }
    ASSERT_EQ(widget.size(), before);
    frame.GetState()->placement()->changed();
    EXPECT_TRUE(QTest::qWaitFor([&] { return widget.size() == size; }));
}

TEST_F(Frame, MayEndWhileItIsMoved) {
    for (const bool placed : {false, true}) {
        ShyFrame frame;
        ASSERT_TRUE(frame.Create(nullptr, "Shy", WS_OVERLAPPEDWINDOW, CRect(10, 10, 310, 210)));
        frame.ShowWindow(SW_SHOW);
        settle();
        frame.shy = true;
        WINDOWPLACEMENT placement{sizeof(WINDOWPLACEMENT), 0, SW_SHOWNORMAL, {}, {}, {30, 40, 530, 440}};
        if (placed) {
            frame.SetWindowPlacement(&placement);
        } else {
            frame.MoveWindow(30, 40, 500, 400);
        }
        EXPECT_FALSE(::IsWindow(frame.m_hWnd));
        settle();
    }
}

TEST_F(Frame, FailsWithoutItsMenu) {
    auto* frame = new CFrameWnd; // deletes itself
    EXPECT_FALSE(frame->LoadFrame(777));
}

// --- menus ---

TEST_F(Frame, MenuByMouseUpdatesItemsAndSendsCommands) {
    NoteFrame& frame = openNote();
    QMenu* edit = clickBar(frame, "Edit");
    ASSERT_NE(edit, nullptr);
    EXPECT_TRUE(itemOf(*edit, "Draw")->isEnabled());
    EXPECT_FALSE(itemOf(*edit, "Locked")->isEnabled());
    EXPECT_FALSE(itemOf(*edit, "Orphan")->isEnabled()) << "nobody handles it";
    EXPECT_FALSE(itemOf(*edit, "Grid")->isChecked());
    clickItem(*edit, "Grid");
    EXPECT_TRUE(noted("grid"));
    EXPECT_EQ(openMenu(), nullptr);
    EXPECT_EQ(CWnd::GetFocus(), &view());

    edit = clickBar(frame, "Edit");
    EXPECT_TRUE(itemOf(*edit, "Grid")->isChecked());
    key(Qt::Key_Escape);
}

TEST_F(Frame, MenuItemsWithoutHandlersStayWhenAsked) {
    NoteFrame& frame = openNote();
    frame.m_bAutoMenuEnable = FALSE;
    QMenu* edit = clickBar(frame, "Edit");
    ASSERT_NE(edit, nullptr);
    EXPECT_TRUE(itemOf(*edit, "Orphan")->isEnabled());
    key(Qt::Key_Escape);
}

TEST_F(Frame, MenuByKeyboard) {
    openNote();
    key(Qt::Key_E, Qt::AltModifier);
    ASSERT_NE(openMenu(), nullptr);
    EXPECT_EQ(openMenu()->activeAction(), itemOf(*openMenu(), "Draw"));
    key(Qt::Key_Return);
    EXPECT_TRUE(noted("draw"));

    // F10 gives the bar the keyboard, arrows walk, a letter chooses.
    key(Qt::Key_F10);
    EXPECT_NE(qobject_cast<QMenuBar*>(QApplication::focusWidget()), nullptr);
    key(Qt::Key_Right);
    key(Qt::Key_Down);
    ASSERT_NE(openMenu(), nullptr);
    EXPECT_NE(itemOf(*openMenu(), "Grid"), nullptr);
    key(Qt::Key_G);
    EXPECT_TRUE(noted("grid"));
    EXPECT_EQ(CWnd::GetFocus(), &view());
}

TEST_F(Frame, RadioItemsInPopupsOfPopups) {
    NoteFrame& frame = openNote();
    view().large = true;
    QMenu* edit = clickBar(frame, "Edit");
    ASSERT_NE(edit, nullptr);
    clickItem(*edit, "Size");
    QMenu* sizes = openMenu();
    ASSERT_NE(sizes, nullptr);
    ASSERT_NE(sizes, edit);
    EXPECT_TRUE(itemOf(*sizes, "Large")->isChecked());
    EXPECT_NE(itemOf(*sizes, "Large")->actionGroup(), nullptr);
    EXPECT_FALSE(itemOf(*sizes, "Small")->isChecked());
    clickItem(*sizes, "Small");
    EXPECT_FALSE(view().large);
}

TEST_F(Frame, PromptsOfMenuItems) {
    NoteFrame& frame = openNote();
    EXPECT_EQ(frame.status.GetPaneText(0), "Ready");
    QMenu* edit = clickBar(frame, "Edit");
    ASSERT_NE(edit, nullptr);
    edit->setActiveAction(itemOf(*edit, "Grid"));
    EXPECT_EQ(frame.status.GetPaneText(0), "Shows the grid");
    edit->setActiveAction(itemOf(*edit, "Draw"));
    EXPECT_EQ(frame.status.GetPaneText(0), "Draws a shape");
    key(Qt::Key_Escape);
    key(Qt::Key_Escape);
    EXPECT_EQ(frame.status.GetPaneText(0), "Ready");
}

TEST_F(Frame, ChangesOfTheBarAreSeenAtOnce) {
    NoteFrame& frame = openNote();
    const auto* bar = qobject_cast<QMenuBar*>(widgetOf(frame)->menuWidget());
    frame.GetMenu()->AppendMenu(MF_STRING, ID_TEST_DRAW, "Now");
    ASSERT_EQ(bar->actions().size(), 4);
    bar->actions().back()->trigger();
    settle();
    EXPECT_TRUE(noted("draw"));
    CMenu* shown = frame.GetMenu();
    frame.SetMenu(nullptr);
    EXPECT_TRUE(bar->isHidden());
    frame.SetMenu(shown);
    EXPECT_FALSE(bar->isHidden());
}

// --- accelerators ---

TEST_F(Frame, Accelerators) {
    openNote();
    key(Qt::Key_D, Qt::ControlModifier);
    EXPECT_EQ(journal(), std::vector<std::string>{"draw"});
    key(Qt::Key_D);
    key(Qt::Key_D, Qt::ControlModifier | Qt::ShiftModifier);
    key(Qt::Key_L, Qt::ControlModifier);
    EXPECT_EQ(journal(), std::vector<std::string>{"draw"}) << "plain, with Shift, of a disabled command";
    key(Qt::Key_F5);
    key(Qt::Key_F5, Qt::ShiftModifier);
    QTest::keyClick(widgetOf(*static_cast<CFrameWnd*>(AfxGetMainWnd()))->windowHandle(), '*');
    EXPECT_EQ(journal(), (std::vector<std::string>{"draw", "grid", "frame", "document"}));
}

TEST_F(Frame, AcceleratorsWorkAfterAMenuWasOpenedByKeys) {
    openNote();
    key(Qt::Key_E, Qt::AltModifier); // Alt is let go of while the menu has the keyboard
    ASSERT_NE(openMenu(), nullptr);
    key(Qt::Key_Escape);
    key(Qt::Key_Escape);
    EXPECT_EQ(CWnd::GetFocus(), &view());
    key(Qt::Key_D, Qt::ControlModifier);
    EXPECT_TRUE(noted("draw"));
}

TEST_F(Frame, AcceleratorsRestWhileAMenuIsOpen) {
    NoteFrame& frame = openNote();
    ASSERT_NE(clickBar(frame, "View"), nullptr);
    key(Qt::Key_F5);
    EXPECT_FALSE(noted("grid"));
    key(Qt::Key_Escape);
    key(Qt::Key_Escape);
}

TEST_F(Frame, ATableIsReplacedWhileItsFrameLives) {
    NoteFrame& frame = openNote();
    // A command that stands in two menus, and a key that two commands claim.
    CMenu popup;
    popup.CreatePopupMenu();
    popup.AppendMenu(MF_STRING, ID_TEST_DRAW, "&Again");
    frame.GetMenu()->AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(popup.Detach()), "&More");
    const ACCEL entries[] = {{FVIRTKEY | FCONTROL, 'K', ID_TEST_DRAW}, {FVIRTKEY | FCONTROL, 'K', ID_TEST_GRID}};
    EXPECT_TRUE(DestroyAcceleratorTable(frame.m_hAccelTable));
    key(Qt::Key_D, Qt::ControlModifier);
    EXPECT_EQ(journal(), std::vector<std::string>{});
    frame.m_hAccelTable = CreateAcceleratorTable(entries, 2);
    key(Qt::Key_D, Qt::ControlModifier);
    EXPECT_EQ(journal(), std::vector<std::string>{});
    key(Qt::Key_K, Qt::ControlModifier);
    EXPECT_EQ(journal(), std::vector<std::string>{"draw"});
    DestroyAcceleratorTable(std::exchange(frame.m_hAccelTable, nullptr));
    key(Qt::Key_K, Qt::ControlModifier);
    EXPECT_EQ(journal(), std::vector<std::string>{"draw"});
}

TEST_F(Frame, TablesByHandle) {
    openNote();
    const ACCEL entries[] = {{FVIRTKEY | FCONTROL, 'Q', 100}, {0, 'x', 101}};
    const HACCEL table = CreateAcceleratorTable(entries, 2);
    ASSERT_NE(table, nullptr);
    EXPECT_EQ(CopyAcceleratorTable(table, nullptr, 0), 2);
    ACCEL copy[1] = {};
    EXPECT_EQ(CopyAcceleratorTable(table, copy, 1), 1);
    EXPECT_EQ(copy[0].cmd, 100);
    MSG letter{AfxGetMainWnd()->GetSafeHwnd(), WM_CHAR, 'x', 1, 0, {}};
    EXPECT_TRUE(TranslateAccelerator(letter.hwnd, table, &letter));
    letter.wParam = 'y';
    EXPECT_FALSE(TranslateAccelerator(letter.hwnd, table, &letter));
    EXPECT_EQ(LoadAccelerators(nullptr, MAKEINTRESOURCE(999)), nullptr);
    EXPECT_TRUE(DestroyAcceleratorTable(table));
    EXPECT_FALSE(DestroyAcceleratorTable(table));
    EXPECT_EQ(CopyAcceleratorTable(table, nullptr, 0), 0);
    EXPECT_EQ(CreateAcceleratorTable(entries, 0), nullptr);
}

// --- routing ---

TEST_F(Frame, CommandsGoFromViewToDocumentToFrame) {
    NoteFrame& frame = openNote();
    for (const UINT id : {ID_TEST_DRAW, ID_TEST_DOC, ID_TEST_FRAME, ID_TEST_LOCKED}) {
        frame.SendMessage(WM_COMMAND, id);
    }
    EXPECT_EQ(journal(), (std::vector<std::string>{"draw", "document", "frame"})) << "a disabled one is not sent";
    AFX_CMDHANDLERINFO info;
    EXPECT_TRUE(frame.OnCmdMsg(ID_TEST_DOC, CN_COMMAND, nullptr, &info));
    EXPECT_EQ(info.pTarget, &document());
    EXPECT_EQ(journal().size(), 3U) << "asking does not act";
}

TEST_F(Frame, ClickMakesAViewActive) {
    NoteFrame& frame = openNote();
    frame.SetActiveView(nullptr);
    QTest::mouseClick(tvx::afx::peerOf(static_cast<CView*>(frame.GetDlgItem(AFX_IDW_PANE_FIRST))->m_hWnd),
                      Qt::LeftButton);
    EXPECT_EQ(frame.GetActiveView(), frame.GetDlgItem(AFX_IDW_PANE_FIRST));
    EXPECT_EQ(CWnd::GetFocus(), frame.GetActiveView());
}

namespace {

/// Deletes the first character of its field, then all of it, with keys that are the frame's accelerators too.
void typeInto(CWnd& dialog) {
    CWnd* field = dialog.GetDlgItem(IDC_TEST_TEXT);
    field->SetWindowText("abc");
    field->SetFocus();
    field->SendMessage(EM_SETSEL, 0, 0);
    key(Qt::Key_Delete);
    EXPECT_EQ(titleOf(*field), "bc");
    key(Qt::Key_A, Qt::ControlModifier);
    key(Qt::Key_Delete);
    EXPECT_EQ(titleOf(*field), "");
    key(Qt::Key_F5);
}

} // namespace

TEST_F(Frame, KeysOfADialogAreTheDialogsOwn) {
    NoteFrame& frame = openNote();
    key(Qt::Key_Delete);
    ASSERT_EQ(journal(), std::vector<std::string>{"frame"}) << "an accelerator";
    journal().clear();
    CDialog modeless;
    ASSERT_TRUE(modeless.Create(IDD_TESTKEYS, &frame));
    settle();
    typeInto(modeless);
    modeless.DestroyWindow();
    CDialog modal(IDD_TESTKEYS, &frame);
    inDialog([&modal] {
        typeInto(modal);
        key(Qt::Key_Escape);
    });
    EXPECT_EQ(modal.DoModal(), IDCANCEL);
    EXPECT_EQ(journal(), std::vector<std::string>{}) << "nothing happened to what is behind";
    settle();
    key(Qt::Key_Delete);
    EXPECT_EQ(journal(), std::vector<std::string>{"frame"}) << "afterwards it is an accelerator again";
}
