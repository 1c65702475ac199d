#include "platform/afx/gdi/detail/ButtonImages.h"

#include "platform/afx/gdi/detail/GdiObjects.h"

#include <QApplication>
#include <QIconEngine>
#include <QPainter>
#include <QPalette>
#include <QPixmap>
#include <QStyle>
#include <QStyleOption>

#include <algorithm>
#include <utility>

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

bool isDarkPalette() {
    const QPalette palette = QGuiApplication::palette();
    return palette.color(QPalette::WindowText).lightness() > palette.color(QPalette::Window).lightness();
}

namespace {

/// Outlines and letters that were drawn for a light ground, seen on a dark one.
QImage forDarkGround(QImage image) {
    constexpr int littleColor = 32;
    constexpr int dark = 128;
    for (int y = 0; y < image.height(); ++y) {
        auto* line = reinterpret_cast<QRgb*>(image.scanLine(y));
        std::transform(line, line + image.width(), line, [](QRgb pixel) {
            const auto [least, most] = std::minmax({qRed(pixel), qGreen(pixel), qBlue(pixel)});
            return most < dark && most - least <= littleColor ? pixel ^ RGB_MASK : pixel;
        });
    }
    return image;
}

/// Chooses the picture for the desktop's colours each time that it is shown, since those may change.
class ButtonIconEngine : public QIconEngine {
public:
    explicit ButtonIconEngine(QImage image) : m_image(std::move(image)) {}

    void paint(QPainter* painter, const QRect& area, QIcon::Mode mode, QIcon::State state) override {
        const QPixmap shown = pixmap(area.size(), mode, state);
        QRect place(QPoint(), shown.size());
        place.moveCenter(area.center());
        painter->drawPixmap(place.topLeft(), shown);
    }
    QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State) override {
        QPixmap shown = QPixmap::fromImage(isDarkPalette() ? forDarkGround(m_image) : m_image);
        if (const QSize fitting = actualSize(size, mode, QIcon::Off); fitting != shown.size()) {
            shown = shown.scaled(fitting, Qt::IgnoreAspectRatio, Qt::SmoothTransformation);
        }
        QStyleOption option(0);
        option.palette = QGuiApplication::palette();
        return mode == QIcon::Normal ? shown : QApplication::style()->generatedIconPixmap(mode, shown, &option);
    }
    QSize actualSize(const QSize& size, QIcon::Mode, QIcon::State) override {
        const bool fits = m_image.width() <= size.width() && m_image.height() <= size.height();
        return fits ? m_image.size() : m_image.size().scaled(size, Qt::KeepAspectRatio);
    }
    QList<QSize> availableSizes(QIcon::Mode, QIcon::State) override {
        return {m_image.size()};
    }
    QIconEngine* clone() const override {
        return new ButtonIconEngine(m_image);
    }

private:
    QImage m_image;
};

} // namespace

QIcon buttonIcon(const QImage& picture) {
    return picture.isNull() ? QIcon() : QIcon(new ButtonIconEngine(picture));
}

QIcon buttonIcon(HBITMAP bitmap) {
    return buttonIcon(buttonImages(bitmap));
}

} // namespace tvx::afx
