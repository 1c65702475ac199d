#pragma once

/// @file
/// Who has the mouse and the keyboard.

#include "platform/base/Types.h"

class QFocusEvent;

namespace tvx::afx {

class Window;

/// The window that has captured the mouse, null for none.
HWND captureWindow();
/// Sends WM_SETFOCUS or WM_KILLFOCUS for a change that the toolkit reports, unless it has been told already.
void tellFocus(Window& window, bool got);
/// Closes open menus and lets go of the mouse: what WM_CANCELMODE asks for.
void cancelModes();
/// Lets go of mouse and keyboard for a window that ends.
void forgetFocus(HWND window);

} // namespace tvx::afx
