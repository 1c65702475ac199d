#pragma once

#include "FindDialog.h"
#include "NotesDoc.h"
#include "NotesEdit.h"

/// Shows the text in an edit control that fills the view, and takes what the Edit menu does with it.
class CNotesView : public CView {
    DECLARE_DYNCREATE(CNotesView)

public:
    CNotesDoc* GetDocument() const {
        return static_cast<CNotesDoc*>(m_pDocument);
    }
    /// The text as it stands in the control, with "\r\n" between lines.
    std::string GetText() const;
    /// Tells that it has been saved as it is. What was done before can still be undone.
    void SetSaved();

    void OnDraw(CDC*) override {}
    void OnUpdate(CView* sender, LPARAM hint, CObject* object) override;

    afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg void OnSize(UINT type, int cx, int cy);
    afx_msg void OnSetFocus(CWnd* previous);
    afx_msg void OnContextMenu(CWnd* window, CPoint point);
    afx_msg void OnChange();
    afx_msg void OnEditUndo();
    afx_msg void OnEditCut();
    afx_msg void OnEditCopy();
    afx_msg void OnEditPaste();
    afx_msg void OnEditClear();
    afx_msg void OnEditSelectAll();
    afx_msg void OnEditFind();
    afx_msg void OnEditRepeat();
    afx_msg void OnViewFont();
    afx_msg void OnUpdateUndo(CCmdUI* item);
    afx_msg void OnUpdateSelected(CCmdUI* item);
    afx_msg void OnUpdatePaste(CCmdUI* item);
    afx_msg void OnUpdatePosition(CCmdUI* item);

private:
    bool findFrom(int start);
    void setFont(const LOGFONT& font);

    CNotesEdit m_edit;
    CFont m_font;
    FindOptions m_find;

    DECLARE_MESSAGE_MAP()
};
