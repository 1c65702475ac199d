#include "platform/afx/gdi/detail/Advances.h"

#include "platform/base/Text.h"

#include <cmath>

namespace tvx::afx {

namespace {

struct Range {
    char32_t first;
    char32_t last;
};

/// Characters that are drawn alike whatever stands beside them: Latin, Greek, Cyrillic, punctuation, arrows, symbols,
/// kana, ideographs and Hangul syllables, without combining marks, format characters and soft hyphens.
constexpr Range independent[] = {
    {0x20, 0x7E},     {0xA0, 0xAC},     {0xAE, 0x2AF},    {0x370, 0x482},   {0x48A, 0x52F},
    {0x1E00, 0x1FFF}, {0x2010, 0x2027}, {0x2030, 0x205E}, {0x2070, 0x209C}, {0x20A0, 0x20BF},
    {0x2100, 0x218B}, {0x2190, 0x23FF}, {0x2460, 0x25FF}, {0x3000, 0x3029}, {0x3030, 0x303F},
    {0x3041, 0x3096}, {0x309B, 0x30FF}, {0x3400, 0x9FFF}, {0xAC00, 0xD7A3}, {0xFF01, 0xFFEE},
};

bool isIndependent(char32_t character) {
    for (const Range& range : independent) {
        if (character <= range.last) {
            return character >= range.first;
        }
    }
    return false;
}

} // namespace

Advances::Advance Advances::measured(char32_t character) const {
    if (!isIndependent(character)) {
        return unfit;
    }
    const double width = m_metrics.horizontalAdvance(QChar(static_cast<char16_t>(character)));
    const double whole = std::round(width);
    return width == whole && whole >= 0 && whole < 0x7FFF ? static_cast<Advance>(whole) : unfit;
}

Advances::Advance Advances::of(char32_t character) const {
    if (character > 0xFFFF) {
        return unfit;
    }
    auto& page = m_pages[character >> 8];
    if (!page) {
        page = std::make_unique<Page>();
        page->fill(unknown);
    }
    Advance& advance = (*page)[character & 0xFF];
    if (advance == unknown) {
        advance = measured(character);
    }
    return advance;
}

std::optional<int> Advances::widthOf(std::string_view text) const {
    int width = 0;
    for (std::size_t at = 0; at < text.size();) {
        const auto byte = static_cast<unsigned char>(text[at]);
        const Advance advance = of(byte < 0x80 ? static_cast<char32_t>(text[at++]) : text::decode(text, at));
        if (advance < 0) {
            return std::nullopt;
        }
        width += advance;
    }
    return width;
}

} // namespace tvx::afx
