#pragma once

/// @file
/// Keys by number and by name.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

/// What belongs to a key; 0 when nothing does.
/// @param code a virtual key (VK_...), or for types 1 and 3 a scan code
/// @param type 0: the scan code of a virtual key. Each key has its own; only the keys of the cursor block share theirs
///             with those keys of the keypad that do the same without NumLock. 1 and 3: the virtual key of a scan code,
///             where 0xE000 added to the code stands for the extended keys. 2: the character that a virtual key types
///             without Shift, letters in upper case.
/// @note Scan codes do not depend on the keyboard's layout here.
TVX_PLATFORM_API UINT MapVirtualKeyA(UINT code, UINT type);
/// The name of a key as a user reads it, in the user's language. Keys that type a character are named by the sign that
/// the keyboard has on them.
/// @param parameter that of a key message: scan code in bits 16 to 23, bit 24 for the extended keys. Without that bit
///        the keys of the cursor block are those of the keypad ("Num 4").
/// @param buffer receives the name in UTF-8 with a zero behind it, cut between characters where it does not fit
/// @return the bytes stored without the zero, 0 for what is no key
TVX_PLATFORM_API int GetKeyNameTextA(LONG parameter, LPSTR buffer, int size);

/// The same calls by the names without their suffix.
/// @{
inline UINT MapVirtualKey(UINT code, UINT type) {
    return MapVirtualKeyA(code, type);
}
inline int GetKeyNameText(LONG parameter, LPSTR buffer, int size) {
    return GetKeyNameTextA(parameter, buffer, size);
}
/// @}
