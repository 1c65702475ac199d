// LedgerView.h : interface of the CLedgerView class

class CLedgerView : public CView
{
protected: // create from serialization only
    CLedgerView();
    DECLARE_DYNCREATE(CLedgerView)

public:
    CLedgerDoc* GetDocument() { return (CLedgerDoc*)m_pDocument; }
    LOGFONT     m_logFont;
    COLORREF    m_crText;
    BOOL        m_bRuled;
    CString     m_strTyped;     // the line that has no end yet

    void PlaceCaret();
    int  LineHeight() { return -MulDiv(m_logFont.lfHeight, 3, 2); }

    //{{AFX_VIRTUAL(CLedgerView)
    virtual void OnDraw(CDC* pDC);  // overridden to draw this view
    protected:
    virtual BOOL OnPreparePrinting(CPrintInfo* pInfo);
    virtual void OnBeginPrinting(CDC* pDC, CPrintInfo* pInfo);
    virtual void OnPrint(CDC* pDC, CPrintInfo* pInfo);
    virtual void OnEndPrinting(CDC* pDC, CPrintInfo* pInfo);
    //}}AFX_VIRTUAL

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

// In Names.cpp: calls what old sources call, and tells what is not as it should be.
void TellNames(CLedgerView& view, CStringArray& lines);
