#include "platform/win/Process.h"

#include "platform/base/SystemPath.h"
#include "platform/win/Error.h"
#include "platform/win/detail/ChildEnvironment.h"
#include "platform/win/detail/PidFd.h"
#include "platform/win/detail/PipeObject.h"
#include "platform/win/detail/ProcessObject.h"
#include "platform/win/detail/ProgramSearch.h"
#include "platform/win/detail/Spawn.h"

#include <array>
#include <cerrno>
#include <optional>
#include <string>
#include <unistd.h>
#include <vector>

using namespace tvx::win;

namespace {

BOOL failed(DWORD error) {
    SetLastError(error);
    return FALSE;
}

/// The standard handles of a start-up record, held while a child is being started.
class StandardHandles {
public:
    StandardHandles(const STARTUPINFOA* startup, BOOL inherit) {
        if (!startup || !(startup->dwFlags & STARTF_USESTDHANDLES)) {
            return;
        }
        const HANDLE handles[] = {startup->hStdInput, startup->hStdOutput, startup->hStdError};
        for (std::size_t index = 0; index < m_objects.size(); ++index) {
            if (inherit && isInheritable(handles[index])) {
                m_objects[index] = objectOf<PipeObject>(handles[index]);
            }
            m_descriptors[index] = m_objects[index] ? m_objects[index]->descriptor() : nullDevice;
        }
    }

    const std::array<int, 3>& descriptors() const {
        return m_descriptors;
    }

private:
    std::array<std::shared_ptr<PipeObject>, 3> m_objects;
    std::array<int, 3> m_descriptors{0, 1, 2};
};

Program findProgram(LPCSTR application, LPCSTR commandLine) {
    if (!application) {
        return tvx::win::findProgram(commandLine);
    }
    Program program = tvx::win::findProgram("\"" + std::string(application) + "\"");
    program.arguments = commandLine ? readings(commandLine).front().arguments : std::string_view();
    return program;
}

/// The words of a command line for the child, as `execve` takes them.
class ChildArguments {
public:
    explicit ChildArguments(const Program& program) : m_words{program.name} {
        for (const std::string& word : splitArguments(program.arguments)) {
            m_words.push_back(wordForChild(word));
        }
        for (std::string& word : m_words) {
            m_pointers.push_back(word.data());
        }
        m_pointers.push_back(nullptr);
    }

    char* const* block() const {
        return m_pointers.data();
    }

private:
    std::vector<std::string> m_words;
    std::vector<char*> m_pointers;
};

StartShow showState(const STARTUPINFOA* startup) {
    const bool hidden = startup && (startup->dwFlags & STARTF_USESHOWWINDOW) && startup->wShowWindow == 0;
    return hidden ? StartShow::Hidden : StartShow::Normal;
}

DWORD errorOf(const SpawnResult& result) {
    const bool missing = result.error == ENOENT || result.error == ENOTDIR;
    if (result.failedStep == SpawnStep::Directory && missing) {
        return ERROR_DIRECTORY;
    }
    return tvx::errorFromErrno(result.error);
}

SpawnResult start(const Program& program, const std::optional<std::string>& directory, const STARTUPINFOA* startup,
                  BOOL inherit) {
    const ChildArguments arguments(program);
    const ChildEnvironment environment(showState(startup));
    const StandardHandles handles(startup, inherit);
    SpawnRequest request;
    request.program = program.file.c_str();
    request.arguments = arguments.block();
    request.environment = environment.block();
    request.directory = directory ? directory->c_str() : nullptr;
    request.standard = handles.descriptors();
    return spawn(request);
}

void hold(SpawnResult started, PROCESS_INFORMATION& information) {
    const auto child = std::make_shared<ProcessObject>(std::move(started.process), Kinship::Child, started.id);
    information.hProcess = makeHandle(child, Inheritance::None);
    information.hThread = makeHandle(child, Inheritance::None);
    information.dwProcessId = static_cast<DWORD>(started.id);
    information.dwThreadId = information.dwProcessId;
}

} // namespace

BOOL CreateProcessA(LPCSTR application, LPSTR commandLine, const SECURITY_ATTRIBUTES* /*processAttributes*/,
                    const SECURITY_ATTRIBUTES* /*threadAttributes*/, BOOL inherit, DWORD /*flags*/, LPVOID environment,
                    LPCSTR directory, const STARTUPINFOA* startup, PROCESS_INFORMATION* information) {
    if (environment) {
        return failed(ERROR_NOT_SUPPORTED);
    }
    const bool blank = commandLine && readings(commandLine).empty();
    if (blank || (!application && !commandLine)) {
        return failed(ERROR_INVALID_PARAMETER);
    }
    ReleasedChildren::instance().collect();
    const std::optional<std::string> folder = directory ? tvx::systemPath(directory) : std::nullopt;
    if (directory && !folder) {
        return failed(ERROR_DIRECTORY);
    }
    const Program program = findProgram(application, commandLine);
    if (program.file.empty()) {
        return failed(program.error);
    }
    SpawnResult result = start(program, folder, startup, inherit);
    if (!result.process) {
        return failed(errorOf(result));
    }
    hold(std::move(result), *information);
    return TRUE;
}

void GetStartupInfoA(STARTUPINFOA* startup) {
    *startup = {};
    if (askedStartShow() == StartShow::Hidden) {
        startup->dwFlags = STARTF_USESHOWWINDOW;
    }
}

DWORD WaitForInputIdle(HANDLE process, DWORD /*timeout*/) {
    if (objectOf<ProcessObject>(process)) {
        SetLastError(ERROR_NOT_SUPPORTED);
    }
    return WAIT_FAILED;
}

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
    return makeHandle(std::make_shared<ProcessObject>(std::move(process), Kinship::Stranger), Inheritance::None);
}

BOOL GetExitCodeProcess(HANDLE process, DWORD* code) {
    const auto object = objectOf<ProcessObject>(process);
    if (!object) {
        return FALSE;
    }
    *code = object->exitCode();
    return TRUE;
}

BOOL TerminateProcess(HANDLE process, UINT code) {
    const auto object = objectOf<ProcessObject>(process);
    const DWORD error = object ? object->terminate(code) : ERROR_INVALID_HANDLE;
    if (error != ERROR_SUCCESS) {
        SetLastError(error);
    }
    return error == ERROR_SUCCESS ? TRUE : FALSE;
}

namespace tvx {

void setLastInputTime(DWORD time) {
    keepLastInputTime(time);
}

} // namespace tvx
