#pragma once

#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Wnd.h"

/// A scroll bar that stands alone (SBS_HORZ, SBS_VERT). It tells its parent by WM_HSCROLL or WM_VSCROLL where the user
/// wants to go; the parent sets the position. A parent that does nothing leaves the slider where it was.
///
/// The part of the range that is seen at once is the page (SCROLLINFO::nPage); the last position is max - page + 1.
class TVX_PLATFORM_API CScrollBar : public CWnd {
    DECLARE_DYNAMIC(CScrollBar)

public:
    /// Creates the bar with SBS_HORZ or SBS_VERT; `rect` is its place in the parent's client area, in pixels. The range
    /// is empty until SetScrollRange or SetScrollInfo tells one. FALSE when creation was refused.
    BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);
    using CWnd::Create;

    /// Where the slider stands now; while it is dragged, the position of before (see SCROLLINFO::nTrackPos).
    int GetScrollPos() const {
        return static_cast<int>(SendMessage(SBM_GETPOS));
    }
    /// Moves the slider, as far as range and page let it, and answers where it was. The parent is not told.
    int SetScrollPos(int position, BOOL redraw = TRUE) {
        return static_cast<int>(SendMessage(SBM_SETPOS, static_cast<WPARAM>(position), redraw));
    }
    /// Stores the least and the greatest position; neither pointer may be null.
    void GetScrollRange(int* min, int* max) const {
        SendMessage(SBM_GETRANGE, reinterpret_cast<WPARAM>(min), reinterpret_cast<LPARAM>(max));
    }
    /// Sets the least and the greatest position. A slider outside comes to the nearer end.
    void SetScrollRange(int min, int max, BOOL redraw = TRUE) {
        SendMessage(SBM_SETRANGE, static_cast<WPARAM>(min), max);
    }
    /// Stores range, page, position and the position of a slider being dragged (nTrackPos), all of them whatever
    /// `mask` asks for. Answers TRUE.
    BOOL GetScrollInfo(SCROLLINFO* info, UINT mask = SIF_ALL) {
        info->fMask = mask;
        return static_cast<BOOL>(SendMessage(SBM_GETSCROLLINFO, 0, reinterpret_cast<LPARAM>(info)));
    }
    /// Sets what `info->fMask` names (SIF_RANGE, SIF_PAGE, SIF_POS) and leaves the rest. Answers where the slider
    /// stands then.
    BOOL SetScrollInfo(SCROLLINFO* info, BOOL redraw = TRUE) {
        return static_cast<BOOL>(
            SendMessage(SBM_SETSCROLLINFO, static_cast<WPARAM>(redraw), reinterpret_cast<LPARAM>(info)));
    }
};
