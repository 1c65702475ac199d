#pragma once

/// @file
/// Moving and sizing windows with the keyboard.

#include "platform/base/Types.h"

namespace tvx::afx {

/// What the arrow keys change.
enum class KeyChange {
    Place, ///< The window moves as it is.
    Size,  ///< The right and the lower edge move.
};

/// Lets the user move or size a window: arrows by a grid's step, with Ctrl by one pixel. Enter and the mouse's buttons
/// leave it there, Esc brings it back. Answers when that is done or the window has ended.
void changeByKeys(HWND window, KeyChange change);

} // namespace tvx::afx
