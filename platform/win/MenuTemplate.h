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
    enum class Kind { Command, Separator, Popup };
    /// Placement asked for in the script: on the line as usual, in a new column (with a line before it), or pushed to
    /// the right end of the menu bar.
    enum class Break { None, Bar, Column };

    Kind kind = Kind::Command;
    Break breakBefore = Break::None;
    bool grayed = false;   ///< GRAYED
    bool inactive = false; ///< INACTIVE: disabled, but drawn as usual
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
