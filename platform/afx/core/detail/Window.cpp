#include "platform/afx/core/detail/Window.h"

#include "platform/afx/core/Wnd.h"
#include "platform/afx/core/detail/Caption.h"
#include "platform/afx/core/detail/Capture.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/FrameButton.h"
#include "platform/afx/core/detail/HandleWatches.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/MessageQueue.h"
#include "platform/afx/core/detail/PlainWindow.h"
#include "platform/afx/core/detail/Timers.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/Text.h"
#include "platform/win/Error.h"

#include <QApplication>

#include <algorithm>
#include <atomic>
#include <map>
#include <unordered_map>

namespace tvx::afx {

namespace {

struct Tables {
    std::unordered_map<std::uintptr_t, Window*> byHandle;
    std::unordered_map<const QObject*, Window*> byWidget;
    std::vector<Window*> topLevels;
    std::uintptr_t nextHandle = 0x80000000U;
};

Tables& tables() {
    static auto* instance = new Tables;
    return *instance;
}

std::map<std::string, WindowClass, text::LessNoCase>& classes() {
    static auto* instance = new std::map<std::string, WindowClass, text::LessNoCase>;
    return *instance;
}

/// Under X11 a top-level window's handle is its X id, so that it means the same window to other processes.
HWND newHandle(const QWidget& widget, bool topLevel) {
    if (topLevel && QGuiApplication::platformName() == QLatin1String("xcb")) {
        return reinterpret_cast<HWND>(const_cast<QWidget&>(widget).winId());
    }
    // X ids have 29 bits: none of theirs is as large as one of ours.
    auto& next = tables().nextHandle;
    while (tables().byHandle.contains(next)) {
        ++next;
    }
    const auto handle = next++;
    if (next > 0xFFFFFFFFU) {
        next = 0x80000000U;
    }
    return reinterpret_cast<HWND>(handle);
}

} // namespace

void addWindowClass(WindowClass windowClass) {
    std::string name = windowClass.name;
    classes().insert_or_assign(std::move(name), std::move(windowClass));
}

const WindowClass* findWindowClass(const char* name) {
    const auto found = classes().find(name);
    return found != classes().end() ? &found->second : nullptr;
}

QString toQt(const char* text) {
    const std::string_view bytes = text ? text : "";
    // Bytes that are no UTF-8 come back from the toolkit as they were given.
    return text::isWellFormed(bytes) ? QString::fromUtf8(bytes.data(), static_cast<qsizetype>(bytes.size()))
                                     : QString::fromStdU16String(text::widen16(bytes));
}

std::string fromQt(const QString& text) {
    return text.isValidUtf16() ? text.toStdString() : text::narrow(std::u16string_view(text.toStdU16String()));
}

QWidget* peerOf(HWND handle) {
    const Window* window = Window::from(handle);
    return window ? window->clientWidget() : nullptr;
}

// --- creation ---

Window::Window(const CREATESTRUCT& cs)
    : m_style(static_cast<DWORD>(cs.style)),
      m_exStyle(cs.dwExStyle),
      m_className(IS_INTRESOURCE(cs.lpszClass) ? "" : cs.lpszClass),
      m_text(toQt(cs.lpszName)) {
    Window* other = from(cs.hwndParent);
    if (isChild()) {
        m_parent = other;
        m_id = static_cast<int>(reinterpret_cast<std::intptr_t>(cs.hMenu));
    } else if (other) {
        m_owner = other->topLevel();
    }
}

Window::~Window() = default;

void Window::realize(const CREATESTRUCT& cs) {
    m_widget = makeWidget(m_parent ? m_parent->childHost() : nullptr);
    if (!m_widget->isWindow()) {
        m_widget->hide(); // else it would come up with its parent
    }
    keepPlace();
    m_handle = newHandle(*m_widget, !isChild());
    tables().byHandle[reinterpret_cast<std::uintptr_t>(m_handle)] = this;
    tables().byWidget[m_widget] = this;
    if (m_parent) {
        m_parent->m_children.push_back(this);
    } else {
        tables().topLevels.push_back(this);
    }
    if ((m_style & WS_DISABLED) != 0) {
        m_widget->setEnabled(false);
    }
    const QRect current = windowRect();
    const bool ownPlace = cs.x != CW_USEDEFAULT;
    const bool ownSize = cs.cx != CW_USEDEFAULT;
    const QPoint place = ownPlace ? QPoint(cs.x, cs.y) : current.topLeft();
    const QSize size = ownSize ? QSize(cs.cx, cs.cy) : current.size();
    if (isChild() || ownPlace) {
        setWindowRect(QRect(place, size));
    } else if (ownSize) {
        m_widget->resize(size); // the place is left to the desktop
    }
    widgetMade();
}

void Window::keepPlace() {
    const bool moves = m_widget->isWindow() || m_widget->windowType() == Qt::SubWindow;
    m_placement = moves ? std::make_unique<Placement>(*this) : nullptr;
}

void Window::widgetMade() {}

bool Window::start(const CREATESTRUCT& cs) {
    const HWND handle = m_handle;
    const auto parameter = reinterpret_cast<LPARAM>(&cs);
    if (call(WM_CREATE, 0, parameter) == -1) {
        if (from(handle)) {
            destroy();
        }
        return false;
    }
    if (from(handle)) {
        m_creating = false;
        tellGeometry();
    }
    // Not before WM_CREATE was handled: that is where hosts make the children.
    if (from(handle) && (m_style & WS_VISIBLE) != 0) {
        show((m_style & WS_MAXIMIZE) != 0 ? SW_SHOWMAXIMIZED : SW_SHOW);
    }
    return from(handle) != nullptr;
}

HWND createWindow(const CREATESTRUCT& cs, CWnd* object, bool* stood) {
    const WindowClass* windowClass = findWindowClass(cs.lpszClass);
    if (windowClass && !ensureGui()) {
        tellMissingDisplay();
    }
    if (!windowClass || !ensureGui()) {
        SetLastError(!windowClass ? ERROR_CANNOT_FIND_WND_CLASS : ERROR_INVALID_WINDOW_HANDLE);
        return nullptr;
    }
    if ((cs.style & WS_CHILD) != 0 && !Window::from(cs.hwndParent)) {
        SetLastError(ERROR_INVALID_WINDOW_HANDLE);
        return nullptr;
    }
    const WindowFactory factory = windowClass->factory ? windowClass->factory : &makePlainWindow;
    Window* window = factory(cs).release();
    window->classCursor = windowClass->cursor;
    window->classBrush = windowClass->background;
    window->bigIcon = windowClass->icon;
    guarded([&] { window->realize(cs); });
    if (object) {
        object->PreSubclassWindow();
        object->Attach(window->handle());
    }
    if (stood) {
        *stood = true;
    }
    const HWND handle = window->handle();
    return window->start(cs) ? handle : nullptr;
}

// --- tables ---

namespace {

/// The window looked for last: messages come in rows to one.
constinit std::atomic<Window*> foundLast = nullptr;

} // namespace

Window* Window::from(HWND handle) {
    Window* last = foundLast.load(std::memory_order_relaxed);
    if (last && last->m_handle == handle) {
        return last;
    }
    const auto& table = tables().byHandle;
    const auto found = table.find(reinterpret_cast<std::uintptr_t>(handle));
    if (found == table.end()) {
        return nullptr;
    }
    foundLast.store(found->second, std::memory_order_relaxed);
    return found->second;
}

Window* Window::of(const QObject* object) {
    const auto& table = tables().byWidget;
    while (object && object->isWidgetType()) {
        const auto found = table.find(object);
        if (found != table.end()) {
            return found->second;
        }
        // A menu or a tool tip belongs to a widget without being a part of its window.
        if (static_cast<const QWidget*>(object)->isWindow()) {
            break;
        }
        object = object->parent();
    }
    return nullptr;
}

const std::vector<Window*>& Window::topLevels() {
    return tables().topLevels;
}

std::vector<HWND> Window::topLevelHandles() {
    std::vector<HWND> handles;
    handles.reserve(topLevels().size());
    std::ranges::transform(topLevels(), std::back_inserter(handles), &Window::handle);
    return handles;
}

Window* Window::topLevel() {
    Window* window = this;
    while (window->m_parent) {
        window = window->m_parent;
    }
    return window;
}

Window* Window::child(int id) const {
    const auto found =
        std::find_if(m_children.begin(), m_children.end(), [id](const Window* w) { return w->m_id == id; });
    return found != m_children.end() ? *found : nullptr;
}

void Window::placeAfter(Window* after) {
    if (!m_parent) {
        return;
    }
    auto& siblings = m_parent->m_children;
    std::erase(siblings, this);
    const auto place = std::find(siblings.begin(), siblings.end(), after);
    siblings.insert(place == siblings.end() ? siblings.begin() : std::next(place), this);
}

void Window::setParent(Window* parent) {
    if (m_parent) {
        std::erase(m_parent->m_children, this);
    } else {
        std::erase(tables().topLevels, this);
    }
    m_parent = parent;
    // The toolkit hides a widget that gets another parent and moves it into the corner.
    const bool shown = m_widget && !m_widget->isHidden();
    const QRect place = m_widget->geometry();
    guarded([&] {
        m_widget->setParent(parent ? parent->childHost() : nullptr);
        keepPlace();
        m_widget->setGeometry(place);
        m_widget->setVisible(shown);
    });
    (parent ? parent->m_children : tables().topLevels).push_back(this);
}

// --- the attached object ---

CWnd* Window::objectOrTemporary() {
    if (m_object) {
        return m_object;
    }
    if (!m_temporary) {
        m_temporary = std::make_unique<CWnd>();
        m_temporary->m_hWnd = m_handle;
    }
    return m_temporary.get();
}

void Window::attach(CWnd* object) {
    m_object = object;
}

void Window::detach() {
    m_object = nullptr;
}

void Window::dropTemporary() {
    if (m_temporary) {
        m_temporary->m_hWnd = nullptr; // its destructor must not end the window
        m_temporary.reset();
    }
}

// --- parts and state ---

QWidget* Window::clientWidget() const {
    return m_widget;
}

QRect Window::clientRect() const {
    const QWidget* client = clientWidget();
    return client ? client->rect() : QRect();
}

QWidget* Window::focusWidget() const {
    return m_widget;
}

QWidget* Window::childHost() const {
    return clientWidget();
}

void Window::setStyle(DWORD style, DWORD exStyle) {
    const DWORD oldStyle = std::exchange(m_style, style);
    const DWORD oldExStyle = std::exchange(m_exStyle, exStyle);
    if (m_widget && (oldStyle != style || oldExStyle != exStyle)) {
        styleChanged(oldStyle, oldExStyle);
    }
}

void Window::styleChanged(DWORD oldStyle, DWORD oldExStyle) {}

void Window::fontChanged() {}

void Window::iconChanged() {}

void Window::setText(const QString& text) {
    m_text = text;
    if (m_widget && m_widget->isWindow()) {
        m_widget->setWindowTitle(text);
    }
}

Window* Window::activeChildFrame() const {
    for (const Window* child : m_children) {
        if (Window* frame = child->heldChildFrame()) {
            return frame;
        }
    }
    return nullptr;
}

void Window::setMenu(HMENU menu) {}

bool Window::isEnabled() const {
    return (m_style & WS_DISABLED) == 0;
}

void Window::setEnabled(bool enabled) {
    m_style = enabled ? (m_style & ~DWORD{WS_DISABLED}) : (m_style | WS_DISABLED);
    guarded([&] { m_widget->setEnabled(enabled); });
    call(WM_ENABLE, enabled ? TRUE : FALSE);
}

int Window::hitTest(QPoint) const {
    return HTCLIENT;
}

void Window::setFrameButton(const QString& name, const QRect* place, UINT command) {
    const QRect within = place ? place->translated(wholeRect().topLeft()) : QRect();
    if (!place) {
        m_frameButton.reset();
    } else if (!m_frameButton || m_frameButton->name() != name || m_frameButton->command() != command) {
        m_frameButton = std::make_unique<FrameButton>(*this, name, command);
    }
    if (m_frameButton) {
        m_frameButton->setPlace(within);
    }
    if (Caption* own = caption()) {
        own->setButton(within);
    }
}

// --- place and size ---

QRect Window::windowRect() const {
    if (!m_widget) {
        return {};
    }
    if (m_widget->isWindow()) {
        return m_placement ? m_placement->frameRect() : m_widget->frameGeometry();
    }
    // A frame's client area begins below its menu bar, which is inside of the toolkit's widget.
    const QPoint origin = m_parent ? m_parent->clientRect().topLeft() : QPoint();
    return m_widget->geometry().translated(-origin);
}

void Window::setWindowRect(const QRect& rect) {
    if (!m_widget) {
        return;
    }
    if (m_widget->isWindow() && m_placement) {
        m_placement->moveFrame(rect, Measured::Client);
        return;
    }
    const QPoint origin = m_parent ? m_parent->clientRect().topLeft() : QPoint();
    m_widget->setGeometry(rect.translated(origin));
}

QRect Window::wholeRect() const {
    if (!m_widget) {
        return {};
    }
    const QRect screen = screenRect();
    return {m_widget->mapFromGlobal(screen.topLeft()), screen.size()};
}

QRect Window::screenRect() const {
    if (!m_widget || m_widget->isWindow()) {
        return windowRect();
    }
    return {m_widget->mapToGlobal(QPoint(0, 0)), m_widget->size()};
}

QPoint Window::clientToScreen(const QPoint& point) const {
    const QWidget* client = clientWidget();
    return client ? client->mapToGlobal(point + clientRect().topLeft()) : point;
}

QPoint Window::screenToClient(const QPoint& point) const {
    const QWidget* client = clientWidget();
    return client ? client->mapFromGlobal(point) - clientRect().topLeft() : point;
}

void Window::show(int command) {
    if (!m_widget) {
        return;
    }
    const bool visible = command != SW_HIDE;
    const bool before = !m_widget->isHidden();
    m_style = visible ? (m_style | WS_VISIBLE) : (m_style & ~DWORD{WS_VISIBLE});
    const HWND handle = m_handle;
    if (visible != before) {
        beforeShow(visible);
        call(WM_SHOWWINDOW, visible ? TRUE : FALSE);
    }
    // Handlers of messages may destroy the window.
    if (from(handle)) {
        guarded([&] { showWidget(command); });
    }
    // Frames and dialogs hear of their size when they are shown, not only when it changes.
    if (from(handle) && m_placement) {
        tellGeometry();
    }
}

void Window::beforeShow(bool) {}

void Window::showWidget(int command) {
    m_widget->setVisible(command != SW_HIDE);
}

bool Window::isVisible() const {
    for (const Window* window = this; window; window = window->m_parent) {
        if ((window->m_style & WS_VISIBLE) == 0) {
            return false;
        }
    }
    return true;
}

namespace {

UINT sizeState(const QWidget& widget) {
    if (!widget.isWindow() && widget.windowType() != Qt::SubWindow) {
        return SIZE_RESTORED;
    }
    if (widget.isMinimized()) {
        return SIZE_MINIMIZED;
    }
    return widget.isMaximized() ? SIZE_MAXIMIZED : SIZE_RESTORED;
}

} // namespace

void Window::tellGeometry() {
    if (m_placement) {
        m_placement->changed();
    }
    if (m_creating || m_destroyed || !m_widget) {
        return;
    }
    const QSize size = clientRect().size();
    const QPoint place = windowRect().topLeft();
    const UINT state = sizeState(*m_widget);
    const HWND handle = m_handle;
    const bool resized = std::exchange(m_toldSize, size) != size || std::exchange(m_toldState, state) != state;
    const bool moved = std::exchange(m_toldPlace, place) != place;
    if (resized) {
        call(WM_SIZE, state, MAKELPARAM(size.width(), size.height()));
    }
    if (moved && from(handle)) {
        call(WM_MOVE, 0, MAKELPARAM(place.x(), place.y()));
    }
}

// --- end ---

void Window::destroy() {
    if (m_destroyed) {
        return;
    }
    const HWND self = m_handle;
    // The end of one owned window may be the end of another, and of this one.
    for (const HWND handle : topLevelHandles()) {
        if (Window* window = from(handle); window && window->m_owner == this) {
            window->destroy();
        }
        if (from(self) != this) {
            return;
        }
    }
    // All are marked before any is told: a handler must not begin to destroy what goes anyway.
    markDestroyed();
    if (m_widget && !m_widget->isHidden()) {
        guarded([this] { m_widget->hide(); });
    }
    tellDestroy();
    finishDestroy();
}

void Window::markDestroyed() {
    m_destroyed = true;
    for (Window* child : m_children) {
        child->markDestroyed();
    }
}

void Window::tellDestroy() {
    call(WM_DESTROY);
    const auto children = m_children;
    for (Window* child : children) {
        child->tellDestroy();
    }
}

void Window::finishDestroy() {
    while (!m_children.empty()) {
        m_children.back()->finishDestroy();
    }
    const HWND handle = m_handle;
    forgetFocus(handle);
    forgetTimers(handle);
    forgetHandleWatches(handle);
    call(WM_NCDESTROY);
    MessageQueue::instance().forget(handle);
    unlink();
    bury(this);
}

namespace {

/// The widget lives a little longer than its window, which its signals must not reach any more.
void silence(QWidget& widget) {
    widget.blockSignals(true);
    const auto parts = widget.findChildren<QObject*>();
    for (QObject* part : parts) {
        part->blockSignals(true);
    }
}

} // namespace

void Window::unlink() {
    if (m_object) {
        m_object->m_hWnd = nullptr;
        m_object = nullptr;
    }
    dropTemporary();
    m_frameButton.reset();
    m_placement.reset();
    foundLast.store(nullptr, std::memory_order_relaxed);
    tables().byHandle.erase(reinterpret_cast<std::uintptr_t>(m_handle));
    if (m_parent) {
        std::erase(m_parent->m_children, this);
    } else {
        std::erase(tables().topLevels, this);
    }
    for (Window* window : tables().topLevels) {
        if (window->m_owner == this) {
            window->m_owner = nullptr;
        }
    }
    if (m_widget) {
        tables().byWidget.erase(m_widget);
        silence(*m_widget);
        m_widget->hide();
        // It may be the receiver of the event that is being handled.
        m_widget->deleteLater();
    }
}

} // namespace tvx::afx
