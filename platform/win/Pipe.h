#pragma once

/// @file
/// Pipes without a name, such as those that a child's standard input and output are connected to.
///
///     HANDLE readEnd = nullptr, writeEnd = nullptr;
///     SECURITY_ATTRIBUTES inheritable{sizeof inheritable, nullptr, TRUE};
///     CreatePipe(&readEnd, &writeEnd, &inheritable, 0);
///     // ... a child writes into writeEnd ...
///     DWORD waiting = 0;
///     if (PeekNamedPipe(readEnd, nullptr, 0, nullptr, &waiting, nullptr) && waiting > 0)
///         ReadFile(readEnd, buffer, waiting, &count, nullptr); // does not block: so many bytes are there

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Handle.h"

/// How a new handle may be used.
struct SECURITY_ATTRIBUTES {
    DWORD nLength = sizeof(SECURITY_ATTRIBUTES);
    LPVOID lpSecurityDescriptor = nullptr; ///< not used
    BOOL bInheritHandle = FALSE;           ///< whether a child may be given the handle as a standard handle
};

/// Makes a pipe. It holds 1 MiB where the system allows (users without privileges have a limit for all their pipes),
/// so that a child that writes much seldom waits for its reader.
/// @param readEnd, writeEnd  receive the handles, which the caller closes; unchanged on failure
/// @param attributes         whether both ends may be given to a child; null: they may not
/// @param size               0: as told above; else the pipe has the system's own size, 64 KiB
/// @return FALSE with `ERROR_TOO_MANY_OPEN_FILES` when the process has no descriptors left
TVX_PLATFORM_API BOOL CreatePipe(HANDLE* readEnd, HANDLE* writeEnd, const SECURITY_ATTRIBUTES* attributes, DWORD size);

/// Tells how many bytes wait in a pipe, without reading them and without waiting.
/// @param pipe       its reading end
/// @param buffer, size, read, left  null and 0: bytes cannot be looked at (`ERROR_NOT_SUPPORTED`)
/// @param available  receives the number; null when only the pipe's state is of interest
/// @return FALSE with `ERROR_BROKEN_PIPE` when nothing waits and nobody holds the writing end any more
TVX_PLATFORM_API BOOL PeekNamedPipe(HANDLE pipe, LPVOID buffer, DWORD size, DWORD* read, DWORD* available, DWORD* left);

/// Reads from a pipe. Waits for the first byte when none is there; takes what then is there, up to `size` bytes.
/// @param read        receives the number of bytes
/// @param overlapped  null: reading is always done when the call returns
/// @return FALSE with `ERROR_BROKEN_PIPE` when all was read and nobody holds the writing end any more
TVX_PLATFORM_API BOOL ReadFile(HANDLE pipe, LPVOID buffer, DWORD size, DWORD* read, LPVOID overlapped);
