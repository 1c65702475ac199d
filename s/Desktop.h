#pragma once

#include "afxwin.h"
#include "s/Export.h"

struct _XDisplay;

/// Operations on the desktop: the number under which other processes know a window, and bringing a window forward,
/// whichever process it belongs to.
///
/// A window identifier is the window's handle as a number of 32 bits. Under X11 that of a top-level window means the
/// same window to every process. In a pure Wayland session a process can neither see nor raise another one's windows:
/// their identifiers are no windows there (docs/languages.md).
class GUI_API Gui_Desktop {
public:
    Gui_Desktop() = delete;

    /// The identifier of the current thread's main window; 0 when there is no main window or no such thread.
    static unsigned long GetMainWindowID();
    /// The identifier of a window, such as a dialog.
    static unsigned long GetDialogWindowID(HWND dialog);

    /// Brings a window to the front, restored when it was minimised, and makes it the active one. When it is on another
    /// virtual desktop, that one is gone to. A window manager that does not allow it shows that the window asks for
    /// attention.
    /// @param windowId any number
    /// @return 0 when it is no window, or no longer; else 1
    static int ShowWindow(unsigned long windowId);

    /// The display connection of the window system. Always null: windows are reached by their handles here.
    static _XDisplay* GetDisplay();
};
