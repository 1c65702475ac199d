#include "platform/afx/gdi/detail/Mapping.h"

#include "platform/afx/gdi/GdiTypes.h"

#include <algorithm>
#include <cstdlib>

namespace tvx::afx {

int scaled(std::int64_t value, int by, int per) {
    if (by == per) {
        return saturated(value);
    }
    // A distance of 33 bits, doubled, times an extent of 32 does not fit 64. Halves are rounded up whatever the sign,
    // so that a shape has the same size on either side of the origin.
    __extension__ using Wide = __int128;
    const Wide sign = per < 0 ? -1 : 1;
    const Wide numerator = sign * (Wide{2} * value * by + per);
    const Wide denominator = sign * 2 * per;
    Wide quotient = numerator / denominator;
    if (numerator % denominator < 0) {
        --quotient;
    }
    return static_cast<int>(std::clamp<Wide>(quotient, INT_MIN, INT_MAX));
}

namespace {

/// Logical units to an inch of the modes with fixed extents.
int unitsPerInch(int mode) {
    switch (mode) {
    case MM_LOMETRIC:
        return 254;
    case MM_HIMETRIC:
        return 2540;
    case MM_LOENGLISH:
        return 100;
    case MM_HIENGLISH:
        return 1000;
    case MM_TWIPS:
        return 1440;
    default:
        return 0;
    }
}

} // namespace

bool Mapping::hasFreeExtents() const {
    return m_mode == MM_ISOTROPIC || m_mode == MM_ANISOTROPIC;
}

bool Mapping::setMode(int mode) {
    if (mode < MM_TEXT || mode > MM_ANISOTROPIC) {
        return false;
    }
    // MM_ISOTROPIC begins with the extents of tenths of a millimetre, MM_ANISOTROPIC with those of the mode before.
    const int units = unitsPerInch(mode == MM_ISOTROPIC ? MM_LOMETRIC : mode);
    if (units != 0) {
        m_windowExtent = {units, units};
        m_viewportExtent = {pixelsPerInch, -pixelsPerInch};
    } else if (mode == MM_TEXT) {
        m_windowExtent = m_viewportExtent = {1, 1};
    }
    m_mode = mode;
    return true;
}

bool Mapping::setWindowExtent(QSize extent) {
    if (!hasFreeExtents() || extent.width() == 0 || extent.height() == 0) {
        return false;
    }
    m_windowExtent = extent;
    keepIsotropic();
    return true;
}

bool Mapping::setViewportExtent(QSize extent) {
    if (!hasFreeExtents() || extent.width() == 0 || extent.height() == 0) {
        return false;
    }
    m_viewportExtent = extent;
    keepIsotropic();
    return true;
}

void Mapping::keepIsotropic() {
    if (m_mode != MM_ISOTROPIC) {
        return;
    }
    const std::int64_t width = std::abs(std::int64_t{m_viewportExtent.width()});
    const std::int64_t height = std::abs(std::int64_t{m_viewportExtent.height()});
    const int unitsWide = std::abs(m_windowExtent.width());
    const int unitsHigh = std::abs(m_windowExtent.height());
    const auto signedLike = [](int value, int sign) { return sign < 0 ? -value : value; };
    // A pixel stands for as many units down as across: the extent with pixels to spare gives them up.
    if (width * unitsHigh > height * unitsWide) {
        m_viewportExtent.setWidth(
            signedLike(std::max(1, scaled(height, unitsWide, unitsHigh)), m_viewportExtent.width()));
    } else {
        m_viewportExtent.setHeight(
            signedLike(std::max(1, scaled(width, unitsHigh, unitsWide)), m_viewportExtent.height()));
    }
}

namespace {

int converted(int value, int fromOrigin, int by, int per, int toOrigin) {
    const std::int64_t distance = std::int64_t{value} - fromOrigin;
    return saturated(std::int64_t{scaled(distance, by, per)} + toOrigin);
}

} // namespace

QPoint Mapping::toDevice(QPoint logical) const {
    return {
        converted(logical.x(), windowOrigin.x(), m_viewportExtent.width(), m_windowExtent.width(), viewportOrigin.x()),
        converted(logical.y(), windowOrigin.y(), m_viewportExtent.height(), m_windowExtent.height(),
                  viewportOrigin.y())};
}

QPoint Mapping::toLogical(QPoint device) const {
    return {
        converted(device.x(), viewportOrigin.x(), m_windowExtent.width(), m_viewportExtent.width(), windowOrigin.x()),
        converted(device.y(), viewportOrigin.y(), m_windowExtent.height(), m_viewportExtent.height(),
                  windowOrigin.y())};
}

QPoint Mapping::toPixel(QPoint logical) const {
    const QPoint device = toDevice(logical);
    return {std::clamp(device.x(), -farthestPixel, farthestPixel),
            std::clamp(device.y(), -farthestPixel, farthestPixel)};
}

QRect Mapping::toPixels(const RECT& logical) const {
    const QPoint first = toPixel(QPoint(logical.left, logical.top));
    const QPoint second = toPixel(QPoint(logical.right, logical.bottom));
    const QPoint corner(std::min(first.x(), second.x()), std::min(first.y(), second.y()));
    return {corner, QSize(std::abs(second.x() - first.x()), std::abs(second.y() - first.y()))};
}

QSize Mapping::sizeToDevice(QSize logical) const {
    return {std::abs(scaled(logical.width(), m_viewportExtent.width(), m_windowExtent.width())),
            std::abs(scaled(logical.height(), m_viewportExtent.height(), m_windowExtent.height()))};
}

QSize Mapping::sizeToLogical(QSize device) const {
    return {std::abs(scaled(device.width(), m_windowExtent.width(), m_viewportExtent.width())),
            std::abs(scaled(device.height(), m_windowExtent.height(), m_viewportExtent.height()))};
}

} // namespace tvx::afx
