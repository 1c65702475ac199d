#pragma once

#include "platform/base/Export.h"

namespace tvx {

/// Whether the X display that the environment names (`DISPLAY`) answers. Asks it anew at each call, in well under a
/// millisecond; a toolkit that is told to use a display that does not answer ends the process.
[[nodiscard]] TVX_PLATFORM_API bool canOpenDisplay();

/// Which of the keys that stay on until they are pressed again are on.
struct KeyLocks {
    bool caps = false;
    bool num = false;
    bool scroll = false;
};

/// The lock keys as the lights of the X display's keyboard show them; none is on where no display answers.
[[nodiscard]] TVX_PLATFORM_API KeyLocks keyLocks();

/// The same of the Wayland compositor that the environment names (`WAYLAND_DISPLAY`, or `WAYLAND_SOCKET` for a process
/// that was given its connection).
[[nodiscard]] TVX_PLATFORM_API bool canOpenWaylandDisplay();

} // namespace tvx
