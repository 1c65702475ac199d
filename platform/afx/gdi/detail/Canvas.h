#pragma once

#include "platform/afx/gdi/detail/Raster.h"
#include "platform/base/Types.h"

#include <QImage>
#include <QRegion>

#include <span>

/// @file
/// Pixels that can be drawn on. All images here are `QImage::Format_RGB32`; a monochrome one is an image of its own
/// that holds black and white only.

namespace tvx::afx {

constexpr Pixel pixelOf(COLORREF color) {
    return opaque | (static_cast<Pixel>(GetRValue(color)) << 16) | (static_cast<Pixel>(GetGValue(color)) << 8) |
           GetBValue(color);
}
constexpr COLORREF colorOf(Pixel pixel) {
    return RGB(static_cast<int>(pixel >> 16), static_cast<int>(pixel >> 8), static_cast<int>(pixel));
}

enum class PixelFormat { Color, Monochrome };

/// The colour nearest to `pixel` in a format: black or white by brightness in a monochrome one.
constexpr Pixel nearest(Pixel pixel, PixelFormat format) {
    if (format == PixelFormat::Color) {
        return pixel | opaque;
    }
    const unsigned brightness = ((pixel >> 16) & 0xFF) * 299 + ((pixel >> 8) & 0xFF) * 587 + (pixel & 0xFF) * 114;
    return brightness >= 128 * 1000 ? whitePixel : blackPixel;
}

/// What an area is drawn with: one colour or a repeated picture, and how it combines with what is there.
struct Ink {
    Pixel color = blackPixel;
    Rop2 rop = Rop2::Copy;
    const QImage* pattern = nullptr; ///< Format_ARGB32; pixels with alpha 0 leave the target alone
    QPoint patternOrigin;

    /// The colour at a point; false where nothing is drawn.
    [[nodiscard]] bool at(int x, int y, Pixel& pixel) const;
};

/// An image that is open for drawing, and what is visible of it.
///
/// Hosts count in a context's device units. On a display that has more pixels a unit is a block of them: `pixels` gives
/// the blocks of a rectangle, which lie side by side without gaps also where a unit is no whole number of pixels. All
/// other members count in pixels of the image; what lies outside the clipping area is left alone.
class TVX_PLATFORM_API Canvas {
public:
    QImage* image = nullptr;
    QPoint origin;    ///< where (0, 0) of the context lies on the target, in units
    double ratio = 1; ///< pixels to a unit, either way
    QRegion clip;     ///< in pixels, inside the image
    PixelFormat format = PixelFormat::Color;

    /// Whether a unit is a pixel.
    [[nodiscard]] bool isPlain() const {
        return ratio == 1;
    }
    /// The first pixel of a unit.
    [[nodiscard]] QPoint pixel(QPoint unit) const;
    /// The pixels of a rectangle of units.
    [[nodiscard]] QRect pixels(const QRect& units) const;
    [[nodiscard]] QRegion pixels(const QRegion& units) const;
    /// A place between units as one between pixels.
    [[nodiscard]] QPointF place(QPointF units) const {
        return (units + origin) * ratio;
    }
    /// The units that pixels belong to, those only partly covered too.
    [[nodiscard]] QRect units(const QRect& pixels) const;

    /// The pixels that have been changed so far.
    [[nodiscard]] QRect touched() const {
        return m_touched;
    }
    [[nodiscard]] QRect bounds() const {
        return clip.boundingRect();
    }
    /// Marks an area as changed by drawing that went around the members.
    void touch(const QRect& area) {
        m_touched |= area & bounds();
    }

    void fill(const QRect& area, const Ink& ink);
    void fill(const Spans& spans, const Ink& ink);
    void plot(QPoint point, const Ink& ink);
    /// Many points of one ink.
    void plot(std::span<const QPoint> points, const Ink& ink);
    /// Combines `source`, whose pixels are in this canvas's format, with the pixels from `at` on.
    void blit(const QImage& source, QPoint at, Rop3 rop, const Ink& brush);

    [[nodiscard]] Pixel* row(int y) const {
        return reinterpret_cast<Pixel*>(image->bits() + y * image->bytesPerLine());
    }

private:
    void fillClipped(const QRect& area, const Ink& ink);
    void plotVisible(QPoint point, const Ink& ink, const PenOperation& operation);
    QRect m_touched;
};

} // namespace tvx::afx
