#pragma once

/// @file
/// Keys: the toolkit's and the framework's numbers for them, and which are down.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <QKeyEvent>

#include <optional>

namespace tvx::afx {

/// The virtual key (VK_...) of a key event, 0 for a key that has none. A letter key keeps its Latin letter under
/// layouts that have none, so that accelerators work there.
TVX_PLATFORM_API int virtualKey(const QKeyEvent& event);
/// The second parameter of a key message: repeat count 1, scan code and extended bit, previous and transition state.
TVX_PLATFORM_API LPARAM keyParameter(const QKeyEvent& event, bool released);
/// The mouse buttons and modifier keys as MK_... bits.
TVX_PLATFORM_API WPARAM buttonFlags(Qt::MouseButtons buttons, Qt::KeyboardModifiers modifiers);
/// The name of a key in the user's language, or the sign that it has on the user's layout; empty for what is no key of
/// a keyboard.
QString keyName(int virtualKey);
/// Keeps track of the keys that are down; called for every key event.
void noteKey(int virtualKey, bool down);
/// Whether a press repeats one that lasts.
bool isRepeated(const QKeyEvent& event);
/// Keeps in mind when a key went down or up; called for every key event before it is delivered.
void noteTime(const QKeyEvent& event);
/// Forgets all keys; called when the application loses the keyboard, since releases are not seen from then on.
void forgetKeys();
TVX_PLATFORM_API bool isKeyDown(int virtualKey);
/// The Latin letter, in lower case, or the digit of the key that was pressed last and is down; 0 for others. Access
/// keys are found by it where what the key types is none: on layouts of other scripts, and where digits want Shift.
char32_t pressedLetter();

/// The modifiers of accelerators and hot keys.
struct HeldModifiers {
    bool shift = false;
    bool control = false;
    bool alt = false;
};
/// Those that are down. AltGr counts as Ctrl and Alt.
HeldModifiers modifiersHeld();
/// The same beside a key that is pressed; nothing where AltGr makes it type a character, which is no accelerator.
std::optional<HeldModifiers> acceleratorModifiers(int virtualKey);
/// Whether a lock key (VK_CAPITAL, VK_NUMLOCK, VK_SCROLL) is on. False for other keys, and where the desktop does not
/// tell.
bool isKeyLocked(int virtualKey);

} // namespace tvx::afx
