#include "platform/afx/core/detail/Caption.h"

#include "platform/afx/core/Message.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/detail/ButtonImages.h"

#include <QApplication>
#include <QPainter>

#include <algorithm>
#include <array>
#include <utility>

namespace tvx::afx {

CaptionStyle::CaptionStyle() : QProxyStyle(QApplication::style()->name()) {}

int CaptionStyle::styleHint(StyleHint hint, const QStyleOption* option, const QWidget* widget,
                            QStyleHintReturn* data) const {
    return hint == SH_TitleBar_NoBorder ? 0 : QProxyStyle::styleHint(hint, option, widget, data);
}

QRect CaptionStyle::subControlRect(ComplexControl control, const QStyleOptionComplex* option, SubControl part,
                                   const QWidget* widget) const {
    QRect place = QProxyStyle::subControlRect(control, option, part, widget);
    if (control == CC_TitleBar && part == SC_TitleBarLabel && place.intersects(button)) {
        if (button.center().x() > place.center().x()) {
            place.setRight(button.left() - 1);
        } else {
            place.setLeft(button.right() + 1);
        }
    }
    return place;
}

void CaptionStyle::drawComplexControl(ComplexControl control, const QStyleOptionComplex* option, QPainter* painter,
                                      const QWidget* widget) const {
    const auto* given = qstyleoption_cast<const QStyleOptionTitleBar*>(option);
    if (control != CC_TitleBar || !given) {
        QProxyStyle::drawComplexControl(control, option, painter, widget);
        return;
    }
    QStyleOptionTitleBar caption = *given;
    caption.state.setFlag(State_Active, isActive);
    caption.palette.setCurrentColorGroup(isActive ? QPalette::Active : QPalette::Inactive);
    if (!isActive && isDarkPalette()) {
        // The style draws the buttons of inactive captions in black all the same; those of active ones are light, so
        // the caption is drawn as an active one in quiet colours.
        caption.palette.setColor(QPalette::Highlight, caption.palette.color(QPalette::Window));
        caption.palette.setColor(QPalette::HighlightedText, caption.palette.color(QPalette::WindowText));
    }
    const bool drawsActive = isActive || isDarkPalette();
    if (isDarkPalette()) {
        caption.palette.setColor(QPalette::Text, Qt::black); // of a title's shadow, which would blur it
    }
    caption.titleBarState = drawsActive ? caption.titleBarState | State_Active : caption.titleBarState & ~State_Active;
    QProxyStyle::drawComplexControl(control, &caption, painter, widget);
}

QIcon CaptionStyle::standardIcon(StandardPixmap picture, const QStyleOption* option, const QWidget* widget) const {
    const QIcon icon = QProxyStyle::standardIcon(picture, option, widget);
    const bool isSign = picture >= SP_TitleBarMinButton && picture <= SP_TitleBarContextHelpButton;
    return isSign && isDarkPalette() ? signIcon(icon) : icon;
}

Caption::Caption(Window& window) : m_window(window), m_style(std::make_unique<CaptionStyle>()) {}

Caption::~Caption() = default;

QStyle& Caption::style() const {
    return *m_style;
}

void Caption::renewStyle() {
    auto renewed = std::make_unique<CaptionStyle>();
    renewed->button = m_style->button;
    renewed->isActive = m_style->isActive;
    m_style = std::move(renewed);
}

int Caption::border() const {
    const Qt::WindowStates state = m_window.widget()->windowState();
    const bool fills = (state & (Qt::WindowMaximized | Qt::WindowFullScreen)) != 0;
    return fills ? 0 : fullBorder();
}

int Caption::fullBorder() const {
    return m_style->pixelMetric(QStyle::PM_MdiSubWindowFrameWidth, nullptr, m_window.widget());
}

int Caption::hiddenBorder() const {
    const QWidget& widget = *m_window.widget();
    return widget.isMaximized() && !widget.isFullScreen() ? fullBorder() : 0;
}

int Caption::height() const {
    const QWidget& widget = *m_window.widget();
    // The buttons of a child frame that fills its main frame stand in that one's menu bar.
    const bool isElsewhere = widget.isMaximized() && !widget.isWindow();
    return isElsewhere || widget.isFullScreen() ? 0 : m_style->pixelMetric(QStyle::PM_TitleBarHeight, nullptr, &widget);
}

QMargins Caption::margins() const {
    const int edge = border();
    return {edge, edge + height(), edge, edge};
}

QSize Caption::leastSize() const {
    QStyleOptionTitleBar option = bar();
    constexpr int wide = 1000;
    option.rect.setWidth(wide);
    const QRect label =
        m_style->baseStyle()->subControlRect(QStyle::CC_TitleBar, &option, QStyle::SC_TitleBarLabel, m_window.widget());
    const QMargins around = margins();
    const int own = m_style->button.isEmpty() ? 0 : m_style->button.width();
    return {wide - label.width() + own + around.left() + around.right(), around.top() + around.bottom()};
}

QStyleOptionTitleBar Caption::bar() const {
    const QWidget& widget = *m_window.widget();
    QStyleOptionTitleBar option;
    option.initFrom(&widget);
    const int edge = border();
    option.rect = QRect(edge, edge, widget.width() - 2 * edge, height());
    option.subControls = QStyle::SC_All;
    option.titleBarFlags = widget.windowFlags() | Qt::WindowTitleHint;
    option.titleBarState = static_cast<int>(widget.windowState());
    option.icon = widget.windowIcon();
    return option;
}

namespace {

struct Part {
    int code;
    QStyle::SubControl control;
};

/// The parts of a caption in front of its label. A maximised window has a restore button in the place of one of them, a
/// minimised child frame in that of another.
constexpr std::array parts{
    Part{HTCLOSE, QStyle::SC_TitleBarCloseButton}, Part{HTMAXBUTTON, QStyle::SC_TitleBarMaxButton},
    Part{HTMINBUTTON, QStyle::SC_TitleBarMinButton}, Part{HTSYSMENU, QStyle::SC_TitleBarSysMenu}};

QStyle::SubControl controlOf(int code, const QWidget& widget) {
    const bool isMinimized = widget.isMinimized();
    if ((code == HTMINBUTTON && isMinimized) || (code == HTMAXBUTTON && widget.isMaximized() && !isMinimized)) {
        return QStyle::SC_TitleBarNormalButton;
    }
    const auto* found = std::ranges::find(parts, code, &Part::code);
    return found != parts.end() ? found->control : QStyle::SC_None;
}

} // namespace

QRect Caption::systemMenuRect() const {
    const QStyleOptionTitleBar option = bar();
    return m_style->subControlRect(QStyle::CC_TitleBar, &option, QStyle::SC_TitleBarSysMenu, m_window.widget());
}

/// The edge or corner at a point, HTNOWHERE away from the border. Corners reach along both edges, so that they can be
/// hit.
int Caption::edgeAt(QPoint point) const {
    const int edge = border();
    const QRect whole = m_window.widget()->rect();
    const QRect inside = whole.adjusted(edge, edge, -edge, -edge);
    if (!whole.contains(point) || inside.contains(point)) {
        return HTNOWHERE;
    }
    if ((m_window.style() & WS_THICKFRAME) == 0 || m_window.widget()->isMinimized()) {
        return HTBORDER;
    }
    constexpr int corner = 16;
    const bool left = point.x() < corner;
    const bool right = point.x() >= whole.width() - corner;
    const bool top = point.y() < corner;
    const bool bottom = point.y() >= whole.height() - corner;
    if (top) {
        return left ? HTTOPLEFT : right ? HTTOPRIGHT : point.y() < edge ? HTTOP : HTNOWHERE;
    }
    if (bottom) {
        return left ? HTBOTTOMLEFT : right ? HTBOTTOMRIGHT : HTBOTTOM;
    }
    return left ? HTLEFT : HTRIGHT;
}

int Caption::hitTest(QPoint point) const {
    const QWidget& widget = *m_window.widget();
    if (!widget.rect().contains(point)) {
        return HTNOWHERE;
    }
    if (const int edge = edgeAt(point)) {
        return edge;
    }
    const QStyleOptionTitleBar option = bar();
    if (!option.rect.contains(point)) {
        return HTCLIENT;
    }
    // The corners of a maximised window are where the mouse ends up that is thrown there: their buttons reach into
    // them.
    QPoint at = point;
    if (widget.isMaximized()) {
        const int half = option.rect.height() / 2;
        at = QPoint(std::clamp(at.x(), option.rect.left() + half, std::max(half, option.rect.right() - half)),
                    std::max(at.y(), option.rect.center().y()));
    }
    // Half of the gap at the left of a button belongs to it. So a button that the host puts beside it, by what it is
    // told here, has its size and the same gap.
    constexpr int reach = 1;
    for (const Part& part : parts) {
        const QStyle::SubControl control = controlOf(part.code, widget);
        const QRect place = m_style->subControlRect(QStyle::CC_TitleBar, &option, control, &widget);
        if (place.adjusted(-reach, 0, 0, 0).contains(at)) {
            return part.code;
        }
    }
    return HTCAPTION;
}

void Caption::paint(QPainter& painter) const {
    const QWidget& widget = *m_window.widget();
    if (border() > 0) {
        QStyleOptionFrame frame;
        frame.initFrom(&widget);
        frame.lineWidth = border();
        frame.state.setFlag(QStyle::State_Active, m_style->isActive);
        m_style->drawPrimitive(QStyle::PE_FrameWindow, &frame, &painter, &widget);
    }
    QStyleOptionTitleBar option = bar();
    if (option.rect.height() <= 0) {
        return;
    }
    const QStyle::SubControl control = controlOf(pressed != 0 ? pressed : hovered, widget);
    const bool isDown = pressed != 0 && pressed == hovered;
    if (control != QStyle::SC_None && (isDown || pressed == 0)) {
        option.activeSubControls = control;
        option.state |= isDown ? QStyle::State_Sunken : QStyle::State_MouseOver;
    } else {
        option.state &= ~QStyle::State_MouseOver;
    }
    const QRect label = m_style->subControlRect(QStyle::CC_TitleBar, &option, QStyle::SC_TitleBarLabel, &widget);
    option.text = option.fontMetrics.elidedText(widget.windowTitle(), Qt::ElideRight, label.width());
    m_style->drawComplexControl(QStyle::CC_TitleBar, &option, &painter, &widget);
}

bool Caption::proc(UINT message, WPARAM wParam) {
    QWidget& widget = *m_window.widget();
    if (message == WM_NCACTIVATE) {
        setActive(wParam != 0);
        return false;
    }
    if (message != WM_NCPAINT || !m_window.inFramePaint) {
        return false;
    }
    // Not when it is the menu bar that is being painted.
    if (widget.testAttribute(Qt::WA_WState_InPaintEvent)) {
        QPainter painter(&widget);
        paint(painter);
    }
    return true;
}

void Caption::update() const {
    QWidget& widget = *m_window.widget();
    widget.update(QRegion(widget.rect()) - QRegion(widget.rect() - margins()));
}

void Caption::stateChanged() {
    hovered = 0;
    update();
}

void Caption::setActive(bool active) {
    m_style->isActive = active;
    update();
}

void Caption::setButton(const QRect& place) {
    if (std::exchange(m_style->button, place) != place) {
        update();
    }
}

} // namespace tvx::afx
