#pragma once

/// @file
/// The mode in which the pointer chooses what to explain. While it lasts, a press of the left button asks for help on
/// what it hits, a chosen menu command for help on that command; Esc, a press of another button and leaving the
/// application end it.

#include "platform/afx/core/Message.h"
#include "platform/base/Export.h"

class QEvent;
class QObject;

namespace tvx::afx {

class Window;

/// Begins the mode for a frame, which gets WM_EXITHELPMODE when it is to end.
TVX_PLATFORM_API void beginHelpMode(HWND frame);
/// Ends it; nothing happens when there is none. For whoever handles WM_EXITHELPMODE.
TVX_PLATFORM_API void endHelpMode();
/// Whether the mode took an event of the user's, which then is nobody else's.
bool helpModeTakes(const Window& window, const QObject& receiver, QEvent& event);
/// Asks the frame to leave the mode, if there is one.
void leaveHelpMode();

} // namespace tvx::afx
