#include "platform/afx/core/detail/CaptionedWindow.h"

#include "platform/afx/core/Message.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Loop.h"

#include <QMainWindow>

namespace tvx::afx {

CaptionedWindow::CaptionedWindow(const CREATESTRUCT& cs)
    : TopLevelWindow(cs), m_caption(*this), m_mouse(*this, m_caption) {}

Caption* CaptionedWindow::caption() const {
    return &m_caption;
}

void CaptionedWindow::widgetMade() {
    TopLevelWindow::widgetMade();
    stateChanged();
    connectStoring(widget(), &QWidget::windowTitleChanged, widget(), [this] { m_caption.update(); });
    connectStoring(widget(), &QWidget::windowIconChanged, widget(), [this] { m_caption.update(); });
}

/// What stands in the window begins below the caption.
void CaptionedWindow::stateChanged() {
    guarded([this] { widget()->setContentsMargins(m_caption.margins()); });
    m_caption.stateChanged();
}

QSize CaptionedWindow::leastSize() const {
    return m_caption.leastSize();
}

bool CaptionedWindow::isHeldByCaption() const {
    return m_mouse.isHeld();
}

int CaptionedWindow::hitTest(QPoint screen) const {
    const int part = m_caption.hitTest(widget()->mapFromGlobal(screen));
    return part == HTCLIENT ? TopLevelWindow::hitTest(screen) : part;
}

/// The border of a maximised window lies beyond the screen: what is measured from its corners is the same in any state.
QRect CaptionedWindow::screenRect() const {
    const int beyond = m_caption.hiddenBorder();
    return TopLevelWindow::screenRect().adjusted(-beyond, -beyond, beyond, beyond);
}

void CaptionedWindow::updateFrame() {
    TopLevelWindow::updateFrame();
    m_caption.update();
}

void CaptionedWindow::followStyle() {
    m_caption.renewStyle();
    stateChanged();
}

LRESULT CaptionedWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (const auto answer = m_mouse.proc(message, wParam, lParam)) {
        return *answer;
    }
    if (m_caption.proc(message, wParam)) {
        return 0;
    }
    if (message == WM_THEMECHANGED) {
        followStyle();
        return 0;
    }
    return TopLevelWindow::defaultProc(message, wParam, lParam);
}

} // namespace tvx::afx
