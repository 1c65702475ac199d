#pragma once

#include "afxwin.h"

/// A button that shows a colour and lets the user choose another one. A choice reaches the parent as a change of a
/// field does, by EN_CHANGE.
class CColorButton : public CButton {
public:
    COLORREF GetColor() const {
        return m_color;
    }
    void SetColor(COLORREF color);
    void DrawItem(DRAWITEMSTRUCT* item) override;

protected:
    /// The parent hears of a choice, not of clicks.
    BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) override;

private:
    bool Choose();

    COLORREF m_color = 0;
};

/// Exchanges the colour of such a button, which is made of a control the first time.
void DDX_Color(CDataExchange* dx, int id, CColorButton& button, COLORREF& color);
