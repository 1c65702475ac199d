#pragma once

/// @file
/// The keys of dialogs: moving between controls, mnemonics, Enter and Esc.

#include "platform/afx/core/Message.h"
#include "platform/base/Export.h"

#include <vector>

namespace tvx::afx {

class Window;

/// Whether a message is one of a dialog's keys; it is carried out then.
TVX_PLATFORM_API bool isDialogMessage(Window& dialog, const MSG& msg);

enum class Direction { Forward, Backward };
/// The next control that Tab reaches, the first one when `from` is null; null when there is none.
TVX_PLATFORM_API Window* nextTabItem(Window& dialog, const Window* from, Direction direction);
/// The next control that the arrow keys reach.
TVX_PLATFORM_API Window* nextGroupItem(const Window& from, Direction direction);
/// Gives a control the keyboard as Tab does: the text of an edit control is selected.
TVX_PLATFORM_API void focusControl(Window& control);

} // namespace tvx::afx
