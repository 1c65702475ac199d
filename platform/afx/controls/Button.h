#pragma once

#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Wnd.h"
#include "platform/afx/gdi/Gdi.h"

/// A push button, check box, radio button or group box: which, its style says (BS_...).
class TVX_PLATFORM_API CButton : public CWnd {
    DECLARE_DYNAMIC(CButton)

public:
    BOOL Create(LPCSTR text, DWORD style, const RECT& rect, CWnd* parent, UINT id);
    using CWnd::Create;

    /// BST_PUSHED, BST_FOCUS and the mark.
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
    void SetButtonStyle(UINT style, BOOL redraw = TRUE) {
        SendMessage(BM_SETSTYLE, style, redraw);
    }
    /// Shows a picture, which stays the caller's; the style must have BS_ICON or BS_BITMAP. Answers the previous one.
    HICON SetIcon(HICON icon) {
        return reinterpret_cast<HICON>(SendMessage(BM_SETIMAGE, IMAGE_ICON, reinterpret_cast<LPARAM>(icon)));
    }
    HBITMAP SetBitmap(HBITMAP bitmap) {
        return reinterpret_cast<HBITMAP>(SendMessage(BM_SETIMAGE, IMAGE_BITMAP, reinterpret_cast<LPARAM>(bitmap)));
    }
    /// Paints a button with BS_OWNERDRAW, when the parent did not.
    virtual void DrawItem(DRAWITEMSTRUCT* item);

protected:
    BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) override;
};
