#pragma once

/// @file
/// The clipboard, and the memory blocks that travel through it.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <cstddef>

// Formats
#define CF_TEXT 1
#define CF_BITMAP 2
#define CF_UNICODETEXT 13

// GlobalAlloc
#define GMEM_FIXED 0x0000
#define GMEM_MOVEABLE 0x0002
#define GMEM_ZEROINIT 0x0040
#define GMEM_DDESHARE 0x2000
#define GHND 0x0042
#define GPTR 0x0040

/// Opens the clipboard for a window (null: the application). FALSE while another window of this program has it open.
TVX_PLATFORM_API BOOL OpenClipboard(HWND window);
/// Ends the use; what was set is given to other programs now.
TVX_PLATFORM_API BOOL CloseClipboard();
/// Empties the clipboard, which must be open.
TVX_PLATFORM_API BOOL EmptyClipboard();
/// Puts a block into the clipboard, which owns it from then on. Null on failure; the block stays the caller's then.
/// @param format CF_TEXT (zero-terminated UTF-8) or a registered format
TVX_PLATFORM_API HANDLE SetClipboardData(UINT format, HANDLE block);
/// The contents in a format, null when it has none. While WM_PASTE is handled these are what the user pastes, which may
/// be another program's selection (middle button) or a text that was dropped. The block belongs to the clipboard and is
/// valid until it is closed.
TVX_PLATFORM_API HANDLE GetClipboardData(UINT format);
/// Whether the clipboard has contents in a format. It need not be open.
TVX_PLATFORM_API BOOL IsClipboardFormatAvailable(UINT format);
/// The number, from 0xC000 up, of a format known by its name. 0 for an empty name.
TVX_PLATFORM_API UINT RegisterClipboardFormatA(LPCSTR name);

/// A block of memory. Null when there is not enough.
TVX_PLATFORM_API HGLOBAL GlobalAlloc(UINT flags, std::size_t bytes);
/// A block of another size with the same contents, or null and the old block stays.
TVX_PLATFORM_API HGLOBAL GlobalReAlloc(HGLOBAL block, std::size_t bytes, UINT flags);
/// The address of a block's first byte; null for what is no block.
TVX_PLATFORM_API LPVOID GlobalLock(HGLOBAL block);
/// Blocks never move, so nothing is counted: the address stays valid until the block is freed or grows. FALSE only for
/// what is no block.
TVX_PLATFORM_API BOOL GlobalUnlock(HGLOBAL block);
/// Size of a block in bytes; 0 for what is no block.
TVX_PLATFORM_API std::size_t GlobalSize(HGLOBAL block);
/// Frees a block. Null on success, else the handle.
TVX_PLATFORM_API HGLOBAL GlobalFree(HGLOBAL block);

/// RegisterClipboardFormatA.
inline UINT RegisterClipboardFormat(LPCSTR name) {
    return RegisterClipboardFormatA(name);
}
