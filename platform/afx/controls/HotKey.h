#pragma once

#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Wnd.h"

/// A field that takes one key with its modifiers, by typing it, and shows its name ("Ctrl+Shift+F5"). Its class is
/// "msctls_hotkey32", so templates can have it.
///
/// While it has the keyboard it takes every key: Tab, Enter, Esc, Backspace and Delete, the short-cuts, menu keys and
/// access keys of everything around it, F1 too. The user leaves it with the mouse, so a dialog keeps a button beside
/// it; a program empties it by SetHotKey(0, 0). The parent gets EN_CHANGE for each key that is typed.
class TVX_PLATFORM_API CHotKeyCtrl : public CWnd {
    DECLARE_DYNAMIC(CHotKeyCtrl)

public:
    /// Creates the field; `rect` is its place in the parent's client area, in pixels. FALSE when creation was refused.
    BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);
    using CWnd::Create;

    /// Shows a key; the parent is not told.
    /// @param virtualKey VK_..., 0 for none @param modifiers HOTKEYF_...
    void SetHotKey(WORD virtualKey, WORD modifiers) {
        SendMessage(HKM_SETHOTKEY, static_cast<WPARAM>((virtualKey & 0xFF) | (modifiers & 0xFF) << 8));
    }
    /// The key typed or set last, in the low word: VK_... in its low byte (0 for none), HOTKEYF_... in its high byte.
    DWORD GetHotKey() const {
        return static_cast<DWORD>(SendMessage(HKM_GETHOTKEY));
    }
    /// The same in two parts. HOTKEYF_EXT tells a key of the cursor block from that of the keypad.
    void GetHotKey(WORD& virtualKey, WORD& modifiers) const {
        const DWORD key = GetHotKey();
        virtualKey = static_cast<WORD>(key & 0xFFU);
        modifiers = static_cast<WORD>(key >> 8 & 0xFFU);
    }
    /// Keeps keys without enough modifiers out.
    /// @param invalidCombinations HKCOMB_... that must not be typed
    /// @param modifiers HOTKEYF_... that are added to a key which is typed with one of them all the same
    void SetRules(WORD invalidCombinations, WORD modifiers) {
        SendMessage(HKM_SETRULES, invalidCombinations, modifiers);
    }
};
