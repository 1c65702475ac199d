#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/detail/TextLayout.h"

#include <algorithm>
#include <string>

using namespace tvx::afx;

namespace {

/// The state that DrawText changes for itself, put back at the end.
class TextState {
public:
    explicit TextState(CDC& dc) : m_dc(dc), m_align(dc.SetTextAlign(TA_LEFT | TA_TOP)) {}
    ~TextState() {
        m_dc.SetTextAlign(m_align);
    }
    TextState(const TextState&) = delete;
    TextState& operator=(const TextState&) = delete;

private:
    CDC& m_dc;
    UINT m_align;
};

int lineLeft(const RECT& rect, UINT format, int width) {
    const int space = rect.right - rect.left - width;
    if (format & DT_CENTER) {
        return rect.left + space / 2;
    }
    return format & DT_RIGHT ? rect.left + space : rect.left;
}

int firstLineTop(const RECT& rect, UINT format, int height) {
    if ((format & DT_SINGLELINE) == 0) {
        return rect.top;
    }
    const int space = rect.bottom - rect.top - height;
    if (format & DT_VCENTER) {
        return rect.top + space / 2;
    }
    return format & DT_BOTTOM ? rect.top + space : rect.top;
}

void drawUnderline(CDC& dc, const LayoutLine& line, int x, int y, const TextLayoutStyle& style) {
    if (line.mnemonic == std::string::npos) {
        return;
    }
    const std::string_view text = line.text;
    const int from = layoutWidth(dc, text.substr(0, line.mnemonic), style);
    const int to = layoutWidth(dc, text.substr(0, line.mnemonic + line.mnemonicLength), style);
    TEXTMETRIC metrics;
    dc.GetTextMetrics(&metrics);
    CPen pen(PS_SOLID, 0, dc.GetTextColor());
    CPen* old = dc.SelectObject(&pen);
    const CPoint position = dc.GetCurrentPosition();
    const int base = y + metrics.tmAscent + 1;
    dc.MoveTo(x + from, base);
    dc.LineTo(x + to, base);
    dc.MoveTo(position);
    dc.SelectObject(old);
}

void drawLine(CDC& dc, const LayoutLine& line, const RECT& rect, UINT format, int y, const TextLayoutStyle& style) {
    const int x = lineLeft(rect, format, line.width);
    const UINT clip = format & DT_NOCLIP ? 0 : ETO_CLIPPED;
    if (format & DT_EXPANDTABS && line.text.find('\t') != std::string::npos) {
        // The call that draws tabs has no rectangle to cut at.
        const int saved = dc.SaveDC();
        if (clip) {
            dc.IntersectClipRect(&rect);
        }
        dc.TabbedTextOut(x, y, line.text.data(), static_cast<int>(line.text.size()), 1, &style.tabWidth, x);
        dc.RestoreDC(saved);
    } else {
        dc.ExtTextOut(x, y, clip, &rect, line.text.data(), static_cast<UINT>(line.text.size()), nullptr);
    }
    if ((format & DT_HIDEPREFIX) == 0) {
        drawUnderline(dc, line, x, y, style);
    }
}

/// The rectangle without numbers so large that sums with them would not fit.
RECT pulledIn(const RECT& rect) {
    static constexpr int farAway = 1 << 29;
    const auto pull = [](int value) { return std::clamp(value, -farAway, farAway); };
    return {pull(rect.left), pull(rect.top), pull(rect.right), pull(rect.bottom)};
}

int widestLine(const TextLayout& layout) {
    int width = 0;
    for (const LayoutLine& line : layout.lines) {
        width = std::max(width, line.width);
    }
    return width;
}

/// Makes the rectangle as large as the text: a single line keeps its alignment to the old one.
void fitRectangle(RECT& rect, UINT format, const TextLayout& layout, int top) {
    const int width = widestLine(layout);
    rect.left = format & DT_WORDBREAK ? rect.left : lineLeft(rect, format, width);
    rect.right = rect.left + width;
    rect.top = top;
    rect.bottom = top + layout.height();
}

} // namespace

int CDC::DrawText(LPCSTR text, int count, RECT* rect, UINT format) {
    TEXTMETRIC metrics;
    if (!text || !rect || !GetTextMetrics(&metrics)) {
        return 0;
    }
    const TextState state(*this);
    const RECT area = pulledIn(*rect);
    const std::string_view whole = count < 0 ? std::string_view(text) : std::string_view(text, count);
    TextLayoutStyle style;
    style.format = format;
    style.width = area.right - area.left;
    // With DT_TABSTOP the second byte of the format says how many characters a tab is wide.
    const int perTab = format & DT_TABSTOP ? static_cast<int>((format >> 8) & 0xFF) : 8;
    style.tabWidth = std::max(1, perTab) * metrics.tmAveCharWidth;
    style.lineHeight = metrics.tmHeight + (format & DT_EXTERNALLEADING ? metrics.tmExternalLeading : 0);
    const TextLayout layout = layOutText(*this, whole, style);
    // In the metric modes y grows upwards.
    const int downwards = GetMapMode() != MM_TEXT && GetViewportExt().cy * GetWindowExt().cy < 0 ? -1 : 1;
    int y = firstLineTop(area, format, downwards * layout.height());
    const int top = y;
    if (format & DT_CALCRECT) {
        *rect = area;
        fitRectangle(*rect, format, layout, top);
        if (downwards < 0) {
            rect->bottom = top - layout.height();
        }
        return layout.height();
    }
    for (const LayoutLine& line : layout.lines) {
        drawLine(*this, line, area, format, y, style);
        y += downwards * style.lineHeight;
    }
    // Centred or at the bottom, the end of the text is counted from the top of the rectangle.
    return layout.height() + std::abs(top - area.top);
}

int CDC::DrawText(const CString& text, RECT* rect, UINT format) {
    return DrawText(text, text.GetLength(), rect, format);
}
