#pragma once

/// @file
/// Keys: the toolkit's and the framework's numbers for them, and which are down.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <QKeyEvent>

namespace tvx::afx {

/// The virtual key (VK_...) of a key event, 0 for a key that has none. A letter key keeps its Latin letter under
/// layouts that have none, so that accelerators work there.
TVX_PLATFORM_API int virtualKey(const QKeyEvent& event);
/// The toolkit's key for a virtual key; Qt::Key_unknown when there is none.
TVX_PLATFORM_API Qt::Key keyOf(int virtualKey);
/// The second parameter of a key message: repeat count 1, scan code, previous and transition state.
LPARAM keyParameter(const QKeyEvent& event, bool released);
/// The mouse buttons and modifier keys as MK_... bits.
TVX_PLATFORM_API WPARAM buttonFlags(Qt::MouseButtons buttons, Qt::KeyboardModifiers modifiers);
/// Keeps track of the keys that are down; called for every key event.
void noteKey(int virtualKey, bool down);
/// Whether a press repeats one that lasts.
bool isRepeated(const QKeyEvent& event);
/// Keeps in mind when a key went down or up; called for every key event before it is delivered.
void noteTime(const QKeyEvent& event);
/// Forgets all keys; called when the application loses the keyboard, since releases are not seen from then on.
void forgetKeys();
TVX_PLATFORM_API bool isKeyDown(int virtualKey);
/// Whether a lock key (VK_CAPITAL, VK_NUMLOCK, VK_SCROLL) is on. False for other keys, and where the desktop does not
/// tell.
bool isKeyLocked(int virtualKey);

} // namespace tvx::afx
