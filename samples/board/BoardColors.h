#pragma once

#include "Drawing.h"

#include <array>

namespace board {

/// Outline colours, in the order of the commands from ID_COLOR_FIRST.
inline constexpr std::array<Color, 6> outlineColors{0x000000, 0x606060, 0xC02020, 0x207030, 0x204080, 0xC06010};
/// Fills, in the order of the commands from ID_FILL_FIRST.
inline constexpr std::array<Color, 6> fillColors{noColor, 0xFFFFFF, 0xE4E8EC, 0xFFF4B0, 0xD8EFDC, 0xDCE8F4};

} // namespace board
