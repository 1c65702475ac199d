#include "platform/afx/controls/detail/TreeArea.h"

#include "platform/afx/controls/detail/TipWindow.h"
#include "platform/afx/core/detail/Loop.h"

#include <QHelpEvent>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>
#include <QToolTip>

namespace tvx::afx {

TreeArea::TreeArea(QWidget* parent, TreeWindow& window) : QAbstractScrollArea(parent), m_window(window) {
    viewport()->setBackgroundRole(QPalette::Base);
    // The tree paints every pixel itself; while it must not, what was painted before stays.
    viewport()->setAttribute(Qt::WA_OpaquePaintEvent);
}

bool TreeArea::viewportEvent(QEvent* event) {
    if (event->type() != QEvent::ToolTip) {
        return QAbstractScrollArea::viewportEvent(event);
    }
    const auto& help = static_cast<const QHelpEvent&>(*event);
    QString tip;
    storing([&] { tip = m_window.tipAt(help.pos()); });
    QToolTip::showText(help.globalPos(), tipText(tip), viewport());
    return true;
}

void TreeArea::paintEvent(QPaintEvent* event) {
    QPainter painter(viewport());
    storing([&] { m_window.paint(painter, event->rect()); });
}

void TreeArea::mousePressEvent(QMouseEvent* event) {
    storing([&] { m_window.press(*event); });
}

void TreeArea::mouseReleaseEvent(QMouseEvent* event) {
    storing([&] { m_window.release(*event); });
}

void TreeArea::mouseDoubleClickEvent(QMouseEvent* event) {
    storing([&] { m_window.pressTwice(*event); });
}

void TreeArea::mouseMoveEvent(QMouseEvent* event) {
    event->accept();
}

void TreeArea::focusInEvent(QFocusEvent* event) {
    QAbstractScrollArea::focusInEvent(event);
    m_window.focusCame(event->reason() == Qt::MouseFocusReason);
}

/// Keys are taken as messages; the toolkit would scroll by them.
void TreeArea::keyPressEvent(QKeyEvent* event) {
    event->ignore();
}

void TreeArea::resizeEvent(QResizeEvent* event) {
    QAbstractScrollArea::resizeEvent(event);
    storing([this] { m_window.resized(); });
}

void TreeArea::changeEvent(QEvent* event) {
    QAbstractScrollArea::changeEvent(event);
    viewport()->update();
}

void TreeArea::scrollContentsBy(int, int) {
    storing([this] { m_window.scrolled(); });
}

} // namespace tvx::afx
