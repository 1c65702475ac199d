#pragma once

#include "platform/base/Export.h"
#include "platform/base/Geometry.h"

#include <QPoint>
#include <QRect>
#include <QSize>

#include <algorithm>
#include <climits>
#include <cstdint>

namespace tvx::afx {

/// Pixels to an inch, both ways.
constexpr int pixelsPerInch = 96;

/// Nothing is drawn beyond this distance from the origin.
constexpr int farthestPixel = 1 << 27;

/// Conversion between logical and device units, in integers: halves are rounded up.
class TVX_PLATFORM_API Mapping {
public:
    [[nodiscard]] int mode() const {
        return m_mode;
    }
    /// False for a number that is no mode. Extents become the mode's own; origins stay.
    bool setMode(int mode);

    QPoint windowOrigin;
    QPoint viewportOrigin;
    [[nodiscard]] QSize windowExtent() const {
        return m_windowExtent;
    }
    [[nodiscard]] QSize viewportExtent() const {
        return m_viewportExtent;
    }
    /// False in the modes whose extents are fixed, and for an extent of 0.
    bool setWindowExtent(QSize extent);
    bool setViewportExtent(QSize extent);

    [[nodiscard]] QPoint toDevice(QPoint logical) const;
    [[nodiscard]] QPoint toLogical(QPoint device) const;
    /// As `toDevice`, for drawing: never farther out than `farthestPixel`, so that sizes and sums fit an `int`.
    [[nodiscard]] QPoint toPixel(QPoint logical) const;
    /// Both corners converted; of corners in the wrong order those of the result are put right.
    [[nodiscard]] QRect toPixels(const RECT& logical) const;
    /// Widths and heights alone, never negative.
    [[nodiscard]] QSize sizeToDevice(QSize logical) const;
    [[nodiscard]] QSize sizeToLogical(QSize device) const;

private:
    void keepIsotropic();
    [[nodiscard]] bool hasFreeExtents() const;

    int m_mode = 1;
    QSize m_windowExtent{1, 1};
    QSize m_viewportExtent{1, 1};
};

/// The number kept inside the range of `int`.
constexpr int saturated(std::int64_t value) {
    return static_cast<int>(std::clamp<std::int64_t>(value, INT_MIN, INT_MAX));
}
/// A rectangle from its corner and size, which may be negative.
constexpr RECT rectAt(int x, int y, int width, int height) {
    return {x, y, saturated(std::int64_t{x} + width), saturated(std::int64_t{y} + height)};
}
/// Width or height of a rectangle.
constexpr int distance(int from, int to) {
    return saturated(std::int64_t{to} - from);
}

/// `value * by / per`, rounded to the nearest integer (halves up) and kept inside the range of `int`. `per` is not 0.
[[nodiscard]] TVX_PLATFORM_API int scaled(std::int64_t value, int by, int per);

} // namespace tvx::afx
