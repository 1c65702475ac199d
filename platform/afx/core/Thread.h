#pragma once

/// @file
/// The thread that windows live on, with its message loop.

#include "platform/afx/core/Wnd.h"

/// The user-interface thread. A process has one: its CWinApp.
class TVX_PLATFORM_API CWinThread : public CCmdTarget {
    DECLARE_DYNAMIC(CWinThread)

public:
    CWinThread() = default;
    ~CWinThread() override = default;

    /// The window whose end is the application's end. Set it in InitInstance.
    CWnd* m_pMainWnd = nullptr;
    /// The in-place active window, null when there is none.
    CWnd* m_pActiveWnd = nullptr;

    /// Makes the application's first windows. FALSE ends the start-up.
    virtual BOOL InitInstance();
    /// Handles messages until the main window has ended or PostQuitMessage was called, then answers ExitInstance().
    /// An exception that escapes a handler comes out here.
    virtual int Run();
    /// Looks at every message before it is dispatched, after the windows on its road. TRUE consumes it. The base
    /// version offers it to the windows from the target up to the main frame.
    virtual BOOL PreTranslateMessage(MSG* message);
    /// Waits for one message and handles it. FALSE when the application is quitting.
    virtual BOOL PumpMessage();
    /// Work for when no message waits. Called with 0, 1, 2, ... until it answers FALSE or a message comes.
    virtual BOOL OnIdle(LONG count);
    /// Whether idle work is due after a message. The base version leaves out mouse moves that move nothing.
    virtual BOOL IsIdleMessage(MSG* message);
    /// Last call before the thread ends; the result is the process's exit code.
    virtual int ExitInstance();
    /// The application's main window: the active in-place frame, or m_pMainWnd.
    virtual CWnd* GetMainWnd();
    /// Puts a message without a window into the thread's queue; it arrives at PreTranslateMessage and the
    /// thread's own ON_THREAD_MESSAGE handlers.
    BOOL PostThreadMessage(UINT message, WPARAM wParam, LPARAM lParam);

protected:
    /// Calls the ON_THREAD_MESSAGE handler of a message that no window takes.
    BOOL DispatchThreadMessage(MSG* message);
    friend struct ThreadMessages;

private:
    CPoint m_lastMouse{-1, -1};
    UINT m_lastMessage = 0;
};

/// The thread of the caller: the application object on its user-interface thread, null elsewhere.
TVX_PLATFORM_API CWinThread* AfxGetThread();
/// The message now being handled, null outside of every handler. It is gone when its handler returns.
TVX_PLATFORM_API MSG* AfxGetCurrentMessage();
/// Whether a handler of an activation message (WM_ACTIVATE, WM_NCACTIVATE, WM_MDIACTIVATE, WM_MOUSEACTIVATE,
/// WM_SETFOCUS, WM_KILLFOCUS) of this thread is running, anywhere below the caller. The toolkit is changing its list of
/// child frames then, or going through it: a caller posts itself a message and destroys a frame when that arrives.
/// A modal loop that such a handler has opened is no exception, since the handler goes on after it; a caller that would
/// post again and again waits for the end of the loop instead.
TVX_PLATFORM_API bool AfxIsActivating();
/// Ends the application: PostQuitMessage, which tells more.
TVX_PLATFORM_API void AfxPostQuitMessage(int exitCode);
