#pragma once

#include "platform/afx/core/App.h"
#include "platform/win/FrameworkIds.h"

namespace tvx::afx {

/// Whether the application has help: its handlers know the command ID_HELP.
inline bool isHelpOffered() {
    CWinApp* app = AfxGetApp();
    AFX_CMDHANDLERINFO handler{};
    return app && app->OnCmdMsg(ID_HELP, CN_COMMAND, nullptr, &handler);
}

} // namespace tvx::afx
