#pragma once

#include "platform/win/Handle.h"
#include "s/Process.h"

#include <string>

/// What a process object knows of its child.
struct Gui_Process::Record {
    HANDLE process = INVALID_HANDLE_VALUE;    ///< owned; invalid without a child
    HANDLE mainThread = INVALID_HANDLE_VALUE; ///< owned, kept for hosts that ask for it
    HANDLE inputPipe = INVALID_HANDLE_VALUE;  ///< this process's end of the child's standard input
    HANDLE outputPipe = INVALID_HANDLE_VALUE; ///< this process's end of the child's standard output and error
    DWORD lastError = 0;
    ReleasePolicy releasePolicy = TerminateOnRelease;
    DWORD releaseExitCode = 1;
    DWORD mainThreadId = 0;
    DWORD exitCode = 0xFFFFFFFF; ///< 0xFFFFFFFF without a child, `STILL_ACTIVE` until its end was seen
    DWORD processId = 0;
    bool notifies = false;  ///< a message about the child was asked for
    CString chunk;          ///< what AppendOutput read last: its room is used again
    std::string unfinished; ///< output that waits for its rest before it is shown

    /// Asks for the exit code as long as the child runs.
    DWORD CurrentExitCode();
    /// Withdraws requests for messages about the child.
    void StopNotifying();
    /// Keeps the error of a call of the platform that failed.
    void NoteError();
    /// Ignored while a child with captured output is held.
    void SetPolicy(ReleasePolicy policy, DWORD code);
};
