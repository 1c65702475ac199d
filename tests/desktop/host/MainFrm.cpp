// MainFrm.cpp : implementation of the CMainFrame class

#include "stdafx.h"
#include "Ledger.h"

#include "MainFrm.h"

IMPLEMENT_DYNCREATE(CMainFrame, CFrameWnd)

BEGIN_MESSAGE_MAP(CMainFrame, CFrameWnd)
    //{{AFX_MSG_MAP(CMainFrame)
    ON_WM_CREATE()
    ON_WM_WINDOWPOSCHANGING()
    ON_WM_WINDOWPOSCHANGED()
    //}}AFX_MSG_MAP
END_MESSAGE_MAP()

static UINT indicators[] =
{
    ID_SEPARATOR,           // status line indicator
    ID_INDICATOR_CAPS,
    ID_INDICATOR_NUM,
};

int CMainFrame::OnCreate(LPCREATESTRUCT lpCreateStruct)
{
    if (CFrameWnd::OnCreate(lpCreateStruct) == -1)
        return -1;
    if (!m_wndToolBar.CreateEx(this, TBSTYLE_FLAT, WS_CHILD | WS_VISIBLE | CBRS_TOP
        | CBRS_GRIPPER | CBRS_TOOLTIPS | CBRS_FLYBY | CBRS_SIZE_DYNAMIC) ||
        !m_wndToolBar.LoadToolBar(IDR_MAINFRAME))
    {
        TRACE0("Failed to create toolbar\n");
        return -1;      // fail to create
    }
    if (!m_wndStatusBar.Create(this) ||
        !m_wndStatusBar.SetIndicators(indicators,
          sizeof(indicators)/sizeof(UINT)))
        return -1;      // fail to create
    m_wndToolBar.EnableDocking(CBRS_ALIGN_ANY);
    EnableDocking(CBRS_ALIGN_ANY);
    DockControlBar(&m_wndToolBar);
    return 0;
}

BOOL CMainFrame::PreCreateWindow(CREATESTRUCT& cs)
{
    cs.cx = min(640, GetSystemMetrics(SM_CXSCREEN));
    cs.cy = min(cs.cx * 3L / 4, (LONG)480);
    return CFrameWnd::PreCreateWindow(cs);
}

void CMainFrame::OnWindowPosChanging(WINDOWPOS FAR* lpwndpos)
{
    CFrameWnd::OnWindowPosChanging(lpwndpos);
    lpwndpos->cx = max(lpwndpos->cx, 200);
}

void CMainFrame::OnWindowPosChanged(WINDOWPOS FAR* lpwndpos)
{
    CFrameWnd::OnWindowPosChanged(lpwndpos);
    lpwndpos->flags |= SWP_NOMOVE;
}
