#pragma once

#include "afxwin.h"
#include "s/BrowserHelp.h"
#include "s/MessageOrigin.h"

/// What the application object keeps for itself.
struct Gui_WinAppData {
    int registered = 0; ///< 1 once this process has made itself the first instance
    CString usageText;  ///< the host's text behind the usage summary
    CString pending;    ///< messages of the command-line check that are still to be shown
    Gui_BrowserHelp help;
    CDocManager* docManager = nullptr; ///< what InitApplication has installed; only compared
};

/// The origin of the messages that the application object issues.
inline Port_MsgManData WinAppOrigin(int line) {
    return LibraryOrigin("../s/WinApp", line, "$Revision");
}
