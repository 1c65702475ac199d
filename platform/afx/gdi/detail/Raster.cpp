#include "platform/afx/gdi/detail/Raster.h"

#include "platform/afx/gdi/detail/Mapping.h"

#include <algorithm>
#include <cmath>

namespace tvx::afx {

namespace {

/// Points farther out are pulled in, so that products of two coordinates fit 64 bits.
QPoint pulledIn(QPoint point) {
    return {std::clamp(point.x(), -farthestPixel, farthestPixel), std::clamp(point.y(), -farthestPixel, farthestPixel)};
}

std::int64_t floorDiv(std::int64_t value, std::int64_t by) {
    const std::int64_t quotient = value / by;
    return value % by != 0 && (value < 0) != (by < 0) ? quotient - 1 : quotient;
}

} // namespace

LinePixels::LinePixels(QPoint from, QPoint to) : m_from(pulledIn(from)) {
    const QPoint delta = pulledIn(to) - m_from;
    m_steep = std::abs(delta.y()) > std::abs(delta.x());
    const int major = m_steep ? delta.y() : delta.x();
    m_count = std::abs(major);
    m_majorStep = major < 0 ? -1 : 1;
    m_minorDelta = m_steep ? delta.x() : delta.y();
}

LinePixels::Range LinePixels::within(const QRect& bounds) const {
    const int start = m_steep ? m_from.y() : m_from.x();
    const int low = m_steep ? bounds.top() : bounds.left();
    const int high = m_steep ? bounds.bottom() : bounds.right();
    const int first = m_majorStep > 0 ? low - start : start - high;
    const int last = m_majorStep > 0 ? high - start : start - low;
    return {std::clamp(first, 0, m_count), std::clamp(last + 1, 0, m_count)};
}

QPoint LinePixels::at(int index) const {
    const int major = m_majorStep * index;
    const auto minor = static_cast<int>(floorDiv(2 * m_minorDelta * index + m_count, 2 * std::int64_t{m_count}));
    return m_from + (m_steep ? QPoint(minor, major) : QPoint(major, minor));
}

QPolygonF LinePixels::stripe(Range range) const {
    const QPointF start = QPointF(m_from) + QPointF(0.5, 0.5);
    const double slope = static_cast<double>(m_minorDelta) / (std::int64_t{m_majorStep} * m_count);
    // Backwards the first pixel's border is its far one.
    const double first = m_majorStep * (range.first - 0.5);
    const double last = m_majorStep * (range.last - 0.5);
    const auto corner = [&](double major, double across) {
        const double minor = major * slope + across;
        return start + (m_steep ? QPointF(minor, major) : QPointF(major, minor));
    };
    const double low = std::min(first, last);
    const double high = std::max(first, last);
    const double side = m_steep ? 0.5 : -0.5;
    return QPolygonF({corner(low, side), corner(high, side), corner(high, -side), corner(low, -side)});
}

namespace {

/// How many pixels each end of row `row` of an ellipse of `size` lies inside the box.
int ellipseInset(QSize size, int row) {
    if (row == (size.height() - 1) / 2 || row == size.height() / 2) {
        return 0; // the middle touches the box, however flat the ellipse is
    }
    const double width = size.width();
    const double height = size.height();
    const double y = (2.0 * row + 1.0 - height) / height;
    const double halfWidth = width * std::sqrt(std::max(0.0, 1.0 - y * y)) / 2.0;
    const int inset = static_cast<int>(std::ceil(width / 2.0 - halfWidth - 0.5));
    return std::clamp(inset, 0, (size.width() - 1) / 2);
}

} // namespace

Spans ellipseSpans(const QRect& box) {
    return roundRectSpans(box, box.size());
}

Spans roundRectSpans(const QRect& box, QSize corner) {
    Spans rows;
    if (box.isEmpty()) {
        return rows;
    }
    corner = corner.boundedTo(box.size());
    const int straight = box.height() - corner.height();
    rows.reserve(static_cast<std::size_t>(box.height()));
    for (int row = 0; row < box.height(); ++row) {
        int inset = 0;
        if (!corner.isEmpty() && row < corner.height() / 2) {
            inset = ellipseInset(corner, row);
        } else if (!corner.isEmpty() && row >= corner.height() / 2 + straight) {
            inset = ellipseInset(corner, row - straight);
        }
        rows.push_back({box.top() + row, box.left() + inset, box.right() + 1 - inset});
    }
    return rows;
}

std::vector<QPoint> framePixels(const QRect& box, const QRect& bounds) {
    std::vector<QPoint> pixels;
    if (box.isEmpty()) {
        return pixels;
    }
    const QRect inside = box & bounds;
    const auto add = [&](QPoint point) {
        if (bounds.contains(point)) {
            pixels.push_back(point);
        }
    };
    for (int x = inside.left(); x <= inside.right(); ++x) {
        add({x, box.top()});
        if (box.height() > 1) {
            add({x, box.bottom()});
        }
    }
    for (int y = std::max(inside.top(), box.top() + 1); y <= std::min(inside.bottom(), box.bottom() - 1); ++y) {
        add({box.left(), y});
        if (box.width() > 1) {
            add({box.right(), y});
        }
    }
    return pixels;
}

namespace {

/// Goes around a shape given by its rows, a row at a time down the right side and up the left one.
class OutlineWalker {
public:
    explicit OutlineWalker(const Spans& rows) : m_rows(rows) {}

    std::vector<QPoint> walk() {
        const int last = static_cast<int>(m_rows.size()) - 1;
        run(m_rows.front().y, m_rows.front().left, m_rows.front().right - 1);
        for (int row = 1; row < last; ++row) {
            rightEnd(row);
        }
        if (last > 0) {
            run(m_rows.back().y, m_rows.back().right - 1, m_rows.back().left);
        }
        for (int row = last - 1; row > 0; --row) {
            leftEnd(row);
        }
        return std::move(m_outline);
    }

private:
    void run(int y, int from, int to) {
        const int step = from <= to ? 1 : -1;
        for (int x = from; x != to + step; x += step) {
            m_outline.emplace_back(x, y);
        }
    }
    [[nodiscard]] const Span& row(int index) const {
        return m_rows[static_cast<std::size_t>(index)];
    }
    void rightEnd(int index) {
        const int end = row(index).right - 1;
        const int above = row(index - 1).right;
        const int below = row(index + 1).right;
        if (above <= end) {
            run(row(index).y, above, end);
        } else {
            run(row(index).y, end, std::min(end, below));
        }
    }
    void leftEnd(int index) {
        const Span& span = row(index);
        if (span.right - span.left == 1) {
            return; // the right side had it
        }
        const int above = row(index - 1).left - 1;
        const int below = row(index + 1).left - 1;
        if (below >= span.left) {
            run(span.y, below, span.left);
        } else {
            run(span.y, span.left, std::max(span.left, above));
        }
    }

    const Spans& m_rows;
    std::vector<QPoint> m_outline;
};

} // namespace

std::vector<QPoint> outlineOf(const Spans& rows) {
    return rows.empty() ? std::vector<QPoint>() : OutlineWalker(rows).walk();
}

namespace {

/// A side of a polygon, from its upper to its lower end.
struct Edge {
    double top;
    double bottom;
    double x; ///< at the upper end
    double slope;
    int direction; ///< +1 when it was drawn downwards

    [[nodiscard]] double at(double y) const {
        return x + (y - top) * slope;
    }
};

std::vector<Edge> edgesOf(std::span<const QPolygonF> polygons) {
    std::vector<Edge> edges;
    for (const QPolygonF& polygon : polygons) {
        for (qsizetype i = 0; i < polygon.size(); ++i) {
            QPointF from = polygon[i];
            QPointF to = polygon[(i + 1) % polygon.size()];
            // A side along a row has no crossing with it.
            if (from.y() == to.y()) {
                continue;
            }
            const int direction = from.y() < to.y() ? 1 : -1;
            if (direction < 0) {
                std::swap(from, to);
            }
            edges.push_back({from.y(), to.y(), from.x(), (to.x() - from.x()) / (to.y() - from.y()), direction});
        }
    }
    std::ranges::sort(edges, {}, &Edge::top);
    return edges;
}

struct Crossing {
    double x;
    int direction;
};

int firstPixel(double x, const QRect& bounds) {
    return static_cast<int>(std::clamp(std::ceil(x - 0.5), double(bounds.left()), double(bounds.right()) + 1));
}

void appendRow(Spans& spans, int y, std::span<const Crossing> crossings, FillRule rule, const QRect& bounds) {
    int winding = 0;
    for (std::size_t i = 0; i + 1 < crossings.size(); ++i) {
        winding += rule == FillRule::Winding ? crossings[i].direction : (winding ? -1 : 1);
        const int left = firstPixel(crossings[i].x, bounds);
        const int right = firstPixel(crossings[i + 1].x, bounds);
        if (winding == 0 || left >= right) {
            continue;
        }
        if (!spans.empty() && spans.back().y == y && spans.back().right == left) {
            spans.back().right = right;
        } else {
            spans.push_back({y, left, right});
        }
    }
}

} // namespace

Spans polygonSpans(std::span<const QPolygonF> polygons, FillRule rule, const QRect& bounds) {
    const std::vector<Edge> edges = edgesOf(polygons);
    Spans spans;
    std::vector<const Edge*> active;
    std::vector<Crossing> crossings;
    std::size_t next = 0;
    for (int y = bounds.top(); y <= bounds.bottom(); ++y) {
        // A pixel belongs to the area when its centre does, so that areas side by side neither overlap nor leave gaps.
        const double middle = y + 0.5;
        while (next < edges.size() && edges[next].top <= middle) {
            active.push_back(&edges[next++]);
        }
        std::erase_if(active, [&](const Edge* edge) { return edge->bottom <= middle; });
        if (active.empty() && next == edges.size()) {
            break;
        }
        crossings.clear();
        for (const Edge* edge : active) {
            crossings.push_back({edge->at(middle), edge->direction});
        }
        std::ranges::sort(crossings, {}, &Crossing::x);
        appendRow(spans, y, crossings, rule, bounds);
    }
    return spans;
}

} // namespace tvx::afx
