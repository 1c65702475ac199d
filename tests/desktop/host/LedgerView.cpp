// LedgerView.cpp : implementation of the CLedgerView class

#include "stdafx.h"
#include "Ledger.h"

#include "LedgerDoc.h"
#include "ledgerview.h"
#include "Parts\options.h"

const UINT WM_ADDLINE = ::RegisterWindowMessage(_T("Ledger.AddLine"));

IMPLEMENT_DYNCREATE(CLedgerView, CView)

BEGIN_MESSAGE_MAP(CLedgerView, CView)
    //{{AFX_MSG_MAP(CLedgerView)
    ON_WM_CHAR()
    ON_WM_SETFOCUS()
    ON_WM_KILLFOCUS()
    ON_COMMAND(ID_FORMAT_FONT, OnFormatFont)
    ON_COMMAND(ID_FORMAT_COLOR, OnFormatColor)
    ON_COMMAND(ID_TOOLS_OPTIONS, OnToolsOptions)
    ON_COMMAND(ID_TOOLS_NAMES, CLedgerView::OnToolsNames)
    ON_COMMAND(ID_TOOLS_RULED, &CLedgerView::OnToolsRuled)
    ON_UPDATE_COMMAND_UI(ID_TOOLS_RULED, OnUpdateToolsRuled)
    ON_REGISTERED_MESSAGE(WM_ADDLINE, OnAddLine)
    //}}AFX_MSG_MAP
    // Standard printing commands
    ON_COMMAND(ID_FILE_PRINT, CView::OnFilePrint)
    ON_COMMAND(ID_FILE_PRINT_DIRECT, CView::OnFilePrint)
    ON_COMMAND(ID_FILE_PRINT_PREVIEW, CView::OnFilePrintPreview)
END_MESSAGE_MAP()

CLedgerView::CLedgerView()
{
    ZeroMemory(&m_logFont, sizeof(m_logFont));
    m_logFont.lfHeight = -16;
    _tcscpy(m_logFont.lfFaceName, _T("MS Sans Serif"));
    m_crText = PALETTERGB(0, 0, 128);
    m_bRuled = FALSE;
}

void CLedgerView::OnDraw(CDC* pDC)
{
    CLedgerDoc* pDoc = GetDocument();
    ASSERT_VALID(pDoc);
    CString strText = pDoc->m_strText + m_strTyped;

    HDC hDC = pDC->GetSafeHdc();
    CRect rect;
    GetClientRect(rect);
    HFONT hFont = ::CreateFontIndirect(&m_logFont);
    HFONT hOldFont = (HFONT)::SelectObject(hDC, hFont);
    ::SetTextColor(hDC, m_crText);
    ::SetBkMode(hDC, TRANSPARENT);
    int y = 4;
    while (!strText.IsEmpty())
    {
        CString strLine = strText.SpanExcluding(_T("\n"));
        ::TextOut(hDC, 8, y, strLine, strLine.GetLength());
        y += LineHeight();
        if (m_bRuled)
        {
            ::MoveToEx(hDC, rect.left, y - 2, NULL);
            ::LineTo(hDC, rect.right, y - 2);
        }
        strText = strText.Mid(min(strLine.GetLength() + 1L, (LONG)strText.GetLength()));
    }
    ::SelectObject(hDC, hOldFont);
    ::DeleteObject(hFont);
}

// CLedgerView printing

BOOL CLedgerView::OnPreparePrinting(CPrintInfo* pInfo)
{
    pInfo->SetMinPage(1);
    pInfo->SetMaxPage(2);
    if (pInfo->GetMaxPage() - pInfo->GetMinPage() > 8)
        return FALSE;
    return DoPreparePrinting(pInfo);
}

void CLedgerView::OnBeginPrinting(CDC* pDC, CPrintInfo* pInfo)
{
    CView::OnBeginPrinting(pDC, pInfo);
}

void CLedgerView::OnPrint(CDC* pDC, CPrintInfo* pInfo)
{
    pDC->IntersectClipRect(pInfo->m_rectDraw);
    CView::OnPrint(pDC, pInfo);
}

void CLedgerView::OnEndPrinting(CDC* /*pDC*/, CPrintInfo* /*pInfo*/)
{
}

// CLedgerView message handlers

void CLedgerView::PlaceCaret()
{
    CClientDC dc(this);
    CFont font;
    font.CreateFontIndirect(&m_logFont);
    CFont* pOldFont = dc.SelectObject(&font);
    CPoint point = CSize(8, 4) + dc.GetTextExtent(m_strTyped, m_strTyped.GetLength());
    dc.SelectObject(pOldFont);
    CString strText = GetDocument()->m_strText;
    point.y = 4 + strText.Remove('\n') * LineHeight();
    SetCaretPos(point);
}

void CLedgerView::OnChar(UINT nChar, UINT nRepCnt, UINT nFlags)
{
    if (nChar == VK_RETURN)
    {
        CString strLine = m_strTyped;
        m_strTyped.Empty();
        SendMessage(WM_ADDLINE, 0, (LPARAM)(LPCTSTR)strLine);
    }
    else
        m_strTyped += (TCHAR)nChar;
    HideCaret();
    Invalidate();
    PlaceCaret();
    ShowCaret();
}

LRESULT CLedgerView::OnAddLine(WPARAM /*wParam*/, LPARAM lParam)
{
    GetDocument()->AddLine((LPCTSTR)lParam);
    return 0;
}

void CLedgerView::OnSetFocus(CWnd* pOldWnd)
{
    CView::OnSetFocus(pOldWnd);
    CreateSolidCaret(2, LineHeight());
    PlaceCaret();
    ShowCaret();
}

void CLedgerView::OnKillFocus(CWnd* pNewWnd)
{
    CView::OnKillFocus(pNewWnd);
    ::DestroyCaret();
}

void CLedgerView::OnFormatFont()
{
    CFontDialog dlg(&m_logFont, CF_EFFECTS | CF_SCREENFONTS, NULL, this);
    if (dlg.DoModal() == IDOK)
    {
        dlg.GetCurrentFont(&m_logFont);
        TCHAR szLine[_MAX_PATH];
        wsprintf(szLine, _T("font of %d points"), dlg.GetSize() / 10);
        GetDocument()->AddLine(szLine);
    }
}

void CLedgerView::OnFormatColor()
{
    CColorDialog dlg(m_crText, CC_FULLOPEN, this);
    if (dlg.DoModal() == IDOK)
    {
        m_crText = dlg.GetColor();
        CString strLine;
        strLine.Format(_T("colour %02x%02x%02x"), GetRValue(m_crText), GetGValue(m_crText), GetBValue(m_crText));
        GetDocument()->AddLine(strLine);
    }
}

void CLedgerView::OnToolsOptions()
{
    COptions dlg(this);
    if (dlg.DoModal() != IDOK)
        return;
    char szNumber[34];
    itoa(dlg.m_nCurrency, szNumber, 10);
    TCHAR szLine[_MAX_PATH];
    strcpy_s(szLine, "name ");
    strcat_s(szLine, dlg.m_strName);
    strcat_s(szLine, ", currency ");
    strcat_s(szLine, szNumber);
    GetDocument()->AddLine(szLine);
}

void CLedgerView::OnToolsNames()
{
    CStringArray lines;
    TellNames(*this, lines);
    for (int i = 0; i < lines.GetSize(); i++)
        GetDocument()->AddLine(lines[i]);
}

void CLedgerView::OnToolsRuled()
{
    m_bRuled = !m_bRuled;
    Invalidate();
}

void CLedgerView::OnUpdateToolsRuled(CCmdUI* pCmdUI)
{
    pCmdUI->SetCheck(m_bRuled);
}
