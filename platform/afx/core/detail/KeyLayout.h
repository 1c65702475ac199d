#pragma once

/// @file
/// The keys that type characters, on the layout that the user has.

#include "platform/base/Export.h"
#include "platform/win/KeyboardSigns.h"

#include <QtGlobal>

#include <vector>

namespace tvx::afx {

/// Gives each key of a layout that types a character a virtual key of its own.
///
/// A letter key is that letter, a key of the digits' row that digit whatever it types without Shift. VK_OEM_PLUS,
/// VK_OEM_COMMA, VK_OEM_MINUS and VK_OEM_PERIOD are where their signs are, the other keys with signs too where they
/// type without Shift what they type on the usual layout. What is left has the virtual key of its place, or one that no
/// key has. On layouts without Latin letters, places decide alone.
class TVX_PLATFORM_API KeyLayout {
public:
    /// @param signs by the key codes of the display; keys without signs do not exist.
    explicit KeyLayout(const std::vector<KeySigns>& signs);
    /// The virtual key of a key code; 0 for keys that type no character.
    [[nodiscard]] int virtualKey(unsigned keyCode) const;
    /// What a virtual key types without Shift; 0 for those that are on no key.
    [[nodiscard]] char32_t sign(int virtualKey) const;

private:
    struct Key {
        unsigned keyCode;
        KeySigns signs;
        int virtualKey;
    };
    void placeLetters();
    void placeSigns();
    void placeOthers();
    void give(int virtualKey, char32_t KeySigns::* which, char32_t sign);
    [[nodiscard]] bool isGiven(int virtualKey) const;
    std::vector<Key> m_keys;
};

/// The virtual key that the usual layout has at a place; 0 for keys that type no character. Key codes are numbered by
/// place on every keyboard.
[[nodiscard]] int characterKeyAt(unsigned keyCode);

/// The layout that the user types with now, by what a key event tells of it (QKeyEvent::nativeModifiers). Null where it
/// is not known: without X display, and for the third and fourth of a user's layouts.
[[nodiscard]] const KeyLayout* layoutOf(quint32 nativeModifiers);
/// The one of the last key event.
[[nodiscard]] const KeyLayout* presentLayout();

} // namespace tvx::afx
