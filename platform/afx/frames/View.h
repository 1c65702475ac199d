#pragma once

/// @file
/// CView: the window that shows a document.

#include "platform/afx/frames/Frame.h"

class CBrush;
class CDocument;

/// What printing would be told. There is no printer here: hosts fill it in and read it, nothing looks at it.
struct CPrintInfo {
    BOOL m_bPreview = FALSE; ///< Always FALSE, as m_bDirect.
    BOOL m_bDirect = FALSE;
    BOOL m_bContinuePrinting = TRUE; ///< FALSE would end the loop over the pages.
    UINT m_nCurPage = 1;             ///< The page to be printed.
    UINT m_nNumPreviewPages = 0;
    LPVOID m_lpUserData = nullptr; ///< The host's own.
    CRect m_rectDraw;              ///< Where a page may be drawn: nowhere.
    CString m_strPageDesc;

    /// The first and the last page; of unknown length at first.
    /// @{
    void SetMinPage(UINT page) {
        m_minPage = page;
    }
    void SetMaxPage(UINT page) {
        m_maxPage = page;
    }
    UINT GetMinPage() const {
        return m_minPage;
    }
    UINT GetMaxPage() const {
        return m_maxPage;
    }
    /// @}

private:
    UINT m_minPage = 1;
    UINT m_maxPage = 0xFFFF;
};

/// Shows (part of) a document and takes the user's input for it. Its document's template makes it with its frame; the
/// object deletes itself when its window has ended.
///
/// A derived class draws in OnDraw, reacts to changes in OnUpdate, and handles commands in its message map; those it
/// does not handle go to the document.
///
/// @code
/// void CBoardView::OnDraw(CDC* dc) {
///     for (const Shape& shape : GetDocument()->shapes()) shape.draw(*dc);
/// }
/// @endcode
class TVX_PLATFORM_API CView : public CWnd {
    DECLARE_DYNAMIC(CView)

public:
    ~CView() override;

    /// The document, null for a view without one.
    CDocument* GetDocument() const {
        return m_pDocument;
    }

    /// Draws the document. The context is prepared by OnPrepareDC.
    virtual void OnDraw(CDC* dc) = 0;
    /// Called once the view stands in its frame, before it is shown. The base calls OnUpdate.
    virtual void OnInitialUpdate();
    /// Called when the document has changed. The base repaints the whole view.
    /// @param sender the view that made the change, null for none; it is not called itself
    /// @param hint,object what CDocument::UpdateAllViews was given
    virtual void OnUpdate(CView* sender, LPARAM hint, CObject* object);
    /// Sets up a context for OnDraw: mapping mode, origin.
    /// @param info null: there is no printing here
    virtual void OnPrepareDC(CDC* dc, CPrintInfo* info = nullptr);
    /// Called when the view becomes its frame's active one, or ceases to be. The base gives it the keyboard.
    virtual void OnActivateView(BOOL activate, CView* activated, CView* deactivated);
    /// Called when the frame is activated or deactivated.
    virtual void OnActivateFrame(UINT state, CFrameWnd* frame);

    /// Printing. There is no printer here: the two commands ask OnPreparePrinting, and DoPreparePrinting, where a
    /// derived class's ends, tells the user so. The other members are there to be overridden; nobody calls them.
    /// @{

    /// In the map of a derived class these answer ID_FILE_PRINT and ID_FILE_PRINT_PREVIEW.
    afx_msg void OnFilePrint();
    afx_msg void OnFilePrintPreview();
    /// Whether printing is to begin. The base asks DoPreparePrinting.
    virtual BOOL OnPreparePrinting(CPrintInfo* info);
    /// Tells that there is no printer, and answers FALSE.
    BOOL DoPreparePrinting(CPrintInfo* info);
    virtual void OnBeginPrinting(CDC* dc, CPrintInfo* info) {}
    /// Draws a page. The base calls OnDraw.
    virtual void OnPrint(CDC* dc, CPrintInfo* info);
    virtual void OnEndPrinting(CDC* dc, CPrintInfo* info) {}
    /// @}

    BOOL PreCreateWindow(CREATESTRUCT& cs) override;
    void PostNcDestroy() override;
    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override;
    CScrollBar* GetScrollBarCtrl(int bar) const override;

    /// Ties the view to the document of its creation context.
    afx_msg int OnCreate(CREATESTRUCT* cs);
    /// Takes the view away as the frame's active one.
    afx_msg void OnDestroy();
    /// Prepares a context and calls OnDraw.
    afx_msg void OnPaint();
    /// A click makes the view its frame's active one, unless a handler answered that it must not activate.
    afx_msg int OnMouseActivate(CWnd* desktop, UINT hitTest, UINT message);
    /// The first update of the frame's windows: calls OnInitialUpdate.
    afx_msg LRESULT OnInitialUpdateMessage(WPARAM, LPARAM);

protected:
    CView() = default;
    friend class CDocument;
    friend class CFrameWnd;

    CDocument* m_pDocument = nullptr;

    DECLARE_MESSAGE_MAP()
};
