#include "platform/afx/gdi/Dc.h"
#include "tests/ui/afx/AccessibleTree.h"
#include "tests/ui/afx/controls/ControlTesting.h"

#include <QScrollBar>

namespace {

/// Lines of its own, which it draws and names.
class Log : public CListBox {
public:
    std::vector<std::string> lines{"1> open a", "opened", "2> run b", "3> close", "closed"};
    mutable int asked = 0;
    std::vector<CPoint> menus;

    void fill() {
        for (const std::string& line : lines) {
            AddString(reinterpret_cast<LPCSTR>(&line));
        }
    }
    void DrawItem(DRAWITEMSTRUCT* item) override {
        const auto& line = *reinterpret_cast<const std::string*>(item->itemData);
        CDC::FromHandle(item->hDC)->TextOut(item->rcItem.left, item->rcItem.top, line.c_str(),
                                            static_cast<int>(line.size()));
    }
    CString GetAccessibleText(int index) const override {
        ++asked;
        return reinterpret_cast<const std::string*>(GetItemDataPtr(index))->c_str();
    }

protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message == WM_CONTEXTMENU) {
            menus.emplace_back(GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam));
        }
        return CListBox::WindowProc(message, wParam, lParam);
    }
};

class OwnerList : public ListTest<Log> {
protected:
    void make(DWORD style) override {
        ASSERT_TRUE(control.Create(shown | WS_BORDER | WS_VSCROLL | WS_HSCROLL | LBS_NOTIFY | LBS_OWNERDRAWFIXED |
                                       LBS_EXTENDEDSEL | style,
                                   place, &dialog, controlId));
        control.fill();
    }
    using Lines = std::vector<int>;
};

} // namespace

TEST_F(OwnerList, SelectsByKeysAndMouse) {
    struct Step {
        const char* name;
        Qt::Key key;
        Qt::KeyboardModifiers modifiers;
        std::vector<int> selected;
        int caret;
    };
    const Step steps[] = {
        {"first", Qt::Key_Home, Qt::NoModifier, {0}, 0},
        {"extend", Qt::Key_Down, Qt::ShiftModifier, {0, 1}, 1},
        {"the keyboard's line alone", Qt::Key_Down, Qt::ControlModifier, {0, 1}, 2},
        {"and on", Qt::Key_End, Qt::ControlModifier, {0, 1}, 4},
        {"take in", Qt::Key_Space, Qt::ControlModifier, {0, 1, 4}, 4},
        {"add a range", Qt::Key_Up, Qt::ControlModifier | Qt::ShiftModifier, {0, 1, 3, 4}, 3},
        {"one", Qt::Key_Up, Qt::NoModifier, {2}, 2},
        {"all", Qt::Key_A, Qt::ControlModifier, {0, 1, 2, 3, 4}, 2},
        {"page", Qt::Key_PageDown, Qt::NoModifier, {4}, 4},
    };
    with(0, [&] {
        for (const auto& [name, pressed, modifiers, lines, caret] : steps) {
            key(pressed, modifiers);
            EXPECT_EQ(selected(), lines) << name;
            EXPECT_EQ(control.GetCaretIndex(), caret) << name;
        }
        EXPECT_EQ(told(LBN_SELCHANGE), 7) << "the keyboard's line is no selection";
        click(&control, middle(1));
        click(&control, middle(3), Qt::ControlModifier);
        EXPECT_EQ(selected(), (Lines{1, 3}));
        // The right button asks about what is selected, or else about the line under it.
        click(&control, middle(1), Qt::NoModifier, Qt::RightButton);
        EXPECT_EQ(selected(), (Lines{1, 3}));
        click(&control, middle(0), Qt::NoModifier, Qt::RightButton);
        EXPECT_EQ(selected(), Lines{0});
        click(&control, {20, 95}, Qt::NoModifier, Qt::RightButton);
        EXPECT_EQ(selected(), Lines{0}) << "there is no line";
        key(Qt::Key_F10, Qt::ShiftModifier);
        EXPECT_EQ(control.menus.size(), 4U);
        EXPECT_EQ(control.menus.back(), CPoint(-1, -1));
    });
}

TEST_F(OwnerList, LongLinesScrollSidewaysByKeys) {
    with(0, [&] {
        key(Qt::Key_Home);
        key(Qt::Key_Right);
        EXPECT_EQ(control.GetCaretIndex(), 1) << "nothing to scroll: the next line";
        control.SetHorizontalExtent(500);
        key(Qt::Key_Right);
        EXPECT_EQ(control.GetCaretIndex(), 1);
        EXPECT_GT(control.GetScrollPos(SB_HORZ), 0);
        CRect first;
        control.GetItemRect(0, &first);
        EXPECT_EQ(first.left, -control.GetScrollPos(SB_HORZ));
        key(Qt::Key_Left);
        EXPECT_EQ(control.GetScrollPos(SB_HORZ), 0);
    });
}

TEST_F(OwnerList, LinesAreKnownToAssistiveTools) {
    with(0, [&] {
        key(Qt::Key_Home);
        key(Qt::Key_Down, Qt::ShiftModifier);
        EXPECT_EQ(control.asked, 0) << "nobody has asked for a line";
        QWidget* widget = tvx::afx::Window::from(control.m_hWnd)->widget();
        const QAccessibleInterface& list = *QAccessible::queryAccessibleInterface(widget);
        EXPECT_EQ(list.childCount(), 5);
        EXPECT_EQ(control.asked, 0);
        EXPECT_EQ(accessibleTree(list), R"(List ""
 ListItem "1> open a"
 ListItem "opened"
 ListItem "2> run b"
 ListItem "3> close"
 ListItem "closed"
)");
        const QAccessibleInterface& second = *list.child(1);
        EXPECT_TRUE(second.state().selected);
        EXPECT_TRUE(second.state().focused);
        EXPECT_FALSE(list.child(2)->state().selected);
        EXPECT_EQ(list.focusChild(), &second);
        EXPECT_EQ(list.childAt(second.rect().center().x(), second.rect().center().y()), &second);
        EXPECT_EQ(second.parent(), &list);
        EXPECT_EQ(list.indexOfChild(&second), 1);
        control.SetCaretIndex(3);
        EXPECT_EQ(list.focusChild()->text(QAccessible::Name), "3> close");
        list.child(4)->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
        EXPECT_EQ(selected(), Lines{4});
        QAccessibleInterface* last = list.child(4);
        control.DeleteString(4);
        EXPECT_FALSE(last->isValid());
        EXPECT_TRUE(last->text(QAccessible::Name).isEmpty());
        EXPECT_EQ(list.childCount(), 4);
    });
}
