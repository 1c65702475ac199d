#pragma once

#include "afx.h"
#include "s/Export.h"

#include <memory>

class CEdit;

/// One program that runs as a child process.
///
/// The host makes one object for each program, starts it with Run, and asks from time to time what has become of it:
/// nothing here waits for the child or calls back, and no operation shows a message or throws. Output is collected
/// without ever blocking. A host that shows output as it comes is woken by NotifyWindow and needs no timer.
///
/// @code
/// Gui_Process compiler;
/// if (!compiler.Run("compile -v part.brd", nullptr, 1, 1))
///     report(compiler.GetError());
/// ...
/// // now and then, until it has ended and nothing is left:
/// compiler.AppendOutput(m_log, nullptr);
/// if (!compiler.IsActive() && !compiler.HasOutput())
///     report(compiler.GetExitCode());
/// @endcode
///
/// The object holds one child at a time, from a successful Run to Release, also after the child has ended. The
/// destructor releases. Objects are not copied, and belong to one thread; the static members may be called from any.
///
/// docs/processes.md has the rules of command lines, the exit codes, and what a child inherits.
class GUI_API Gui_Process {
public:
    /// What Release does to a child that it holds.
    enum ReleasePolicy {
        LeaveRunning = 0,       ///< the child runs on, and nothing of it stays behind when it ends
        TerminateOnRelease = 1, ///< the child is terminated, as by Terminate
    };

    /// Holds no child. The release policy is `TerminateOnRelease` with exit code 1.
    Gui_Process();
    /// Releases.
    virtual ~Gui_Process();
    Gui_Process(const Gui_Process&) = delete;
    Gui_Process& operator=(const Gui_Process&) = delete;

    /// Starts a program.
    /// @param commandLine  the program and its arguments; blanks in names are kept by quotes
    /// @param directory    where the child starts; null is the current directory
    /// @param capture      non-zero connects the child's standard input and output to pipes, and sets the release
    ///                     policy to `TerminateOnRelease` with exit code 1; 0: it reads nothing and its output is lost
    /// @param hidden       non-zero: an application of the family shows no window
    /// @return 1; 0 when the start failed (GetError says why) or a child is held already (GetError is 0)
    int Run(const char* commandLine, const char* directory, int capture, int hidden);
    /// Sets the release policy to `LeaveRunning` with exit code 0, then starts a program without capture, shown.
    /// @param timeout  not used: programs do not tell when their window is there
    int RunWaitForWindow(const char* commandLine, const char* directory, unsigned long timeout);

    /// Opens an address in a web browser: the user's, else that of the system, else the last resort. A browser that
    /// does not start gives way to the next; when none starts, one message box says what was tried. The browser runs on
    /// without being held, so it does not matter what this object holds. docs/programs.md has the rules.
    /// @param url        an address such as "file:///opt/tarvex/doc/usenglish/board/index.html"
    /// @param directory  where the browser starts; null or empty is the current directory
    /// @param wait       not used: a browser that was started is all that is waited for
    /// @param timeout    not used
    /// @return 1 when a browser was started, else 0
    int RunWebBrowser(const char* url, const char* directory, int wait, unsigned long timeout);
    /// Opens a text in the user's text editor (Gui_Profile::ReadTextEditorName). Sets the release policy to
    /// `LeaveRunning` with exit code 0.
    /// @param fileName   written behind the editor's command line as it is: a name with blanks needs its quotes
    /// @param directory  where the editor starts; null is the current directory
    /// @param wait       not used
    /// @param timeout    not used
    /// @return as Run
    int RunTextEditor(const char* fileName, const char* directory, int wait, unsigned long timeout);

    /// What the child ended with: 259 while it runs, 0xFFFFFFFF without a child. A child that crashed has a code
    /// beginning with 0xC or 0x8; one that was stopped by a signal 128 and the signal's number.
    unsigned long GetExitCode();
    /// Whether the child still runs: 1 or 0.
    int IsActive();
    /// Waits until the child has ended; messages are not handled meanwhile.
    /// @param timeout  milliseconds; 0xFFFFFFFF waits for ever
    /// @return 0 when it has ended, 258 when the time ran out, 0xFFFFFFFF without a child
    unsigned long Wait(unsigned long timeout) const;
    /// Ends the child at once; it cannot refuse. It is still held, and reports `exitCode` from then on. Programs that
    /// the child started end with it where they kept its process group, as the commands of a shell script do. Those of
    /// a child that has ended already run on, and keep its pipes.
    /// @return 0 without a child, or when it has ended already
    int Terminate(unsigned long exitCode);
    /// Lets go of the child as the release policy says, and of output that was not read. What the child has started
    /// ends only where Terminate ends it: it runs on when the child is left running, and when the child had ended
    /// before. Nothing happens without a child.
    void Release();
    /// Decides what Release does.
    /// @param exitCode  what a child that is terminated reports
    /// A child with captured output is always terminated with 1: the call is ignored while one is held.
    void SetReleasePolicy(ReleasePolicy policy, unsigned long exitCode);

    /// Whether captured output waits to be read: 1 or 0. Half a character or line end that AppendOutput holds back
    /// waits too.
    int HasOutput();
    /// Reads all captured output that waits, as it is.
    /// @param text  replaced; unchanged when nothing waits
    /// @return 1, or 0 when nothing waits. GetError is 109 when nothing can come any more.
    int GetOutput(CString& text);
    /// Appends the captured output that waits to a log, whose oldest text gives way at its limit
    /// (Gui_Edit::AppendText). A child that writes faster than the log takes it does not hold up the caller: what comes
    /// during the call may be left for the next one. Half a character or half a line end at the end of what has come is
    /// held back for its rest, until the child has ended or for 200 milliseconds; then a further call appends it as it
    /// is.
    /// @param lastChunk  receives the piece that was appended last, when there was one; may be null
    /// @return whether anything was appended: 1 or 0
    int AppendOutput(CEdit& edit, CString* lastChunk);
    /// Asks for one message as soon as there is something to do: output waits, what was held back has waited long
    /// enough, no more can come, or the child has ended. Ask again when it has been handled; messages come at most once
    /// a frame. Release and the window's end withdraw the request.
    /// @param window   one of this thread; it gets the message with two zeros
    /// @param message  its number; a later request with the same window and number replaces this one
    /// @return 1, or 0 when nothing is to be expected: no child, or GetExitCode has told its end and no output can come
    int NotifyWindow(HWND window, unsigned int message);

    /// Brings the windows of a running child to the front, minimised ones too.
    /// @return always 0
    int ShowMainWindow() const;

    /// The platform's error number of the last operation that failed; most operations begin by setting it to 0.
    unsigned long GetError() const;
    /// The child's handle, `INVALID_HANDLE_VALUE` without a child. It is closed by Release.
    void* GetProcessHandle() const;
    /// The handle of the child's first thread, likewise.
    void* GetMainThreadHandle() const;
    /// The id of the child's first thread, 0 without a child.
    unsigned long GetMainThreadId() const;
    /// The child's process id; has no meaning without a child.
    unsigned long GetProcessId() const;

    /// Whether any process with that id is alive. One that has ended but was not collected by its parent is not; one
    /// that the caller may not ask about is.
    static int IsActive(unsigned long processId);
    /// 1 for the exit code of a program that the interrupt keys stopped, 0xC000013A.
    static int IsAbortExitCode(unsigned long code);
    /// 1 for the exit code of a program that crashed: one of the two highest bits is set, and it is no abort.
    static int IsCrashExitCode(unsigned long code);

protected:
    struct Record;

    std::unique_ptr<Record> m_record;
};
