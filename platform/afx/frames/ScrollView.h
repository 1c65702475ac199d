#pragma once

/// @file
/// CScrollView: a view that is a window onto a larger drawing.

#include "platform/afx/frames/View.h"

/// A view with scroll bars. Tell the size of the drawing with SetScrollSizes (in OnInitialUpdate, and again when it
/// changes); from then on OnPrepareDC moves the origin so that OnDraw draws as if the whole drawing were visible.
///
/// Scroll bars appear when the drawing is larger than the view. The arrow keys, Page Up and Down, Home, End and the
/// wheel scroll. Scrolling moves what is drawn already and repaints the rest.
class TVX_PLATFORM_API CScrollView : public CView {
    DECLARE_DYNAMIC(CScrollView)

public:
    /// The default for SetScrollSizes: a tenth of the drawing a page, a tenth of that a line.
    static const SIZE sizeDefault;

    /// Tells the size of the drawing.
    /// @param mapMode MM_...; the sizes are in its units. Not MM_ISOTROPIC or MM_ANISOTROPIC
    /// @param total   size of the drawing; both at least 0
    /// @param page,line how far a click into the bar and on its arrows goes
    void SetScrollSizes(int mapMode, SIZE total, const SIZE& page = sizeDefault, const SIZE& line = sizeDefault);
    /// Scales the drawing to the size of the view instead of scrolling. Never enlarges beyond what fits.
    /// @param total size of the drawing in logical units
    void SetScaleToFitSize(SIZE total);

    /// The point of the drawing at the view's top left corner, in logical units.
    CPoint GetScrollPosition() const;
    /// The same in pixels.
    CPoint GetDeviceScrollPosition() const;
    /// Scrolls so that `point` (logical units) comes to the top left corner, as far as the drawing reaches.
    void ScrollToPosition(POINT point);
    /// The whole size of the drawing in logical units.
    CSize GetTotalSize() const;
    /// Mapping mode and sizes as they were told; pixels for the sizes of a step.
    void GetDeviceScrollSizes(int& mapMode, SIZE& total, SIZE& page, SIZE& line) const;
    /// Makes the frame around the view so large that the whole drawing is seen; needs sizes and a frame.
    /// @param shrinkOnly TRUE never enlarges the frame
    void ResizeParentToFit(BOOL shrinkOnly = TRUE);
    /// Fills the part of the view right of and below a drawing that is smaller, for OnEraseBkgnd of a host that gives
    /// the paper another colour. `dc` counts in pixels of the client area.
    void FillOutsideRect(CDC* dc, CBrush* brush);

    void OnPrepareDC(CDC* dc, CPrintInfo* info = nullptr) override;
    BOOL PreCreateWindow(CREATESTRUCT& cs) override;
    /// Scrolls by a code of both bars (low byte horizontal, next byte vertical; 0xFF none). FALSE when nothing moved
    /// or, with `doScroll` FALSE, would move.
    virtual BOOL OnScroll(UINT code, UINT position, BOOL doScroll = TRUE);
    /// Scrolls by pixels, as far as the drawing reaches.
    virtual BOOL OnScrollBy(CSize distance, BOOL doScroll = TRUE);

    afx_msg void OnSize(UINT type, int cx, int cy);
    afx_msg void OnHScroll(UINT code, UINT position, CScrollBar* bar);
    afx_msg void OnVScroll(UINT code, UINT position, CScrollBar* bar);
    afx_msg BOOL OnMouseWheel(UINT flags, short delta, CPoint point);
    afx_msg void OnKeyDown(UINT key, UINT repeat, UINT flags);

protected:
    CScrollView() = default;
    /// Brings bars and position into line with the sizes. Called by the framework.
    void UpdateBars();

    DECLARE_MESSAGE_MAP()

private:
    void scrollToDevice(CPoint position);
    CPoint limits() const;
    int m_mapMode = 0;
    CSize m_totalLog{0, 0};
    CSize m_totalDev{0, 0};
    CSize m_pageDev{0, 0};
    CSize m_lineDev{0, 0};
    CPoint m_position{0, 0};
    int m_wheelRest = 0;
    bool m_updatingBars = false;
};
