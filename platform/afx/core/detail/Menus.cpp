#include "platform/afx/core/detail/Menus.h"

#include "platform/afx/gdi/detail/HandleTable.h"
#include "platform/base/Text.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/MenuTemplate.h"
#include "platform/win/Resource.h"

#include <algorithm>

namespace tvx::afx {

namespace {

/// What a bare kind of item keeps of the flags it was made with.
constexpr UINT stateFlags = MF_GRAYED | MF_DISABLED | MF_CHECKED;
constexpr UINT keptFlags = stateFlags | MF_SEPARATOR | MF_OWNERDRAW | MF_MENUBREAK | MF_MENUBARBREAK | MF_HELP;
constexpr UINT noItem = 0xFFFFFFFF;

HandleTable<Menu>& menus() {
    static auto* table = new HandleTable<Menu>(9);
    return *table;
}

std::vector<MenuListener*>& listeners() {
    static auto* all = new std::vector<MenuListener*>;
    return *all;
}

HMENU addMenu() {
    auto menu = std::make_shared<Menu>();
    Menu& made = *menu;
    made.handle = reinterpret_cast<HMENU>(menus().add(std::move(menu)));
    return made.handle;
}

/// A popup's handle travels as the command; the calls of old took either.
MenuItem makeItem(UINT flags, UINT_PTR id, LPCSTR text) {
    MenuItem item;
    item.flags = flags & keptFlags;
    if ((flags & MF_POPUP) != 0) {
        item.popup = reinterpret_cast<HMENU>(id);
        item.id = noItem;
    } else {
        item.id = static_cast<UINT>(id);
    }
    const bool plain = (flags & (MF_BITMAP | MF_OWNERDRAW | MF_SEPARATOR)) == 0;
    if (plain && text) {
        item.text = text;
    } else if (plain && (flags & MF_POPUP) == 0) {
        item.flags |= MF_SEPARATOR; // an item without a text is drawn as one
    }
    return item;
}

void fillFrom(HMENU handle, const std::vector<MenuItemTemplate>& lines) {
    for (const MenuItemTemplate& line : lines) {
        MenuItem item;
        item.id = line.id;
        item.text = line.text;
        item.flags |= line.kind == MenuItemTemplate::Kind::Separator ? MF_SEPARATOR : 0U;
        item.flags |= line.grayed ? MF_GRAYED : 0U;
        item.flags |= line.inactive ? MF_DISABLED : 0U;
        item.flags |= line.checked ? MF_CHECKED : 0U;
        item.flags |= line.help ? MF_HELP : 0U;
        item.flags |= line.breakBefore == MenuItemTemplate::Break::Bar      ? MF_MENUBARBREAK
                      : line.breakBefore == MenuItemTemplate::Break::Column ? MF_MENUBREAK
                                                                            : 0U;
        if (line.kind == MenuItemTemplate::Kind::Popup) {
            item.popup = addMenu();
            fillFrom(item.popup, line.items);
        }
        menuFrom(handle)->items.push_back(std::move(item));
    }
}

char32_t firstCharacter(const std::string& text) {
    std::size_t at = 0;
    return text::decode(text, at);
}

MenuPlace findCommand(HMENU handle, UINT id) {
    Menu* menu = menuFrom(handle);
    if (!menu) {
        return {};
    }
    for (std::size_t i = 0; i < menu->items.size(); ++i) {
        const MenuItem& item = menu->items[i];
        if (!item.popup && item.id == id && !item.isSeparator()) {
            return {menu, i};
        }
    }
    for (const MenuItem& item : menu->items) {
        if (const MenuPlace place = findCommand(item.popup, id)) {
            return place;
        }
    }
    return {};
}

} // namespace

Menu* menuFrom(HMENU handle) {
    return menus().find(reinterpret_cast<std::uintptr_t>(handle)).get();
}

MenuPlace findItem(HMENU handle, UINT item, UINT flags) {
    if ((flags & MF_BYPOSITION) == 0) {
        return findCommand(handle, item);
    }
    Menu* menu = menuFrom(handle);
    return menu && item < menu->items.size() ? MenuPlace{menu, item} : MenuPlace{};
}

bool contains(HMENU outer, HMENU inner) {
    if (outer == inner) {
        return true;
    }
    const Menu* menu = menuFrom(outer);
    return menu && std::any_of(menu->items.begin(), menu->items.end(),
                               [inner](const MenuItem& item) { return item.popup && contains(item.popup, inner); });
}

char32_t accessKey(const std::string& text) {
    for (std::size_t i = 0; i + 1 < text.size() && text[i] != '\t'; ++i) {
        if (text[i] != '&') {
            continue;
        }
        if (text[i + 1] == '&') {
            ++i;
            continue;
        }
        return firstCharacter(text::toLower(std::string_view(text).substr(i + 1)));
    }
    return 0;
}

MenuListener::MenuListener() {
    listeners().push_back(this);
}

MenuListener::~MenuListener() {
    std::erase(listeners(), this);
}

void tellMenuChanged(HMENU menu) {
    const auto all = listeners();
    for (MenuListener* listener : all) {
        listener->menuChanged(menu);
    }
}

} // namespace tvx::afx

using namespace tvx::afx;

HMENU CreateMenu() {
    return addMenu();
}

HMENU CreatePopupMenu() {
    return addMenu();
}

HMENU LoadMenuA(HINSTANCE module, LPCSTR name) {
    const auto lines = tvx::parseMenuTemplate(tvx::resourceBytes(module, name, RT_MENU));
    if (!lines) {
        return nullptr;
    }
    const HMENU menu = addMenu();
    fillFrom(menu, *lines);
    return menu;
}

BOOL DestroyMenu(HMENU handle) {
    const auto menu = menus().take(reinterpret_cast<std::uintptr_t>(handle));
    if (!menu) {
        return FALSE;
    }
    for (const MenuItem& item : menu->items) {
        if (item.popup) {
            DestroyMenu(item.popup);
        }
    }
    tellMenuChanged(handle);
    return TRUE;
}

BOOL IsMenu(HMENU menu) {
    return menuFrom(menu) ? TRUE : FALSE;
}

// --- items ---

BOOL AppendMenuA(HMENU menu, UINT flags, UINT_PTR id, LPCSTR text) {
    return InsertMenuA(menu, noItem, flags | MF_BYPOSITION, id, text);
}

BOOL InsertMenuA(HMENU handle, UINT position, UINT flags, UINT_PTR id, LPCSTR text) {
    Menu* menu = menuFrom(handle);
    const auto popup = (flags & MF_POPUP) != 0 ? reinterpret_cast<HMENU>(id) : nullptr;
    if (!menu || ((flags & MF_POPUP) != 0 && (!menuFrom(popup) || contains(popup, handle)))) {
        return FALSE;
    }
    MenuPlace place = findItem(handle, position, flags);
    if (!place) {
        place = {menu, menu->items.size()};
    }
    auto& items = place.menu->items;
    items.insert(items.begin() + static_cast<std::ptrdiff_t>(place.index), makeItem(flags, id, text));
    tellMenuChanged(place.menu->handle);
    return TRUE;
}

BOOL ModifyMenuA(HMENU handle, UINT position, UINT flags, UINT_PTR id, LPCSTR text) {
    const MenuPlace place = findItem(handle, position, flags);
    if (!place) {
        return FALSE;
    }
    MenuItem item = makeItem(flags, id, text);
    const HMENU old = place.item().popup;
    if (item.popup && item.popup != old && contains(item.popup, handle)) {
        return FALSE;
    }
    place.item() = std::move(item);
    const HMENU changed = place.menu->handle;
    if (old && old != place.item().popup) {
        DestroyMenu(old);
    }
    tellMenuChanged(changed);
    return TRUE;
}

BOOL RemoveMenu(HMENU handle, UINT position, UINT flags) {
    const MenuPlace place = findItem(handle, position, flags);
    if (!place) {
        return FALSE;
    }
    place.menu->items.erase(place.menu->items.begin() + static_cast<std::ptrdiff_t>(place.index));
    tellMenuChanged(place.menu->handle);
    return TRUE;
}

BOOL DeleteMenu(HMENU handle, UINT position, UINT flags) {
    const MenuPlace place = findItem(handle, position, flags);
    if (!place) {
        return FALSE;
    }
    const HMENU popup = place.item().popup;
    RemoveMenu(handle, position, flags);
    if (popup) {
        DestroyMenu(popup);
    }
    return TRUE;
}

namespace {

/// Sets some of the state bits and answers the old ones, noItem when there is no such item.
UINT changeState(HMENU handle, UINT item, UINT flags, UINT mask) {
    const MenuPlace place = findItem(handle, item, flags);
    if (!place) {
        return noItem;
    }
    UINT& state = place.item().flags;
    const UINT old = state & mask;
    if (old != (flags & mask)) {
        state = (state & ~mask) | (flags & mask);
        tellMenuChanged(place.menu->handle);
    }
    return old;
}

} // namespace

BOOL EnableMenuItem(HMENU menu, UINT item, UINT flags) {
    return static_cast<BOOL>(changeState(menu, item, flags, MF_GRAYED | MF_DISABLED));
}

DWORD CheckMenuItem(HMENU menu, UINT item, UINT flags) {
    const MenuPlace place = findItem(menu, item, flags);
    if (place && (flags & MF_CHECKED) != 0) {
        place.item().mark = MenuItem::Mark::Check;
    }
    return changeState(menu, item, flags, MF_CHECKED);
}

BOOL CheckMenuRadioItem(HMENU menu, UINT first, UINT last, UINT checked, UINT flags) {
    BOOL found = FALSE;
    for (UINT item = first; item <= last; ++item) {
        const MenuPlace place = findItem(menu, item, flags);
        if (!place) {
            continue;
        }
        changeState(menu, item, (flags & MF_BYPOSITION) | (item == checked ? MF_CHECKED : 0U), MF_CHECKED);
        if (item == checked) {
            place.item().mark = MenuItem::Mark::Radio;
            found = TRUE;
        }
    }
    return found;
}

BOOL SetMenuDefaultItem(HMENU handle, UINT item, UINT byPosition) {
    Menu* menu = menuFrom(handle);
    if (!menu) {
        return FALSE;
    }
    const MenuPlace place = findItem(handle, item, byPosition != 0 ? MF_BYPOSITION : MF_BYCOMMAND);
    if (!place && item != noItem) {
        return FALSE;
    }
    // A command may be in a popup below: the popup has one default item, like every menu.
    Menu& changed = place ? *place.menu : *menu;
    for (MenuItem& other : changed.items) {
        other.isDefault = false;
    }
    if (place) {
        place.item().isDefault = true;
    }
    tellMenuChanged(changed.handle);
    return TRUE;
}

BOOL SetMenuItemBitmaps(HMENU menu, UINT position, UINT flags, HBITMAP unchecked, HBITMAP checked) {
    const MenuPlace place = findItem(menu, position, flags);
    if (!place) {
        return FALSE;
    }
    place.item().unchecked = unchecked;
    place.item().checked = checked;
    tellMenuChanged(place.menu->handle);
    return TRUE;
}

// --- questions ---

int GetMenuItemCount(HMENU handle) {
    const Menu* menu = menuFrom(handle);
    return menu ? static_cast<int>(menu->items.size()) : -1;
}

UINT GetMenuItemID(HMENU menu, int position) {
    const MenuPlace place = findItem(menu, static_cast<UINT>(position), MF_BYPOSITION);
    if (!place || place.item().popup) {
        return noItem;
    }
    return place.item().isSeparator() ? 0 : place.item().id;
}

UINT GetMenuState(HMENU menu, UINT item, UINT flags) {
    const MenuPlace place = findItem(menu, item, flags);
    if (!place) {
        return noItem;
    }
    const MenuItem& found = place.item();
    if (!found.popup) {
        return found.flags;
    }
    const auto count = static_cast<UINT>(std::max(0, GetMenuItemCount(found.popup)));
    return ((found.flags | MF_POPUP) & 0xFFU) | (count << 8U);
}

int GetMenuStringA(HMENU menu, UINT item, LPSTR buffer, int size, UINT flags) {
    const MenuPlace place = findItem(menu, item, flags);
    const std::string text = place ? place.item().text : std::string();
    if (!buffer || size <= 0) {
        return static_cast<int>(text.size());
    }
    return static_cast<int>(::tvx::text::copyCut(text, buffer, static_cast<std::size_t>(size)));
}

HMENU GetSubMenu(HMENU menu, int position) {
    const MenuPlace place = findItem(menu, static_cast<UINT>(position), MF_BYPOSITION);
    return place ? place.item().popup : nullptr;
}
