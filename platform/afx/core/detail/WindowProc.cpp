#include "platform/afx/core/detail/Capture.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/core/detail/KeyMove.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/MenuRequest.h"
#include "platform/afx/core/detail/Window.h"

#include "platform/afx/core/Wnd.h"
#include "platform/base/Text.h"

#include <cstring>

namespace tvx::afx {

LRESULT Window::call(UINT message, WPARAM wParam, LPARAM lParam) {
    Dispatch current;
    // Time and place are those of the message that is being handled: who sends one does not ask the clock.
    const DWORD place = GetMessagePos();
    current.msg = {m_handle,
                   message,
                   wParam,
                   lParam,
                   static_cast<DWORD>(GetMessageTime()),
                   {GET_X_LPARAM(place), GET_Y_LPARAM(place)}};
    current.window = this;
    const DispatchScope scope(current);
    return deliver(message, wParam, lParam);
}

LRESULT Window::deliver(UINT message, WPARAM wParam, LPARAM lParam) {
    return m_object ? m_object->WindowProc(message, wParam, lParam) : defaultProc(message, wParam, lParam);
}

LRESULT Window::textProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_SETTEXT) {
        setText(toQt(reinterpret_cast<const char*>(lParam)));
        return TRUE;
    }
    const std::string content = fromQt(text());
    if (message == WM_GETTEXTLENGTH) {
        return static_cast<LRESULT>(content.size());
    }
    auto* buffer = reinterpret_cast<char*>(lParam);
    if (!buffer || wParam == 0) {
        return 0;
    }
    return static_cast<LRESULT>(text::copyCut(content, buffer, wParam));
}

/// What happens with mouse messages that nobody took: the widget gets the event, and what it does not know goes on.
LRESULT Window::mouseProc(UINT message, WPARAM wParam, LPARAM lParam) {
    passEvent(*this, message);
    if (message == WM_RBUTTONUP && !m_destroyed) {
        const QPoint screen = clientToScreen(QPoint(GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)));
        return call(WM_CONTEXTMENU, reinterpret_cast<WPARAM>(m_handle), MAKELPARAM(screen.x(), screen.y()));
    }
    return 0;
}

LRESULT Window::systemCommand(UINT command, LPARAM lParam) {
    switch (command & 0xFFF0U) {
    case SC_CLOSE:
        return call(WM_CLOSE);
    case SC_MINIMIZE:
        show(SW_MINIMIZE);
        return 0;
    case SC_MAXIMIZE:
        show(SW_SHOWMAXIMIZED);
        return 0;
    case SC_RESTORE:
        show(SW_RESTORE);
        return 0;
    case SC_MOVE:
        changeByKeys(m_handle, KeyChange::Place);
        return 0;
    case SC_SIZE:
        changeByKeys(m_handle, KeyChange::Size);
        return 0;
    default:
        return 0;
    }
}

/// Questions of controls that their parent left unanswered go back to the control's own object.
LRESULT Window::reflect(UINT message, WPARAM wParam, LPARAM lParam) {
    Window* control = nullptr;
    if (message == WM_DRAWITEM) {
        control = from(reinterpret_cast<const DRAWITEMSTRUCT*>(lParam)->hwndItem);
    } else if (message == WM_MEASUREITEM || message == WM_DELETEITEM) {
        control = child(static_cast<int>(wParam));
    } else {
        control = from(reinterpret_cast<HWND>(lParam));
    }
    LRESULT result = 0;
    if (control && control->m_object) {
        control->m_object->OnChildNotify(message, wParam, lParam, &result);
    }
    return result;
}

LRESULT Window::appearanceProc(UINT message, WPARAM wParam, LPARAM lParam) {
    HICON& icon = wParam == ICON_BIG ? bigIcon : smallIcon;
    switch (message) {
    case WM_SETFONT:
        font = reinterpret_cast<HFONT>(wParam);
        fontChanged();
        return 0;
    case WM_GETFONT:
        return reinterpret_cast<LRESULT>(font);
    case WM_SETICON: {
        const HICON old = std::exchange(icon, reinterpret_cast<HICON>(lParam));
        iconChanged();
        return reinterpret_cast<LRESULT>(old);
    }
    case WM_GETICON:
        return reinterpret_cast<LRESULT>(icon);
    case WM_SETREDRAW:
        guarded([&] { m_widget->setUpdatesEnabled(wParam != 0); });
        return 0;
    default:
        return 0;
    }
}

/// Messages whose answer is the parent's when nobody here has one.
LRESULT Window::parentProc(UINT message, WPARAM wParam, LPARAM lParam) {
    const auto askParent = [&](LRESULT without) {
        return m_parent ? SendMessageA(m_parent->m_handle, message, wParam, lParam) : without;
    };
    switch (message) {
    case WM_SETCURSOR:
        // The parent may choose for its children; the innermost class cursor is the last word.
        return askParent(FALSE) != 0 || showClassCursor(wParam) ? TRUE : FALSE;
    case WM_MOUSEACTIVATE:
        return askParent(MA_ACTIVATE);
    case WM_MOUSEWHEEL:
        // A wheel that turns over something that does not scroll, or not further, is for what it stands in.
        return passEvent(*this, message) && isEventTaken() ? 0 : askParent(0);
    case WM_CONTEXTMENU:
        if (!m_parent) {
            noteMenuUntaken(wParam);
        }
        return askParent(0);
    default:
        return askParent(0);
    }
}

LRESULT Window::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_SETTEXT:
    case WM_GETTEXT:
    case WM_GETTEXTLENGTH:
        return textProc(message, wParam, lParam);
    case WM_SETFONT:
    case WM_GETFONT:
    case WM_SETICON:
    case WM_GETICON:
    case WM_SETREDRAW:
        return appearanceProc(message, wParam, lParam);
    case WM_SETCURSOR:
    case WM_MOUSEACTIVATE:
    case WM_CONTEXTMENU:
    case WM_MOUSEWHEEL:
        return parentProc(message, wParam, lParam);
    case WM_HELP:
        return helpProc(reinterpret_cast<const HELPINFO*>(lParam));
    case WM_KEYDOWN:
        return keyDown(wParam, lParam);
    case WM_CLOSE:
        destroy();
        return 0;
    case WM_SYSCOMMAND:
        return systemCommand(static_cast<UINT>(wParam), lParam);
    case WM_QUERYENDSESSION:
        return TRUE;
    case WM_NCHITTEST:
        return hitTest(QPoint(GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)));
    case WM_NCPAINT:
        if (!passEvent(*this, message) && !inFramePaint) {
            updateFrame();
        }
        return 0;
    case WM_NCACTIVATE:
        updateFrame();
        return TRUE;
    case WM_CTLCOLORMSGBOX:
    case WM_CTLCOLOREDIT:
    case WM_CTLCOLORLISTBOX:
    case WM_CTLCOLORBTN:
    case WM_CTLCOLORSCROLLBAR:
    case WM_CTLCOLORSTATIC:
    case WM_DRAWITEM:
    case WM_MEASUREITEM:
    case WM_DELETEITEM:
        return reflect(message, wParam, lParam);
    case WM_CANCELMODE:
        cancelModes();
        return 0;
    case WM_SYSKEYUP:
    case WM_SYSCHAR:
    case WM_SYSKEYDOWN:
        return systemKey(message, wParam, lParam);
    default:
        if (message >= WM_MOUSEFIRST && message <= WM_MOUSELAST) {
            return mouseProc(message, wParam, lParam);
        }
        passEvent(*this, message);
        return 0;
    }
}

/// A help request that nobody took goes on to what the window stands in or over.
LRESULT Window::helpProc(const HELPINFO* info) {
    const Window* above = m_parent ? m_parent : m_owner;
    if (above) {
        return SendMessageA(above->m_handle, WM_HELP, 0, reinterpret_cast<LPARAM>(info));
    }
    answerHelpRequest(*info, m_handle);
    return TRUE;
}

/// The help key asks once, however long it is held.
LRESULT Window::keyDown(WPARAM key, LPARAM lParam) {
    const bool help = key == VK_F1 || key == VK_HELP;
    const bool repeated = (lParam & (LPARAM{1} << 30)) != 0;
    if (!help || repeated || isKeyDown(VK_SHIFT) || isKeyDown(VK_CONTROL) || isKeyDown(VK_MENU)) {
        passEvent(*this, WM_KEYDOWN);
        return 0;
    }
    requestHelp(m_handle);
    return 0;
}

/// Keys with Alt that nobody took belong to the menu of the top-level window.
LRESULT Window::systemKey(UINT message, WPARAM wParam, LPARAM lParam) {
    const HWND top = topLevel()->m_handle;
    const bool menuKey =
        (message == WM_SYSKEYUP && wParam == VK_MENU) || (message == WM_SYSKEYDOWN && wParam == VK_F10);
    if (menuKey && wParam == VK_F10 && isKeyDown(VK_SHIFT)) {
        return call(WM_CONTEXTMENU, reinterpret_cast<WPARAM>(m_handle), MAKELPARAM(-1, -1));
    }
    if (menuKey) {
        return SendMessageA(top, WM_SYSCOMMAND, SC_KEYMENU, 0);
    }
    if (message == WM_SYSCHAR) {
        return SendMessageA(top, WM_SYSCOMMAND, SC_KEYMENU, static_cast<LPARAM>(wParam));
    }
    passEvent(*this, message);
    return 0;
}

} // namespace tvx::afx
