#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// The command console: a window inside the main frame in which the user types commands at a numbered prompt, sees the
/// commands that were executed and what the application reports about them, recalls earlier ones, and copies or runs
/// those that he picks. What a command means is the application's affair.
///
/// @code
/// int RunCommand(const char* text) {
///     const bool done = Execute(text);
///     console.AddCommand(text);
///     console.AddStatusLine(done ? "Done." : "Expected: open <file>");
///     return done;
/// }
///
/// Gui_Console console(RunCommand, 0);
///
/// console.Init(); // in InitInstance, before the main frame is loaded
/// console.Open(); // a command of the main frame
/// @endcode
///
/// A host makes one object, whose lines and numbers outlive the windows; a second one at the same time is refused with
/// an internal error. The main frame must be one with child frames. All calls come from the
/// user-interface thread, also from within the callback, which may close the console or open dialogs.
///
/// | typed | runs |
/// |---|---|
/// | `!!` | the last command |
/// | `!21` | command 21 |
/// | `!run` | the newest command that begins with "run" |
///
/// Beside these, Up and Down go through the commands and come back to the unfinished text, and Ctrl+R searches while
/// the user types. docs/console.md tells users and hosts more.
class GUI_API Gui_Console {
public:
    /// @param callback  executes a command and answers 1 when it is done: the field is emptied. With any other result
    ///     the text stays in the field, to be corrected. It gets what is to be run, never a recall expression, and
    ///     reports by AddCommand and AddStatusLine: nothing is numbered, listed or recallable before AddCommand
    /// @param unused    there for hosts that give it
    Gui_Console(int (*callback)(const char*), int unused);
    /// Forgets all lines. A window that is still open stays, empty.
    ~Gui_Console();
    Gui_Console(const Gui_Console&) = delete;
    Gui_Console& operator=(const Gui_Console&) = delete;

    /// Registers the console's document template with the application. Call it once, before Open.
    /// @return 1
    int Init();
    /// Opens the window, with all lines there are; one that is open is activated.
    /// @return 1; 0 before Init, or when the application cannot show the window
    int Open();
    /// Closes the window.
    /// @return 1; 0 when none is open
    int Close();
    /// Whether a window is open.
    int IsOpen() const;

    /// Sets whether status lines are shown. Lines that the window has stay as they are.
    void SetShowCommandStatusFlag(int show);
    /// Whether status lines are shown: what the open window's box says, else what it said last; at first 0.
    int GetShowCommandStatusFlag() const;

    /// Appends a command with the next number.
    /// @return 1
    int AddCommand(const char* text);
    /// Appends a line of what the application reports.
    /// @return 1
    int AddStatusLine(const char* text);

    /// Sets whether the commands that the user ran are there for Up, Down and Ctrl+R after the next start, too: the
    /// last 500 of them, in the application's settings (without their numbers). At first they are not. Commands that
    /// may hold passwords are a reason to leave it so. Turning it off forgets what is kept.
    void SetKeepRecallFlag(int keep);
    /// Whether they are kept.
    int GetKeepRecallFlag() const;
};
