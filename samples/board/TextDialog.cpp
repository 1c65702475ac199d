#include "TextDialog.h"

#include "s/Help.h"

// clang-format off
BEGIN_MESSAGE_MAP(CTextDialog, CDialog)
    ON_BN_CLICKED(IDHELP, &CTextDialog::OnHelpButton)
END_MESSAGE_MAP()
// clang-format on

CTextDialog::CTextDialog(LPCSTR text, CWnd* parent) : CDialog(IDD_TEXT, parent), m_text(text) {
    m_text.Replace("\n", "\r\n");
}

CString CTextDialog::GetText() const {
    CString text = m_text;
    text.Replace("\r\n", "\n");
    return text;
}

void CTextDialog::DoDataExchange(CDataExchange* dx) {
    CDialog::DoDataExchange(dx);
    DDX_Text(dx, IDC_TEXT, m_text);
}

void CTextDialog::OnHelpButton() {
    Gui_Help::OnDialog(IDD_TEXT);
}
