#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/afx/gdi/detail/Outline.h"
#include "platform/afx/gdi/detail/Regions.h"

#include <QPainter>

using namespace tvx::afx;

namespace {

/// Fills a rectangle given in logical units.
BOOL fillLogical(HDC handle, const RECT& rect, const BrushObject& brush, Rop2 rop) {
    const auto dc = findContext(handle);
    if (!dc) {
        return FALSE;
    }
    Drawing drawing(*dc);
    QImage pattern;
    const auto ink = dc->brushInk(drawing.canvas, brush, rop, pattern);
    if (drawing && ink) {
        drawing.canvas.fill(drawing.pixels(rect), *ink);
    }
    return TRUE;
}

BrushObject solid(COLORREF color) {
    BrushObject brush;
    brush.description = {static_cast<UINT>(BS_SOLID), color, 0};
    return brush;
}

/// The brush of a handle; a number up to that of the last system colour plus one stands for that colour's brush.
Tool<BrushObject> brushOf(HBRUSH handle) {
    const auto number = reinterpret_cast<std::uintptr_t>(handle);
    if (number >= 1 && number <= COLOR_HOTLIGHT + 1) {
        handle = GetSysColorBrush(static_cast<int>(number) - 1);
    }
    return findTool<BrushObject>(handle);
}

BOOL fillWith(HDC dc, const RECT* rect, HBRUSH handle) {
    const auto brush = brushOf(handle);
    return rect && brush && fillLogical(dc, *rect, *brush, Rop2::Copy);
}

} // namespace

int FillRect(HDC dc, const RECT* rect, HBRUSH brush) {
    return fillWith(dc, rect, brush);
}

void CDC::FillRect(const RECT* rect, CBrush* brush) {
    fillWith(m_hDC, rect, brush ? static_cast<HBRUSH>(brush->m_hObject) : nullptr);
}

void CDC::FrameRect(const RECT* rect, CBrush* brush) {
    const auto tool = brushOf(brush ? static_cast<HBRUSH>(brush->m_hObject) : nullptr);
    if (!rect || !tool) {
        return;
    }
    const int inside[] = {saturated(std::int64_t{rect->left} + 1), saturated(std::int64_t{rect->top} + 1),
                          saturated(std::int64_t{rect->right} - 1), saturated(std::int64_t{rect->bottom} - 1)};
    const RECT sides[] = {{rect->left, rect->top, rect->right, inside[1]},
                          {rect->left, inside[3], rect->right, rect->bottom},
                          {rect->left, inside[1], inside[0], inside[3]},
                          {inside[2], inside[1], rect->right, inside[3]}};
    for (const RECT& side : sides) {
        if (side.left < side.right && side.top < side.bottom) {
            fillLogical(m_hDC, side, *tool, Rop2::Copy);
        }
    }
}

void CDC::InvertRect(const RECT* rect) {
    if (rect) {
        fillLogical(m_hDC, *rect, solid(0), Rop2::NotDestination);
    }
}

BOOL CDC::FillRgn(CRgn* region, CBrush* brush) {
    const auto area = findTool<RegionObject>(region ? region->m_hObject : nullptr);
    const auto tool = brushOf(brush ? static_cast<HBRUSH>(brush->m_hObject) : nullptr);
    const auto dc = findContext(m_hDC);
    if (!area || !tool || !dc) {
        return FALSE;
    }
    Drawing drawing(*dc);
    QImage pattern;
    const auto ink = dc->brushInk(drawing.canvas, *tool, Rop2::Copy, pattern);
    if (!drawing || !ink) {
        return TRUE;
    }
    for (const QRect& rect : area->region) {
        drawing.canvas.fill(drawing.canvas.pixels(rect), *ink);
    }
    return TRUE;
}

void CDC::FillSolidRect(const RECT* rect, COLORREF color) {
    if (!rect) {
        return;
    }
    SetBkColor(color);
    fillLogical(m_hDC, *rect, solid(color), Rop2::Copy);
}

void CDC::FillSolidRect(int x, int y, int cx, int cy, COLORREF color) {
    const RECT rect = rectAt(x, y, cx, cy);
    FillSolidRect(&rect, color);
}

void CDC::Draw3dRect(const RECT* rect, COLORREF topLeft, COLORREF bottomRight) {
    if (rect) {
        Draw3dRect(rect->left, rect->top, distance(rect->left, rect->right), distance(rect->top, rect->bottom), topLeft,
                   bottomRight);
    }
}

void CDC::Draw3dRect(int x, int y, int cx, int cy, COLORREF topLeft, COLORREF bottomRight) {
    const RECT rect = rectAt(x, y, cx, cy);
    FillSolidRect(x, y, distance(1, cx), 1, topLeft);
    FillSolidRect(x, y, 1, distance(1, cy), topLeft);
    // The corners at both ends of the dark sides belong to them.
    FillSolidRect(rect.right, y, -1, cy, bottomRight);
    FillSolidRect(x, rect.bottom, cx, -1, bottomRight);
}

BOOL CDC::PatBlt(int x, int y, int width, int height, DWORD rop) {
    const auto dc = findContext(m_hDC);
    const Rop3 ternary = rop3FromCode(rop);
    if (!dc || usesSource(ternary)) {
        return FALSE;
    }
    const RECT rect = rectAt(x, y, width, height);
    const Rop2 binary = rop2FromRop3(ternary);
    // Of the four results of a binary operation two are for zeros of the brush and two for its ones: where they are
    // equal, the brush does not count, and a null brush must not keep the operation from being done.
    const bool usesBrush = static_cast<unsigned>(binary) >> 2 != (static_cast<unsigned>(binary) & 3U);
    return fillLogical(m_hDC, rect, usesBrush ? *dc->state.brush : solid(0), binary);
}

// Edges

namespace {

struct EdgeColors {
    int topLeft;
    int bottomRight;
};

/// System colours of the outer line of an edge.
EdgeColors outerColors(UINT edge, UINT flags) {
    if (flags & BF_MONO) {
        return {COLOR_WINDOWFRAME, COLOR_WINDOWFRAME};
    }
    if (flags & BF_FLAT) {
        return {COLOR_BTNSHADOW, COLOR_BTNSHADOW};
    }
    if (edge & BDR_RAISEDOUTER) {
        return {flags & BF_SOFT ? COLOR_BTNHIGHLIGHT : COLOR_3DLIGHT, COLOR_3DDKSHADOW};
    }
    return {flags & BF_SOFT ? COLOR_3DDKSHADOW : COLOR_BTNSHADOW, COLOR_BTNHIGHLIGHT};
}

EdgeColors innerColors(UINT edge, UINT flags) {
    if (flags & BF_MONO) {
        return {COLOR_WINDOW, COLOR_WINDOW};
    }
    if (flags & BF_FLAT) {
        return {COLOR_BTNFACE, COLOR_BTNFACE};
    }
    if (edge & BDR_RAISEDINNER) {
        return {flags & BF_SOFT ? COLOR_3DLIGHT : COLOR_BTNHIGHLIGHT, COLOR_BTNSHADOW};
    }
    return {flags & BF_SOFT ? COLOR_BTNSHADOW : COLOR_3DDKSHADOW, COLOR_3DLIGHT};
}

/// Draws one line along the sides that `flags` names and takes it off the rectangle.
void drawEdgeLine(HDC dc, RECT& rect, EdgeColors colors, UINT flags) {
    const BrushObject light = solid(GetSysColor(colors.topLeft));
    const BrushObject dark = solid(GetSysColor(colors.bottomRight));
    RECT inside = rect;
    if (flags & BF_LEFT) {
        fillLogical(dc, {rect.left, rect.top, ++inside.left, rect.bottom}, light, Rop2::Copy);
    }
    if (flags & BF_TOP) {
        fillLogical(dc, {rect.left, rect.top, rect.right, ++inside.top}, light, Rop2::Copy);
    }
    // The dark sides last: the corners that they share with the light ones are theirs.
    if (flags & BF_RIGHT) {
        fillLogical(dc, {--inside.right, rect.top, rect.right, rect.bottom}, dark, Rop2::Copy);
    }
    if (flags & BF_BOTTOM) {
        fillLogical(dc, {rect.left, --inside.bottom, rect.right, rect.bottom}, dark, Rop2::Copy);
    }
    rect = inside;
}

} // namespace

BOOL CDC::DrawEdge(RECT* rect, UINT edge, UINT flags) {
    if (!rect || !findContext(m_hDC)) {
        return FALSE;
    }
    RECT inside = *rect;
    if (edge & (BDR_RAISEDOUTER | BDR_SUNKENOUTER)) {
        drawEdgeLine(m_hDC, inside, outerColors(edge, flags), flags);
    }
    if (edge & (BDR_RAISEDINNER | BDR_SUNKENINNER)) {
        drawEdgeLine(m_hDC, inside, innerColors(edge, flags), flags);
    }
    if (flags & BF_MIDDLE) {
        fillLogical(m_hDC, inside, solid(GetSysColor(flags & BF_MONO ? COLOR_WINDOW : COLOR_BTNFACE)), Rop2::Copy);
    }
    if (flags & BF_ADJUST) {
        *rect = inside;
    }
    return TRUE;
}

void CDC::DrawFocusRect(const RECT* rect) {
    const auto dc = findContext(m_hDC);
    if (!dc || !rect) {
        return;
    }
    Drawing drawing(*dc);
    if (!drawing) {
        return;
    }
    // Every second pixel by its place, so that the dots stay where they are when the frame grows.
    std::vector<QPoint> dots = framePixels(drawing.pixels(*rect), drawing.canvas.bounds());
    const QPoint first = drawing.canvas.pixel({});
    std::erase_if(dots, [first](QPoint dot) { return ((dot.x() - first.x() + dot.y() - first.y()) & 1) != 0; });
    drawing.canvas.plot(dots, {whitePixel, Rop2::XorPen, nullptr, {}});
}

// Icons

namespace {

BOOL drawIcon(HDC handle, QPoint logical, HICON icon, QSize size) {
    const auto dc = findContext(handle);
    const QImage image = iconImage(icon);
    if (!dc || image.isNull()) {
        return FALSE;
    }
    Drawing drawing(*dc);
    if (!drawing) {
        return TRUE;
    }
    Canvas& canvas = drawing.canvas;
    // Icons keep their size in pixels in every mapping mode, only their place is converted.
    const QRect place = canvas.pixels(QRect(dc->state.mapping.toPixel(logical), size.isEmpty() ? image.size() : size));
    QPainter painter(canvas.image);
    painter.setClipRegion(canvas.clip);
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    painter.drawImage(place, image);
    canvas.touch(place);
    return TRUE;
}

} // namespace

BOOL CDC::DrawIcon(int x, int y, HICON icon) {
    return drawIcon(m_hDC, {x, y}, icon, {});
}

BOOL CDC::DrawIcon(POINT point, HICON icon) {
    return drawIcon(m_hDC, toQt(point), icon, {});
}

BOOL DrawIconEx(HDC dc, int x, int y, HICON icon, int width, int height, UINT, HBRUSH background, UINT) {
    const QSize size = width > 0 && height > 0 ? QSize(width, height) : iconImage(icon).size();
    const RECT area = {x, y, x + size.width(), y + size.height()};
    if (background && !size.isEmpty()) {
        fillWith(dc, &area, background);
    }
    return drawIcon(dc, {x, y}, icon, size);
}

// Pixels

BOOL CDC::SetPixelV(int x, int y, COLORREF color) {
    const auto dc = findContext(m_hDC);
    if (!dc) {
        return FALSE;
    }
    Drawing drawing(*dc);
    if (drawing) {
        Canvas& canvas = drawing.canvas;
        canvas.fill(canvas.pixels(QRect(dc->state.mapping.toPixel(QPoint(x, y)), QSize(1, 1))), dc->ink(color));
    }
    return TRUE;
}

COLORREF CDC::SetPixel(int x, int y, COLORREF color) {
    if (!PtVisible(x, y) || !SetPixelV(x, y, color)) {
        return CLR_INVALID;
    }
    // What is really there: a monochrome bitmap has the nearer of two colours.
    return GetPixel(x, y);
}

COLORREF CDC::SetPixel(POINT point, COLORREF color) {
    return SetPixel(point.x, point.y, color);
}

COLORREF CDC::GetPixel(int x, int y) const {
    const auto dc = findContext(m_hDC);
    if (!dc) {
        return CLR_INVALID;
    }
    Drawing drawing(*dc);
    const QPoint point = drawing.canvas.pixel(dc->state.mapping.toPixel(QPoint(x, y)));
    if (!drawing || !drawing.canvas.clip.contains(point)) {
        return CLR_INVALID;
    }
    return colorOf(drawing.canvas.row(point.y())[point.x()]);
}

COLORREF CDC::GetPixel(POINT point) const {
    return GetPixel(point.x, point.y);
}

COLORREF GetPixel(HDC dc, int x, int y) {
    const CDC* wrapper = CDC::FromHandle(dc);
    return wrapper ? wrapper->GetPixel(x, y) : CLR_INVALID;
}

COLORREF SetPixel(HDC dc, int x, int y, COLORREF color) {
    CDC* wrapper = CDC::FromHandle(dc);
    return wrapper ? wrapper->SetPixel(x, y, color) : CLR_INVALID;
}
