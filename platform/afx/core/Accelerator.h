#pragma once

/// @file
/// Accelerator tables: keys that stand for commands. A frame has one (CFrameWnd::m_hAccelTable) and translates the keys
/// of all its windows with it.

#include "platform/afx/core/Message.h"

// Bits of ACCEL::fVirt
#define FVIRTKEY TRUE
#define FNOINVERT 0x02
#define FSHIFT 0x04
#define FCONTROL 0x08
#define FALT 0x10

/// One key of a table.
struct tagACCEL {
    BYTE fVirt; ///< FVIRTKEY and the modifiers that must be down; without FVIRTKEY `key` is a character
    WORD key;   ///< VK_..., or a character of at most 16 bits
    WORD cmd;   ///< the command it stands for
};
using ACCEL = tagACCEL;
using LPACCEL = ACCEL*;

/// A table made from a resource of one module (null: the application). Null when there is none
/// or it is damaged.
TVX_PLATFORM_API HACCEL LoadAcceleratorsA(HINSTANCE module, LPCSTR name);
/// A table made from `count` entries, to be destroyed by the caller. Null for 0 entries.
TVX_PLATFORM_API HACCEL CreateAcceleratorTableA(const ACCEL* entries, int count);
/// Copies up to `count` entries and answers how many; with a null `entries` the number of all.
TVX_PLATFORM_API int CopyAcceleratorTableA(HACCEL table, ACCEL* entries, int count);
/// Ends a table. FALSE for what is none (any more).
TVX_PLATFORM_API BOOL DestroyAcceleratorTable(HACCEL table);
/// Sends the command of a key message to `window` (WM_COMMAND with code 1, or WM_SYSCOMMAND for commands from 0xF000 up
/// that its system menu has). A command that is greyed in the window's menu is not sent, its key is used up all the
/// same.
/// @return whether the table has the key
TVX_PLATFORM_API int TranslateAcceleratorA(HWND window, HACCEL table, MSG* message);

/// The same calls by the names without their suffix.
/// @{
inline HACCEL LoadAccelerators(HINSTANCE module, LPCSTR name) {
    return LoadAcceleratorsA(module, name);
}
inline HACCEL CreateAcceleratorTable(const ACCEL* entries, int count) {
    return CreateAcceleratorTableA(entries, count);
}
inline int CopyAcceleratorTable(HACCEL table, ACCEL* entries, int count) {
    return CopyAcceleratorTableA(table, entries, count);
}
inline int TranslateAccelerator(HWND window, HACCEL table, MSG* message) {
    return TranslateAcceleratorA(window, table, message);
}
/// @}
