#pragma once

#include "BoardDoc.h"
#include "Drawing.h"
#include "Options.h"
#include "afxwin.h"

#include <optional>

namespace board {

/// What the mouse does, in the order of the commands from ID_TOOL_SELECT.
enum class Tool { Select, Rectangle, Ellipse, Line, Text };

} // namespace board

/// Shows a drawing and changes it with the mouse.
class CBoardView : public CScrollView {
    DECLARE_DYNCREATE(CBoardView)

public:
    CBoardDoc* GetDocument() const {
        return static_cast<CBoardDoc*>(m_pDocument);
    }

    void OnDraw(CDC* dc) override;
    void OnInitialUpdate() override;
    void OnUpdate(CView* sender, LPARAM hint, CObject* object) override;
    BOOL PreCreateWindow(CREATESTRUCT& cs) override;
    /// Follows options that have come into force.
    void OptionsChanged(const Options& before);
    void OnActivateView(BOOL activate, CView* activated, CView* deactivated) override;

    afx_msg BOOL OnEraseBkgnd(CDC* dc);
    afx_msg void OnLButtonDown(UINT flags, CPoint point);
    afx_msg void OnMouseMove(UINT flags, CPoint point);
    afx_msg void OnLButtonUp(UINT flags, CPoint point);
    afx_msg void OnLButtonDblClk(UINT flags, CPoint point);
    afx_msg void OnCaptureChanged(CWnd* window);
    afx_msg void OnContextMenu(CWnd* window, CPoint point);
    afx_msg void OnKeyDown(UINT key, UINT repeat, UINT flags);
    afx_msg BOOL OnSetCursor(CWnd* window, UINT hitTest, UINT message);

    afx_msg void OnTool(UINT id);
    afx_msg void OnUpdateTool(CCmdUI* item);
    afx_msg void OnColor(UINT id);
    afx_msg void OnUpdateColor(CCmdUI* item);
    afx_msg void OnFill(UINT id);
    afx_msg void OnUpdateFill(CCmdUI* item);
    afx_msg void OnEditClear();
    afx_msg void OnEditText();
    afx_msg void OnToFront();
    afx_msg void OnToBack();
    afx_msg void OnUpdateSelected(CCmdUI* item);
    afx_msg void OnUpdateEditText(CCmdUI* item);
    afx_msg void OnUpdatePosition(CCmdUI* item);

private:
    /// What a drag does with the draft: moves it, or moves one of its handles.
    enum class Drag { None, Move, Resize };

    const board::Shape* Selected() const;
    void Select(int index);
    /// The selected shape's handle at the point: 0 to 3 for a box's corners (from, its right, to, its left), 0 and 2
    /// for the ends of a line; -1 for none.
    int HandleAt(board::Point point) const;
    board::Point ToDrawing(CPoint point) const;
    board::Point Snapped(board::Point point) const;
    void TakeColors();

    void StartDrawing(board::Point point);
    void StartSelecting(board::Point point);
    void StartDrag(Drag drag, int handle, board::Point point);
    void EndDrag(bool keep);
    void KeepDraft();
    void ReplaceSelected(board::Shape shape);
    void MoveSelected(int place);
    void ShowScrollArea();
    const board::Shape* Marked() const;
    void InvalidateArea(CRect area);
    void InvalidateMarked();

    void DrawGrid(CDC& dc) const;
    void DrawHandles(CDC& dc, const board::Shape& shape) const;

    board::Tool m_tool = board::Tool::Select;
    board::Color m_color = 0;
    board::Color m_fill = board::noColor;
    int m_selected = -1;
    board::Point m_pointer; ///< Where the mouse is, for the status bar.

    Drag m_drag = Drag::None;
    int m_handle = -1;
    board::Point m_last;
    std::optional<board::Shape> m_draft; ///< The shape being drawn, moved or resized.
    bool m_draftIsNew = false;
    CRect m_markedArea; ///< Where draft and handles were when they were drawn last, in the drawing's coordinates.

    DECLARE_MESSAGE_MAP()
};
