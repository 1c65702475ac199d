#pragma once

#include "afxext.h"
#include "s/FrameWnd.h"
#include "s/StatusBar.h"

/// The main window: tool bar, text, status bar. That it comes up where it stood last, with its bars as they were, is
/// its base's doing.
class CMainFrame : public Gui_FrameWnd {
    DECLARE_DYNCREATE(CMainFrame)

public:
    BOOL PreCreateWindow(CREATESTRUCT& cs) override;
    afx_msg int OnCreate(CREATESTRUCT* cs);

private:
    CToolBar m_toolBar;
    Gui_StatusBar m_statusBar;

    DECLARE_MESSAGE_MAP()
};
