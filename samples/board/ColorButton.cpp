#include "ColorButton.h"

#include "afxdlgs.h"

void CColorButton::SetColor(COLORREF color) {
    m_color = color;
    CString text;
    text.Format("#%02X%02X%02X", GetRValue(color), GetGValue(color), GetBValue(color));
    SetWindowText(text); // what assistive tools say
    Invalidate();
}

void CColorButton::DrawItem(DRAWITEMSTRUCT* item) {
    CDC* const dc = CDC::FromHandle(item->hDC);
    CRect area = item->rcItem;
    const bool isPressed = (item->itemState & ODS_SELECTED) != 0;
    dc->FillSolidRect(area, GetSysColor(COLOR_BTNFACE));
    dc->DrawEdge(area, isPressed ? EDGE_SUNKEN : EDGE_RAISED, BF_RECT);
    area.DeflateRect(5, 5);
    dc->FillSolidRect(area, GetSysColor(COLOR_WINDOWTEXT));
    area.DeflateRect(1, 1);
    dc->FillSolidRect(area, (item->itemState & ODS_DISABLED) != 0 ? GetSysColor(COLOR_BTNFACE) : m_color);
    if ((item->itemState & ODS_FOCUS) != 0) {
        area = item->rcItem;
        area.DeflateRect(3, 3);
        dc->DrawFocusRect(area);
    }
}

bool CColorButton::Choose() {
    CColorDialog dialog(m_color, CC_FULLOPEN | CC_RGBINIT, GetParent());
    if (dialog.DoModal() != IDOK || dialog.GetColor() == m_color) {
        return false;
    }
    SetColor(dialog.GetColor());
    return true;
}

BOOL CColorButton::OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
    const bool isClick = message == WM_COMMAND && HIWORD(wParam) == BN_CLICKED;
    if (!isClick) {
        return CButton::OnChildNotify(message, wParam, lParam, result);
    }
    if (Choose()) {
        GetParent()->SendMessage(WM_COMMAND, MAKEWPARAM(GetDlgCtrlID(), EN_CHANGE), reinterpret_cast<LPARAM>(m_hWnd));
    }
    return TRUE;
}

void DDX_Color(CDataExchange* dx, int id, CColorButton& button, COLORREF& color) {
    if (!button.m_hWnd) {
        DDX_Control(dx, id, button);
    }
    if (dx->m_bSaveAndValidate) {
        color = button.GetColor();
    } else {
        button.SetColor(color);
    }
}
