#pragma once

#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Wnd.h"
#include "platform/afx/gdi/Gdi.h"

/// A push button, check box, radio button or group box: which, its style says (BS_...).
class TVX_PLATFORM_API CButton : public CWnd {
    DECLARE_DYNAMIC(CButton)

public:
    /// Creates the button in `parent`.
    /// @param text  its label; "&" marks the mnemonic, which the dialog around it acts on
    /// @param style WS_... and BS_...; the kind of button is fixed from then on, whatever SetButtonStyle says
    /// @param rect  place in the parent's client area, in pixels
    /// @param id    number that the parent's BN_... notifications carry
    /// @return FALSE when creation was refused
    BOOL Create(LPCSTR text, DWORD style, const RECT& rect, CWnd* parent, UINT id);
    using CWnd::Create;

    /// BST_PUSHED while it is held down, BST_FOCUS while it has the keyboard, and the mark as GetCheck answers it.
    UINT GetState() const {
        return static_cast<UINT>(SendMessage(BM_GETSTATE));
    }
    /// Shows the button pressed or not; clicks nothing.
    void SetState(BOOL pressed) {
        SendMessage(BM_SETSTATE, static_cast<WPARAM>(pressed));
    }
    /// BST_UNCHECKED, BST_CHECKED or BST_INDETERMINATE.
    int GetCheck() const {
        return static_cast<int>(SendMessage(BM_GETCHECK));
    }
    /// Sets the mark of this button alone: others of a radio group keep theirs (see CWnd::CheckRadioButton).
    void SetCheck(int check) {
        SendMessage(BM_SETCHECK, static_cast<WPARAM>(check));
    }
    /// The low 16 bits of the style.
    UINT GetButtonStyle() const {
        return GetStyle() & 0xFFFFU;
    }
    /// Sets the low 16 bits of the style. Label, default look and the meaning of clicks follow; a push button does not
    /// become a box with a mark or the other way round, because the control keeps the widget it was created with.
    void SetButtonStyle(UINT style, BOOL redraw = TRUE) {
        SendMessage(BM_SETSTYLE, style, redraw);
    }
    /// Shows an icon, which stays the caller's and must live as long as it is shown; null takes it away. With BS_ICON
    /// it stands instead of the label, without beside it. Answers the previous picture, whose end is the caller's
    /// affair.
    HICON SetIcon(HICON icon) {
        return reinterpret_cast<HICON>(SendMessage(BM_SETIMAGE, IMAGE_ICON, reinterpret_cast<LPARAM>(icon)));
    }
    /// The same for a bitmap and BS_BITMAP. A button has one picture: this replaces an icon.
    HBITMAP SetBitmap(HBITMAP bitmap) {
        return reinterpret_cast<HBITMAP>(SendMessage(BM_SETIMAGE, IMAGE_BITMAP, reinterpret_cast<LPARAM>(bitmap)));
    }
    /// Paints a button with BS_OWNERDRAW, when the parent did not.
    virtual void DrawItem(DRAWITEMSTRUCT* item);

protected:
    BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) override;
};
