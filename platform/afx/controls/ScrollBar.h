#pragma once

#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Wnd.h"

/// A scroll bar that stands alone (SBS_HORZ, SBS_VERT). It tells its parent by WM_HSCROLL or WM_VSCROLL where the user
/// wants to go; the parent sets the position.
class TVX_PLATFORM_API CScrollBar : public CWnd {
    DECLARE_DYNAMIC(CScrollBar)

public:
    BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);
    using CWnd::Create;

    int GetScrollPos() const {
        return static_cast<int>(SendMessage(SBM_GETPOS));
    }
    /// Answers the previous position.
    int SetScrollPos(int position, BOOL redraw = TRUE) {
        return static_cast<int>(SendMessage(SBM_SETPOS, static_cast<WPARAM>(position), redraw));
    }
    void GetScrollRange(int* min, int* max) const {
        SendMessage(SBM_GETRANGE, reinterpret_cast<WPARAM>(min), reinterpret_cast<LPARAM>(max));
    }
    void SetScrollRange(int min, int max, BOOL redraw = TRUE) {
        SendMessage(SBM_SETRANGE, static_cast<WPARAM>(min), max);
    }
    BOOL GetScrollInfo(SCROLLINFO* info, UINT mask = SIF_ALL) {
        info->fMask = mask;
        return static_cast<BOOL>(SendMessage(SBM_GETSCROLLINFO, 0, reinterpret_cast<LPARAM>(info)));
    }
    BOOL SetScrollInfo(SCROLLINFO* info, BOOL redraw = TRUE) {
        return static_cast<BOOL>(
            SendMessage(SBM_SETSCROLLINFO, static_cast<WPARAM>(redraw), reinterpret_cast<LPARAM>(info)));
    }
};
