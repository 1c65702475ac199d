#pragma once

/// @file
/// Files dropped on a window: what WM_DROPFILES carries.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

/// Dropped files, valid until DragFinish.
using HDROP = HANDLE;

/// The name of a dropped file, at most size - 1 bytes and never half a character; answers its length.
/// @param index  0xFFFFFFFF: answers the number of files
/// @param buffer null: answers the whole length of the name
TVX_PLATFORM_API UINT DragQueryFileA(HDROP drop, UINT index, LPSTR buffer, UINT size);
/// Frees what the handle stands for.
TVX_PLATFORM_API void DragFinish(HDROP drop);
/// Lets a window accept dropped files, or no longer.
TVX_PLATFORM_API void DragAcceptFiles(HWND window, BOOL accept);

/// DragQueryFileA.
inline UINT DragQueryFile(HDROP drop, UINT index, LPSTR buffer, UINT size) {
    return DragQueryFileA(drop, index, buffer, size);
}
