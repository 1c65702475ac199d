#include "s/Tutorial.h"

#include "res/resource.h"
#include "s/Msg.h"
#include "s/Process.h"

int Gui_Tutorial::Unsupported(const char* /*name*/) {
    return 0;
}

void Gui_Tutorial::DeleteMenuItem(CMenu* menu, unsigned int commandId) {
    if (!menu) {
        return;
    }
    const int count = static_cast<int>(menu->GetMenuItemCount());
    for (int position = 0; position < count; ++position) {
        DeleteMenuItem(menu->GetSubMenu(position), commandId);
    }
    while (menu->DeleteMenu(commandId, MF_BYCOMMAND)) {
    }
}

void Gui_Tutorial::Start(const char* commandLine) {
    Gui_Process tutorial;
    tutorial.SetReleasePolicy(Gui_Process::LeaveRunning, 0);
    if (!tutorial.Run(commandLine, nullptr, 0, 0)) {
        Gui_Msg message(GUI_IDS_TUTORIAL_FAILED);
        message << commandLine;
        AfxMessageBox(message);
    }
}
