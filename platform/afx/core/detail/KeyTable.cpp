#include "platform/afx/core/detail/KeyTable.h"

#include "platform/win/ResourceConstants.h"

#include <Qt>

#include <algorithm>
#include <span>
#include <string_view>
#include <vector>

namespace tvx::afx {

namespace {

struct KeyRow {
    int virtualKey;
    int scanCode;
    int key;           ///< the toolkit's, which is the character for keys that have a sign
    char16_t sign = 0; ///< where the toolkit's key of it is another one's
};

/// A stretch of keys that follow each other in each of the three numberings.
struct KeyRun {
    int virtualKey;
    int scanCode;
    int key;
    int count;
};

constexpr int ext = extendedKey;

// Scan codes are those that keyboards have always sent. Those from 0x80 up are our own: they stand for keys that share
// their code with another one, or have none.
constexpr KeyRow keyRows[] = {
    {VK_ESCAPE, 0x01, Qt::Key_Escape},
    {'0', 0x0B, Qt::Key_0},
    {VK_OEM_MINUS, 0x0C, Qt::Key_Minus},
    {VK_OEM_PLUS, 0x0D, Qt::Key_Equal},
    {VK_BACK, 0x0E, Qt::Key_Backspace},
    {VK_TAB, 0x0F, Qt::Key_Tab},
    {VK_OEM_4, 0x1A, Qt::Key_BracketLeft},
    {VK_OEM_6, 0x1B, Qt::Key_BracketRight},
    {VK_RETURN, 0x1C, Qt::Key_Return},
    {VK_CONTROL, 0x1D, Qt::Key_Control},
    {VK_OEM_1, 0x27, Qt::Key_Semicolon},
    {VK_OEM_7, 0x28, Qt::Key_Apostrophe},
    {VK_OEM_3, 0x29, Qt::Key_QuoteLeft},
    {VK_SHIFT, 0x2A, Qt::Key_Shift},
    {VK_OEM_5, 0x2B, Qt::Key_Backslash},
    {VK_OEM_COMMA, 0x33, Qt::Key_Comma},
    {VK_OEM_PERIOD, 0x34, Qt::Key_Period},
    {VK_OEM_2, 0x35, Qt::Key_Slash},
    {VK_MENU, 0x38, Qt::Key_Alt},
    {VK_RMENU, 0x89, Qt::Key_AltGr},
    {VK_SPACE, 0x39, Qt::Key_Space},
    {VK_CAPITAL, 0x3A, Qt::Key_CapsLock},
    {VK_NUMLOCK, 0x45, Qt::Key_NumLock},
    {VK_SCROLL, 0x46, Qt::Key_ScrollLock},
    {VK_HOME, 0x47 | ext, Qt::Key_Home},
    {VK_UP, 0x48 | ext, Qt::Key_Up},
    {VK_PRIOR, 0x49 | ext, Qt::Key_PageUp},
    {VK_LEFT, 0x4B | ext, Qt::Key_Left},
    {VK_RIGHT, 0x4D | ext, Qt::Key_Right},
    {VK_END, 0x4F | ext, Qt::Key_End},
    {VK_DOWN, 0x50 | ext, Qt::Key_Down},
    {VK_NEXT, 0x51 | ext, Qt::Key_PageDown},
    {VK_INSERT, 0x52 | ext, Qt::Key_Insert},
    {VK_DELETE, 0x53 | ext, Qt::Key_Delete},
    {VK_SNAPSHOT, 0x54, Qt::Key_Print},
    {VK_OEM_102, 0x56, 0, u'<'},
    {VK_LWIN, 0x5B, Qt::Key_Super_L},
    {VK_RWIN, 0x5C, Qt::Key_Super_R},
    {VK_APPS, 0x5D, Qt::Key_Menu},
    {VK_SLEEP, 0x5F, Qt::Key_Sleep},
    {VK_KANA, 0x70, Qt::Key_Hiragana_Katakana},
    {VK_OEM_8, 0x73, 0, u'!'},
    {VK_CONVERT, 0x79, Qt::Key_Henkan},
    {VK_NONCONVERT, 0x7B, Qt::Key_Muhenkan},
    {VK_CANCEL, 0x80, Qt::Key_Cancel},
    {VK_CLEAR, 0x81, Qt::Key_Clear},
    {VK_PAUSE, 0x82, Qt::Key_Pause},
    {VK_KANJI, 0x83, Qt::Key_Zenkaku_Hankaku},
    {VK_SELECT, 0x84, Qt::Key_Select},
    {VK_PRINT, 0x85, Qt::Key_Printer},
    {VK_EXECUTE, 0x86, Qt::Key_Execute},
    {VK_HELP, 0x87, Qt::Key_Help},
    {VK_BROWSER_BACK, 0xA6, Qt::Key_Back},
    {VK_BROWSER_FORWARD, 0xA7, Qt::Key_Forward},
    {VK_BROWSER_REFRESH, 0xA8, Qt::Key_Refresh},
    {VK_BROWSER_STOP, 0xA9, Qt::Key_Stop},
    {VK_BROWSER_SEARCH, 0xAA, Qt::Key_Search},
    {VK_BROWSER_FAVORITES, 0xAB, Qt::Key_Favorites},
    {VK_BROWSER_HOME, 0xAC, Qt::Key_HomePage},
    {VK_VOLUME_MUTE, 0xAD, Qt::Key_VolumeMute},
    {VK_VOLUME_DOWN, 0xAE, Qt::Key_VolumeDown},
    {VK_VOLUME_UP, 0xAF, Qt::Key_VolumeUp},
    {VK_MEDIA_NEXT_TRACK, 0xB0, Qt::Key_MediaNext},
    {VK_MEDIA_PREV_TRACK, 0xB1, Qt::Key_MediaPrevious},
    {VK_MEDIA_STOP, 0xB2, Qt::Key_MediaStop},
    {VK_MEDIA_PLAY_PAUSE, 0xB3, Qt::Key_MediaTogglePlayPause},
    {VK_LAUNCH_MAIL, 0xB4, Qt::Key_LaunchMail},
    {VK_LAUNCH_MEDIA_SELECT, 0xB5, Qt::Key_LaunchMedia},
    {VK_LAUNCH_APP1, 0xB6, Qt::Key_Launch0},
    {VK_LAUNCH_APP2, 0xB7, Qt::Key_Calculator},
};

constexpr KeyRun keyRuns[] = {
    {'1', 0x02, Qt::Key_1, 9},       {VK_F1, 0x3B, Qt::Key_F1, 10},  {VK_F11, 0x57, Qt::Key_F11, 2},
    {VK_F13, 0x64, Qt::Key_F13, 11}, {VK_F24, 0x76, Qt::Key_F24, 1},
};

/// The letter keys of the usual layout by place, row by row.
struct LetterRow {
    int scanCode;
    std::string_view letters;
};
constexpr LetterRow letterRows[] = {{0x10, "QWERTYUIOP"}, {0x1E, "ASDFGHJKL"}, {0x2C, "ZXCVBNM"}};

/// Keys of the keypad that type something.
constexpr KeyRow keypadRows[] = {
    {VK_NUMPAD0, 0x52, Qt::Key_0},       {VK_NUMPAD1, 0x4F, Qt::Key_1},         {VK_NUMPAD2, 0x50, Qt::Key_2},
    {VK_NUMPAD3, 0x51, Qt::Key_3},       {VK_NUMPAD4, 0x4B, Qt::Key_4},         {VK_NUMPAD5, 0x4C, Qt::Key_5},
    {VK_NUMPAD6, 0x4D, Qt::Key_6},       {VK_NUMPAD7, 0x47, Qt::Key_7},         {VK_NUMPAD8, 0x48, Qt::Key_8},
    {VK_NUMPAD9, 0x49, Qt::Key_9},       {VK_MULTIPLY, 0x37, Qt::Key_Asterisk}, {VK_ADD, 0x4E, Qt::Key_Plus},
    {VK_SUBTRACT, 0x4A, Qt::Key_Minus},  {VK_DECIMAL, 0x53, Qt::Key_Period},    {VK_DIVIDE, 0x88, Qt::Key_Slash},
    {VK_SEPARATOR, 0x7E, Qt::Key_Comma},
};

/// Other keys and signs that are one of the keys above.
struct OtherKey {
    int key;
    int virtualKey;
};
constexpr OtherKey otherKeys[] = {
    {Qt::Key_Backtab, VK_TAB},
    {Qt::Key_Enter, VK_RETURN},
    {Qt::Key_SysReq, VK_SNAPSHOT},
    {Qt::Key_Meta, VK_LWIN},
    {Qt::Key_Katakana, VK_KANA},
    {Qt::Key_Hiragana, VK_KANA},
    {Qt::Key_Hangul, VK_KANA},
    {Qt::Key_Kanji, VK_KANJI},
    {Qt::Key_Hangul_Hanja, VK_KANJI},
    {Qt::Key_MediaPlay, VK_MEDIA_PLAY_PAUSE},
    {Qt::Key_MediaPause, VK_MEDIA_PLAY_PAUSE},
    {Qt::Key_Reload, VK_BROWSER_REFRESH},
    {Qt::Key_Launch1, VK_LAUNCH_APP2},
    {Qt::Key_Colon, VK_OEM_1},
    {Qt::Key_Plus, VK_OEM_PLUS},
    {Qt::Key_Less, VK_OEM_COMMA},
    {Qt::Key_Underscore, VK_OEM_MINUS},
    {Qt::Key_Greater, VK_OEM_PERIOD},
    {Qt::Key_Question, VK_OEM_2},
    {Qt::Key_AsciiTilde, VK_OEM_3},
    {Qt::Key_BraceLeft, VK_OEM_4},
    {Qt::Key_Bar, VK_OEM_5},
    {Qt::Key_BraceRight, VK_OEM_6},
    {Qt::Key_QuoteDbl, VK_OEM_7},
};

/// The whole table in one piece, the keypad's keys behind the others.
std::vector<KeyRow> allKeys() {
    std::vector<KeyRow> keys(std::begin(keyRows), std::end(keyRows));
    for (const KeyRun& run : keyRuns) {
        for (int i = 0; i < run.count; ++i) {
            keys.push_back({run.virtualKey + i, run.scanCode + i, run.key + i});
        }
    }
    for (const LetterRow& row : letterRows) {
        int scanCode = row.scanCode;
        for (const char letter : row.letters) {
            keys.push_back({letter, scanCode++, letter});
        }
    }
    return keys;
}

const std::vector<KeyRow>& mainKeys() {
    static const auto& keys = *new std::vector<KeyRow>(allKeys());
    return keys;
}

/// The row with such a number, null when there is none.
const KeyRow* rowWith(int KeyRow::* field, int value, std::span<const KeyRow> rows) {
    const auto found = std::ranges::find(rows, value, field);
    return found != rows.end() ? &*found : nullptr;
}

const KeyRow* rowWith(int KeyRow::* field, int value) {
    const KeyRow* row = rowWith(field, value, mainKeys());
    return row ? row : rowWith(field, value, keypadRows);
}

} // namespace

int virtualKeyOf(int key) {
    if (const KeyRow* row = key != 0 ? rowWith(&KeyRow::key, key, mainKeys()) : nullptr) {
        return row->virtualKey;
    }
    const auto* other = std::ranges::find(otherKeys, key, &OtherKey::key);
    return other != std::end(otherKeys) ? other->virtualKey : 0;
}

int keypadKeyOf(int key) {
    const KeyRow* row = rowWith(&KeyRow::key, key, keypadRows);
    return row ? row->virtualKey : 0;
}

int virtualKeyAt(int scanCode) {
    const KeyRow* row = rowWith(&KeyRow::scanCode, scanCode);
    if (!row) {
        row = rowWith(&KeyRow::scanCode, scanCode ^ extendedKey);
    }
    return row ? row->virtualKey : 0;
}

int scanCodeOf(int virtualKey) {
    const KeyRow* row = rowWith(&KeyRow::virtualKey, virtualKey);
    return row ? row->scanCode : 0;
}

bool isKeypadSign(int virtualKey) {
    return rowWith(&KeyRow::virtualKey, virtualKey, keypadRows) != nullptr;
}

bool isCharacterKey(int virtualKey) {
    const KeyRow* row = rowWith(&KeyRow::virtualKey, virtualKey, mainKeys());
    return row && row->key < Qt::Key_Escape;
}

char16_t usualSign(int virtualKey) {
    const KeyRow* row = rowWith(&KeyRow::virtualKey, virtualKey);
    if (!row || row->key >= Qt::Key_Escape) {
        return 0;
    }
    return row->sign != 0 ? row->sign : static_cast<char16_t>(row->key);
}

} // namespace tvx::afx
