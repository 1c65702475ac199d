#include "platform/win/Process.h"

#include "platform/win/Error.h"
#include "platform/win/detail/PidFd.h"
#include "platform/win/detail/ProcessObject.h"

#include <cerrno>
#include <unistd.h>

using namespace tvx::win;

DWORD GetCurrentProcessId() {
    return static_cast<DWORD>(::getpid());
}

HANDLE GetCurrentProcess() {
    return INVALID_HANDLE_VALUE;
}

HANDLE OpenProcess(DWORD access, BOOL /*inherit*/, DWORD processId) {
    if (access & ~PROCESS_QUERY_INFORMATION) {
        SetLastError(ERROR_ACCESS_DENIED);
        return nullptr;
    }
    Descriptor process(::pidfd_open(static_cast<pid_t>(processId), 0));
    if (!process) {
        // ENOENT is the system's answer to the id of a thread that is no process.
        SetLastError(errno == ENOENT ? ERROR_INVALID_PARAMETER : tvx::errorFromErrno(errno));
        return nullptr;
    }
    return makeHandle(std::make_shared<ProcessObject>(std::move(process), Kinship::stranger), Inheritance::none);
}

BOOL GetExitCodeProcess(HANDLE process, DWORD* code) {
    const auto object = objectOf<ProcessObject>(process);
    if (!object)
        return FALSE;
    *code = object->exitCode();
    return TRUE;
}

BOOL TerminateProcess(HANDLE process, UINT code) {
    const auto object = objectOf<ProcessObject>(process);
    const DWORD error = object ? object->terminate(code) : ERROR_INVALID_HANDLE;
    if (error != ERROR_SUCCESS)
        SetLastError(error);
    return error == ERROR_SUCCESS ? TRUE : FALSE;
}
