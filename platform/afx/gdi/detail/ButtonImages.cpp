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

/// A dark sign in the colour of texts: the paler a pixel is, the less of it is seen.
QImage inTextColor(QImage image) {
    const QRgb text = QGuiApplication::palette().color(QPalette::ButtonText).rgb() & RGB_MASK;
    const auto eachPixel = [&image](const auto& act) {
        for (int y = 0; y < image.height(); ++y) {
            auto* line = reinterpret_cast<QRgb*>(image.scanLine(y));
            std::for_each(line, line + image.width(), act);
        }
    };
    int most = 1;
    eachPixel([&most](QRgb pixel) { most = std::max(most, qAlpha(pixel) != 0 ? 255 - qGray(pixel) : 0); });
    eachPixel([&](QRgb& pixel) {
        pixel = text | static_cast<QRgb>(qAlpha(pixel) * std::min(255 - qGray(pixel), most) / most) << 24U;
    });
    return image;
}

/// Chooses the picture for the desktop's colours each time that it is shown, since those may change.
class ButtonIconEngine : public QIconEngine {
public:
    using Change = QImage (*)(QImage);
    /// @param forDark what makes of the picture one that is seen on a dark desktop
    ButtonIconEngine(QImage image, Change forDark) : m_image(std::move(image)), m_forDark(forDark) {}

    void paint(QPainter* painter, const QRect& area, QIcon::Mode mode, QIcon::State state) override {
        const QPixmap shown = pixmap(area.size(), mode, state);
        QRect place(QPoint(), shown.size());
        place.moveCenter(area.center());
        painter->drawPixmap(place.topLeft(), shown);
    }
    QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State) override {
        QPixmap shown = QPixmap::fromImage(isDarkPalette() ? m_forDark(m_image) : m_image);
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
        return new ButtonIconEngine(m_image, m_forDark);
    }

private:
    QImage m_image;
    Change m_forDark;
};

} // namespace

QIcon buttonIcon(const QImage& picture) {
    return picture.isNull() ? QIcon() : QIcon(new ButtonIconEngine(picture, &forDarkGround));
}

QIcon signIcon(const QIcon& sign) {
    const QList<QSize> sizes = sign.availableSizes();
    if (sizes.isEmpty()) {
        return sign;
    }
    const QImage picture = sign.pixmap(sizes.back(), 1.0).toImage().convertToFormat(QImage::Format_ARGB32);
    return QIcon(new ButtonIconEngine(picture, &inTextColor));
}

QIcon buttonIcon(HBITMAP bitmap) {
    return buttonIcon(buttonImages(bitmap));
}

} // namespace tvx::afx
