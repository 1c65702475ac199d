#include "platform/afx/gdi/detail/ButtonImages.h"

#include "platform/afx/gdi/detail/GdiObjects.h"

#include <QPixmap>

namespace tvx::afx {

QImage buttonImages(HBITMAP bitmap) {
    QImage image = bitmapImage(bitmap);
    if (image.isNull()) {
        return image;
    }
    image = image.convertToFormat(QImage::Format_ARGB32);
    for (int y = 0; y < image.height(); ++y) {
        auto* line = reinterpret_cast<QRgb*>(image.scanLine(y));
        std::replace_if(
            line, line + image.width(),
            [](QRgb pixel) { return pixel == qRgb(192, 192, 192) || pixel == qRgb(255, 0, 255); }, QRgb{0});
    }
    return image;
}

QIcon buttonIcon(HBITMAP bitmap) {
    const QImage image = buttonImages(bitmap);
    return image.isNull() ? QIcon() : QIcon(QPixmap::fromImage(image));
}

} // namespace tvx::afx
