#pragma once

#include "afxext.h"
#include "afxwin.h"
#include "s/FloatMainFrame.h"
#include "s/StatusBar.h"

/// The main window: tool bar, status bar, drawings in between, which may be given windows of their own. It comes up
/// where it stood last, with its bars as they were.
class CMainFrame : public Gui_FloatMainFrame {
    DECLARE_DYNCREATE(CMainFrame)

public:
    BOOL PreCreateWindow(CREATESTRUCT& cs) override;
    void ActivateFrame(int command = -1) override;

    afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg void OnClose();
    afx_msg void OnRunCommand();
    afx_msg void OnConsole();
    afx_msg void OnWebBrowser();
    afx_msg void OnHelpSearch();

private:
    void saveWindows();

    bool m_placed = false;
    CToolBar m_toolBar;
    Gui_StatusBar m_statusBar;
    CString m_lastCommand;
    CString m_lastKeyword;

    DECLARE_MESSAGE_MAP()
};
