#include "platform/afx/gdi/detail/Outline.h"

#include <algorithm>
#include <cmath>
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

Spans roundedRows(const Canvas& canvas, const QRect& box, QSize corner) {
    const auto pixels = [&canvas](int units) { return static_cast<int>(std::lround(units * canvas.ratio)); };
    return roundRectSpans(canvas.pixels(box), {pixels(corner.width()), pixels(corner.height())});
}

void Outline::addPixel(QPoint point, int phase) {
    (isOn(dashPattern(m_style), phase) ? m_on : m_off).push_back(point);
}

void Outline::plotPixels() {
    const auto plot = [this](std::vector<QPoint>& points, std::vector<QPolygonF>& stripes, const Ink& ink) {
        m_canvas.plot(points, ink);
        // As one area: by exclusive or pixels where lines meet would be gone.
        m_canvas.fill(polygonSpans(stripes, FillRule::Winding, m_canvas.bounds()), ink);
        points.clear();
        stripes.clear();
    };
    plot(m_on, m_onStripes, *m_ink);
    if (m_gap) {
        plot(m_off, m_offStripes, *m_gap);
    }
}

void Outline::thin(const QPolygon& points) {
    for (qsizetype i = 0; i + 1 < points.size(); ++i) {
        if (m_canvas.isPlain()) {
            thinPixels({m_canvas.pixel(points[i]), m_canvas.pixel(points[i + 1])});
        } else {
            thinStripes({points[i], points[i + 1]});
        }
    }
}

void Outline::thinPixels(const LinePixels& pixels) {
    pixels.forEach(pixels.within(m_canvas.bounds()),
                   [&](int index, QPoint point) { addPixel(point, m_phase + index); });
    m_phase = (m_phase + pixels.count() % dashPeriod) % dashPeriod;
}

void Outline::thinStripes(const LinePixels& pixels) {
    const LinePixels::Range range = pixels.within(m_canvas.units(m_canvas.bounds()));
    const std::span<const int> pattern = dashPattern(m_style);
    for (int first = range.first; first < range.last;) {
        const bool on = isOn(pattern, m_phase + first);
        int last = pattern.empty() ? range.last : first + 1;
        while (last < range.last && isOn(pattern, m_phase + last) == on) {
            ++last;
        }
        QPolygonF stripe = pixels.stripe({first, last});
        for (QPointF& corner : stripe) {
            corner = m_canvas.place(corner);
        }
        (on ? m_onStripes : m_offStripes).push_back(std::move(stripe));
        first = last;
    }
    m_phase = (m_phase + pixels.count() % dashPeriod) % dashPeriod;
}

void Outline::fillStroke(const QPainterPathStroker& stroker, const QPainterPath& path, const Ink& ink) {
    QTransform toPixels = QTransform::fromScale(m_canvas.ratio, m_canvas.ratio);
    // Points mean middles of units.
    toPixels.translate(m_canvas.origin.x() + 0.5, m_canvas.origin.y() + 0.5);
    const QList<QPolygonF> areas = stroker.createStroke(path).toSubpathPolygons(toPixels);
    m_canvas.fill(
        polygonSpans({areas.data(), static_cast<std::size_t>(areas.size())}, FillRule::Winding, m_canvas.bounds()),
        ink);
}

void Outline::wide(const QPainterPath& path) {
    QPainterPathStroker stroker;
    stroker.setWidth(m_width);
    stroker.setCapStyle(Qt::RoundCap);
    stroker.setJoinStyle(m_style == PS_INSIDEFRAME ? Qt::MiterJoin : Qt::RoundJoin);
    const std::span<const int> pattern = dashPattern(m_style);
    if (pattern.empty()) {
        fillStroke(stroker, path, *m_ink);
        return;
    }
    QList<qreal> lengths(pattern.begin(), pattern.end());
    stroker.setCapStyle(Qt::FlatCap);
    stroker.setDashPattern(lengths);
    fillStroke(stroker, path, *m_ink);
    if (m_gap) {
        // The gaps are the dashes of the same pattern begun one part later.
        std::ranges::rotate(lengths, lengths.begin() + 1);
        stroker.setDashPattern(lengths);
        stroker.setDashOffset(dashPeriod - pattern[0]);
        fillStroke(stroker, path, *m_gap);
    }
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
        // A step in any direction has the point itself as its first one.
        thin(QPolygon({points.last(), points.last() + QPoint(1, 0)}));
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

void Outline::curve(const QPolygonF& points, Ends ends) {
    if (m_canvas.isPlain() && ends == Ends::Open) {
        line(points.toPolygon(), LastPoint::Drawn);
    } else if (m_canvas.isPlain()) {
        closed(points.toPolygon());
    } else if (m_ink && !points.isEmpty()) {
        QPainterPath path;
        path.addPolygon(points);
        if (ends == Ends::Met) {
            path.closeSubpath();
        }
        wide(path);
    }
}

void Outline::rectangle(const QRect& box) {
    if (isWide()) {
        rounded(box, {});
        // There and back would draw every pixel twice.
    } else if (box.width() == 1 || box.height() == 1) {
        line(QPolygon({box.topLeft(), box.bottomRight()}), LastPoint::Drawn);
    } else {
        closed(QPolygon({box.topLeft(), box.topRight(), box.bottomRight(), box.bottomLeft()}));
    }
}

/// Between the rows of a shape and those of the one a unit further in: what is filled never shows outside of it.
void Outline::thinRing(const QRect& box, QSize corner) {
    const Spans outer = roundedRows(m_canvas, box, corner);
    const Spans inner = roundedRows(m_canvas, box.adjusted(1, 1, -1, -1), corner - QSize(2, 2));
    Spans ring;
    auto hole = inner.begin();
    for (const Span& row : outer) {
        if (hole == inner.end() || hole->y != row.y) {
            ring.push_back(row);
            continue;
        }
        ring.push_back({row.y, row.left, hole->left});
        ring.push_back({row.y, hole->right, row.right});
        ++hole;
    }
    m_canvas.fill(ring, *m_ink);
}

void Outline::rounded(const QRect& box, QSize corner) {
    if (!m_ink || box.isEmpty()) {
        return;
    }
    const bool solid = dashPattern(m_style).empty();
    if (!isWide() && m_canvas.isPlain()) {
        for (const QPoint& point : outlineOf(roundedRows(m_canvas, box, corner))) {
            addPixel(point, m_phase++);
        }
        plotPixels();
        return;
    }
    if (!isWide() && solid) {
        thinRing(box, corner);
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
