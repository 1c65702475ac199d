#include "platform/afx/core/Thread.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/Menu.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/MessageQueue.h"
#include "platform/afx/gdi/Dc.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/Exception.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <thread>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CWinThread, CCmdTarget)

namespace {

/// The thread that the static objects of the program are made on: the user interface's.
const std::thread::id interfaceThread = std::this_thread::get_id();

} // namespace

CWinThread* AfxGetThread() {
    return std::this_thread::get_id() == interfaceThread ? AfxGetApp() : nullptr;
}

bool AfxIsActivating() {
    constexpr std::array messages{WM_ACTIVATE,      WM_NCACTIVATE, WM_MDIACTIVATE,
                                  WM_MOUSEACTIVATE, WM_SETFOCUS,   WM_KILLFOCUS};
    for (const Dispatch* each = DispatchScope::current(); each; each = each->outer) {
        if (std::ranges::find(messages, each->msg.message) != messages.end()) {
            return true;
        }
    }
    return false;
}

MSG* AfxGetCurrentMessage() {
    Dispatch* current = DispatchScope::current();
    return current ? &current->msg : nullptr;
}

void AfxPostQuitMessage(int exitCode) {
    ::PostQuitMessage(exitCode);
}

BOOL CWinThread::InitInstance() {
    return FALSE;
}

int CWinThread::Run() {
    if (!ensureGui()) {
        tellMissingDisplay();
        ExitInstance();
        return 1;
    }
    ModalLoop loop;
    loop.run();
    if (isQuitting()) {
        const int exitCode = takeQuit();
        const int result = ExitInstance();
        // A failure that was told by PostQuitMessage is not lost over an ExitInstance that knows of none.
        return exitCode != 0 ? exitCode : result;
    }
    return ExitInstance();
}

BOOL CWinThread::PreTranslateMessage(MSG* message) {
    if (!message->hwnd) {
        return DispatchThreadMessage(message);
    }
    CWnd* mainWindow = GetMainWnd();
    const HWND stop = mainWindow ? mainWindow->m_hWnd : nullptr;
    if (CWnd::WalkPreTranslateTree(stop, message)) {
        return TRUE;
    }
    // Accelerators of the main frame work in its owned popups too, unless a modal dialog keeps the user from it.
    const CWnd* target = CWnd::FromHandle(message->hwnd);
    if (mainWindow && mainWindow->IsWindowEnabled() && target && target->GetTopLevelParent() != mainWindow) {
        return mainWindow->PreTranslateMessage(message);
    }
    return FALSE;
}

BOOL CWinThread::DispatchThreadMessage(MSG* message) {
    const AFX_MSGMAP_ENTRY* entry = FindMessageEntry(message->message, 0, 0);
    if (!entry) {
        return FALSE;
    }
    MessageCall call;
    call.message = message->message;
    call.wParam = message->wParam;
    call.lParam = message->lParam;
    return entry->pfn(*this, call) ? TRUE : FALSE;
}

BOOL CWinThread::PumpMessage() {
    if (!ensureGui()) {
        return FALSE;
    }
    MessageQueue& queue = MessageQueue::instance();
    EventCapture& capture = EventCapture::instance();
    while (!isQuitting()) {
        // Posted messages before input, as PeekMessage hands them out.
        if (auto posted = queue.find(nullptr, 0, 0, true)) {
            pump(*posted);
            return TRUE;
        }
        if (capture.redeliverFirst()) {
            return TRUE;
        }
        capture.collect(true);
    }
    return FALSE;
}

BOOL CWinThread::OnIdle(LONG) {
    CWnd::DeleteTempMap();
    CMenu::DeleteTempMap();
    CDC::DeleteTempMap();
    CGdiObject::DeleteTempMap();
    return FALSE;
}

BOOL CWinThread::IsIdleMessage(MSG* message) {
    if (message->message == WM_MOUSEMOVE || message->message == WM_NCMOUSEMOVE) {
        if (m_lastMouse == CPoint(message->pt) && m_lastMessage == message->message) {
            return FALSE;
        }
        m_lastMouse = CPoint(message->pt);
        m_lastMessage = message->message;
        return TRUE;
    }
    return message->message != WM_PAINT ? TRUE : FALSE;
}

int CWinThread::ExitInstance() {
    return 0;
}

CWnd* CWinThread::GetMainWnd() {
    return m_pActiveWnd ? m_pActiveWnd : m_pMainWnd;
}

BOOL CWinThread::PostThreadMessage(UINT message, WPARAM wParam, LPARAM lParam) {
    return ::PostMessageA(nullptr, message, wParam, lParam);
}
