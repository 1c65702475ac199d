#include "platform/afx/core/Accelerator.h"

#include "platform/afx/core/Menu.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Menus.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/detail/HandleTable.h"
#include "platform/win/AcceleratorTemplate.h"
#include "platform/win/Resource.h"

#include <algorithm>
#include <vector>

using namespace tvx::afx;

namespace {

using Table = std::vector<ACCEL>;

HandleTable<Table>& accelerators() {
    static auto* table = new HandleTable<Table>(10);
    return *table;
}

HACCEL addTable(Table table) {
    return reinterpret_cast<HACCEL>(accelerators().add(std::make_shared<Table>(std::move(table))));
}

std::shared_ptr<Table> tableOf(HACCEL handle) {
    return accelerators().find(reinterpret_cast<std::uintptr_t>(handle));
}

/// Whether the entry's modifiers are down beside its key, and no others.
bool hasModifiers(const ACCEL& entry) {
    const auto held = acceleratorModifiers(entry.key);
    return held && held->shift == ((entry.fVirt & FSHIFT) != 0) && held->control == ((entry.fVirt & FCONTROL) != 0) &&
           held->alt == ((entry.fVirt & FALT) != 0);
}

bool matches(const ACCEL& entry, const MSG& message) {
    const bool virtualKey = (entry.fVirt & FVIRTKEY) != 0;
    switch (message.message) {
    case WM_KEYDOWN:
    case WM_SYSKEYDOWN:
        return virtualKey && entry.key == message.wParam && hasModifiers(entry);
    case WM_CHAR:
        return !virtualKey && (entry.fVirt & FALT) == 0 && entry.key == message.wParam;
    case WM_SYSCHAR:
        return !virtualKey && (entry.fVirt & FALT) != 0 && entry.key == message.wParam;
    default:
        return false;
    }
}

/// Lets the owner bring the state of the popup with a command up to date, as if it were opened.
bool isEnabled(HWND window, UINT command) {
    const HMENU menu = GetMenu(window);
    MenuPlace place = findItem(menu, command, MF_BYCOMMAND);
    if (!place) {
        return true;
    }
    const HMENU popup = place.menu->handle;
    if (popup != menu) {
        int index = 0;
        while (GetSubMenu(menu, index) != popup && index < GetMenuItemCount(menu)) {
            ++index;
        }
        SendMessageA(window, WM_INITMENU, reinterpret_cast<WPARAM>(menu), 0);
        SendMessageA(window, WM_INITMENUPOPUP, reinterpret_cast<WPARAM>(popup), MAKELPARAM(index, FALSE));
    }
    place = findItem(menu, command, MF_BYCOMMAND);
    return !place || place.item().isEnabled();
}

} // namespace

HACCEL LoadAcceleratorsA(HINSTANCE module, LPCSTR name) {
    const auto entries = tvx::parseAcceleratorTemplate(tvx::resourceBytes(module, name, RT_ACCELERATOR));
    if (!entries) {
        return nullptr;
    }
    Table table;
    for (const auto& entry : *entries) {
        table.push_back({entry.flags, entry.key, entry.command});
    }
    return addTable(std::move(table));
}

HACCEL CreateAcceleratorTableA(const ACCEL* entries, int count) {
    return entries && count > 0 ? addTable(Table(entries, entries + count)) : nullptr;
}

int CopyAcceleratorTableA(HACCEL handle, ACCEL* entries, int count) {
    const auto table = tableOf(handle);
    if (!table) {
        return 0;
    }
    const auto all = static_cast<int>(table->size());
    if (!entries) {
        return all;
    }
    const int copied = std::clamp(count, 0, all);
    std::copy_n(table->begin(), copied, entries);
    return copied;
}

BOOL DestroyAcceleratorTable(HACCEL table) {
    return accelerators().take(reinterpret_cast<std::uintptr_t>(table)) ? TRUE : FALSE;
}

int TranslateAcceleratorA(HWND window, HACCEL handle, MSG* message) {
    if (message->message < WM_KEYFIRST || message->message > WM_KEYLAST) {
        return 0;
    }
    const auto table = tableOf(handle);
    if (!table || !Window::from(window)) {
        return 0;
    }
    const auto found =
        std::find_if(table->begin(), table->end(), [message](const ACCEL& entry) { return matches(entry, *message); });
    if (found == table->end()) {
        return 0;
    }
    const WORD command = found->cmd;
    if (command >= SC_SIZE && findItem(GetSystemMenu(window, FALSE), command, MF_BYCOMMAND)) {
        SendMessageA(window, WM_SYSCOMMAND, command, 1 << 16);
    } else if (command != 0 && IsWindowEnabled(window) && isEnabled(window, command)) {
        SendMessageA(window, WM_COMMAND, MAKEWPARAM(command, 1), 0);
    }
    return 1;
}
