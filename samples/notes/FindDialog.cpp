#include "FindDialog.h"

#include "Resource.h"
#include "s/Help.h"

// clang-format off
BEGIN_MESSAGE_MAP(CFindDialog, CDialog)
    ON_EN_CHANGE(IDC_FIND_TEXT, &CFindDialog::OnText)
    ON_BN_CLICKED(IDHELP, &CFindDialog::OnHelpButton)
END_MESSAGE_MAP()
// clang-format on

CFindDialog::CFindDialog(const FindOptions& options, CWnd* parent) : CDialog(IDD_FIND, parent), m_options(options) {}

void CFindDialog::DoDataExchange(CDataExchange* dx) {
    CDialog::DoDataExchange(dx);
    DDX_Text(dx, IDC_FIND_TEXT, m_options.text);
    DDX_Check(dx, IDC_FIND_WORD, m_options.wholeWord);
    DDX_Check(dx, IDC_FIND_CASE, m_options.matchCase);
}

BOOL CFindDialog::OnInitDialog() {
    CDialog::OnInitDialog();
    OnText();
    return TRUE;
}

// Nothing cannot be found.
void CFindDialog::OnText() {
    GetDlgItem(IDOK)->EnableWindow(GetDlgItem(IDC_FIND_TEXT)->GetWindowTextLength() > 0);
}

void CFindDialog::OnHelpButton() {
    Gui_Help::OnDialog(IDD_FIND);
}
