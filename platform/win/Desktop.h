#pragma once

/// @file
/// The windows that other processes show on the desktop, as X windows under the window manager's rules. The calls that
/// hosts know (`IsWindow`, `ShowWindow`, `EnumThreadWindows`, ...) are in platform/afx/core/WindowCalls.h: they answer
/// for this process's own windows themselves and ask here about all others.
///
/// Every function answers "no such window" (false, 0, empty) where no X display answers, as in a pure Wayland session,
/// and for this process's own windows. Any thread may call them.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <cstdint>
#include <string>
#include <vector>

namespace tvx::desktop {

/// The X id of a top-level window; 0 is none. Any number may be asked about.
using WindowId = std::uint32_t;

/// Whether another process has such a top-level window: one that the window manager manages or that bears an
/// application's class. Parts of windows, the desktop's background and helper windows do not count.
[[nodiscard]] TVX_PLATFORM_API bool exists(WindowId window);

/// Whether it is minimised.
[[nodiscard]] TVX_PLATFORM_API bool isIconic(WindowId window);

/// Whether it is maximised in both directions.
[[nodiscard]] TVX_PLATFORM_API bool isMaximized(WindowId window);

/// The window that it stands over, as a dialog does over its frame; 0 when there is none.
[[nodiscard]] TVX_PLATFORM_API WindowId ownerOf(WindowId window);

/// Its application's class as the window manager knows it, e.g. "Firefox".
[[nodiscard]] TVX_PLATFORM_API std::string classNameOf(WindowId window);

/// The number of the process that shows it; 0 when it does not tell or runs on another machine.
[[nodiscard]] TVX_PLATFORM_API DWORD processOf(WindowId window);

/// The active window, if it is another process's.
[[nodiscard]] TVX_PLATFORM_API WindowId active();

/// The windows of other processes that the window manager manages, the topmost first.
[[nodiscard]] TVX_PLATFORM_API std::vector<WindowId> windows();

/// Restores the window if it is minimised, raises it and gives it the keyboard; the virtual desktop that it is on
/// becomes the current one. Waits until the window manager has done it, for a fifth of a second at most.
/// @return false when it has not: the window then asks for attention in the way the desktop shows that
TVX_PLATFORM_API bool activate(WindowId window);

/// Asks the window manager to minimise the window.
TVX_PLATFORM_API void minimize(WindowId window);

/// What a window is to become.
enum class Extent { Normal, Maximized };

/// Asks the window manager to maximise the window or to give it its normal size again.
TVX_PLATFORM_API void setExtent(WindowId window, Extent extent);

} // namespace tvx::desktop
