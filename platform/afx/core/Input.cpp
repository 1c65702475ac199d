#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Cursors.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/detail/GdiObjects.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/win/Error.h"
#include "platform/win/Picture.h"

#include <QApplication>
#include <QCursor>
#include <QPixmap>

#include <algorithm>
#include <array>
#include <map>
#include <string>
#include <utility>

namespace tvx::afx {

namespace {

struct NamedCursor {
    std::uintptr_t id;
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
HWND edgeCursorWindow = nullptr;

const NamedCursor* systemCursor(std::uintptr_t id) {
    const auto* found = std::ranges::find(systemCursors, id, &NamedCursor::id);
    return found != systemCursors.end() ? found : nullptr;
}

/// A cursor of the resources, which are handled as icons are; null when the module has none of that name.
HCURSOR loadFromModule(HINSTANCE module, LPCSTR name) {
    // Loaded once, as cursors are asked for anew with each move of the mouse.
    static auto& loaded = *new std::map<std::pair<HINSTANCE, std::string>, HCURSOR>;
    const std::string key =
        IS_INTRESOURCE(name) ? '#' + std::to_string(reinterpret_cast<std::uintptr_t>(name)) : std::string(name);
    HCURSOR& cursor = loaded[{module, key}];
    if (cursor) {
        return cursor;
    }
    if (const auto read = tvx::loadCursorPicture(module, name)) {
        const QImage pixels(reinterpret_cast<const uchar*>(read->picture.pixels.data()), read->picture.width,
                            read->picture.height, read->picture.width * 4, QImage::Format_ARGB32);
        cursor = reinterpret_cast<HCURSOR>(addIcon(pixels.copy(), QPoint(read->hotX, read->hotY)));
    }
    return cursor;
}

} // namespace

QCursor cursorOf(HCURSOR cursor) {
    const auto id = reinterpret_cast<std::uintptr_t>(cursor);
    if (const NamedCursor* named = systemCursor(id)) {
        return QCursor(named->shape);
    }
    // Pictures must not outlive the connection to the desktop.
    static std::map<HCURSOR, QCursor> pictures;
    [[maybe_unused]] static const bool cleared = (qAddPostRoutine([] { pictures.clear(); }), true);
    if (const auto known = pictures.find(cursor); known != pictures.end()) {
        return known->second;
    }
    const auto icon = icons().find(id);
    return icon ? pictures[cursor] = QCursor(QPixmap::fromImage(icon->image), icon->hotSpot.x(), icon->hotSpot.y())
                : QCursor(Qt::ArrowCursor);
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
    // What stands inside of the frame would have the edge's cursor too.
    if (const Window* edge = Window::from(std::exchange(edgeCursorWindow, nullptr))) {
        edge->widget()->unsetCursor();
    }
    cursorWindow = window;
}

void showEdgeCursor(HWND window, Qt::CursorShape shape) {
    edgeCursorWindow = window;
    Window::from(window)->widget()->setCursor(shape);
}

} // namespace tvx::afx

using namespace tvx::afx;

HCURSOR LoadCursorA(HINSTANCE module, LPCSTR name) {
    if (const HCURSOR own = module ? loadFromModule(module, name) : nullptr) {
        return own;
    }
    const auto id = reinterpret_cast<std::uintptr_t>(name);
    if (systemCursor(id)) {
        return reinterpret_cast<HCURSOR>(id);
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
        if (widget->cursor() != wanted || !widget->testAttribute(Qt::WA_SetCursor)) {
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
