#pragma once

#include "Resource.h"
#include "afxwin.h"

/// Asks for the text of a shape. Lines end with "\n" outside and with "\r\n" in the field.
class CTextDialog : public CDialog {
public:
    CTextDialog(LPCSTR text, CWnd* parent) : CDialog(IDD_TEXT, parent), m_text(text) {
        m_text.Replace("\n", "\r\n");
    }
    /// What was typed, valid when DoModal has answered IDOK.
    CString GetText() const {
        CString text = m_text;
        text.Replace("\r\n", "\n");
        return text;
    }

protected:
    void DoDataExchange(CDataExchange* dx) override {
        CDialog::DoDataExchange(dx);
        DDX_Text(dx, IDC_TEXT, m_text);
    }

private:
    CString m_text;
};
