#include "s/Process.h"

#include "platform/win/Error.h"
#include "platform/win/Process.h"
#include "s/ProcessRecord.h"
#include "s/Record.h"

#include <algorithm>
#include <limits>
#include <utility>

namespace {

constexpr unsigned long crashBits = 0xC0000000;
constexpr WORD showHidden = 0;
constexpr WORD showNormally = 5;
constexpr DWORD smallPipe = 4096;

bool isValid(HANDLE handle) {
    return handle != INVALID_HANDLE_VALUE;
}

void close(HANDLE& handle) {
    if (isValid(handle)) {
        CloseHandle(std::exchange(handle, INVALID_HANDLE_VALUE));
    }
}

enum class PipeEnds { OnlyReadingForChild, BothForChild };

/// A pipe between the child and this process.
struct Pipe {
    HANDLE readEnd = INVALID_HANDLE_VALUE;
    HANDLE writeEnd = INVALID_HANDLE_VALUE;

    Pipe() = default;
    Pipe(const Pipe&) = delete;
    Pipe& operator=(const Pipe&) = delete;
    ~Pipe() {
        close(readEnd);
        close(writeEnd);
    }

    bool Create(PipeEnds ends) {
        const SECURITY_ATTRIBUTES inheritable{sizeof inheritable, nullptr, TRUE};
        // Little is written to a child.
        const DWORD size = ends == PipeEnds::OnlyReadingForChild ? smallPipe : 0;
        if (!CreatePipe(&readEnd, &writeEnd, &inheritable, size)) {
            return false;
        }
        const HANDLE self = GetCurrentProcess();
        return ends == PipeEnds::BothForChild || DuplicateHandle(self, writeEnd, self, &writeEnd, 0, FALSE,
                                                                 DUPLICATE_SAME_ACCESS | DUPLICATE_CLOSE_SOURCE);
    }
};

bool start(const char* commandLine, const char* directory, STARTUPINFOA& startup, PROCESS_INFORMATION& child) {
    CString line(commandLine);
    return CreateProcessA(nullptr, line.GetBuffer(), nullptr, nullptr, TRUE, 0, nullptr, directory, &startup, &child);
}

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

void Gui_Process::Record::NoteError() {
    lastError = GetLastError();
}

void Gui_Process::Record::SetPolicy(ReleasePolicy policy, DWORD code) {
    if (isValid(inputPipe)) {
        return;
    }
    releasePolicy = policy;
    releaseExitCode = code;
}

Gui_Process::Gui_Process() : m_record(MakeRecord<Record>()) {}

Gui_Process::~Gui_Process() {
    Release();
}

int Gui_Process::Run(const char* commandLine, const char* directory, int capture, int hidden) {
    Record& record = *m_record;
    record.lastError = 0;
    if (isValid(record.process)) {
        return 0;
    }
    Pipe input;
    Pipe output;
    // A child whose pipes nobody reads any more would hang on its next output.
    if (capture) {
        record.SetPolicy(TerminateOnRelease, 1);
    }
    STARTUPINFOA startup;
    startup.dwFlags = STARTF_USESHOWWINDOW | STARTF_USESTDHANDLES;
    startup.wShowWindow = hidden ? showHidden : showNormally;
    PROCESS_INFORMATION child;
    const bool connected =
        !capture || (input.Create(PipeEnds::OnlyReadingForChild) && output.Create(PipeEnds::BothForChild));
    startup.hStdInput = input.readEnd;
    startup.hStdOutput = startup.hStdError = output.writeEnd;
    if (!connected || !start(commandLine, directory, startup, child)) {
        record.NoteError();
        return 0;
    }
    WaitForInputIdle(child.hProcess, 1000);
    record.process = child.hProcess;
    record.processId = child.dwProcessId;
    record.mainThread = child.hThread;
    record.mainThreadId = child.dwThreadId;
    record.inputPipe = std::exchange(input.writeEnd, INVALID_HANDLE_VALUE);
    record.outputPipe = std::exchange(output.readEnd, INVALID_HANDLE_VALUE);
    record.exitCode = STILL_ACTIVE;
    return 1;
}

int Gui_Process::RunWaitForWindow(const char* commandLine, const char* directory, unsigned long /*timeout*/) {
    m_record->SetPolicy(LeaveRunning, 0);
    return Run(commandLine, directory, 0, 0);
}

DWORD Gui_Process::Record::CurrentExitCode() {
    lastError = 0;
    DWORD code = exitCode;
    if (exitCode != STILL_ACTIVE) {
        return code;
    }
    if (GetExitCodeProcess(process, &code)) {
        exitCode = code;
    } else {
        NoteError();
    }
    return code;
}

unsigned long Gui_Process::GetExitCode() {
    return m_record->CurrentExitCode();
}

int Gui_Process::IsActive() {
    return GetExitCode() == STILL_ACTIVE;
}

unsigned long Gui_Process::Wait(unsigned long timeout) const {
    // Without a child the handle would stand for the calling process, which never ends while it waits.
    if (!isValid(m_record->process)) {
        return WAIT_FAILED;
    }
    return WaitForSingleObject(m_record->process, static_cast<DWORD>(std::min<unsigned long>(timeout, INFINITE)));
}

int Gui_Process::Terminate(unsigned long exitCode) {
    Record& record = *m_record;
    record.lastError = 0;
    if (!isValid(record.process)) {
        return 0;
    }
    if (TerminateProcess(record.process, static_cast<UINT>(exitCode))) {
        return 1;
    }
    record.NoteError();
    return 0;
}

void Gui_Process::Release() {
    Record& record = *m_record;
    if (isValid(record.process) && record.releasePolicy != LeaveRunning) {
        Terminate(record.releaseExitCode);
    }
    record.StopNotifying();
    record.chunk.Empty();
    record.unfinished.clear();
    close(record.process);
    close(record.mainThread);
    close(record.inputPipe);
    close(record.outputPipe);
    record.mainThreadId = 0;
    record.lastError = 0;
    record.exitCode = 0xFFFFFFFF;
}

void Gui_Process::SetReleasePolicy(ReleasePolicy policy, unsigned long exitCode) {
    m_record->SetPolicy(policy, static_cast<DWORD>(exitCode));
}

DWORD Gui_Process::Record::WaitingBytes() {
    lastError = 0;
    DWORD waiting = 0;
    if (isValid(outputPipe) && !PeekNamedPipe(outputPipe, nullptr, 0, nullptr, &waiting, nullptr)) {
        NoteError();
    }
    return waiting;
}

int Gui_Process::HasOutput() {
    return m_record->WaitingBytes() > 0 || !m_record->unfinished.empty();
}

int Gui_Process::GetOutput(CString& text) {
    Record& record = *m_record;
    const DWORD waiting = record.WaitingBytes();
    const std::string held = std::exchange(record.unfinished, {});
    const int most = static_cast<int>(held.size() + waiting);
    if (most == 0) {
        return 0;
    }
    // A larger buffer has no use for the old content.
    if (text.GetAllocLength() <= most) {
        text.Empty();
    }
    DWORD count = 0;
    char* const buffer = text.GetBuffer(most + 1);
    char* const behind = std::ranges::copy(held, buffer).out;
    if (waiting > 0 && !ReadFile(record.outputPipe, behind, waiting, &count, nullptr)) {
        record.NoteError();
    }
    text.ReleaseBuffer(static_cast<int>(held.size() + count));
    return 1;
}

unsigned long Gui_Process::GetError() const {
    return m_record->lastError;
}

void* Gui_Process::GetProcessHandle() const {
    return m_record->process;
}

void* Gui_Process::GetMainThreadHandle() const {
    return m_record->mainThread;
}

unsigned long Gui_Process::GetMainThreadId() const {
    return m_record->mainThreadId;
}

unsigned long Gui_Process::GetProcessId() const {
    return m_record->processId;
}

int Gui_Process::IsActive(unsigned long processId) {
    return processId <= std::numeric_limits<DWORD>::max() && hasProcess(static_cast<DWORD>(processId));
}

int Gui_Process::IsAbortExitCode(unsigned long code) {
    return code == STATUS_CONTROL_C_EXIT;
}

int Gui_Process::IsCrashExitCode(unsigned long code) {
    return !IsAbortExitCode(code) && (code & crashBits) != 0;
}
