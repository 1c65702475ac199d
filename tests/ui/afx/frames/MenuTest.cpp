#include "platform/afx/core/Menu.h"
#include "platform/afx/core/detail/MenuWidgets.h"
#include "platform/afx/core/detail/Menus.h"
#include "tests/ui/afx/AccessibleTree.h"
#include "tests/ui/afx/frames/FrameTesting.h"

using namespace frametest;

// --- the lists behind handles ---

namespace {

std::string textOf(HMENU menu, UINT item, UINT flags = MF_BYCOMMAND) {
    char text[64];
    GetMenuStringA(menu, item, text, sizeof(text), flags);
    return text;
}

class MenuList : public testing::Test {
protected:
    void SetUp() override {
        menu.LoadMenu(IDR_TESTMAIN);
    }
    CMenu menu;
};

} // namespace

TEST_F(MenuList, HoldsWhatTheResourceSays) {
    ASSERT_EQ(menu.GetMenuItemCount(), 3U);
    EXPECT_EQ(textOf(menu, 0, MF_BYPOSITION), "&File");
    EXPECT_EQ(textOf(menu, ID_FILE_NEW), "&New\tCtrl+N");
    EXPECT_EQ(menu.GetMenuItemID(0), 0xFFFFFFFFU);
    EXPECT_EQ(menu.GetSubMenu(0)->GetMenuItemID(2), 0U);
    EXPECT_EQ(menu.GetSubMenu(0)->GetMenuState(2, MF_BYPOSITION), UINT{MF_SEPARATOR});
    EXPECT_EQ(menu.GetMenuState(0, MF_BYPOSITION), (4U << 8U) | MF_POPUP);
    EXPECT_FALSE(CMenu().LoadMenu(999));
}

TEST_F(MenuList, FindsCommandsInPopupsAndChangesThem) {
    EXPECT_TRUE(menu.InsertMenu(ID_TEST_LARGE, MF_BYCOMMAND, 500, "Medium"));
    const HMENU sizes = menu.GetSubMenu(1)->GetSubMenu(4)->m_hMenu;
    EXPECT_EQ(GetMenuItemCount(sizes), 3);
    EXPECT_EQ(GetMenuItemID(sizes, 1), 500U);
    EXPECT_EQ(menu.EnableMenuItem(500, MF_GRAYED), UINT{MF_ENABLED});
    EXPECT_EQ(menu.EnableMenuItem(500, MF_ENABLED), UINT{MF_GRAYED});
    EXPECT_EQ(menu.CheckMenuItem(500, MF_CHECKED), UINT{MF_UNCHECKED});
    EXPECT_EQ(menu.GetMenuState(500, MF_BYCOMMAND), UINT{MF_CHECKED});
    EXPECT_EQ(menu.CheckMenuItem(999, MF_CHECKED), 0xFFFFFFFFU);
    EXPECT_TRUE(menu.ModifyMenu(500, MF_BYCOMMAND, 501, "Middle"));
    EXPECT_EQ(textOf(menu, 501), "Middle");
    EXPECT_TRUE(menu.DeleteMenu(501, MF_BYCOMMAND));
    EXPECT_FALSE(menu.DeleteMenu(501, MF_BYCOMMAND));
}

TEST_F(MenuList, HasOneDefaultItemInAPopup) {
    EXPECT_EQ(menu.GetSafeHmenu(), menu.m_hMenu);
    const auto isDefault = [this](UINT item) { return tvx::afx::findItem(menu, item, MF_BYCOMMAND).item().isDefault; };
    EXPECT_TRUE(menu.SetDefaultItem(ID_FILE_NEW));
    EXPECT_TRUE(menu.SetDefaultItem(ID_FILE_SAVE));
    EXPECT_FALSE(isDefault(ID_FILE_NEW));
    EXPECT_TRUE(isDefault(ID_FILE_SAVE));
    EXPECT_FALSE(menu.SetDefaultItem(999));
}

TEST_F(MenuList, OwnsItsPopups) {
    const HMENU file = menu.GetSubMenu(0)->m_hMenu;
    EXPECT_TRUE(menu.RemoveMenu(0, MF_BYPOSITION));
    EXPECT_TRUE(IsMenu(file));
    EXPECT_TRUE(menu.AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(file), "File"));
    EXPECT_FALSE(AppendMenuA(file, MF_POPUP, reinterpret_cast<UINT_PTR>(menu.m_hMenu), "round and round"));
    const HMENU whole = menu.m_hMenu;
    EXPECT_TRUE(menu.DestroyMenu());
    EXPECT_FALSE(IsMenu(file));
    EXPECT_EQ(GetMenuItemCount(whole), -1);
    EXPECT_FALSE(AppendMenuA(whole, MF_STRING, 1, "late"));
}

TEST_F(MenuList, CutsTextsBetweenCharacters) {
    menu.ModifyMenu(ID_FILE_NEW, MF_BYCOMMAND, ID_FILE_NEW, "a\xC3\xA4z");
    char text[4];
    EXPECT_EQ(menu.GetMenuString(ID_FILE_NEW, text, 3, MF_BYCOMMAND), 1);
    EXPECT_STREQ(text, "a");
    EXPECT_EQ(menu.GetMenuString(ID_FILE_NEW, text, 4, MF_BYCOMMAND), 3);
    EXPECT_EQ(menu.GetMenuString(ID_FILE_NEW, nullptr, 0, MF_BYCOMMAND), 4);
}

TEST(MenuText, AccessKey) {
    EXPECT_EQ(tvx::afx::accessKey("&File"), U'f');
    EXPECT_EQ(tvx::afx::accessKey("A && &B"), U'b');
    EXPECT_EQ(tvx::afx::accessKey("Stra&\xC3\x9F"
                                  "e"),
              U'\u00DF');
    EXPECT_EQ(tvx::afx::accessKey("None\t&Ctrl"), 0U);
}

// --- popups on the screen ---

using ContextMenu = FrameTest;

TEST_F(ContextMenu, AnswersOrSendsWhatIsChosen) {
    NoteFrame& frame = openNote();
    CMenu menu;
    menu.LoadMenu(IDR_TESTCONTEXT);
    CMenu* popup = menu.GetSubMenu(0);
    later([] { clickItem(*openMenu(), "Draw"); });
    EXPECT_EQ(popup->TrackPopupMenu(TPM_RETURNCMD, 20, 20, &frame), ID_TEST_DRAW);
    settle();
    EXPECT_FALSE(noted("draw"));

    later([] {
        EXPECT_FALSE(itemOf(*openMenu(), "Locked")->isEnabled()); // through the view's update handler
        clickItem(*openMenu(), "Draw");
    });
    EXPECT_EQ(popup->TrackPopupMenu(TPM_LEFTALIGN, 20, 20, &frame), TRUE);
    EXPECT_FALSE(noted("draw")) << "sent only after the menu is gone";
    settle();
    EXPECT_TRUE(noted("draw"));
}

TEST_F(ContextMenu, ClosesByEscapeAndByCancelMode) {
    NoteFrame& frame = openNote();
    CMenu menu;
    menu.LoadMenu(IDR_TESTCONTEXT);
    later([] { key(Qt::Key_Escape); });
    EXPECT_EQ(menu.GetSubMenu(0)->TrackPopupMenu(TPM_RETURNCMD, 20, 20, &frame), 0);
    later([&frame] { frame.SendMessage(WM_CANCELMODE); });
    EXPECT_EQ(menu.GetSubMenu(0)->TrackPopupMenu(TPM_RETURNCMD, 20, 20, &frame), 0);
    EXPECT_EQ(openMenu(), nullptr);
}

namespace {

class ThrowingFrame : public CFrameWnd {
public:
    afx_msg void OnInitMenuPopup(CMenu*, UINT, BOOL) {
        AfxThrowUserException();
    }

protected:
    DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(ThrowingFrame, CFrameWnd)
ON_WM_INITMENUPOPUP()
END_MESSAGE_MAP()

} // namespace

TEST_F(ContextMenu, LetsExceptionsOfHandlersOut) {
    auto* frame = new ThrowingFrame;
    ASSERT_TRUE(frame->Create(nullptr, "throws"));
    CMenu menu;
    menu.LoadMenu(IDR_TESTCONTEXT);
    EXPECT_THROW(menu.GetSubMenu(0)->TrackPopupMenu(TPM_LEFTALIGN, 0, 0, frame), CUserException*);
    EXPECT_EQ(openMenu(), nullptr);
    frame->DestroyWindow();
}

TEST_F(ContextMenu, SystemMenuIsTheWindowsOwn) {
    NoteFrame& frame = openNote();
    CMenu* menu = frame.GetSystemMenu(FALSE);
    ASSERT_NE(menu, nullptr);
    const UINT before = menu->GetMenuItemCount();
    menu->AppendMenu(MF_STRING, 0x10, "About");
    EXPECT_EQ(frame.GetSystemMenu(FALSE)->GetMenuItemCount(), before + 1);
    frame.GetSystemMenu(TRUE);
    EXPECT_EQ(frame.GetSystemMenu(FALSE)->GetMenuItemCount(), before);
}

namespace {

class MenuKeysView : public NoteView {
    DECLARE_DYNCREATE(MenuKeysView)

public:
    afx_msg void OnContextMenu(CWnd*, CPoint point) {
        frametest::note(point == CPoint(-1, -1) ? "context menu by key" : "context menu by mouse");
    }

protected:
    DECLARE_MESSAGE_MAP()
};

IMPLEMENT_DYNCREATE(MenuKeysView, NoteView)
BEGIN_MESSAGE_MAP(MenuKeysView, NoteView)
ON_WM_CONTEXTMENU()
END_MESSAGE_MAP()

} // namespace

TEST_F(ContextMenu, OpensByKey) {
    NoteFrame& frame = openNote();
    CCreateContext context;
    context.m_pNewViewClass = RUNTIME_CLASS(MenuKeysView);
    context.m_pCurrentDoc = &document();
    CWnd* added = frame.CreateView(&context, AFX_IDW_PANE_FIRST + 1);
    ASSERT_NE(added, nullptr);
    added->ShowWindow(SW_SHOW);
    added->SetFocus();
    key(Qt::Key_F10, Qt::ShiftModifier);
    EXPECT_EQ(journal(), std::vector<std::string>{"context menu by key"});
    EXPECT_FALSE(tvx::afx::menuHasKeyboard());
}

TEST_F(ContextMenu, TheBarShowsWhichEntryHasTheKeyboard) {
    NoteFrame& frame = openNote();
    auto* bar = qobject_cast<QMenuBar*>(widgetOf(frame)->menuWidget());
    const QRect file = bar->actionGeometry(bar->actions()[0]);
    const QRect edit = bar->actionGeometry(bar->actions()[1]);
    const auto look = [&](const QRect& entry) { return bar->grab(entry).toImage(); };
    const QImage plain = look(file);
    const QImage plainEdit = look(edit);
    key(Qt::Key_F10);
    EXPECT_NE(look(file), plain);
    key(Qt::Key_Right);
    EXPECT_EQ(look(file), plain);
    EXPECT_NE(look(edit), plainEdit);
    key(Qt::Key_Escape);
    EXPECT_EQ(look(edit), plainEdit);
}

// Russian letters, by the places of E and D: the entries keep their Latin access keys.
TEST_F(FrameTest, AccessKeysAreFoundOnLayoutsOfOtherScripts) {
    openNote();
    const auto press = [](unsigned place, Qt::KeyboardModifiers modifiers, const char* typed) {
        QWidget* target = openMenu() ? openMenu() : QApplication::focusWidget();
        const QString text = QString::fromUtf8(typed);
        for (const QEvent::Type type : {QEvent::KeyPress, QEvent::KeyRelease}) {
            QKeyEvent event(type, text[0].toUpper().unicode(), modifiers, place, 0, 0, text);
            QSpontaneKeyEvent::setSpontaneous(&event);
            QApplication::instance()->notify(target, &event);
        }
    };
    press(26, Qt::AltModifier, "у");
    ASSERT_NE(openMenu(), nullptr);
    EXPECT_EQ(openMenu()->actions()[0]->text(), "&Draw\tCtrl+D");
    press(40, Qt::NoModifier, "в");
    settle();
    EXPECT_EQ(journal(), std::vector<std::string>{"draw"});
}

// --- assistive tools ---

TEST_F(FrameTest, TellsAssistiveToolsPartsOfAFrameByName) {
    NoteFrame& frame = openNote();
    frame.tools.SetWindowText("Drawing");
    frame.SendMessage(WM_SETMESSAGESTRING, AFX_IDS_IDLEMESSAGE); // the pointer may stand on a button
    EXPECT_EQ(accessibleTree(*QAccessible::queryAccessibleInterface(widgetOf(frame))), R"(Window "Note - Frame Test"
 MenuBar ""
  MenuItem "File"
  MenuItem "Edit"
  MenuItem "View"
 Client ""
  Client ""
 ToolBar "Drawing"
  Button "Draw"
  Button "Locked"
  Separator ""
  CheckBox "Grid"
  Button "Orphan"
 StatusBar "Status Bar"
  Grip ""
  StaticText "Ready"
  StaticText "000 shapes"
  StaticText ""
)");
    frame.GetMenu()->ModifyMenu(ID_FILE_CLOSE, MF_BYCOMMAND, ID_FILE_CLOSE, "閉じる(&C)");
    QMenu* menu = clickBar(frame, "File");
    EXPECT_EQ(accessibleTree(*QAccessible::queryAccessibleInterface(menu)), R"(PopupMenu ""
 MenuItem "New"
 MenuItem "Save"
 Separator ""
 MenuItem "閉じる"
)");
    QAccessibleInterface* save = QAccessible::queryAccessibleInterface(itemOf(*menu, "Save"));
    EXPECT_EQ(save->text(QAccessible::Accelerator), "Ctrl+S");
    EXPECT_EQ(save->parent()->object(), menu);
    EXPECT_EQ(save->rect().size(), menu->actionGeometry(itemOf(*menu, "Save")).size());
    EXPECT_FALSE(save->state().focused);
    menu->setActiveAction(itemOf(*menu, "Save"));
    EXPECT_TRUE(save->state().focused);
    key(Qt::Key_Escape);
    menu = clickBar(frame, "Edit");
    QAccessibleInterface* draw = QAccessible::queryAccessibleInterface(itemOf(*menu, "Draw"));
    draw->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    settle();
    EXPECT_TRUE(noted("draw"));
    key(Qt::Key_Escape);
}

TEST_F(FrameTest, TellsAssistiveToolsOfChildFramesOnce) {
    const BoardsFrame& frame = openBoards();
    boards().OpenDocumentFile(nullptr);
    settle();
    EXPECT_EQ(accessibleTree(*QAccessible::queryAccessibleInterface(widgetOf(frame))), R"(Window "Board1 - Frame Test"
 MenuBar ""
  MenuItem "Board"
  MenuItem "Window"
 LayeredPane ""
  Window "Board1"
   Client ""
    Client ""
     Client ""
 StatusBar "Status Bar"
  Grip ""
  StaticText "Ready"
)");
}

TEST_F(FrameTest, TellsAssistiveToolsOfAButtonInAFrame) {
    BoardsFrame& frame = openBoards();
    boards().OpenDocumentFile(nullptr);
    settle();
    for (CWnd* window : std::initializer_list<CWnd*>{frame.MDIGetActive(), &frame}) {
        QWidget* widget = window->GetState()->widget();
        QAccessibleInterface* whole = QAccessible::queryAccessibleInterface(widget);
        const int parts = whole->childCount();
        const CRect place(100, 4, 116, 18); // in the menu bar of one, the caption of the other
        for (const char* name : {"Other", "Float"}) {
            window->SetFrameButton(name, place, SC_MAXIMIZE);
        }
        CRect around;
        window->GetWindowRect(around);
        const QRect expected(around.left + 100, around.top + 4, 16, 14);
        QAccessibleInterface* button = whole->childAt(expected.x() + 1, expected.y() + 1);
        ASSERT_TRUE(button && whole->childCount() == parts + 1);
        EXPECT_EQ(whole->child(parts), button);
        EXPECT_EQ(whole->indexOfChild(button), parts);
        EXPECT_EQ(button->parent(), whole);
        EXPECT_EQ(accessibleTree(*button), "Button \"Float\"\n");
        EXPECT_EQ(button->rect(), expected);
        EXPECT_EQ(QApplication::widgetAt(expected.center()),
                  widget == widgetOf(frame) ? widgetOf(frame)->menuWidget() : widget);
        button->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
        settle();
        EXPECT_TRUE(window->IsZoomed());
        EXPECT_EQ(button->state().invisible, window != &frame) << "a maximised child frame has no caption";
        window->SetFrameButton("Float", nullptr, 0);
        EXPECT_EQ(whole->childCount(), parts);
    }
}
