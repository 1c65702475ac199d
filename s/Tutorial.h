#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// The tutorials on a host's menus. There are no objects of this class.
///
/// @code
/// if (Gui_Tutorial::Unsupported("layout"))
///     Gui_Tutorial::DeleteMenuItem(menu, ID_TUTORIAL_LAYOUT);
/// ...
/// Gui_Tutorial::Start("layout-tutorial --first");
/// @endcode
class GUI_API Gui_Tutorial {
public:
    Gui_Tutorial() = delete;

    /// Whether a tutorial is not to be offered.
    /// @return 0: all are supported
    static int Unsupported(const char* name);
    /// Takes every item of a command off a menu and off its submenus, at any depth.
    /// @param menu  null: nothing happens
    static void DeleteMenuItem(CMenu* menu, unsigned int commandId);
    /// Runs the program of a tutorial, which runs on by itself. A message box says when it cannot be started.
    static void Start(const char* commandLine);
};
