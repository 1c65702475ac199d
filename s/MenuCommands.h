#pragma once

#include "afxwin.h"

#include <vector>

/// A command of a menu tree.
struct MenuCommand {
    CString label;     ///< the texts of the menus around it and its own, without marks, a blank before each
    CString shortCut;  ///< what the item shows behind its tab
    UINT id = 0;       ///< the command
    UINT state = 0;    ///< MF_GRAYED, MF_DISABLED, MF_CHECKED
    int nameStart = 0; ///< where in the label the item's own text begins
};

/// All commands of a menu and its popups, in the order of the menus. Items that open popups are none.
/// @param menu  null has none
[[nodiscard]] std::vector<MenuCommand> CommandsOf(const CMenu* menu);

/// What a command does: its string up to the first line break. Empty when there is no such string.
[[nodiscard]] CString PromptOf(UINT command);
