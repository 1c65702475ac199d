#pragma once

/// @file
/// Handles of the system's objects: processes and ends of pipes. A handle is a number; one that is stale or made up is
/// refused with `ERROR_INVALID_HANDLE`. Who got a handle closes it; the object ends with the last handle to it.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

/// What calls and hosts put where there is no handle. The same number stands for the calling process where a call takes
/// a process, see GetCurrentProcess().
inline const HANDLE INVALID_HANDLE_VALUE = reinterpret_cast<HANDLE>(static_cast<std::intptr_t>(-1));

inline constexpr DWORD INFINITE = 0xFFFFFFFF;         ///< A time-out that never passes.
inline constexpr DWORD WAIT_OBJECT_0 = 0;             ///< What was waited for has happened.
inline constexpr DWORD WAIT_FAILED = 0xFFFFFFFF;      ///< There was nothing to wait for: see the last error.
inline constexpr DWORD DUPLICATE_CLOSE_SOURCE = 0x01; ///< Closes the handle that was duplicated, also when that fails.
inline constexpr DWORD DUPLICATE_SAME_ACCESS = 0x02;  ///< The new handle may do what the old one may; always so here.

/// Closes a handle. Closing the last handle of a child that still runs lets it run on; the layer collects its end.
/// FALSE with `ERROR_INVALID_HANDLE` when it is none.
TVX_PLATFORM_API BOOL CloseHandle(HANDLE handle);

/// Makes another handle to the same object, inheritable or not.
/// @param sourceProcess  GetCurrentProcess(), as is `targetProcess`: handles of other processes cannot be reached,
///                       which is `ERROR_ACCESS_DENIED`
/// @param target         receives the new handle; the caller closes it
/// @param access         not used: a duplicate may do what its source may
/// @param inherit        whether a child may be given the new handle as one of its standard handles
/// @param options        of `DUPLICATE_CLOSE_SOURCE`, `DUPLICATE_SAME_ACCESS`
/// @return FALSE on failure; `target` is unchanged then
TVX_PLATFORM_API BOOL DuplicateHandle(HANDLE sourceProcess, HANDLE source, HANDLE targetProcess, HANDLE* target,
                                      DWORD access, BOOL inherit, DWORD options);

/// Waits until a process has ended, or until bytes wait in a pipe or its other end is closed. The thread handles no
/// messages meanwhile.
/// @param timeout  milliseconds; 0 only asks, `INFINITE` waits for ever
/// @return `WAIT_OBJECT_0`, `WAIT_TIMEOUT` when the time ran out, `WAIT_FAILED` when the handle is none
TVX_PLATFORM_API DWORD WaitForSingleObject(HANDLE handle, DWORD timeout);
