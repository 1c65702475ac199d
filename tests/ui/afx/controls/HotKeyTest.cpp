#include "platform/afx/controls/HotKey.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <QAccessible>
#include <QContextMenuEvent>
#include <QLineEdit>

namespace {

/// A dialog with a hot-key control behind a label, which counts what it should never hear of.
class HotKeyDialog : public ScriptedDialog {
public:
    HotKeyDialog() : ScriptedDialog(IDD_HOT_KEY) {
        prepare = [this] { GetDlgItem(IDC_HOT_KEY)->SetFocus(); };
    }
    std::string shown() const {
        return field()->text().toStdString();
    }
    QLineEdit* field() const {
        return qobject_cast<QLineEdit*>(tvx::afx::peerOf(hotKey.m_hWnd));
    }
    std::pair<int, int> typed() const {
        WORD virtualKey = 0;
        WORD modifiers = 0;
        hotKey.GetHotKey(virtualKey, modifiers);
        return {virtualKey, modifiers};
    }
    CHotKeyCtrl hotKey;
    int strays = 0;

protected:
    void DoDataExchange(CDataExchange* dx) override {
        CDialog::DoDataExchange(dx);
        DDX_Control(dx, IDC_HOT_KEY, hotKey);
    }
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        strays += message == WM_CONTEXTMENU || message == WM_HELP || message == WM_SYSCOMMAND ? 1 : 0;
        return ScriptedDialog::WindowProc(message, wParam, lParam);
    }
};

/// Presses a key of any kind where the keyboard is; those with a sign type it.
void press(Qt::Key key, Qt::KeyboardModifiers modifiers) {
    const QString text = key < Qt::Key_Escape ? QString(QChar(key)) : QString();
    QTest::sendKeyEvent(QTest::Click, QApplication::focusWidget(), key, text, modifiers);
}

TEST(HotKey, TakesEveryKey) {
    struct Typed {
        Qt::Key key;
        Qt::KeyboardModifiers modifiers;
        int virtualKey;
        int flags;
        const char* name;
    };
    const auto control = Qt::ControlModifier;
    const auto alt = Qt::AltModifier;
    const auto shift = Qt::ShiftModifier;
    const Typed table[] = {
        {Qt::Key_Tab, Qt::NoModifier, VK_TAB, 0, "Tab"},
        {Qt::Key_Backtab, shift, VK_TAB, HOTKEYF_SHIFT, "Shift+Tab"},
        {Qt::Key_Return, Qt::NoModifier, VK_RETURN, 0, "Enter"},
        {Qt::Key_Escape, Qt::NoModifier, VK_ESCAPE, 0, "Esc"},
        {Qt::Key_Space, Qt::NoModifier, VK_SPACE, 0, "Space"},
        {Qt::Key_Backspace, alt, VK_BACK, HOTKEYF_ALT, "Alt+Backspace"},
        {Qt::Key_Delete, Qt::NoModifier, VK_DELETE, HOTKEYF_EXT, "Delete"},
        {Qt::Key_Left, alt, VK_LEFT, HOTKEYF_ALT | HOTKEYF_EXT, "Alt+Left"},
        {Qt::Key_A, Qt::NoModifier, 'A', 0, "A"},
        {Qt::Key_D, alt, 'D', HOTKEYF_ALT, "Alt+D"}, // the access key of a button
        {Qt::Key_O, control, 'O', HOTKEYF_CONTROL, "Ctrl+O"},
        {Qt::Key_F1, Qt::NoModifier, VK_F1, 0, "F1"},
        {Qt::Key_F4, alt, VK_F4, HOTKEYF_ALT, "Alt+F4"},
        {Qt::Key_F10, Qt::NoModifier, VK_F10, 0, "F10"},
        {Qt::Key_F10, shift, VK_F10, HOTKEYF_SHIFT, "Shift+F10"},
        {Qt::Key_Plus, control | shift, VK_OEM_PLUS, HOTKEYF_CONTROL | HOTKEYF_SHIFT, "Ctrl+Shift+="},
        {Qt::Key_4, Qt::KeypadModifier, VK_NUMPAD4, 0, "Num 4"},
        {Qt::Key_Home, Qt::KeypadModifier, VK_HOME, 0, "Home"},
        {Qt::Key_Plus, control | Qt::KeypadModifier, VK_ADD, HOTKEYF_CONTROL, "Ctrl+Num +"},
        {Qt::Key_VolumeUp, Qt::NoModifier, VK_VOLUME_UP, 0, "Volume Up"},
        {Qt::Key_F5, control | alt | shift, VK_F5, HOTKEYF_CONTROL | HOTKEYF_ALT | HOTKEYF_SHIFT, "Ctrl+Alt+Shift+F5"},
    };
    HotKeyDialog dialog;
    dialog.script = [&] {
        EXPECT_EQ(dialog.shown(), "None");
        for (const Typed& typed : table) {
            dialog.commands.clear();
            press(typed.key, typed.modifiers);
            EXPECT_EQ(dialog.typed(), std::pair(typed.virtualKey, typed.flags)) << typed.name;
            EXPECT_EQ(dialog.shown(), typed.name);
            EXPECT_EQ(dialog.commands, (std::vector{std::pair(IDC_HOT_KEY, EN_CHANGE)})) << typed.name;
        }
        // Keys that do their work wherever they are pressed are none to be kept.
        for (const Qt::Key key : {Qt::Key_Super_L, Qt::Key_NumLock, Qt::Key_CapsLock, Qt::Key_unknown}) {
            press(key, Qt::NoModifier);
        }
        press(Qt::Key_Alt, alt);
        EXPECT_EQ(dialog.shown(), "Ctrl+Alt+Shift+F5");
        QContextMenuEvent menu(QContextMenuEvent::Keyboard, QPoint(5, 5), QPoint(5, 5));
        QSpontaneKeyEvent::setSpontaneous(&menu);
        QApplication::instance()->notify(dialog.field(), &menu);
        EXPECT_EQ(dialog.strays, 0);
        EXPECT_EQ(dialog.focus(), IDC_HOT_KEY);
        const QAccessibleInterface* told = QAccessible::queryAccessibleInterface(dialog.field());
        EXPECT_EQ(told->text(QAccessible::Name), "Key:");
        EXPECT_EQ(told->text(QAccessible::Value), "Ctrl+Alt+Shift+F5");
        // The way out.
        click(dialog.GetDlgItem(IDC_APPLY));
        EXPECT_EQ(dialog.codes(IDC_APPLY, BN_CLICKED), 1);
        key(Qt::Key_Escape);
        EXPECT_EQ(dialog.codes(IDCANCEL, BN_CLICKED), 1);
    };
    EXPECT_EQ(dialog.DoModal(), IDCANCEL);
}

TEST(HotKey, ShowsWhatIsHeld) {
    HotKeyDialog dialog;
    dialog.script = [&] {
        dialog.hotKey.SetHotKey('K', HOTKEYF_CONTROL);
        EXPECT_EQ(dialog.hotKey.GetHotKey(), 0x24BU);
        QWidget* field = dialog.field();
        const auto act = [&](QTest::KeyAction action, Qt::Key key) {
            QTest::sendKeyEvent(action, field, key, QString(), Qt::NoModifier);
        };
        act(QTest::Press, Qt::Key_Shift);
        EXPECT_EQ(dialog.shown(), "Shift+");
        act(QTest::Press, Qt::Key_Control);
        EXPECT_EQ(dialog.shown(), "Ctrl+Shift+");
        act(QTest::Release, Qt::Key_Shift);
        EXPECT_EQ(dialog.shown(), "Ctrl+");
        act(QTest::Release, Qt::Key_Control);
        EXPECT_EQ(dialog.shown(), "Ctrl+K");
        EXPECT_EQ(dialog.codes(IDC_HOT_KEY, EN_CHANGE), 0);

        // A key that was pressed elsewhere and is still held is not meant.
        QKeyEvent held(QEvent::KeyPress, Qt::Key_Return, Qt::NoModifier, "\r", true);
        QSpontaneKeyEvent::setSpontaneous(&held);
        QApplication::instance()->notify(field, &held);
        EXPECT_EQ(dialog.shown(), "Ctrl+K");

        // With AltGr keys type characters, which are none of a command.
        act(QTest::Press, Qt::Key_AltGr);
        QTest::sendKeyEvent(QTest::Click, field, Qt::Key_Q, QStringLiteral("@"), Qt::GroupSwitchModifier);
        act(QTest::Release, Qt::Key_AltGr);
        EXPECT_EQ(dialog.shown(), "Ctrl+K");
    };
    EXPECT_EQ(dialog.DoModal(), ScriptedDialog::scriptDone);
}

TEST(HotKey, AddsModifiersByItsRules) {
    HotKeyDialog dialog;
    dialog.script = [&] {
        dialog.hotKey.SetRules(HKCOMB_NONE | HKCOMB_S, HOTKEYF_CONTROL | HOTKEYF_ALT);
        key(Qt::Key_K);
        EXPECT_EQ(dialog.shown(), "Ctrl+Alt+K");
        key(Qt::Key_K, Qt::ShiftModifier);
        EXPECT_EQ(dialog.shown(), "Ctrl+Alt+Shift+K");
        key(Qt::Key_K, Qt::ControlModifier | Qt::ShiftModifier);
        EXPECT_EQ(dialog.shown(), "Ctrl+Shift+K");
    };
    EXPECT_EQ(dialog.DoModal(), ScriptedDialog::scriptDone);
}

} // namespace
