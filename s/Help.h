#pragma once

#include "s/Export.h"

/// Help requests of the application's own: each goes to the application object's WinHelp, as those of the help key do
/// (docs/help-requests.md). There are no objects of this class.
///
/// @code
/// void CScaleDlg::OnHelpButton() {
///     Gui_Help::OnDialog(IDD);
/// }
/// @endcode
///
/// Without an application object nothing happens.
class GUI_API Gui_Help {
public:
    Gui_Help() = delete;

    /// Help on a command: its number is added to HID_BASE_COMMAND. The others differ in what the number is added to.
    static void OnCommand(unsigned int id);
    /// Help on a dialog or another resource: HID_BASE_RESOURCE.
    static void OnDialog(unsigned int id);
    /// Help on a message: HID_BASE_PROMPT.
    static void OnPrompt(unsigned int id);
    /// Help on a bar: HID_BASE_CONTROL.
    static void OnFrameControl(unsigned int id);
    /// The contents page.
    /// @param id  not used: the signature is that of a command handler
    static void OnContents(unsigned int id);

    /// Says where the application's help is; called in InitInstance.
    ///
    /// With a help map of that package, the application's help file becomes the map's name and requests are answered
    /// from it. Otherwise an installed help file of that name is taken.
    /// @param name  the package with the extension ".map" or ".hlp", as in "board.map"; a name without one stays
    ///              without, and Gui_WinApp then takes the help file for no map
    /// @return 1, or 0 when neither is installed; the name of the map is set all the same then
    static int SetHelpFileName(const char* name);
};
