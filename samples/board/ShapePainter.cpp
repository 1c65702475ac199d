#include "ShapePainter.h"

#include <algorithm>

using namespace board;

namespace {

COLORREF toColorRef(Color color) {
    return RGB((color >> 16) & 0xFF, (color >> 8) & 0xFF, color & 0xFF);
}

CRect boxOf(const Shape& shape) {
    CRect box(shape.from.x, shape.from.y, shape.to.x, shape.to.y);
    box.NormalizeRect();
    return box;
}

void drawText(CDC& dc, const Shape& shape, const LOGFONT& textFont) {
    CRect box = boxOf(shape);
    if (shape.fill != noColor) {
        dc.FillSolidRect(box, toColorRef(shape.fill));
    }
    CFont font;
    font.CreateFontIndirect(&textFont);
    CFont* before = dc.SelectObject(&font);
    dc.SetBkMode(TRANSPARENT);
    dc.SetTextColor(toColorRef(shape.color));
    dc.DrawText(shape.text.c_str(), -1, box, DT_LEFT | DT_TOP | DT_WORDBREAK | DT_NOPREFIX | DT_NOCLIP);
    dc.SelectObject(before);
}

void drawOutline(CDC& dc, const Shape& shape) {
    if (shape.kind == ShapeKind::Line) {
        dc.MoveTo(shape.from.x, shape.from.y);
        dc.LineTo(shape.to.x, shape.to.y);
    } else if (shape.kind == ShapeKind::Ellipse) {
        dc.Ellipse(boxOf(shape));
    } else {
        dc.Rectangle(boxOf(shape));
    }
}

} // namespace

Color FromColorRef(COLORREF color) {
    return static_cast<Color>(GetRValue(color) << 16 | GetGValue(color) << 8 | GetBValue(color));
}

void DrawShape(CDC& dc, const Shape& shape, const Options& options) {
    if (shape.kind == ShapeKind::Text) {
        drawText(dc, shape, options.GetTextFont(shape.size));
        return;
    }
    CPen pen(PS_SOLID, shape.width, toColorRef(shape.color));
    CBrush brush;
    if (shape.fill == noColor) {
        brush.CreateStockObject(NULL_BRUSH);
    } else {
        brush.CreateSolidBrush(toColorRef(shape.fill));
    }
    CPen* penBefore = dc.SelectObject(&pen);
    CBrush* brushBefore = dc.SelectObject(&brush);
    drawOutline(dc, shape);
    dc.SelectObject(brushBefore);
    dc.SelectObject(penBefore);
}

CRect ReachOf(const Shape& shape) {
    CRect reach = boxOf(shape);
    if (shape.kind == ShapeKind::Text) {
        // A text may run over the right and lower side of its box. Letters of the alphabet are hardly wider than high;
        // others have more bytes. Lines are broken at blanks and beside characters of more than a byte.
        const auto mayBreak = [](char c) { return c <= ' ' || c == '-'; }; // negative: a byte of several
        const auto breaks = std::count_if(shape.text.begin(), shape.text.end(), mayBreak);
        const int most = 2 * maxCoordinate;
        const int wide =
            shape.size * 5 / 4 * static_cast<int>(std::min<std::size_t>(shape.text.size(), most / shape.size));
        const int high = shape.size * 2 * static_cast<int>(std::min<std::ptrdiff_t>(breaks + 1, most / shape.size));
        reach.right = std::max<LONG>(reach.right, reach.left + wide);
        reach.bottom = std::max<LONG>(reach.bottom, reach.top + high);
    }
    reach.InflateRect(shape.width, shape.width);
    reach.right += 1;
    reach.bottom += 1;
    return reach;
}
