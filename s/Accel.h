#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// A keyboard accelerator: a key with its modifiers, and the command that it stands for.
///
/// @code
/// Gui_Accel accel(FVIRTKEY | FCONTROL | FSHIFT, VK_F5, ID_VIEW_REFRESH);
/// accel.GetKeyText(); // "Ctrl+Shift+F5" with an English keyboard
/// @endcode
///
/// A value. It adds nothing to the platform's entry, so that arrays and pointers of the two are the same.
class GUI_API Gui_Accel : public tagACCEL {
public:
    /// All fields 0.
    Gui_Accel() : tagACCEL{} {}
    /// @param flags    FVIRTKEY, FNOINVERT, FSHIFT, FCONTROL, FALT
    /// @param key      VK_... with FVIRTKEY, a character without
    /// @param command  the command's identifier
    Gui_Accel(unsigned char flags, unsigned short key, unsigned short command) : tagACCEL{flags, key, command} {}
    Gui_Accel(const tagACCEL& accel) : tagACCEL(accel) {}
    /// @param accel  copied; not null
    Gui_Accel(const tagACCEL* accel) : tagACCEL(*accel) {}

    Gui_Accel& operator=(const tagACCEL& accel);
    /// Compares all three fields; one side may be a tagACCEL.
    friend bool operator==(const Gui_Accel& first, const Gui_Accel& second) {
        return first.fVirt == second.fVirt && first.key == second.key && first.cmd == second.cmd;
    }
    /// Whether all fields are 0: 1 or 0.
    int IsEmpty() const;
    /// Sets all fields to 0.
    void Clear();
    /// The object itself.
    operator tagACCEL*();

    /// Flags and key in one number: the flags in bits 0 to 7, FNOINVERT always among them, the key in bits 16 to 31.
    /// The command is not part of it, so accelerators of the same key have the same number.
    unsigned long EncodeFlagsAndKey() const {
        return static_cast<unsigned long>(key) << 16U | fVirt | FNOINVERT;
    }
    /// Takes flags and key from such a number; the command stays.
    void DecodeFlagsAndKey(unsigned long packed) {
        fVirt = static_cast<BYTE>(packed);
        key = static_cast<WORD>(packed >> 16U);
    }

    /// The key's name for display, as the keyboard layout calls it: modifiers in the order Ctrl, Alt, Shift, "+"
    /// between the parts. Alt and Shift of characters are not named. Empty for an empty accelerator.
    CString GetKeyText() const;
};
