#pragma once

/// @file
/// What lies behind menu handles: lists of items. They know nothing of the toolkit; detail/MenuWidgets shows them.

#include "platform/afx/core/Menu.h"

#include <memory>
#include <string>
#include <vector>

namespace tvx::afx {

/// One item: a command, a separator or a popup.
struct MenuItem {
    enum class Mark { Check, Radio };

    UINT flags = 0; ///< MF_SEPARATOR, MF_GRAYED, MF_DISABLED, MF_CHECKED, MF_OWNERDRAW, MF_MENUBREAK, ...
    UINT id = 0;    ///< The command; of no meaning for separators.
    std::string text;
    HMENU popup = nullptr;
    Mark mark = Mark::Check;
    bool isDefault = false;
    HBITMAP unchecked = nullptr;
    HBITMAP checked = nullptr;

    [[nodiscard]] bool isSeparator() const {
        return (flags & MF_SEPARATOR) != 0;
    }
    [[nodiscard]] bool isEnabled() const {
        return (flags & (MF_GRAYED | MF_DISABLED)) == 0;
    }
};

/// One menu. Its popups are menus of their own, destroyed with it.
struct Menu {
    HMENU handle = nullptr;
    std::vector<MenuItem> items;
};

/// The menu of a handle, null for what is none.
[[nodiscard]] TVX_PLATFORM_API Menu* menuFrom(HMENU handle);

/// Where an item stands.
struct MenuPlace {
    Menu* menu = nullptr;
    std::size_t index = 0;

    explicit operator bool() const {
        return menu != nullptr;
    }
    MenuItem& item() const {
        return menu->items[index];
    }
};
/// An item by position (MF_BYPOSITION) or by command, then also in the popups below.
[[nodiscard]] TVX_PLATFORM_API MenuPlace findItem(HMENU menu, UINT item, UINT flags);
/// Whether `inner` is `outer` or one of the popups in it, at any depth.
[[nodiscard]] bool contains(HMENU outer, HMENU inner);

/// The number that a text's "&" makes the access key, as a lower-case letter; 0 for none.
[[nodiscard]] TVX_PLATFORM_API char32_t accessKey(const std::string& text);

/// Hears of changes of any menu; bars show them at once.
class MenuListener {
public:
    MenuListener();
    virtual ~MenuListener();
    MenuListener(const MenuListener&) = delete;
    MenuListener& operator=(const MenuListener&) = delete;
    virtual void menuChanged(HMENU menu) = 0;
};

/// Tells the listeners. Called by everything that changes a menu.
void tellMenuChanged(HMENU menu);

} // namespace tvx::afx
