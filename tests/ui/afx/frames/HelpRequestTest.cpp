#include "platform/afx/dialogs/Dialog.h"
#include "platform/win/FrameworkIds.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/frames/FrameTesting.h"

using namespace frametest;

namespace {

using Requests = std::vector<std::pair<DWORD_PTR, UINT>>;

/// The one request for a context.
Requests context(DWORD_PTR number) {
    return {{number, HELP_CONTEXT}};
}

/// Notes the help requests that come by, and takes them when it is told to.
class KeysDialog : public CDialog {
public:
    explicit KeysDialog(CWnd* parent = nullptr) : CDialog(IDD_TESTKEYS, parent) {}
    std::vector<HELPINFO> seen;
    bool takes = false;
    using CDialog::m_nIDHelp;

protected:
    afx_msg BOOL OnHelpInfo(HELPINFO* info) {
        seen.push_back(*info);
        return takes ? TRUE : CDialog::OnHelpInfo(info);
    }
    DECLARE_MESSAGE_MAP()
};

// clang-format off
BEGIN_MESSAGE_MAP(KeysDialog, CDialog)
    ON_WM_HELPINFO()
END_MESSAGE_MAP()
// clang-format on

class HelpRequest : public FrameTest {
protected:
    void SetUp() override {
        FrameTest::SetUp();
        testApplication.help.clear();
    }
    void TearDown() override {
        FrameTest::TearDown();
        testApplication.help.clear();
    }
    static Requests take() {
        return std::exchange(testApplication.help, {});
    }
};

/// Presses the help key in the message box that comes up next.
void helpInBox(std::vector<std::string>& texts) {
    later([&texts] {
        auto* box = dynamic_cast<QMessageBox*>(QApplication::activeModalWidget());
        ASSERT_NE(box, nullptr);
        texts.push_back(box->text().toStdString());
        QTest::keyClick(box, Qt::Key_F1);
        QTest::keyClick(box, Qt::Key_Escape);
    });
}

} // namespace

TEST_F(HelpRequest, TheKeyAsksForTheFrameAndOnceHoweverLongItIsHeld) {
    openNote();
    key(Qt::Key_F1);
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTMAIN));
    QTest::simulateEvent(QApplication::focusWidget(), true, Qt::Key_F1, Qt::NoModifier, QString(), true);
    key(Qt::Key_F1, Qt::ControlModifier);
    EXPECT_EQ(take(), Requests());
    // As the toolkit tells it when it was quicker than the display.
    for (const auto type : {QEvent::KeyRelease, QEvent::KeyPress}) {
        QKeyEvent event(type, Qt::Key_F1, Qt::NoModifier);
        event.setTimestamp(7);
        QSpontaneKeyEvent::setSpontaneous(&event);
        QCoreApplication::sendEvent(QApplication::focusWidget(), &event);
    }
    EXPECT_EQ(take(), Requests());
    AfxGetMainWnd()->SendMessage(WM_COMMAND, ID_HELP);
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTMAIN)) << "the command takes the same road";
}

TEST_F(HelpRequest, TheActiveChildFrameAnswersBeforeTheMainFrame) {
    BoardsFrame& frame = openBoards();
    frame.SendMessage(WM_COMMAND, ID_HELP);
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTMAIN));
    boards().OpenDocumentFile(nullptr);
    settle();
    key(Qt::Key_F1);
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTBOARD)) << "from the view";
    frame.SendMessage(WM_HELP, 0, reinterpret_cast<LPARAM>(std::make_unique<HELPINFO>().get()));
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTBOARD)) << "from the main frame";
    frame.SendMessage(WM_COMMAND, ID_CONTEXT_HELP);
    EXPECT_TRUE(frame.m_bHelpMode) << "the whole window's, though the child frame gets commands first";
    QTest::mouseClick(tvx::afx::peerOf(frame.MDIGetActive()->GetActiveView()->m_hWnd), Qt::LeftButton);
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTBOARD));
    frame.MDIGetActive()->m_nIDHelp = 0;
    frame.m_nIDHelp = 0;
    key(Qt::Key_F1);
    EXPECT_EQ(take(), (Requests{{0, HELP_FINDER}})) << "nobody has a context: ID_DEFAULT_HELP";
}

TEST_F(HelpRequest, ADialogGetsItWithItsControlAndAnswersForItself) {
    openNote();
    KeysDialog dialog(AfxGetMainWnd());
    inDialog([&] {
        key(Qt::Key_F1);
        EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDD_TESTKEYS));
        ASSERT_EQ(dialog.seen.size(), 1U);
        EXPECT_EQ(dialog.seen[0].iContextType, HELPINFO_WINDOW);
        EXPECT_EQ(dialog.seen[0].iCtrlId, IDC_TEST_TEXT);
        EXPECT_EQ(dialog.seen[0].hItemHandle, dialog.GetDlgItem(IDC_TEST_TEXT)->m_hWnd);
        EXPECT_EQ(dialog.seen[0].dwContextId, 701U);
        EXPECT_EQ(dialog.GetWindowContextHelpId(), 700U);
        EXPECT_TRUE(dialog.SetWindowContextHelpId(5));
        dialog.SendMessage(WM_KEYDOWN, VK_F1);
        EXPECT_EQ(dialog.seen.back().dwContextId, 5U);
        take();
        dialog.takes = true;
        key(Qt::Key_F1);
        EXPECT_EQ(take(), Requests()) << "taken by its handler";
        dialog.takes = false;
        dialog.m_nIDHelp = 0;
        key(Qt::Key_F1);
        EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTMAIN)) << "the frame behind it answers";
        dialog.EndDialog(IDOK);
    });
    EXPECT_EQ(dialog.DoModal(), IDOK);
}

TEST_F(HelpRequest, ADialogWithoutAFrameAnswersToo) {
    KeysDialog dialog;
    inDialog([&] {
        key(Qt::Key_F1);
        EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDD_TESTKEYS));
        dialog.EndDialog(IDOK);
    });
    EXPECT_EQ(dialog.DoModal(), IDOK);
}

TEST_F(HelpRequest, AMenuAsksForItsHighlightedItem) {
    NoteFrame& frame = openNote();
    QMenu* edit = clickBar(frame, "Edit");
    ASSERT_NE(edit, nullptr);
    edit->setActiveAction(itemOf(*edit, "Draw"));
    QTest::keyClick(edit, Qt::Key_F1);
    EXPECT_EQ(take(), context(HID_BASE_COMMAND + ID_TEST_DRAW));
    EXPECT_EQ(openMenu(), edit) << "whoever shows help closes it";
    edit->setActiveAction(itemOf(*edit, "Size"));
    QTest::keyClick(edit, Qt::Key_F1);
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTMAIN)) << "a popup has no command";
    QAction* locked = itemOf(*edit, "Locked");
    edit->setActiveAction(nullptr);
    QCursor::setPos(edit->mapToGlobal(edit->actionGeometry(locked).center()));
    QTest::keyClick(edit, Qt::Key_F1);
    EXPECT_EQ(take(), context(HID_BASE_COMMAND + ID_TEST_LOCKED)) << "disabled items are not highlighted in all styles";
    QCursor::setPos(edit->mapToGlobal(QPoint(-50, -50)));
    QTest::keyClick(edit, Qt::Key_F1);
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTMAIN)) << "no item at all";
    // A request without a context, as hosts send it, finds the item too.
    edit->setActiveAction(itemOf(*edit, "Grid"));
    frame.SendMessage(WM_COMMANDHELP, 0, 0);
    EXPECT_EQ(take(), context(HID_BASE_COMMAND + ID_TEST_GRID));
    frame.SendMessage(WM_CANCELMODE);
    EXPECT_EQ(openMenu(), nullptr);
    later([] {
        QTest::keyClick(openMenu(), Qt::Key_Down);
        QTest::keyClick(openMenu(), Qt::Key_F1);
        openMenu()->close();
    });
    CMenu context1;
    context1.LoadMenu(IDR_TESTCONTEXT);
    context1.GetSubMenu(0)->TrackPopupMenu(TPM_LEFTALIGN, 100, 100, &view());
    EXPECT_EQ(take(), context(HID_BASE_COMMAND + ID_TEST_DRAW)) << "a menu of a view, not of the frame";
    later([&] {
        openMenu()->setActiveAction(itemOf(*openMenu(), "Close"));
        QTest::keyClick(openMenu(), Qt::Key_F1);
        openMenu()->close();
    });
    frame.SendMessage(WM_SYSCOMMAND, SC_KEYMENU, ' ');
    EXPECT_EQ(take(), context(HID_BASE_COMMAND + AFX_IDS_SCCLOSE));
}

TEST_F(HelpRequest, AMessageBoxAsksForItsHelpIdElseForWhatItStandsOver) {
    openNote();
    std::vector<std::string> texts;
    helpInBox(texts);
    AfxMessageBox("Disk is full.", MB_OK, 40);
    EXPECT_EQ(take(), context(HID_BASE_PROMPT + 40));
    helpInBox(texts);
    AfxMessageBox(IDR_TESTMAIN);
    EXPECT_EQ(take(), context(HID_BASE_PROMPT + IDR_TESTMAIN)) << "a text's own number";
    helpInBox(texts);
    AfxMessageBox("No number");
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTMAIN));
    later([] {
        auto* box = dynamic_cast<QMessageBox*>(QApplication::activeModalWidget());
        ASSERT_NE(box, nullptr);
        QAbstractButton* help = box->buttons().back();
        EXPECT_EQ(help->text().remove('&'), "Help");
        help->click();
        EXPECT_TRUE(box->isVisible()) << "it stays open";
        QTest::keyClick(box, Qt::Key_Escape);
    });
    EXPECT_EQ(AfxMessageBox("Really?", MB_OKCANCEL | MB_HELP, 42), IDCANCEL);
    EXPECT_EQ(take(), context(HID_BASE_PROMPT + 42));
    KeysDialog dialog(AfxGetMainWnd());
    inDialog([&] {
        helpInBox(texts);
        dialog.MessageBox("In a dialog");
        EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDD_TESTKEYS));
        helpInBox(texts);
        AfxMessageBox("In a dialog", MB_OK, 41);
        EXPECT_EQ(take(), context(HID_BASE_PROMPT + 41));
        dialog.EndDialog(IDOK);
    });
    dialog.DoModal();
    EXPECT_EQ(texts.size(), 5U);
}

TEST_F(HelpRequest, TheBaseTellsThatThereIsNoViewerAndThatBoxHasNoHelp) {
    openNote();
    std::vector<std::string> texts;
    helpInBox(texts);
    testApplication.CWinApp::WinHelpA(1, HELP_CONTEXT);
    testApplication.CWinApp::WinHelpA(0, HELP_QUIT);
    EXPECT_EQ(take(), Requests());
    EXPECT_EQ(texts, std::vector<std::string>{"Help could not be started."});
    view().WinHelp(7);
    testApplication.WinHelp(8, HELP_KEY);
    EXPECT_EQ(take(), (Requests{{7, HELP_CONTEXT}, {8, HELP_KEY}}));
}

TEST_F(HelpRequest, InHelpModeAClickExplainsInsteadOfActing) {
    NoteFrame& frame = openNote();
    const auto enter = [&] { frame.SendMessage(WM_COMMAND, ID_CONTEXT_HELP); };
    key(Qt::Key_F1, Qt::ShiftModifier);
    EXPECT_TRUE(frame.m_bHelpMode);
    EXPECT_TRUE(testApplication.m_bHelpMode);
    ASSERT_NE(QApplication::overrideCursor(), nullptr);
    EXPECT_EQ(QApplication::overrideCursor()->shape(), Qt::WhatsThisCursor);
    EXPECT_EQ(titleOf(frame.status), "Select an object on which to get Help");
    key(Qt::Key_D, Qt::ControlModifier);
    EXPECT_FALSE(noted("draw")) << "accelerators wait";
    CRect grid;
    frame.tools.GetItemRect(frame.tools.CommandToIndex(ID_TEST_GRID), grid);
    QWidget* tools = tvx::afx::peerOf(frame.tools.m_hWnd);
    QWidget* button = tools->childAt(grid.CenterPoint().x, grid.CenterPoint().y);
    ASSERT_NE(button, nullptr);
    QTest::mouseClick(button, Qt::LeftButton);
    EXPECT_EQ(take(), context(HID_BASE_COMMAND + ID_TEST_GRID));
    EXPECT_FALSE(view().grid) << "not carried out";
    EXPECT_FALSE(frame.m_bHelpMode);
    EXPECT_FALSE(testApplication.m_bHelpMode);
    EXPECT_EQ(QApplication::overrideCursor(), nullptr);
    enter();
    QTest::mouseClick(tvx::afx::peerOf(frame.status.m_hWnd), Qt::LeftButton);
    EXPECT_EQ(take(), context(HID_BASE_CONTROL + AFX_IDW_STATUS_BAR));
    enter();
    QTest::mouseClick(tvx::afx::peerOf(view().m_hWnd), Qt::LeftButton);
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTMAIN));
}

TEST_F(HelpRequest, HelpModeExplainsMenuCommandsAndEndsByEscapeOrByItself) {
    NoteFrame& frame = openNote();
    const auto enter = [&] { frame.SendMessage(WM_COMMAND, ID_CONTEXT_HELP); };
    enter();
    clickItem(*clickBar(frame, "Edit"), "Grid");
    settle();
    EXPECT_EQ(take(), context(HID_BASE_COMMAND + ID_TEST_GRID));
    EXPECT_FALSE(view().grid);
    EXPECT_FALSE(frame.m_bHelpMode);
    enter();
    frame.SendMessage(WM_SYSCOMMAND, SC_CLOSE);
    ASSERT_NE(AfxGetMainWnd()->m_hWnd, nullptr);
    EXPECT_EQ(take(), context(HID_BASE_COMMAND + AFX_IDS_SCCLOSE)) << "the close button too";
    enter();
    key(Qt::Key_Escape);
    EXPECT_FALSE(frame.m_bHelpMode);
    enter();
    testApplication.OnContextHelp();
    EXPECT_FALSE(frame.m_bHelpMode) << "asked for twice";
    enter();
    key(Qt::Key_F1);
    EXPECT_FALSE(frame.m_bHelpMode);
    EXPECT_EQ(take(), context(HID_BASE_RESOURCE + IDR_TESTMAIN));
    enter();
    QTest::mouseClick(tvx::afx::peerOf(view().m_hWnd), Qt::RightButton);
    EXPECT_FALSE(frame.m_bHelpMode);
    EXPECT_EQ(take(), Requests());
    enter();
    frame.DestroyWindow();
    EXPECT_EQ(QApplication::overrideCursor(), nullptr) << "the frame has ended";
}
