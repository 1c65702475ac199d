#pragma once

#include "platform/win/Handle.h"
#include "s/Process.h"

#include <chrono>
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
    std::string unfinished; ///< read, but it waits for its rest before it is shown
    std::chrono::steady_clock::time_point unfinishedSince;

    /// Asks for the exit code as long as the child runs.
    DWORD CurrentExitCode();
    /// Bytes that can be read; notes the error when none can come any more.
    DWORD WaitingBytes();
    /// Takes half a character or half a line end from the end of what was read, to be read again with its rest.
    void HoldBack(CString& text);
    /// How long what is held back still waits for its rest.
    std::chrono::milliseconds Patience(std::chrono::steady_clock::time_point now) const;
    /// Withdraws requests for messages about the child.
    void StopNotifying();
    /// Keeps the error of a call of the platform that failed.
    void NoteError();
    /// Ignored while a child with captured output is held.
    void SetPolicy(ReleasePolicy policy, DWORD code);
};
