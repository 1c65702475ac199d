// Names.cpp : what the plain names of calls answer

#include "stdafx.h"
#include "mainfrm.h"
#include "ledgerdoc.h"
#include "ledgerview.h"
#include "RESOURCE.H"

static void Tell(CStringArray& lines, LPCTSTR lpszName, BOOL bRight)
{
    lines.Add(CString(lpszName) + (bRight ? _T(": right") : _T(": WRONG")));
}

static void TellTexts(CStringArray& lines)
{
    char sz[40] = "";
    FAR char* lpsz = _tcsupr(strcpy(sz, "abc"));
    BOOL bRight = !stricmp(lpsz, "aBc") && !_strnicmp("abd", "ABc", 2) && stricmp("a", "b") < 0;
    Tell(lines, "texts without case", bRight && !_tcscmp(strlwr(sz), "abc"));
    __int64 nLarge = _atoi64("5000000000");
    bRight = nLarge / 1000 == 5000000 && !strcmp(itoa(-255, sz, 10), "-255") && !strcmp(_itoa(255, sz, 16), "ff");
    Tell(lines, "numbers", bRight && _ttoi(_T("12")) == 12 && MulDiv(7, 3, 2) == 11 && MulDiv(-7, 3, 2) == -11);
    bRight = strcpy_s(sz, sizeof(sz), "one") == 0 && strcat_s(sz, sizeof(sz), " two") == 0 && !_tcscmp(sz, "one two");
    char szShort[4];
    bRight = bRight && strcpy_s(szShort, "four") != 0 && !*szShort && strncpy_s(szShort, 4, "four", 3) == 0;
    Tell(lines, "copies", bRight && lstrlen(szShort) == 3 && sprintf_s(sz, sizeof(sz), "%s!", szShort) == 4);
    SYSTEMTIME st = { 1999, 12, 5, 31 };
    FILETIME ft = { 1, 0 };
    UCHAR uch = 200;
    Tell(lines, "min and max", max(uch, 100) == 200 && min((long)st.wYear, 2000) == 1999 && max(ft.dwLowDateTime, 0U) == 1);
}

static void TellGeometry(CStringArray& lines)
{
    CPoint point = CSize(3, 4);
    CPoint packed = (LPARAM)MAKELPARAM(-3, 4);
    CSize size = point;
    CRect rect = CPoint(1, 1) + CRect(0, 0, 5, 5);
    rect = CSize(1, 0) + rect;
    CRgn rgn;
    rgn.CreateRectRgnIndirect(rect);
    Tell(lines, "geometry", size.cy == 4 && packed.x == -3 && rect == CRect(2, 1, 7, 6) && rgn.PtInRegion(point));
}

// A picture in memory, drawn by handles.
static void TellDrawing(CStringArray& lines)
{
    HDC hDC = ::CreateCompatibleDC(NULL);
    HBITMAP hBitmap = ::CreateBitmap(100, 100, 1, 32, NULL);
    HGDIOBJ hOldBitmap = ::SelectObject(hDC, hBitmap);
    BOOL bRight = ::PatBlt(hDC, 0, 0, 100, 100, WHITENESS);
    HBRUSH hBrush = ::CreateHatchBrush(HS_CROSS, RGB(255, 0, 0));
    HBRUSH hSolid = ::CreateSolidBrush(RGB(0, 0, 255));
    HBRUSH hPattern = ::CreatePatternBrush(hBitmap);
    HPEN hPen = ::CreatePen(PS_SOLID, 1, RGB(255, 0, 0));
    bRight = bRight && hBrush && hPattern;
    int nSaved = ::SaveDC(hDC);
    ::SelectObject(hDC, hPen);
    ::SelectObject(hDC, hSolid);
    POINT points[] = { { 60, 10 }, { 90, 10 }, { 75, 30 } };
    bRight = bRight && ::Rectangle(hDC, 0, 0, 20, 20) && ::Ellipse(hDC, 20, 0, 40, 20) &&
        ::RoundRect(hDC, 40, 0, 60, 20, 6, 6) && ::Polygon(hDC, points, 3) && ::Polyline(hDC, points, 3) &&
        ::Arc(hDC, 0, 40, 20, 60, 20, 50, 10, 40) && ::Pie(hDC, 20, 40, 40, 60, 40, 50, 30, 40);
    bRight = bRight && ::GetPixel(hDC, 10, 10) == RGB(0, 0, 255) && ::GetPixel(hDC, 0, 5) == RGB(255, 0, 0) &&
        ::GetPixel(hDC, 75, 15) == RGB(0, 0, 255);
    Tell(lines, "shapes", bRight && ::RestoreDC(hDC, nSaved));

    CRect rect(50, 50, 60, 60);
    bRight = ::FrameRect(hDC, rect, hSolid) && ::GetPixel(hDC, 50, 50) == RGB(0, 0, 255) &&
        ::InvertRect(hDC, rect) && ::GetPixel(hDC, 50, 50) == RGB(255, 255, 0) && ::DrawFocusRect(hDC, rect) &&
        ::DrawEdge(hDC, rect, EDGE_RAISED, BF_RECT) && ::DrawIcon(hDC, 64, 64, ::LoadIcon(NULL, IDI_HAND)) &&
        ::StretchBlt(hDC, 80, 80, 20, 20, hDC, 0, 0, 10, 10, SRCCOPY) && ::GetPixel(hDC, 90, 90) == RGB(0, 0, 255);
    Tell(lines, "areas", bRight);

    ::SetTextColor(hDC, RGB(1, 2, 3));
    ::SetBkColor(hDC, RGB(4, 5, 6));
    TEXTMETRIC tm;
    HFONT hFont = ::CreateFont(-12, 0, 0, 0, FW_BOLD, 0, 0, 0, DEFAULT_CHARSET, 0, 0, 0, 0, _T("Arial"));
    HGDIOBJ hOldFont = ::SelectObject(hDC, hFont);
    bRight = ::GetTextColor(hDC) == RGB(1, 2, 3) && ::GetBkColor(hDC) == RGB(4, 5, 6) &&
        ::SetROP2(hDC, R2_NOT) == R2_COPYPEN && ::SetStretchBltMode(hDC, COLORONCOLOR) == BLACKONWHITE &&
        ::SetTextAlign(hDC, TA_RIGHT) == TA_LEFT && ::GetTextMetrics(hDC, &tm) && tm.tmWeight >= FW_BOLD &&
        ::ExtTextOut(hDC, 40, 70, ETO_OPAQUE, CRect(20, 70, 40, 80), _T("x"), 1, NULL) &&
        ::GetPixel(hDC, 21, 71) == RGB(4, 5, 6) && ::DrawText(hDC, _T("x"), 1, rect, DT_CALCRECT) > 0;
    Tell(lines, "text", bRight);
    ::SelectObject(hDC, hOldFont);

    POINT before;
    SIZE extent;
    bRight = ::SetMapMode(hDC, MM_ANISOTROPIC) == MM_TEXT && ::SetWindowExtEx(hDC, 2, 2, NULL) &&
        ::SetViewportExtEx(hDC, 6, 6, NULL) && ::SetViewportExtEx(hDC, 3, 3, &extent) && extent.cx == 6 &&
        ::SetWindowOrgEx(hDC, 5, 0, NULL) && ::SetWindowOrgEx(hDC, 0, 0, &before) && before.x == 5 &&
        ::SetViewportOrgEx(hDC, 1, 0, &before) && before.x == 0 && ::SetMapMode(hDC, MM_TEXT) == MM_ANISOTROPIC;
    HRGN hRgn = ::CreateRectRgn(0, 0, 50, 50);
    ::SetViewportOrgEx(hDC, 0, 0, NULL);
    CRect clip;
    bRight = bRight && ::SelectClipRgn(hDC, hRgn) == SIMPLEREGION && ::SelectClipRgn(hDC, NULL) == SIMPLEREGION &&
        ::IntersectClipRect(hDC, 0, 0, 30, 30) == SIMPLEREGION && ::ExcludeClipRect(hDC, 0, 0, 10, 30) == SIMPLEREGION &&
        ::GetClipBox(hDC, clip) == SIMPLEREGION && clip == CRect(10, 0, 30, 30) && !::LineTo(NULL, 1, 1);
    Tell(lines, "mapping and clipping", bRight);

    HGDIOBJ objects[] = { hRgn, hFont, hPen, hBrush, hSolid, hPattern };
    ::SelectObject(hDC, hOldBitmap);
    for (int i = 0; i < (int)ARRAYSIZE(objects); i++)
        ::DeleteObject(objects[i]);
    ::DeleteDC(hDC);
    ::DeleteObject(hBitmap);
}

static void TellWindows(CWnd& wnd, CStringArray& lines)
{
    CMainFrame* pFrame = (CMainFrame*)AfxGetMainWnd();
    TCHAR sz[_MAX_PATH];
    CString strTitle;
    pFrame->GetWindowText(strTitle);
    BOOL bRight = ::GetClassName(pFrame->m_hWnd, sz, _MAX_PATH) > 0 && ::FindWindow(sz, strTitle) == pFrame->m_hWnd &&
        ::GetWindowTextLength(pFrame->m_hWnd) == strTitle.GetLength();
    LONG_PTR nOld = ::SetWindowLongPtr(wnd, GWL_USERDATA, 42);
    bRight = bRight && ::GetWindowLongPtr(wnd, GWL_USERDATA) == 42;
    ::SetWindowLongPtr(wnd, GWL_USERDATA, nOld);
    bRight = bRight && wnd.ChildWindowFromPoint(CPoint(1, 1)) == &wnd &&
        pFrame->SetWindowPos(&CWnd::wndTop, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE) &&
        pFrame->SetWindowPos(&CWnd::wndTopMost, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE) &&
        (pFrame->GetExStyle() & WS_EX_TOPMOST) != 0 &&
        pFrame->SetWindowPos(&CWnd::wndNoTopMost, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE) &&
        (pFrame->GetExStyle() & WS_EX_TOPMOST) == 0;
    Tell(lines, "windows", bRight);

    WINDOWPOS wp = { pFrame->m_hWnd, NULL, 0, 0, 10, 10, 0 };
    pFrame->SendMessage(WM_WINDOWPOSCHANGING, 0, (LPARAM)&wp);
    pFrame->SendMessage(WM_WINDOWPOSCHANGED, 0, (LPARAM)&wp);
    Tell(lines, "window positions", wp.cx == 200 && (wp.flags & SWP_NOMOVE));

    CToolBarCtrl& bar = pFrame->m_wndToolBar.GetToolBarCtrl();
    bRight = bar.GetButtonCount() == 5 && bar.HideButton(ID_FILE_PRINT) && bar.IsButtonHidden(ID_FILE_PRINT) &&
        bar.HideButton(ID_FILE_PRINT, FALSE) && bar.EnableButton(ID_FILE_NEW, FALSE) &&
        !bar.IsButtonEnabled(ID_FILE_NEW) && bar.EnableButton(ID_FILE_NEW) && bar.CheckButton(ID_FILE_SAVE) &&
        bar.IsButtonChecked(ID_FILE_SAVE) && bar.CheckButton(ID_FILE_SAVE, FALSE) && !bar.EnableButton(1);
    Tell(lines, "tool bar", bRight);
}

static void TellSystem(CStringArray& lines)
{
    STARTUPINFO si;
    ZeroMemory(&si, sizeof(si));
    ::GetStartupInfo(&si);
    PROCESS_INFORMATION pi;
    char szCommand[] = "true";
    BOOL bRight = ::CreateProcess(NULL, szCommand, NULL, NULL, FALSE, 0, NULL, NULL, &si, &pi) &&
        ::WaitForSingleObject(pi.hProcess, INFINITE) == WAIT_OBJECT_0;
    HANDLE hEnum;
    DWORD dwCount = 1, dwSize = 0;
    bRight = bRight && ::WNetOpenEnum(RESOURCE_CONNECTED, RESOURCETYPE_DISK, 0, NULL, &hEnum) == NO_ERROR &&
        ::WNetEnumResource(hEnum, &dwCount, NULL, &dwSize) != NO_ERROR;
    Tell(lines, "system", bRight);
}

void TellNames(CLedgerView& view, CStringArray& lines)
{
    TellTexts(lines);
    TellGeometry(lines);
    TellDrawing(lines);
    TellWindows(view, lines);
    TellSystem(lines);
    ::MessageBox(view, _T("All names have been called."), _T("Names"), MB_OK);
}
