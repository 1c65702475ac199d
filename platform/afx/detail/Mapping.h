#pragma once

#include "platform/base/Export.h"
#include "platform/base/Geometry.h"

#include <QPoint>
#include <QRect>
#include <QSize>

namespace tvx::afx {

/// Pixels to an inch, both ways.
constexpr int kPixelsPerInch = 96;

/// Conversion between logical and device units, in integers: halves are rounded up.
class TVX_PLATFORM_API Mapping {
public:
    [[nodiscard]] int mode() const {
        return mode_;
    }
    /// False for a number that is no mode. Extents become the mode's own; origins stay.
    bool setMode(int mode);

    QPoint windowOrigin;
    QPoint viewportOrigin;
    [[nodiscard]] QSize windowExtent() const {
        return windowExtent_;
    }
    [[nodiscard]] QSize viewportExtent() const {
        return viewportExtent_;
    }
    /// False in the modes whose extents are fixed, and for an extent of 0.
    bool setWindowExtent(QSize extent);
    bool setViewportExtent(QSize extent);

    [[nodiscard]] QPoint toDevice(QPoint logical) const;
    [[nodiscard]] QPoint toLogical(QPoint device) const;
    /// Both corners converted; of corners in the wrong order those of the result are put right.
    [[nodiscard]] QRect toDevice(const RECT& logical) const;
    /// Widths and heights alone, never negative.
    [[nodiscard]] QSize sizeToDevice(QSize logical) const;
    [[nodiscard]] QSize sizeToLogical(QSize device) const;

private:
    void keepIsotropic();
    [[nodiscard]] bool hasFreeExtents() const;

    int mode_ = 1;
    QSize windowExtent_{1, 1};
    QSize viewportExtent_{1, 1};
};

/// `value * by / per`, rounded to the nearest integer (halves up) and kept inside the range of `int`. `per` is not 0.
[[nodiscard]] TVX_PLATFORM_API int scaled(std::int64_t value, int by, int per);

} // namespace tvx::afx
