#pragma once

/// @file
/// The calls that work on bare window handles. A handle that is no window (any more) makes them answer 0 and do
/// nothing.
///
/// Under X11 the handle of a top-level window is its X id, which means the same window to every process. The calls
/// `IsWindow`, `IsIconic`, `IsZoomed`, `ShowWindow`, `GetParent`, `GetClassNameA`, `GetWindowThreadProcessId` and
/// `SetForegroundWindow` take windows of other processes too. In a Wayland session they do not exist: handles of other
/// processes are no windows there.

#include "platform/afx/core/Message.h"

/// Windows: their tree, state, place and painting. Each call is the CWnd member of the same name.
/// @{
TVX_PLATFORM_API BOOL IsWindow(HWND window);
TVX_PLATFORM_API BOOL DestroyWindow(HWND window);
/// The parent of a child, the owner of a popup or dialog.
TVX_PLATFORM_API HWND GetParent(HWND window);
TVX_PLATFORM_API HWND SetParent(HWND window, HWND parent);
TVX_PLATFORM_API HWND GetWindow(HWND window, UINT relation);
TVX_PLATFORM_API HWND GetTopWindow(HWND window);
TVX_PLATFORM_API HWND GetDlgItem(HWND window, int id);
TVX_PLATFORM_API int GetDlgCtrlID(HWND window);
TVX_PLATFORM_API BOOL IsChild(HWND parent, HWND window);
TVX_PLATFORM_API BOOL IsWindowVisible(HWND window);
TVX_PLATFORM_API BOOL IsWindowEnabled(HWND window);
TVX_PLATFORM_API BOOL EnableWindow(HWND window, BOOL enable);
TVX_PLATFORM_API BOOL IsIconic(HWND window);
TVX_PLATFORM_API BOOL IsZoomed(HWND window);
/// The result tells whether the window was visible before. Windows of other processes are minimised, restored,
/// maximised and brought to the front; SW_HIDE leaves them as they are.
TVX_PLATFORM_API BOOL ShowWindow(HWND window, int command);
TVX_PLATFORM_API BOOL MoveWindow(HWND window, int x, int y, int width, int height, BOOL repaint);
TVX_PLATFORM_API BOOL SetWindowPos(HWND window, HWND after, int x, int y, int cx, int cy, UINT flags);
TVX_PLATFORM_API BOOL BringWindowToTop(HWND window);
TVX_PLATFORM_API BOOL GetWindowRect(HWND window, RECT* rect);
TVX_PLATFORM_API BOOL GetClientRect(HWND window, RECT* rect);
TVX_PLATFORM_API BOOL GetWindowPlacement(HWND window, WINDOWPLACEMENT* placement);
TVX_PLATFORM_API BOOL SetWindowPlacement(HWND window, const WINDOWPLACEMENT* placement);
TVX_PLATFORM_API BOOL ClientToScreen(HWND window, POINT* point);
TVX_PLATFORM_API BOOL ScreenToClient(HWND window, POINT* point);
/// Null stands for the screen.
TVX_PLATFORM_API int MapWindowPoints(HWND from, HWND to, POINT* points, UINT count);
TVX_PLATFORM_API BOOL InvalidateRect(HWND window, const RECT* rect, BOOL erase);
TVX_PLATFORM_API BOOL UpdateWindow(HWND window);
TVX_PLATFORM_API BOOL RedrawWindow(HWND window, const RECT* rect, HRGN region, UINT flags);
/// @}

/// Keyboard, mouse and activation: which window has them. The setting calls answer the window that had them before.
/// @{
TVX_PLATFORM_API HWND GetFocus();
TVX_PLATFORM_API HWND SetFocus(HWND window);
TVX_PLATFORM_API HWND GetCapture();
TVX_PLATFORM_API HWND SetCapture(HWND window);
TVX_PLATFORM_API BOOL ReleaseCapture();
TVX_PLATFORM_API HWND GetActiveWindow();
TVX_PLATFORM_API HWND SetActiveWindow(HWND window);
/// @}
/// The active window, this process's or another one's; null when there is none.
TVX_PLATFORM_API HWND GetForegroundWindow();
/// Brings a window to the front and makes it the active one. FALSE when it is no window, or when the window manager
/// refuses another process's: that one asks for attention then.
TVX_PLATFORM_API BOOL SetForegroundWindow(HWND window);
/// The screen's own window; its rectangle is the primary screen's.
TVX_PLATFORM_API HWND GetDesktopWindow();
/// The innermost window of this process at a point of the screen, hidden and disabled ones left out; null for none.
TVX_PLATFORM_API HWND WindowFromPoint(POINT point);
/// The first child, in the order of GetWindow, at a point of the parent's client area, hidden and disabled ones
/// included; the parent itself where no child is, null outside of it.
TVX_PLATFORM_API HWND ChildWindowFromPoint(HWND parent, POINT point);
/// The first top-level window of this process with that class (any case) and caption; null for either means any.
/// Windows of other processes are not found: EnumWindows lists them.
TVX_PLATFORM_API HWND FindWindowA(LPCSTR className, LPCSTR text);
/// Calls `callback` for all descendants of a window until it answers FALSE.
TVX_PLATFORM_API BOOL EnumChildWindows(HWND parent, WNDENUMPROC callback, LPARAM param);
/// Calls `callback` for each top-level window until it answers FALSE: this process's in the order of their creation,
/// then those of other processes that the window manager lists, the topmost first.
TVX_PLATFORM_API BOOL EnumWindows(WNDENUMPROC callback, LPARAM param);
/// The same for the windows of one thread. Of another process all windows belong to its first thread, whose number is
/// the process's own.
TVX_PLATFORM_API BOOL EnumThreadWindows(DWORD thread, WNDENUMPROC callback, LPARAM param);
/// The thread that a window lives on; 0 when it is no window, or one of another machine.
/// @param process receives the window's process; may be null; unchanged when the result is 0
TVX_PLATFORM_API DWORD GetWindowThreadProcessId(HWND window, DWORD* process);
/// Kept for hosts that attach to the foreground window's thread before they activate a window. The display has one
/// input for all, so nothing has to be attached. FALSE for equal threads and for 0.
TVX_PLATFORM_API BOOL AttachThreadInput(DWORD from, DWORD to, BOOL attach);

/// Texts and numbers of a window; buffers are always ended by NUL.
/// @{
TVX_PLATFORM_API BOOL SetWindowTextA(HWND window, LPCSTR text);
TVX_PLATFORM_API int GetWindowTextA(HWND window, LPSTR buffer, int size);
TVX_PLATFORM_API int GetWindowTextLengthA(HWND window);
TVX_PLATFORM_API int GetClassNameA(HWND window, LPSTR buffer, int size);
/// Style, extended style, identifier or user data (GWL_...); the setting call answers the previous value. Both answer 0
/// for another index. What a new style changes is seen at once, without SWP_FRAMECHANGED.
TVX_PLATFORM_API LONG_PTR GetWindowLongPtrA(HWND window, int index);
TVX_PLATFORM_API LONG_PTR SetWindowLongPtrA(HWND window, int index, LONG_PTR value);
/// @}

/// The pointer's place in screen pixels. FALSE without a display.
TVX_PLATFORM_API BOOL GetCursorPos(POINT* point);
/// Moves the pointer, as far as the desktop lets a program do that: Wayland desktops do not. FALSE without a display.
TVX_PLATFORM_API BOOL SetCursorPos(int x, int y);
/// Shows a cursor over the window that the pointer is in; meant for WM_SETCURSOR handlers. Answers the previous one.
TVX_PLATFORM_API HCURSOR SetCursor(HCURSOR cursor);
/// A cursor of the module's resources, or one of the system's (IDC_ARROW, ...), which need no module. Null when there
/// is none of that name or number. Cursors are shared and never destroyed.
TVX_PLATFORM_API HCURSOR LoadCursorA(HINSTANCE module, LPCSTR name);
/// The state of a key or mouse button (VK_...): negative when down; the lowest bit says of VK_CAPITAL, VK_NUMLOCK and
/// VK_SCROLL whether they are on, as far as the desktop tells (a Wayland session does not). Keys that went down while
/// another program had the keyboard are not known.
TVX_PLATFORM_API SHORT GetKeyState(int key);
/// The same: a program only hears of keys by its messages. A long calculation that wants to see Esc has to let them
/// come (PeekMessage, PumpMessage) before it asks.
TVX_PLATFORM_API SHORT GetAsyncKeyState(int key);

/// The caret: a mark in a window that shows where text is entered, blinking as the desktop's does. There is one for all
/// windows. A window makes it when it gets the keyboard and destroys it when it loses it; it comes hidden. Under the
/// caret the window is painted again each time it goes. FALSE when the caret is not that window's (null: any).
/// @{

/// @param bitmap whose size is taken; null or 1 (grey): `width` and `height`, where 0 is the width of a border
TVX_PLATFORM_API BOOL CreateCaret(HWND window, HBITMAP bitmap, int width, int height);
TVX_PLATFORM_API BOOL DestroyCaret();
/// Pixels of the client area.
TVX_PLATFORM_API BOOL SetCaretPos(int x, int y);
TVX_PLATFORM_API BOOL GetCaretPos(POINT* point);
/// A caret that was hidden several times has to be shown as often.
TVX_PLATFORM_API BOOL ShowCaret(HWND window);
TVX_PLATFORM_API BOOL HideCaret(HWND window);
/// @}

/// The dialog units of the system font (SYSTEM_FONT), in pixels: width in the low half, height in the high one. A
/// horizontal dialog unit is a quarter of the width, a vertical one an eighth of the height.
TVX_PLATFORM_API LONG GetDialogBaseUnits();

/// Starts a timer, or starts it anew when the window has one of that number. With a null window the number is chosen,
/// unless it is that of such a timer, and answered.
/// @param elapse   milliseconds, at least 1
/// @param callback called instead of sending WM_TIMER; null for the message
/// @return 0 when the window is none, or without a display
TVX_PLATFORM_API UINT_PTR SetTimer(HWND window, UINT_PTR id, UINT elapse, TIMERPROC callback);
/// Ends a timer; it does nothing any more. FALSE when there is none. A window's timers end with it.
TVX_PLATFORM_API BOOL KillTimer(HWND window, UINT_PTR id);

/// The same calls by the names without their suffix.
/// @{
inline HWND FindWindow(LPCSTR className, LPCSTR text) {
    return FindWindowA(className, text);
}
inline int GetClassName(HWND window, LPSTR buffer, int size) {
    return GetClassNameA(window, buffer, size);
}
inline LONG_PTR GetWindowLongPtr(HWND window, int index) {
    return GetWindowLongPtrA(window, index);
}
inline LONG_PTR SetWindowLongPtr(HWND window, int index, LONG_PTR value) {
    return SetWindowLongPtrA(window, index, value);
}
inline LONG_PTR GetWindowLong(HWND window, int index) {
    return GetWindowLongPtrA(window, index);
}
inline LONG_PTR SetWindowLong(HWND window, int index, LONG_PTR value) {
    return SetWindowLongPtrA(window, index, value);
}
inline BOOL SetWindowText(HWND window, LPCSTR text) {
    return SetWindowTextA(window, text);
}
inline int GetWindowTextLength(HWND window) {
    return GetWindowTextLengthA(window);
}
inline int GetWindowText(HWND window, LPSTR buffer, int size) {
    return GetWindowTextA(window, buffer, size);
}
inline HCURSOR LoadCursor(HINSTANCE module, LPCSTR name) {
    return LoadCursorA(module, name);
}
/// @}

// The system's cursors
#define IDC_ARROW MAKEINTRESOURCE(32512)
#define IDC_IBEAM MAKEINTRESOURCE(32513)
#define IDC_WAIT MAKEINTRESOURCE(32514)
#define IDC_CROSS MAKEINTRESOURCE(32515)
#define IDC_SIZENWSE MAKEINTRESOURCE(32642)
#define IDC_SIZENESW MAKEINTRESOURCE(32643)
#define IDC_SIZEWE MAKEINTRESOURCE(32644)
#define IDC_SIZENS MAKEINTRESOURCE(32645)
#define IDC_SIZEALL MAKEINTRESOURCE(32646)
#define IDC_NO MAKEINTRESOURCE(32648)
#define IDC_HAND MAKEINTRESOURCE(32649)
#define IDC_APPSTARTING MAKEINTRESOURCE(32650)
#define IDC_HELP MAKEINTRESOURCE(32651)
