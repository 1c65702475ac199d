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

    /// Shows an icon or bitmap, which stays the caller's; the control takes its size unless it has SS_CENTERIMAGE.
    /// Answers the previous one.
    HICON SetIcon(HICON icon) {
        return reinterpret_cast<HICON>(SendMessage(STM_SETIMAGE, IMAGE_ICON, reinterpret_cast<LPARAM>(icon)));
    }
    HICON GetIcon() const {
        return reinterpret_cast<HICON>(SendMessage(STM_GETIMAGE, IMAGE_ICON));
    }
    HBITMAP SetBitmap(HBITMAP bitmap) {
        return reinterpret_cast<HBITMAP>(SendMessage(STM_SETIMAGE, IMAGE_BITMAP, reinterpret_cast<LPARAM>(bitmap)));
    }
    HBITMAP GetBitmap() const {
        return reinterpret_cast<HBITMAP>(SendMessage(STM_GETIMAGE, IMAGE_BITMAP));
    }
};
