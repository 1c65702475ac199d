#pragma once

/// @file
/// Calls about files by name. Names come in the framework's form (`C:\a\b`) or the system's (`/a/b`); what is handed
/// out has the framework's. docs/file-names.md has the rules. Texts of any length are handled; a caller with a small
/// buffer learns how much is needed.

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Handle.h"

#include <string>
#include <string_view>

struct SECURITY_ATTRIBUTES;

/// What a file is like, in bits.
/// @{
inline constexpr DWORD FILE_ATTRIBUTE_READONLY = 0x01;
inline constexpr DWORD FILE_ATTRIBUTE_HIDDEN = 0x02; ///< Its name begins with a dot.
inline constexpr DWORD FILE_ATTRIBUTE_DIRECTORY = 0x10;
inline constexpr DWORD FILE_ATTRIBUTE_NORMAL = 0x80; ///< No other bit.
inline constexpr DWORD INVALID_FILE_ATTRIBUTES = 0xFFFFFFFF;
/// @}

/// What a file is to be opened for.
/// @{
inline constexpr DWORD GENERIC_READ = 0x80000000;
inline constexpr DWORD GENERIC_WRITE = 0x40000000;
/// @}

/// What others may do with an open file; 0 keeps everybody out who asks in the same way.
/// @{
inline constexpr DWORD FILE_SHARE_READ = 0x01;
inline constexpr DWORD FILE_SHARE_WRITE = 0x02;
/// @}

/// What to do when a file exists and when it does not.
/// @{
inline constexpr DWORD CREATE_NEW = 1;
inline constexpr DWORD CREATE_ALWAYS = 2;
inline constexpr DWORD OPEN_EXISTING = 3;
inline constexpr DWORD OPEN_ALWAYS = 4;
inline constexpr DWORD TRUNCATE_EXISTING = 5;
/// @}

/// What the file or folder of a name is like.
/// @return bits; FILE_ATTRIBUTE_READONLY when nobody may write it or this user may not. INVALID_FILE_ATTRIBUTES when it
///     does not exist or cannot be examined: `ERROR_FILE_NOT_FOUND`, `ERROR_PATH_NOT_FOUND` for an unknown drive or
///     share, `ERROR_ACCESS_DENIED`, ...
TVX_PLATFORM_API DWORD GetFileAttributesA(LPCSTR name);

/// Opens or creates a file.
/// @param access       of GENERIC_READ and GENERIC_WRITE
/// @param share        0: nobody else may open it through this call meanwhile (`ERROR_SHARING_VIOLATION`), nor may it
///                     be open already; otherwise others may
/// @param security     not used; the handle is not inherited
/// @param disposition  one of CREATE_NEW to TRUNCATE_EXISTING
/// @param flags        not used: new files get what the process's mask allows
/// @param pattern      not used
/// @return a handle that the caller closes; INVALID_HANDLE_VALUE on failure
TVX_PLATFORM_API HANDLE CreateFileA(LPCSTR name, DWORD access, DWORD share, const SECURITY_ATTRIBUTES* security,
                                    DWORD disposition, DWORD flags, HANDLE pattern);

/// Removes a file; a folder is refused with `ERROR_ACCESS_DENIED`.
TVX_PLATFORM_API BOOL DeleteFileA(LPCSTR name);

/// Makes a folder in one that exists.
/// @param security  not used: it gets what the process's mask allows
/// @return FALSE with `ERROR_ALREADY_EXISTS`, `ERROR_PATH_NOT_FOUND` without the folder around it,
/// `ERROR_ACCESS_DENIED`,
///     ...
TVX_PLATFORM_API BOOL CreateDirectoryA(LPCSTR name, const SECURITY_ATTRIBUTES* security);

/// The current folder, such as "C:\work", without a separator at the end unless it is a root.
/// @param size    bytes of `buffer`
/// @param buffer  receives the text; may be null when `size` is 0
/// @return its length; when it does not fit, the bytes needed; 0 with the last error when there is none
TVX_PLATFORM_API DWORD GetCurrentDirectoryA(DWORD size, LPSTR buffer);

/// The whole name: completed with the current drive and folder, "." and ".." resolved. Nothing is looked for.
/// @param size      bytes of `buffer`
/// @param buffer    receives the text; may be null when `size` is 0
/// @param filePart  receives where the last part begins in it, null when it ends with a separator; may be null
/// @return as GetCurrentDirectoryA
TVX_PLATFORM_API DWORD GetFullPathNameA(LPCSTR name, DWORD size, LPSTR buffer, LPSTR* filePart);

/// @{
/// The same calls by the names that hosts write.
inline DWORD GetFileAttributes(LPCSTR name) {
    return GetFileAttributesA(name);
}
inline HANDLE CreateFile(LPCSTR name, DWORD access, DWORD share, const SECURITY_ATTRIBUTES* security, DWORD disposition,
                         DWORD flags, HANDLE pattern) {
    return CreateFileA(name, access, share, security, disposition, flags, pattern);
}
inline BOOL DeleteFile(LPCSTR name) {
    return DeleteFileA(name);
}
inline BOOL CreateDirectory(LPCSTR name, const SECURITY_ATTRIBUTES* security) {
    return CreateDirectoryA(name, security);
}
inline DWORD GetCurrentDirectory(DWORD size, LPSTR buffer) {
    return GetCurrentDirectoryA(size, buffer);
}
inline DWORD GetFullPathName(LPCSTR name, DWORD size, LPSTR buffer, LPSTR* filePart) {
    return GetFullPathNameA(name, size, buffer, filePart);
}
/// @}

namespace tvx {

/// What there is under a name.
enum class FileKind {
    None,
    File,
    Folder,
    Device, ///< or a pipe: reading may wait for ever
};

/// Tells what there is under a name, links followed, in half the time that GetFileAttributesA takes: whether it may be
/// written is not asked. FileKind::None, with the last error, when that cannot be told.
[[nodiscard]] TVX_PLATFORM_API FileKind fileKind(LPCSTR name);

/// What GetFullPathNameA gives. A name that cannot have the framework's form, because it lies on no drive or holds
/// backslashes, has the system's.
[[nodiscard]] TVX_PLATFORM_API std::string fullName(std::string_view name);

} // namespace tvx
