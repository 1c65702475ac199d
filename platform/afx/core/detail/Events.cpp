#include "platform/afx/core/detail/BrokenPixels.h"
#include "platform/afx/core/detail/CaptionMouse.h"
#include "platform/afx/core/detail/Capture.h"
#include "platform/afx/core/detail/Cursors.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Drops.h"
#include "platform/afx/core/detail/HelpMode.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/MessageQueue.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/core/detail/WindowSurface.h"

#include <QApplication>
#include <QContextMenuEvent>
#include <QInputMethodEvent>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPaintEvent>
#include <QWheelEvent>
#include <QWindowStateChangeEvent>

#include <memory>

namespace tvx::afx {

namespace {

/// A press that pre-translation has seen already, when the toolkit asked for shortcuts. Presses that come without that
/// question (redelivered ones, those of input methods and tests) are offered when they arrive.
struct OfferedKey {
    int key = 0;
    quint64 timestamp = 0;
    bool consumed = false;
    bool pending = false;
} offeredKey;

/// Whether Alt went down and nothing else happened since: its release then opens the menu bar.
bool altAlone = false;

bool keepForPeek(const MSG& msg, QObject* receiver, const QEvent* event) {
    EventCapture& capture = EventCapture::instance();
    if (!capture.isCollecting()) {
        return false;
    }
    CapturedEvent captured;
    captured.msg = msg;
    captured.receiver = receiver;
    captured.event.reset(event->clone());
    capture.add(std::move(captured));
    return true;
}

/// Runs one message with the event behind it. An input event that nobody passed on ends here.
bool deliverInput(const MSG& msg, QObject* receiver, QEvent* event) {
    EventSource source{receiver, event};
    dispatch(msg, &source);
    if (!source.passed) {
        event->accept();
    }
    return true;
}

// --- keys ---

bool isSystemKey(const QKeyEvent& event) {
    const bool alt = event.modifiers().testFlag(Qt::AltModifier) && !event.modifiers().testFlag(Qt::ControlModifier);
    return alt || event.key() == Qt::Key_F10 || virtualKey(event) == VK_MENU;
}

MSG keyMessage(const Window& window, const QKeyEvent& event, bool released) {
    const bool system = isSystemKey(event);
    const UINT down = system ? WM_SYSKEYDOWN : WM_KEYDOWN;
    const UINT up = system ? WM_SYSKEYUP : WM_KEYUP;
    return makeMessage(window.handle(), released ? up : down, static_cast<WPARAM>(virtualKey(event)),
                       keyParameter(event, released));
}

/// On layouts of other scripts Ctrl with a letter key is what it is on Latin ones, for fields of the toolkit as well.
/// Null for keys that mean the same everywhere.
std::unique_ptr<QKeyEvent> asLatin(const QKeyEvent& event) {
    const int key = virtualKey(event);
    const bool control =
        event.modifiers().testFlag(Qt::ControlModifier) && !event.modifiers().testFlag(Qt::AltModifier);
    if (!control || key < 'A' || key > 'Z' || event.key() < 0x80 || event.key() >= Qt::Key_Escape) {
        return nullptr;
    }
    auto latin = std::make_unique<QKeyEvent>(event.type(), key, event.modifiers(), event.nativeScanCode(),
                                             event.nativeVirtualKey(), event.nativeModifiers(),
                                             QString(QChar(key - '@')), event.isAutoRepeat(), event.count());
    latin->setTimestamp(event.timestamp());
    return latin;
}

/// Esc gives back a window that the mouse holds by its caption.
bool endsHold(const QKeyEvent& event) {
    const Window* held = event.key() == Qt::Key_Escape ? Window::from(captureWindow()) : nullptr;
    if (!held || !held->isHeldByCaption()) {
        return false;
    }
    SendMessageA(held->handle(), WM_CANCELMODE, 0, 0);
    return true;
}

/// The toolkit asks with this event before its own shortcuts: the place where a key can be taken from everybody.
bool onShortcutOverride(Window& window, QObject* receiver, QKeyEvent& event) {
    MSG msg = keyMessage(window, event, false);
    event.accept(); // shortcuts of the toolkit's never fire: accelerators and mnemonics are the layer's
    if (EventCapture::instance().isCollecting()) {
        return true;
    }
    armIdle();
    const bool consumed = endsHold(event) || preTranslate(msg);
    offeredKey = {event.key(), event.timestamp(), consumed, true};
    return true;
}

/// Whether pre-translation consumes a press, or has done so.
bool isConsumed(const QKeyEvent& event, MSG msg) {
    const bool offered = std::exchange(offeredKey.pending, false) && offeredKey.key == event.key() &&
                         (offeredKey.timestamp == event.timestamp() || event.timestamp() == 0);
    return offered ? offeredKey.consumed : endsHold(event) || preTranslate(msg);
}

/// Characters go one message each; the event itself goes to the widget with the first that nobody handled.
void deliverCharacters(Window& window, const QKeyEvent& event, EventSource& source) {
    const UINT message = isSystemKey(event) ? WM_SYSCHAR : WM_CHAR;
    const HWND handle = window.handle();
    const auto characters = event.text().toUcs4();
    const bool control = event.modifiers().testFlag(Qt::ControlModifier);
    for (auto character : characters) {
        // Ctrl and Enter are the line feed to hosts, the carriage return to the desktop.
        character = control && character == U'\r' ? U'\n' : character;
        MSG msg = makeMessage(handle, message, character, keyParameter(event, false));
        if (!preTranslate(msg)) {
            dispatch(msg, &source);
        }
    }
}

bool onKeyPress(Window& window, QObject* receiver, QKeyEvent& event) {
    altAlone = event.key() == Qt::Key_Alt;
    const MSG msg = keyMessage(window, event, false);
    if (keepForPeek(msg, receiver, &event)) {
        return true;
    }
    const HWND target = window.handle();
    if (isConsumed(event, msg) || !Window::from(target)) {
        event.accept();
        return true;
    }
    EventSource source{receiver, &event};
    const HWND handle = target;
    const bool makesCharacters = !event.text().isEmpty();
    if (makesCharacters) {
        // A widget inserts the character at this one event, so it gets it where the framework would insert it.
        dispatch(msg);
        if (Window::from(handle)) {
            deliverCharacters(window, event, source);
        }
    } else {
        dispatch(msg, &source);
    }
    if (!source.passed) {
        event.accept();
    }
    return true;
}

bool onKeyRelease(Window& window, QObject* receiver, QKeyEvent& event) {
    // The display tells of a release between repeated presses; hosts know repeated presses only.
    if (event.isAutoRepeat()) {
        event.accept();
        return true;
    }
    MSG msg = keyMessage(window, event, true);
    if (keepForPeek(msg, receiver, &event)) {
        return true;
    }
    if (virtualKey(event) == VK_MENU) {
        // Only a lone Alt opens the menu; the release of an Alt that was used with another key is an ordinary one.
        msg.message = altAlone ? WM_SYSKEYUP : WM_KEYUP;
        altAlone = false;
    }
    EventSource source{receiver, &event};
    armIdle();
    if (!preTranslate(msg)) {
        dispatch(msg, &source);
    }
    event.accept();
    return true;
}

/// Text composed by an input method comes without key presses.
bool onInputMethod(Window& window, QObject* receiver, QInputMethodEvent& event) {
    const auto characters = event.commitString().toUcs4();
    if (characters.isEmpty()) {
        return false;
    }
    EventSource source{receiver, &event};
    const HWND handle = window.handle();
    for (const auto character : characters) {
        MSG msg = makeMessage(handle, WM_CHAR, character, 1);
        if (!preTranslate(msg)) {
            dispatch(msg, &source);
        }
    }
    return true;
}

// --- mouse ---

UINT buttonMessage(const QMouseEvent& event) {
    UINT first = WM_LBUTTONDOWN;
    if (event.button() == Qt::RightButton) {
        first = WM_RBUTTONDOWN;
    } else if (event.button() == Qt::MiddleButton) {
        first = WM_MBUTTONDOWN;
    } else if (event.button() != Qt::LeftButton) {
        return WM_NULL;
    }
    // The numbers of a button's messages follow each other: down, up, double click.
    switch (event.type()) {
    case QEvent::MouseButtonPress:
        return first;
    case QEvent::MouseButtonRelease:
        return first + 1;
    case QEvent::MouseButtonDblClick:
        return first + 2;
    default:
        return WM_NULL;
    }
}

Window* mouseTarget(Window* under) {
    if (Window* capturing = Window::from(captureWindow())) {
        return capturing;
    }
    while (under && under->passesMouse() && under->parent()) {
        under = under->parent();
    }
    return under;
}

/// The part of a window (HT...) that the mouse is over. A mouse that is captured is the client area's wherever it is.
int partUnder(const Window& window, QPoint screen) {
    if (captureWindow()) {
        return HTCLIENT;
    }
    if (EventCapture::instance().isCollecting()) {
        return window.hitTest(screen);
    }
    return static_cast<int>(SendMessageA(window.handle(), WM_NCHITTEST, 0, MAKELPARAM(screen.x(), screen.y())));
}

/// The message of the mouse for a part of a window: those outside of the client area have numbers of their own.
MSG mouseMessage(const Window& window, UINT message, int part, const QMouseEvent& event) {
    const QPoint screen = event.globalPosition().toPoint();
    if (part != HTCLIENT) {
        return makeMessage(window.handle(), message - WM_MOUSEFIRST + WM_NCMOUSEMOVE, static_cast<WPARAM>(part),
                           MAKELPARAM(screen.x(), screen.y()));
    }
    const QPoint point = window.screenToClient(screen);
    return makeMessage(window.handle(), message, buttonFlags(event.buttons(), event.modifiers()),
                       MAKELPARAM(point.x(), point.y()));
}

/// The window that has the mouse over its frame.
HWND frameUnder = nullptr;

/// Tells a window when the mouse is over its frame no longer, wherever it went.
void noteFrameUnder(HWND window) {
    const HWND before = std::exchange(frameUnder, window);
    if (before && before != window) {
        SendMessageA(before, WM_NCMOUSELEAVE, 0, 0);
    }
}

/// Lets windows choose the cursor, and views and child frames become active, before they see the press itself.
void announceMouse(const Window& window, UINT message, int part) {
    const HWND handle = window.handle();
    // Nobody is asked for a cursor while the mouse is captured: that is the rule hosts know.
    if (!captureWindow()) {
        noteFrameUnder(part == HTCLIENT ? nullptr : handle);
        noteCursorWindow(handle);
        SendMessageA(handle, WM_SETCURSOR, reinterpret_cast<WPARAM>(handle),
                     MAKELPARAM(part, static_cast<int>(message)));
    }
    const bool press = message == WM_LBUTTONDOWN || message == WM_RBUTTONDOWN || message == WM_MBUTTONDOWN;
    if (press && !captureWindow()) {
        Window* current = Window::from(handle);
        const HWND top = current ? current->topLevel()->handle() : nullptr;
        SendMessageA(handle, WM_MOUSEACTIVATE, reinterpret_cast<WPARAM>(top),
                     MAKELPARAM(part, static_cast<int>(message)));
    }
}

bool onMouse(Window& under, QObject* receiver, QMouseEvent& event) {
    const QPoint screen = event.globalPosition().toPoint();
    notePointer(fromQt(screen));
    const UINT message = event.type() == QEvent::MouseMove ? static_cast<UINT>(WM_MOUSEMOVE) : buttonMessage(event);
    Window* target = mouseTarget(&under);
    if (message == WM_NULL || !target) {
        return false;
    }
    altAlone = false;
    const HWND handle = target->handle();
    const int part = partUnder(*target, screen);
    target = Window::from(handle);
    if (target && !EventCapture::instance().isCollecting()) {
        announceMouse(*target, message, part);
        target = Window::from(handle);
    }
    if (!target) {
        event.accept();
        return true;
    }
    MSG msg = mouseMessage(*target, message, part, event);
    if (keepForPeek(msg, receiver, &event)) {
        return true;
    }
    noteIdle(msg);
    if (preTranslate(msg)) {
        event.accept();
        return true;
    }
    return deliverInput(msg, receiver, &event);
}

bool onWheel(Window& under, QObject* receiver, QWheelEvent& event) {
    Window* target = mouseTarget(&under);
    if (!target || event.angleDelta().y() == 0) {
        return false;
    }
    const QPoint screen = event.globalPosition().toPoint();
    // The wheel's is the one mouse message in screen coordinates.
    const WPARAM keys = buttonFlags(event.buttons(), event.modifiers());
    MSG msg = makeMessage(target->handle(), WM_MOUSEWHEEL, MAKEWPARAM(static_cast<int>(keys), event.angleDelta().y()),
                          MAKELPARAM(screen.x(), screen.y()));
    if (keepForPeek(msg, receiver, &event)) {
        return true;
    }
    armIdle();
    if (preTranslate(msg)) {
        event.accept();
        return true;
    }
    return deliverInput(msg, receiver, &event);
}

/// The right button's release asks for a menu by way of its default; only the keyboard's request comes from here.
bool onContextMenu(Window& window, QContextMenuEvent& event) {
    event.accept();
    if (event.reason() == QContextMenuEvent::Keyboard) {
        window.call(WM_CONTEXTMENU, reinterpret_cast<WPARAM>(window.handle()), MAKELPARAM(-1, -1));
    }
    return true;
}

// --- painting, place, activation ---

bool onPaint(Window& window, QObject* receiver, QPaintEvent& event) {
    if (receiver == window.widget() && window.caption()) {
        const HWND handle = window.handle();
        EventSource source{receiver, &event};
        const bool isBoth = receiver == window.clientWidget();
        paintFrame(window, isBoth ? nullptr : &source);
        if (!isBoth || !Window::from(handle)) {
            return true;
        }
    }
    if (receiver != window.clientWidget()) {
        return false;
    }
    const bool outer = std::exchange(window.inPaint, true);
    window.paintRegion = event.region().translated(-window.clientRect().topLeft());
    struct Done {
        Window& window;
        bool outer;
        ~Done() {
            window.inPaint = outer;
            window.paintRegion = QRegion();
        }
    } done{window, outer};
    EventSource source{receiver, &event};
    dispatch(makeMessage(window.handle(), WM_PAINT, 0, 0), &source);
    return true;
}

bool onCloseRequest(Window& window, QEvent& event) {
    // The toolkit must not hide the window: what happens is decided by whoever handles WM_CLOSE.
    event.ignore();
    armIdle();
    MSG msg = makeMessage(window.handle(), WM_SYSCOMMAND, SC_CLOSE, 0);
    pump(msg);
    return true;
}

void tellActivation(HWND handle, bool active) {
    Window* other = Window::of(QApplication::activeWindow());
    const HWND otherHandle = other && other->handle() != handle ? other->handle() : nullptr;
    armIdle();
    // The caption first, as hosts know the order.
    SendMessageA(handle, WM_NCACTIVATE, active ? TRUE : FALSE, 0);
    SendMessageA(handle, WM_ACTIVATE, active ? WA_ACTIVE : WA_INACTIVE, reinterpret_cast<LPARAM>(otherHandle));
}

/// The window that the toolkit takes for an inactive one because the window manager moves it.
HWND keptActive = nullptr;

void onActivation(const Window& window, bool active) {
    const HWND handle = window.handle();
    if (!active && isHeldByDesktop(handle) && !QApplication::activeWindow()) {
        keptActive = handle;
        return;
    }
    const HWND kept = std::exchange(keptActive, nullptr);
    if (kept == handle && active) {
        return;
    }
    if (kept && kept != handle) {
        tellActivation(kept, false);
    }
    tellActivation(handle, active);
}

void onFocus(Window& window, const QFocusEvent& event) {
    if (event.reason() == Qt::PopupFocusReason || event.reason() == Qt::MenuBarFocusReason) {
        return; // a menu borrows the keyboard only
    }
    armIdle();
    tellFocus(window, event.gotFocus());
}

/// Events that the toolkit handles first and the window hears of afterwards.
bool onAfterwards(Window& window, QObject* receiver, QEvent& event, bool& result) {
    EventSource source{receiver, &event};
    const HWND handle = window.handle();
    passToToolkit(source);
    result = true;
    Window* current = Window::from(handle);
    if (!current) {
        return true;
    }
    const bool outermost = receiver == current->widget();
    switch (event.type()) {
    case QEvent::Move:
    case QEvent::Resize:
    case QEvent::WindowStateChange:
        if (outermost && event.type() == QEvent::WindowStateChange) {
            current->stateChanged();
        }
        if (outermost || receiver == current->clientWidget()) {
            current->tellGeometry();
        }
        break;
    case QEvent::WindowActivate:
    case QEvent::WindowDeactivate:
        if (outermost && current->widget()->isWindow()) {
            onActivation(*current, event.type() == QEvent::WindowActivate);
        }
        break;
    case QEvent::FocusIn:
    case QEvent::FocusOut:
        onFocus(*current, static_cast<QFocusEvent&>(event));
        break;
    case QEvent::Leave:
        if (outermost && frameUnder == handle) {
            noteFrameUnder(nullptr);
            current = Window::from(handle);
        }
        if (current && receiver == current->clientWidget()) {
            current->call(WM_MOUSELEAVE);
        }
        break;
    default:
        break;
    }
    return true;
}

bool translateKey(Window& window, QObject* receiver, QKeyEvent& event) {
    if (const auto latin = event.type() != QEvent::KeyRelease ? asLatin(event) : nullptr) {
        const bool done = translateKey(window, receiver, *latin);
        event.setAccepted(latin->isAccepted());
        return done;
    }
    return event.type() == QEvent::ShortcutOverride ? onShortcutOverride(window, receiver, event)
           : event.type() == QEvent::KeyPress       ? onKeyPress(window, receiver, event)
                                                    : onKeyRelease(window, receiver, event);
}

bool translateInput(Window& window, QObject* receiver, QEvent* event) {
    switch (event->type()) {
    case QEvent::ShortcutOverride:
    case QEvent::KeyPress:
    case QEvent::KeyRelease:
        return translateKey(window, receiver, static_cast<QKeyEvent&>(*event));
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonRelease:
    case QEvent::MouseButtonDblClick:
    case QEvent::MouseMove:
        return onMouse(window, receiver, static_cast<QMouseEvent&>(*event));
    case QEvent::Wheel:
        return onWheel(window, receiver, static_cast<QWheelEvent&>(*event));
    case QEvent::ContextMenu:
        return onContextMenu(window, static_cast<QContextMenuEvent&>(*event));
    default:
        return false;
    }
}

bool isInput(QEvent::Type type) {
    switch (type) {
    case QEvent::ShortcutOverride:
    case QEvent::KeyPress:
    case QEvent::KeyRelease:
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonRelease:
    case QEvent::MouseButtonDblClick:
    case QEvent::MouseMove:
    case QEvent::Wheel:
    case QEvent::ContextMenu:
        return true;
    default:
        return false;
    }
}

void postToTree(const Window& window, UINT message) {
    PostMessageA(window.handle(), message, 0, 0);
    for (const Window* child : window.children()) {
        postToTree(*child, message);
    }
}

/// Tells every window, once however many of them the toolkit tells. Posted, because it is going through its list of
/// widgets.
class Announcement {
public:
    explicit Announcement(UINT message) : m_message(message) {}
    void make() {
        if (std::exchange(m_isMade, true)) {
            return;
        }
        for (const Window* window : Window::topLevels()) {
            postToTree(*window, m_message);
        }
        QMetaObject::invokeMethod(qApp, [this] { m_isMade = false; }, Qt::QueuedConnection);
    }

private:
    UINT m_message;
    bool m_isMade = false;
};

/// A new style or new colours of the desktop.
void onAppearance(const QEvent& event) {
    static Announcement colors(WM_SYSCOLORCHANGE);
    static Announcement style(WM_THEMECHANGED);
    if (event.type() != QEvent::StyleChange) {
        colors.make();
    }
    style.make();
}

bool translateOther(Window& window, QObject* receiver, QEvent* event, bool& result) {
    switch (event->type()) {
    case QEvent::Paint:
        return onPaint(window, receiver, static_cast<QPaintEvent&>(*event));
    case QEvent::Close:
        return receiver == window.widget() && window.widget()->isWindow() && onCloseRequest(window, *event);
    case QEvent::StyleChange:
    case QEvent::ApplicationPaletteChange:
        if (receiver == window.widget() && window.widget()->isWindow()) {
            onAppearance(*event);
        }
        return false;
    case QEvent::DragEnter:
    case QEvent::DragMove:
    case QEvent::Drop:
        return translateDrop(window, *event);
    case QEvent::InputMethod:
        return onInputMethod(window, receiver, static_cast<QInputMethodEvent&>(*event));
    case QEvent::Move:
    case QEvent::Resize:
    case QEvent::WindowStateChange:
    case QEvent::WindowActivate:
    case QEvent::WindowDeactivate:
    case QEvent::FocusIn:
    case QEvent::FocusOut:
    case QEvent::Leave:
        return onAfterwards(window, receiver, *event, result);
    default:
        return false;
    }
}

/// The time of the key that was watched last, in milliseconds of the display's clock.
quint64 watchedLast = 0;

/// Whether a press was watched when the toolkit asked for short-cuts. What that question led to, such as a command's
/// dialog, may have heard of later keys since, and of this one's release.
bool wasWatched(const QKeyEvent& press) {
    return press.timestamp() != 0 && static_cast<qint32>(press.timestamp() - watchedLast) <= 0;
}

/// Keys are watched wherever they go: one released in a menu or a dialog of the toolkit's is not down any more.
void watchKeys(const QEvent& event) {
    const bool asks = event.type() == QEvent::ShortcutOverride;
    const bool release = event.type() == QEvent::KeyRelease;
    if (!event.spontaneous() || (!asks && !release && event.type() != QEvent::KeyPress)) {
        return;
    }
    const auto& key = static_cast<const QKeyEvent&>(event);
    if (!asks) {
        noteTime(key);
    }
    if (event.type() == QEvent::KeyPress && wasWatched(key)) {
        return;
    }
    watchedLast = key.timestamp();
    // The toolkit drops the release of a key whose press opened a modal dialog when it comes before that has the
    // keyboard, and a press in another program's window is never seen; later keys tell of modifiers.
    const bool isModifier = (key.key() >= Qt::Key_Shift && key.key() <= Qt::Key_Alt) || key.key() == Qt::Key_AltGr;
    for (const auto& [flag, modifier] :
         {std::pair(Qt::ShiftModifier, VK_SHIFT), std::pair(Qt::ControlModifier, VK_CONTROL),
          std::pair(Qt::AltModifier, VK_MENU), std::pair(Qt::GroupSwitchModifier, VK_RMENU)}) {
        if (!isModifier) {
            noteKey(modifier, key.modifiers().testFlag(flag));
        }
    }
    if (!release || !key.isAutoRepeat()) {
        noteKey(virtualKey(key), !release);
    }
}

} // namespace

void paintFrame(Window& window, EventSource* source) {
    const HWND handle = window.handle();
    WindowSurface& surface = WindowSurface::of(*window.widget());
    const bool outer = std::exchange(window.inFramePaint, true);
    surface.beginPaint();
    dispatch(makeMessage(handle, WM_NCPAINT, 1, 0), source);
    surface.endPaint();
    if (Window* still = Window::from(handle)) {
        still->inFramePaint = outer;
    }
}

bool translateEvent(QObject* receiver, QEvent* event, bool& result) {
    if (takePassing(event) || ExceptionCarrier::isPending()) {
        return false;
    }
    if (event->type() == QEvent::ApplicationStateChange) {
        forgetKeys();
        if (QGuiApplication::applicationState() != Qt::ApplicationActive) {
            leaveHelpMode();
        }
        return false;
    }
    watchKeys(*event);
    if (!receiver->isWidgetType()) {
        return false;
    }
    repaintBrokenEdges(*static_cast<QWidget*>(receiver), *event);
    const bool input = isInput(event->type());
    // The toolkit forwards wheel and key events between widgets by sending them again; only the user's count. An
    // open menu or drop-down list has all input to itself.
    if (input && (!event->spontaneous() || QApplication::activePopupWidget())) {
        return false;
    }
    Window* window = Window::of(receiver);
    if (!window || window->isDestroyed()) {
        return false;
    }
    if (input && helpModeTakes(*window, *receiver, *event)) {
        result = true;
        return true;
    }
    return input ? translateInput(*window, receiver, event) : translateOther(*window, receiver, event, result);
}

} // namespace tvx::afx
