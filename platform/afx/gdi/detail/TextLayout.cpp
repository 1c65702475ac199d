#include "platform/afx/gdi/detail/TextLayout.h"

#include "platform/base/Text.h"

#include <algorithm>

namespace tvx::afx {

namespace {

constexpr std::string_view ellipsis = "...";

/// Takes the ampersands out: the last one before a character underlines it, a doubled one stands for itself.
LayoutLine withoutPrefixes(std::string_view text, UINT format) {
    LayoutLine line;
    if (format & DT_NOPREFIX) {
        line.text = text;
        return line;
    }
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] == '&' && i + 1 < text.size()) {
            ++i;
            if (text[i] != '&') {
                line.mnemonic = line.text.size();
                line.mnemonicLength = text::characterLength(text, i);
            }
        } else if (text[i] == '&') {
            break;
        }
        line.text += text[i];
    }
    return line;
}

/// Splits at line ends: "\r\n", "\n" or "\r".
std::vector<std::string_view> paragraphs(std::string_view text) {
    std::vector<std::string_view> all;
    while (true) {
        const std::size_t end = text.find_first_of("\r\n");
        all.push_back(text.substr(0, end));
        if (end == std::string_view::npos) {
            return all;
        }
        text.remove_prefix(end + (text.substr(end, 2) == "\r\n" ? 2 : 1));
    }
}

class Breaker {
public:
    Breaker(const CDC& dc, const TextLayoutStyle& style) : m_dc(dc), m_style(style) {}

    /// The lines of a paragraph, broken between words. A word wider than the rectangle has a line of its own.
    std::vector<LayoutLine> lines(const LayoutLine& paragraph) const {
        std::vector<LayoutLine> result;
        std::size_t at = 0;
        do {
            const std::size_t end = lineEnd(paragraph.text, at);
            result.push_back(part(paragraph, at, end));
            at = std::min(paragraph.text.find_first_not_of(' ', end), paragraph.text.size());
        } while (at < paragraph.text.size());
        return result;
    }

private:
    [[nodiscard]] std::size_t lineEnd(const std::string& text, std::size_t at) const {
        std::size_t fitting = std::string::npos;
        for (std::size_t end = at; end < text.size();) {
            end = std::min(text.find(' ', std::min(text.find_first_not_of(' ', end), text.size())), text.size());
            const std::string_view line = std::string_view(text).substr(at, end - at);
            if (layoutWidth(m_dc, line, m_style) > m_style.width && fitting != std::string::npos) {
                return fitting;
            }
            fitting = end;
        }
        return text.size();
    }

    static LayoutLine part(const LayoutLine& paragraph, std::size_t from, std::size_t to) {
        LayoutLine line;
        line.text = paragraph.text.substr(from, to - from);
        if (paragraph.mnemonic >= from && paragraph.mnemonic < to) {
            line.mnemonic = paragraph.mnemonic - from;
            line.mnemonicLength = paragraph.mnemonicLength;
        }
        return line;
    }

    const CDC& m_dc;
    const TextLayoutStyle& m_style;
};

void dropMnemonicBeyond(LayoutLine& line, std::size_t kept) {
    if (line.mnemonic != std::string::npos && line.mnemonic + line.mnemonicLength > kept) {
        line.mnemonic = std::string::npos;
    }
}

/// Cuts characters off the end until the rest fits with an ellipsis; one character stays in any case.
void shortenEnd(LayoutLine& line, const CDC& dc, const TextLayoutStyle& style) {
    std::size_t kept = line.text.size();
    std::string shortened = line.text;
    while (layoutWidth(dc, shortened, style) > style.width && text::previousCharacter(line.text, kept) > 0) {
        kept = text::previousCharacter(line.text, kept);
        shortened = line.text.substr(0, kept).append(ellipsis);
    }
    dropMnemonicBeyond(line, kept);
    line.text = shortened;
}

/// Replaces characters before the last separator of a path by an ellipsis until the rest fits.
void shortenPath(LayoutLine& line, const CDC& dc, const TextLayoutStyle& style) {
    const std::size_t last = std::min(line.text.find_last_of("\\/"), line.text.size());
    const std::string tail = line.text.substr(last);
    std::size_t kept = last;
    std::string shortened = line.text;
    while (layoutWidth(dc, shortened, style) > style.width && kept > 0) {
        kept = text::previousCharacter(line.text, kept);
        shortened = line.text.substr(0, kept).append(ellipsis).append(tail);
    }
    dropMnemonicBeyond(line, kept);
    line.text = shortened;
}

} // namespace

int layoutWidth(const CDC& dc, std::string_view text, const TextLayoutStyle& style) {
    const auto size = static_cast<int>(text.size());
    // The size goes along, so nothing depends on a zero behind the text.
    // NOLINTBEGIN(bugprone-suspicious-stringview-data-usage)
    if ((style.format & DT_EXPANDTABS) == 0) {
        return dc.GetTextExtent(text.data(), size).cx;
    }
    return dc.GetTabbedTextExtent(text.data(), size, 1, &style.tabWidth).cx;
    // NOLINTEND(bugprone-suspicious-stringview-data-usage)
}

TextLayout layOutText(const CDC& dc, std::string_view text, const TextLayoutStyle& style) {
    TextLayout layout;
    layout.lineHeight = style.lineHeight;
    const bool single = (style.format & DT_SINGLELINE) != 0;
    const auto all = single ? std::vector<std::string_view>{text} : paragraphs(text);
    for (const std::string_view paragraph : all) {
        const LayoutLine line = withoutPrefixes(paragraph, style.format);
        const bool breaks = !single && (style.format & DT_WORDBREAK) != 0;
        const auto lines = breaks ? Breaker(dc, style).lines(line) : std::vector<LayoutLine>{line};
        layout.lines.insert(layout.lines.end(), lines.begin(), lines.end());
    }
    for (LayoutLine& line : layout.lines) {
        if (style.format & DT_PATH_ELLIPSIS) {
            shortenPath(line, dc, style);
        } else if (style.format & (DT_END_ELLIPSIS | DT_WORD_ELLIPSIS)) {
            shortenEnd(line, dc, style);
        }
        line.width = layoutWidth(dc, line.text, style);
    }
    return layout;
}

} // namespace tvx::afx
