#include "platform/afx/core/Clipboard.h"
#include "tests/ui/afx/controls/ControlTesting.h"

#include <QClipboard>
#include <QDropEvent>
#include <QLineEdit>
#include <QMenu>
#include <QMimeData>

namespace {

constexpr UINT watched[] = {WM_CUT, WM_COPY, WM_PASTE, WM_CLEAR, WM_UNDO, EM_SETSEL, CB_SETEDITSEL};

/// Notes the messages for clipboard work, and may take the pastes itself.
template <class Base>
class Watching : public Base {
public:
    std::vector<UINT> seen;
    bool takesPastes = false;
    std::string pasted; ///< What the clipboard held while a paste was taken.

    /// The messages since the last call.
    std::vector<UINT> taken() {
        return std::exchange(seen, {});
    }

protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (std::find(std::begin(watched), std::end(watched), message) != std::end(watched)) {
            seen.push_back(message);
        }
        if (message != WM_PASTE || !takesPastes) {
            return Base::WindowProc(message, wParam, lParam);
        }
        EXPECT_TRUE(OpenClipboard(nullptr));
        EXPECT_TRUE(IsClipboardFormatAvailable(CF_TEXT));
        pasted = static_cast<const char*>(GlobalLock(GetClipboardData(CF_TEXT)));
        CloseClipboard();
        return 0;
    }
};

template <class Base>
class FieldTest : public ControlTest<Watching<Base>> {
protected:
    using ControlTest<Watching<Base>>::control;
    using ControlTest<Watching<Base>>::dialog;

    /// What is typed into: the widget that drops come to.
    QWidget* field() const {
        QWidget* peer = tvx::afx::peerOf(control.m_hWnd);
        auto* line = peer->findChild<QLineEdit*>();
        return line ? line : peer;
    }
    void drop(const QString& text, QPoint at, QObject* source = nullptr) const {
        QMimeData data;
        data.setText(text);
        QDragEnterEvent enter(at, Qt::CopyAction | Qt::MoveAction, &data, Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(field(), &enter);
        QDropEvent dropped(at, Qt::CopyAction | Qt::MoveAction, &data, Qt::LeftButton, Qt::NoModifier);
        dropped.setDropAction(Qt::MoveAction);
        QCoreApplication::sendEvent(field(), &dropped);
    }
    /// Asks for the menu by `ask` and acts on it. Answers what its items say, disabled ones in brackets.
    std::vector<std::string> menu(const std::function<void()>& ask, const std::function<void(QMenu&)>& act) const {
        std::vector<std::string> items;
        QTimer timer;
        QObject::connect(&timer, &QTimer::timeout, &timer, [&] {
            auto* open = qobject_cast<QMenu*>(QApplication::activePopupWidget());
            if (!open) {
                return;
            }
            timer.stop();
            for (const QAction* action : open->actions()) {
                const std::string text = action->text().toStdString();
                items.push_back(action->isEnabled() || action->isSeparator() ? text : "(" + text + ")");
            }
            act(*open);
            open->close();
        });
        timer.start(0);
        ask();
        // The display of these tests gives the keyboard to a menu, but not back.
        tvx::afx::peerOf(dialog.m_hWnd)->activateWindow();
        EXPECT_TRUE(waitForActive(dialog));
        return items;
    }
    void make(DWORD style) override {
        ASSERT_TRUE(control.Create(shown | WS_BORDER | style, this->place, &dialog, controlId));
    }
};

void choose(QMenu& menu, Qt::Key key) {
    QTest::keyClick(&menu, key);
}

using EditClipboard = FieldTest<CEdit>;
using ComboClipboard = FieldTest<CComboBox>;

struct Act {
    const char* name;
    Qt::Key key;
    Qt::KeyboardModifiers modifiers;
    UINT message;
};

constexpr Act acts[] = {
    {"Ctrl+X", Qt::Key_X, Qt::ControlModifier, WM_CUT},
    {"Ctrl+Z", Qt::Key_Z, Qt::ControlModifier, WM_UNDO},
    {"Shift+Delete", Qt::Key_Delete, Qt::ShiftModifier, WM_CUT},
    {"Alt+Backspace", Qt::Key_Backspace, Qt::AltModifier, WM_UNDO},
    {"Ctrl+C", Qt::Key_C, Qt::ControlModifier, WM_COPY},
    {"Ctrl+Insert", Qt::Key_Insert, Qt::ControlModifier, WM_COPY},
    {"Ctrl+V", Qt::Key_V, Qt::ControlModifier, WM_PASTE},
    {"Shift+Insert", Qt::Key_Insert, Qt::ShiftModifier, WM_PASTE},
};

} // namespace

TEST_F(EditClipboard, KeysAskByMessages) {
    for (const DWORD style : {DWORD{ES_AUTOHSCROLL}, DWORD{ES_MULTILINE | ES_AUTOHSCROLL}}) {
        with(style, [&] {
            type("text");
            QApplication::clipboard()->setText("pasted");
            for (const auto& [name, pressed, modifiers, message] : acts) {
                control.SetSel(0, 2);
                control.taken();
                key(pressed, modifiers);
                EXPECT_EQ(control.taken(), std::vector<UINT>{message}) << name;
            }
            control.SetWindowText("whole");
            control.taken();
            key(Qt::Key_A, Qt::ControlModifier);
            EXPECT_EQ(control.taken(), std::vector<UINT>{EM_SETSEL});
            key(Qt::Key_X, Qt::ControlModifier);
            EXPECT_EQ(textOf(&control), "");
            // Undone as far as it goes, and not back again; what was undone can be done again.
            for (int i = 0; i < 3; ++i) {
                key(Qt::Key_Z, Qt::ControlModifier);
            }
            EXPECT_EQ(textOf(&control), "whole");
            key(Qt::Key_Y, Qt::ControlModifier);
            EXPECT_EQ(textOf(&control), "");
            control.Undo();
            control.Undo();
            EXPECT_EQ(textOf(&control), "") << "hosts' undo goes both ways";
        });
    }
}

TEST_F(ComboClipboard, KeysAskByMessages) {
    with(CBS_DROPDOWN | CBS_AUTOHSCROLL, [&] {
        type("text");
        for (const auto& [name, pressed, modifiers, message] : acts) {
            control.SetEditSel(0, 2);
            control.taken();
            key(pressed, modifiers);
            EXPECT_EQ(control.taken(), std::vector<UINT>{message}) << name;
        }
        QApplication::clipboard()->setText("one\r\ntwo");
        key(Qt::Key_A, Qt::ControlModifier);
        const int changes = told(CBN_EDITCHANGE);
        key(Qt::Key_V, Qt::ControlModifier);
        EXPECT_EQ(textOf(&control), "one") << "a field of one line takes one";
        EXPECT_EQ(told(CBN_EDITCHANGE), changes + 1);
        drop("2\n3", {field()->width() - 3, 5});
        EXPECT_EQ(textOf(&control), "one2");
        const auto items =
            menu([&] { key(Qt::Key_F10, Qt::ShiftModifier); }, [](QMenu& open) { choose(open, Qt::Key_A); });
        EXPECT_EQ(items.size(), 8U);
        EXPECT_EQ(control.GetEditSel(), static_cast<DWORD>(MAKELONG(0, 4)));
    });
    with(CBS_DROPDOWNLIST, [&] {
        control.SendMessage(WM_CONTEXTMENU, reinterpret_cast<WPARAM>(control.m_hWnd), MAKELPARAM(5, 5));
        EXPECT_EQ(QApplication::activePopupWidget(), nullptr) << "nothing to edit";
    });
}

TEST_F(EditClipboard, HostsGetEveryPaste) {
    for (const DWORD style : {DWORD{ES_AUTOHSCROLL}, DWORD{ES_MULTILINE | ES_AUTOHSCROLL}}) {
        with(style, [&] {
            control.SetWindowText("kept");
            control.takesPastes = true;
            QApplication::clipboard()->setText("clipboard's");
            key(Qt::Key_V, Qt::ControlModifier);
            EXPECT_EQ(std::exchange(control.pasted, ""), "clipboard's");
            drop("dropped", {2, 5});
            EXPECT_EQ(std::exchange(control.pasted, ""), "dropped") << "the host finds it in the clipboard";
            menu([&] { key(Qt::Key_F10, Qt::ShiftModifier); }, [](QMenu& open) { choose(open, Qt::Key_P); });
            EXPECT_EQ(std::exchange(control.pasted, ""), "clipboard's");
            // One that does not insert what was moved within the field keeps it.
            control.SetSel(0, 2);
            drop("ke", {190, 5}, field());
            EXPECT_EQ(textOf(&control), "kept");
            EXPECT_EQ(std::exchange(control.pasted, ""), "ke");
            control.SetReadOnly();
            key(Qt::Key_V, Qt::ControlModifier);
            drop("dropped", {2, 5});
            EXPECT_EQ(control.pasted, "") << "nothing is pasted into what cannot be typed into";
        });
        control.takesPastes = false;
    }
}

TEST_F(EditClipboard, DropsKeepTheRulesOfPastes) {
    struct Case {
        DWORD style;
        const char* dropped;
        const char* expected;
    };
    for (const auto& [style, dropped, expected] :
         {Case{0, "one\ntwo", "one12"}, Case{ES_NUMBER, "a3b4", "3412"}, Case{ES_UPPERCASE, "ab", "AB12"},
          Case{0, "abcdefgh", "abcdef12"}, Case{ES_MULTILINE, "a\nb", "a\r\nb12"}, Case{ES_PASSWORD, "ab", "ab12"}}) {
        with(style | ES_AUTOHSCROLL, [&] {
            control.SetWindowText("12");
            control.SetLimitText(8);
            drop(dropped, {1, 5});
            EXPECT_EQ(textOf(&control), expected);
        });
    }
}

TEST_F(EditClipboard, SecretsAreNotCopied) {
    with(ES_PASSWORD | ES_AUTOHSCROLL, [&] {
        type("secret");
        QApplication::clipboard()->setText("before");
        for (const Qt::Key pressed : {Qt::Key_C, Qt::Key_X, Qt::Key_Insert}) {
            control.SetSel(0, -1);
            key(pressed, Qt::ControlModifier);
        }
        EXPECT_EQ(textOf(&control), "secret");
        EXPECT_EQ(QApplication::clipboard()->text(), "before");
        const auto items = menu([&] { key(Qt::Key_F10, Qt::ShiftModifier); }, [](QMenu& open) {});
        EXPECT_EQ(items, (std::vector<std::string>{"&Undo", "", "(Cu&t)", "(&Copy)", "&Paste", "&Delete", "",
                                                   "(Select &All)"}));
    });
}

TEST_F(EditClipboard, MenuDoesWhatIsPossible) {
    for (const DWORD style : {DWORD{ES_AUTOHSCROLL}, DWORD{ES_MULTILINE | ES_AUTOHSCROLL}}) {
        with(style, [&] {
            QApplication::clipboard()->clear();
            control.SetWindowText("abc");
            const auto byKey = [] { key(Qt::Key_F10, Qt::ShiftModifier); };
            QPoint at;
            control.SetSel(3, 3);
            auto items = menu(byKey, [&](QMenu& open) {
                at = open.pos() - tvx::afx::peerOf(control.m_hWnd)->mapToGlobal(QPoint(0, 0));
                choose(open, Qt::Key_A);
            });
            EXPECT_EQ(items, (std::vector<std::string>{"(&Undo)", "", "(Cu&t)", "(&Copy)", "(&Paste)", "(&Delete)", "",
                                                       "Select &All"}));
            EXPECT_GT(at.x(), 10) << "at the caret";
            EXPECT_LT(at.x(), 60);
            menu(byKey, [](QMenu& open) { choose(open, Qt::Key_C); });
            EXPECT_EQ(QApplication::clipboard()->text(), "abc");
            control.taken();
            items = menu([&] { click(&control, {100, 8}, Qt::NoModifier, Qt::RightButton); },
                         [](QMenu& open) { choose(open, Qt::Key_D); });
            EXPECT_EQ(items[7], "(Select &All)") << "the right button leaves the selection";
            EXPECT_EQ(control.taken(), std::vector<UINT>{WM_CLEAR});
            EXPECT_EQ(textOf(&control), "");
            menu(byKey, [](QMenu& open) { choose(open, Qt::Key_U); });
            EXPECT_EQ(textOf(&control), "abc");
            EXPECT_EQ(told(EN_CHANGE), style == ES_AUTOHSCROLL ? 3 : 2);
        });
    }
}

TEST_F(EditClipboard, ParentsAreAskedForAMenuFirst) {
    class Parent : public ScriptedDialog {
    public:
        using ScriptedDialog::ScriptedDialog;
        std::vector<HWND> asked;

    protected:
        LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
            if (message == WM_CONTEXTMENU) {
                asked.push_back(reinterpret_cast<HWND>(wParam));
                return 0;
            }
            return ScriptedDialog::WindowProc(message, wParam, lParam);
        }
    } parent(IDD_EMPTY);
    parent.prepare = [&] { ASSERT_TRUE(control.Create(shown, place, &parent, controlId)); };
    parent.script = [&] {
        click(&control, {20, 10}, Qt::NoModifier, Qt::RightButton);
        EXPECT_EQ(parent.asked, std::vector<HWND>{control.m_hWnd});
        EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
    };
    EXPECT_EQ(parent.DoModal(), ScriptedDialog::scriptDone);
}
