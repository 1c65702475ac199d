#pragma once

#include "platform/base/Export.h"

namespace tvx {

/// Whether the X display that the environment names (`DISPLAY`) answers. Asks it anew at each call, in well under a
/// millisecond; a toolkit that is told to use a display that does not answer ends the process.
[[nodiscard]] TVX_PLATFORM_API bool canOpenDisplay();

} // namespace tvx
