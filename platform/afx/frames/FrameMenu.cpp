#include "platform/afx/core/App.h"
#include "platform/afx/core/DropFiles.h"
#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/frames/Frame.h"

// Menus and the status line of frames.

void CFrameWnd::OnInitMenu(CMenu* menu) {
    CWnd::OnInitMenu(menu);
}

void CFrameWnd::OnInitMenuPopup(CMenu* popup, UINT index, BOOL systemMenu) {
    CWnd::OnInitMenuPopup(popup, index, systemMenu);
    if (!systemMenu && popup) {
        updateMenuItems(*popup);
    }
}

namespace {

/// The popup's item in the menu bar, for handlers that look at it.
CMenu* parentOf(const CWnd& frame, const CMenu& popup) {
    CMenu* bar = frame.GetMenu();
    const int count = bar ? static_cast<int>(bar->GetMenuItemCount()) : 0;
    for (int i = 0; i < count; ++i) {
        if (::GetSubMenu(bar->m_hMenu, i) == popup.m_hMenu) {
            return bar;
        }
    }
    return nullptr;
}

} // namespace

void CFrameWnd::updateMenuItems(CMenu& popup) {
    CCmdUI element;
    element.m_pMenu = &popup;
    element.m_pParentMenu = parentOf(*this, popup);
    element.m_nIndexMax = popup.GetMenuItemCount();
    for (element.m_nIndex = 0; element.m_nIndex < element.m_nIndexMax; ++element.m_nIndex) {
        const auto position = static_cast<int>(element.m_nIndex);
        element.m_nID = popup.GetMenuItemID(position);
        element.m_pSubMenu = nullptr;
        if (element.m_nID == static_cast<UINT>(-1)) {
            // A popup goes under the name of its first command.
            element.m_pSubMenu = popup.GetSubMenu(position);
            element.m_nID = element.m_pSubMenu ? element.m_pSubMenu->GetMenuItemID(0) : 0;
            if (element.m_nID == 0 || element.m_nID == static_cast<UINT>(-1)) {
                continue;
            }
            element.DoUpdate(this, FALSE);
        } else if (element.m_nID != 0) {
            // The commands from 0xF000 up are the window's, which handles them without a handler.
            element.DoUpdate(this, m_bAutoMenuEnable && element.m_nID < 0xF000 ? TRUE : FALSE);
        }
        // A handler may have put items in or taken some out, such as a list of files.
        const UINT count = popup.GetMenuItemCount();
        if (count < element.m_nIndexMax) {
            element.m_nIndex -= element.m_nIndexMax - count;
            while (element.m_nIndex < count &&
                   popup.GetMenuItemID(static_cast<int>(element.m_nIndex)) == element.m_nID) {
                ++element.m_nIndex;
            }
        }
        element.m_nIndexMax = count;
    }
}

void CFrameWnd::OnMenuSelect(UINT item, UINT flags, HMENU) {
    CFrameWnd* top = GetTopLevelFrame();
    UINT prompt = 0;
    // So the platform tells that the menu has closed.
    if (flags == 0xFFFF) {
        prompt = top->m_bHelpMode ? AFX_IDS_HELPMODEMESSAGE : AFX_IDS_IDLEMESSAGE;
    } else {
        prompt = (flags & (MF_SEPARATOR | MF_POPUP)) != 0 ? 0 : tvx::afx::promptOf(item);
    }
    top->m_nIDTracking = prompt;
    if (top->m_nIDTracking != top->m_nIDLastMessage) {
        top->SetMessageText(top->m_nIDTracking);
    }
}

void CFrameWnd::GetMessageString(UINT id, CString& message) const {
    CString text;
    message.Empty();
    if (text.LoadString(id)) {
        AfxExtractSubString(message, text, 0);
    }
}

void CFrameWnd::SetMessageText(LPCSTR text) {
    SendMessage(WM_SETMESSAGESTRING, 0, reinterpret_cast<LPARAM>(text));
}

void CFrameWnd::SetMessageText(UINT id) {
    SendMessage(WM_SETMESSAGESTRING, id);
}

CWnd* CFrameWnd::GetMessageBar() {
    return GetDescendantWindow(AFX_IDW_STATUS_BAR, TRUE);
}

LRESULT CFrameWnd::OnSetMessageString(WPARAM id, LPARAM text) {
    const UINT last = m_nIDLastMessage;
    CString message;
    if (text != 0) {
        message = reinterpret_cast<LPCSTR>(text);
    } else if (id != 0) {
        GetMessageString(static_cast<UINT>(id), message);
    }
    if (CWnd* bar = GetMessageBar()) {
        bar->SetWindowText(message);
    }
    m_nIDLastMessage = static_cast<UINT>(id);
    m_nIDTracking = static_cast<UINT>(id);
    return last;
}

LRESULT CFrameWnd::OnIdleUpdateCmdUI(WPARAM, LPARAM) {
    if ((m_nIdleFlags & idleTitle) != 0) {
        OnUpdateFrameTitle(TRUE);
    }
    if ((m_nIdleFlags & idleLayout) != 0) {
        RecalcLayout();
    }
    m_nIdleFlags = 0;
    return 0;
}

void CFrameWnd::OnUpdateKeyIndicator(CCmdUI* item) {
    int key = VK_CAPITAL;
    if (item->m_nID == ID_INDICATOR_NUM) {
        key = VK_NUMLOCK;
    } else if (item->m_nID == ID_INDICATOR_SCRL) {
        key = VK_SCROLL;
    }
    item->Enable(::GetKeyState(key) & 1);
}

void CFrameWnd::OnDropFiles(HANDLE handle) {
    SetForegroundWindow();
    const auto drop = static_cast<HDROP>(handle);
    const UINT count = ::DragQueryFileA(drop, 0xFFFFFFFF, nullptr, 0);
    for (UINT i = 0; i < count; ++i) {
        CString name;
        const auto length = static_cast<int>(::DragQueryFileA(drop, i, nullptr, 0));
        ::DragQueryFileA(drop, i, name.GetBuffer(length), static_cast<UINT>(length) + 1);
        name.ReleaseBuffer();
        if (CWinApp* app = AfxGetApp()) {
            app->OpenDocumentFile(name);
        }
    }
    ::DragFinish(drop);
}
