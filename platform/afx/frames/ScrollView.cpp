#include "platform/afx/frames/ScrollView.h"

#include "platform/afx/gdi/Dc.h"

#include <algorithm>

IMPLEMENT_DYNAMIC(CScrollView, CView)

// clang-format off
BEGIN_MESSAGE_MAP(CScrollView, CView)
    ON_WM_SIZE()
    ON_WM_HSCROLL()
    ON_WM_VSCROLL()
    ON_WM_MOUSEWHEEL()
    ON_WM_KEYDOWN()
END_MESSAGE_MAP()
// clang-format on

const SIZE CScrollView::sizeDefault = {0, 0};

namespace {

/// Stands in m_mapMode for a drawing that is scaled to the view.
constexpr int scaleToFit = -1;
/// Lines that one notch of the wheel scrolls.
constexpr int wheelLines = 3;

} // namespace

BOOL CScrollView::PreCreateWindow(CREATESTRUCT& cs) {
    return CView::PreCreateWindow(cs);
}

// --- sizes ---

void CScrollView::SetScrollSizes(int mapMode, SIZE total, const SIZE& page, const SIZE& line) {
    const int oldMode = std::exchange(m_mapMode, mapMode);
    m_totalLog = total;
    // The screen's context: sizes may be told before the view has a window.
    CClientDC dc(nullptr);
    dc.SetMapMode(mapMode);
    const auto toDevice = [&dc](SIZE size) {
        dc.LPtoDP(&size);
        return CSize(size);
    };
    m_totalDev = toDevice(total);
    m_pageDev = toDevice(page);
    m_lineDev = toDevice(line);
    const auto complete = [](LONG& step, LONG whole, int part) {
        if (step == 0) {
            step = whole / part;
        }
    };
    complete(m_pageDev.cx, m_totalDev.cx, 10);
    complete(m_pageDev.cy, m_totalDev.cy, 10);
    complete(m_lineDev.cx, m_pageDev.cx, 10);
    complete(m_lineDev.cy, m_pageDev.cy, 10);
    if (m_hWnd) {
        UpdateBars();
        if (oldMode != mapMode) {
            Invalidate(TRUE);
        }
    }
}

void CScrollView::SetScaleToFitSize(SIZE total) {
    m_mapMode = scaleToFit;
    m_totalLog = total;
    m_position = CPoint(0, 0);
    if (m_hWnd) {
        ShowScrollBar(SB_BOTH, FALSE);
        CRect client;
        GetClientRect(&client);
        m_totalDev = client.Size();
        Invalidate(TRUE);
    }
}

void CScrollView::OnPrepareDC(CDC* dc, CPrintInfo*) {
    if (m_mapMode == scaleToFit) {
        dc->SetMapMode(MM_ANISOTROPIC);
        dc->SetWindowExt(m_totalLog);
        dc->SetViewportExt(m_totalDev);
        return;
    }
    if (m_mapMode != 0) {
        dc->SetMapMode(m_mapMode);
        dc->SetViewportOrg(-m_position.x, -m_position.y);
    }
}

CPoint CScrollView::GetDeviceScrollPosition() const {
    return m_position;
}

CPoint CScrollView::GetScrollPosition() const {
    if (m_mapMode == scaleToFit || m_mapMode == 0) {
        return {0, 0};
    }
    CPoint point = m_position;
    CClientDC dc(nullptr);
    dc.SetMapMode(m_mapMode);
    dc.DPtoLP(&point);
    return point;
}

CSize CScrollView::GetTotalSize() const {
    return m_totalLog;
}

void CScrollView::GetDeviceScrollSizes(int& mapMode, SIZE& total, SIZE& page, SIZE& line) const {
    mapMode = m_mapMode;
    total = m_totalDev;
    page = m_pageDev;
    line = m_lineDev;
}

void CScrollView::ScrollToPosition(POINT point) {
    if (m_mapMode == scaleToFit || m_mapMode == 0) {
        return;
    }
    CClientDC dc(nullptr);
    dc.SetMapMode(m_mapMode);
    dc.LPtoDP(&point);
    scrollToDevice(point);
}

CPoint CScrollView::limits() const {
    CRect client;
    GetClientRect(&client);
    return {std::max<LONG>(0, m_totalDev.cx - client.Width()), std::max<LONG>(0, m_totalDev.cy - client.Height())};
}

void CScrollView::UpdateBars() {
    if (m_mapMode == scaleToFit || m_updatingBars) {
        return;
    }
    m_updatingBars = true; // showing a bar changes the size of the view
    const auto fits = [this] {
        CRect client;
        GetClientRect(&client);
        return std::pair(m_totalDev.cx <= client.Width(), m_totalDev.cy <= client.Height());
    };
    ShowScrollBar(SB_BOTH, FALSE);
    const auto [wide, high] = fits();
    ShowScrollBar(SB_HORZ, !wide);
    ShowScrollBar(SB_VERT, !high);
    // One bar takes the room that the other direction needed.
    const auto [stillWide, stillHigh] = fits();
    ShowScrollBar(SB_HORZ, !stillWide);
    ShowScrollBar(SB_VERT, !stillHigh);
    CRect client;
    GetClientRect(&client);
    SCROLLINFO info{};
    info.cbSize = sizeof(info);
    info.fMask = SIF_RANGE | SIF_PAGE;
    info.nMax = std::max<int>(0, m_totalDev.cx - 1);
    info.nPage = static_cast<UINT>(client.Width());
    SetScrollInfo(SB_HORZ, &info);
    info.nMax = std::max<int>(0, m_totalDev.cy - 1);
    info.nPage = static_cast<UINT>(client.Height());
    SetScrollInfo(SB_VERT, &info);
    m_updatingBars = false;
    const CPoint before = m_position;
    scrollToDevice(m_position);
    if (before == m_position) {
        SetScrollPos(SB_HORZ, m_position.x);
        SetScrollPos(SB_VERT, m_position.y);
    }
}

void CScrollView::scrollToDevice(CPoint position) {
    const CPoint limit = limits();
    position.x = std::clamp<LONG>(position.x, 0, limit.x);
    position.y = std::clamp<LONG>(position.y, 0, limit.y);
    if (position == m_position) {
        return;
    }
    const CPoint before = std::exchange(m_position, position);
    SetScrollPos(SB_HORZ, position.x);
    SetScrollPos(SB_VERT, position.y);
    ScrollWindow(before.x - position.x, before.y - position.y);
}

// --- scrolling ---

BOOL CScrollView::OnScrollBy(CSize distance, BOOL doScroll) {
    const CPoint limit = limits();
    const CPoint target(std::clamp<LONG>(m_position.x + distance.cx, 0, limit.x),
                        std::clamp<LONG>(m_position.y + distance.cy, 0, limit.y));
    if (target == m_position) {
        return FALSE;
    }
    if (doScroll) {
        scrollToDevice(target);
    }
    return TRUE;
}

namespace {

/// How far one bar's code moves, in pixels.
int distanceOf(BYTE code, UINT position, int now, int page, int line, int limit) {
    switch (code) {
    case SB_TOP:
        return -now;
    case SB_BOTTOM:
        return limit - now;
    case SB_LINEUP:
        return -line;
    case SB_LINEDOWN:
        return line;
    case SB_PAGEUP:
        return -page;
    case SB_PAGEDOWN:
        return page;
    case SB_THUMBTRACK:
    case SB_THUMBPOSITION:
        return static_cast<int>(position) - now;
    default:
        return 0;
    }
}

} // namespace

BOOL CScrollView::OnScroll(UINT code, UINT position, BOOL doScroll) {
    const CPoint limit = limits();
    const int dx = distanceOf(LOBYTE(code), position, m_position.x, m_pageDev.cx, m_lineDev.cx, limit.x);
    const int dy = distanceOf(HIBYTE(code), position, m_position.y, m_pageDev.cy, m_lineDev.cy, limit.y);
    const BOOL moved = OnScrollBy(CSize(dx, dy), doScroll);
    // Painted at once: while the slider is dragged, messages come faster than the loop gets to painting.
    if (moved && doScroll) {
        UpdateWindow();
    }
    return moved;
}

namespace {

/// Positions beyond 16 bits do not fit a message; the bar knows them.
UINT trackPosition(CWnd& view, int bar, UINT code, UINT position) {
    if (code != SB_THUMBTRACK && code != SB_THUMBPOSITION) {
        return position;
    }
    SCROLLINFO info{};
    info.cbSize = sizeof(info);
    return view.GetScrollInfo(bar, &info, SIF_TRACKPOS) ? static_cast<UINT>(info.nTrackPos) : position;
}

} // namespace

void CScrollView::OnHScroll(UINT code, UINT position, CScrollBar* bar) {
    if (bar) {
        CView::OnHScroll(code, position, bar); // a control's, not the frame's
        return;
    }
    OnScroll(MAKEWORD(static_cast<int>(code), 0xFF), trackPosition(*this, SB_HORZ, code, position));
}

void CScrollView::OnVScroll(UINT code, UINT position, CScrollBar* bar) {
    if (bar) {
        CView::OnVScroll(code, position, bar);
        return;
    }
    OnScroll(MAKEWORD(0xFF, static_cast<int>(code)), trackPosition(*this, SB_VERT, code, position));
}

BOOL CScrollView::OnMouseWheel(UINT flags, short delta, CPoint point) {
    // With a modifier key the wheel is the host's, mostly for zooming.
    if ((flags & (MK_SHIFT | MK_CONTROL)) != 0 || limits().y == 0) {
        return CView::OnMouseWheel(flags, delta, point);
    }
    m_wheelRest += delta; // fine wheels send parts of a notch
    const int lines = m_wheelRest * wheelLines / WHEEL_DELTA;
    m_wheelRest -= lines * WHEEL_DELTA / wheelLines;
    if (OnScrollBy(CSize(0, -lines * m_lineDev.cy))) {
        UpdateWindow();
    }
    return TRUE;
}

void CScrollView::OnKeyDown(UINT key, UINT repeat, UINT flags) {
    constexpr BYTE none = 0xFF;
    BYTE horizontal = none;
    BYTE vertical = none;
    switch (key) {
    case VK_UP:
        vertical = SB_LINEUP;
        break;
    case VK_DOWN:
        vertical = SB_LINEDOWN;
        break;
    case VK_PRIOR:
        vertical = SB_PAGEUP;
        break;
    case VK_NEXT:
        vertical = SB_PAGEDOWN;
        break;
    case VK_LEFT:
        horizontal = SB_LINEUP;
        break;
    case VK_RIGHT:
        horizontal = SB_LINEDOWN;
        break;
    case VK_HOME:
        vertical = SB_TOP;
        break;
    case VK_END:
        vertical = SB_BOTTOM;
        break;
    default:
        CView::OnKeyDown(key, repeat, flags);
        return;
    }
    OnScroll(MAKEWORD(horizontal, vertical), 0);
}

void CScrollView::OnSize(UINT type, int cx, int cy) {
    CView::OnSize(type, cx, cy);
    if (m_mapMode == scaleToFit) {
        SetScaleToFitSize(m_totalLog);
    } else if (m_mapMode != 0) {
        UpdateBars();
    }
}

void CScrollView::ResizeParentToFit(BOOL shrinkOnly) {
    CFrameWnd* frame = GetParentFrame();
    if (!frame || m_mapMode == 0) {
        return;
    }
    CRect client;
    CSize bars(0, 0);
    if (m_mapMode != scaleToFit) {
        // The bars that are there now may be gone in the new size, so what counts is the view without them.
        const bool updating = std::exchange(m_updatingBars, true);
        ShowScrollBar(SB_BOTH, TRUE);
        GetClientRect(&client);
        bars = client.Size();
        ShowScrollBar(SB_BOTH, FALSE);
        GetClientRect(&client);
        bars = client.Size() - bars;
        m_updatingBars = updating;
    } else {
        GetClientRect(&client);
    }
    CSize wanted = m_mapMode == scaleToFit ? m_totalLog : m_totalDev;
    if (shrinkOnly) {
        // Where a bar stays, its room is needed beside the drawing, or the other bar would come as well.
        const CSize besides(wanted.cy > client.Height() ? bars.cx : 0, wanted.cx > client.Width() ? bars.cy : 0);
        wanted.cx = std::min<LONG>(wanted.cx + besides.cx, client.Width());
        wanted.cy = std::min<LONG>(wanted.cy + besides.cy, client.Height());
    }
    CRect outer;
    frame->GetWindowRect(&outer);
    frame->SetWindowPos(nullptr, 0, 0, outer.Width() + wanted.cx - client.Width(),
                        outer.Height() + wanted.cy - client.Height(), SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
    UpdateBars(); // the size may be the old one
}

void CScrollView::FillOutsideRect(CDC* dc, CBrush* brush) {
    CRect rect;
    GetClientRect(&rect);
    if (rect.right > m_totalDev.cx) {
        const CRect right(m_totalDev.cx, 0, rect.right, rect.bottom);
        dc->FillRect(&right, brush);
    }
    if (rect.bottom > m_totalDev.cy) {
        const CRect below(0, m_totalDev.cy, std::min<LONG>(rect.right, m_totalDev.cx), rect.bottom);
        dc->FillRect(&below, brush);
    }
}
