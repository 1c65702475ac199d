#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Module.h"
#include "platform/win/ResourceError.h"

#include <optional>
#include <vector>

namespace tvx {

/// Pixels of a bitmap, an icon or a cursor, decoded.
struct Picture {
    int width = 0;         ///< in pixels, at least 1
    int height = 0;        ///< in pixels, at least 1
    int bitsPerPixel = 32; ///< of the resource the pixels came from: 1 tells a monochrome bitmap
    /// `width * height` values 0xAARRGGBB, top row first, not premultiplied. Bitmaps are opaque (alpha 255) unless
    /// they have 32 bits and an alpha channel.
    std::vector<std::uint32_t> pixels;
    bool hasAlpha = false; ///< whether any pixel is not opaque

    /// Pixel at column `x`, row `y`, both inside the picture.
    [[nodiscard]] std::uint32_t at(int x, int y) const {
        return pixels[static_cast<std::size_t>(y) * static_cast<std::size_t>(width) + static_cast<std::size_t>(x)];
    }
};

/// A picture for a pointer, with the pixel that points.
struct CursorPicture {
    Picture picture; ///< what the pointer looks like
    int hotX = 0;    ///< column of the pixel that points
    int hotY = 0;    ///< row of it, from the top
};

/// Reads the data of an RT_BITMAP resource: uncompressed, with 1, 4, 8, 16, 24 or 32 bits a pixel.
[[nodiscard]] TVX_PLATFORM_API ResourceResult<Picture> parseBitmap(ResourceBytes data);

/// Reads the image of one size of an icon (RT_ICON data).
[[nodiscard]] TVX_PLATFORM_API ResourceResult<Picture> parseIconImage(ResourceBytes data);

/// The icon of that name in `module`, in the size that fits best: the exact one, else the smallest one that is larger,
/// else the largest; among these the one with most colours. It is not scaled.
/// @param size wanted width and height in pixels
[[nodiscard]] TVX_PLATFORM_API ResourceResult<Picture> loadIconPicture(HMODULE module, LPCSTR name, int size);

/// The cursor of that name in `module`.
[[nodiscard]] TVX_PLATFORM_API ResourceResult<CursorPicture> loadCursorPicture(HMODULE module, LPCSTR name);

/// The bitmap of that name in `module`.
[[nodiscard]] TVX_PLATFORM_API ResourceResult<Picture> loadBitmapPicture(HMODULE module, LPCSTR name);

} // namespace tvx
