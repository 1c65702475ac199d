#include "platform/afx/core/detail/Capture.h"

#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"

#include <QApplication>

namespace tvx::afx {

namespace {

HWND capturing = nullptr;
HWND focusTold = nullptr;

HWND focusNow() {
    const Window* window = Window::of(QApplication::focusWidget());
    return window ? window->handle() : nullptr;
}

} // namespace

HWND captureWindow() {
    return capturing;
}

void tellFocus(Window& window, bool got) {
    const HWND handle = window.handle();
    if (got && focusTold != handle) {
        const HWND previous = std::exchange(focusTold, handle);
        SendMessageA(handle, WM_SETFOCUS, reinterpret_cast<WPARAM>(previous), 0);
        // The keyboard may go from one part of a control to another: the window has it all the while.
    } else if (!got && focusTold == handle && focusNow() != handle) {
        focusTold = nullptr;
        SendMessageA(handle, WM_KILLFOCUS, reinterpret_cast<WPARAM>(focusNow()), 0);
    }
}

void cancelModes() {
    while (QWidget* popup = QApplication::activePopupWidget()) {
        guarded([popup] { popup->close(); });
        // One that refuses to close must not keep this going for ever.
        if (QApplication::activePopupWidget() == popup) {
            break;
        }
    }
    ReleaseCapture();
}

void forgetFocus(HWND window) {
    if (capturing == window) {
        capturing = nullptr;
    }
    if (focusTold == window) {
        focusTold = nullptr;
    }
}

} // namespace tvx::afx

using namespace tvx::afx;

HWND GetCapture() {
    return capturing;
}

HWND SetCapture(HWND window) {
    const HWND previous = capturing;
    if (Window::from(window)) {
        capturing = window;
        if (previous && previous != window) {
            SendMessageA(previous, WM_CAPTURECHANGED, 0, reinterpret_cast<LPARAM>(window));
        }
    }
    return previous;
}

BOOL ReleaseCapture() {
    if (const HWND previous = std::exchange(capturing, nullptr)) {
        SendMessageA(previous, WM_CAPTURECHANGED, 0, 0);
    }
    return TRUE;
}

HWND GetFocus() {
    return QCoreApplication::instance() ? focusNow() : nullptr;
}

HWND SetFocus(HWND handle) {
    const HWND previous = GetFocus();
    Window* window = Window::from(handle);
    if (window && window->widget()) {
        guarded([window] { window->focusWidget()->setFocus(Qt::OtherFocusReason); });
    } else if (!handle && QCoreApplication::instance()) {
        if (QWidget* focused = QApplication::focusWidget()) {
            guarded([focused] { focused->clearFocus(); });
        }
    }
    return previous;
}
