#include "platform/afx/gdi/Dc.h"

#include "platform/afx/core/Wnd.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/core/detail/WindowSurface.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/base/Exception.h"
#include "platform/win/Error.h"

// Contexts of windows: what GetDC, BeginPaint and the classes over them open.

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CClientDC, CDC)
IMPLEMENT_DYNAMIC(CWindowDC, CDC)
IMPLEMENT_DYNAMIC(CPaintDC, CDC)

namespace {

HDC screenContext() {
    return addContext(std::make_shared<DeviceContext>(DcKind::Screen, std::make_unique<ScreenTarget>()));
}

/// The client area of a window in its client widget; empty when the window is gone.
QRect clientArea(HWND handle) {
    const Window* window = Window::from(handle);
    return window ? window->clientRect() : QRect();
}

QRect wholeArea(HWND handle) {
    const Window* window = Window::from(handle);
    return window ? window->wholeRect() : QRect();
}

HDC addWindowContext(HWND window, DcKind kind, std::unique_ptr<DrawTarget> target) {
    auto context = std::make_shared<DeviceContext>(kind, std::move(target));
    context->window = window;
    return addContext(std::move(context));
}

HDC windowContext(HWND handle, WindowPart part) {
    const Window* window = Window::from(handle);
    const bool client = part == WindowPart::Client;
    QWidget* widget = !window ? nullptr : client ? window->clientWidget() : window->widget();
    if (!widget) {
        SetLastError(ERROR_INVALID_WINDOW_HANDLE);
        return nullptr;
    }
    const auto area = [handle, client] { return client ? clientArea(handle) : wholeArea(handle); };
    return addWindowContext(handle, DcKind::Window, std::make_unique<WindowTarget>(*widget, part, area));
}

/// The handle of a window object; null for no object, which stands for the screen. Raises CResourceException when the
/// object has no window.
HWND handleOf(const CWnd* window) {
    if (!window) {
        return nullptr;
    }
    if (!Window::from(window->m_hWnd)) {
        AfxThrowResourceException();
    }
    return window->m_hWnd;
}

} // namespace

HDC GetDC(HWND window) {
    return window ? windowContext(window, WindowPart::Client) : screenContext();
}

HDC GetWindowDC(HWND window) {
    return window ? windowContext(window, WindowPart::Whole) : screenContext();
}

int ReleaseDC(HWND, HDC dc) {
    const auto context = findContext(dc);
    const bool releasable = context && (context->kind == DcKind::Window || context->kind == DcKind::Screen);
    return releasable && removeContext(dc) ? 1 : 0;
}

HDC BeginPaint(HWND handle, PAINTSTRUCT* paint) {
    Window* window = Window::from(handle);
    if (!window || !window->clientWidget() || !paint) {
        SetLastError(ERROR_INVALID_WINDOW_HANDLE);
        return nullptr;
    }
    const QRegion update = window->inPaint ? window->paintRegion : QRegion();
    auto target =
        std::make_unique<PaintTarget>(*window->clientWidget(), update.translated(window->clientRect().topLeft()),
                                      [handle] { return clientArea(handle); });
    *paint = {};
    paint->hdc = addWindowContext(handle, DcKind::Paint, std::move(target));
    paint->rcPaint = fromQt(update.boundingRect());
    if (!update.isEmpty()) {
        paint->fErase = window->call(WM_ERASEBKGND, reinterpret_cast<WPARAM>(paint->hdc)) == 0;
    }
    return paint->hdc;
}

BOOL EndPaint(HWND, const PAINTSTRUCT* paint) {
    const auto context = findContext(paint ? paint->hdc : nullptr);
    return context && context->kind == DcKind::Paint && removeContext(paint->hdc);
}

CClientDC::CClientDC(CWnd* window) : m_hWnd(handleOf(window)) {
    Attach(::GetDC(m_hWnd));
}

CClientDC::~CClientDC() {
    ::ReleaseDC(m_hWnd, Detach());
}

CWindowDC::CWindowDC(CWnd* window) : m_hWnd(handleOf(window)) {
    Attach(::GetWindowDC(m_hWnd));
}

CWindowDC::~CWindowDC() {
    ::ReleaseDC(m_hWnd, Detach());
}

CPaintDC::CPaintDC(CWnd* window) : m_hWnd(handleOf(window)) {
    if (!Attach(::BeginPaint(m_hWnd, &m_ps))) {
        AfxThrowResourceException();
    }
}

CPaintDC::~CPaintDC() {
    Detach();
    ::EndPaint(m_hWnd, &m_ps);
}

namespace tvx::afx {

CDC* contextOf(HDC handle) {
    return CDC::FromHandle(handle);
}

} // namespace tvx::afx
