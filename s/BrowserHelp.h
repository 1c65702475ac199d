#pragma once

#include "s/Export.h"

#include <memory>

/// Answers help requests from a help map: finds the documents of a request, lets the user choose when there are
/// several, and opens one in the web browser or the PDF viewer (docs/help-requests.md).
///
/// Gui_WinApp has one, which gets all requests of an application whose help file is a map. A host that keeps the help
/// of a component apart makes one of its own:
///
/// @code
/// Gui_BrowserHelp meshHelp;
/// if (meshHelp.SetHelpMapFileName("mesh.map"))
///     meshHelp.HelpForMapRecordKey("solver iterative");
/// @endcode
///
/// A request is done when its document was handed to a program, or the user was told why not. Before a program comes
/// up, open menus are closed, help mode and mouse capture end. With the environment variable `TVX_GUI_HELP_DEBUG` set
/// when the object is made, each request is shown in a message box first, with the numbers that it came with.
class GUI_API Gui_BrowserHelp {
public:
    /// No map yet.
    Gui_BrowserHelp();
    ~Gui_BrowserHelp();
    Gui_BrowserHelp(const Gui_BrowserHelp&) = delete;
    Gui_BrowserHelp& operator=(const Gui_BrowserHelp&) = delete;

    /// Chooses the map of a package; the user is told when it is not installed. It is read with the first request, and
    /// its records are added to those of a map that was chosen before.
    /// @param name  the package, with or without ".map"; nothing is done when the map in use ends with it
    /// @return 1; 0 when there is no such map: a map in use stays in use
    int SetHelpMapFileName(const char* name);

    /// Answers one request of the framework.
    /// @param dwData  for HELP_CONTEXT the context, 0x20080 for the contents page; for HELP_KEY the address of the
    ///                keyword, 0 for none; else nothing
    /// @param nCmd    HELP_CONTEXT: the first document of the record; HELP_CONTENTS or HELP_FINDER: the contents page;
    ///                HELP_KEY: a choice where there are several; anything else is not found
    /// @return 0 when there is no map or no browser could be started, else 1: also when there is no help for it or the
    ///         user has chosen nothing
    int BrowserHelp(unsigned long dwData, unsigned int nCmd);
    /// Answers a request for a key of the map, such as "dialog 12".
    /// @return as BrowserHelp
    int HelpForMapRecordKey(const char* key);

    /// Help on a command, a dialog or other resource, a message, a bar: BrowserHelp with the number added to the base
    /// of its kind.
    /// @{
    int OnCommand(unsigned int id);
    int OnDialog(unsigned int id);
    int OnPrompt(unsigned int id);
    int OnFrameControl(unsigned int id);
    /// @}
    /// The contents page.
    int OnContents();
    /// Does nothing: failures are told where they happen.
    void DisplayFailureOnHelp();

private:
    struct Record;

    std::unique_ptr<Record> m_record;
};
