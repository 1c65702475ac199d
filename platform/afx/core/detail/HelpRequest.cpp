#include "platform/afx/core/detail/HelpRequest.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/win/FrameworkIds.h"

#include <utility>

namespace tvx::afx {

namespace {

int answering = 0;

LRESULT send(HWND target, HELPINFO info) {
    info.cbSize = sizeof info;
    GetCursorPos(&info.MousePos);
    return SendMessageA(target, WM_HELP, 0, reinterpret_cast<LPARAM>(&info));
}

HWND mainWindow() {
    const CWnd* main = AfxGetMainWnd();
    return main ? main->m_hWnd : nullptr;
}

HWND above(HWND handle) {
    const Window* window = Window::from(handle);
    const Window* next = window && window->parent() ? window->parent() : (window ? window->owner() : nullptr);
    return next ? next->handle() : nullptr;
}

} // namespace

LRESULT requestHelp(HWND handle) {
    const Window* window = Window::from(handle);
    HELPINFO info{};
    info.iContextType = HELPINFO_WINDOW;
    info.iCtrlId = window ? window->id() : 0;
    info.hItemHandle = handle;
    info.dwContextId = window ? window->helpContext : 0;
    return send(handle, info);
}

void requestMenuHelp(HWND owner, HMENU menu, UINT item) {
    HELPINFO info{};
    info.iContextType = HELPINFO_MENUITEM;
    info.iCtrlId = static_cast<int>(item);
    info.hItemHandle = menu;
    send(owner ? owner : mainWindow(), info);
}

void answerHelpRequest(const HELPINFO& info, HWND last) {
    const HWND asked = static_cast<HWND>(info.hItemHandle);
    if (info.iContextType == HELPINFO_MENUITEM && info.iCtrlId != 0) {
        explain(last, HID_BASE_COMMAND + promptOf(static_cast<UINT>(info.iCtrlId)));
    } else {
        explain(info.iContextType == HELPINFO_WINDOW && Window::from(asked) ? asked : last);
    }
}

void explain(HWND window, DWORD_PTR context) {
    const HelpAnswer answer;
    for (HWND at = Window::from(window) ? window : mainWindow(); at;) {
        const HWND next = above(at); // an answer may end the window
        if (SendMessageA(at, WM_COMMANDHELP, 0, static_cast<LPARAM>(context)) != 0) {
            return;
        }
        at = next;
    }
    if (CWnd* main = AfxGetMainWnd(); main && main->m_hWnd) {
        main->SendMessage(WM_COMMAND, ID_DEFAULT_HELP);
    } else if (CWinApp* app = AfxGetApp()) {
        app->OnCmdMsg(ID_DEFAULT_HELP, CN_COMMAND, nullptr, nullptr);
    }
}

void explainAtKeyboard(HWND fallback) {
    const HWND focus = GetFocus();
    explain(focus ? focus : fallback);
}

HelpAnswer::HelpAnswer() {
    ++answering;
}

HelpAnswer::~HelpAnswer() {
    --answering;
}

bool HelpAnswer::isUnderWay() {
    return answering > 0;
}

namespace {

DWORD_PTR boxContext = 0;

} // namespace

BoxHelp::BoxHelp(DWORD_PTR context) : m_outer(std::exchange(boxContext, context)) {}

BoxHelp::~BoxHelp() {
    boxContext = m_outer;
}

DWORD_PTR BoxHelp::take() {
    return std::exchange(boxContext, 0);
}

UINT promptOf(UINT command) {
    if (command >= SC_SIZE && command < 0xF1F0) {
        return (command - SC_SIZE) / 16 + AFX_IDS_SCFIRST;
    }
    if (command >= ID_FILE_MRU_FIRST && command <= ID_FILE_MRU_LAST) {
        return ID_FILE_MRU_FILE1;
    }
    return command >= AFX_IDM_FIRST_MDICHILD ? AFX_IDS_MDICHILD : command;
}

} // namespace tvx::afx
