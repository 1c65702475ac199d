#include "platform/afx/controls/detail/StaticWindow.h"

#include "platform/afx/core/detail/Accessible.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/GdiObjects.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/Resource.h"

#include <QAccessible>
#include <QLabel>
#include <QPainter>
#include <QStyle>
#include <QStyleOption>
#include <qdrawutil.h>

namespace tvx::afx {

namespace {

/// A label of the toolkit, for what assistive tools know of labels. It draws itself.
class StaticFace : public QLabel {
public:
    StaticFace(QWidget* parent, StaticWindow& window) : QLabel(parent), m_window(window) {
        setTextFormat(Qt::PlainText);
    }

protected:
    void paintEvent(QPaintEvent*) override {
        QPainter painter(this);
        storing([&] { m_window.paint(painter); }); // an owner-drawn one asks the host
    }

private:
    StaticWindow& m_window;
};

std::unique_ptr<Window> makeStatic(const CREATESTRUCT& cs) {
    return std::make_unique<StaticWindow>(cs);
}

const WindowClassEntry staticEntry("Static", &makeStatic);

} // namespace

QWidget* StaticWindow::makeWidget(QWidget* parent) {
    auto* face = new StaticFace(parent, *this);
    face->setAttribute(Qt::WA_TransparentForMouseEvents, passesMouse());
    return face;
}

void StaticWindow::widgetMade() {
    Control::widgetMade();
    tellText();
    loadPicture();
}

void StaticWindow::styleChanged(DWORD oldStyle, DWORD oldExStyle) {
    Control::styleChanged(oldStyle, oldExStyle);
    widget()->setAttribute(Qt::WA_TransparentForMouseEvents, passesMouse());
    widget()->update();
}

void StaticWindow::setText(const QString& text) {
    Control::setText(text);
    if (widget()) {
        tellText();
        widget()->update();
    }
}

bool StaticWindow::isText() const {
    return type() <= SS_RIGHT || type() == SS_SIMPLE || type() == SS_LEFTNOWORDWRAP;
}

namespace {

void tellNamed(QWidget& widget) {
    if (QAccessible::isActive() && widget.isVisible()) {
        QAccessibleEvent event(&widget, QAccessible::NameChanged);
        QAccessible::updateAccessibility(&event);
    }
}

} // namespace

/// Tells the label its text without marks of access keys: those are the dialog's affair.
void StaticWindow::tellText() {
    QString shown = isText() ? text() : QString();
    if ((style() & SS_NOPREFIX) == 0) {
        shown = withoutMarks(shown);
    }
    auto& label = static_cast<QLabel&>(*widget());
    if (label.buddy()) {
        shown.replace(QLatin1Char('&'), QLatin1String("&&")); // in a label of something the toolkit reads access keys
    }
    label.setText(shown);
    tellNamed(label);
    if (label.buddy()) {
        tellNamed(*label.buddy());
    }
}

void StaticWindow::labelFor(Control& next) {
    setLabelled(&next);
}

void StaticWindow::setLabelled(const Window* window) {
    if (isText()) {
        static_cast<QLabel*>(widget())->setBuddy(window ? window->widget() : nullptr);
        tellText();
    }
}

QString StaticWindow::mnemonicText() const {
    return isText() && (style() & SS_NOPREFIX) == 0 ? text() : QString();
}

// --- pictures ---

/// Pictures named by the text, as templates do it: icons and bitmaps of the resources.
void StaticWindow::loadPicture() {
    if ((type() != SS_ICON && type() != SS_BITMAP) || text().isEmpty()) {
        return;
    }
    const std::string name = fromQt(text());
    if (type() == SS_ICON) {
        setPicture(IMAGE_ICON, LoadIconA(AfxFindResourceHandle(name.c_str(), RT_GROUP_ICON), name.c_str()));
    } else {
        setPicture(IMAGE_BITMAP, LoadBitmapA(AfxFindResourceHandle(name.c_str(), RT_BITMAP), name.c_str()));
    }
}

QImage StaticWindow::picture() const {
    return type() == SS_ICON ? iconImage(static_cast<HICON>(m_picture)) : bitmapImage(static_cast<HBITMAP>(m_picture));
}

LRESULT StaticWindow::setPicture(UINT kind, HANDLE picture) {
    const HANDLE old = std::exchange(m_picture, picture);
    if ((kind == IMAGE_ICON) != (type() == SS_ICON)) {
        setStyle((style() & ~DWORD{SS_TYPEMASK}) | (kind == IMAGE_ICON ? SS_ICON : SS_BITMAP), exStyle());
    }
    const QImage image = this->picture();
    // A control takes the size of its picture, unless it is to centre or to stretch it.
    const bool keepsSize = (style() & (SS_CENTERIMAGE | SS_REALSIZECONTROL)) != 0;
    if (!image.isNull() && !keepsSize) {
        guarded([&] { setWindowRect(QRect(windowRect().topLeft(), image.size())); });
    }
    widget()->update();
    return reinterpret_cast<LRESULT>(old);
}

void StaticWindow::paintPicture(QPainter& painter, const QRect& area) const {
    const QImage image = picture();
    if (image.isNull()) {
        return;
    }
    if ((style() & SS_REALSIZECONTROL) != 0) {
        painter.drawImage(area, image);
        return;
    }
    QPoint corner = area.topLeft();
    if ((style() & SS_CENTERIMAGE) != 0) {
        corner += QPoint((area.width() - image.width()) / 2, (area.height() - image.height()) / 2);
    }
    painter.drawImage(corner, image);
}

// --- shapes and texts ---

bool StaticWindow::paintShape(QPainter& painter, const QRect& area) const {
    const QPalette& palette = widget()->palette();
    const QColor shades[] = {palette.color(QPalette::Shadow), palette.color(QPalette::Mid),
                             palette.color(QPalette::Light)};
    if (type() >= SS_BLACKRECT && type() <= SS_WHITERECT) {
        painter.fillRect(area, shades[type() - SS_BLACKRECT]);
        return true;
    }
    if (type() >= SS_BLACKFRAME && type() <= SS_WHITEFRAME) {
        painter.setPen(shades[type() - SS_BLACKFRAME]);
        painter.drawRect(area.adjusted(0, 0, -1, -1));
        return true;
    }
    if (type() < SS_ETCHEDHORZ || type() > SS_ETCHEDFRAME) {
        return false;
    }
    QRect line = area;
    if (type() == SS_ETCHEDHORZ) {
        line.setHeight(std::min(2, area.height()));
    } else if (type() == SS_ETCHEDVERT) {
        line.setWidth(std::min(2, area.width()));
    }
    qDrawShadeRect(&painter, line, palette, true);
    return true;
}

void StaticWindow::paintText(QPainter& painter, const QRect& area) const {
    int flags = Qt::TextExpandTabs;
    switch (type()) {
    case SS_CENTER:
        flags |= Qt::AlignHCenter | Qt::TextWordWrap;
        break;
    case SS_RIGHT:
        flags |= Qt::AlignRight | Qt::TextWordWrap;
        break;
    case SS_SIMPLE:
    case SS_LEFTNOWORDWRAP:
        flags |= Qt::AlignLeft;
        break;
    default:
        flags |= Qt::AlignLeft | Qt::TextWordWrap;
        break;
    }
    QString shown = text();
    const bool ellipsis = (style() & SS_ELLIPSISMASK) != 0;
    if ((style() & SS_CENTERIMAGE) != 0 || ellipsis) {
        flags = (flags & ~Qt::TextWordWrap) | ((style() & SS_CENTERIMAGE) != 0 ? Qt::AlignVCenter : Qt::AlignTop);
    }
    if (ellipsis) {
        const bool path = (style() & SS_ELLIPSISMASK) == SS_PATHELLIPSIS;
        shown = painter.fontMetrics().elidedText(shown, path ? Qt::ElideMiddle : Qt::ElideRight, area.width());
    }
    if ((style() & SS_NOPREFIX) == 0) {
        flags |= Qt::TextShowMnemonic;
    }
    widget()->style()->drawItemText(&painter, area, flags, widget()->palette(), widget()->isEnabled(), shown,
                                    QPalette::WindowText);
}

void StaticWindow::paint(QPainter& painter) {
    QRect area = widget()->rect();
    // Only a parent that chose colours has them filled in; else what lies below is seen.
    if (widget()->testAttribute(Qt::WA_SetPalette)) {
        painter.fillRect(area, widget()->palette().color(QPalette::Window));
    }
    if (type() == SS_OWNERDRAW) {
        paintByOwner(painter, ODT_STATIC, 0);
        return;
    }
    if (hasBorder() || (style() & SS_SUNKEN) != 0) {
        const bool plain = (style() & WS_BORDER) != 0 && (style() & SS_SUNKEN) == 0;
        if (plain) {
            painter.setPen(widget()->palette().color(QPalette::Dark));
            painter.drawRect(area.adjusted(0, 0, -1, -1));
        } else {
            qDrawShadePanel(&painter, area, widget()->palette(), true);
        }
        area.adjust(1, 1, -1, -1);
    }
    if (type() == SS_ICON || type() == SS_BITMAP) {
        paintPicture(painter, area);
    } else if (!paintShape(painter, area)) {
        paintText(painter, area);
    }
}

LRESULT StaticWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case STM_SETICON:
        return setPicture(IMAGE_ICON, reinterpret_cast<HANDLE>(wParam));
    case STM_SETIMAGE:
        return setPicture(static_cast<UINT>(wParam), reinterpret_cast<HANDLE>(lParam));
    case STM_GETICON:
    case STM_GETIMAGE:
        return reinterpret_cast<LRESULT>(m_picture);
    case WM_LBUTTONUP:
    case WM_LBUTTONDBLCLK:
        if (!passesMouse()) {
            passEvent(*this, message);
            notify(message == WM_LBUTTONUP ? STN_CLICKED : STN_DBLCLK);
            return 0;
        }
        break;
    default:
        break;
    }
    return Control::defaultProc(message, wParam, lParam);
}

} // namespace tvx::afx
