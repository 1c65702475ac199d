#include "platform/afx/detail/Canvas.h"

#include <algorithm>

namespace tvx::afx {

namespace {

int wrapped(std::int64_t value, int by) {
    const auto rest = static_cast<int>(value % by);
    return rest < 0 ? rest + by : rest;
}

void fillRow(Pixel* pixels, int count, Pixel color, Rop2 rop) {
    if (rop == Rop2::copy) {
        std::fill_n(pixels, count, color);
        return;
    }
    for (int i = 0; i < count; ++i)
        pixels[i] = combine(rop, color, pixels[i]);
}

void fillPatternRow(Pixel* row, const Span& span, const Ink& ink) {
    Pixel color = 0;
    for (int x = span.left; x < span.right; ++x) {
        if (ink.at(x, span.y, color))
            row[x] = combine(ink.rop, color, row[x]);
    }
}

Span cut(const Span& span, const QRect& area) {
    return {span.y, std::max(span.left, area.left()), std::min(span.right, area.right() + 1)};
}

} // namespace

bool Ink::at(int x, int y, Pixel& pixel) const {
    pixel = color;
    if (!pattern)
        return true;
    const int column = wrapped(std::int64_t{x} - patternOrigin.x(), pattern->width());
    const int line = wrapped(std::int64_t{y} - patternOrigin.y(), pattern->height());
    pixel = reinterpret_cast<const Pixel*>(pattern->constScanLine(line))[column];
    return (pixel & kOpaque) != 0;
}

void Canvas::fillClipped(const QRect& area, const Ink& ink) {
    for (int y = area.top(); y <= area.bottom(); ++y) {
        if (ink.pattern)
            fillPatternRow(row(y), {y, area.left(), area.right() + 1}, ink);
        else
            fillRow(row(y) + area.left(), area.width(), ink.color, ink.rop);
    }
    touched_ |= area;
}

void Canvas::fill(const QRect& area, const Ink& ink) {
    for (const QRect& visible : clip) {
        if (const QRect part = visible & area; !part.isEmpty())
            fillClipped(part, ink);
    }
}

void Canvas::fill(const Spans& spans, const Ink& ink) {
    if (spans.empty())
        return;
    for (const QRect& visible : clip) {
        const auto top = std::ranges::lower_bound(spans, visible.top(), {}, &Span::y);
        for (auto span = top; span != spans.end() && span->y <= visible.bottom(); ++span) {
            const Span part = cut(*span, visible);
            if (part.left < part.right)
                fillClipped(QRect(part.left, part.y, part.right - part.left, 1), ink);
        }
    }
}

void Canvas::plot(QPoint point, const Ink& ink) {
    plot(std::span(&point, 1), ink);
}

void Canvas::plot(std::span<const QPoint> points, const Ink& ink) {
    Pixel color = 0;
    for (const QRect& visible : clip) {
        for (const QPoint& point : points) {
            if (!visible.contains(point) || !ink.at(point.x(), point.y(), color))
                continue;
            Pixel& pixel = row(point.y())[point.x()];
            pixel = combine(ink.rop, color, pixel);
            touched_ |= QRect(point, point);
        }
    }
}

void Canvas::blit(const QImage& source, QPoint at, Rop3 rop, const Ink& brush) {
    const QRect whole(at, source.size());
    for (const QRect& visible : clip) {
        const QRect part = visible & whole;
        if (part.isEmpty())
            continue;
        for (int y = part.top(); y <= part.bottom(); ++y) {
            const auto* from = reinterpret_cast<const Pixel*>(source.constScanLine(y - at.y())) - at.x();
            Pixel* to = row(y);
            if (rop == kRop3Source) {
                std::copy(from + part.left(), from + part.right() + 1, to + part.left());
                continue;
            }
            Pixel pattern = 0;
            for (int x = part.left(); x <= part.right(); ++x) {
                if (!brush.at(x, y, pattern))
                    pattern = to[x];
                to[x] = combine(rop, pattern, from[x], to[x]);
            }
        }
        touched_ |= part;
    }
}

} // namespace tvx::afx
