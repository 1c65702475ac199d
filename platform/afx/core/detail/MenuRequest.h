#pragma once

/// @file
/// Whether somebody takes a request for a context menu.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

namespace tvx::afx {

class Window;

/// Sends WM_CONTEXTMENU to the parents of a window, for one that shows a menu of its own where none of them does.
/// @param wParam,lParam those of the message that the window got
/// @return whether one of them took it; the window may be gone then
[[nodiscard]] TVX_PLATFORM_API bool parentsTakeMenu(const Window& window, WPARAM wParam, LPARAM lParam);
/// Called where a request ends that no window has taken.
void noteMenuUntaken(WPARAM wParam);

} // namespace tvx::afx
