#include "platform/afx/gdi/detail/Outline.h"

#include <QPainterPathStroker>

#include <algorithm>
#include <span>

namespace tvx::afx {

namespace {

/// Pixels on and off in turn of the dashed styles.
std::span<const int> dashPattern(UINT style) {
    static constexpr int dash[] = {18, 6};
    static constexpr int dot[] = {3, 3};
    static constexpr int dashDot[] = {9, 6, 3, 6};
    static constexpr int dashDotDot[] = {9, 3, 3, 3, 3, 3};
    switch (style) {
    case PS_DASH:
        return dash;
    case PS_DOT:
        return dot;
    case PS_DASHDOT:
        return dashDot;
    case PS_DASHDOTDOT:
        return dashDotDot;
    default:
        return {};
    }
}

/// All patterns repeat after this many pixels.
constexpr int dashPeriod = 24;

bool isOn(std::span<const int> pattern, int phase) {
    if (pattern.empty()) {
        return true;
    }
    std::size_t part = 0;
    for (phase %= dashPeriod; phase >= pattern[part % pattern.size()]; ++part) {
        phase -= pattern[part % pattern.size()];
    }
    return part % 2 == 0;
}

int deviceWidth(const DeviceContext& context) {
    const int width = context.state.pen->description.lopnWidth.x;
    return std::max(1, context.state.mapping.sizeToDevice({width, 0}).width());
}

} // namespace

Outline::Outline(const DeviceContext& context, Canvas& canvas)
    : m_context(context),
      m_canvas(canvas),
      m_ink(context.penInk()),
      m_style(context.state.pen->description.lopnStyle),
      m_width(deviceWidth(context)) {
    // Dashed lines are one pixel wide; a wider pen of such a style draws without gaps.
    if (isWide() && m_style != PS_INSIDEFRAME) {
        m_style = PS_SOLID;
    }
    if (m_ink && context.state.backMode == OPAQUE) {
        m_gap = context.ink(context.state.backColor, m_ink->rop);
    }
}

void Outline::addPixel(QPoint point, int phase) {
    (isOn(dashPattern(m_style), phase) ? m_on : m_off).push_back(point);
}

void Outline::plotPixels() {
    m_canvas.plot(m_on, *m_ink);
    if (m_gap) {
        m_canvas.plot(m_off, *m_gap);
    }
    m_on.clear();
    m_off.clear();
}

void Outline::thin(const QPolygon& points) {
    const QRect bounds = m_canvas.bounds();
    for (qsizetype i = 0; i + 1 < points.size(); ++i) {
        const LinePixels pixels(points[i], points[i + 1]);
        pixels.forEach(pixels.within(bounds), [&](int index, QPoint point) { addPixel(point, m_phase + index); });
        m_phase = (m_phase + pixels.count() % dashPeriod) % dashPeriod;
    }
}

void Outline::wide(const QPainterPath& path) {
    QPainterPathStroker stroker;
    stroker.setWidth(m_width);
    stroker.setCapStyle(Qt::RoundCap);
    stroker.setJoinStyle(m_style == PS_INSIDEFRAME ? Qt::MiterJoin : Qt::RoundJoin);
    // Points mean centres of pixels.
    const QList<QPolygonF> areas = stroker.createStroke(path.translated(0.5, 0.5)).toSubpathPolygons();
    m_canvas.fill(
        polygonSpans({areas.data(), static_cast<std::size_t>(areas.size())}, FillRule::Winding, m_canvas.bounds()),
        *m_ink);
}

void Outline::line(const QPolygon& points, LastPoint last) {
    if (!m_ink || points.isEmpty()) {
        return;
    }
    if (isWide()) {
        QPainterPath path;
        path.addPolygon(QPolygonF(points));
        wide(path);
        return;
    }
    thin(points);
    if (last == LastPoint::Drawn) {
        addPixel(points.last(), m_phase);
    }
    plotPixels();
}

void Outline::closed(const QPolygon& points) {
    if (!m_ink || points.isEmpty()) {
        return;
    }
    if (isWide()) {
        QPainterPath path;
        path.addPolygon(QPolygonF(points));
        path.closeSubpath();
        wide(path);
        return;
    }
    // Each side leaves its last pixel to the next one: by exclusive or a pixel drawn twice would be gone.
    thin(points);
    thin(QPolygon({points.last(), points.first()}));
    plotPixels();
}

void Outline::rectangle(const QRect& box) {
    if (isWide()) {
        rounded(box, {}, {});
        // There and back would draw every pixel twice.
    } else if (box.width() == 1 || box.height() == 1) {
        line(QPolygon({box.topLeft(), box.bottomRight()}), LastPoint::Drawn);
    } else {
        closed(QPolygon({box.topLeft(), box.topRight(), box.bottomRight(), box.bottomLeft()}));
    }
}

void Outline::rounded(const QRect& box, QSize corner, const Spans& rows) {
    if (!m_ink || box.isEmpty()) {
        return;
    }
    if (!isWide()) {
        for (const QPoint& point : outlineOf(rows)) {
            addPixel(point, m_phase++);
        }
        plotPixels();
        return;
    }
    QRectF middle = QRectF(box.topLeft(), box.bottomRight());
    if (m_style == PS_INSIDEFRAME) {
        const double half = (m_width - 1) / 2.0;
        middle.adjust(half, half, -half, -half);
    }
    QPainterPath path;
    path.addRoundedRect(middle.normalized(), corner.width() / 2.0, corner.height() / 2.0);
    wide(path);
}

} // namespace tvx::afx
