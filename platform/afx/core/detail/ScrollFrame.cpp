#include "platform/afx/core/detail/ScrollFrame.h"

#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/ScrollCode.h"
#include "platform/afx/core/detail/Window.h"

#include <QKeyEvent>
#include <QScrollBar>
#include <QWheelEvent>

namespace tvx::afx {

ScrollFrame::ScrollFrame(Window& window, QWidget* parent, Background background)
    : QAbstractScrollArea(parent), m_window(window) {
    setFocusPolicy(Qt::NoFocus);
    setAttribute(Qt::WA_InputMethodEnabled);
    viewport()->setAutoFillBackground(false);
    viewport()->setBackgroundRole(QPalette::Window);
    if (background == Background::Windows) {
        // The window paints each pixel that it asks to be repainted; the toolkit must not paint before it.
        viewport()->setAttribute(Qt::WA_OpaquePaintEvent);
        viewport()->setAttribute(Qt::WA_NoSystemBackground);
    }
    // WM_MOUSEMOVE comes with no button pressed, too.
    viewport()->setMouseTracking(true);
    followStyle();
    connectBar(SB_HORZ);
    connectBar(SB_VERT);
}

void ScrollFrame::followStyle() {
    const DWORD style = m_window.style();
    if ((m_window.exStyle() & WS_EX_CLIENTEDGE) != 0) {
        setFrameStyle(QFrame::StyledPanel | QFrame::Sunken);
    } else if ((style & WS_BORDER) != 0) {
        setFrameStyle(QFrame::Box | QFrame::Plain);
    } else {
        setFrameStyle(QFrame::NoFrame);
    }
    const auto policy = [style](DWORD bit) {
        return (style & bit) != 0 ? Qt::ScrollBarAlwaysOn : Qt::ScrollBarAlwaysOff;
    };
    setHorizontalScrollBarPolicy(policy(WS_HSCROLL));
    setVerticalScrollBarPolicy(policy(WS_VSCROLL));
    setAcceptDrops((m_window.exStyle() & WS_EX_ACCEPTFILES) != 0);
}

QScrollBar* ScrollFrame::bar(int direction) const {
    return direction == SB_HORZ ? horizontalScrollBar() : verticalScrollBar();
}

void ScrollFrame::showBar(int direction, bool show) {
    const DWORD bit = direction == SB_HORZ ? WS_HSCROLL : WS_VSCROLL;
    const DWORD style = m_window.style();
    m_window.setStyle(show ? (style | bit) : (style & ~bit), m_window.exStyle());
}

void ScrollFrame::connectBar(int direction) {
    QScrollBar* slider = bar(direction);
    const UINT message = direction == SB_HORZ ? WM_HSCROLL : WM_VSCROLL;
    // The toolkit would move the slider by itself; here the window decides, by SetScrollPos. Its own idea is put back
    // before it acts on it.
    connectStoring(slider, &QScrollBar::actionTriggered, slider, [this, slider, message](int action) {
        const int code = scrollCodeOf(action);
        const int position = slider->sliderPosition();
        if (code != SB_THUMBTRACK) {
            slider->setSliderPosition(slider->value());
        }
        armIdle();
        m_window.call(message, MAKEWPARAM(code, position));
    });
    connectStoring(slider, &QScrollBar::sliderReleased, slider, [this, slider, message] {
        m_window.call(message, MAKEWPARAM(SB_THUMBPOSITION, slider->sliderPosition()));
        m_window.call(message, MAKEWPARAM(SB_ENDSCROLL, 0));
    });
}

void ScrollFrame::keyPressEvent(QKeyEvent* event) {
    event->ignore();
}

void ScrollFrame::wheelEvent(QWheelEvent* event) {
    event->ignore();
}

} // namespace tvx::afx
