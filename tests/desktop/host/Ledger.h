// Ledger.h : main header file for the LEDGER application

#ifndef __AFXWIN_H__
    #error include 'stdafx.h' before including this file
#endif

#include "Resource.h"       // main symbols

class CLedgerApp : public CWinApp
{
public:
    //{{AFX_VIRTUAL(CLedgerApp)
    virtual BOOL InitInstance();
    //}}AFX_VIRTUAL

    //{{AFX_MSG(CLedgerApp)
    afx_msg void OnAppAbout();
    //}}AFX_MSG
    DECLARE_MESSAGE_MAP()
};
