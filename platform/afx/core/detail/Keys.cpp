#include "platform/afx/core/detail/Keys.h"

#include "platform/afx/core/Message.h"
#include "platform/win/Display.h"

#include <QGuiApplication>

#include <algorithm>
#include <array>
#include <bitset>
#include <optional>

namespace tvx::afx {

namespace {

struct KeyPair {
    int key;
    int virtualKey;
};

constexpr std::array<KeyPair, 57> keyTable{{
    {Qt::Key_Escape, VK_ESCAPE},
    {Qt::Key_Tab, VK_TAB},
    {Qt::Key_Backtab, VK_TAB},
    {Qt::Key_Backspace, VK_BACK},
    {Qt::Key_Return, VK_RETURN},
    {Qt::Key_Enter, VK_RETURN},
    {Qt::Key_Insert, VK_INSERT},
    {Qt::Key_Delete, VK_DELETE},
    {Qt::Key_Pause, VK_PAUSE},
    {Qt::Key_Print, VK_SNAPSHOT},
    {Qt::Key_SysReq, VK_SNAPSHOT},
    {Qt::Key_Clear, VK_CLEAR},
    {Qt::Key_Home, VK_HOME},
    {Qt::Key_End, VK_END},
    {Qt::Key_Left, VK_LEFT},
    {Qt::Key_Up, VK_UP},
    {Qt::Key_Right, VK_RIGHT},
    {Qt::Key_Down, VK_DOWN},
    {Qt::Key_PageUp, VK_PRIOR},
    {Qt::Key_PageDown, VK_NEXT},
    {Qt::Key_Shift, VK_SHIFT},
    {Qt::Key_Control, VK_CONTROL},
    {Qt::Key_Alt, VK_MENU},
    {Qt::Key_AltGr, VK_MENU},
    {Qt::Key_Meta, VK_LWIN},
    {Qt::Key_Super_L, VK_LWIN},
    {Qt::Key_Super_R, VK_RWIN},
    {Qt::Key_Menu, VK_APPS},
    {Qt::Key_CapsLock, VK_CAPITAL},
    {Qt::Key_NumLock, VK_NUMLOCK},
    {Qt::Key_ScrollLock, VK_SCROLL},
    {Qt::Key_Help, VK_HELP},
    {Qt::Key_Space, VK_SPACE},
    {Qt::Key_Semicolon, VK_OEM_1},
    {Qt::Key_Colon, VK_OEM_1},
    {Qt::Key_Equal, VK_OEM_PLUS},
    {Qt::Key_Plus, VK_OEM_PLUS},
    {Qt::Key_Comma, VK_OEM_COMMA},
    {Qt::Key_Less, VK_OEM_COMMA},
    {Qt::Key_Minus, VK_OEM_MINUS},
    {Qt::Key_Underscore, VK_OEM_MINUS},
    {Qt::Key_Period, VK_OEM_PERIOD},
    {Qt::Key_Greater, VK_OEM_PERIOD},
    {Qt::Key_Slash, VK_OEM_2},
    {Qt::Key_Question, VK_OEM_2},
    {Qt::Key_QuoteLeft, VK_OEM_3},
    {Qt::Key_AsciiTilde, VK_OEM_3},
    {Qt::Key_BracketLeft, VK_OEM_4},
    {Qt::Key_BraceLeft, VK_OEM_4},
    {Qt::Key_Backslash, VK_OEM_5},
    {Qt::Key_Bar, VK_OEM_5},
    {Qt::Key_BracketRight, VK_OEM_6},
    {Qt::Key_BraceRight, VK_OEM_6},
    {Qt::Key_Apostrophe, VK_OEM_7},
    {Qt::Key_QuoteDbl, VK_OEM_7},
    {Qt::Key_Asterisk, VK_MULTIPLY},
    {Qt::Key_Cancel, VK_CANCEL},
}};

/// Characters of the shifted digit keys of the usual layout.
constexpr std::array<int, 10> shiftedDigits{
    Qt::Key_ParenRight, Qt::Key_Exclam,      Qt::Key_At,        Qt::Key_NumberSign, Qt::Key_Dollar,
    Qt::Key_Percent,    Qt::Key_AsciiCircum, Qt::Key_Ampersand, Qt::Key_Asterisk,   Qt::Key_ParenLeft};

/// X key codes of the letter keys (evdev numbering plus 8, the numbering of every current X server), by place.
int letterByScanCode(quint32 code) {
    constexpr const char* rows[] = {"QWERTYUIOP", "ASDFGHJKL", "ZXCVBNM"};
    constexpr quint32 first[] = {24, 38, 52};
    for (int row = 0; row < 3; ++row) {
        const std::string_view letters = rows[row];
        if (code >= first[row] && code < first[row] + letters.size()) {
            return letters[code - first[row]];
        }
    }
    return 0;
}

int keypadKey(int key) {
    if (key >= Qt::Key_0 && key <= Qt::Key_9) {
        return VK_NUMPAD0 + (key - Qt::Key_0);
    }
    switch (key) {
    case Qt::Key_Asterisk:
        return VK_MULTIPLY;
    case Qt::Key_Plus:
        return VK_ADD;
    case Qt::Key_Minus:
        return VK_SUBTRACT;
    case Qt::Key_Period:
    case Qt::Key_Comma:
        return VK_DECIMAL;
    case Qt::Key_Slash:
        return VK_DIVIDE;
    default:
        return 0;
    }
}

/// The lock keys as they were when somebody asked last; empty since the keyboard was used again.
std::optional<KeyLocks> knownLocks;

struct KeyTime {
    int key = 0;
    quint64 time = 0;
    bool operator==(const KeyTime&) const = default;
};
KeyTime lastRelease; ///< nothing when it came with its press, as programs send keys
KeyTime lastPress;

std::bitset<256>& keysDown() {
    static std::bitset<256> keys;
    return keys;
}

} // namespace

int virtualKey(const QKeyEvent& event) {
    const int key = event.key();
    if (event.modifiers().testFlag(Qt::KeypadModifier)) {
        if (const int pad = keypadKey(key); pad != 0) {
            return pad;
        }
    }
    if ((key >= Qt::Key_A && key <= Qt::Key_Z) || (key >= Qt::Key_0 && key <= Qt::Key_9)) {
        return key;
    }
    if (key >= Qt::Key_F1 && key <= Qt::Key_F24) {
        return VK_F1 + (key - Qt::Key_F1);
    }
    const auto digit = std::find(shiftedDigits.begin(), shiftedDigits.end(), key);
    if (digit != shiftedDigits.end() && event.modifiers().testFlag(Qt::ShiftModifier)) {
        return '0' + static_cast<int>(digit - shiftedDigits.begin());
    }
    const auto found = std::find_if(keyTable.begin(), keyTable.end(), [key](const KeyPair& p) { return p.key == key; });
    // On the layouts of other scripts letters are known by their place, so that Ctrl+C is where it was.
    return found != keyTable.end() ? found->virtualKey : letterByScanCode(event.nativeScanCode());
}

Qt::Key keyOf(int virtualKey) {
    if ((virtualKey >= 'A' && virtualKey <= 'Z') || (virtualKey >= '0' && virtualKey <= '9')) {
        return static_cast<Qt::Key>(virtualKey);
    }
    if (virtualKey >= VK_F1 && virtualKey <= VK_F24) {
        return static_cast<Qt::Key>(Qt::Key_F1 + (virtualKey - VK_F1));
    }
    if (virtualKey >= VK_NUMPAD0 && virtualKey <= VK_NUMPAD9) {
        return static_cast<Qt::Key>(Qt::Key_0 + (virtualKey - VK_NUMPAD0));
    }
    const auto found = std::find_if(keyTable.begin(), keyTable.end(),
                                    [virtualKey](const KeyPair& p) { return p.virtualKey == virtualKey; });
    return found != keyTable.end() ? static_cast<Qt::Key>(found->key) : Qt::Key_unknown;
}

LPARAM keyParameter(const QKeyEvent& event, bool released) {
    DWORD value = 1U | ((event.nativeScanCode() & 0xFFU) << 16);
    if (event.modifiers().testFlag(Qt::AltModifier)) {
        value |= 1U << 29;
    }
    if (released || isRepeated(event)) {
        value |= 1U << 30; // the key was down before
    }
    if (released) {
        value |= 1U << 31;
    }
    return static_cast<LPARAM>(value);
}

WPARAM buttonFlags(Qt::MouseButtons buttons, Qt::KeyboardModifiers modifiers) {
    WPARAM flags = 0;
    flags |= buttons.testFlag(Qt::LeftButton) ? MK_LBUTTON : 0;
    flags |= buttons.testFlag(Qt::RightButton) ? MK_RBUTTON : 0;
    flags |= buttons.testFlag(Qt::MiddleButton) ? MK_MBUTTON : 0;
    flags |= modifiers.testFlag(Qt::ShiftModifier) ? MK_SHIFT : 0;
    flags |= modifiers.testFlag(Qt::ControlModifier) ? MK_CONTROL : 0;
    return flags;
}

void noteKey(int virtualKey, bool down) {
    knownLocks.reset();
    if (virtualKey > 0 && virtualKey < 256) {
        keysDown().set(static_cast<std::size_t>(virtualKey), down);
    }
}

// A held key comes as releases and presses of the same time. The toolkit calls a press repeated when it finds it in its
// queue behind the release, which is chance in an application that waits for events.
bool isRepeated(const QKeyEvent& event) {
    const KeyTime now{event.key(), event.timestamp()};
    return event.isAutoRepeat() || (now.time != 0 && now == lastRelease);
}

void noteTime(const QKeyEvent& event) {
    const KeyTime now{event.key(), event.timestamp()};
    if (event.type() == QEvent::KeyPress) {
        lastPress = now;
    } else {
        lastRelease = now == lastPress ? KeyTime() : now;
    }
}

void forgetKeys() {
    knownLocks.reset();
    keysDown().reset();
}

bool isKeyDown(int virtualKey) {
    return virtualKey > 0 && virtualKey < 256 && keysDown().test(static_cast<std::size_t>(virtualKey));
}

bool isKeyLocked(int virtualKey) {
    if (!knownLocks) {
        const bool told = QGuiApplication::platformName() == QLatin1String("xcb");
        knownLocks = told ? keyLocks() : KeyLocks();
    }
    switch (virtualKey) {
    case VK_CAPITAL:
        return knownLocks->caps;
    case VK_NUMLOCK:
        return knownLocks->num;
    case VK_SCROLL:
        return knownLocks->scroll;
    default:
        return false;
    }
}

} // namespace tvx::afx
