#include "platform/afx/controls/detail/HotKeyWindow.h"

#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/KeyTable.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/OwnText.h"
#include "platform/win/FrameworkIds.h"

#include <QGuiApplication>
#include <QLineEdit>
#include <QMouseEvent>

namespace tvx::afx {

namespace {

/// A line of text for what assistive tools know of fields: a label names it, its value is what it shows. Nothing in it
/// can be selected or composed.
class HotKeyFace : public QLineEdit {
public:
    explicit HotKeyFace(QWidget* parent) : QLineEdit(parent) {
        setReadOnly(true);
        setAttribute(Qt::WA_InputMethodEnabled, false);
        setCursor(Qt::ArrowCursor);
    }

protected:
    void mousePressEvent(QMouseEvent* event) override {
        event->accept();
    }
    void mouseMoveEvent(QMouseEvent* event) override {
        event->accept();
    }
    void mouseDoubleClickEvent(QMouseEvent* event) override {
        event->accept();
    }
};

std::unique_ptr<Window> makeHotKey(const CREATESTRUCT& cs) {
    return std::make_unique<HotKeyWindow>(cs);
}

const WindowClassEntry hotKeyEntry("msctls_hotkey32", &makeHotKey);

bool isModifier(int key) {
    return key == VK_SHIFT || key == VK_CONTROL || key == VK_MENU || key == VK_RMENU;
}

/// Keys that do something by themselves wherever they are pressed.
bool isDesktopKey(int key) {
    return key == VK_LWIN || key == VK_RWIN || key == VK_CAPITAL || key == VK_NUMLOCK;
}

int flagsOf(const HeldModifiers& held) {
    return (held.shift ? HOTKEYF_SHIFT : 0) | (held.control ? HOTKEYF_CONTROL : 0) | (held.alt ? HOTKEYF_ALT : 0);
}

/// "Ctrl+Shift+": in the order in which the library names them.
QString modifierNames(int modifiers) {
    QString names;
    for (const auto& [flag, key] : {std::pair(HOTKEYF_CONTROL, VK_CONTROL), std::pair(HOTKEYF_ALT, VK_MENU),
                                    std::pair(HOTKEYF_SHIFT, VK_SHIFT)}) {
        if ((modifiers & flag) != 0) {
            names += keyName(key) + QLatin1Char('+');
        }
    }
    return names;
}

/// The bit that names a combination of modifiers.
int combinationBit(int modifiers) {
    switch (modifiers & (HOTKEYF_SHIFT | HOTKEYF_CONTROL | HOTKEYF_ALT)) {
    case 0:
        return HKCOMB_NONE;
    case HOTKEYF_SHIFT:
        return HKCOMB_S;
    case HOTKEYF_CONTROL:
        return HKCOMB_C;
    case HOTKEYF_ALT:
        return HKCOMB_A;
    case HOTKEYF_SHIFT | HOTKEYF_CONTROL:
        return HKCOMB_SC;
    case HOTKEYF_SHIFT | HOTKEYF_ALT:
        return HKCOMB_SA;
    case HOTKEYF_CONTROL | HOTKEYF_ALT:
        return HKCOMB_CA;
    default:
        return HKCOMB_SCA;
    }
}

} // namespace

QWidget* HotKeyWindow::makeWidget(QWidget* parent) {
    return new HotKeyFace(parent);
}

void HotKeyWindow::widgetMade() {
    Control::widgetMade();
    show();
}

UINT HotKeyWindow::dialogCode(const MSG*) const {
    return DLGC_WANTALLKEYS | DLGC_WANTCHARS | DLGC_WANTARROWS | DLGC_WANTTAB;
}

void HotKeyWindow::applyColors(QPalette& palette, const QColor& text, const QColor& background) const {
    applyFieldColors(palette, text, background);
}

void HotKeyWindow::focusMoved(bool got) {
    m_awaits = false;
    show();
    // The window manager keeps keys for itself, Alt+F4 among them, unless somebody has the whole keyboard.
    if (QGuiApplication::platformName() == QLatin1String("xcb")) {
        guarded([&] { got ? widget()->grabKeyboard() : widget()->releaseKeyboard(); });
    }
}

void HotKeyWindow::show() {
    QString shown;
    if (m_awaits) {
        shown = modifierNames(flagsOf(modifiersHeld()));
    } else if (m_hotKey.key != 0) {
        shown = modifierNames(m_hotKey.modifiers) + keyName(m_hotKey.key);
    } else {
        shown = ownText(TVX_IDS_NO_KEY);
    }
    guarded([&] { static_cast<QLineEdit*>(widget())->setText(shown); });
}

HotKeyWindow::HotKey HotKeyWindow::byRules(HotKey typed) const {
    const bool invalid = (combinationBit(typed.modifiers) & m_invalid) != 0;
    return {typed.key, invalid ? typed.modifiers | m_added : typed.modifiers};
}

void HotKeyWindow::pressed(int key, LPARAM parameter) {
    // A key that was down before belongs to whoever had the keyboard then.
    const bool repeated = (parameter & (LPARAM{1} << 30)) != 0;
    if (key == 0 || repeated || isDesktopKey(key)) {
        return;
    }
    m_awaits = isModifier(key);
    const auto held = acceleratorModifiers(key);
    const bool isTyped = !m_awaits && held;
    if (isTyped) {
        const bool extended = (parameter & (LPARAM{1} << 24)) != 0;
        m_hotKey = byRules({key, flagsOf(*held) | (extended ? HOTKEYF_EXT : 0)});
    }
    show();
    if (isTyped) {
        notify(EN_CHANGE);
    }
}

void HotKeyWindow::released() {
    if (m_awaits) {
        m_awaits = flagsOf(modifiersHeld()) != 0;
        show();
    }
}

LRESULT HotKeyWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_KEYDOWN:
    case WM_SYSKEYDOWN:
        pressed(static_cast<int>(wParam), lParam);
        return 0;
    case WM_KEYUP:
    case WM_SYSKEYUP:
        released();
        return 0;
    case WM_CHAR:
    case WM_SYSCHAR:
    case WM_CONTEXTMENU:
        return 0;
    case HKM_SETHOTKEY:
        m_hotKey = {static_cast<int>(wParam & 0xFF), static_cast<int>(wParam >> 8 & 0xFF)};
        m_awaits = false;
        show();
        return 0;
    case HKM_GETHOTKEY:
        return m_hotKey.key | m_hotKey.modifiers << 8;
    case HKM_SETRULES:
        m_invalid = static_cast<int>(wParam);
        m_added = LOWORD(static_cast<DWORD>(lParam));
        return 0;
    default:
        return Control::defaultProc(message, wParam, lParam);
    }
}

} // namespace tvx::afx
