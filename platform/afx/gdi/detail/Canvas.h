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
    QPoint patternOrigin;            ///< in the coordinates of the target's context

    /// The colour at a point; false where nothing is drawn.
    [[nodiscard]] bool at(int x, int y, Pixel& pixel) const;
};

/// An image that is open for drawing, with its place in a context's coordinates and what is visible of it.
/// Points given to the members are in the context's device units; what lies outside the clipping area is left alone.
class Canvas {
public:
    QImage* image = nullptr;
    QPoint origin; ///< where (0, 0) of the context lies in the image
    QRegion clip;  ///< in the context's coordinates, inside the image
    PixelFormat format = PixelFormat::Color;

    /// What has been changed so far, in the context's coordinates.
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
        return reinterpret_cast<Pixel*>(image->bits() + (y + origin.y()) * image->bytesPerLine()) + origin.x();
    }

private:
    void fillClipped(const QRect& area, const Ink& ink);
    void plotVisible(QPoint point, const Ink& ink, const PenOperation& operation);
    QRect m_touched;
};

} // namespace tvx::afx
