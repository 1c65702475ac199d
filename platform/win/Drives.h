#pragma once

/// @file
/// Drives: which there are, of what kind they are, which one is the current. Letters stand for folders of the system:
/// C: is "/", removable media, optical discs and network folders have letters from D: up. The environment variable
/// TVX_DRIVES replaces that table. docs/file-names.md tells the whole.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

/// Kinds of drives, as GetDriveTypeA answers them.
/// @{
inline constexpr UINT DRIVE_UNKNOWN = 0;
inline constexpr UINT DRIVE_NO_ROOT_DIR = 1; ///< There is no such drive.
inline constexpr UINT DRIVE_REMOVABLE = 2;
inline constexpr UINT DRIVE_FIXED = 3;
inline constexpr UINT DRIVE_REMOTE = 4; ///< A folder of another machine.
inline constexpr UINT DRIVE_CDROM = 5;
inline constexpr UINT DRIVE_RAMDISK = 6;
/// @}

/// The drives that there are, one bit each: 1 for A:, 4 for C:.
TVX_PLATFORM_API DWORD GetLogicalDrives();

/// The kind of the drive on which a name lies.
/// @param root  "D:\", "D:", "\\server\share\"; null asks about the current drive. Only the drive or share counts, not
///              what stands behind it.
/// @return one of the DRIVE_ numbers; DRIVE_NO_ROOT_DIR for one that does not exist and for a name without drive
TVX_PLATFORM_API UINT GetDriveTypeA(LPCSTR root);
/// @copydoc GetDriveTypeA
inline UINT GetDriveType(LPCSTR root) {
    return GetDriveTypeA(root);
}

/// The number of the current drive: 1 for A:, 3 for C:. 0 when the current folder lies on no drive.
TVX_PLATFORM_API int _getdrive();

/// The current folder of a drive, such as "D:\work". Where the current folder lies on another drive, that is the root.
/// @param drive   its number as for _getdrive; 0 asks for the current one
/// @param buffer  receives the text; null asks for memory of malloc, which the caller frees
/// @param size    bytes of `buffer`; without one, the least to allocate
/// @return where the text is; null with `errno` ERANGE when it does not fit, EACCES when there is no such drive
TVX_PLATFORM_API char* _getdcwd(int drive, char* buffer, int size);
