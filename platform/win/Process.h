#pragma once

/// @file
/// Processes: starting children, and asking about any process.
///
/// Behind a process handle stands the system's own reference to that process, never its number alone: an answer is
/// never about another process that got the same number later.

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Handle.h"

inline constexpr DWORD STILL_ACTIVE = 259; ///< What GetExitCodeProcess gives for a process that runs.

inline constexpr DWORD PROCESS_QUERY_INFORMATION = 0x0400; ///< The right to ask about a process.

/// @{
/// Exit codes of processes that a signal ended. A signal without a code of its own gives 0xC0000000 and its number; so
/// does, with the number 0, an end whose code nobody can tell.
inline constexpr DWORD STATUS_BREAKPOINT = 0x80000003;
inline constexpr DWORD STATUS_ACCESS_VIOLATION = 0xC0000005;
inline constexpr DWORD STATUS_IN_PAGE_ERROR = 0xC0000006;
inline constexpr DWORD STATUS_ILLEGAL_INSTRUCTION = 0xC000001D;
inline constexpr DWORD STATUS_INTEGER_DIVIDE_BY_ZERO = 0xC0000094;
inline constexpr DWORD STATUS_CONTROL_C_EXIT = 0xC000013A;
/// @}

/// The calling process's id.
TVX_PLATFORM_API DWORD GetCurrentProcessId();

/// A number that stands for the calling process where a call takes a process. It need not be closed.
TVX_PLATFORM_API HANDLE GetCurrentProcess();

/// Opens any process for questions.
/// @param access     `PROCESS_QUERY_INFORMATION`; more is not given: `ERROR_ACCESS_DENIED`
/// @param inherit    not used
/// @param processId  the id; one that has ended but has not been collected by its parent can be opened and has ended
/// @return a handle that the caller closes. Null with `ERROR_INVALID_PARAMETER` when there is no such process.
TVX_PLATFORM_API HANDLE OpenProcess(DWORD access, BOOL inherit, DWORD processId);

/// Asks for a process's exit code, without waiting.
/// @param code  receives `STILL_ACTIVE` while the process runs, then what it ended with: its own code (0 to 255), that
///              of TerminateProcess, or one of those above. The code of a process that CreateProcessA did not start, or
///              whose end a handler of the host's collected, cannot be told: 0xC0000000.
/// @return FALSE when `process` is no process
TVX_PLATFORM_API BOOL GetExitCodeProcess(HANDLE process, DWORD* code);

/// Ends a child at once; it cannot refuse. The call does not wait for the end.
/// @param process  from CreateProcessA; one from OpenProcess gives `ERROR_ACCESS_DENIED`, as does one that has ended
/// @param code     what GetExitCodeProcess is to give from then on
TVX_PLATFORM_API BOOL TerminateProcess(HANDLE process, UINT code);
