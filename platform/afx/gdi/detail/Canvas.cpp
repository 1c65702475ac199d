#include "platform/afx/gdi/detail/Canvas.h"

#include <algorithm>
#include <cmath>

namespace tvx::afx {

namespace {

int wrapped(std::int64_t value, int by) {
    const auto rest = static_cast<int>(value % by);
    return rest < 0 ? rest + by : rest;
}

void fillRow(Pixel* pixels, int count, Pixel color, Rop2 rop) {
    if (rop == Rop2::Copy) {
        std::fill_n(pixels, count, color);
        return;
    }
    std::transform(pixels, pixels + count, pixels, PenOperation(rop, color));
}

void fillPatternRow(Pixel* row, const Span& span, const Ink& ink) {
    Pixel color = 0;
    for (int x = span.left; x < span.right; ++x) {
        if (ink.at(x, span.y, color)) {
            row[x] = combine(ink.rop, color, row[x]);
        }
    }
}

Span cut(const Span& span, const QRect& area) {
    return {span.y, std::max(span.left, area.left()), std::min(span.right, area.right() + 1)};
}

} // namespace

bool Ink::at(int x, int y, Pixel& pixel) const {
    pixel = color;
    if (!pattern) {
        return true;
    }
    const int column = wrapped(std::int64_t{x} - patternOrigin.x(), pattern->width());
    const int line = wrapped(std::int64_t{y} - patternOrigin.y(), pattern->height());
    pixel = reinterpret_cast<const Pixel*>(pattern->constScanLine(line))[column];
    return (pixel & opaque) != 0;
}

namespace {

/// The pixel that an edge between units is rounded to: a pixel belongs to the unit in which its middle lies.
int firstPixel(int unit, double ratio) {
    return ratio == 1 ? unit : static_cast<int>(std::ceil(unit * ratio - 0.5));
}

} // namespace

QPoint Canvas::pixel(QPoint unit) const {
    return {firstPixel(unit.x() + origin.x(), ratio), firstPixel(unit.y() + origin.y(), ratio)};
}

QRect Canvas::pixels(const QRect& units) const {
    const QPoint end = pixel({units.x() + units.width(), units.y() + units.height()});
    return {pixel(units.topLeft()), end - QPoint(1, 1)};
}

QRegion Canvas::pixels(const QRegion& units) const {
    if (isPlain()) {
        return units.translated(origin);
    }
    // The toolkit wants rectangles in bands; converted ones stay so, but one may have shrunk to nothing.
    QRegion result;
    for (const QRect& rect : units) {
        result |= pixels(rect);
    }
    return result;
}

QRect Canvas::units(const QRect& pixels) const {
    if (pixels.isEmpty()) {
        return {};
    }
    const auto floored = [this](int pixel) { return static_cast<int>(std::floor(pixel / ratio)); };
    const auto raised = [this](int pixel) { return static_cast<int>(std::ceil(pixel / ratio)); };
    return QRect(QPoint(floored(pixels.left()), floored(pixels.top())),
                 QPoint(raised(pixels.right() + 1) - 1, raised(pixels.bottom() + 1) - 1))
        .translated(-origin);
}

void Canvas::fillClipped(const QRect& area, const Ink& ink) {
    for (int y = area.top(); y <= area.bottom(); ++y) {
        if (ink.pattern) {
            fillPatternRow(row(y), {y, area.left(), area.right() + 1}, ink);
        } else {
            fillRow(row(y) + area.left(), area.width(), ink.color, ink.rop);
        }
    }
    m_touched |= area;
}

void Canvas::fill(const QRect& area, const Ink& ink) {
    for (const QRect& visible : clip) {
        if (const QRect part = visible & area; !part.isEmpty()) {
            fillClipped(part, ink);
        }
    }
}

void Canvas::fill(const Spans& spans, const Ink& ink) {
    if (spans.empty()) {
        return;
    }
    for (const QRect& visible : clip) {
        const auto top = std::ranges::lower_bound(spans, visible.top(), {}, &Span::y);
        for (auto span = top; span != spans.end() && span->y <= visible.bottom(); ++span) {
            const Span part = cut(*span, visible);
            if (part.left < part.right) {
                fillClipped(QRect(part.left, part.y, part.right - part.left, 1), ink);
            }
        }
    }
}

void Canvas::plot(QPoint point, const Ink& ink) {
    plot(std::span(&point, 1), ink);
}

void Canvas::plot(std::span<const QPoint> points, const Ink& ink) {
    if (points.empty()) {
        return;
    }
    QRect around(points.front(), points.front());
    for (const QPoint& point : points) {
        around |= QRect(point, point);
    }
    const PenOperation operation(ink.rop, ink.color);
    for (const QRect& visible : clip) {
        if (!visible.intersects(around)) {
            continue;
        }
        // Most shapes lie in one visible rectangle, where their points need not be asked one by one.
        const bool whole = visible.contains(around);
        for (const QPoint& point : points) {
            if (whole || visible.contains(point)) {
                plotVisible(point, ink, operation);
            }
        }
        m_touched |= visible & around;
    }
}

void Canvas::plotVisible(QPoint point, const Ink& ink, const PenOperation& operation) {
    Pixel& pixel = row(point.y())[point.x()];
    Pixel color = 0;
    if (!ink.pattern) {
        pixel = operation(pixel);
    } else if (ink.at(point.x(), point.y(), color)) {
        pixel = combine(ink.rop, color, pixel);
    }
}

namespace {

void blitRow(Pixel* to, const Pixel* from, const Span& span, Rop3 rop, const Ink& brush) {
    if (rop == rop3Source) {
        std::copy(from + span.left, from + span.right, to + span.left);
        return;
    }
    if (!brush.pattern) {
        std::transform(from + span.left, from + span.right, to + span.left, to + span.left,
                       BlitOperation(rop, brush.color));
        return;
    }
    Pixel pattern = 0;
    for (int x = span.left; x < span.right; ++x) {
        if (!brush.at(x, span.y, pattern)) {
            pattern = to[x];
        }
        to[x] = combine(rop, pattern, from[x], to[x]);
    }
}

} // namespace

void Canvas::blit(const QImage& source, QPoint at, Rop3 rop, const Ink& brush) {
    const QRect whole(at, source.size());
    for (const QRect& visible : clip) {
        const QRect part = visible & whole;
        for (int y = part.top(); y <= part.bottom(); ++y) {
            const auto* from = reinterpret_cast<const Pixel*>(source.constScanLine(y - at.y())) - at.x();
            blitRow(row(y), from, {y, part.left(), part.right() + 1}, rop, brush);
        }
        m_touched |= part;
    }
}

} // namespace tvx::afx
