#pragma once

#include "platform/afx/gdi/detail/Canvas.h"
#include "platform/afx/gdi/detail/Fonts.h"

#include <QString>
#include <QTransform>

#include <string_view>
#include <vector>

namespace tvx::afx {

/// One line of text in a font, measured and drawn in device units.
class TextLine {
public:
    /// @param text UTF-8; bytes that are no UTF-8 are shown as Latin-1 characters
    TextLine(const RealizedFont& font, std::string_view text);

    /// Number of code points.
    [[nodiscard]] std::size_t characterCount() const;
    /// Replaces the font's advances, one for each character.
    void setAdvances(std::vector<int> advances);
    /// Width in pixels.
    [[nodiscard]] int width() const;

    /// Fills the line's cell behind the text. @param left left end of the base line
    void fillBackground(Canvas& canvas, QPoint left, const Ink& ink) const;
    void draw(Canvas& canvas, QPoint left, Pixel color) const;

private:
    [[nodiscard]] QTransform onBaseLine(const Canvas& canvas, QPoint left) const;

    const RealizedFont& m_font;
    QString m_text;
    std::vector<int> m_advances;
};

/// Text for the toolkit: UTF-8, every byte that belongs to no UTF-8 sequence as the Latin-1 character of its value.
[[nodiscard]] TVX_PLATFORM_API QString shownText(std::string_view text);

/// Tab stops as the text calls describe them.
class TabStops {
public:
    /// @param count 0: a stop every eight average characters, 1: a stop every `stops[0]`, else the stops themselves
    TabStops(int count, const int* stops, int averageWidth);
    /// The first stop right of `x`; beyond the last one listed there is one every eight average characters.
    [[nodiscard]] int after(int x) const;

private:
    std::vector<int> m_stops;
    int m_every;
};

} // namespace tvx::afx
