// LedgerView.h : interface of the CLedgerView class

#if !defined(AFX_LEDGERVIEW_H__4C1D7B2B_INCLUDED_)
#define AFX_LEDGERVIEW_H__4C1D7B2B_INCLUDED_

class CLedgerView : public CView
{
protected: // create from serialization only
    CLedgerView();
    DECLARE_DYNCREATE(CLedgerView)

// Attributes
public:
    CLedgerDoc* GetDocument();
    LOGFONT     m_logFont;
    COLORREF    m_crText;
    BOOL        m_bRuled;
    CString     m_strTyped;     // the line that has no end yet

// Operations
    void PlaceCaret();
    int  LineHeight() { return -MulDiv(m_logFont.lfHeight, 3, 2); }

    //{{AFX_VIRTUAL(CLedgerView)
    public:
    virtual void OnDraw(CDC* pDC);  // overridden to draw this view
    virtual BOOL PreCreateWindow(CREATESTRUCT& cs);
    protected:
    virtual BOOL OnPreparePrinting(CPrintInfo* pInfo);
    virtual void OnBeginPrinting(CDC* pDC, CPrintInfo* pInfo);
    virtual void OnPrint(CDC* pDC, CPrintInfo* pInfo);
    virtual void OnEndPrinting(CDC* pDC, CPrintInfo* pInfo);
    virtual void OnEndPrintPreview(CDC* pDC, CPrintInfo* pInfo, POINT point, CPreviewView* pView);
    //}}AFX_VIRTUAL

    virtual ~CLedgerView();

protected:
    //{{AFX_MSG(CLedgerView)
    afx_msg void OnChar(UINT nChar, UINT nRepCnt, UINT nFlags);
    afx_msg void OnSetFocus(CWnd* pOldWnd);
    afx_msg void OnKillFocus(CWnd* pNewWnd);
    afx_msg void OnFormatFont();
    afx_msg void OnFormatColor();
    afx_msg void OnToolsOptions();
    afx_msg void OnToolsNames();
    afx_msg void OnToolsRuled();
    afx_msg void OnUpdateToolsRuled(CCmdUI* pCmdUI);
    afx_msg LRESULT OnAddLine(WPARAM wParam, LPARAM lParam);
    //}}AFX_MSG
    DECLARE_MESSAGE_MAP()
};

#ifndef _DEBUG  // debug version in LedgerView.cpp
inline CLedgerDoc* CLedgerView::GetDocument()
   { return (CLedgerDoc*)m_pDocument; }
#endif

#endif // !defined(AFX_LEDGERVIEW_H__4C1D7B2B_INCLUDED_)
