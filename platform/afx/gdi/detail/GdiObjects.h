#pragma once

#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/Canvas.h"
#include "platform/afx/gdi/detail/HandleTable.h"

#include <QFont>
#include <QIcon>
#include <QImage>
#include <QRegion>

#include <memory>
#include <variant>

/// @file
/// What stands behind the handles of drawing tools and icons.

namespace tvx::afx {

struct PenObject {
    LOGPEN description{};
};

struct BrushObject {
    LOGBRUSH description{};
    QImage pattern; ///< of a pattern brush, Format_RGB32
    PixelFormat patternFormat = PixelFormat::Color;
    int systemColor = -1; ///< follows the palette when 0 or above
};

struct FontObject {
    LOGFONTA description{};
};

struct BitmapObject {
    QImage image; ///< Format_RGB32
    PixelFormat format = PixelFormat::Color;
    HDC selectedInto = nullptr;
    /// Pixels of the image for one that the host knows of: above 1 for a bitmap made compatible with a window on a
    /// display that has more of them, so that what is drawn by way of it is as sharp as on the window.
    double ratio = 1;

    /// Size as the host knows it.
    [[nodiscard]] QSize size() const;
    /// The pixels that the host knows of.
    [[nodiscard]] QImage plainImage() const;
};

struct RegionObject {
    QRegion region;
};

enum class GdiOwner { Host, Stock };

/// A drawing tool of any kind.
struct GdiObject {
    std::variant<PenObject, BrushObject, FontObject, BitmapObject, RegionObject> value;
    GdiOwner owner = GdiOwner::Host;

    [[nodiscard]] DWORD type() const;
};

/// A tool of kind `T` together with the handle it was found by; empty when there is none.
template <class T>
struct Tool {
    HGDIOBJ handle = nullptr;
    std::shared_ptr<GdiObject> object;

    explicit operator bool() const {
        return object != nullptr;
    }
    T* operator->() const {
        return std::get_if<T>(&object->value);
    }
    T& operator*() const {
        return *std::get_if<T>(&object->value);
    }
};

[[nodiscard]] TVX_PLATFORM_API HandleTable<GdiObject>& gdiObjects();

template <class T>
[[nodiscard]] HGDIOBJ addGdiObject(T value, GdiOwner owner = GdiOwner::Host) {
    auto object = std::make_shared<GdiObject>(GdiObject{std::move(value), owner});
    return reinterpret_cast<HGDIOBJ>(gdiObjects().add(std::move(object)));
}

template <class T>
[[nodiscard]] Tool<T> findTool(HGDIOBJ handle) {
    auto object = gdiObjects().find(reinterpret_cast<std::uintptr_t>(handle));
    if (!object || !std::holds_alternative<T>(object->value)) {
        return {};
    }
    return {handle, std::move(object)};
}

template <class T>
[[nodiscard]] Tool<T> stockTool(int index) {
    return findTool<T>(GetStockObject(index));
}

/// A bitmap of black pixels; null handle for sizes that cannot be had.
[[nodiscard]] HBITMAP addBitmap(int width, int height, PixelFormat format, double ratio = 1);
/// A bitmap with these pixels. Takes any format of image.
[[nodiscard]] TVX_PLATFORM_API HBITMAP addBitmap(const QImage& image, PixelFormat format = PixelFormat::Color);
/// The pixels of a bitmap, null image for a handle that is none.
[[nodiscard]] TVX_PLATFORM_API QImage bitmapImage(HBITMAP bitmap);

struct IconObject {
    QImage image; ///< Format_ARGB32, not premultiplied
    QPoint hotSpot;
    QIcon windowIcon{}; ///< Of windows, made when first asked for.
};
[[nodiscard]] TVX_PLATFORM_API HandleTable<IconObject>& icons();
/// An icon or cursor with these pixels, to be destroyed with `DestroyIcon`.
[[nodiscard]] TVX_PLATFORM_API HICON addIcon(const QImage& image, QPoint hotSpot = {});
/// The picture of an icon, null image for a handle that is none.
[[nodiscard]] TVX_PLATFORM_API QImage iconImage(HICON icon);
/// An icon as windows of the toolkit show it, null icon for a handle that is none. It is the same one for all windows:
/// the toolkit keeps what it has scaled for each icon, long after the windows have ended.
[[nodiscard]] QIcon windowIcon(HICON icon);

} // namespace tvx::afx
