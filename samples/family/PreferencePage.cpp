#include "PreferencePage.h"

#include "Preferences.h"
#include "s/Help.h"

CPreferencePage::CPreferencePage(UINT templateId, CPreferences& sheet)
    : CDialog(templateId), m_template(templateId), m_sheet(sheet) {}

BOOL CPreferencePage::Create(CWnd* parent) {
    m_isFilling = true;
    const BOOL made = CDialog::Create(m_template, parent);
    m_isFilling = false;
    return made;
}

BOOL CPreferencePage::OnInitDialog() {
    CDialog::OnInitDialog();
    return FALSE; // the keyboard stays in the tree until the user comes here
}

void CPreferencePage::Show() {
    m_isFilling = true;
    UpdateData(FALSE);
    m_isFilling = false;
}

bool CPreferencePage::Take() {
    return UpdateData(TRUE) != FALSE;
}

void CPreferencePage::ShowDefaults() {
    SetDefaults();
    Show();
    SetChanged();
}

void CPreferencePage::SetChanged() {
    m_sheet.SetPageChanged(*this);
}

// Enter and Esc mean the buttons of the sheet, wherever the keyboard is.
void CPreferencePage::OnOK() {
    m_sheet.PostMessage(WM_COMMAND, IDOK);
}

void CPreferencePage::OnCancel() {
    m_sheet.PostMessage(WM_COMMAND, IDCANCEL);
}

BOOL CPreferencePage::OnCommand(WPARAM wParam, LPARAM lParam) {
    const UINT code = HIWORD(wParam);
    const auto* control = CWnd::FromHandle(reinterpret_cast<HWND>(lParam));
    const bool isButton = control && (control->SendMessage(WM_GETDLGCODE) & DLGC_BUTTON) != 0;
    const bool isPush = isButton && (control->GetStyle() & 0x0F) <= BS_DEFPUSHBUTTON; // opens something else
    const bool changes = isButton ? code == BN_CLICKED && !isPush : code == EN_CHANGE || code == CBN_SELCHANGE;
    if (lParam != 0 && changes && !m_isFilling) {
        SetChanged();
    }
    return CDialog::OnCommand(wParam, lParam);
}

void OnPreferencePage(Gui_PropItem* item, CWnd* page, Gui_PropItem::Notification what) {
    auto* const fields = static_cast<CPreferencePage*>(page);
    auto* const sheet = static_cast<CPreferences*>(item->GetPropSheet());
    if (!fields) {
        return;
    }
    switch (what) {
    case Gui_PropItem::NotifyActivate:
    case Gui_PropItem::NotifyReactivate:
        fields->Show();
        break;
    case Gui_PropItem::NotifyDeactivate:
        fields->Take();
        break;
    case Gui_PropItem::NotifyApply:
        if (!fields->Take()) {
            sheet->DontClose();
        } else {
            sheet->Store();
        }
        break;
    case Gui_PropItem::NotifyHelp:
        Gui_Help::OnDialog(fields->GetTopic());
        break;
    case Gui_PropItem::NotifyFocusFirst:
        sheet->FocusPage(*fields, false);
        break;
    case Gui_PropItem::NotifyFocusLast:
        sheet->FocusPage(*fields, true);
        break;
    }
}
