#pragma once

#include "afxext.h"
#include "afxwin.h"

/// The main window: tool bar above, status bar below, drawings in between.
class CMainFrame : public CMDIFrameWnd {
    DECLARE_DYNCREATE(CMainFrame)

public:
    BOOL PreCreateWindow(CREATESTRUCT& cs) override;
    afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg void OnRunCommand();

private:
    CToolBar m_toolBar;
    CStatusBar m_statusBar;
    CString m_lastCommand;

    DECLARE_MESSAGE_MAP()
};
