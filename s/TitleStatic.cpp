#include "s/TitleStatic.h"

#include <algorithm>
#include <cmath>

BEGIN_MESSAGE_MAP(Gui_TitleStatic, CStatic)
ON_WM_PAINT()
END_MESSAGE_MAP()

void Gui_TitleStatic::SetTitle(const Port::StringBase<char>& title) {
    if (m_title != title) {
        m_title = title;
        changed();
    }
}

void Gui_TitleStatic::SetSubTitle(const Port::StringBase<char>& subTitle) {
    if (m_subTitle != subTitle) {
        m_subTitle = subTitle;
        changed();
    }
}

void Gui_TitleStatic::SetReadable(bool readable) {
    m_readable = readable;
    Invalidate(FALSE);
}

void Gui_TitleStatic::changed() {
    if (!m_hWnd) {
        return;
    }
    // The window's text is what assistive tools read; the band draws the two lines itself.
    const bool both = !m_title.IsEmpty() && !m_subTitle.IsEmpty();
    SetWindowText((m_title + (both ? ". " : "") + m_subTitle).c_str());
    Invalidate(FALSE);
    UpdateWindow();
}

namespace {

constexpr COLORREF white = RGB(255, 255, 255);

/// The share of light that an eye takes from a colour, 0 to 1 (relative luminance of sRGB).
double lightOf(COLORREF color) {
    const auto linear = [](BYTE value) {
        const double part = value / 255.0;
        return part <= 0.04045 ? part / 12.92 : std::pow((part + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * linear(GetRValue(color)) + 0.7152 * linear(GetGValue(color)) + 0.0722 * linear(GetBValue(color));
}

/// The colour itself, or as little darker as white needs to be read on it.
COLORREF darkenedForWhite(COLORREF color) {
    constexpr double wanted = 4.5; // what is asked of texts of usual size
    COLORREF result = color;
    for (int part = 99; 1.05 / (lightOf(result) + 0.05) < wanted; --part) {
        result = RGB(GetRValue(color) * part / 100, GetGValue(color) * part / 100, GetBValue(color) * part / 100);
    }
    return result;
}

LOGFONT interfaceFont() {
    LOGFONT font{};
    CFont::FromHandle(static_cast<HFONT>(GetStockObject(DEFAULT_GUI_FONT)))->GetLogFont(&font);
    return font;
}

/// Draws a line centred at half the width, its top or bottom (as the alignment says) at y; one too wide ends in dots.
void drawLine(CDC& dc, const CString& text, UINT alignment, int width, int y) {
    constexpr int margin = 4;
    if (dc.GetTextExtent(text).cx <= width - 2 * margin) {
        dc.SetTextAlign(TA_CENTER | alignment);
        dc.TextOut(width / 2, y, text);
        return;
    }
    dc.SetTextAlign(TA_LEFT | TA_TOP);
    const int height = dc.GetTextExtent(text).cy;
    const int top = alignment == TA_BOTTOM ? y - height : y;
    CRect place(margin, top, width - margin, top + height);
    dc.DrawText(text, &place, DT_SINGLELINE | DT_NOPREFIX | DT_END_ELLIPSIS | DT_LEFT);
}

} // namespace

void Gui_TitleStatic::OnPaint() {
    CPaintDC dc(this);
    CRect client;
    GetClientRect(&client);
    const COLORREF shadow = GetSysColor(COLOR_BTNSHADOW);
    dc.FillSolidRect(&client, m_readable ? darkenedForWhite(shadow) : shadow);
    dc.SetTextColor(white);
    dc.SetBkMode(TRANSPARENT);
    LOGFONT description = interfaceFont();
    description.lfWeight = FW_BOLD;
    description.lfHeight = std::max<LONG>(description.lfHeight, 5 * client.Height() / 12);
    CFont titleFont;
    titleFont.CreateFontIndirect(&description);
    CFont* const previous = dc.SelectObject(&titleFont);
    drawLine(dc, m_title.c_str(), TA_BOTTOM, client.Width(), client.Height() / 2 - 2);
    dc.SelectStockObject(DEFAULT_GUI_FONT);
    drawLine(dc, m_subTitle.c_str(), TA_TOP, client.Width(), client.Height() / 2 + 2);
    dc.SelectObject(previous);
}
