#include "platform/afx/frames/detail/StatusPane.h"

#include "platform/afx/core/detail/Window.h"
#include "platform/afx/core/detail/WindowSurface.h"
#include "platform/afx/frames/StatusBar.h"

#include <QAccessibleWidget>
#include <QPainter>
#include <QStyle>
#include <QStyleOptionFrame>
#include <qdrawutil.h>

#include <utility>

namespace tvx::afx {

namespace {

/// Border and space at each end of a pane's text.
constexpr int textMargin = 5;
/// The same above and below it.
constexpr int lineMargin = 2;

class AccessiblePane : public QAccessibleWidget {
public:
    explicit AccessiblePane(StatusPane& pane) : QAccessibleWidget(&pane, QAccessible::StaticText) {}
    QString text(QAccessible::Text kind) const override {
        return kind == QAccessible::Name ? static_cast<StatusPane*>(widget())->text() : QAccessibleWidget::text(kind);
    }
};

QAccessibleInterface* answerForPane(const QString&, QObject* object) {
    auto* pane = dynamic_cast<StatusPane*>(object);
    return pane ? new AccessiblePane(*pane) : nullptr;
}

} // namespace

int statusPaneHeight(const QFontMetrics& metrics) {
    return metrics.height() + 2 * lineMargin;
}

StatusPane::StatusPane(QWidget* bar) : QWidget(bar) {
    [[maybe_unused]] static const bool isAnswered = (QAccessible::installFactory(&answerForPane), true);
    setObjectName(QStringLiteral("pane"));
    setAttribute(Qt::WA_TransparentForMouseEvents); // the bar's window is the one that hosts ask about
}

void StatusPane::setShape(unsigned style, int textWidth) {
    m_textWidth = textWidth;
    if (std::exchange(m_style, style) != style) {
        m_isTaken = m_isPainted = false;
        showSoon();
    }
}

int StatusPane::wantedWidth() const {
    return std::max(m_textWidth, 0) + 2 * textMargin;
}

bool StatusPane::stretches() const {
    return (m_style & SBPS_STRETCH) != 0;
}

// --- text ---

void StatusPane::setText(const CString& text) {
    m_given = text;
    m_isTaken = m_isPainted = false;
}

const QString& StatusPane::text() const {
    if (!std::exchange(m_isTaken, true)) {
        m_text = (m_style & SBPS_DISABLED) != 0 ? QString() : toQt(m_given);
    }
    return m_text;
}

QRect StatusPane::textArea() const {
    return rect().adjusted(textMargin, 0, -textMargin, 0);
}

bool StatusPane::isCut() const {
    return fontMetrics().horizontalAdvance(text()) > textArea().width();
}

// --- painting ---

void StatusPane::showSoon() {
    if (!m_isPainted && !std::exchange(m_isAskedFor, true)) {
        update();
    }
}

/// Draws into the window's pixels: the toolkit's own repaint would paint all that waits in the window, the host's views
/// among it, while the host is in the middle of something.
void StatusPane::showNow() {
    if (m_isPainted || !isVisible()) {
        return;
    }
    WindowSurface& surface = WindowSurface::of(*this);
    const QRect place(mapTo(window(), QPoint()), size());
    QImage* pixels = surface.open(place);
    if (!pixels) {
        return;
    }
    {
        QPainter painter(pixels);
        painter.scale(surface.ratio(), surface.ratio());
        parentWidget()->render(&painter, place.topLeft(), geometry(), DrawWindowBackground | DrawChildren);
    }
    surface.close(place, WindowSurface::ShownBy::Flush);
    surface.flush();
}

void StatusPane::painted() {
    m_isPainted = true;
    m_isAskedFor = false;
    if (QAccessible::isActive() && m_told != text()) {
        m_told = text();
        QAccessibleEvent event(this, QAccessible::NameChanged);
        QAccessible::updateAccessibility(&event);
    }
}

void StatusPane::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    if ((m_style & SBPS_POPOUT) != 0) {
        // Styles draw raised and sunken borders alike.
        qDrawShadePanel(&painter, rect(), palette());
    } else if ((m_style & SBPS_NOBORDERS) == 0) {
        QStyleOptionFrame option;
        option.initFrom(this);
        option.frameShape = QFrame::StyledPanel;
        option.lineWidth = 1;
        option.state |= QStyle::State_Sunken;
        style()->drawControl(QStyle::CE_ShapedFrame, &option, &painter, this);
    }
    const QRect area = textArea();
    const int line = Qt::AlignLeft | Qt::AlignVCenter | Qt::TextSingleLine;
    const QString shown = isCut() ? fontMetrics().elidedText(text(), Qt::ElideRight, area.width()) : text();
    style()->drawItemText(&painter, area, line, palette(), isEnabled(), shown, QPalette::WindowText);
    painted();
}

} // namespace tvx::afx
