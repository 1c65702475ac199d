#include "platform/afx/core/detail/Placement.h"

#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/Gdi.h"

#include <QGuiApplication>
#include <QScreen>
#include <QWindow>

#include <algorithm>
#include <limits>

namespace tvx::afx {

namespace {

/// How long a window manager is given to do what it was asked, in milliseconds; how often it is asked, and how often
/// its borders are looked for.
constexpr int lookBackTime = 150;
constexpr int attempts = 3;
constexpr int looks = 20;

/// Wayland desktops keep the places of windows to themselves; what was asked for must not be lost over that.
bool tellsPlaces() {
    return !QGuiApplication::platformName().startsWith(QLatin1String("wayland"));
}

} // namespace

Placement::Placement(Window& window) : m_window(window) {
    m_settle.setSingleShot(true);
    m_settle.setInterval(0);
    connectStoring(&m_settle, &QTimer::timeout, &m_settle, [this] { settle(); });
    m_lookBack.setSingleShot(true);
    m_lookBack.setInterval(lookBackTime);
    connectStoring(&m_lookBack, &QTimer::timeout, &m_lookBack, [this] { lookBack(); });
}

QWidget& Placement::widget() const {
    return *m_window.widget();
}

QMargins Placement::borders() const {
    const QWindow* native = widget().isWindow() ? widget().windowHandle() : nullptr;
    return native ? native->frameMargins() : QMargins();
}

bool Placement::isNormal() const {
    return !widget().isMaximized() && !widget().isMinimized();
}

/// Whether the desktop will frame the window or has not told yet that it has.
bool Placement::awaitsBorders() const {
    const bool framed = widget().isWindow() && (widget().windowFlags() & Qt::FramelessWindowHint) == 0;
    return framed && (!widget().isVisible() || borders().isNull());
}

/// What the desktop's borders will add to the size of a window that is not shown yet.
QSize Placement::expectedGrowth() const {
    if (widget().isVisible() || !awaitsBorders() || !borders().isNull()) {
        return {0, 0};
    }
    const QMargins expected = m_window.expectedBorders();
    return {expected.left() + expected.right(), expected.top() + expected.bottom()};
}

QRect Placement::frameRect() const {
    const QRect frame = widget().geometry() + borders();
    return {frame.topLeft(), frame.size() + expectedGrowth()};
}

void Placement::moveFrame(const QRect& rect, Measured measured) {
    m_wish.reset();
    m_lookBack.stop();
    m_askedCorner = rect.topLeft();
    if (awaitsBorders()) {
        m_wish = Wish{rect, measured};
    } else if (isNormal()) {
        // What the desktop still tells of the place before does not count.
        m_wish = Wish{rect, Measured::Frame, attempts};
        m_lookBack.start();
    }
    const QMargins around = borders();
    const QSize inside =
        rect.size() - expectedGrowth() - QSize(around.left() + around.right(), around.top() + around.bottom());
    if (around.isNull()) {
        widget().move(rect.topLeft());
        widget().resize(inside.expandedTo({1, 1}));
    } else {
        widget().setGeometry(QRect(rect.topLeft() + QPoint(around.left(), around.top()), inside.expandedTo({1, 1})));
    }
    if (isNormal()) {
        m_restored = rect;
        m_restoredSize = widget().size();
    }
}

void Placement::setRestored(const QRect& rect) {
    if (isNormal()) {
        m_window.setWindowRect(rect);
        if (m_wish) {
            m_wish->measured = Measured::Frame;
        }
    } else {
        m_wish = Wish{rect, Measured::Frame};
        m_askedCorner = rect.topLeft();
    }
    m_restored = rect;
}

QRect Placement::restored() const {
    if (m_wish && m_wish->measured == Measured::Frame) {
        return m_wish->rect;
    }
    QRect rect = m_window.windowRect();
    if (!isNormal() && !m_restored.isNull()) {
        // A size that was told before the state it belongs to is no restored one.
        const bool early = widget().isMaximized() && widget().size() == m_restoredSize && !m_before.isNull();
        rect = early ? m_before : m_restored;
    }
    return widget().isWindow() && !tellsPlaces() ? QRect(m_askedCorner, rect.size()) : rect;
}

void Placement::aboutToShow() {
    QWindow* native = widget().windowHandle();
    if (!m_wish || widget().isVisible() || !native || !native->handle()) {
        return;
    }
    // A window that exists already would be put with its inside at the place. The toolkit leaves it alone when it
    // stands where its widget does.
    native->resize(widget().size());
    native->setFramePosition(widget().pos());
}

void Placement::changed() {
    m_settle.start();
}

void Placement::settle() {
    if (m_window.isDestroyed() || !m_window.widget() || !widget().isVisible()) {
        return;
    }
    if (!isNormal()) {
        m_specialInside = widget().geometry();
    } else if (widget().geometry() == m_specialInside) {
        return; // restored, but still of the size it had before: the new one is on its way
    } else {
        m_specialInside = QRect();
        grant();
        remember();
    }
}

QRect Placement::wishedFrame() const {
    return m_wish->measured == Measured::Frame ? m_wish->rect : QRect(m_wish->rect.topLeft(), frameRect().size());
}

void Placement::grant() {
    if (!m_wish || m_lookBack.isActive()) {
        return;
    }
    Wish wish = *m_wish;
    if (awaitsBorders()) {
        // Borders that change nothing of the size inside come without an event.
        m_wish->looks++;
        if (wish.looks < looks) {
            m_lookBack.start();
        }
        return;
    }
    ++wish.attempts;
    const QRect wanted = wishedFrame();
    if (wanted != frameRect()) {
        guarded([&] { m_window.setWindowRect(wanted); });
    }
    m_wish = wish;
    m_lookBack.start();
}

void Placement::lookBack() {
    if (!m_wish || m_window.isDestroyed() || !m_window.widget() || !isNormal()) {
        return;
    }
    const bool done = !awaitsBorders() && m_wish->attempts > 0 && wishedFrame() == frameRect();
    if (done || m_wish->attempts >= attempts) {
        m_wish.reset();
        remember();
    } else {
        grant();
    }
}

void Placement::remember() {
    if (m_wish || m_window.isDestroyed() || !m_window.widget()) {
        return;
    }
    const QRect now = m_window.windowRect();
    if (now != m_restored) {
        m_before = m_restored;
        m_restored = now;
        m_restoredSize = widget().size();
    }
}

// --- screens ---

namespace {

/// Coordinates that no screen reaches, well inside what display servers take.
constexpr int farthest = 30000;

bool showsEnough(const QRect& caption, const QRect& screen) {
    constexpr int graspable = 64;
    const QRect shown = caption & screen;
    return shown.width() >= std::min(graspable, caption.width()) && shown.height() * 2 >= caption.height();
}

int distance(const QRect& area, const QPoint& point) {
    const int dx = std::max({area.left() - point.x(), 0, point.x() - area.right()});
    const int dy = std::max({area.top() - point.y(), 0, point.y() - area.bottom()});
    return dx + dy;
}

QRect nearestWorkArea(const QPoint& point) {
    QRect nearest;
    int least = std::numeric_limits<int>::max();
    const auto screens = QGuiApplication::screens();
    for (const QScreen* screen : screens) {
        const int away = distance(screen->availableGeometry(), point);
        if (away < least) {
            least = away;
            nearest = screen->availableGeometry();
        }
    }
    return nearest;
}

} // namespace

QRect reachableFrame(const QRect& frame) {
    const auto screens = QGuiApplication::screens();
    const QRect caption(frame.topLeft(), QSize(frame.width(), std::max(GetSystemMetrics(SM_CYCAPTION), 16)));
    const bool reachable = std::any_of(screens.begin(), screens.end(), [&](const QScreen* screen) {
        return showsEnough(caption, screen->availableGeometry());
    });
    if (reachable || screens.isEmpty()) {
        return frame;
    }
    const auto near = [](int at) { return std::clamp(at, -farthest, farthest); };
    const QRect area = nearestWorkArea(QPoint(near(frame.left()), near(frame.top())));
    const QSize size = frame.size().boundedTo(area.size());
    return {std::clamp(frame.left(), area.left(), area.right() + 1 - size.width()),
            std::clamp(frame.top(), area.top(), area.bottom() + 1 - size.height()), size.width(), size.height()};
}

} // namespace tvx::afx
