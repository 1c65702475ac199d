// Ledger.h : main header file for the LEDGER application

#if !defined(AFX_LEDGER_H__4C1D7B25_INCLUDED_)
#define AFX_LEDGER_H__4C1D7B25_INCLUDED_

#ifndef __AFXWIN_H__
    #error include 'stdafx.h' before including this file
#endif

#include "resource.h"       // main symbols

class CLedgerApp : public CWinApp
{
public:
    CLedgerApp();

// Overrides
    //{{AFX_VIRTUAL(CLedgerApp)
    public:
    virtual BOOL InitInstance();
    //}}AFX_VIRTUAL

// Implementation
    //{{AFX_MSG(CLedgerApp)
    afx_msg void OnAppAbout();
    //}}AFX_MSG
    DECLARE_MESSAGE_MAP()
};

#endif // !defined(AFX_LEDGER_H__4C1D7B25_INCLUDED_)
