// Options.h : the dialog of the options

#include "..\Resource.h"

class COptions : public CDialog
{
public:
    COptions(CWnd* pParent = NULL);   // standard constructor

    //{{AFX_DATA(COptions)
    enum { IDD = IDD_OPTIONS };
    CComboBox   m_wndCurrency;
    CString     m_strName;
    int         m_nCurrency;
    //}}AFX_DATA

protected:
    virtual void DoDataExchange(CDataExchange* pDX);    // DDX/DDV support

    //{{AFX_MSG(COptions)
    virtual BOOL OnInitDialog();
    afx_msg void OnSelendokCurrency();
    //}}AFX_MSG
    DECLARE_MESSAGE_MAP()
};
