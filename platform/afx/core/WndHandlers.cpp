#include "platform/afx/core/Wnd.h"

#include "platform/afx/core/detail/Dispatch.h"

// The handlers that derived classes list in their message maps and call as their base: each does what happens without
// one.

// Default() hands on the message as it came: a host that calls a base handler with other values changes nothing, as it
// is used to.
void CWnd::OnActivate(UINT, CWnd*, BOOL) {
    Default();
}

void CWnd::OnActivateApp(BOOL, DWORD) {
    Default();
}

void CWnd::OnCancelMode() {
    Default();
}

void CWnd::OnCaptureChanged(CWnd*) {
    Default();
}

void CWnd::OnClose() {
    Default();
}

void CWnd::OnContextMenu(CWnd*, CPoint) {
    Default();
}

int CWnd::OnCreate(CREATESTRUCT*) {
    return static_cast<int>(Default());
}

HBRUSH CWnd::OnCtlColor(CDC*, CWnd*, UINT) {
    return reinterpret_cast<HBRUSH>(Default());
}

void CWnd::OnDestroy() {
    Default();
}

void CWnd::OnDrawItem(int, DRAWITEMSTRUCT*) {
    Default();
}

void CWnd::OnDropFiles(HANDLE) {
    Default();
}

void CWnd::OnEnable(BOOL) {
    Default();
}

void CWnd::OnEndSession(BOOL) {
    Default();
}

void CWnd::OnEnterIdle(UINT, CWnd*) {
    Default();
}

BOOL CWnd::OnEraseBkgnd(CDC*) {
    return static_cast<BOOL>(Default());
}

UINT CWnd::OnGetDlgCode() {
    return static_cast<UINT>(Default());
}

void CWnd::OnGetMinMaxInfo(MINMAXINFO*) {
    Default();
}

BOOL CWnd::OnHelpInfo(HELPINFO*) {
    return static_cast<BOOL>(Default());
}

void CWnd::OnHScroll(UINT, UINT, CScrollBar*) {
    Default();
}

void CWnd::OnVScroll(UINT, UINT, CScrollBar*) {
    Default();
}

void CWnd::OnInitMenu(CMenu*) {
    Default();
}

void CWnd::OnInitMenuPopup(CMenu*, UINT, BOOL) {
    Default();
}

void CWnd::OnKeyDown(UINT, UINT, UINT) {
    Default();
}

void CWnd::OnKeyUp(UINT, UINT, UINT) {
    Default();
}

void CWnd::OnChar(UINT, UINT, UINT) {
    Default();
}

void CWnd::OnSysKeyDown(UINT, UINT, UINT) {
    Default();
}

void CWnd::OnSysKeyUp(UINT, UINT, UINT) {
    Default();
}

void CWnd::OnSysChar(UINT, UINT, UINT) {
    Default();
}

void CWnd::OnSysCommand(UINT, LPARAM) {
    Default();
}

void CWnd::OnKillFocus(CWnd*) {
    Default();
}

void CWnd::OnSetFocus(CWnd*) {
    Default();
}

void CWnd::OnLButtonDown(UINT, CPoint) {
    Default();
}

void CWnd::OnLButtonUp(UINT, CPoint) {
    Default();
}

void CWnd::OnLButtonDblClk(UINT, CPoint) {
    Default();
}

void CWnd::OnRButtonDown(UINT, CPoint) {
    Default();
}

void CWnd::OnRButtonUp(UINT, CPoint) {
    Default();
}

void CWnd::OnRButtonDblClk(UINT, CPoint) {
    Default();
}

void CWnd::OnMButtonDown(UINT, CPoint) {
    Default();
}

void CWnd::OnMButtonUp(UINT, CPoint) {
    Default();
}

void CWnd::OnMouseMove(UINT, CPoint) {
    Default();
}

void CWnd::OnMouseLeave() {
    Default();
}

BOOL CWnd::OnMouseWheel(UINT, short, CPoint) {
    return static_cast<BOOL>(Default());
}

int CWnd::OnMouseActivate(CWnd*, UINT, UINT) {
    return static_cast<int>(Default());
}

void CWnd::OnMDIActivate(BOOL, CWnd*, CWnd*) {
    Default();
}

void CWnd::OnMeasureItem(int, MEASUREITEMSTRUCT*) {
    Default();
}

void CWnd::OnMenuSelect(UINT, UINT, HMENU) {
    Default();
}

void CWnd::OnMove(int, int) {
    Default();
}

BOOL CWnd::OnNcActivate(BOOL) {
    return static_cast<BOOL>(Default());
}

LRESULT CWnd::OnNcHitTest(CPoint) {
    return Default();
}

void CWnd::OnNcLButtonDblClk(UINT, CPoint) {
    Default();
}

void CWnd::OnNcLButtonDown(UINT, CPoint) {
    Default();
}

void CWnd::OnNcLButtonUp(UINT, CPoint) {
    Default();
}

void CWnd::OnNcMouseMove(UINT, CPoint) {
    Default();
}

void CWnd::OnNcRButtonUp(UINT, CPoint) {
    Default();
}

void CWnd::OnNcPaint() {
    Default();
}

void CWnd::OnPaint() {
    Default();
}

HCURSOR CWnd::OnQueryDragIcon() {
    return reinterpret_cast<HCURSOR>(Default());
}

BOOL CWnd::OnQueryEndSession() {
    return static_cast<BOOL>(Default());
}

BOOL CWnd::OnSetCursor(CWnd*, UINT, UINT) {
    return static_cast<BOOL>(Default());
}

void CWnd::OnSettingChange(UINT, LPCSTR) {
    Default();
}

void CWnd::OnShowWindow(BOOL, UINT) {
    Default();
}

void CWnd::OnSize(UINT, int, int) {
    Default();
}

void CWnd::OnSysColorChange() {
    Default();
}

LRESULT CWnd::OnThemeChanged() {
    return Default();
}

void CWnd::OnTimer(UINT_PTR) {
    Default();
}

// What the framework itself does with messages that no derived class handles.
// clang-format off
BEGIN_MESSAGE_MAP(CWnd, CCmdTarget)
    ON_WM_NCDESTROY()
END_MESSAGE_MAP()
// clang-format on

void CWnd::OnWindowPosChanged(WINDOWPOS*) {
    Default();
}

void CWnd::OnWindowPosChanging(WINDOWPOS*) {
    Default();
}
