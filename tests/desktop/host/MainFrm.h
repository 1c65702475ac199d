// MainFrm.h : interface of the CMainFrame class

class CMainFrame : public CFrameWnd
{
protected: // create from serialization only
    DECLARE_DYNCREATE(CMainFrame)

public:
    virtual BOOL PreCreateWindow(CREATESTRUCT& cs);
    CToolBar    m_wndToolBar;

protected:  // control bar embedded members
    CStatusBar  m_wndStatusBar;

    //{{AFX_MSG(CMainFrame)
    afx_msg int OnCreate(LPCREATESTRUCT lpCreateStruct);
    afx_msg void OnWindowPosChanging(WINDOWPOS FAR* lpwndpos);
    afx_msg void OnWindowPosChanged(WINDOWPOS FAR* lpwndpos);
    //}}AFX_MSG
    DECLARE_MESSAGE_MAP()
};
