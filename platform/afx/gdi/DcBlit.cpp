#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/afx/gdi/detail/Stretch.h"

#include <algorithm>

using namespace tvx::afx;

namespace {

/// Pixels of one direction from an edge to another: `mirrored` tells that they run downwards.
struct Extent {
    int start;
    int length;
    bool mirrored;
};

/// Pixel `from` is the first one in either direction.
Extent extentOf(int from, int to) {
    return to < from ? Extent{to + 1, from - to, true} : Extent{from, to - from, false};
}

/// A rectangle of a blit, with the direction in which its pixels are to be read.
struct BlitArea {
    QRect rect;
    bool mirroredX;
    bool mirroredY;
};

BlitArea blitArea(const Mapping& mapping, const RECT& logical) {
    const QPoint first = mapping.toPixel(QPoint(logical.left, logical.top));
    const QPoint second = mapping.toPixel(QPoint(logical.right, logical.bottom));
    const Extent across = extentOf(first.x(), second.x());
    const Extent down = extentOf(first.y(), second.y());
    return {{across.start, down.start, across.length, down.length}, across.mirrored, down.mirrored};
}

/// What a blit reads: the part of the source that exists, and where it lies in the part asked for.
struct SourcePixels {
    QImage image; ///< a copy: source and target may be the same pixels
    QPoint offset;
    QSize wanted; ///< pixels of the part asked for
};

SourcePixels readSource(DeviceContext& source, const QRect& units) {
    Drawing drawing(source);
    if (!drawing) {
        return {};
    }
    const QRect wanted = drawing.canvas.pixels(units);
    const QRect exists = wanted & drawing.canvas.image->rect();
    return {exists.isEmpty() ? QImage() : drawing.canvas.image->copy(exists), exists.topLeft() - wanted.topLeft(),
            wanted.size()};
}

/// Gives pixels the target's format: black and white become the target's text and background colours, and colours
/// become white where they are the source's background colour.
void convertPixels(QImage& image, const DeviceContext& source, const DeviceContext& target) {
    const PixelFormat from = source.target->format();
    const PixelFormat to = target.target->format();
    if (from == to) {
        return;
    }
    const bool expands = from == PixelFormat::Monochrome;
    const Pixel selected = expands ? whitePixel : pixelOf(source.state.backColor);
    const Pixel yes = expands ? pixelOf(target.state.backColor) : whitePixel;
    const Pixel no = expands ? pixelOf(target.state.textColor) : blackPixel;
    for (int y = 0; y < image.height(); ++y) {
        auto* row = reinterpret_cast<Pixel*>(image.scanLine(y));
        std::transform(row, row + image.width(), row, [&](Pixel pixel) { return pixel == selected ? yes : no; });
    }
}

void drawSource(DeviceContext& target, const BlitArea& to, DeviceContext& source, const BlitArea& from, Rop3 rop) {
    SourcePixels pixels = readSource(source, from.rect);
    Drawing drawing(target);
    if (!drawing || pixels.image.isNull()) {
        return;
    }
    const QRect place = drawing.canvas.pixels(to.rect);
    if (place.isEmpty()) {
        return;
    }
    QPoint at = place.topLeft() + pixels.offset;
    const bool mirroredX = to.mirroredX != from.mirroredX;
    const bool mirroredY = to.mirroredY != from.mirroredY;
    if (pixels.wanted != place.size() || mirroredX || mirroredY) {
        // Pixels that only the display has more of are not put together as those of a picture made smaller are.
        const int mode = from.rect.size() == to.rect.size() ? COLORONCOLOR : target.state.stretchMode;
        const Stretch stretch{{pixels.wanted.width(), place.width(), mirroredX},
                              {pixels.wanted.height(), place.height(), mirroredY},
                              mode};
        at = place.topLeft() + stretch.placeOf(QRect(pixels.offset, pixels.image.size())).topLeft();
        pixels.image = stretch.apply(pixels.image, pixels.offset);
    }
    convertPixels(pixels.image, source, target);
    QImage pattern;
    const Ink brush = target.brushInk(drawing.canvas, *target.state.brush, Rop2::Copy, pattern).value_or(Ink{});
    drawing.canvas.blit(pixels.image, at, rop, brush);
}

} // namespace

BOOL CDC::StretchBlt(int x, int y, int width, int height, CDC* source, int sourceX, int sourceY, int sourceWidth,
                     int sourceHeight, DWORD rop) {
    const Rop3 ternary = rop3FromCode(rop);
    if (!usesSource(ternary)) {
        return PatBlt(x, y, width, height, rop);
    }
    const auto target = findContext(m_hDC);
    const auto from = findContext(source ? source->m_hDC : nullptr);
    if (!target || !from) {
        return FALSE;
    }
    const BlitArea toArea = blitArea(target->state.mapping, rectAt(x, y, width, height));
    const BlitArea fromArea = blitArea(from->state.mapping, rectAt(sourceX, sourceY, sourceWidth, sourceHeight));
    if (!toArea.rect.isEmpty() && !fromArea.rect.isEmpty()) {
        drawSource(*target, toArea, *from, fromArea, ternary);
    }
    return TRUE;
}

BOOL CDC::BitBlt(int x, int y, int width, int height, CDC* source, int sourceX, int sourceY, DWORD rop) {
    return StretchBlt(x, y, width, height, source, sourceX, sourceY, width, height, rop);
}

BOOL BitBlt(HDC dc, int x, int y, int width, int height, HDC source, int sourceX, int sourceY, DWORD rop) {
    CDC* target = CDC::FromHandle(dc);
    return target && target->BitBlt(x, y, width, height, CDC::FromHandle(source), sourceX, sourceY, rop);
}
