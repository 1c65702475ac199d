#include "ColorButton.h"

#include "afxdlgs.h"

// clang-format off
BEGIN_MESSAGE_MAP(CColorButton, CButton)
    ON_CONTROL_REFLECT_EX(BN_CLICKED, &CColorButton::OnClicked)
END_MESSAGE_MAP()
// clang-format on

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
    dc->DrawFrameControl(area, DFC_BUTTON, DFCS_BUTTONPUSH | (isPressed ? DFCS_PUSHED : 0U));
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

BOOL CColorButton::OnClicked() {
    CColorDialog dialog(m_color, CC_FULLOPEN, GetParent());
    if (dialog.DoModal() != IDOK || dialog.GetColor() == m_color) {
        return TRUE;
    }
    SetColor(dialog.GetColor());
    return FALSE;
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
