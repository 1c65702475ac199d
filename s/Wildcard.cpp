#include "s/Wildcard.h"

#include "platform/base/Text.h"

#include <cstring>

namespace {

constexpr std::size_t none = std::string_view::npos;

/// A byte that can only stand within a character. A piece that begins with one fits between characters only.
bool isWithinCharacter(char byte) {
    return (static_cast<unsigned char>(byte) & 0xC0) == 0x80;
}

bool fitsAt(std::string_view piece, std::string_view text, std::size_t at) {
    return !isWithinCharacter(piece.front()) || tvx::text::characterStart(text, at) == at;
}

} // namespace

Wildcard::Wildcard(std::string_view pattern) noexcept {
    std::size_t start = 0;
    for (std::size_t star = pattern.find('*'); star != none; star = pattern.find('*', start)) {
        if (m_stars == mostStars) {
            ++m_stars;
            return;
        }
        m_pieces[m_stars++] = pieceOf(pattern.substr(start, star - start));
        start = star + 1;
    }
    m_pieces[m_stars] = pieceOf(pattern.substr(start));
}

Wildcard::Piece Wildcard::pieceOf(std::string_view text) noexcept {
    return {text, text.find('?') != none};
}

/// Where the piece ends when it stands at `at`; npos when it does not.
std::size_t Wildcard::endOf(const Piece& piece, std::string_view text, std::size_t at) noexcept {
    if (!piece.hasAny)
        return text.substr(at).starts_with(piece.text) ? at + piece.text.size() : none;
    for (const char wanted : piece.text) {
        if (at == text.size() || (wanted != '?' && text[at] != wanted))
            return none;
        at += wanted == '?' ? tvx::text::characterLength(text, at) : 1;
    }
    return at;
}

/// Where the piece begins when it stands at the end of the text; npos when it does not.
std::size_t Wildcard::startOf(const Piece& piece, std::string_view text) noexcept {
    if (!piece.hasAny) {
        const std::size_t at = text.size() - piece.text.size();
        return text.ends_with(piece.text) && (piece.text.empty() || fitsAt(piece.text, text, at)) ? at : none;
    }
    constexpr std::size_t longestCharacter = 4;
    const std::size_t most = longestCharacter * piece.text.size();
    for (std::size_t at = text.size(); at > 0 && text.size() - at < most;) {
        at = tvx::text::previousCharacter(text, at);
        if (endOf(piece, text, at) == text.size())
            return at;
    }
    return none;
}

/// Where the leftmost place of the piece from `from` on ends; npos when there is none.
std::size_t Wildcard::findEnd(const Piece& piece, std::string_view text, std::size_t from) noexcept {
    if (piece.text.empty())
        return from;
    if (!piece.hasAny && piece.text.size() == 1 && !isWithinCharacter(piece.text.front())) {
        const std::size_t at = text.find(piece.text.front(), from);
        return at != none ? at + 1 : none;
    }
    if (!piece.hasAny && !isWithinCharacter(piece.text.front())) {
        // The C library's search takes linear time where the obvious one goes over long runs again and again.
        const void* at = memmem(text.data() + from, text.size() - from, piece.text.data(), piece.text.size());
        return at ? static_cast<std::size_t>(static_cast<const char*>(at) - text.data()) + piece.text.size() : none;
    }
    for (std::size_t at = from; at < text.size(); at += tvx::text::characterLength(text, at)) {
        const std::size_t end = endOf(piece, text, at);
        if (end != none)
            return end;
    }
    return none;
}

bool Wildcard::matches(std::string_view text) const noexcept {
    if (m_stars > mostStars)
        return false;
    std::size_t at = endOf(m_pieces[0], text, 0);
    if (m_stars == 0 || at == none)
        return at == text.size();
    const std::size_t last = startOf(m_pieces[m_stars], text);
    if (last == none || last < at)
        return false;
    const std::string_view between = text.substr(0, last);
    for (std::size_t piece = 1; piece < m_stars; ++piece) {
        at = findEnd(m_pieces[piece], between, at);
        if (at == none)
            return false;
    }
    return true;
}
