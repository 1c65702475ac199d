#pragma once

#include <cstdint>

namespace tvx::text {

/// The code point of a byte of the western code page (1252), in which resource scripts were written before UTF-8.
/// The five bytes that the page leaves open keep their value.
[[nodiscard]] constexpr char16_t westernCodePoint(std::uint8_t byte) noexcept {
    constexpr char16_t from80[] = {0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021,
                                   0x02C6, 0x2030, 0x0160, 0x2039, 0x0152, 0x008D, 0x017D, 0x008F,
                                   0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014,
                                   0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178};
    return byte >= 0x80 && byte < 0xA0 ? from80[byte - 0x80] : byte;
}

} // namespace tvx::text
