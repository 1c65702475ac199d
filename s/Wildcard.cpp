#include "s/Wildcard.h"

#include "platform/base/Text.h"

#include <cstring>

namespace {

constexpr std::size_t none = std::string_view::npos;
constexpr int mostStars = 10;

/// A byte that can only stand within a character. A piece that begins with one fits between characters only.
bool isWithinCharacter(char byte) {
    return (static_cast<unsigned char>(byte) & 0xC0) == 0x80;
}

std::size_t characterLength(std::string_view text, std::size_t at) {
    return static_cast<unsigned char>(text[at]) < 0x80 ? 1 : tvx::text::characterLength(text, at);
}

/// What stands between two "*".
struct Piece {
    std::string_view text;
    bool hasAny = false; ///< has a "?"
};

/// Where the piece ends when it stands at `at`; npos when it does not.
std::size_t endOf(std::string_view piece, std::string_view text, std::size_t at) {
    for (const char wanted : piece) {
        if (at == text.size() || (wanted != '?' && text[at] != wanted)) {
            return none;
        }
        at += wanted == '?' ? characterLength(text, at) : 1;
    }
    return at;
}

/// Where the piece, which has a "?", begins when it stands at the end of the text, `first` being the first place
/// allowed; npos when it does not.
std::size_t startOf(std::string_view piece, std::string_view text, std::size_t first) {
    constexpr std::size_t longestCharacter = 4;
    const std::size_t most = longestCharacter * piece.size();
    for (std::size_t at = text.size(); at > first && text.size() - at < most;) {
        at = tvx::text::previousCharacter(text, at);
        if (endOf(piece, text, at) == text.size()) {
            return at >= first ? at : none;
        }
    }
    return none;
}

/// The end of a pattern: its last "*", and where what stands behind that begins in the text.
struct End {
    std::size_t star = 0;
    std::size_t start = none; ///< npos when the text ends otherwise
};

/// @param first the first place allowed in the text
End endOfPattern(std::string_view pattern, std::string_view text, std::size_t first) {
    std::size_t at = text.size();
    std::size_t left = pattern.size() - 1;
    for (; pattern[left] != '*'; --left, --at) {
        if (pattern[left] == '?') {
            const std::size_t star = pattern.rfind('*', left);
            return {star, startOf(pattern.substr(star + 1), text, first)};
        }
        if (at == first || text[at - 1] != pattern[left]) {
            return {};
        }
    }
    const bool fits = at == text.size() || !isWithinCharacter(text[at]) || tvx::text::characterStart(text, at) == at;
    return {left, fits ? at : none};
}

/// Where the leftmost place of the piece from `from` on ends; npos when there is none.
std::size_t findEnd(const Piece& piece, std::string_view text, std::size_t from) {
    if (piece.text.empty()) {
        return from;
    }
    if (!piece.hasAny && !isWithinCharacter(piece.text.front())) {
        const char* start = text.data() + from;
        const std::size_t left = text.size() - from;
        const std::size_t size = piece.text.size();
        // The C library's search does not go over long runs again and again as the obvious one does.
        const void* at =
            size == 1 ? std::memchr(start, piece.text.front(), left) : memmem(start, left, piece.text.data(), size);
        return at ? static_cast<std::size_t>(static_cast<const char*>(at) - text.data()) + size : none;
    }
    for (std::size_t at = from; at < text.size(); at += characterLength(text, at)) {
        const std::size_t end = endOf(piece.text, text, at);
        if (end != none) {
            return end;
        }
    }
    return none;
}

/// The piece that begins at `start` and ends before the next "*" or with the pattern.
Piece pieceAt(std::string_view pattern, std::size_t start) {
    Piece piece;
    std::size_t end = start;
    for (; end < pattern.size() && pattern[end] != '*'; ++end) {
        piece.hasAny = piece.hasAny || pattern[end] == '?';
    }
    piece.text = pattern.substr(start, end - start);
    return piece;
}

/// Where a pattern is being compared with a text.
struct Place {
    std::size_t text = 0;
    std::size_t pattern = 0; ///< of a "*"
};

/// Matches the pieces from one "*" to another against a stretch of the text.
bool matchesBetween(std::string_view text, std::string_view pattern, Place from, Place to) {
    const std::string_view between = text.substr(0, to.text);
    for (int stars = 1; from.pattern < to.pattern; ++stars) {
        if (stars == mostStars) {
            return false;
        }
        const Piece piece = pieceAt(pattern, from.pattern + 1);
        from.text = findEnd(piece, between, from.text);
        if (from.text == none) {
            return false;
        }
        from.pattern += 1 + piece.text.size();
    }
    return true;
}

/// Matches what follows the first "*". Of its own, so that what comes before it does not pay for it.
[[gnu::noinline]] bool matchesBehindStar(std::string_view text, std::string_view pattern, Place star) {
    const auto [last, end] = endOfPattern(pattern, text, star.text);
    if (end == none) {
        return false;
    }
    return star.pattern == last || matchesBetween(text, pattern, star, {end, last});
}

bool matches(std::string_view text, std::string_view pattern) {
    std::size_t at = 0;
    for (std::size_t next = 0; next < pattern.size(); ++next) {
        if (pattern[next] == '*') {
            return matchesBehindStar(text, pattern, {at, next});
        }
        if (at == text.size() || (pattern[next] != '?' && pattern[next] != text[at])) {
            return false;
        }
        at += pattern[next] == '?' ? characterLength(text, at) : 1;
    }
    return at == text.size();
}

/// Whether the pattern is one "*" before characters that stand for themselves, the first of which can only stand
/// between characters.
bool isOnlyEnd(std::string_view pattern) {
    if (pattern.size() < 2 || pattern[0] != '*' || isWithinCharacter(pattern[1])) {
        return false;
    }
    for (const char wanted : pattern.substr(1)) {
        if (wanted == '*' || wanted == '?') {
            return false;
        }
    }
    return true;
}

/// Compares all characters whether they differ or not: which one does cannot be foretold, and a branch that goes the
/// other way costs more than the rest.
bool endsWith(std::string_view text, std::string_view end) {
    if (text.size() < end.size()) {
        return false;
    }
    const char* at = text.data() + (text.size() - end.size());
    unsigned differences = 0;
    for (const char wanted : end) {
        differences |= static_cast<unsigned char>(*at++ ^ wanted);
    }
    return differences == 0;
}

} // namespace

bool MatchesWildcard(std::string_view text, std::string_view pattern) noexcept {
    return isOnlyEnd(pattern) ? endsWith(text, pattern.substr(1)) : matches(text, pattern);
}
