#pragma once

/// @file
/// What a start that was refused reports.

#include "platform/base/Export.h"

namespace tvx::afx {

/// Decides what the process ends with when InitInstance answers FALSE and ExitInstance 0, so that a start which was
/// refused does not look like one that had nothing to do, whatever the host's ExitInstance answers. Each start of an
/// application object begins with 0.
TVX_PLATFORM_API void setStartCode(int exitCode);

} // namespace tvx::afx
