#include "s/Process.h"

#include "platform/win/Error.h"
#include "platform/win/Process.h"

#include <limits>

namespace {

constexpr unsigned long crashBits = 0xC0000000;

int hasProcess(DWORD processId) {
    const HANDLE process = OpenProcess(PROCESS_QUERY_INFORMATION, FALSE, processId);
    if (!process) {
        const DWORD error = GetLastError();
        return error != ERROR_INVALID_PARAMETER && error != ERROR_INVALID_HANDLE;
    }
    DWORD code = 0;
    const bool active = GetExitCodeProcess(process, &code) && code == STILL_ACTIVE;
    CloseHandle(process);
    return active;
}

} // namespace

int Gui_Process::IsActive(unsigned long processId) {
    return processId <= std::numeric_limits<DWORD>::max() && hasProcess(static_cast<DWORD>(processId));
}

int Gui_Process::IsAbortExitCode(unsigned long code) {
    return code == STATUS_CONTROL_C_EXIT;
}

int Gui_Process::IsCrashExitCode(unsigned long code) {
    return !IsAbortExitCode(code) && (code & crashBits) != 0;
}
