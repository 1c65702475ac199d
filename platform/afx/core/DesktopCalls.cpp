// The calls that also work on windows of other processes: own windows are answered for here, the desktop is asked about
// the others.
#include "platform/afx/core/WindowCalls.h"

#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/win/Desktop.h"
#include "platform/win/Error.h"
#include "platform/win/Process.h"

#include <algorithm>
#include <cstring>
#include <string>
#include <vector>

using namespace tvx::afx;
namespace desktop = tvx::desktop;

namespace {

/// The desktop's number of a handle. X ids have 29 bits; other handles are numbers that only this process knows.
desktop::WindowId idOf(HWND handle) {
    const auto value = reinterpret_cast<std::uintptr_t>(handle);
    return value < (1U << 29) ? static_cast<desktop::WindowId>(value) : 0;
}

HWND handleOf(desktop::WindowId id) {
    return reinterpret_cast<HWND>(static_cast<std::uintptr_t>(id));
}

bool isForeign(HWND handle) {
    const bool found = desktop::exists(idOf(handle));
    if (!found) {
        SetLastError(ERROR_INVALID_WINDOW_HANDLE);
    }
    return found;
}

BOOL toBool(bool value) {
    return value ? TRUE : FALSE;
}

/// Shows a window of another process. It is never hidden: the process would not know that it is.
void showForeign(desktop::WindowId window, int command) {
    switch (command) {
    case SW_MINIMIZE:
    case SW_SHOWMINIMIZED:
    case SW_SHOWMINNOACTIVE:
        desktop::minimize(window);
        break;
    case SW_SHOWMAXIMIZED:
        desktop::setExtent(window, desktop::Extent::Maximized);
        (void)desktop::activate(window);
        break;
    case SW_RESTORE:
    case SW_SHOWNORMAL:
        // A minimised window comes back as large as it was.
        if (!desktop::isIconic(window) && desktop::isMaximized(window)) {
            desktop::setExtent(window, desktop::Extent::Normal);
        }
        (void)desktop::activate(window);
        break;
    case SW_SHOW:
    case SW_SHOWDEFAULT:
        (void)desktop::activate(window);
        break;
    default:
        break;
    }
}

/// False when the callback wanted no more.
bool tellOwn(WNDENUMPROC callback, LPARAM param) {
    return std::ranges::all_of(Window::topLevelHandles(),
                               [&](HWND handle) { return !Window::from(handle) || callback(handle, param) != FALSE; });
}

/// The windows of one process, of all other ones for 0.
bool tellForeign(DWORD process, WNDENUMPROC callback, LPARAM param) {
    return std::ranges::all_of(desktop::windows(), [&](desktop::WindowId window) {
        return (process != 0 && desktop::processOf(window) != process) || callback(handleOf(window), param) != FALSE;
    });
}

} // namespace

BOOL IsWindow(HWND handle) {
    return toBool(Window::from(handle) || desktop::exists(idOf(handle)));
}

BOOL IsIconic(HWND handle) {
    const Window* window = Window::from(handle);
    return toBool(window ? window->widget()->isMinimized() : desktop::isIconic(idOf(handle)));
}

BOOL IsZoomed(HWND handle) {
    const Window* window = Window::from(handle);
    return toBool(window ? window->widget()->isMaximized() : desktop::isMaximized(idOf(handle)));
}

BOOL ShowWindow(HWND handle, int command) {
    Window* window = Window::from(handle);
    if (!window) {
        if (!isForeign(handle)) {
            return FALSE;
        }
        showForeign(idOf(handle), command);
        return TRUE;
    }
    const bool before = (window->style() & WS_VISIBLE) != 0;
    window->show(command);
    return toBool(before);
}

HWND GetParent(HWND handle) {
    const Window* window = Window::from(handle);
    if (!window) {
        return isForeign(handle) ? handleOf(desktop::ownerOf(idOf(handle))) : nullptr;
    }
    const Window* above = window->isChild() ? window->parent() : window->owner();
    return above ? above->handle() : nullptr;
}

int GetClassNameA(HWND handle, LPSTR buffer, int size) {
    const Window* window = Window::from(handle);
    if (size <= 0 || (!window && !isForeign(handle))) {
        return 0;
    }
    const std::string name = window ? window->className() : desktop::classNameOf(idOf(handle));
    const std::size_t length = std::min(name.size(), static_cast<std::size_t>(size - 1));
    std::memcpy(buffer, name.data(), length);
    buffer[length] = '\0';
    return static_cast<int>(length);
}

BOOL EnumWindows(WNDENUMPROC callback, LPARAM param) {
    return toBool(tellOwn(callback, param) && tellForeign(0, callback, param));
}

BOOL EnumThreadWindows(DWORD thread, WNDENUMPROC callback, LPARAM param) {
    if (thread == 0) {
        SetLastError(ERROR_INVALID_PARAMETER);
        return FALSE;
    }
    return toBool(thread == guiThread() ? tellOwn(callback, param) : tellForeign(thread, callback, param));
}

DWORD GetWindowThreadProcessId(HWND handle, DWORD* process) {
    const bool own = Window::from(handle) != nullptr;
    const DWORD owner = own ? GetCurrentProcessId() : isForeign(handle) ? desktop::processOf(idOf(handle)) : 0;
    if (process && owner != 0) {
        *process = owner;
    }
    return own ? guiThread() : owner;
}

BOOL AttachThreadInput(DWORD from, DWORD to, BOOL) {
    if (from == 0 || to == 0 || from == to) {
        SetLastError(ERROR_INVALID_PARAMETER);
        return FALSE;
    }
    return TRUE;
}

HWND GetForegroundWindow() {
    // The desktop's answer leaves this process's own windows out.
    const HWND own = GetActiveWindow();
    return own ? own : handleOf(desktop::active());
}

BOOL SetForegroundWindow(HWND handle) {
    Window* window = Window::from(handle);
    if (!window) {
        return toBool(isForeign(handle) && desktop::activate(idOf(handle)));
    }
    guarded([window] { window->topLevel()->widget()->raise(); });
    SetActiveWindow(handle);
    return TRUE;
}
