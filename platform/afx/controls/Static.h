#pragma once

#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Wnd.h"
#include "platform/afx/gdi/Gdi.h"

/// A text, picture, line or frame. It takes no input unless it has SS_NOTIFY.
class TVX_PLATFORM_API CStatic : public CWnd {
    DECLARE_DYNAMIC(CStatic)

public:
    /// @param style SS_...; @param id IDC_STATIC (0xFFFF) for controls nobody asks for
    BOOL Create(LPCSTR text, DWORD style, const RECT& rect, CWnd* parent, UINT id = 0xFFFF);
    using CWnd::Create;

    /// Tells assistive tools that the text stands for another window of the same parent, as it does without being told
    /// for the control that is made next; they hear of the window's new name. Null: for none.
    void SetLabelled(const CWnd* window);

    /// Shows an icon or bitmap, which stays the caller's; the control takes its size unless it has SS_CENTERIMAGE.
    /// Answers the previous one.
    HICON SetIcon(HICON icon) {
        return reinterpret_cast<HICON>(SendMessage(STM_SETIMAGE, IMAGE_ICON, reinterpret_cast<LPARAM>(icon)));
    }
    /// The icon shown, null for none. It belongs to whoever set it; one that a template named belongs to the control's
    /// resources and is never to be destroyed.
    HICON GetIcon() const {
        return reinterpret_cast<HICON>(SendMessage(STM_GETIMAGE, IMAGE_ICON));
    }
    /// The same for a bitmap. A control shows one picture: this turns an SS_ICON control into an SS_BITMAP one.
    HBITMAP SetBitmap(HBITMAP bitmap) {
        return reinterpret_cast<HBITMAP>(SendMessage(STM_SETIMAGE, IMAGE_BITMAP, reinterpret_cast<LPARAM>(bitmap)));
    }
    /// The bitmap shown, null for none; it belongs to whoever set it.
    HBITMAP GetBitmap() const {
        return reinterpret_cast<HBITMAP>(SendMessage(STM_GETIMAGE, IMAGE_BITMAP));
    }
};
