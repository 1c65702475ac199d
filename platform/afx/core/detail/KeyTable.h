#pragma once

/// @file
/// The one table of keys: virtual keys, their scan codes and the toolkit's numbers for them.

namespace tvx::afx {

/// Bit of a scan code: the key stands outside of the keypad whose key has the same code.
inline constexpr int extendedKey = 0x100;

/// The virtual key (VK_...) of one of the toolkit's keys (Qt::Key_...) outside of the keypad, signs as the usual layout
/// has them; 0 for keys that have none.
[[nodiscard]] int virtualKeyOf(int key);
/// The same of a key of the keypad that types something.
[[nodiscard]] int keypadKeyOf(int key);
/// The virtual key of a scan code, by the usual layout; 0 for none. Of a code that two keys share, the one that the
/// extended bit tells.
[[nodiscard]] int virtualKeyAt(int scanCode);
/// The scan code of a virtual key, with extendedKey; 0 for what is no key of a keyboard.
[[nodiscard]] int scanCodeOf(int virtualKey);
/// Whether a key of the keypad types something.
[[nodiscard]] bool isKeypadSign(int virtualKey);
/// Whether a key outside of the keypad types a character that depends on the layout.
[[nodiscard]] bool isCharacterKey(int virtualKey);
/// What the usual layout has on such a key, or on a key of the keypad; 0 for other keys.
[[nodiscard]] char16_t usualSign(int virtualKey);

} // namespace tvx::afx
