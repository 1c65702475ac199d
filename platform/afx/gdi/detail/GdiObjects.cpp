#include "platform/afx/gdi/detail/GdiObjects.h"

#include <QPixmap>

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>

namespace tvx::afx {

namespace {

constexpr std::uint32_t objectTag = 1;
constexpr std::uint32_t iconTag = 3;
/// More pixels than this are refused: 1 GiB.
constexpr std::int64_t mostPixels = std::int64_t{1} << 28;

} // namespace

HandleTable<GdiObject>& gdiObjects() {
    // Never destroyed: static objects of hosts still hold tools when the process ends.
    static auto& table = *new HandleTable<GdiObject>(objectTag);
    return table;
}

DWORD GdiObject::type() const {
    constexpr std::array<DWORD, 5> types = {OBJ_PEN, OBJ_BRUSH, OBJ_FONT, OBJ_BITMAP, OBJ_REGION};
    return types[value.index()];
}

QSize BitmapObject::size() const {
    // Made a little larger, as a broken number of pixels was rounded up when the image was made.
    const auto units = [this](int pixels) { return static_cast<int>(std::floor(pixels / ratio + 1e-6)); };
    return {units(image.width()), units(image.height())};
}

QImage BitmapObject::plainImage() const {
    return ratio == 1 ? image : image.scaled(size());
}

HBITMAP addBitmap(int width, int height, PixelFormat format, double ratio) {
    if (width <= 0 || height <= 0 || std::int64_t{width} * height > mostPixels / (ratio * ratio)) {
        return nullptr;
    }
    QImage image(static_cast<int>(std::ceil(width * ratio)), static_cast<int>(std::ceil(height * ratio)),
                 QImage::Format_RGB32);
    if (image.isNull()) {
        return nullptr;
    }
    image.fill(Qt::black);
    return static_cast<HBITMAP>(addGdiObject(BitmapObject{std::move(image), format, nullptr, ratio}));
}

HBITMAP addBitmap(const QImage& image, PixelFormat format) {
    // The pixels may be the caller's own memory, and their unused byte anything.
    QImage pixels = image.format() == QImage::Format_RGB32 ? image.copy() : image.convertToFormat(QImage::Format_RGB32);
    if (pixels.isNull()) {
        return nullptr;
    }
    for (int y = 0; y < pixels.height(); ++y) {
        auto* row = reinterpret_cast<Pixel*>(pixels.scanLine(y));
        std::transform(row, row + pixels.width(), row, [](Pixel pixel) { return pixel | opaque; });
    }
    return static_cast<HBITMAP>(addGdiObject(BitmapObject{std::move(pixels), format, nullptr, 1}));
}

QImage bitmapImage(HBITMAP bitmap) {
    const auto tool = findTool<BitmapObject>(bitmap);
    return tool ? tool->plainImage().copy() : QImage();
}

HandleTable<IconObject>& icons() {
    static auto& table = *new HandleTable<IconObject>(iconTag);
    return table;
}

HICON addIcon(const QImage& image, QPoint hotSpot) {
    if (image.isNull()) {
        return nullptr;
    }
    auto icon = std::make_shared<IconObject>(IconObject{image.convertToFormat(QImage::Format_ARGB32), hotSpot});
    return reinterpret_cast<HICON>(icons().add(std::move(icon)));
}

QImage iconImage(HICON icon) {
    const auto object = icons().find(reinterpret_cast<std::uintptr_t>(icon));
    return object ? object->image : QImage();
}

QIcon windowIcon(HICON icon) {
    const auto object = icons().find(reinterpret_cast<std::uintptr_t>(icon));
    if (!object) {
        return {};
    }
    if (object->windowIcon.isNull()) {
        object->windowIcon = QIcon(QPixmap::fromImage(object->image));
    }
    return object->windowIcon;
}

} // namespace tvx::afx
