#include "platform/afx/core/detail/BrokenPixels.h"

#include <QMoveEvent>
#include <QResizeEvent>
#include <QWidget>

#include <cmath>

namespace tvx::afx {

namespace {

bool hasBrokenPixels(const QWidget& widget) {
    const double ratio = widget.devicePixelRatio();
    return ratio != std::floor(ratio);
}

} // namespace

QRegion withBrokenPixels(const QWidget& widget, const QRegion& units) {
    if (!hasBrokenPixels(widget)) {
        return units;
    }
    QRegion wider = units;
    for (const QPoint step : {QPoint(1, 0), QPoint(-1, 0), QPoint(0, 1), QPoint(0, -1)}) {
        wider |= wider.translated(step);
    }
    return wider;
}

void repaintBrokenEdges(QWidget& widget, const QEvent& event) {
    QWidget* parent = widget.parentWidget();
    if (!parent || widget.isWindow() || !hasBrokenPixels(widget)) {
        return;
    }
    QRect before = widget.geometry();
    switch (event.type()) {
    case QEvent::Move:
        before.moveTopLeft(static_cast<const QMoveEvent&>(event).oldPos());
        break;
    case QEvent::Resize:
        before.setSize(static_cast<const QResizeEvent&>(event).oldSize());
        break;
    case QEvent::Show:
    case QEvent::Hide:
        break;
    default:
        return;
    }
    parent->update(withBrokenPixels(*parent, QRegion(before) | widget.geometry()));
}

} // namespace tvx::afx
