#include "platform/afx/core/detail/Placement.h"

#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/DesktopAnswers.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/Gdi.h"

#include <QGuiApplication>
#include <QMoveEvent>
#include <QResizeEvent>
#include <QScreen>
#include <QWindow>

#include <algorithm>
#include <limits>
#include <utility>

namespace tvx::afx {

namespace {

/// How often a frame is asked to its place. The borders that a first request counted may have been those of another
/// state of the window; what differs after the second is what the desktop wants, as a smallest size or its own tiles.
constexpr int mostAttempts = 2;

/// Whether a window still stands. Handlers of what a change brings may end it, and its placement with it.
class Standing {
public:
    explicit Standing(const Window& window) : m_window(&window), m_handle(window.handle()) {}
    explicit operator bool() const {
        return Window::from(m_handle) == m_window;
    }

private:
    const Window* m_window;
    HWND m_handle;
};

/// Wayland desktops keep the places of windows to themselves; what was asked for must not be lost over that.
bool tellsPlaces() {
    return !QGuiApplication::platformName().startsWith(QLatin1String("wayland"));
}

} // namespace

Placement::Placement(Window& window) : m_window(window) {
    m_settle.setSingleShot(true);
    m_settle.setInterval(0);
    connectStoring(&m_settle, &QTimer::timeout, &m_settle, [this] { settle(); });
    m_answer.setSingleShot(true);
    m_answer.setInterval(0);
    connectStoring(&m_answer, &QTimer::timeout, &m_answer, [this] { answered(); });
}

QWidget& Placement::widget() const {
    return *m_window.widget();
}

QMargins Placement::borders() const {
    const QWindow* native = widget().isWindow() ? widget().windowHandle() : nullptr;
    return native ? native->frameMargins() : QMargins();
}

bool Placement::isGone() const {
    return m_window.isDestroyed() || !m_window.widget() || !widget().isVisible();
}

bool Placement::isNormal() const {
    return !widget().isMaximized() && !widget().isMinimized();
}

/// Whether the desktop will frame the window or has not told yet that it has.
bool Placement::awaitsBorders() const {
    const bool framed = widget().isWindow() && (widget().windowFlags() & Qt::FramelessWindowHint) == 0;
    return framed && (!widget().isVisible() || (m_bordersComing && !m_bordersTold && borders().isNull()));
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
    m_seen.reset(); // what the desktop still tells of the place before does not count
    m_askedCorner = rect.topLeft();
    if (awaitsBorders()) {
        m_wish = Wish{rect, measured};
    } else if (isNormal()) {
        m_wish = Wish{rect, Measured::Frame, 1};
    }
    const Standing standing(m_window);
    const QMargins around = borders();
    const QSize inside =
        rect.size() - expectedGrowth() - QSize(around.left() + around.right(), around.top() + around.bottom());
    QWidget& moved = widget(); // outlives the window by a turn of the loop
    if (around.isNull()) {
        moved.move(rect.topLeft());
        moved.resize(inside.expandedTo({1, 1}));
    } else {
        moved.setGeometry(QRect(rect.topLeft() + QPoint(around.left(), around.top()), inside.expandedTo({1, 1})));
    }
    if (!standing) {
        return;
    }
    if (isNormal()) {
        m_restored = rect;
    }
    // Also without an event: a window that stands there already is told nothing.
    changed();
}

void Placement::setRestored(const QRect& rect) {
    if (isNormal()) {
        const Standing standing(m_window);
        m_window.setWindowRect(rect);
        if (!standing) {
            return;
        }
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
    const QRect rect = isNormal() || m_restored.isNull() ? m_window.windowRect() : m_restored;
    return widget().isWindow() && !tellsPlaces() ? QRect(m_askedCorner, rect.size()) : rect;
}

/// Window managers activate new windows of the active application whatever they ask for, unless they take no keyboard.
void Placement::refuseKeyboard(bool refuse) {
    QWindow* native = widget().isWindow() ? widget().windowHandle() : nullptr;
    if (native && m_refusesKeyboard != refuse) {
        m_refusesKeyboard = refuse;
        native->setFlag(Qt::WindowDoesNotAcceptFocus, refuse);
    }
}

void Placement::aboutToShow(Keyboard keyboard) {
    refuseKeyboard(keyboard == Keyboard::Left && widget().isHidden());
    changed();
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
    m_askAgain = m_asked; // an answer on its way is not about this change
    m_settle.start();
}

void Placement::bordersChanged() {
    m_bordersTold = true;
    changed();
}

void Placement::settle() {
    if (isGone()) {
        return;
    }
    if (isNormal()) {
        m_seen = Seen{m_window.windowRect(), widget().geometry()};
    }
    ask();
}

void Placement::ask() {
    if (m_asked) {
        m_askAgain = true;
        return;
    }
    m_asked = true;
    const Told told = widget().isWindow() ? startWhenDesktopHasAnswered(m_answer) : Told::ByNobody;
    m_bordersComing = told == Told::ByManager;
    if (!widget().isWindow()) {
        m_answer.start(); // child frames are moved by the toolkit, which is done at once
    }
}

/// The toolkit keeps a place to itself that it has told before, though the widget was given another one meanwhile:
/// one that was asked for and then overtaken by maximising, or refused.
void Placement::hearWithheld() {
    const Standing standing(m_window);
    QWindow* native = widget().isWindow() ? widget().windowHandle() : nullptr;
    if (native && widget().size() != native->size()) {
        QResizeEvent resized(native->size(), widget().size());
        guarded([&] { QCoreApplication::sendEvent(native, &resized); });
    }
    if (native && standing && widget().geometry().topLeft() != native->position()) {
        QMoveEvent moved(native->position(), widget().geometry().topLeft());
        guarded([&] { QCoreApplication::sendEvent(native, &moved); });
    }
}

void Placement::answered() {
    m_asked = false;
    const Standing standing(m_window);
    if (!m_askAgain) {
        refuseKeyboard(false);
    }
    if (!isGone()) {
        hearWithheld();
    }
    if (!standing) {
        return;
    }
    if (std::exchange(m_askAgain, false)) {
        if (!isGone()) {
            ask(); // something changed after the question
        }
    } else if (isGone()) {
        m_seen.reset();
    } else if (!isNormal()) {
        leaveNormal();
    } else if (m_wish) {
        grant();
    } else {
        remember(m_window.windowRect());
    }
}

/// What was seen before the state came is the restored rectangle, unless it was the size of that state, told first.
void Placement::leaveNormal() {
    if (m_seen && !m_wish && m_seen->inside != widget().geometry()) {
        remember(m_seen->frame);
    }
    m_seen.reset();
}

QRect Placement::wishedFrame() const {
    return m_wish->measured == Measured::Frame ? m_wish->rect : QRect(m_wish->rect.topLeft(), frameRect().size());
}

void Placement::grant() {
    if (awaitsBorders()) {
        return; // the event that tells them leads here again
    }
    const QRect wanted = wishedFrame();
    if (wanted == m_window.windowRect() || m_wish->attempts >= mostAttempts) {
        m_wish.reset();
        remember(m_window.windowRect());
        return;
    }
    Wish wish = *m_wish;
    ++wish.attempts;
    const Standing standing(m_window);
    guarded([&] { m_window.setWindowRect(wanted); });
    if (standing) {
        m_wish = wish;
        ask();
    }
}

void Placement::remember(const QRect& frame) {
    m_restored = frame;
    m_seen.reset();
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
