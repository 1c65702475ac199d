#include "platform/afx/dialogs/detail/DialogKeys.h"
#include "platform/afx/core/detail/Group.h"

#include "platform/afx/controls/detail/Control.h"
#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/Wnd.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Menus.h"
#include "platform/afx/dialogs/detail/DialogWindow.h"

#include <QApplication>

#include <algorithm>

namespace tvx::afx {

namespace {

UINT codeOf(Window& window, const MSG* msg = nullptr) {
    return static_cast<UINT>(
        SendMessageA(window.handle(), WM_GETDLGCODE, msg ? msg->wParam : 0, reinterpret_cast<LPARAM>(msg)));
}

bool isUsable(const Window& window) {
    // By the style, not by what is seen: the first control is looked for before the dialog is shown.
    return window.isEnabled() && (window.style() & WS_VISIBLE) != 0;
}

/// Child dialogs give their controls to the order of the dialog around them.
bool isContainer(const Window& window) {
    const bool dialog = dynamic_cast<const DialogWindow*>(&window) != nullptr;
    return (window.exStyle() & WS_EX_CONTROLPARENT) != 0 || (dialog && (window.style() & DS_CONTROL) != 0);
}

void collect(const Window& parent, std::vector<Window*>& controls) {
    for (Window* child : parent.children()) {
        if (!isUsable(*child)) {
            continue;
        }
        if (isContainer(*child)) {
            collect(*child, controls);
        } else {
            controls.push_back(child);
        }
    }
}

/// The control with the keyboard; null when it is elsewhere, or at the dialog itself.
Window* focusIn(const Window& dialog) {
    Window* focus = Window::from(GetFocus());
    return focus && IsChild(dialog.handle(), focus->handle()) ? focus : nullptr;
}

} // namespace

Window* nextTabItem(Window& dialog, const Window* from, Direction direction) {
    std::vector<Window*> controls;
    collect(dialog, controls);
    if (direction == Direction::Backward) {
        std::reverse(controls.begin(), controls.end());
    }
    auto place = std::find(controls.begin(), controls.end(), from);
    if (place == controls.end()) {
        place = controls.begin();
    } else {
        // The control itself comes last: it is the answer when there is no other.
        std::rotate(controls.begin(), std::next(place), controls.end());
    }
    const auto isStop = [](const Window* window) { return (window->style() & WS_TABSTOP) != 0; };
    const auto found = std::find_if(controls.begin(), controls.end(), isStop);
    return found != controls.end() ? *found : nullptr;
}

Window* nextGroupItem(const Window& from, Direction direction) {
    auto group = dialogGroup(from);
    if (direction == Direction::Backward) {
        std::reverse(group.begin(), group.end());
    }
    const auto place = std::find(group.begin(), group.end(), &from);
    std::rotate(group.begin(), std::next(place), group.end());
    for (Window* window : group) {
        if (isUsable(*window) && (codeOf(*window) & DLGC_STATIC) == 0) {
            return window;
        }
    }
    return nullptr;
}

void focusControl(Window& control) {
    const HWND handle = control.handle();
    SetFocus(handle);
    Window* still = Window::from(handle);
    if (still && (codeOf(*still) & DLGC_HASSETSEL) != 0) {
        SendMessageA(handle, EM_SETSEL, 0, -1);
    }
}

namespace {

// --- Tab and arrows ---

bool onTab(Window& dialog, Window* focus) {
    const Direction direction = isKeyDown(VK_SHIFT) ? Direction::Backward : Direction::Forward;
    // Where there is nowhere to go, the key is the dialog's all the same.
    if (Window* next = nextTabItem(dialog, focus, direction)) {
        focusControl(*next);
    }
    return true;
}

bool onArrow(Window& focus, Direction direction) {
    Window* next = nextGroupItem(focus, direction);
    if (!next || next == &focus) {
        return true;
    }
    const HWND handle = next->handle();
    SetFocus(handle);
    next = Window::from(handle);
    // The mark follows the keyboard through a group of radio buttons that mark themselves.
    if (next && (codeOf(*next) & DLGC_RADIOBUTTON) != 0 && (next->style() & BS_TYPEMASK) == BS_AUTORADIOBUTTON) {
        SendMessageA(handle, BM_CLICK, 0, 0);
    }
    return true;
}

// --- Enter and Esc ---

bool press(Window& dialog, int id) {
    const Window* button = dialog.child(id);
    if (button && !button->isEnabled()) {
        QApplication::beep();
        return true;
    }
    armIdle();
    const HWND handle = button ? button->handle() : nullptr;
    SendMessageA(dialog.handle(), WM_COMMAND, MAKEWPARAM(id, BN_CLICKED), reinterpret_cast<LPARAM>(handle));
    return true;
}

bool onEnter(Window& dialog, Window* focus) {
    const UINT code = focus ? codeOf(*focus) : 0;
    // A push button that has the keyboard is the default one for that time.
    if ((code & (DLGC_DEFPUSHBUTTON | DLGC_UNDEFPUSHBUTTON)) != 0) {
        armIdle();
        SendMessageA(focus->handle(), BM_CLICK, 0, 0);
        return true;
    }
    const LRESULT answer = SendMessageA(dialog.handle(), DM_GETDEFID, 0, 0);
    const bool has = HIWORD(static_cast<std::uintptr_t>(answer)) == DC_HASDEFID;
    return press(dialog, has ? LOWORD(static_cast<std::uintptr_t>(answer)) : IDOK);
}

// --- mnemonics ---

/// The controls whose text carries this mnemonic, hidden and disabled ones left out.
std::vector<Window*> withMnemonic(const std::vector<Window*>& controls, char32_t letter) {
    std::vector<Window*> found;
    for (Window* window : controls) {
        const auto* control = dynamic_cast<const Control*>(window);
        if (control && accessKey(fromQt(control->mnemonicText())) == letter) {
            found.push_back(window);
        }
    }
    return found;
}

/// A label hands its mnemonic on to the control behind it that takes the keyboard.
Window* behindLabel(const std::vector<Window*>& controls, const Window* label) {
    auto place = std::find(controls.begin(), controls.end(), label);
    for (++place; place != controls.end(); ++place) {
        if ((codeOf(**place) & DLGC_STATIC) == 0) {
            return *place;
        }
    }
    return nullptr;
}

bool activate(const std::vector<Window*>& controls, Window* chosen, bool unique) {
    UINT code = codeOf(*chosen);
    if ((code & DLGC_STATIC) != 0) {
        chosen = behindLabel(controls, chosen);
        if (chosen) {
            focusControl(*chosen);
        }
        return true;
    }
    const HWND handle = chosen->handle();
    SetFocus(handle);
    if (unique && (code & DLGC_BUTTON) != 0) {
        armIdle();
        SendMessageA(handle, BM_CLICK, 0, 0);
    }
    return true;
}

bool onMnemonic(Window& dialog, Window* focus, WPARAM character) {
    std::vector<Window*> controls;
    collect(dialog, controls);
    auto found = withMnemonic(controls, QChar::toLower(static_cast<char32_t>(character)));
    if (found.empty() && pressedLetter() != 0) {
        found = withMnemonic(controls, pressedLetter());
    }
    if (found.empty()) {
        return false;
    }
    // Several controls with one letter take turns, beginning behind the keyboard's place.
    const auto place = std::find(controls.begin(), controls.end(), focus);
    for (Window* candidate : found) {
        if (std::find(controls.begin(), controls.end(), candidate) > place && place != controls.end()) {
            return activate(controls, candidate, found.size() == 1);
        }
    }
    return activate(controls, found.front(), found.size() == 1);
}

bool onKey(Window& dialog, Window* focus, const MSG& msg) {
    const UINT code = focus ? codeOf(*focus, &msg) : 0;
    // With Alt, keys are mnemonics, which come as WM_SYSCHAR, or the menu's.
    if ((code & DLGC_WANTALLKEYS) != 0 || isKeyDown(VK_MENU)) {
        return false;
    }
    const bool control = isKeyDown(VK_CONTROL);
    switch (msg.wParam) {
    case VK_TAB:
        return (code & DLGC_WANTTAB) == 0 && !control && onTab(dialog, focus);
    case VK_LEFT:
    case VK_UP:
        return (code & DLGC_WANTARROWS) == 0 && focus && onArrow(*focus, Direction::Backward);
    case VK_RIGHT:
    case VK_DOWN:
        return (code & DLGC_WANTARROWS) == 0 && focus && onArrow(*focus, Direction::Forward);
    case VK_RETURN:
    case VK_EXECUTE:
        return !control && onEnter(dialog, focus);
    case VK_ESCAPE:
    case VK_CANCEL:
        return press(dialog, IDCANCEL);
    default:
        return false;
    }
}

bool onChar(Window& dialog, Window* focus, const MSG& msg) {
    const UINT code = focus ? codeOf(*focus, &msg) : 0;
    const bool wanted = (code & (DLGC_WANTCHARS | DLGC_WANTALLKEYS)) != 0;
    // A blank presses the focused button; it is nobody's mnemonic.
    if (wanted || msg.wParam <= ' ' || isKeyDown(VK_CONTROL)) {
        return false;
    }
    return onMnemonic(dialog, focus, msg.wParam);
}

} // namespace

bool isDialogMessage(Window& dialog, const MSG& msg) {
    Window* focus = focusIn(dialog);
    switch (msg.message) {
    case WM_KEYDOWN:
        return onKey(dialog, focus, msg);
    case WM_CHAR:
        return onChar(dialog, focus, msg);
    case WM_SYSCHAR:
        return msg.wParam > ' ' && onMnemonic(dialog, focus, msg.wParam);
    default:
        return false;
    }
}

} // namespace tvx::afx

using namespace tvx::afx;

BOOL CWnd::PreTranslateInput(MSG* message) {
    Window* window = GetState();
    const bool key = message->message >= WM_KEYFIRST && message->message <= WM_KEYLAST;
    const bool mouse = message->message >= WM_MOUSEFIRST && message->message <= WM_MOUSELAST;
    const bool own = window && (message->hwnd == m_hWnd || ::IsChild(m_hWnd, message->hwnd));
    if (!own || !(key || mouse)) {
        return FALSE;
    }
    // What is typed into a window is its own, whatever a frame around it or behind it would do with the key.
    if (mouse || !isDialogMessage(*window, *message)) {
        handToWindow();
    }
    return TRUE;
}
