#include "s/MenuCommands.h"

#include "s/MenuStr.h"
#include "s/StringOf.h"

namespace {

void collect(const CMenu& menu, const CString& prefix, std::vector<MenuCommand>& commands) {
    for (int item = 0; item < static_cast<int>(menu.GetMenuItemCount()); ++item) {
        const UINT id = menu.GetMenuItemID(item);
        if (id == 0) {
            continue;
        }
        const Gui_MenuStr text(&menu, item, MF_BYPOSITION);
        MenuCommand command;
        command.nameStart = prefix.GetLength() + 1;
        command.label = prefix + " " + text.GetCommandText();
        if (const CMenu* popup = menu.GetSubMenu(item)) {
            collect(*popup, command.label, commands);
            continue;
        }
        command.shortCut = text.GetShortCutKeyText();
        command.id = id;
        command.state = menu.GetMenuState(static_cast<UINT>(item), MF_BYPOSITION);
        tvx::allocating([&] { commands.push_back(std::move(command)); });
    }
}

} // namespace

std::vector<MenuCommand> CommandsOf(const CMenu* menu) {
    std::vector<MenuCommand> commands;
    if (menu) {
        collect(*menu, CString(), commands);
    }
    return commands;
}

CString PromptOf(UINT command) {
    CString prompt;
    AfxExtractSubString(prompt, StringOf(command), 0);
    return prompt;
}
