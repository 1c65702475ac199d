#include "platform/afx/core/WindowCalls.h"

#include "platform/afx/core/detail/BrokenPixels.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/detail/GdiObjects.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/Text.h"
#include "platform/win/Error.h"

#include <QApplication>
#include <QScreen>

#include <cstring>

using namespace tvx::afx;

namespace {

/// The number that stands for the screen's own window; no window gets it.
HWND desktopHandle() {
    return reinterpret_cast<HWND>(static_cast<std::uintptr_t>(0x00010010));
}

QRect screenArea() {
    return ensureGui() ? QGuiApplication::primaryScreen()->geometry() : QRect();
}

Window* windowOrError(HWND handle) {
    Window* window = Window::from(handle);
    if (!window) {
        SetLastError(ERROR_INVALID_WINDOW_HANDLE);
    }
    return window;
}

HWND handleOf(const Window* window) {
    return window ? window->handle() : nullptr;
}

} // namespace

BOOL DestroyWindow(HWND handle) {
    Window* window = windowOrError(handle);
    if (!window || window->isDestroyed()) {
        return FALSE;
    }
    window->destroy();
    return TRUE;
}

// --- the tree of windows ---

HWND SetParent(HWND handle, HWND parent) {
    Window* window = windowOrError(handle);
    if (!window || (parent && !windowOrError(parent))) {
        return nullptr;
    }
    const HWND previous = handleOf(window->parent());
    window->setParent(Window::from(parent));
    return previous;
}

HWND GetWindow(HWND handle, UINT relation) {
    const Window* window = windowOrError(handle);
    if (!window) {
        return nullptr;
    }
    if (relation == GW_OWNER) {
        return handleOf(window->owner());
    }
    if (relation == GW_CHILD) {
        return window->children().empty() ? nullptr : window->children().front()->handle();
    }
    const auto& siblings = window->parent() ? window->parent()->children() : Window::topLevels();
    const auto place = std::find(siblings.begin(), siblings.end(), window);
    switch (relation) {
    case GW_HWNDFIRST:
        return siblings.front()->handle();
    case GW_HWNDLAST:
        return siblings.back()->handle();
    case GW_HWNDNEXT:
        return std::next(place) != siblings.end() ? (*std::next(place))->handle() : nullptr;
    case GW_HWNDPREV:
        return place != siblings.begin() ? (*std::prev(place))->handle() : nullptr;
    default:
        return nullptr;
    }
}

HWND GetTopWindow(HWND handle) {
    return GetWindow(handle, GW_CHILD);
}

HWND GetDlgItem(HWND handle, int id) {
    const Window* window = windowOrError(handle);
    return window ? handleOf(window->child(id)) : nullptr;
}

int GetDlgCtrlID(HWND handle) {
    const Window* window = windowOrError(handle);
    return window ? window->id() : 0;
}

BOOL IsChild(HWND parent, HWND handle) {
    const Window* window = Window::from(handle);
    while (window && window->isChild()) {
        window = window->parent();
        if (handleOf(window) == parent) {
            return TRUE;
        }
    }
    return FALSE;
}

namespace {

BOOL tellDescendants(const Window& parent, WNDENUMPROC callback, LPARAM param) {
    std::vector<HWND> handles;
    handles.reserve(parent.children().size());
    for (const Window* window : parent.children()) {
        handles.push_back(window->handle());
    }
    // The callback may end any of them.
    for (const HWND handle : handles) {
        if (!Window::from(handle)) {
            continue;
        }
        if (!callback(handle, param)) {
            return FALSE;
        }
        const Window* window = Window::from(handle);
        if (window && !tellDescendants(*window, callback, param)) {
            return FALSE;
        }
    }
    return TRUE;
}

} // namespace

BOOL EnumChildWindows(HWND parent, WNDENUMPROC callback, LPARAM param) {
    const Window* window = windowOrError(parent);
    return window ? tellDescendants(*window, callback, param) : FALSE;
}

HWND GetDesktopWindow() {
    return desktopHandle();
}

HWND FindWindowA(LPCSTR className, LPCSTR text) {
    for (const Window* window : Window::topLevels()) {
        const bool sameClass = !className || tvx::text::equalNoCase(window->className(), className);
        if (sameClass && (!text || fromQt(window->text()) == text)) {
            return window->handle();
        }
    }
    return nullptr;
}

HWND WindowFromPoint(POINT point) {
    const QWidget* widget = ensureGui() ? QApplication::widgetAt(toQt(point)) : nullptr;
    return handleOf(Window::of(widget));
}

HWND ChildWindowFromPoint(HWND parent, POINT point) {
    const Window* window = windowOrError(parent);
    if (!window || !QRect(QPoint(), window->clientRect().size()).contains(toQt(point))) {
        return nullptr;
    }
    for (const Window* child : window->children()) {
        if (child->windowRect().contains(toQt(point))) {
            return child->handle();
        }
    }
    return parent;
}

// --- state ---

BOOL IsWindowVisible(HWND handle) {
    const Window* window = Window::from(handle);
    return window && window->isVisible() ? TRUE : FALSE;
}

BOOL IsWindowEnabled(HWND handle) {
    const Window* window = Window::from(handle);
    return window && window->isEnabled() ? TRUE : FALSE;
}

BOOL EnableWindow(HWND handle, BOOL enable) {
    Window* window = windowOrError(handle);
    if (!window) {
        return FALSE;
    }
    const bool wasDisabled = !window->isEnabled();
    // WM_ENABLE tells of changes only.
    if (wasDisabled == (enable != FALSE)) {
        window->setEnabled(enable != FALSE);
    }
    return wasDisabled ? TRUE : FALSE;
}

LONG_PTR GetWindowLongPtrA(HWND handle, int index) {
    const Window* window = windowOrError(handle);
    if (!window) {
        return 0;
    }
    switch (index) {
    case GWL_STYLE:
        return static_cast<LONG_PTR>(window->style());
    case GWL_EXSTYLE:
        return static_cast<LONG_PTR>(window->exStyle());
    case GWL_ID:
        return window->id();
    case GWL_USERDATA:
        return window->userData;
    default:
        return 0;
    }
}

LONG_PTR SetWindowLongPtrA(HWND handle, int index, LONG_PTR value) {
    const LONG_PTR previous = GetWindowLongPtrA(handle, index);
    Window* window = Window::from(handle);
    if (!window) {
        return 0;
    }
    switch (index) {
    case GWL_STYLE:
        window->setStyle(static_cast<DWORD>(value), window->exStyle());
        break;
    case GWL_EXSTYLE:
        window->setStyle(window->style(), static_cast<DWORD>(value));
        break;
    case GWL_ID:
        window->setId(static_cast<int>(value));
        break;
    case GWL_USERDATA:
        window->userData = value;
        break;
    default:
        break;
    }
    return previous;
}

// --- text ---

BOOL SetWindowTextA(HWND handle, LPCSTR text) {
    if (!windowOrError(handle)) {
        return FALSE;
    }
    return SendMessageA(handle, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(text ? text : "")) != 0 ? TRUE : FALSE;
}

int GetWindowTextA(HWND handle, LPSTR buffer, int size) {
    if (size <= 0 || !windowOrError(handle)) {
        return 0;
    }
    return static_cast<int>(
        SendMessageA(handle, WM_GETTEXT, static_cast<WPARAM>(size), reinterpret_cast<LPARAM>(buffer)));
}

int GetWindowTextLengthA(HWND handle) {
    return static_cast<int>(SendMessageA(handle, WM_GETTEXTLENGTH, 0, 0));
}

// --- place and size ---

BOOL MoveWindow(HWND handle, int x, int y, int width, int height, BOOL repaint) {
    return SetWindowPos(handle, nullptr, x, y, width, height, SWP_NOZORDER | SWP_NOACTIVATE);
}

namespace {

void placeInOrder(Window& window, HWND after) {
    if (after == HWND_TOPMOST || after == HWND_NOTOPMOST) {
        const DWORD topmost = after == HWND_TOPMOST ? DWORD{WS_EX_TOPMOST} : 0;
        window.setStyle(window.style(), (window.exStyle() & ~DWORD{WS_EX_TOPMOST}) | topmost);
        return;
    }
    if (after == HWND_BOTTOM) {
        window.widget()->lower();
    } else if (const Window* other = Window::from(after); other && !window.widget()->isWindow()) {
        window.widget()->stackUnder(other->widget());
        window.placeAfter(Window::from(after));
    } else {
        window.widget()->raise();
    }
}

} // namespace

BOOL SetWindowPos(HWND handle, HWND after, int x, int y, int cx, int cy, UINT flags) {
    Window* window = windowOrError(handle);
    if (!window || !window->widget()) {
        return FALSE;
    }
    const QRect current = window->windowRect();
    const QPoint place = (flags & SWP_NOMOVE) != 0 ? current.topLeft() : QPoint(x, y);
    const QSize size = (flags & SWP_NOSIZE) != 0 ? current.size() : QSize(cx, cy).expandedTo(QSize(0, 0));
    guarded([&] {
        if (QRect(place, size) != current) {
            window->setWindowRect(QRect(place, size));
        }
        if ((flags & SWP_NOZORDER) == 0) {
            placeInOrder(*window, after);
        }
    });
    if (Window::from(handle)) {
        window->tellGeometry();
    }
    const bool activate = (flags & SWP_NOACTIVATE) == 0;
    if ((flags & SWP_SHOWWINDOW) != 0) {
        ShowWindow(handle, activate ? SW_SHOW : SW_SHOWNA);
    } else if ((flags & SWP_HIDEWINDOW) != 0) {
        ShowWindow(handle, SW_HIDE);
    }
    return TRUE;
}

BOOL BringWindowToTop(HWND handle) {
    return SetWindowPos(handle, HWND_TOP, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE);
}

BOOL GetWindowRect(HWND handle, RECT* rect) {
    if (handle == desktopHandle()) {
        *rect = fromQt(screenArea());
        return TRUE;
    }
    const Window* window = windowOrError(handle);
    if (!window) {
        return FALSE;
    }
    *rect = fromQt(window->screenRect());
    return TRUE;
}

BOOL GetClientRect(HWND handle, RECT* rect) {
    if (handle == desktopHandle()) {
        *rect = fromQt(screenArea());
        return TRUE;
    }
    const Window* window = windowOrError(handle);
    if (!window) {
        return FALSE;
    }
    const QSize size = window->clientRect().size();
    *rect = {0, 0, size.width(), size.height()};
    return TRUE;
}

BOOL GetWindowPlacement(HWND handle, WINDOWPLACEMENT* placement) {
    const Window* window = windowOrError(handle);
    if (!window || !window->widget()) {
        return FALSE;
    }
    const QWidget& widget = *window->widget();
    *placement = {};
    placement->length = sizeof(WINDOWPLACEMENT);
    placement->ptMinPosition = placement->ptMaxPosition = {-1, -1};
    placement->showCmd = SW_SHOWNORMAL;
    const Placement* place = window->placement();
    if (place && widget.isMinimized()) {
        placement->showCmd = SW_SHOWMINIMIZED;
        placement->flags = widget.isMaximized() ? WPF_RESTORETOMAXIMIZED : 0;
    } else if (place && widget.isMaximized()) {
        placement->showCmd = SW_SHOWMAXIMIZED;
    }
    placement->rcNormalPosition = fromQt(place ? place->restored() : window->windowRect());
    return TRUE;
}

namespace {

/// A rectangle that a window can have, whatever a damaged record says.
QRect usableRect(const RECT& rect) {
    static constexpr int farthest = 30000;
    const auto near = [](int at) { return std::clamp(at, -farthest, farthest); };
    const QPoint corner(near(rect.left), near(rect.top));
    return {corner, QSize(near(rect.right) - corner.x(), near(rect.bottom) - corner.y()).expandedTo({1, 1})};
}

void setRestoredRect(Window& window, const QRect& rect) {
    Placement* place = window.placement();
    if (place && window.widget()->isWindow()) {
        place->setRestored(reachableFrame(rect));
        return;
    }
    if (window.widget()->isMaximized() || window.widget()->isMinimized()) {
        window.widget()->showNormal();
    }
    window.setWindowRect(rect);
}

} // namespace

BOOL SetWindowPlacement(HWND handle, const WINDOWPLACEMENT* placement) {
    Window* window = windowOrError(handle);
    if (!window || !window->widget()) {
        return FALSE;
    }
    if (placement->length != sizeof(WINDOWPLACEMENT)) {
        SetLastError(ERROR_INVALID_PARAMETER);
        return FALSE;
    }
    const bool minimized = placement->showCmd == SW_SHOWMINIMIZED || placement->showCmd == SW_MINIMIZE ||
                           placement->showCmd == SW_SHOWMINNOACTIVE;
    guarded([&] {
        setRestoredRect(*window, usableRect(placement->rcNormalPosition));
        if (minimized && window->widget()->isWindow()) {
            Qt::WindowStates states = window->widget()->windowState() | Qt::WindowMinimized;
            states.setFlag(Qt::WindowMaximized, (placement->flags & WPF_RESTORETOMAXIMIZED) != 0);
            window->widget()->setWindowState(states);
        }
    });
    if (IsWindow(handle)) {
        window->tellGeometry();
        ShowWindow(handle, static_cast<int>(placement->showCmd));
    }
    return TRUE;
}

BOOL ClientToScreen(HWND handle, POINT* point) {
    const Window* window = windowOrError(handle);
    if (!window) {
        return FALSE;
    }
    *point = fromQt(window->clientToScreen(toQt(*point)));
    return TRUE;
}

BOOL ScreenToClient(HWND handle, POINT* point) {
    const Window* window = windowOrError(handle);
    if (!window) {
        return FALSE;
    }
    *point = fromQt(window->screenToClient(toQt(*point)));
    return TRUE;
}

int MapWindowPoints(HWND from, HWND to, POINT* points, UINT count) {
    POINT offset{0, 0};
    if (from) {
        ClientToScreen(from, &offset);
    }
    if (to) {
        ScreenToClient(to, &offset);
    }
    for (UINT i = 0; i < count; ++i) {
        points[i].x += offset.x;
        points[i].y += offset.y;
    }
    return MAKELONG(offset.x, offset.y);
}

// --- painting ---

namespace {

/// The part of the client area that is to be repainted, in the client widget's coordinates. A region counts before a
/// rectangle.
QRegion partToRepaint(const Window& window, const RECT* rect, HRGN region) {
    const QRect area = window.clientRect();
    if (const auto found = findTool<RegionObject>(region)) {
        return found->region.translated(area.topLeft()) & area;
    }
    return rect ? toQt(*rect).translated(area.topLeft()) & area : area;
}

} // namespace

BOOL RedrawWindow(HWND handle, const RECT* rect, HRGN region, UINT flags) {
    Window* window = windowOrError(handle);
    QWidget* client = peerOf(handle);
    if (!window || !client) {
        return FALSE;
    }
    const QRegion part = withBrokenPixels(*client, partToRepaint(*window, rect, region)) & client->rect();
    guarded([&] {
        if ((flags & RDW_INVALIDATE) != 0) {
            client->update(part);
        }
        if ((flags & RDW_ALLCHILDREN) != 0 && (flags & RDW_INVALIDATE) != 0) {
            for (const Window* child : window->children()) {
                child->clientWidget()->update();
            }
        }
        if ((flags & (RDW_UPDATENOW | RDW_ERASENOW)) != 0) {
            client->repaint(part);
        }
    });
    return TRUE;
}

BOOL InvalidateRect(HWND handle, const RECT* rect, BOOL erase) {
    return RedrawWindow(handle, rect, nullptr, RDW_INVALIDATE | (erase ? RDW_ERASE : 0U));
}

BOOL UpdateWindow(HWND handle) {
    const Window* window = windowOrError(handle);
    if (!window || !window->widget()) {
        return FALSE;
    }
    // The toolkit keeps what is to be repainted per top-level widget and paints it all at this request.
    QWidget* top = window->widget()->window();
    guarded([top] {
        QEvent request(QEvent::UpdateRequest);
        QCoreApplication::sendEvent(top, &request);
    });
    return TRUE;
}

// --- activation ---

HWND GetActiveWindow() {
    return QCoreApplication::instance() ? handleOf(Window::of(QApplication::activeWindow())) : nullptr;
}

HWND SetActiveWindow(HWND handle) {
    const HWND previous = GetActiveWindow();
    Window* window = windowOrError(handle);
    if (window && window->topLevel()->widget()) {
        guarded([window] { window->topLevel()->widget()->activateWindow(); });
    }
    return previous;
}
