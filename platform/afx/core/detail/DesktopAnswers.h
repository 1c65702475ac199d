#pragma once

/// @file
/// What the window manager has done of what it was asked.

#include "platform/base/Export.h"

#include <QMargins>

class QTimer;

namespace tvx::afx {

/// Whether a window manager will tell.
enum class Told {
    ByManager, ///< It will have done all that it was asked so far when the timer starts.
    ByNobody,  ///< There is none, or none that tells; the timer has been started.
};

/// Starts a timer when the window manager has done all that was asked of it before this call, and what it told of that
/// has reached the windows. A timer that is gone by then is forgotten.
TVX_PLATFORM_API Told startWhenDesktopHasAnswered(QTimer& timer);

/// The borders that a window with a caption will get, none where nobody tells. The first call may wait for the answer.
TVX_PLATFORM_API QMargins expectedWindowBorders();

} // namespace tvx::afx
