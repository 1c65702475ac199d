#pragma once

#include "platform/afx/gdi/detail/RasterOps.h"
#include "platform/base/Export.h"

#include <QPoint>
#include <QPolygonF>
#include <QRect>

#include <cstdint>
#include <cstdlib>
#include <span>
#include <vector>

/// @file
/// Shapes as pixels, without a drawing target: which pixels a line, an ellipse or a polygon covers. Nothing here is
/// antialiased, and every pixel of a shape comes once, so that exclusive-or drawing can be undone.

namespace tvx::afx {

/// Pixels `left` .. `right` - 1 of row `y`.
struct Span {
    int y;
    int left;
    int right;
    bool operator==(const Span&) const = default;
};
using Spans = std::vector<Span>;

/// The pixels of a line one pixel wide, from its first point up to but without its last one. The pixels between two
/// points do not depend on the direction of drawing.
class TVX_PLATFORM_API LinePixels {
public:
    LinePixels(QPoint from, QPoint to);

    /// Number of pixels, the last point not counted. 0 when both points are the same.
    [[nodiscard]] int count() const {
        return m_count;
    }
    struct Range {
        int first;
        int last; ///< one past the end
    };
    /// The pixels that may lie in `bounds`: keeps lines with far away ends from taking as long as they are.
    [[nodiscard]] Range within(const QRect& bounds) const;
    /// Pixel number `index`.
    [[nodiscard]] QPoint at(int index) const;
    /// The area of pixels `first` .. `last` - 1 without the steps between them: as wide as a pixel, with its ends on
    /// pixel borders. The corners go clockwise.
    [[nodiscard]] QPolygonF stripe(Range range) const;
    /// Calls `plot(index, point)` for the pixels of a range, in order.
    template <class Plot>
    void forEach(Range range, Plot plot) const;

private:
    QPoint m_from;
    int m_count;
    bool m_steep;
    int m_majorStep;
    std::int64_t m_minorDelta;
};

template <class Plot>
void LinePixels::forEach(Range range, Plot plot) const {
    if (range.first >= range.last) {
        return;
    }
    // The rest of the division that `at` does, carried on from pixel to pixel.
    const QPoint start = at(range.first) - m_from;
    const std::int64_t whole = 2 * std::int64_t{m_count};
    std::int64_t minor = m_steep ? start.x() : start.y();
    std::int64_t rest = 2 * m_minorDelta * range.first + m_count - minor * whole;
    for (int index = range.first; index < range.last; ++index) {
        const int major = m_majorStep * index;
        const int across = static_cast<int>(minor);
        plot(index, m_from + (m_steep ? QPoint(across, major) : QPoint(major, across)));
        rest += 2 * m_minorDelta;
        if (rest >= whole) {
            rest -= whole;
            ++minor;
        } else if (rest < 0) {
            rest += whole;
            --minor;
        }
    }
}

/// The rows of the largest ellipse inside `box`, top row first. Empty for an empty box.
[[nodiscard]] TVX_PLATFORM_API Spans ellipseSpans(const QRect& box);

/// The rows of a rectangle whose corners are quarters of an ellipse of size `corner`.
[[nodiscard]] TVX_PLATFORM_API Spans roundRectSpans(const QRect& box, QSize corner);

/// The pixels of a rectangle's border that lie in `bounds`, each once.
[[nodiscard]] std::vector<QPoint> framePixels(const QRect& box, const QRect& bounds);

/// The outline, one pixel thin, of a shape with one span a row and no dents (as the two above make): clockwise from
/// the left end of the top row, each pixel once.
[[nodiscard]] TVX_PLATFORM_API std::vector<QPoint> outlineOf(const Spans& rows);

enum class FillRule { Alternate, Winding };

/// Pixels whose centre lies inside closed polygons: of edges on pixel borders the left and top ones belong to the
/// shape, the right and bottom ones do not. Only rows of `bounds` are looked at.
/// @param polygons corners in pixel borders: (0, 0) is the top left corner of the first pixel
[[nodiscard]] TVX_PLATFORM_API Spans polygonSpans(std::span<const QPolygonF> polygons, FillRule rule,
                                                  const QRect& bounds);

} // namespace tvx::afx
