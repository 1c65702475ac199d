#pragma once

/// @file
/// Network connections: which folders of other machines are connected, under which drive. An enumeration sees the
/// connections that there were when it was opened.
///
/// @code
/// HANDLE connections = nullptr;
/// if (WNetOpenEnumA(RESOURCE_CONNECTED, RESOURCETYPE_DISK, 0, nullptr, &connections) == NO_ERROR) {
///     DWORD count = 0xFFFFFFFF;
///     DWORD size = sizeof(buffer);
///     while (WNetEnumResourceA(connections, &count, buffer, &size) == NO_ERROR)
///         ...
///     WNetCloseEnum(connections);
/// }
/// @endcode

#include "platform/base/Export.h"
#include "platform/base/Types.h"

inline constexpr DWORD RESOURCE_CONNECTED = 1; ///< The scope: what is connected now.
inline constexpr DWORD RESOURCETYPE_ANY = 0;
inline constexpr DWORD RESOURCETYPE_DISK = 1; ///< The kind: folders.

/// A connection.
struct NETRESOURCEA {
    DWORD dwScope;
    DWORD dwType;
    DWORD dwDisplayType;
    DWORD dwUsage;
    LPSTR lpLocalName;  ///< "X:"; null for one without a drive
    LPSTR lpRemoteName; ///< "\\server\share"
    LPSTR lpComment;    ///< always null
    LPSTR lpProvider;   ///< always null
};
using NETRESOURCE = NETRESOURCEA;

/// Begins an enumeration of the connections.
/// @param scope      RESOURCE_CONNECTED, else `ERROR_NOT_SUPPORTED`
/// @param type       RESOURCETYPE_DISK or RESOURCETYPE_ANY; there are no connections of other kinds
/// @param usage      not used
/// @param container  null: connections have none
/// @param handle     receives the enumeration, to be ended with WNetCloseEnum
/// @return NO_ERROR or an error number
TVX_PLATFORM_API DWORD WNetOpenEnumA(DWORD scope, DWORD type, DWORD usage, NETRESOURCEA* container, HANDLE* handle);

/// Gives the next connections.
/// @param count   in: how many at most, 0xFFFFFFFF for as many as fit; out: how many were given
/// @param buffer  receives an array of NETRESOURCEA, and behind it the texts that they point to
/// @param size    in: bytes of `buffer`; out, with `ERROR_MORE_DATA`: bytes that the next connection needs
/// @return NO_ERROR; `ERROR_NO_MORE_ITEMS` when all were given; `ERROR_MORE_DATA` when not even one fits: it is given
///     by the next call; `ERROR_INVALID_HANDLE`
TVX_PLATFORM_API DWORD WNetEnumResourceA(HANDLE handle, DWORD* count, void* buffer, DWORD* size);

/// The same calls by the names without their suffix.
/// @{
inline DWORD WNetOpenEnum(DWORD scope, DWORD type, DWORD usage, NETRESOURCEA* container, HANDLE* handle) {
    return WNetOpenEnumA(scope, type, usage, container, handle);
}
inline DWORD WNetEnumResource(HANDLE handle, DWORD* count, void* buffer, DWORD* size) {
    return WNetEnumResourceA(handle, count, buffer, size);
}
/// @}

/// Ends an enumeration.
/// @return NO_ERROR or `ERROR_INVALID_HANDLE`
TVX_PLATFORM_API DWORD WNetCloseEnum(HANDLE handle);
