#include "platform/afx/Dc.h"

#include "platform/afx/Wnd.h"
#include "platform/afx/detail/DeviceContext.h"
#include "platform/afx/detail/Window.h"
#include "platform/afx/detail/WindowSurface.h"
#include "platform/base/Exception.h"
#include "platform/win/Error.h"

// Contexts of windows: what GetDC, BeginPaint and the classes over them open.

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CClientDC, CDC)
IMPLEMENT_DYNAMIC(CWindowDC, CDC)
IMPLEMENT_DYNAMIC(CPaintDC, CDC)

namespace {

HDC screenContext() {
    return addContext(std::make_shared<DeviceContext>(DcKind::screen, std::make_unique<ScreenTarget>()));
}

HDC windowContext(HWND handle, WindowPart part) {
    const Window* window = Window::from(handle);
    QWidget* widget = nullptr;
    if (window != nullptr) {
        widget = part == WindowPart::client ? window->clientWidget() : window->widget();
    }
    if (widget == nullptr) {
        SetLastError(ERROR_INVALID_WINDOW_HANDLE);
        return nullptr;
    }
    auto area = [handle, part] {
        const Window* current = Window::from(handle);
        if (current == nullptr || current->widget() == nullptr) {
            return QRect();
        }
        return part == WindowPart::client ? current->clientRect() : current->widget()->rect();
    };
    auto context =
        std::make_shared<DeviceContext>(DcKind::window, std::make_unique<WindowTarget>(*widget, part, std::move(area)));
    context->window = handle;
    return addContext(std::move(context));
}

/// A pointer to a window object that must have a window; null stands for the screen.
HWND handleOf(const CWnd* window) {
    return window != nullptr ? window->m_hWnd : nullptr;
}

} // namespace

HDC GetDC(HWND window) {
    return window != nullptr ? windowContext(window, WindowPart::client) : screenContext();
}

HDC GetWindowDC(HWND window) {
    return window != nullptr ? windowContext(window, WindowPart::whole) : screenContext();
}

int ReleaseDC(HWND, HDC dc) {
    const auto context = findContext(dc);
    const bool releasable = context && (context->kind == DcKind::window || context->kind == DcKind::screen);
    return releasable && removeContext(dc) ? 1 : 0;
}

HDC BeginPaint(HWND handle, PAINTSTRUCT* paint) {
    *paint = {};
    Window* window = Window::from(handle);
    QWidget* client = window != nullptr ? window->clientWidget() : nullptr;
    if (client == nullptr) {
        SetLastError(ERROR_INVALID_WINDOW_HANDLE);
        return nullptr;
    }
    auto area = [handle] {
        const Window* current = Window::from(handle);
        return current != nullptr ? current->clientRect() : QRect();
    };
    const QRegion update = window->paintRegion.translated(window->clientRect().topLeft());
    auto context =
        std::make_shared<DeviceContext>(DcKind::paint, std::make_unique<PaintTarget>(*client, update, std::move(area)));
    context->window = handle;
    paint->hdc = addContext(std::move(context));
    paint->rcPaint = fromQt(window->paintRegion.boundingRect());
    paint->fErase = SendMessageA(handle, WM_ERASEBKGND, reinterpret_cast<WPARAM>(paint->hdc), 0) == 0 ? TRUE : FALSE;
    return paint->hdc;
}

BOOL EndPaint(HWND, const PAINTSTRUCT* paint) {
    return removeContext(paint->hdc) ? TRUE : FALSE;
}

CClientDC::CClientDC(CWnd* window) : m_hWnd(handleOf(window)) {
    if (!Attach(window != nullptr && m_hWnd == nullptr ? nullptr : ::GetDC(m_hWnd))) {
        AfxThrowResourceException();
    }
}

CClientDC::~CClientDC() {
    ::ReleaseDC(m_hWnd, Detach());
}

CWindowDC::CWindowDC(CWnd* window) : m_hWnd(handleOf(window)) {
    if (!Attach(window != nullptr && m_hWnd == nullptr ? nullptr : ::GetWindowDC(m_hWnd))) {
        AfxThrowResourceException();
    }
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
