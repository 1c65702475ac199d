#include "res/resource.h"
#include "s/PropSheetRecord.h"

#include <algorithm>

void PropPagePlace::forget() {
    m_sizes.clear();
    m_page = nullptr;
}

void PropPagePlace::leave() {
    m_page = nullptr;
    for (CScrollBar* bar : {&m_horizontal, &m_vertical}) {
        if (bar->m_hWnd) {
            bar->ShowWindow(SW_HIDE);
        }
    }
}

/// What is known of a page; the first time it has the size that it was made with.
PropPagePlace::PageSize& PropPagePlace::sizeOf(HWND page) {
    const auto [known, isNew] = m_sizes.try_emplace(page);
    if (isNew) {
        CRect rect;
        ::GetWindowRect(page, &rect);
        known->second.size = rect.Size();
    }
    return known->second;
}

CSize PropPagePlace::visible() const {
    CRect client;
    ::GetClientRect(m_page, &client);
    return client.Size();
}

namespace {

/// The room that bars leave of a place for something of a size; each bar takes room that the other direction may need.
CSize roomFor(CSize size, CSize place) {
    CSize room = place;
    const bool across = size.cx > place.cx;
    const bool down = size.cy > place.cy - (across ? GetSystemMetrics(SM_CYHSCROLL) : 0);
    if (down) {
        room.cx -= GetSystemMetrics(SM_CXVSCROLL);
    }
    if (size.cx > room.cx) {
        room.cy -= GetSystemMetrics(SM_CYHSCROLL);
    }
    return room;
}

void showBar(CScrollBar& bar, CWnd& sheet, DWORD style, UINT id, const CRect& rect) {
    if (rect.IsRectEmpty()) {
        if (bar.m_hWnd) {
            bar.ShowWindow(SW_HIDE);
        }
        return;
    }
    if (!bar.m_hWnd) {
        bar.Create(WS_CHILD | style, rect, &sheet, id);
    }
    bar.MoveWindow(&rect);
    bar.ShowWindow(SW_SHOWNA);
}

void setRange(CScrollBar& bar, int whole, int seen, int position) {
    if (bar.m_hWnd) {
        SCROLLINFO info{};
        info.cbSize = sizeof info;
        info.fMask = SIF_RANGE | SIF_PAGE | SIF_POS;
        info.nMax = std::max(0, whole - 1);
        info.nPage = static_cast<UINT>(seen);
        info.nPos = position;
        bar.SetScrollInfo(&info);
    }
}

} // namespace

void PropPagePlace::place(CDialog& sheet, CWnd& page, const CRect& frame, CPoint corner) {
    m_page = page.m_hWnd;
    PageSize& known = sizeOf(m_page);
    const CSize room = scrolls ? roomFor(known.size, frame.Size()) : frame.Size();
    // While the page lays itself out in its new size, its controls stand where it takes them to be.
    const CPoint before = known.position;
    scrollTo(CPoint(0, 0));
    page.SetWindowPos(nullptr, corner.x, corner.y, room.cx, room.cy, SWP_NOZORDER | SWP_NOACTIVATE);
    if (!scrolls || !page.m_hWnd) {
        return;
    }
    CRect line(0, 0, 4, 8); // a line of text
    sheet.MapDialogRect(&line);
    m_line = line.Height();
    showBars(sheet, CRect(corner, room), CRect(corner, frame.Size()));
    scrollTo(before);
}

void PropPagePlace::showBars(CWnd& sheet, const CRect& inside, const CRect& frame) {
    const CSize whole = sizeOf(m_page).size;
    showBar(m_vertical, sheet, SBS_VERT, GUI_IDC_PROP_SCROLL_DOWN,
            CRect(inside.right, frame.top, frame.right, inside.bottom));
    showBar(m_horizontal, sheet, SBS_HORZ, GUI_IDC_PROP_SCROLL_ACROSS,
            CRect(frame.left, inside.bottom, inside.right, frame.bottom));
    setRange(m_vertical, whole.cy, inside.Height(), 0);
    setRange(m_horizontal, whole.cx, inside.Width(), 0);
}

// --- scrolling ---

bool PropPagePlace::scrollTo(CPoint position) {
    PageSize& known = sizeOf(m_page);
    const CSize seen = visible();
    const CPoint target(std::clamp<LONG>(position.x, 0, std::max<LONG>(0, known.size.cx - seen.cx)),
                        std::clamp<LONG>(position.y, 0, std::max<LONG>(0, known.size.cy - seen.cy)));
    const CPoint from = known.position;
    if (target == from) {
        return false;
    }
    known.position = target;
    CWnd::FromHandle(m_page)->ScrollWindow(from.x - target.x, from.y - target.y);
    setRange(m_vertical, known.size.cy, seen.cy, target.y);
    setRange(m_horizontal, known.size.cx, seen.cx, target.x);
    return true;
}

bool PropPagePlace::scrollBy(CSize distance) {
    return scrolls && ::IsWindow(m_page) && scrollTo(sizeOf(m_page).position + distance);
}

bool PropPagePlace::onScroll(int bar, UINT code, const CScrollBar* from) {
    CScrollBar& own = bar == SB_VERT ? m_vertical : m_horizontal;
    if (!::IsWindow(m_page) || from != &own) {
        return false;
    }
    const CPoint now = sizeOf(m_page).position;
    const LONG at = bar == SB_VERT ? now.y : now.x;
    const LONG page = bar == SB_VERT ? visible().cy : visible().cx;
    LONG to = at;
    switch (code) {
    case SB_TOP:
        to = 0;
        break;
    case SB_BOTTOM:
        to = bar == SB_VERT ? sizeOf(m_page).size.cy : sizeOf(m_page).size.cx;
        break;
    case SB_LINEUP:
    case SB_LINEDOWN:
        to += code == SB_LINEUP ? -m_line : m_line;
        break;
    case SB_PAGEUP:
    case SB_PAGEDOWN:
        to += code == SB_PAGEUP ? -page : page;
        break;
    case SB_THUMBTRACK:
    case SB_THUMBPOSITION: {
        SCROLLINFO info{};
        info.cbSize = sizeof info;
        own.GetScrollInfo(&info);
        to = info.nTrackPos;
        break;
    }
    default:
        break;
    }
    scrollTo(bar == SB_VERT ? CPoint(now.x, to) : CPoint(to, now.y));
    return true;
}

bool PropPagePlace::onWheel(int delta) {
    constexpr int linesOfNotch = 3;
    return scrollBy(CSize(0, -delta * linesOfNotch * m_line / WHEEL_DELTA));
}

void PropPagePlace::show(HWND control) {
    if (!scrolls || !::IsChild(m_page, control)) {
        return;
    }
    CRect rect;
    ::GetWindowRect(control, &rect);
    CWnd::FromHandle(m_page)->ScreenToClient(&rect);
    const CSize seen = visible();
    // Its end first: of a control that is larger than the place the beginning is seen.
    const auto distance = [](LONG from, LONG to, LONG extent) {
        const LONG shift = std::max<LONG>(0, to - extent);
        return from - shift < 0 ? from : shift;
    };
    scrollBy(CSize(distance(rect.left, rect.right, seen.cx), distance(rect.top, rect.bottom, seen.cy)));
}
