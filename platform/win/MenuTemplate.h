#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Module.h"
#include "platform/win/ResourceError.h"

#include <string>
#include <vector>

namespace tvx {

/// One line of a menu: a command, a separator, or a popup with lines of its own.
struct MenuItemTemplate {
    /// What choosing the line does.
    enum class Kind { Command, Separator, Popup };
    /// Whether a new column (in a menu bar: a new line) begins here: with a bar before it, or without.
    enum class Break { None, Bar, Column };

    Kind kind = Kind::Command;       ///< decides which of the other members matter
    Break breakBefore = Break::None; ///< MENUBARBREAK or MENUBREAK
    bool grayed = false;             ///< GRAYED
    bool inactive = false;           ///< INACTIVE: disabled, but drawn as usual
    bool checked = false;
    bool help = false;                   ///< HELP: at the right end of a menu bar
    UINT id = 0;                         ///< command identifier; popups of extended menus may have one, others 0
    UINT helpId = 0;                     ///< help context of a popup of an extended menu
    std::string text;                    ///< with "&" before the access key and a tab before the shortcut's name
    std::vector<MenuItemTemplate> items; ///< lines of a popup
};

/// Reads the data of an RT_MENU resource, plain or extended. The result is the lines of the menu bar, or the popups
/// of a context menu.
[[nodiscard]] TVX_PLATFORM_API ResourceResult<std::vector<MenuItemTemplate>> parseMenuTemplate(ResourceBytes data);

} // namespace tvx
