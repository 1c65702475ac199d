#include "platform/afx/core/CmdTarget.h"

#include "platform/afx/core/ControlMessages.h"

#include "platform/afx/core/Wnd.h"
#include "platform/afx/core/detail/Menus.h"

using namespace tvx::afx;

namespace {

/// The item of the menu that is being updated.
MenuItem* itemOf(const CCmdUI& element) {
    const HMENU menu = element.m_pMenu ? element.m_pMenu->m_hMenu : nullptr;
    const MenuPlace place = findItem(menu, element.m_nIndex, MF_BYPOSITION);
    return place ? &place.item() : nullptr;
}

} // namespace

void CCmdUI::Enable(BOOL on) {
    m_bEnableChanged = TRUE;
    if (m_pMenu) {
        // A popup stays open to those who want to see what is in it.
        if (!m_pSubMenu) {
            m_pMenu->EnableMenuItem(m_nIndex, MF_BYPOSITION | (on ? MF_ENABLED : MF_DISABLED | MF_GRAYED));
        }
        return;
    }
    if (!m_pOther) {
        return;
    }
    if (!on && CWnd::GetFocus() == m_pOther) {
        // A disabled control must not keep the keyboard.
        CWnd* parent = m_pOther->GetParent();
        CWnd* next = parent ? parent->GetNextDlgTabItem(m_pOther) : nullptr;
        if (next && next != m_pOther) {
            next->SetFocus();
        }
    }
    m_pOther->EnableWindow(on);
}

void CCmdUI::SetCheck(int check) {
    if (m_pMenu) {
        if (!m_pSubMenu) {
            m_pMenu->CheckMenuItem(m_nIndex, MF_BYPOSITION | (check != 0 ? MF_CHECKED : MF_UNCHECKED));
        }
    } else if (m_pOther && (m_pOther->SendMessage(WM_GETDLGCODE) & DLGC_BUTTON) != 0) {
        m_pOther->SendMessage(BM_SETCHECK, static_cast<WPARAM>(check));
    }
}

void CCmdUI::SetRadio(BOOL on) {
    SetCheck(on ? 1 : 0);
    MenuItem* item = itemOf(*this);
    if (item && !m_pSubMenu) {
        item->mark = MenuItem::Mark::Radio;
        tellMenuChanged(m_pMenu->m_hMenu);
    }
}

void CCmdUI::SetText(LPCSTR text) {
    if (MenuItem* item = itemOf(*this)) {
        if (!m_pSubMenu) {
            item->text = text;
            tellMenuChanged(m_pMenu->m_hMenu);
        }
    } else if (m_pOther) {
        CString before;
        m_pOther->GetWindowText(before);
        if (before != text) {
            m_pOther->SetWindowText(text);
        }
    }
}

void CCmdUI::ContinueRouting() {
    m_bContinueRouting = TRUE;
}

BOOL CCmdUI::DoUpdate(CCmdTarget* target, BOOL disableIfNoHandler) {
    if (m_nID == 0 || LOWORD(m_nID) == 0xFFFF) {
        return TRUE; // separators and what stands for no command
    }
    m_bEnableChanged = FALSE;
    const BOOL found = target->OnCmdMsg(m_nID, CN_UPDATE_COMMAND_UI, this, nullptr);
    if (disableIfNoHandler && !m_bEnableChanged) {
        AFX_CMDHANDLERINFO info;
        info.pTarget = nullptr;
        Enable(target->OnCmdMsg(m_nID, CN_COMMAND, this, &info));
    }
    return found;
}
