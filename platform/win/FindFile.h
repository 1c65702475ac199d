#pragma once

/// @file
/// Going through the entries of a folder.
///
/// @code
/// WIN32_FIND_DATAA entry;
/// const HANDLE find = FindFirstFileA("C:\\plans\\*", &entry);
/// for (BOOL more = find != INVALID_HANDLE_VALUE; more; more = FindNextFileA(find, &entry)) {
///     ...
/// }
/// FindClose(find);
/// @endcode

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Files.h"

/// A moment in units of 100 nanoseconds since 1601. Nothing here tells or takes one.
struct FILETIME {
    /// The halves of the number.
    DWORD dwLowDateTime;
    DWORD dwHighDateTime;
};

/// An entry of a folder. Only what the system tells together with the name is known: times and sizes are 0, and
/// FILE_ATTRIBUTE_READONLY is never set. Who wants those asks GetFileAttributesA or CFile::GetStatus about one entry.
struct WIN32_FIND_DATAA {
    DWORD dwFileAttributes; ///< FILE_ATTRIBUTE_DIRECTORY, FILE_ATTRIBUTE_HIDDEN, or FILE_ATTRIBUTE_NORMAL
    FILETIME ftCreationTime;
    FILETIME ftLastAccessTime;
    FILETIME ftLastWriteTime;
    DWORD nFileSizeHigh;
    DWORD nFileSizeLow;
    DWORD dwReserved0;
    DWORD dwReserved1;
    char cFileName[MAX_PATH];    ///< the bytes that it has on the disk
    char cAlternateFileName[14]; ///< always empty
};
using WIN32_FIND_DATA = WIN32_FIND_DATAA;

/// Finds the first entry of a folder whose name matches.
///
/// No entry is asked for anything: looking at a folder mounts nothing below it and wakes no other machine. Of links it
/// is found out whether they lead to a folder; one that leads to a network folder, or to one that would be mounted by
/// asking, counts as a folder unseen. The call itself waits for as long as the folder's own file system does.
///
/// @param pattern  a folder and a pattern: "*" stands for any text, "?" for one character, "*.*" for every name; case
///                 does not matter
/// @param entry    receives what was found, "." and ".." among them, in no certain order
/// @return a handle that FindClose ends; INVALID_HANDLE_VALUE with `ERROR_FILE_NOT_FOUND` when nothing matches,
///     `ERROR_PATH_NOT_FOUND` without such a folder, `ERROR_ACCESS_DENIED`, ...
TVX_PLATFORM_API HANDLE FindFirstFileA(LPCSTR pattern, WIN32_FIND_DATAA* entry);
/// Finds the next one. FALSE with `ERROR_NO_MORE_FILES` at the end, with another error when the folder cannot be read
/// on. One handle is used by one thread at a time.
TVX_PLATFORM_API BOOL FindNextFileA(HANDLE find, WIN32_FIND_DATAA* entry);
/// Ends a search. FALSE with `ERROR_INVALID_HANDLE` for a handle that is none.
TVX_PLATFORM_API BOOL FindClose(HANDLE find);

/// The same calls by the names that hosts write.
/// @{
inline HANDLE FindFirstFile(LPCSTR pattern, WIN32_FIND_DATAA* entry) {
    return FindFirstFileA(pattern, entry);
}
inline BOOL FindNextFile(HANDLE find, WIN32_FIND_DATAA* entry) {
    return FindNextFileA(find, entry);
}
/// @}
