#pragma once

/// @file
/// CColorDialog: asks for a colour.

#include "platform/afx/core/Wnd.h"

// Flags of a colour dialog
#define CC_RGBINIT 0x0001
#define CC_FULLOPEN 0x0002
#define CC_PREVENTFULLOPEN 0x0004
#define CC_SOLIDCOLOR 0x0080
#define CC_ANYCOLOR 0x0100

/// What a colour dialog is told and answers.
struct CHOOSECOLORA {
    DWORD lStructSize = sizeof(CHOOSECOLORA); ///< Size of this record in bytes; not looked at.
    HWND hwndOwner = nullptr;                 ///< The window it stands over.
    HWND hInstance = nullptr;
    COLORREF rgbResult = 0;           ///< In, with CC_RGBINIT: the colour shown first. Out: the one chosen.
    COLORREF* lpCustColors = nullptr; ///< 16 colours of the user's own, shown and changed.
    DWORD Flags = 0;                  ///< CC_RGBINIT counts: the dialog is always whole and knows all colours.
    LPARAM lCustData = 0;
};
using CHOOSECOLOR = CHOOSECOLORA;

/// The toolkit's colour dialog.
///
/// @code
/// CColorDialog dialog(m_color, 0, this);
/// if (dialog.DoModal() == IDOK) {
///     m_color = dialog.GetColor();
/// }
/// @endcode
class TVX_PLATFORM_API CColorDialog : public CWnd {
    DECLARE_DYNAMIC(CColorDialog)

public:
    /// The record behind the dialog, to be changed before DoModal.
    CHOOSECOLOR m_cc;

    /// @param color the colour shown first; 0 is black
    /// @param parent the window it stands over; null: the main window
    explicit CColorDialog(COLORREF color = 0, DWORD flags = 0, CWnd* parent = nullptr);

    /// Shows the dialog and answers IDOK or IDCANCEL.
    virtual INT_PTR DoModal();
    /// The colour that was chosen, else the one shown first.
    COLORREF GetColor() const {
        return m_cc.rgbResult;
    }
    /// Changes the colour shown first.
    void SetCurrentColor(COLORREF color) {
        m_cc.rgbResult = color;
        m_cc.Flags |= CC_RGBINIT;
    }
    /// The 16 colours of the user's own, the same in all such dialogs of this run.
    static COLORREF* GetSavedCustomColors();
};
