#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/afx/gdi/detail/TextLine.h"
#include "platform/base/Text.h"

#include <cmath>
#include <numbers>
#include <optional>
#include <vector>

using namespace tvx::afx;

namespace {

std::string_view viewOf(LPCSTR text, int count) {
    if (!text) {
        return {};
    }
    return count < 0 ? std::string_view(text) : std::string_view(text, static_cast<std::size_t>(count));
}

std::string_view viewOf(const CString& text) {
    return {static_cast<LPCSTR>(text), static_cast<std::size_t>(text.GetLength())};
}

} // namespace

// Output

BOOL CDC::TextOut(int x, int y, LPCSTR text, int count) {
    return ExtTextOut(x, y, 0, nullptr, text, static_cast<UINT>(viewOf(text, count).size()), nullptr);
}

BOOL CDC::TextOut(int x, int y, const CString& text) {
    return TextOut(x, y, text, text.GetLength());
}

namespace {

/// Where a line of text is put by the alignment flags, in device units.
struct TextPlace {
    QPoint left; ///< left end of the base line
    QPoint next; ///< where text that follows begins
};

TextPlace placeText(const RealizedFont& font, UINT align, QPoint point, int width) {
    const UINT vertical = align & TA_BASELINE;
    const int down = vertical == TA_BASELINE ? 0
                     : vertical == TA_BOTTOM ? -font.metrics.descent()
                                             : font.metrics.ascent();
    const UINT horizontal = align & TA_CENTER;
    const int back = horizontal == TA_CENTER ? width / 2 : horizontal == TA_RIGHT ? width : 0;
    const double angle = -font.angle * std::numbers::pi / 180;
    const double cosine = std::cos(angle);
    const double sine = std::sin(angle);
    const auto moved = [&](QPoint from, double along, double across) {
        return from + QPoint(static_cast<int>(std::lround(along * cosine - across * sine)),
                             static_cast<int>(std::lround(along * sine + across * cosine)));
    };
    const QPoint next = horizontal == TA_CENTER ? point : moved(point, horizontal == TA_RIGHT ? -width : width, 0);
    return {moved(point, -back, down), next};
}

std::vector<int> deviceAdvances(const Mapping& mapping, const int* advances, std::size_t count) {
    std::vector<int> result(count);
    for (std::size_t i = 0; i < count; ++i) {
        result[i] = mapping.sizeToDevice({advances[i], 0}).width();
    }
    return result;
}

} // namespace

BOOL CDC::ExtTextOut(int x, int y, UINT options, const RECT* rect, LPCSTR text, UINT count, const int* advances) {
    const auto dc = findContext(m_hDC);
    if (!dc) {
        return FALSE;
    }
    const auto font = dc->font();
    Drawing drawing(*dc);
    const Mapping& mapping = dc->state.mapping;
    // Hosts fill rectangles by this call with an empty text, so the rectangle does not wait for a font.
    if (rect && (options & ETO_OPAQUE) && drawing) {
        drawing.canvas.fill(drawing.pixels(*rect), dc->ink(dc->state.backColor));
    }
    if (!font) {
        return FALSE;
    }
    TextLine line(*font, viewOf(text, static_cast<int>(count)));
    if (advances) {
        line.setAdvances(deviceAdvances(mapping, advances, line.characterCount()));
    }
    // With TA_UPDATECP the text goes on where the last one ended; the point given is not looked at.
    const bool moves = (dc->state.textAlign & TA_UPDATECP) != 0;
    const QPoint start = mapping.toPixel(moves ? dc->state.position : QPoint(x, y));
    const TextPlace place = placeText(*font, dc->state.textAlign, start, line.width());
    if (drawing) {
        if (rect && (options & ETO_CLIPPED)) {
            drawing.canvas.clip &= drawing.pixels(*rect);
        }
        // The rectangle filled above stands in for the background of the text's own cell.
        if (dc->state.backMode == OPAQUE && !(options & ETO_OPAQUE)) {
            line.fillBackground(drawing.canvas, place.left, dc->ink(dc->state.backColor));
        }
        line.draw(drawing.canvas, place.left, dc->ink(dc->state.textColor).color);
    }
    if (moves) {
        dc->state.position = mapping.toLogical(place.next);
    }
    return TRUE;
}

BOOL CDC::ExtTextOut(int x, int y, UINT options, const RECT* rect, const CString& text, const int* advances) {
    return ExtTextOut(x, y, options, rect, text, static_cast<UINT>(text.GetLength()), advances);
}

// Measuring

namespace {

CSize measure(HDC handle, std::string_view text) {
    const auto dc = findContext(handle);
    const auto font = dc ? dc->font() : nullptr;
    if (!font) {
        return {};
    }
    const std::optional<int> sum = font->advances.widthOf(text);
    const int width = sum ? *sum : TextLine(*font, text).width();
    const QSize size = dc->state.mapping.sizeToLogical({width, font->metrics.height()});
    return {size.width(), size.height()};
}

} // namespace

CSize CDC::GetTextExtent(LPCSTR text, int count) const {
    return measure(m_hDC, viewOf(text, count));
}

CSize CDC::GetTextExtent(const CString& text) const {
    return measure(m_hDC, viewOf(text));
}

BOOL GetTextExtentPoint32A(HDC dc, LPCSTR text, int count, SIZE* size) {
    if (!size || !findContext(dc)) {
        return FALSE;
    }
    *size = measure(dc, viewOf(text, count));
    return TRUE;
}

namespace {

BYTE pitchBits(const RealizedFont& font) {
    // The bit says the opposite of its name: it is set for faces whose advances differ.
    const bool fixed = font.metrics.horizontalAdvance(u'i') == font.metrics.horizontalAdvance(u'W');
    return static_cast<BYTE>(TMPF_VECTOR | TMPF_TRUETYPE | (fixed ? 0 : TMPF_FIXED_PITCH));
}

/// Average advance as dialog units know it: of the Latin letters, rounded.
int averageWidth(const QFontMetrics& metrics) {
    const QString letters = QStringLiteral("ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz");
    return (metrics.horizontalAdvance(letters) / 26 + 1) / 2;
}

} // namespace

BOOL GetTextMetricsA(HDC handle, TEXTMETRICA* metrics) {
    const auto dc = findContext(handle);
    const auto font = dc ? dc->font() : nullptr;
    if (!font || !metrics) {
        return FALSE;
    }
    const QFontMetrics& device = font->metrics;
    const auto high = [&](int pixels) { return dc->state.mapping.sizeToLogical({0, pixels}).height(); };
    const auto wide = [&](int pixels) { return dc->state.mapping.sizeToLogical({pixels, 0}).width(); };
    const LOGFONTA& asked = dc->state.font->description;
    *metrics = {};
    metrics->tmHeight = high(device.height());
    metrics->tmAscent = high(device.ascent());
    metrics->tmDescent = metrics->tmHeight - metrics->tmAscent;
    metrics->tmInternalLeading = high(std::max(0, device.height() - font->font.pixelSize()));
    metrics->tmExternalLeading = high(std::max(0, device.leading()));
    metrics->tmAveCharWidth = wide(averageWidth(device));
    metrics->tmMaxCharWidth = wide(device.maxWidth());
    metrics->tmWeight = asked.lfWeight > 0 ? asked.lfWeight : FW_NORMAL;
    metrics->tmDigitizedAspectX = metrics->tmDigitizedAspectY = pixelsPerInch;
    metrics->tmFirstChar = metrics->tmBreakChar = ' ';
    metrics->tmLastChar = 0xFF;
    metrics->tmDefaultChar = '?';
    metrics->tmItalic = asked.lfItalic;
    metrics->tmUnderlined = asked.lfUnderline;
    metrics->tmStruckOut = asked.lfStrikeOut;
    metrics->tmPitchAndFamily = static_cast<BYTE>((asked.lfPitchAndFamily & 0xF0) | pitchBits(*font));
    metrics->tmCharSet = asked.lfCharSet;
    return TRUE;
}

BOOL CDC::GetTextMetrics(TEXTMETRIC* metrics) const {
    return GetTextMetricsA(m_hDC, metrics);
}

int CDC::GetTextFace(CString& name) const {
    const auto dc = findContext(m_hDC);
    if (!dc) {
        return 0;
    }
    name = dc->state.font->description.lfFaceName;
    if (const auto font = dc->font(); font && name.IsEmpty()) {
        name = font->font.family().toUtf8().constData();
    }
    return name.GetLength();
}

int CDC::GetTextFace(int count, LPSTR name) const {
    CString face;
    const int length = GetTextFace(face);
    if (!name) {
        return length + 1;
    }
    if (count <= 0) {
        return 0;
    }
    return static_cast<int>(tvx::text::copyCut(face.View(), name, static_cast<std::size_t>(count)));
}

BOOL CDC::GetCharWidth(UINT first, UINT last, int* widths) const {
    const auto dc = findContext(m_hDC);
    const auto font = dc ? dc->font() : nullptr;
    constexpr UINT lastCodePoint = 0x10FFFF;
    if (!font || !widths || last < first || last > lastCodePoint) {
        return FALSE;
    }
    for (UINT code = first; code <= last; ++code) {
        const auto character = static_cast<char32_t>(code);
        const int advance = font->metrics.horizontalAdvance(QString::fromUcs4(&character, 1));
        widths[code - first] = dc->state.mapping.sizeToLogical({advance, 0}).width();
    }
    return TRUE;
}

// Tab stops

namespace {

/// Lays out the pieces between tabs and draws them when `output` is given.
CSize layOutTabs(CDC& dc, std::string_view text, int tabCount, const int* tabs, int origin, const POINT* output) {
    TEXTMETRIC metrics;
    if (!dc.GetTextMetrics(&metrics)) {
        return {};
    }
    const TabStops stops(tabCount, tabs, metrics.tmAveCharWidth);
    const int start = output ? std::clamp(distance(origin, output->x), -farthestPixel, farthestPixel) : 0;
    int x = 0;
    for (std::size_t at = 0; at <= text.size();) {
        const std::size_t end = std::min(text.find('\t', at), text.size());
        const auto length = static_cast<int>(end - at);
        if (output) {
            dc.TextOut(saturated(std::int64_t{output->x} + x), output->y, text.data() + at, length);
        }
        x += dc.GetTextExtent(text.data() + at, length).cx;
        if (end < text.size()) {
            x = stops.after(start + x) - start;
        }
        at = end + 1;
    }
    return {x, metrics.tmHeight};
}

} // namespace

CSize CDC::TabbedTextOut(int x, int y, LPCSTR text, int count, int tabCount, const int* tabs, int tabOrigin) {
    const POINT output = {x, y};
    return layOutTabs(*this, viewOf(text, count), tabCount, tabs, tabOrigin, &output);
}

CSize CDC::TabbedTextOut(int x, int y, const CString& text, int tabCount, const int* tabs, int tabOrigin) {
    return TabbedTextOut(x, y, text, text.GetLength(), tabCount, tabs, tabOrigin);
}

CSize CDC::GetTabbedTextExtent(LPCSTR text, int count, int tabCount, const int* tabs) const {
    return layOutTabs(const_cast<CDC&>(*this), viewOf(text, count), tabCount, tabs, 0, nullptr);
}

CSize CDC::GetTabbedTextExtent(const CString& text, int tabCount, const int* tabs) const {
    return GetTabbedTextExtent(text, text.GetLength(), tabCount, tabs);
}
