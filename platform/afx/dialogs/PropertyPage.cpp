#include "platform/afx/dialogs/PropertySheet.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/dialogs/detail/HelpOffered.h"
#include "platform/win/DialogTemplate.h"

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CPropertyPage, CDialog)

CPropertyPage::CPropertyPage(LPCSTR templateName, UINT captionId) : CDialog(templateName) {
    if (captionId != 0 && m_caption.LoadString(captionId)) {
        m_psp.dwFlags |= PSP_USETITLE;
        m_psp.pszTitle = m_caption;
    }
    if (isHelpOffered()) {
        m_psp.dwFlags |= PSP_HASHELP;
    }
}

CPropertyPage::CPropertyPage(UINT templateId, UINT captionId) : CPropertyPage(MAKEINTRESOURCE(templateId), captionId) {}

std::optional<tvx::DialogTemplate> CPropertyPage::describe() const {
    auto description = CDialog::describe();
    if (description) {
        // Templates of pages are written with captions, borders and other styles of windows of their own.
        description->style &= DWORD{DS_SETFONT};
        description->style |= WS_CHILD | DS_CONTROL;
        description->extendedStyle = 0;
        if ((m_psp.dwFlags & PSP_USETITLE) != 0 && m_psp.pszTitle) {
            description->title = m_psp.pszTitle;
        }
    }
    return description;
}

CPropertySheet* CPropertyPage::sheet() const {
    return m_hWnd ? dynamic_cast<CPropertySheet*>(GetParent()) : nullptr;
}

void CPropertyPage::SetModified(BOOL changed) {
    m_isModified = changed != FALSE;
    if (CPropertySheet* around = sheet()) {
        around->noteModified();
    }
}

void CPropertyPage::CancelToClose() {
    CPropertySheet* around = sheet();
    if (!around) {
        return;
    }
    CString close;
    (void)close.LoadString(TVX_IDS_CLOSE);
    around->SetDlgItemText(IDOK, close);
    if (CWnd* cancel = around->GetDlgItem(IDCANCEL)) {
        cancel->EnableWindow(FALSE);
    }
}

LRESULT CPropertyPage::QuerySiblings(WPARAM wParam, LPARAM lParam) {
    const CPropertySheet* around = sheet();
    for (int i = 0; around && i < around->GetPageCount(); ++i) {
        const CPropertyPage* page = around->GetPage(i);
        const LRESULT answer = page->m_hWnd ? page->SendMessage(PSM_QUERYSIBLINGS, wParam, lParam) : 0;
        if (answer != 0) {
            return answer;
        }
    }
    return 0;
}

// --- what the sheet tells ---

BOOL CPropertyPage::OnNotify(WPARAM wParam, LPARAM lParam, LRESULT* result) {
    if (CDialog::OnNotify(wParam, lParam, result)) {
        return TRUE;
    }
    const auto* header = reinterpret_cast<const NMHDR*>(lParam);
    const CWnd* around = GetParent();
    if (!around || header->hwndFrom != around->m_hWnd) {
        return FALSE;
    }
    *result = answer(header->code);
    return TRUE;
}

LRESULT CPropertyPage::answer(UINT code) {
    switch (code) {
    case PSN_SETACTIVE:
        return OnSetActive() ? 0 : -1;
    case PSN_KILLACTIVE:
        return OnKillActive() ? FALSE : TRUE;
    case PSN_APPLY:
        return OnApply() ? PSNRET_NOERROR : PSNRET_INVALID_NOCHANGEPAGE;
    case PSN_RESET:
        OnReset();
        return 0;
    case PSN_QUERYCANCEL:
        return OnQueryCancel() ? FALSE : TRUE;
    case PSN_HELP:
        requestHelp(m_hWnd);
        return 0;
    default:
        return 0;
    }
}

BOOL CPropertyPage::OnSetActive() {
    if (!m_isFilled) {
        UpdateData(FALSE);
    }
    m_isFilled = false;
    return TRUE;
}

BOOL CPropertyPage::OnKillActive() {
    return UpdateData(TRUE);
}

BOOL CPropertyPage::OnApply() {
    OnOK();
    return TRUE;
}

void CPropertyPage::OnReset() {
    OnCancel();
}

BOOL CPropertyPage::OnQueryCancel() {
    return TRUE;
}

void CPropertyPage::OnOK() {}

void CPropertyPage::OnCancel() {}
