#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/afx/gdi/detail/Regions.h"

#include <array>

using namespace tvx::afx;

int tvx::afx::regionKind(const QRegion& region) {
    if (region.isEmpty()) {
        return NULLREGION;
    }
    return region.rectCount() == 1 ? SIMPLEREGION : COMPLEXREGION;
}

QRegion tvx::afx::regionOf(const Spans& spans) {
    std::vector<QRect> rows;
    rows.reserve(spans.size());
    for (const Span& span : spans) {
        rows.emplace_back(span.left, span.y, span.right - span.left, 1);
    }
    QRegion region;
    region.setRects(rows.data(), static_cast<int>(rows.size()));
    return region;
}

QRegion tvx::afx::combined(const QRegion& first, const QRegion& second, int mode) {
    switch (mode) {
    case RGN_AND:
        return first & second;
    case RGN_OR:
        return first | second;
    case RGN_XOR:
        return first ^ second;
    case RGN_DIFF:
        return first - second;
    default:
        return first;
    }
}

namespace {

HRGN addRegion(QRegion region) {
    return static_cast<HRGN>(addGdiObject(RegionObject{std::move(region)}));
}

QRect ordered(int left, int top, int right, int bottom) {
    return Mapping().toPixels({left, top, right, bottom});
}

/// Regions of other shapes than rectangles are kept row by row, and so only within reach of a screen.
QRect screenReach() {
    constexpr int farAway = 1 << 15;
    return {QPoint(-farAway, -farAway), QPoint(farAway, farAway)};
}

QRegion ellipseRegion(const QRect& box) {
    // The toolkit's own ellipses differ by pixels from what Ellipse() draws, but they cost nothing by the row.
    const QRect reach = screenReach();
    return reach.contains(box) ? regionOf(ellipseSpans(box)) : QRegion(box & reach, QRegion::Ellipse);
}

} // namespace

BOOL CRgn::CreateRectRgn(int left, int top, int right, int bottom) {
    return Attach(addRegion(ordered(left, top, right, bottom)));
}

BOOL CRgn::CreateRectRgnIndirect(const RECT* rect) {
    return rect ? CreateRectRgn(rect->left, rect->top, rect->right, rect->bottom) : FALSE;
}

BOOL CRgn::CreateEllipticRgn(int left, int top, int right, int bottom) {
    return Attach(addRegion(ellipseRegion(ordered(left, top, right, bottom))));
}

BOOL CRgn::CreatePolygonRgn(const POINT* points, int count, int mode) {
    if (!points || count < 2) {
        return FALSE;
    }
    QPolygonF polygon;
    for (int i = 0; i < count; ++i) {
        polygon << QPointF(points[i].x, points[i].y);
    }
    const std::array polygons = {polygon};
    const FillRule rule = mode == WINDING ? FillRule::Winding : FillRule::Alternate;
    return Attach(
        addRegion(regionOf(polygonSpans(polygons, rule, polygon.boundingRect().toAlignedRect() & screenReach()))));
}

int CRgn::CombineRgn(const CRgn* first, const CRgn* second, int mode) {
    const auto target = findTool<RegionObject>(m_hObject);
    const auto left = findTool<RegionObject>(first ? first->m_hObject : nullptr);
    const auto right = findTool<RegionObject>(second ? second->m_hObject : nullptr);
    if (!target || !left || (!right && mode != RGN_COPY)) {
        return RGN_ERROR;
    }
    target->region = combined(left->region, right ? right->region : QRegion(), mode);
    return regionKind(target->region);
}

void CRgn::SetRectRgn(int left, int top, int right, int bottom) {
    if (const auto own = findTool<RegionObject>(m_hObject)) {
        own->region = ordered(left, top, right, bottom);
    }
}

int CRgn::OffsetRgn(int x, int y) {
    const auto own = findTool<RegionObject>(m_hObject);
    if (!own) {
        return RGN_ERROR;
    }
    own->region.translate(x, y);
    return regionKind(own->region);
}

int CRgn::GetRgnBox(RECT* rect) const {
    const auto own = findTool<RegionObject>(m_hObject);
    if (!own || !rect) {
        return RGN_ERROR;
    }
    *rect = fromQt(own->region.boundingRect());
    return regionKind(own->region);
}

BOOL CRgn::PtInRegion(int x, int y) const {
    const auto own = findTool<RegionObject>(m_hObject);
    return own && own->region.contains(QPoint(x, y));
}

BOOL CRgn::RectInRegion(const RECT* rect) const {
    const auto own = findTool<RegionObject>(m_hObject);
    return own && rect && own->region.intersects(toQt(*rect));
}
