#pragma once

#include "platform/base/Export.h"

#include <array>
#include <vector>

namespace tvx {

/// What a key types in one layout; 0 where it types nothing. A dead key has the sign of its accent.
struct KeySigns {
    char32_t plain = 0;
    char32_t shifted = 0; ///< With Shift; of a key of the keypad, with NumLock.
};

/// The signs on the keys of the X display's keyboard: by the display's key code, for the first two of the layouts
/// between which the user switches. Asked anew at each call, which costs some tenths of a millisecond. Empty where no
/// display answers.
[[nodiscard]] TVX_PLATFORM_API std::vector<std::array<KeySigns, 2>> keyboardSigns();

/// Whether an event of the display, as its protocol has it, says that the keys have other signs now.
[[nodiscard]] TVX_PLATFORM_API bool isKeyboardChange(const void* event);

} // namespace tvx
