#pragma once

#include <array>
#include <cstddef>
#include <string_view>

/// A pattern with "*" (any run of characters) and "?" (one character of UTF-8), taken apart once and matched against
/// many texts. Everything else stands for itself, byte for byte. A pattern has at most ten "*"; one with more matches
/// nothing.
///
/// What stands before the first "*" and behind the last one is compared in its place, the rest is found from left to
/// right: no text and no pattern make it go back, so the time never grows faster than text times pattern.
class Wildcard {
public:
    /// @param pattern must live as long as this object
    explicit Wildcard(std::string_view pattern) noexcept;
    /// Whether the pattern matches the whole text.
    [[nodiscard]] bool matches(std::string_view text) const noexcept;

private:
    static constexpr std::size_t mostStars = 10;

    /// What stands between two "*".
    struct Piece {
        std::string_view text;
        bool hasAny = false; ///< has a "?"
    };
    static Piece pieceOf(std::string_view text) noexcept;
    static std::size_t endOf(const Piece& piece, std::string_view text, std::size_t at) noexcept;
    static std::size_t startOf(const Piece& piece, std::string_view text) noexcept;
    static std::size_t findEnd(const Piece& piece, std::string_view text, std::size_t from) noexcept;

    std::array<Piece, mostStars + 1> m_pieces;
    std::size_t m_stars = 0;
};
