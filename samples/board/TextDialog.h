#pragma once

#include "Resource.h"
#include "afxwin.h"

/// Asks for the text of a shape. Lines end with "\n" outside and with "\r\n" in the field.
class CTextDialog : public CDialog {
public:
    CTextDialog(LPCSTR text, CWnd* parent);
    /// What was typed, valid when DoModal has answered IDOK.
    CString GetText() const;

protected:
    void DoDataExchange(CDataExchange* dx) override;
    afx_msg void OnHelpButton();
    DECLARE_MESSAGE_MAP()

private:
    CString m_text;
};
