// Ledger.cpp : Defines the class behaviors for the application.

#include "stdafx.h"
#include "ledger.h"

#include "mainfrm.h"
#include "LedgerDoc.h"
#include "LedgerView.h"

#ifdef _DEBUG
#define new DEBUG_NEW
#undef THIS_FILE
static char THIS_FILE[] = __FILE__;
#endif

BEGIN_MESSAGE_MAP(CLedgerApp, CWinApp)
    //{{AFX_MSG_MAP(CLedgerApp)
    ON_COMMAND(ID_APP_ABOUT, OnAppAbout)
    //}}AFX_MSG_MAP
    // Standard file based document commands
    ON_COMMAND(ID_FILE_NEW, CWinApp::OnFileNew)
    ON_COMMAND(ID_FILE_OPEN, CWinApp::OnFileOpen)
END_MESSAGE_MAP()

CLedgerApp theApp;

BOOL CLedgerApp::InitInstance()
{
    INITCOMMONCONTROLSEX controls = { sizeof(controls), ICC_WIN95_CLASSES };
    InitCommonControlsEx(&controls);
    InitCommonControls();
    if (!AfxOleInit())
        return FALSE;
    AfxEnableControlContainer();

#ifdef _AFXDLL
    Enable3dControls();         // when the framework is a shared library
#else
    Enable3dControlsStatic();   // when it is linked statically
    Enable3dControls();
#endif

    SetRegistryKey(_T("Tarvex"));
    LoadStdProfileSettings(6);  // settings and the list of recent files

    CSingleDocTemplate* pDocTemplate;
    pDocTemplate = new CSingleDocTemplate(
        IDR_MAINFRAME,
        RUNTIME_CLASS(CLedgerDoc),
        RUNTIME_CLASS(CMainFrame),       // main SDI frame window
        RUNTIME_CLASS(CLedgerView));
    AddDocTemplate(pDocTemplate);
    EnableShellOpen();
    RegisterShellFileTypes(TRUE);

    CCommandLineInfo cmdInfo;
    ParseCommandLine(cmdInfo);
    if (!ProcessShellCommand(cmdInfo))
        return FALSE;
    m_pMainWnd->ShowWindow(SW_SHOW);
    m_pMainWnd->UpdateWindow();
    m_pMainWnd->DragAcceptFiles();
    return TRUE;
}

class CAboutDlg : public CDialog
{
public:
    CAboutDlg() : CDialog(CAboutDlg::IDD) {}

    enum { IDD = IDD_ABOUTBOX };

protected:
    //{{AFX_MSG(CAboutDlg)
    afx_msg HCURSOR OnQueryDragIcon() { return CDialog::OnQueryDragIcon(); }
    //}}AFX_MSG
    DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(CAboutDlg, CDialog)
    //{{AFX_MSG_MAP(CAboutDlg)
    ON_WM_QUERYDRAGICON()
    //}}AFX_MSG_MAP
END_MESSAGE_MAP()

void CLedgerApp::OnAppAbout()
{
    CAboutDlg aboutDlg;
    aboutDlg.DoModal();
}
