#pragma once

/// @file
/// Processes: starting children, and asking about any process.
///
/// Behind a process handle stands the system's own reference to that process, never its number alone: an answer is
/// never about another process that got the same number later.

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Handle.h"
#include "platform/win/Pipe.h"

inline constexpr DWORD STILL_ACTIVE = 259; ///< What GetExitCodeProcess gives for a process that runs.

inline constexpr DWORD PROCESS_QUERY_INFORMATION = 0x0400; ///< The right to ask about a process.

/// @{
/// Exit codes of processes that a signal ended because they had failed. SIGQUIT, SIGSYS, SIGXCPU and SIGXFSZ give
/// 0xC0000000 and their number; so does, with the number 0, an end whose code nobody can tell. Signals by which
/// somebody ends a program that has not failed (SIGTERM, SIGHUP, SIGKILL, SIGPIPE and the others) give 128 and their
/// number.
inline constexpr DWORD STATUS_BREAKPOINT = 0x80000003;
inline constexpr DWORD STATUS_ACCESS_VIOLATION = 0xC0000005;
inline constexpr DWORD STATUS_IN_PAGE_ERROR = 0xC0000006;
inline constexpr DWORD STATUS_ILLEGAL_INSTRUCTION = 0xC000001D;
inline constexpr DWORD STATUS_INTEGER_DIVIDE_BY_ZERO = 0xC0000094;
inline constexpr DWORD STATUS_CONTROL_C_EXIT = 0xC000013A;
inline constexpr DWORD STATUS_ASSERTION_FAILURE = 0xC0000420;
/// @}

inline constexpr DWORD STARTF_USESHOWWINDOW = 0x001; ///< `wShowWindow` of a start-up record counts.
inline constexpr DWORD STARTF_USESTDHANDLES = 0x100; ///< The standard handles of a start-up record count.

/// How a child is to start. Only the fields named in comments are used.
struct STARTUPINFOA {
    DWORD cb = sizeof(STARTUPINFOA); ///< the record's size
    LPSTR lpReserved = nullptr;
    LPSTR lpDesktop = nullptr;
    LPSTR lpTitle = nullptr;
    DWORD dwX = 0;
    DWORD dwY = 0;
    DWORD dwXSize = 0;
    DWORD dwYSize = 0;
    DWORD dwXCountChars = 0;
    DWORD dwYCountChars = 0;
    DWORD dwFillAttribute = 0;
    DWORD dwFlags = 0;    ///< of `STARTF_USESHOWWINDOW`, `STARTF_USESTDHANDLES`
    WORD wShowWindow = 0; ///< how the child is to show its first window: 0 hides it. Applications of the family obey.
    WORD cbReserved2 = 0;
    BYTE* lpReserved2 = nullptr;
    HANDLE hStdInput = nullptr;  ///< ends of pipes that are inheritable; anything else is the null device
    HANDLE hStdOutput = nullptr; ///< likewise
    HANDLE hStdError = nullptr;  ///< likewise; may be the same as `hStdOutput`
};
using STARTUPINFO = STARTUPINFOA;

/// A started child. The caller closes both handles.
struct PROCESS_INFORMATION {
    HANDLE hProcess = nullptr; ///< the child
    HANDLE hThread = nullptr;  ///< its first thread; here another handle to the child
    DWORD dwProcessId = 0;     ///< the system's process id
    DWORD dwThreadId = 0;      ///< the first thread has the id of its process
};

/// Starts a program. docs/processes.md has the rules: how the command line is split, where the program is looked for,
/// what names in it become, and what the child inherits.
///
/// The child is in a session of its own, so it outlives this process and its terminal. It inherits nothing but its
/// three standard descriptors: those of the start-up record, or without `STARTF_USESTDHANDLES` this process's own.
///
/// @param application  the program, looked for as that of a command line; null takes the first word of the command line
/// @param commandLine  program and arguments; may be null when `application` is given
/// @param processAttributes, threadAttributes  not used
/// @param inherit      whether standard handles are handed on; FALSE makes them the null device
/// @param flags        not used
/// @param environment  null: the child gets this process's environment, cleaned of what the application's bundle added
///                     for itself. Another one is refused with `ERROR_NOT_SUPPORTED`.
/// @param directory    where the child starts; null is the current directory
/// @param information  receives handles and ids; unchanged on failure
/// @return FALSE on failure, also when the program was found but could not be started: `ERROR_FILE_NOT_FOUND`,
///         `ERROR_PATH_NOT_FOUND`, `ERROR_ACCESS_DENIED` (not executable), `ERROR_BAD_EXE_FORMAT` (no program),
///         `ERROR_DIRECTORY`, `ERROR_FILENAME_EXCED_RANGE` (program's name or command line too long),
///         `ERROR_INVALID_PARAMETER` (empty)
TVX_PLATFORM_API BOOL CreateProcessA(LPCSTR application, LPSTR commandLine,
                                     const SECURITY_ATTRIBUTES* processAttributes,
                                     const SECURITY_ATTRIBUTES* threadAttributes, BOOL inherit, DWORD flags,
                                     LPVOID environment, LPCSTR directory, const STARTUPINFOA* startup,
                                     PROCESS_INFORMATION* information);

/// As `CreateProcessA`.
inline BOOL CreateProcess(LPCSTR application, LPSTR commandLine, const SECURITY_ATTRIBUTES* processAttributes,
                          const SECURITY_ATTRIBUTES* threadAttributes, BOOL inherit, DWORD flags, LPVOID environment,
                          LPCSTR directory, const STARTUPINFO* startup, PROCESS_INFORMATION* information) {
    return CreateProcessA(application, commandLine, processAttributes, threadAttributes, inherit, flags, environment,
                          directory, startup, information);
}

/// Tells how this process was asked to start: `wShowWindow` when it is to be hidden.
TVX_PLATFORM_API void GetStartupInfoA(STARTUPINFOA* startup);
inline void GetStartupInfo(STARTUPINFO* startup) {
    GetStartupInfoA(startup);
}

/// Waits until a child has its first window and is idle. Programs of this system do not tell when they are; the answer
/// is at once the one for programs without windows, `WAIT_FAILED`.
TVX_PLATFORM_API DWORD WaitForInputIdle(HANDLE process, DWORD timeout);

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

/// Ends a child at once; it cannot refuse. Those that it started end with it, and theirs, as far as they kept its
/// process group (shells without job control do, `setsid` and daemons do not). The call does not wait for the end.
/// @param process  from CreateProcessA; one from OpenProcess gives `ERROR_ACCESS_DENIED`, as does one that has ended
/// @param code     what GetExitCodeProcess is to give from then on
TVX_PLATFORM_API BOOL TerminateProcess(HANDLE process, UINT code);

namespace tvx {

/// Tells when the user last pressed a key or a button in this process's windows. Children that are started from then on
/// get a startup id (`DESKTOP_STARTUP_ID`) of that time, so that the window manager brings their windows to the front.
/// @param time  in the X display's time, in milliseconds; 0: there was no such input, and children get no id
TVX_PLATFORM_API void setLastInputTime(DWORD time);

} // namespace tvx
