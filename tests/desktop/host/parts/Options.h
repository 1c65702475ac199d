// Options.h : the dialog of the options

#if !defined(AFX_OPTIONS_H__4C1D7B31_INCLUDED_)
#define AFX_OPTIONS_H__4C1D7B31_INCLUDED_

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

    //{{AFX_VIRTUAL(COptions)
    protected:
    virtual void DoDataExchange(CDataExchange* pDX);    // DDX/DDV support
    //}}AFX_VIRTUAL

protected:
    //{{AFX_MSG(COptions)
    virtual BOOL OnInitDialog();
    afx_msg void OnSelendokCurrency();
    //}}AFX_MSG
    DECLARE_MESSAGE_MAP()
};

#endif // !defined(AFX_OPTIONS_H__4C1D7B31_INCLUDED_)
