#pragma once

#include <cstdint>

/// @file
/// Raster operations on pixels of 32 bits (0xffRRGGBB). A code is a truth table: bit `n` of it is the result for the
/// inputs whose bits, written one behind the other, give the number `n`.

namespace tvx::afx {

using Pixel = std::uint32_t;
constexpr Pixel opaque = 0xFF000000U;
constexpr Pixel blackPixel = opaque;
constexpr Pixel whitePixel = 0xFFFFFFFFU;

/// A binary operation of pen (or brush) and destination: bit `pen * 2 + destination` of the table, 0..15.
enum class Rop2 : std::uint8_t { Black = 0, NotDestination = 5, XorPen = 6, Nop = 10, Copy = 12, White = 15 };

/// A ternary operation: bit `brush * 4 + source * 2 + destination` of the table, 0..255.
using Rop3 = std::uint8_t;
constexpr Rop3 rop3Source = 0xCC;

/// The operation of a code for the `SetROP2` call (1..16).
constexpr Rop2 rop2FromCode(int code) {
    return static_cast<Rop2>((code - 1) & 0xF);
}

/// The ternary operation of a code for the blit calls: its third byte.
constexpr Rop3 rop3FromCode(std::uint32_t code) {
    return static_cast<Rop3>((code >> 16) & 0xFF);
}

/// Whether the result depends on the source: else the call fills only.
constexpr bool usesSource(Rop3 rop) {
    return ((rop >> 2) & 0x33) != (rop & 0x33);
}

/// What a ternary operation without a source does with brush and destination.
constexpr Rop2 rop2FromRop3(Rop3 rop) {
    return static_cast<Rop2>((rop & 3) | ((rop >> 2) & 0xC));
}

constexpr Pixel combine(Rop2 rop, Pixel pen, Pixel destination) {
    const auto table = static_cast<unsigned>(rop);
    Pixel result = opaque;
    if (table & 1) {
        result |= ~pen & ~destination;
    }
    if (table & 2) {
        result |= ~pen & destination;
    }
    if (table & 4) {
        result |= pen & ~destination;
    }
    if (table & 8) {
        result |= pen & destination;
    }
    return result;
}

constexpr Pixel combine(Rop3 rop, Pixel brush, Pixel source, Pixel destination) {
    const Rop2 withoutBrush = static_cast<Rop2>(rop & 0xF);
    const Rop2 withBrush = static_cast<Rop2>(rop >> 4);
    return opaque | (~brush & combine(withoutBrush, source, destination)) |
           (brush & combine(withBrush, source, destination));
}

/// A binary operation with a pen that does not change, in two steps for each pixel.
class PenOperation {
public:
    constexpr PenOperation(Rop2 rop, Pixel pen)
        : m_and(combine(rop, pen, 0) ^ combine(rop, pen, ~Pixel{0})), m_xor(combine(rop, pen, 0)) {}
    [[nodiscard]] constexpr Pixel operator()(Pixel destination) const {
        return ((destination & m_and) ^ m_xor) | opaque;
    }

private:
    Pixel m_and;
    Pixel m_xor;
};

/// A ternary operation with a brush that does not change: its polynomial in source and destination.
class BlitOperation {
public:
    constexpr BlitOperation(Rop3 rop, Pixel brush)
        : m_constant(combine(rop, brush, 0, 0)),
          m_source(m_constant ^ combine(rop, brush, ~Pixel{0}, 0)),
          m_destination(m_constant ^ combine(rop, brush, 0, ~Pixel{0})),
          m_both(m_constant ^ m_source ^ m_destination ^ combine(rop, brush, ~Pixel{0}, ~Pixel{0})) {}
    [[nodiscard]] constexpr Pixel operator()(Pixel source, Pixel destination) const {
        return (m_constant ^ (source & m_source) ^ (destination & m_destination) ^ (source & destination & m_both)) |
               opaque;
    }

private:
    Pixel m_constant;
    Pixel m_source;
    Pixel m_destination;
    Pixel m_both;
};

} // namespace tvx::afx
