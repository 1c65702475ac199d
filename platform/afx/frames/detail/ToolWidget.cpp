#include "platform/afx/frames/detail/ToolWidget.h"

#include "platform/afx/core/Message.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Accessible.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/OwnText.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/frames/ControlBar.h"
#include "platform/afx/frames/Frame.h"
#include "platform/afx/gdi/detail/ButtonImages.h"
#include "platform/win/FrameworkIds.h"

#include <QAction>
#include <QLayout>
#include <QMouseEvent>
#include <QStyleOptionDockWidget>
#include <QStylePainter>
#include <QToolButton>
#include <QWindow>

#include <algorithm>
#include <memory>

namespace tvx::afx {

namespace {

/// The toolkit's messages are not shown while this lives.
class Hushed {
public:
    Hushed() : m_before(qInstallMessageHandler([](QtMsgType, const QMessageLogContext&, const QString&) {})) {}
    ~Hushed() {
        qInstallMessageHandler(m_before);
    }
    Hushed(const Hushed&) = delete;
    Hushed& operator=(const Hushed&) = delete;

private:
    QtMessageHandler m_before;
};

CControlBar* barOf(const QWidget& widget) {
    const Window* window = Window::of(&widget);
    return window ? dynamic_cast<CControlBar*>(window->object()) : nullptr;
}

} // namespace

ToolWidget::ToolWidget(const QString& title, QWidget* parent)
    : QToolBar(title, parent), m_close(new QToolButton(this)) {
    setAttribute(Qt::WA_ShowWithoutActivating);
    m_close->setAutoRaise(true);
    m_close->setFocusPolicy(Qt::NoFocus);
    m_close->setIcon(signIcon(style()->standardIcon(QStyle::SP_TitleBarCloseButton, nullptr, this)));
    m_close->setToolTip(withoutMarks(ownText(TVX_IDS_SYS_CLOSE).section('\t', 0, 0)));
    m_close->setAccessibleName(m_close->toolTip());
    m_close->hide();
    connectStoring(m_close, &QToolButton::clicked, this, [this] {
        if (const Window* window = Window::of(this)) {
            PostMessageA(window->handle(), WM_CLOSE, 0, 0);
        }
    });
    connectStoring(this, &QToolBar::topLevelChanged, this, [this](bool) { fitCaption(); });
}

QPoint ToolWidget::place() const {
    return isVisible() ? m_place : pos();
}

int ToolWidget::captionHeight() const {
    // Over a side of the frame the toolkit shows how the bar would stand there.
    return isWindow() && orientation() == Qt::Horizontal ? fontMetrics().height() + 6 : 0;
}

QRect ToolWidget::captionRect() const {
    return {1, 1, width() - 2, captionHeight()};
}

QSize ToolWidget::sizeHint() const {
    QSize size = QToolBar::sizeHint();
    if (const int height = captionHeight(); height > 0) {
        // At least the name and the button; a bar of two buttons is narrower.
        size.setWidth(std::max(size.width(), fontMetrics().horizontalAdvance(windowTitle()) + 2 * height));
        size.rheight() += height;
    }
    return size;
}

/// Puts the buttons below the caption; the toolkit has laid them out as if there were none.
void ToolWidget::fitCaption() {
    const int height = captionHeight();
    if (std::exchange(m_fitted, height) != height && isWindow()) {
        adjustSize();
    }
    const int row = this->height() - height;
    for (int i = 0; height > 0 && i < layout()->count(); ++i) {
        QWidget* button = layout()->itemAt(i)->widget();
        QRect place = button->geometry();
        place.setHeight(std::min(place.height(), row - 2 * layout()->contentsMargins().bottom()));
        place.moveTop(height + (row - place.height()) / 2);
        button->setGeometry(place);
    }
    m_close->setVisible(height > 0);
    m_close->setGeometry(QRect(width() - height - 1, 2, height - 2, height - 2));
    m_close->setIconSize(QSize(height - 8, height - 8));
}

/// The toolkit drags bars by their grip only: what happens on the caption is handed on as if it had happened there.
bool ToolWidget::onCaption(QMouseEvent& event) {
    const bool press = event.type() == QEvent::MouseButtonPress;
    if (press) {
        m_pressed = isWindow() && event.button() == Qt::LeftButton && captionRect().contains(event.pos());
        const QMargins margins = layout()->contentsMargins();
        m_toGrip = QPoint(margins.left() + 1, margins.top() + captionHeight() + 1) - event.pos();
    }
    if (!m_pressed) {
        return false;
    }
    QMouseEvent onGrip(event.type(), event.position() + m_toGrip, event.scenePosition(), event.globalPosition(),
                       event.button(), event.buttons(), event.modifiers());
    m_pressed = event.type() != QEvent::MouseButtonRelease;
    QToolBar::event(&onGrip);
    return true;
}

bool ToolWidget::event(QEvent* event) {
    switch (event->type()) {
    case QEvent::MouseButtonDblClick: {
        CControlBar* bar = isWindow() ? barOf(*this) : nullptr;
        CFrameWnd* frame = bar ? bar->GetDockingFrame() : nullptr;
        if (frame) {
            storing([=] { frame->DockControlBar(bar); });
            return true;
        }
        break;
    }
    case QEvent::MouseButtonPress:
    case QEvent::MouseMove:
    case QEvent::MouseButtonRelease: {
        // At the end of a drag the toolkit asks for the bar's activation, and tells users that it cannot have it.
        const bool dropped = event->type() == QEvent::MouseButtonRelease && isWindow();
        const auto hushed = dropped ? std::make_unique<Hushed>() : nullptr;
        return onCaption(static_cast<QMouseEvent&>(*event)) || QToolBar::event(event);
    }
    case QEvent::StyleChange:
    case QEvent::FontChange:
    case QEvent::WindowTitleChange:
    case QEvent::LayoutRequest: {
        const bool answer = QToolBar::event(event);
        fitCaption();
        return answer;
    }
    default:
        break;
    }
    return QToolBar::event(event);
}

void ToolWidget::showEvent(QShowEvent* event) {
    if (!event->spontaneous()) {
        fitCaption();
        m_place = pos();
        m_painted = false;
        keepFromKeyboard();
    }
    QToolBar::showEvent(event);
}

void ToolWidget::resizeEvent(QResizeEvent* event) {
    QToolBar::resizeEvent(event);
    fitCaption();
}

void ToolWidget::paintEvent(QPaintEvent* event) {
    m_painted = true;
    QToolBar::paintEvent(event);
    if (captionHeight() == 0) {
        return;
    }
    QStylePainter painter(this);
    QStyleOptionDockWidget caption;
    caption.initFrom(this);
    caption.rect = captionRect();
    caption.title = windowTitle();
    caption.closable = true;
    painter.fillRect(caption.rect, palette().window());
    painter.drawControl(QStyle::CE_DockWidgetTitle, caption);
    painter.setPen(palette().color(QPalette::Dark));
    painter.drawRect(rect().adjusted(0, 0, -1, -1));
}

void ToolWidget::moveEvent(QMoveEvent* event) {
    if (m_painted || !event->spontaneous()) {
        m_place = event->pos();
    }
    QToolBar::moveEvent(event);
}

/// Window managers activate new windows of the active application whatever they ask for, so they are told that this one
/// takes no keyboard; bars with controls to type into do.
void ToolWidget::keepFromKeyboard() {
    const Window* bar = isWindow() && windowHandle() ? Window::of(this) : nullptr;
    if (bar) {
        const bool typed = std::ranges::any_of(bar->children(), [](const Window* child) {
            return child->widget() && child->widget()->focusPolicy() != Qt::NoFocus;
        });
        windowHandle()->setFlag(Qt::WindowDoesNotAcceptFocus, !typed);
    }
}

} // namespace tvx::afx
