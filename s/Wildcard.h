#pragma once

#include <string_view>

/// Whether the whole text matches a pattern with "*" (any run of characters) and "?" (one character of UTF-8).
/// Everything else stands for itself, byte for byte. A pattern has at most ten "*"; one with more matches nothing.
///
/// What stands before the first "*" and behind the last one is compared in its place, the rest is found from left to
/// right: no text and no pattern make it go back, so the time never grows faster than text times pattern.
[[nodiscard]] bool MatchesWildcard(std::string_view text, std::string_view pattern) noexcept;
