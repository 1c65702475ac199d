#include "platform/afx/core/detail/HelpMode.h"

#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/core/detail/Window.h"

#include <QApplication>
#include <QKeyEvent>
#include <QMenuBar>
#include <QMouseEvent>

#include <utility>

namespace tvx::afx {

namespace {

HWND modeFrame = nullptr;
/// The release of a press that was taken is taken too, and its second press when it is a double click.
bool releaseIsDue = false;

/// What lies at a point of a window: the first answer on the way up, 0 for none.
DWORD_PTR contextAt(HWND handle, QPoint screen) {
    LRESULT answer = 0;
    for (Window* window = Window::from(handle); window && answer == 0; window = Window::from(handle)) {
        handle = window->parent() ? window->parent()->handle() : nullptr; // an answer may end the window
        const QPoint point = window->screenToClient(screen);
        answer = window->call(WM_HELPHITTEST, 0, MAKELPARAM(point.x(), point.y()));
    }
    return static_cast<DWORD_PTR>(answer);
}

bool takePress(const Window& window, const QMouseEvent& event) {
    const HWND handle = window.handle();
    const QPoint screen = event.globalPosition().toPoint();
    releaseIsDue = true;
    leaveHelpMode();
    if (event.button() == Qt::LeftButton) {
        const DWORD_PTR context = contextAt(handle, screen);
        explain(handle, context);
    }
    return true;
}

bool takeKey(const QKeyEvent& event) {
    // With modifiers it is the key that has begun the mode.
    if (event.key() == Qt::Key_F1 && event.modifiers() == Qt::NoModifier) {
        leaveHelpMode();
        return false;
    }
    if (event.key() == Qt::Key_Escape) {
        // Asked for first, pressed then: the mode lasts until the press, so that nobody else gets it.
        if (event.type() == QEvent::KeyPress) {
            leaveHelpMode();
        }
        return true;
    }
    // What opens menus works on; nothing is typed meanwhile.
    const bool menuKey = event.key() == Qt::Key_F10 || event.key() == Qt::Key_Alt;
    return !menuKey && !event.modifiers().testFlag(Qt::AltModifier);
}

} // namespace

void beginHelpMode(HWND frame) {
    if (!modeFrame) {
        QApplication::setOverrideCursor(Qt::WhatsThisCursor);
    }
    modeFrame = frame;
}

void endHelpMode() {
    if (std::exchange(modeFrame, nullptr)) {
        QApplication::restoreOverrideCursor();
    }
}

void leaveHelpMode() {
    if (modeFrame) {
        SendMessageA(modeFrame, WM_EXITHELPMODE, 0, 0);
    }
}

bool helpModeTakes(const Window& window, const QObject& receiver, QEvent& event) {
    const QEvent::Type type = event.type();
    if (releaseIsDue && (type == QEvent::MouseButtonRelease || type == QEvent::ContextMenu)) {
        releaseIsDue = type == QEvent::ContextMenu;
        event.accept();
        return true;
    }
    if (!modeFrame || qobject_cast<const QMenuBar*>(&receiver)) {
        releaseIsDue = releaseIsDue && type != QEvent::MouseButtonPress;
        return false;
    }
    bool taken = false;
    if (type == QEvent::MouseButtonPress || type == QEvent::MouseButtonDblClick) {
        taken = takePress(window, static_cast<QMouseEvent&>(event));
    } else if (type == QEvent::KeyPress || type == QEvent::ShortcutOverride) {
        taken = takeKey(static_cast<QKeyEvent&>(event));
    }
    if (taken) {
        event.accept();
    }
    return taken;
}

} // namespace tvx::afx
