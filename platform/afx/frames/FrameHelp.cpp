#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/HelpMode.h"
#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/frames/MdiFrame.h"
#include "platform/afx/frames/ToolBar.h"

// Help requests of frames and bars.

using namespace tvx::afx;

BOOL CFrameWnd::OnHelpInfo(HELPINFO* info) {
    answerHelpRequest(*info, m_hWnd);
    return TRUE;
}

LRESULT CFrameWnd::OnCommandHelp(WPARAM, LPARAM context) {
    const bool isIdle = m_nIDTracking == AFX_IDS_IDLEMESSAGE || m_nIDTracking == AFX_IDS_HELPMODEMESSAGE;
    if (context == 0 && m_nIDTracking != 0 && !isIdle) {
        context = LPARAM{HID_BASE_COMMAND} + m_nIDTracking;
    } else if (context == 0 && m_nIDHelp != 0) {
        context = LPARAM{HID_BASE_RESOURCE} + m_nIDHelp;
    }
    if (context == 0) {
        return FALSE;
    }
    WinHelpInternal(static_cast<DWORD_PTR>(context));
    return TRUE;
}

LRESULT CMDIFrameWnd::OnCommandHelp(WPARAM wParam, LPARAM context) {
    CMDIChildWnd* child = MDIGetActive();
    const bool isIdle = m_nIDTracking == 0 || m_nIDTracking == AFX_IDS_IDLEMESSAGE;
    // The document that is worked on says more than the application, but not more than an open menu.
    if (child && isIdle && child->SendMessage(WM_COMMANDHELP, wParam, context) != 0) {
        return TRUE;
    }
    return CFrameWnd::OnCommandHelp(wParam, context);
}

void CFrameWnd::OnContextHelp() {
    // The command reaches child frames first; the mode is the whole window's.
    if (CFrameWnd* top = GetTopLevelFrame(); top != this) {
        top->OnContextHelp();
        return;
    }
    if (m_bHelpMode) {
        ExitHelpMode();
        return;
    }
    m_bHelpMode = TRUE;
    if (CWinApp* app = AfxGetApp()) {
        app->m_bHelpMode = TRUE;
    }
    SetMessageText(AFX_IDS_HELPMODEMESSAGE);
    beginHelpMode(m_hWnd);
}

void CFrameWnd::ExitHelpMode() {
    if (!m_bHelpMode) {
        return;
    }
    m_bHelpMode = FALSE;
    if (CWinApp* app = AfxGetApp()) {
        app->m_bHelpMode = FALSE;
    }
    endHelpMode();
    SetMessageText(AFX_IDS_IDLEMESSAGE);
}

LRESULT CFrameWnd::OnExitHelpMode(WPARAM, LPARAM) {
    ExitHelpMode();
    return TRUE;
}

bool CFrameWnd::explains(UINT command) {
    const bool ofHelp = command == ID_HELP || command == ID_CONTEXT_HELP || command == ID_DEFAULT_HELP;
    if (!m_bHelpMode || command == 0 || ofHelp) {
        return false;
    }
    ExitHelpMode();
    if (SendMessage(WM_COMMANDHELP, 0, LPARAM{HID_BASE_COMMAND} + promptOf(command)) == 0) {
        SendMessage(WM_COMMAND, ID_DEFAULT_HELP);
    }
    return true;
}

LRESULT CControlBar::OnHelpHitTest(WPARAM, LPARAM) {
    return LPARAM{HID_BASE_CONTROL} + GetDlgCtrlID();
}

LRESULT CToolBar::OnHelpHitTest(WPARAM wParam, LPARAM point) {
    for (int i = 0; i < GetCount(); ++i) {
        CRect button;
        GetItemRect(i, button);
        if (GetItemID(i) != ID_SEPARATOR && button.PtInRect(CPoint(GET_X_LPARAM(point), GET_Y_LPARAM(point)))) {
            return LPARAM{HID_BASE_COMMAND} + GetItemID(i);
        }
    }
    return CControlBar::OnHelpHitTest(wParam, point);
}
