#pragma once

/// @file
/// CFontDialog: asks for a font.

#include "platform/afx/core/Wnd.h"
#include "platform/afx/gdi/Dc.h"

// Flags of a font dialog
#define CF_SCREENFONTS 0x00000001
#define CF_PRINTERFONTS 0x00000002
#define CF_BOTH 0x00000003
#define CF_INITTOLOGFONTSTRUCT 0x00000040
#define CF_EFFECTS 0x00000100
#define CF_FIXEDPITCHONLY 0x00004000
#define CF_FORCEFONTEXIST 0x00010000

/// What a font dialog is told and answers.
struct CHOOSEFONTA {
    DWORD lStructSize = sizeof(CHOOSEFONTA); ///< Size of this record in bytes; not looked at.
    HWND hwndOwner = nullptr;                ///< The window it stands over.
    HDC hDC = nullptr;
    LOGFONT* lpLogFont = nullptr; ///< In, with CF_INITTOLOGFONTSTRUCT: the font shown first. Out: the one chosen.
    int iPointSize = 0;           ///< Out: the size in tenths of a point.
    DWORD Flags = 0;              ///< CF_INITTOLOGFONTSTRUCT and CF_FIXEDPITCHONLY count.
    COLORREF rgbColors = 0;       ///< Kept: the dialog has no choice of colours.
    LPARAM lCustData = 0;
};
using CHOOSEFONT = CHOOSEFONTA;

/// The toolkit's font dialog.
///
/// @code
/// CFontDialog dialog(&m_logFont, CF_EFFECTS | CF_SCREENFONTS, nullptr, this);
/// if (dialog.DoModal() == IDOK) {
///     dialog.GetCurrentFont(&m_logFont);
/// }
/// @endcode
class TVX_PLATFORM_API CFontDialog : public CWnd {
    DECLARE_DYNAMIC(CFontDialog)

public:
    /// The record behind the dialog, to be changed before DoModal.
    CHOOSEFONT m_cf;
    /// The font that it shows and answers.
    LOGFONT m_lf{};

    /// @param initial the font shown first; null: the default font
    /// @param printer not used: there is no printer
    /// @param parent  the window it stands over; null: the main window
    explicit CFontDialog(LOGFONT* initial = nullptr, DWORD flags = CF_EFFECTS | CF_SCREENFONTS, CDC* printer = nullptr,
                         CWnd* parent = nullptr);

    /// Shows the dialog and answers IDOK or IDCANCEL.
    virtual INT_PTR DoModal();
    /// The font that was chosen. Its height is that of the em square in pixels of the screen, below 0.
    void GetCurrentFont(LOGFONT* font) const {
        *font = m_lf;
    }
    /// Parts of it.
    /// @{
    CString GetFaceName() const {
        return m_lf.lfFaceName;
    }
    /// In tenths of a point.
    int GetSize() const {
        return m_cf.iPointSize;
    }
    int GetWeight() const {
        return m_lf.lfWeight;
    }
    BOOL IsBold() const {
        return m_lf.lfWeight > FW_NORMAL;
    }
    BOOL IsItalic() const {
        return m_lf.lfItalic != 0;
    }
    BOOL IsUnderline() const {
        return m_lf.lfUnderline != 0;
    }
    BOOL IsStrikeOut() const {
        return m_lf.lfStrikeOut != 0;
    }
    /// The colour that came with the record.
    COLORREF GetColor() const {
        return m_cf.rgbColors;
    }
    /// @}
};
