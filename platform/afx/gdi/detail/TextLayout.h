#pragma once

#include "platform/afx/gdi/Dc.h"

#include <string>
#include <string_view>
#include <vector>

namespace tvx::afx {

/// One line of a text that was laid out, ready to be drawn.
struct LayoutLine {
    std::string text;
    int width = 0;
    std::size_t mnemonic = std::string::npos; ///< place of the underlined character in `text`
    std::size_t mnemonicLength = 0;           ///< its bytes
};

struct TextLayout {
    std::vector<LayoutLine> lines;
    int lineHeight = 0;
    [[nodiscard]] int height() const {
        return static_cast<int>(lines.size()) * lineHeight;
    }
};

struct TextLayoutStyle {
    UINT format = 0; ///< DT_...
    int width = 0;   ///< of the rectangle, in logical units
    int tabWidth = 0;
    int lineHeight = 0;
};

/// Takes prefixes out, breaks the text into lines and shortens what does not fit, as the format asks for.
[[nodiscard]] TextLayout layOutText(const CDC& dc, std::string_view text, const TextLayoutStyle& style);

/// Width of a piece of a line, with its tabs where the format expands them.
[[nodiscard]] int layoutWidth(const CDC& dc, std::string_view text, const TextLayoutStyle& style);

} // namespace tvx::afx
