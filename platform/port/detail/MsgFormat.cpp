#include "platform/port/detail/MsgFormat.h"

#include <algorithm>
#include <iterator>

namespace Port::detail {

namespace {

struct Range {
    char32_t first;
    char32_t last;
};

// Blocks of the classes W and F of the Unicode character database's EastAsianWidth.txt.
constexpr Range wideRanges[] = {
    {0x1100, 0x115F},   {0x231A, 0x231B},   {0x2329, 0x232A},   {0x23E9, 0x23EC},   {0x25FD, 0x25FE},
    {0x2614, 0x2615},   {0x2648, 0x2653},   {0x2E80, 0x303E},   {0x3041, 0xA4CF},   {0xA960, 0xA97F},
    {0xAC00, 0xD7A3},   {0xF900, 0xFAFF},   {0xFE10, 0xFE19},   {0xFE30, 0xFE6F},   {0xFF00, 0xFF60},
    {0xFFE0, 0xFFE6},   {0x16FE0, 0x18CFF}, {0x1AFF0, 0x1B2FF}, {0x1F300, 0x1F320}, {0x1F330, 0x1F64F},
    {0x1F680, 0x1F6FF}, {0x1F900, 0x1F9FF}, {0x1FA70, 0x1FAFF}, {0x20000, 0x2FFFD}, {0x30000, 0x3FFFD},
};

// Blocks of combining marks, joiners and variation selectors (general categories Mn, Me and Cf).
constexpr Range markRanges[] = {
    {0x0300, 0x036F}, {0x0483, 0x0489}, {0x0591, 0x05BD}, {0x064B, 0x065F}, {0x1AB0, 0x1AFF},
    {0x1DC0, 0x1DFF}, {0x200B, 0x200F}, {0x2060, 0x2064}, {0x20D0, 0x20FF}, {0x302A, 0x302D},
    {0x3099, 0x309A}, {0xFE00, 0xFE0F}, {0xFE20, 0xFE2F}, {0xFEFF, 0xFEFF}, {0xE0100, 0xE01EF},
};

// Punctuation that must not begin a line of Chinese or Japanese text.
constexpr std::u32string_view closing =
    U"\u3001\u3002\u3009\u300B\u300D\u300F\u3011\u3015\u30FB\u30FC\uFF01\uFF09\uFF0C"
    U"\uFF0E\uFF1A\uFF1B\uFF1F\uFF3D\uFF5D";

template <std::size_t Count>
bool isIn(const Range (&ranges)[Count], wchar_t character) {
    const auto code = static_cast<char32_t>(character);
    const auto* after = std::upper_bound(std::begin(ranges), std::end(ranges), code,
                                         [](char32_t value, const Range& range) { return value < range.first; });
    return after != std::begin(ranges) && code <= std::prev(after)->last;
}

bool isBlank(wchar_t character) {
    return character == L' ' || character == L'\t';
}

/// Wraps one line of text, which holds no line feed.
class LineWrapper {
public:
    LineWrapper(std::wstring_view text, int width, std::vector<std::wstring>& lines)
        : m_text(text), m_width(width), m_lines(lines) {
        m_indentLength = std::min(text.find_first_not_of(L" \t"), text.size());
        int columns = 0;
        for (std::size_t i = 0; i < m_indentLength; ++i) {
            columns = columnAfter(columns, text[i]);
        }
        if (columns * 2 > width) {
            m_indentLength = 0;
        }
    }

    void run() {
        if (m_width > 0) {
            for (std::size_t i = 0; i < m_text.size();) {
                i = step(i);
            }
        }
        emit(m_text.size());
    }

private:
    static int columnAfter(int column, wchar_t character) {
        return character == L'\t' ? (column / 8 + 1) * 8 : column + columnsOf(character);
    }

    /// Takes the character at @p i onto the current line, or ends the line before it; the next position to look at.
    std::size_t step(std::size_t i) {
        const wchar_t character = m_text[i];
        noteBreak(i);
        const int column = columnAfter(m_column, character);
        if (column > m_width && m_hasWord && !isBlank(character)) {
            return endLine(i);
        }
        m_column = column;
        m_hasWord = m_hasWord || !isBlank(character);
        return i + 1;
    }

    /// Notes where the line may end: before a blank that follows a word, and beside a wide character.
    void noteBreak(std::size_t i) {
        if (!m_hasWord) {
            return;
        }
        const wchar_t character = m_text[i];
        const wchar_t before = m_text[i - 1];
        if (isBlank(character)) {
            if (!isBlank(before)) {
                m_breakEnd = i;
            }
        } else if (isBlank(before)) {
            m_breakNext = i;
        } else if ((columnsOf(character) == 2 || columnsOf(before) == 2) && columnsOf(character) > 0 &&
                   closing.find(static_cast<char32_t>(character)) == std::u32string_view::npos) {
            m_breakEnd = m_breakNext = i;
        }
    }

    std::size_t endLine(std::size_t i) {
        const bool hasBreak = m_breakNext > m_start;
        emit(hasBreak ? m_breakEnd : i);
        m_start = hasBreak ? m_breakNext : i;
        m_hasWord = false;
        m_column = 0;
        for (std::size_t k = 0; k < m_indentLength; ++k) {
            m_column = columnAfter(m_column, m_text[k]);
        }
        return m_start;
    }

    void emit(std::size_t end) {
        std::wstring line(m_emitted ? m_text.substr(0, m_indentLength) : std::wstring_view());
        line += m_text.substr(m_start, end - m_start);
        m_lines.push_back(std::move(line));
        m_emitted = true;
    }

    std::wstring_view m_text;
    int m_width;
    std::vector<std::wstring>& m_lines;
    std::size_t m_indentLength = 0;
    std::size_t m_start = 0;
    std::size_t m_breakEnd = 0;
    std::size_t m_breakNext = 0;
    int m_column = 0;
    bool m_hasWord = false;
    bool m_emitted = false;
};

} // namespace

int columnsOf(wchar_t character) {
    if (character < 0x20 || character == 0x7F) {
        return 0;
    }
    if (character < 0x300) {
        return 1;
    }
    if (isIn(markRanges, character)) {
        return 0;
    }
    return isIn(wideRanges, character) ? 2 : 1;
}

std::vector<std::wstring> wrapText(std::wstring_view text, int width) {
    std::vector<std::wstring> lines;
    while (!text.empty()) {
        const std::size_t end = std::min(text.find(L'\n'), text.size());
        std::wstring_view line = text.substr(0, end);
        if (line.ends_with(L'\r')) {
            line.remove_suffix(1);
        }
        LineWrapper(line, width, lines).run();
        text.remove_prefix(std::min(end + 1, text.size()));
    }
    return lines;
}

} // namespace Port::detail
