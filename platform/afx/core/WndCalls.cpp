#include "platform/afx/core/Wnd.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/ScrollFrame.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/base/Text.h"

#include <QAbstractScrollArea>
#include <QCoreApplication>
#include <QScreen>
#include <QScrollBar>

// The members of CWnd that pass a call on to the window behind the object.

using namespace tvx::afx;

namespace {

HWND handleOf(const CWnd* window) {
    return window ? window->m_hWnd : nullptr;
}

} // namespace

// --- state ---

DWORD CWnd::GetStyle() const {
    return static_cast<DWORD>(::GetWindowLongPtrA(m_hWnd, GWL_STYLE));
}

DWORD CWnd::GetExStyle() const {
    return static_cast<DWORD>(::GetWindowLongPtrA(m_hWnd, GWL_EXSTYLE));
}

namespace {

BOOL modify(HWND window, int index, DWORD remove, DWORD add, UINT swpFlags) {
    const auto style = static_cast<DWORD>(::GetWindowLongPtrA(window, index));
    const DWORD wanted = (style & ~remove) | add;
    if (style == wanted) {
        return FALSE;
    }
    ::SetWindowLongPtrA(window, index, static_cast<LONG_PTR>(wanted));
    if (swpFlags != 0) {
        ::SetWindowPos(window, nullptr, 0, 0, 0, 0, SWP_NOSIZE | SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE | swpFlags);
    }
    return TRUE;
}

} // namespace

BOOL CWnd::ModifyStyle(DWORD remove, DWORD add, UINT swpFlags) {
    return modify(m_hWnd, GWL_STYLE, remove, add, swpFlags);
}

BOOL CWnd::ModifyStyleEx(DWORD remove, DWORD add, UINT swpFlags) {
    return modify(m_hWnd, GWL_EXSTYLE, remove, add, swpFlags);
}

int CWnd::GetDlgCtrlID() const {
    return ::GetDlgCtrlID(m_hWnd);
}

int CWnd::SetDlgCtrlID(int id) {
    return static_cast<int>(::SetWindowLongPtrA(m_hWnd, GWL_ID, id));
}

BOOL CWnd::EnableWindow(BOOL enable) {
    return ::EnableWindow(m_hWnd, enable);
}

BOOL CWnd::IsWindowEnabled() const {
    return ::IsWindowEnabled(m_hWnd);
}

BOOL CWnd::ShowWindow(int command) {
    return ::ShowWindow(m_hWnd, command);
}

BOOL CWnd::IsWindowVisible() const {
    return ::IsWindowVisible(m_hWnd);
}

BOOL CWnd::IsIconic() const {
    return ::IsIconic(m_hWnd);
}

BOOL CWnd::IsZoomed() const {
    return ::IsZoomed(m_hWnd);
}

// --- text and font ---

void CWnd::SetWindowText(LPCSTR text) {
    ::SetWindowTextA(m_hWnd, text);
}

int CWnd::GetWindowText(LPSTR buffer, int size) const {
    return ::GetWindowTextA(m_hWnd, buffer, size);
}

void CWnd::GetWindowText(CString& text) const {
    const int length = ::GetWindowTextLengthA(m_hWnd);
    LPSTR buffer = text.GetBufferSetLength(length);
    const int copied = ::GetWindowTextA(m_hWnd, buffer, length + 1);
    text.ReleaseBufferSetLength(copied);
}

int CWnd::GetWindowTextLength() const {
    return ::GetWindowTextLengthA(m_hWnd);
}

void CWnd::SetFont(CFont* font, BOOL redraw) {
    const auto handle = font ? reinterpret_cast<WPARAM>(font->GetSafeHandle()) : 0;
    ::SendMessageA(m_hWnd, WM_SETFONT, handle, redraw);
}

CFont* CWnd::GetFont() const {
    return CFont::FromHandle(reinterpret_cast<HFONT>(::SendMessageA(m_hWnd, WM_GETFONT, 0, 0)));
}

HICON CWnd::SetIcon(HICON icon, BOOL bigIcon) {
    return reinterpret_cast<HICON>(
        ::SendMessageA(m_hWnd, WM_SETICON, bigIcon ? ICON_BIG : ICON_SMALL, reinterpret_cast<LPARAM>(icon)));
}

HICON CWnd::GetIcon(BOOL bigIcon) const {
    return reinterpret_cast<HICON>(::SendMessageA(m_hWnd, WM_GETICON, bigIcon ? ICON_BIG : ICON_SMALL, 0));
}

// --- place and size ---

void CWnd::GetWindowRect(RECT* rect) const {
    ::GetWindowRect(m_hWnd, rect);
}

void CWnd::GetClientRect(RECT* rect) const {
    ::GetClientRect(m_hWnd, rect);
}

void CWnd::MoveWindow(int x, int y, int width, int height, BOOL repaint) {
    ::MoveWindow(m_hWnd, x, y, width, height, repaint);
}

void CWnd::MoveWindow(const RECT* rect, BOOL repaint) {
    ::MoveWindow(m_hWnd, rect->left, rect->top, rect->right - rect->left, rect->bottom - rect->top, repaint);
}

BOOL CWnd::SetWindowPos(const CWnd* insertAfter, int x, int y, int cx, int cy, UINT flags) {
    return ::SetWindowPos(m_hWnd, handleOf(insertAfter), x, y, cx, cy, flags);
}

// They are never destroyed: the end of the process would take them for windows.
const CWnd& CWnd::wndTop = *new CWnd(HWND_TOP);
const CWnd& CWnd::wndBottom = *new CWnd(HWND_BOTTOM);
const CWnd& CWnd::wndTopMost = *new CWnd(HWND_TOPMOST);
const CWnd& CWnd::wndNoTopMost = *new CWnd(HWND_NOTOPMOST);

BOOL CWnd::GetWindowPlacement(WINDOWPLACEMENT* placement) const {
    return ::GetWindowPlacement(m_hWnd, placement);
}

BOOL CWnd::SetWindowPlacement(const WINDOWPLACEMENT* placement) {
    return ::SetWindowPlacement(m_hWnd, placement);
}

void CWnd::CenterWindow(CWnd* other) {
    const Window* window = GetState();
    if (!window || !window->widget()) {
        return;
    }
    CWnd* over = other;
    if (!over) {
        over = window->isChild() ? GetParent() : GetOwner();
    }
    const QScreen* screen = window->widget()->screen();
    QRect available = screen->availableGeometry();
    QRect area = available;
    if (window->isChild()) {
        area = available = QRect(QPoint(), window->parent()->clientRect().size());
    } else if (over && over->IsWindowVisible() && !over->IsIconic()) {
        area = over->GetState()->screenRect();
    }
    QRect place(QPoint(), window->windowRect().size());
    place.moveCenter(area.center());
    place.moveRight(std::min(place.right(), available.right()));
    place.moveBottom(std::min(place.bottom(), available.bottom()));
    // The left top corner last: of a window larger than the screen the caption has to be within reach.
    place.moveLeft(std::max(place.left(), available.left()));
    place.moveTop(std::max(place.top(), available.top()));
    ::SetWindowPos(m_hWnd, nullptr, place.x(), place.y(), 0, 0, SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE);
}

void CWnd::BringWindowToTop() {
    ::BringWindowToTop(m_hWnd);
}

void CWnd::ClientToScreen(POINT* point) const {
    ::ClientToScreen(m_hWnd, point);
}

void CWnd::ClientToScreen(RECT* rect) const {
    ::MapWindowPoints(m_hWnd, nullptr, reinterpret_cast<POINT*>(rect), 2);
}

void CWnd::ScreenToClient(POINT* point) const {
    ::ScreenToClient(m_hWnd, point);
}

void CWnd::ScreenToClient(RECT* rect) const {
    ::MapWindowPoints(nullptr, m_hWnd, reinterpret_cast<POINT*>(rect), 2);
}

void CWnd::MapWindowPoints(CWnd* to, POINT* points, UINT count) const {
    ::MapWindowPoints(m_hWnd, handleOf(to), points, count);
}

void CWnd::MapWindowPoints(CWnd* to, RECT* rect) const {
    ::MapWindowPoints(m_hWnd, handleOf(to), reinterpret_cast<POINT*>(rect), 2);
}

void CWnd::CalcWindowRect(RECT* rect, UINT) {
    const Window* window = GetState();
    if (!window) {
        return;
    }
    const QRect client(window->clientToScreen(QPoint(0, 0)), window->clientRect().size());
    const QRect whole = window->screenRect();
    rect->left += whole.left() - client.left();
    rect->top += whole.top() - client.top();
    rect->right += whole.right() - client.right();
    rect->bottom += whole.bottom() - client.bottom();
}

// --- painting ---

void CWnd::Invalidate(BOOL erase) {
    ::InvalidateRect(m_hWnd, nullptr, erase);
}

void CWnd::InvalidateRect(const RECT* rect, BOOL erase) {
    ::InvalidateRect(m_hWnd, rect, erase);
}

void CWnd::UpdateWindow() {
    ::UpdateWindow(m_hWnd);
}

BOOL CWnd::RedrawWindow(const RECT* rect, CRgn* region, UINT flags) {
    return ::RedrawWindow(m_hWnd, rect, region ? static_cast<HRGN>(*region) : nullptr, flags);
}

void CWnd::SetRedraw(BOOL redraw) {
    ::SendMessageA(m_hWnd, WM_SETREDRAW, redraw, 0);
}

CDC* CWnd::GetDC() {
    return CDC::FromHandle(::GetDC(m_hWnd));
}

CDC* CWnd::GetWindowDC() {
    return CDC::FromHandle(::GetWindowDC(m_hWnd));
}

int CWnd::ReleaseDC(CDC* dc) {
    return ::ReleaseDC(m_hWnd, dc->m_hDC);
}

void CWnd::SetFrameButton(LPCSTR name, const RECT* place, UINT command) {
    if (Window* window = GetState()) {
        const QRect wanted = place ? toQt(*place) : QRect();
        window->setFrameButton(toQt(name), place ? &wanted : nullptr, command);
    }
}

void CWnd::ScrollWindow(int dx, int dy, const RECT* scroll, const RECT* clip) {
    const Window* window = GetState();
    QWidget* client = peerOf(m_hWnd);
    if (!client) {
        return;
    }
    const QRect area = window->clientRect();
    guarded([&] {
        if (!scroll && !clip && area == client->rect()) {
            client->scroll(dx, dy);
            return;
        }
        const RECT* part = scroll ? scroll : clip;
        client->scroll(dx, dy, part ? toQt(*part).translated(area.topLeft()) : area);
    });
}

// --- the tree of windows ---

CWnd* CWnd::GetParent() const {
    return FromHandle(::GetParent(m_hWnd));
}

CWnd* CWnd::SetParent(CWnd* parent) {
    return FromHandle(::SetParent(m_hWnd, handleOf(parent)));
}

CWnd* CWnd::GetOwner() const {
    return m_pOwner ? m_pOwner : GetParent();
}

void CWnd::SetOwner(CWnd* owner) {
    m_pOwner = owner;
}

CWnd* CWnd::GetTopLevelParent() const {
    HWND window = m_hWnd;
    while (const HWND parent = ::GetParent(window)) {
        window = parent;
    }
    return FromHandle(window);
}

CWnd* CWnd::GetWindow(UINT relation) const {
    return FromHandle(::GetWindow(m_hWnd, relation));
}

CWnd* CWnd::GetTopWindow() const {
    return FromHandle(::GetTopWindow(m_hWnd));
}

BOOL CWnd::IsChild(const CWnd* other) const {
    return ::IsChild(m_hWnd, handleOf(other));
}

CWnd* CWnd::GetDlgItem(int id) const {
    return FromHandle(::GetDlgItem(m_hWnd, id));
}

void CWnd::GetDlgItem(int id, HWND* handle) const {
    *handle = ::GetDlgItem(m_hWnd, id);
}

namespace {

Window* descendant(const Window& window, int id, BOOL onlyPerm) {
    for (Window* child : window.children()) {
        if (child->id() == id && (!onlyPerm || child->object())) {
            return child;
        }
    }
    for (const Window* child : window.children()) {
        if (Window* found = descendant(*child, id, onlyPerm)) {
            return found;
        }
    }
    return nullptr;
}

} // namespace

CWnd* CWnd::GetDescendantWindow(int id, BOOL onlyPerm) const {
    const Window* window = GetState();
    Window* found = window ? descendant(*window, id, onlyPerm) : nullptr;
    return found ? found->objectOrTemporary() : nullptr;
}

CWnd* CWnd::GetDesktopWindow() {
    static CWnd desktop;
    desktop.m_hWnd = ::GetDesktopWindow();
    return &desktop;
}

CWnd* CWnd::FindWindow(LPCSTR className, LPCSTR text) {
    return FromHandle(::FindWindowA(className, text));
}

CWnd* CWnd::ChildWindowFromPoint(POINT point) const {
    return FromHandle(::ChildWindowFromPoint(m_hWnd, point));
}

CWnd* CWnd::WindowFromPoint(POINT point) {
    return FromHandle(::WindowFromPoint(point));
}

// --- activation, focus, capture, timers ---

CWnd* CWnd::SetActiveWindow() {
    return FromHandle(::SetActiveWindow(m_hWnd));
}

CWnd* CWnd::GetActiveWindow() {
    return FromHandle(::GetActiveWindow());
}

BOOL CWnd::SetForegroundWindow() {
    return ::SetForegroundWindow(m_hWnd);
}

CWnd* CWnd::GetForegroundWindow() {
    return FromHandle(::GetForegroundWindow());
}

CWnd* CWnd::SetFocus() {
    return FromHandle(::SetFocus(m_hWnd));
}

CWnd* CWnd::GetFocus() {
    return FromHandle(::GetFocus());
}

CWnd* CWnd::SetCapture() {
    return FromHandle(::SetCapture(m_hWnd));
}

CWnd* CWnd::GetCapture() {
    return FromHandle(::GetCapture());
}

UINT_PTR CWnd::SetTimer(UINT_PTR id, UINT elapse, TIMERPROC callback) {
    return ::SetTimer(m_hWnd, id, elapse, callback);
}

BOOL CWnd::KillTimer(UINT_PTR id) {
    return ::KillTimer(m_hWnd, id);
}

// --- scroll bars of the frame ---

namespace {

/// The frame of windows whose bars are their own business; null for others, and for none.
ScrollFrame* scrollFrameOf(const CWnd& window) {
    const Window* state = window.GetState();
    return state ? dynamic_cast<ScrollFrame*>(state->widget()) : nullptr;
}

QScrollBar* barOf(const CWnd& window, int bar) {
    const Window* state = window.GetState();
    if (!state || !state->widget()) {
        return nullptr;
    }
    if (const ScrollFrame* frame = scrollFrameOf(window)) {
        return frame->bar(bar);
    }
    // Edit and list controls keep the ranges of their bars themselves.
    const auto* area = dynamic_cast<const QAbstractScrollArea*>(state->widget());
    // Lists that grow put off telling their bars.
    QCoreApplication::sendPostedEvents(state->widget(), QEvent::MetaCall);
    const bool exists = area && (state->style() & (bar == SB_HORZ ? WS_HSCROLL : WS_VSCROLL)) != 0;
    return !exists ? nullptr : bar == SB_HORZ ? area->horizontalScrollBar() : area->verticalScrollBar();
}

} // namespace

int CWnd::SetScrollPos(int bar, int pos, BOOL) {
    QScrollBar* slider = barOf(*this, bar);
    if (!slider) {
        return 0;
    }
    const int previous = slider->value();
    slider->setValue(pos);
    return previous;
}

int CWnd::GetScrollPos(int bar) const {
    const QScrollBar* slider = barOf(*this, bar);
    return slider ? slider->value() : 0;
}

void CWnd::SetScrollRange(int bar, int min, int max, BOOL redraw) {
    SCROLLINFO info{};
    info.cbSize = sizeof(info);
    info.fMask = SIF_RANGE;
    info.nMin = min;
    info.nMax = max;
    SetScrollInfo(bar, &info, redraw);
}

void CWnd::GetScrollRange(int bar, int* min, int* max) const {
    const QScrollBar* slider = barOf(*this, bar);
    // The toolkit's maximum is the last position, the host's the last thing seen: a page less one apart.
    *min = slider ? slider->minimum() : 0;
    *max = slider ? slider->maximum() + std::max(slider->pageStep() - 1, 0) : 0;
}

BOOL CWnd::SetScrollInfo(int bar, SCROLLINFO* info, BOOL) {
    QScrollBar* slider = barOf(*this, bar);
    if (!slider) {
        return FALSE;
    }
    ScrollFrame* frame = scrollFrameOf(*this);
    if (!frame) {
        // Controls keep range and page of their bars by what is in them.
        slider->setValue((info->fMask & SIF_POS) != 0 ? info->nPos : slider->value());
        return TRUE;
    }
    SCROLLINFO now{};
    GetScrollInfo(bar, &now, SIF_ALL);
    if ((info->fMask & SIF_RANGE) != 0) {
        now.nMin = info->nMin;
        now.nMax = info->nMax;
    }
    if ((info->fMask & SIF_PAGE) != 0) {
        now.nPage = info->nPage;
    }
    const int page = static_cast<int>(now.nPage);
    const int last = std::max(now.nMin, now.nMax - std::max(page - 1, 0));
    slider->setPageStep(page);
    slider->setRange(now.nMin, last);
    if ((info->fMask & SIF_POS) != 0) {
        slider->setValue(info->nPos);
    }
    // A bar that has nothing to scroll disappears, unless it is to stay disabled.
    const bool needed = last > now.nMin;
    slider->setEnabled(needed);
    frame->showBar(bar, needed || (info->fMask & SIF_DISABLENOSCROLL) != 0);
    return TRUE;
}

BOOL CWnd::GetScrollInfo(int bar, SCROLLINFO* info, UINT mask) {
    const QScrollBar* slider = barOf(*this, bar);
    if (!slider) {
        return FALSE;
    }
    info->fMask = mask;
    GetScrollRange(bar, &info->nMin, &info->nMax);
    info->nPage = static_cast<UINT>(slider->pageStep());
    info->nPos = slider->value();
    info->nTrackPos = slider->sliderPosition();
    return TRUE;
}

void CWnd::ShowScrollBar(UINT bar, BOOL show) {
    ScrollFrame* frame = scrollFrameOf(*this);
    if (!frame) {
        return;
    }
    if (bar == SB_HORZ || bar == SB_BOTH) {
        frame->showBar(SB_HORZ, show != FALSE);
    }
    if (bar == SB_VERT || bar == SB_BOTH) {
        frame->showBar(SB_VERT, show != FALSE);
    }
}

CScrollBar* CWnd::GetScrollBarCtrl(int) const {
    return nullptr;
}

// --- help ---

void CWnd::WinHelpA(DWORD_PTR data, UINT command) {
    if (CWinApp* app = AfxGetApp()) {
        app->WinHelpA(data, command);
    }
}

void CWnd::WinHelpInternal(DWORD_PTR data, UINT command) {
    if (CWinApp* app = AfxGetApp()) {
        app->WinHelpInternal(data, command);
    }
}

DWORD CWnd::GetWindowContextHelpId() const {
    const Window* window = GetState();
    return window ? window->helpContext : 0;
}

BOOL CWnd::SetWindowContextHelpId(DWORD context) {
    Window* window = GetState();
    if (window) {
        window->helpContext = context;
    }
    return window ? TRUE : FALSE;
}

void CWnd::OnHelp() {
    explainAtKeyboard(m_hWnd);
}

void CWnd::OnHelpIndex() {
    WinHelpInternal(0, HELP_INDEX);
}

void CWnd::OnHelpFinder() {
    WinHelpInternal(0, HELP_FINDER);
}

void CWnd::OnHelpUsing() {
    WinHelpInternal(0, HELP_HELPONHELP);
}

void CWnd::DragAcceptFiles(BOOL accept) {
    ModifyStyleEx(accept ? 0 : WS_EX_ACCEPTFILES, accept ? WS_EX_ACCEPTFILES : 0);
}
