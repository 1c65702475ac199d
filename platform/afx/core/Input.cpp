#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Cursors.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/win/Error.h"

#include <QApplication>
#include <QCursor>

#include <array>

namespace tvx::afx {

namespace {

struct NamedCursor {
    int id;
    Qt::CursorShape shape;
};

constexpr std::array<NamedCursor, 13> systemCursors{{
    {32512, Qt::ArrowCursor},
    {32513, Qt::IBeamCursor},
    {32514, Qt::WaitCursor},
    {32515, Qt::CrossCursor},
    {32642, Qt::SizeFDiagCursor},
    {32643, Qt::SizeBDiagCursor},
    {32644, Qt::SizeHorCursor},
    {32645, Qt::SizeVerCursor},
    {32646, Qt::SizeAllCursor},
    {32648, Qt::ForbiddenCursor},
    {32649, Qt::PointingHandCursor},
    {32650, Qt::BusyCursor},
    {32651, Qt::WhatsThisCursor},
}};

HCURSOR shown = nullptr;
HWND cursorWindow = nullptr;

} // namespace

QCursor cursorOf(HCURSOR cursor) {
    const auto id = reinterpret_cast<std::uintptr_t>(cursor);
    for (const NamedCursor& named : systemCursors) {
        if (static_cast<std::uintptr_t>(named.id) == id) {
            return QCursor(named.shape);
        }
    }
    return QCursor(Qt::ArrowCursor);
}

bool Window::showClassCursor(WPARAM under) {
    const HWND target = reinterpret_cast<HWND>(under);
    if (target != m_handle) {
        return false;
    }
    cursorWindow = target;
    if (classCursor) {
        SetCursor(classCursor);
    } else {
        shown = nullptr;
        clientWidget()->unsetCursor();
    }
    return true;
}

void noteCursorWindow(HWND window) {
    cursorWindow = window;
}

} // namespace tvx::afx

using namespace tvx::afx;

HCURSOR LoadCursorA(HINSTANCE module, LPCSTR name) {
    if (!IS_INTRESOURCE(name)) {
        SetLastError(ERROR_RESOURCE_NAME_NOT_FOUND);
        return nullptr;
    }
    const auto id = static_cast<int>(reinterpret_cast<std::uintptr_t>(name));
    for (const auto& named : systemCursors) {
        if (named.id == id) {
            return reinterpret_cast<HCURSOR>(static_cast<std::uintptr_t>(id));
        }
    }
    SetLastError(ERROR_RESOURCE_NAME_NOT_FOUND);
    return nullptr;
}

HCURSOR SetCursor(HCURSOR cursor) {
    const HCURSOR previous = shown;
    shown = cursor;
    QWidget* widget = peerOf(cursorWindow);
    if (widget && cursor) {
        const QCursor wanted = cursorOf(cursor);
        // Handlers of WM_SETCURSOR set the same one at every move of the mouse; the display need not hear of it.
        if (widget->cursor().shape() != wanted.shape() || !widget->testAttribute(Qt::WA_SetCursor)) {
            widget->setCursor(wanted);
        }
    } else if (widget) {
        // Null hides the pointer.
        widget->setCursor(Qt::BlankCursor);
    }
    return previous;
}

BOOL GetCursorPos(POINT* point) {
    if (!ensureGui()) {
        return FALSE;
    }
    *point = fromQt(QCursor::pos());
    return TRUE;
}

BOOL SetCursorPos(int x, int y) {
    if (!ensureGui()) {
        return FALSE;
    }
    QCursor::setPos(x, y);
    return TRUE;
}

SHORT GetKeyState(int key) {
    if (!ensureGui()) {
        return 0;
    }
    const Qt::KeyboardModifiers modifiers = QGuiApplication::keyboardModifiers();
    const Qt::MouseButtons buttons = QGuiApplication::mouseButtons();
    bool down = false;
    switch (key) {
    case VK_SHIFT:
        // A modifier that went down in another program's window is known from later events only.
        down = modifiers.testFlag(Qt::ShiftModifier) || isKeyDown(key);
        break;
    case VK_CONTROL:
        down = modifiers.testFlag(Qt::ControlModifier) || isKeyDown(key);
        break;
    case VK_MENU:
        down = modifiers.testFlag(Qt::AltModifier) || isKeyDown(key);
        break;
    case VK_LBUTTON:
        down = buttons.testFlag(Qt::LeftButton);
        break;
    case VK_RBUTTON:
        down = buttons.testFlag(Qt::RightButton);
        break;
    case VK_MBUTTON:
        down = buttons.testFlag(Qt::MiddleButton);
        break;
    default:
        down = isKeyDown(key);
        break;
    }
    return static_cast<SHORT>((down ? 0x8000 : 0) | (isKeyLocked(key) ? 1 : 0));
}

SHORT GetAsyncKeyState(int key) {
    return static_cast<SHORT>(GetKeyState(key) & 0x8000);
}
