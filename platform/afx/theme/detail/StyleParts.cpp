#include "platform/afx/theme/detail/StyleParts.h"

#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/detail/DeviceContext.h"

#include <QApplication>
#include <QPainter>
#include <QStyleOptionTitleBar>

#include <algorithm>
#include <cstdlib>
#include <vector>

namespace tvx::afx {

QIcon PartStyle::standardIcon(StandardPixmap picture, const QStyleOption* option, const QWidget* widget) const {
    return withPictures ? CaptionStyle::standardIcon(picture, option, widget) : QIcon();
}

namespace {

QPalette::ColorGroup groupOf(int part, int state) {
    // A button in a menu bar is never disabled; it is asked for so when the window is not active.
    if (state == StyleParts::Inactive || (part == StyleParts::ChildButton && state == StyleParts::Disabled)) {
        return QPalette::Inactive;
    }
    return state == StyleParts::Disabled ? QPalette::Disabled : QPalette::Active;
}

void setState(QStyleOptionComplex& option, QStyle::SubControl which, int part, int state) {
    const QPalette::ColorGroup group = groupOf(part, state);
    option.palette.setCurrentColorGroup(group);
    option.state.setFlag(QStyle::State_Enabled, group != QPalette::Disabled);
    option.state.setFlag(QStyle::State_Active, group == QPalette::Active);
    option.state.setFlag(QStyle::State_Sunken, state == StyleParts::Pushed);
    option.state.setFlag(QStyle::State_MouseOver, state == StyleParts::Hot || state == StyleParts::Pushed);
    if (option.state.testFlag(QStyle::State_MouseOver)) {
        option.activeSubControls = which;
    }
}

/// A caption with every button that it can have side by side.
QStyleOptionTitleBar caption(const QStyle& style, const QWidget* widget) {
    QStyleOptionTitleBar option;
    if (widget) {
        option.initFrom(widget);
    } else {
        option.palette = QApplication::palette();
    }
    const int height = style.pixelMetric(QStyle::PM_TitleBarHeight, nullptr, widget);
    option.rect = QRect(0, 0, 10 * height, height);
    option.subControls = QStyle::SC_All;
    option.titleBarFlags = Qt::Window | Qt::WindowTitleHint | Qt::WindowMinMaxButtonsHint | Qt::WindowCloseButtonHint |
                           Qt::WindowContextHelpButtonHint | Qt::WindowShadeButtonHint;
    return option;
}

/// A picture of a part of what is drawn, on the ground that windows have.
template <class Draw>
QImage shot(const QRect& part, double ratio, const QPalette& palette, const Draw& draw) {
    if (part.isEmpty()) {
        return {};
    }
    QImage image((QSizeF(part.size()) * ratio).toSize(), QImage::Format_RGB32);
    image.setDevicePixelRatio(ratio);
    image.fill(palette.color(QPalette::Window));
    QPainter painter(&image);
    painter.translate(-part.topLeft());
    draw(painter);
    return image;
}

/// The least distance of two colours of which one can be read on the other.
constexpr int readable = 96;

int distance(QRgb one, QRgb other) {
    return std::abs(qRed(one) - qRed(other)) + std::abs(qGreen(one) - qGreen(other)) +
           std::abs(qBlue(one) - qBlue(other));
}

/// The colour that most pictures have at a point; that of the first where they do not agree.
QRgb mostCommon(const std::vector<QImage>& pictures, int x, int y) {
    const QRgb first = pictures.front().pixel(x, y);
    for (const QImage& picture : pictures) {
        const QRgb color = picture.pixel(x, y);
        const auto votes =
            std::ranges::count_if(pictures, [&](const QImage& other) { return other.pixel(x, y) == color; });
        if (static_cast<std::size_t>(votes) * 2 > pictures.size()) {
            return color;
        }
    }
    return first;
}

} // namespace

const QWidget* StyleParts::widget() const {
    const Window* window = Window::from(m_window);
    return window ? window->widget() : nullptr;
}

bool StyleParts::exist() {
    const QStyle& style = *QApplication::style();
    const QStyleOptionTitleBar option = caption(style, nullptr);
    return style.subControlRect(QStyle::CC_TitleBar, &option, QStyle::SC_TitleBarMinButton).isValid();
}

QImage StyleParts::captionShot(QStyle::SubControl which, int state, double ratio) const {
    QStyleOptionTitleBar option = caption(m_style, widget());
    setState(option, which, CaptionButton, state);
    m_style.isActive = option.state.testFlag(QStyle::State_Active);
    const QRect place = m_style.subControlRect(QStyle::CC_TitleBar, &option, which, widget());
    return shot(place, ratio, option.palette, [&](QPainter& painter) {
        m_style.drawComplexControl(QStyle::CC_TitleBar, &option, &painter, widget());
    });
}

/// Styles take signs of captions from pictures, or draw lines. In the latter case the face is what most buttons have in
/// common.
StyleParts::Button StyleParts::captionButton(int state, double ratio) const {
    Button button{captionShot(QStyle::SC_TitleBarMinButton, state, ratio), {}};
    m_style.withPictures = false;
    std::vector<QImage> pictures;
    for (const auto which : {QStyle::SC_TitleBarMinButton, QStyle::SC_TitleBarMaxButton, QStyle::SC_TitleBarCloseButton,
                             QStyle::SC_TitleBarShadeButton, QStyle::SC_TitleBarContextHelpButton}) {
        const QImage picture = captionShot(which, state, ratio);
        if (picture.size() == button.whole.size()) {
            pictures.push_back(picture);
        }
    }
    m_style.withPictures = true;
    button.face = button.whole;
    for (int y = 0; y < button.face.height(); ++y) {
        for (int x = 0; x < button.face.width(); ++x) {
            button.face.setPixel(x, y, mostCommon(pictures, x, y));
        }
    }
    return button;
}

QImage StyleParts::childShot(int state, double ratio) const {
    QStyleOptionComplex option;
    option.palette = widget() ? widget()->palette() : QApplication::palette();
    option.subControls = QStyle::SC_MdiMinButton | QStyle::SC_MdiNormalButton | QStyle::SC_MdiCloseButton;
    option.rect = QRect(QPoint(), m_style.sizeFromContents(QStyle::CT_MdiControls, &option, QSize(), widget()));
    setState(option, QStyle::SC_MdiMinButton, ChildButton, state);
    const QRect place = m_style.subControlRect(QStyle::CC_MdiControls, &option, QStyle::SC_MdiMinButton, widget());
    return shot(place, ratio, option.palette, [&](QPainter& painter) {
        m_style.drawComplexControl(QStyle::CC_MdiControls, &option, &painter, widget());
    });
}

StyleParts::Button StyleParts::childButton(int state, double ratio) const {
    Button button{childShot(state, ratio), {}};
    m_style.withPictures = false;
    button.face = childShot(state, ratio);
    m_style.withPictures = true;
    return button;
}

StyleParts::Button StyleParts::button(int part, int state, double ratio) const {
    return part == CaptionButton ? captionButton(state, ratio) : childButton(state, ratio);
}

/// The colour of a sign: that of it which is farthest from the face, as its edges are shaded. Some styles draw dark
/// signs on dark faces; those have the colour of texts.
QRgb StyleParts::sign(int part, int state) const {
    const Button button = this->button(part, state, 1);
    QRgb found = QApplication::palette().color(groupOf(part, state), QPalette::ButtonText).rgb();
    int farthest = readable;
    for (int y = 0; y < button.whole.height(); ++y) {
        for (int x = 0; x < button.whole.width(); ++x) {
            const QRgb color = button.whole.pixel(x, y);
            if (const int away = distance(color, button.face.pixel(x, y)); away > farthest) {
                farthest = away;
                found = color;
            }
        }
    }
    return found;
}

COLORREF StyleParts::color(int index) const {
    switch (index) {
    case COLOR_CAPTIONTEXT:
        return colorOf(sign(CaptionButton, Normal));
    case COLOR_INACTIVECAPTIONTEXT:
        return colorOf(sign(CaptionButton, Inactive));
    case COLOR_BTNTEXT:
        return colorOf(sign(ChildButton, Normal));
    default:
        return GetSysColor(index);
    }
}

namespace {

/// Where the sign stands on a button, in units. In menu bars it begins directly below the middle, where its colour is
/// looked for; other rows of the face may differ in their shade.
QRect signPlace(int part, QSize size) {
    const int width = size.width() * 4 / 9;
    const int below = part == StyleParts::ChildButton ? 1 : 2;
    return {(size.width() - width) / 2, size.height() / 2 + below, width, 2};
}

} // namespace

bool StyleParts::draw(HDC dc, int part, int state, const RECT& place, const RECT* clip) const {
    const auto context = findContext(dc);
    const int last = part == CaptionButton ? Inactive : Disabled;
    if (!context || (part != CaptionButton && part != ChildButton) || state < Normal || state > last) {
        return false;
    }
    Drawing drawing(*context);
    if (!drawing) {
        return true; // nothing of it can be seen
    }
    Canvas& canvas = drawing.canvas;
    if (clip) {
        canvas.clip &= drawing.pixels(*clip);
    }
    const QRect units = context->state.mapping.toPixels(place);
    const QRect pixels = canvas.pixels(units);
    QImage face = button(part, state, canvas.ratio).face;
    // Buttons in menu bars stand at their places; there is some room between them.
    if (part == CaptionButton && face.size() != pixels.size()) {
        face = face.scaled(pixels.size());
    }
    Ink ink;
    canvas.blit(face.copy(QRect(QPoint(), pixels.size().boundedTo(face.size()))), pixels.topLeft(), rop3Source, ink);
    ink.color = sign(part, state);
    canvas.fill(canvas.pixels(signPlace(part, units.size()).translated(units.topLeft())), ink);
    return true;
}

} // namespace tvx::afx
