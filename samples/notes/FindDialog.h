#pragma once

#include "afxwin.h"

/// What is looked for, and how.
struct FindOptions {
    CString text;
    BOOL wholeWord = FALSE;
    BOOL matchCase = FALSE;
};

/// Asks for a text to find.
class CFindDialog : public CDialog {
public:
    CFindDialog(const FindOptions& options, CWnd* parent);
    /// What was asked for, valid when DoModal has answered IDOK.
    const FindOptions& GetOptions() const {
        return m_options;
    }

protected:
    BOOL OnInitDialog() override;
    void DoDataExchange(CDataExchange* dx) override;
    afx_msg void OnText();
    afx_msg void OnHelpButton();
    DECLARE_MESSAGE_MAP()

private:
    FindOptions m_options;
};
