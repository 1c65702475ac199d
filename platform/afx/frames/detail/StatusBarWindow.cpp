#include "platform/afx/frames/detail/StatusBarWindow.h"

#include "platform/afx/controls/detail/Control.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/frames/StatusBar.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/Fonts.h"
#include "platform/win/FrameworkIds.h"

#include <QFontInfo>
#include <QHelpEvent>
#include <QSizeGrip>
#include <QStyle>
#include <QToolTip>

#include <algorithm>
#include <cstring>

namespace tvx::afx {

namespace {

/// Around the row of panes, and between them.
constexpr int margin = 2;
/// Texts that come within the time of a picture of the display count together. The first of them are shown as they
/// come: a host that sets a few and then works for long wants all of them seen.
constexpr int pictureTime = 16;
constexpr int shownInPicture = 16;

std::unique_ptr<Window> makeStatusBar(const CREATESTRUCT& cs) {
    return std::make_unique<StatusBarWindow>(cs);
}

const WindowClassEntry statusBarEntry("msctls_statusbar32", &makeStatusBar);

} // namespace

// --- the widget ---

StatusBarWidget::StatusBarWidget(QWidget* parent) : QStatusBar(parent) {
    setMouseTracking(true);
    applyFont();
}

void StatusBarWidget::setCount(int count) {
    while (static_cast<int>(m_panes.size()) > count) {
        delete m_panes.back();
        m_panes.pop_back();
    }
    while (static_cast<int>(m_panes.size()) < count) {
        m_panes.push_back(new StatusPane(this));
        m_panes.back()->setFont(m_paneFont);
        m_panes.back()->show();
    }
}

void StatusBarWidget::useFont(HFONT font) {
    m_hostFont = font;
    applyFont();
}

LOGFONT StatusBarWidget::desktopFont() const {
    QFont named = font();
    const QFontInfo real(named);
    named.setFamily(real.family()); // the desktop may name a kind of font only
    return describeFont(named, real.pixelSize());
}

/// The bar keeps the desktop's font, and so hears of another one.
void StatusBarWidget::applyFont() {
    m_paneFont = m_hostFont ? toolkitFont(m_hostFont) : controlFont(desktopFont());
    for (StatusPane* pane : m_panes) {
        pane->setFont(m_paneFont);
    }
    updateGeometry();
    place();
}

StatusPane* StatusBarWidget::pane(int index) const {
    return index >= 0 && index < static_cast<int>(m_panes.size()) ? m_panes[static_cast<std::size_t>(index)] : nullptr;
}

StatusPane* StatusBarWidget::paneAt(QPoint point) const {
    const auto found =
        std::ranges::find_if(m_panes, [&](const StatusPane* pane) { return pane->geometry().contains(point); });
    return found != m_panes.end() ? *found : nullptr;
}

/// The place for panes. That of the size grip is kept free when there is none, too: a frame that is maximised is told
/// its size before the grip is gone.
QRect StatusBarWidget::room() const {
    const auto* grip = findChild<QSizeGrip*>(QString(), Qt::FindDirectChildrenOnly);
    const int end = margin + (grip ? grip->sizeHint().width() : 0);
    const int height = statusPaneHeight(QFontMetrics(m_paneFont));
    return {margin, std::max((this->height() - height + 1) / 2, 0), std::max(width() - margin - end, 0), height};
}

void StatusBarWidget::place() {
    const QRect area = room();
    int free = area.width();
    int sharing = 0;
    for (const StatusPane* pane : m_panes) {
        free -= (pane->stretches() ? 0 : pane->wantedWidth()) + (pane == m_panes.back() ? 0 : margin);
        sharing += pane->stretches() ? 1 : 0;
    }
    int x = area.x();
    for (StatusPane* pane : m_panes) {
        int width = pane->wantedWidth();
        if (pane->stretches()) {
            width = std::max(free, 0) / sharing;
            free -= width;
            --sharing;
        }
        const QRect whole(x, area.y(), width, area.height());
        // What does not fit any more is cut; a pane without any room stands at the end.
        const QRect place(std::min(x, area.right() + 1), area.y(), std::max((whole & area).width(), 0), area.height());
        pane->setGeometry(QStyle::visualRect(layoutDirection(), rect(), place));
        x += width + margin;
    }
}

void StatusBarWidget::resizeEvent(QResizeEvent* event) {
    QStatusBar::resizeEvent(event);
    place();
}

QSize StatusBarWidget::minimumSizeHint() const {
    const int height = statusPaneHeight(QFontMetrics(m_paneFont)) + 2 * margin;
    return {0, std::max(height, QStatusBar::minimumSizeHint().height())};
}

QSize StatusBarWidget::sizeHint() const {
    int width = 0;
    for (const StatusPane* pane : m_panes) {
        width += pane->wantedWidth() + margin;
    }
    return {width, minimumSizeHint().height()};
}

bool StatusBarWidget::event(QEvent* event) {
    const Window* window = event->type() == QEvent::ToolTip ? Window::of(this) : nullptr;
    if (event->type() == QEvent::ToolTip && window) {
        const auto& help = static_cast<const QHelpEvent&>(*event);
        const StatusPane* pane = paneAt(help.pos());
        if (pane && pane->isCut() && !TipWindow::tellsAt(*window, help.pos())) {
            QToolTip::showText(help.globalPos(), tipText(pane->text()), this, pane->geometry());
        }
        return true;
    }
    const bool result = QStatusBar::event(event);
    if (event->type() == QEvent::FontChange) {
        applyFont();
    } else if (event->type() == QEvent::LayoutDirectionChange) {
        place();
    }
    return result;
}

bool StatusBarWidget::isDue() {
    if (!m_frame.isValid() || m_frame.hasExpired(pictureTime)) {
        m_frame.start();
        m_inFrame = 0;
    }
    return ++m_inFrame <= shownInPicture;
}

void StatusBarWidget::showNow(StatusPane& pane) {
    if (!pane.isPainted() && isVisible() && isDue()) {
        pane.showNow();
    }
    pane.showSoon();
}

// --- the window ---

StatusBarWindow::~StatusBarWindow() {
    if (m_desktopFont) {
        DeleteObject(m_desktopFont);
    }
}

QWidget* StatusBarWindow::makeWidget(QWidget* parent) {
    auto* bar = new StatusBarWidget(parent);
    bar->setObjectName(QStringLiteral("bar%1").arg(id()));
    return bar;
}

void StatusBarWindow::fontChanged() {
    guarded([this] { bar()->useFont(font); });
}

HFONT StatusBarWindow::desktopFont() {
    const LOGFONT now = bar()->desktopFont();
    if (!m_desktopFont || std::memcmp(&now, &m_described, sizeof(now)) != 0) {
        DeleteObject(m_desktopFont);
        m_desktopFont = CreateFontIndirectA(&now);
        m_described = now;
    }
    return m_desktopFont;
}

QString StatusBarWindow::text() const {
    return toQt(nameOfBar(static_cast<UINT>(id()), TVX_IDS_STATUS_BAR));
}

QString StatusBarWindow::cutTextAt(QPoint point) const {
    const StatusPane* pane = widget() ? bar()->paneAt(point) : nullptr;
    return pane && pane->isCut() ? pane->text() : QString();
}

LRESULT StatusBarWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_GETFONT:
        return reinterpret_cast<LRESULT>(font || !widget() ? font : desktopFont());
    case SB_GETRECT: {
        const StatusPane* pane = widget() ? bar()->pane(static_cast<int>(wParam)) : nullptr;
        if (pane) {
            // The bar may have a size that the toolkit has not told it yet.
            bar()->place();
            *reinterpret_cast<RECT*>(lParam) = fromQt(pane->geometry());
        }
        return pane ? TRUE : FALSE;
    }
    default:
        return BarWindow::defaultProc(message, wParam, lParam);
    }
}

} // namespace tvx::afx
