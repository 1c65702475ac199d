#include "platform/afx/core/detail/Keys.h"

#include "platform/afx/core/Message.h"
#include "platform/afx/core/detail/KeyLayout.h"
#include "platform/afx/core/detail/KeyTable.h"
#include "platform/win/Display.h"

#include <QGuiApplication>

#include <algorithm>
#include <array>
#include <bitset>
#include <optional>

namespace tvx::afx {

namespace {

/// Characters of the shifted digit keys of the usual layout.
constexpr std::array<int, 10> shiftedDigits{
    Qt::Key_ParenRight, Qt::Key_Exclam,      Qt::Key_At,        Qt::Key_NumberSign, Qt::Key_Dollar,
    Qt::Key_Percent,    Qt::Key_AsciiCircum, Qt::Key_Ampersand, Qt::Key_Asterisk,   Qt::Key_ParenLeft};

// What the display calls keys that the toolkit has no number for, or another one's.
constexpr quint32 metaLeft = 0xFFE7;
constexpr quint32 metaRight = 0xFFE8;
constexpr quint32 breakKey = 0xFF6B;
/// The key code of the keypad's second sign between digits, which few keyboards have.
constexpr quint32 separatorKey = 129;
/// Key codes of F13 to F18, which the display takes for keys that start programs.
constexpr quint32 firstLaunchKey = 191;
constexpr quint32 lastLaunchKey = 196;

int keypadKey(const QKeyEvent& event) {
    if (!event.modifiers().testFlag(Qt::KeypadModifier)) {
        return 0;
    }
    if (event.nativeScanCode() == separatorKey) {
        return VK_SEPARATOR;
    }
    return event.key() == Qt::Key_Comma ? VK_DECIMAL : keypadKeyOf(event.key());
}

/// Keys that type no character, and the blank.
int functionKey(const QKeyEvent& event) {
    switch (event.nativeVirtualKey()) {
    case metaLeft:
    case metaRight:
        return VK_MENU; // Alt that was pressed after Shift
    case breakKey:
        return VK_CANCEL;
    default:
        break;
    }
    const int known = virtualKeyOf(event.key());
    if (known == 0 && event.nativeScanCode() >= firstLaunchKey && event.nativeScanCode() <= lastLaunchKey) {
        return VK_F13 + static_cast<int>(event.nativeScanCode() - firstLaunchKey);
    }
    return isCharacterKey(known) && known != VK_SPACE ? 0 : known;
}

/// By what the key types with the modifiers that are held, where the layout is not known.
int characterKey(const QKeyEvent& event) {
    const int key = event.key();
    const int known = virtualKeyOf(key);
    const int place = characterKeyAt(event.nativeScanCode());
    // A key of the digits' row is its digit, whatever it types.
    if (place >= '0' && place <= '9' && (known < '0' || known > '9')) {
        return place;
    }
    const auto digit = std::find(shiftedDigits.begin(), shiftedDigits.end(), key);
    if (digit != shiftedDigits.end() && event.modifiers().testFlag(Qt::ShiftModifier)) {
        return '0' + static_cast<int>(digit - shiftedDigits.begin());
    }
    // On the layouts of other scripts letters are known by their place, so that Ctrl+C is where it was.
    return known != 0 ? known : place;
}

/// The lock keys as they were when somebody asked last; empty since the keyboard was used again.
std::optional<KeyLocks> knownLocks;

struct KeyTime {
    int key = 0; ///< by place, since what it types changes with the modifiers
    quint64 time = 0;
    bool operator==(const KeyTime&) const = default;
};
KeyTime timeOf(const QKeyEvent& event) {
    const auto place = static_cast<int>(event.nativeScanCode());
    return {place != 0 ? place : event.key(), event.timestamp()};
}
KeyTime lastRelease; ///< nothing when it came with its press, as programs send keys
KeyTime lastPress;
int pressedLast = 0; ///< its virtual key

std::bitset<256>& keysDown() {
    static std::bitset<256> keys;
    return keys;
}

} // namespace

int virtualKey(const QKeyEvent& event) {
    const KeyLayout* layout = event.nativeScanCode() != 0 ? layoutOf(event.nativeModifiers()) : nullptr;
    if (const int pad = keypadKey(event)) {
        return pad;
    }
    if (const int function = functionKey(event)) {
        return function;
    }
    // By place, since the display tells of the sign that the modifiers make, and of another one when they go first.
    const int placed = layout ? layout->virtualKey(event.nativeScanCode()) : 0;
    return placed != 0 ? placed : characterKey(event);
}

LPARAM keyParameter(const QKeyEvent& event, bool released) {
    const int key = virtualKey(event);
    const bool keypad = event.modifiers().testFlag(Qt::KeypadModifier);
    const int scanCode = scanCodeOf(key) & (keypad ? 0xFF : 0x1FF);
    DWORD value = 1U | (static_cast<DWORD>(scanCode) << 16);
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
    pressedLast = down ? virtualKey : pressedLast;
    if (virtualKey > 0 && virtualKey < 256) {
        keysDown().set(static_cast<std::size_t>(virtualKey), down);
    }
}

// A held key comes as releases and presses of the same time. The toolkit calls a press repeated when it finds it in its
// queue behind the release, which is chance in an application that waits for events.
bool isRepeated(const QKeyEvent& event) {
    const KeyTime now = timeOf(event);
    return event.isAutoRepeat() || (now.time != 0 && now == lastRelease);
}

void noteTime(const QKeyEvent& event) {
    const KeyTime now = timeOf(event);
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

char32_t pressedLetter() {
    if (!isKeyDown(pressedLast)) {
        return 0;
    }
    const bool letter = pressedLast >= 'A' && pressedLast <= 'Z';
    const bool digit = pressedLast >= '0' && pressedLast <= '9';
    return letter ? static_cast<char32_t>(pressedLast - 'A') + U'a' : digit ? static_cast<char32_t>(pressedLast) : 0;
}

HeldModifiers modifiersHeld() {
    const bool altGr = isKeyDown(VK_RMENU);
    return {isKeyDown(VK_SHIFT), altGr || isKeyDown(VK_CONTROL), altGr || isKeyDown(VK_MENU)};
}

std::optional<HeldModifiers> acceleratorModifiers(int virtualKey) {
    const bool types = isKeyDown(VK_RMENU) && isCharacterKey(virtualKey);
    return types ? std::nullopt : std::optional(modifiersHeld());
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
