#pragma once

/// @file
/// The drawing calls by handle: each is the CDC member of its name for the context that a handle stands for, and
/// answers what that answers; for a handle that is no context, what the member answers without one.

#include "platform/afx/gdi/Dc.h"

namespace tvx::afx {

/// The object of a context, or one that holds nothing.
class HandleDc {
public:
    explicit HandleDc(HDC dc) : m_context(CDC::FromHandle(dc)) {}
    CDC* operator->() {
        return m_context ? m_context : &m_none;
    }
    /// What a call answers whose member has no result, or one that is not asked for.
    BOOL isThere() const {
        return m_context != nullptr;
    }
    /// The same, when `value` has been stored where `before` points, unless that is null.
    template <class Value>
    BOOL store(const Value& value, Value* before) const {
        if (before) {
            *before = value;
        }
        return isThere();
    }

private:
    CDC m_none;
    CDC* m_context;
};

} // namespace tvx::afx

// A call that hands its arguments on: result, name, parameters behind the context, arguments.
#define TVX_BY_HANDLE(result, name, parameters, ...)                                                                   \
    inline result name(HDC dc TVX_PARAMETERS parameters) {                                                             \
        return tvx::afx::HandleDc(dc)->name(__VA_ARGS__);                                                              \
    }
#define TVX_PARAMETERS(...) __VA_OPT__(, ) __VA_ARGS__

/// Drawing
/// @{
TVX_BY_HANDLE(BOOL, LineTo, (int x, int y), x, y)
TVX_BY_HANDLE(BOOL, Polyline, (const POINT* points, int count), points, count)
TVX_BY_HANDLE(BOOL, Polygon, (const POINT* points, int count), points, count)
TVX_BY_HANDLE(BOOL, Rectangle, (int left, int top, int right, int bottom), left, top, right, bottom)
TVX_BY_HANDLE(BOOL, RoundRect, (int left, int top, int right, int bottom, int cx, int cy), left, top, right, bottom, cx,
              cy)
TVX_BY_HANDLE(BOOL, Ellipse, (int left, int top, int right, int bottom), left, top, right, bottom)
TVX_BY_HANDLE(BOOL, Arc, (int left, int top, int right, int bottom, int x1, int y1, int x2, int y2), left, top, right,
              bottom, x1, y1, x2, y2)
TVX_BY_HANDLE(BOOL, Pie, (int left, int top, int right, int bottom, int x1, int y1, int x2, int y2), left, top, right,
              bottom, x1, y1, x2, y2)
TVX_BY_HANDLE(BOOL, DrawEdge, (RECT * rect, UINT edge, UINT flags), rect, edge, flags)
TVX_BY_HANDLE(BOOL, DrawIcon, (int x, int y, HICON icon), x, y, icon)
TVX_BY_HANDLE(BOOL, PatBlt, (int x, int y, int width, int height, DWORD rop), x, y, width, height, rop)
TVX_BY_HANDLE(BOOL, StretchBlt,
              (int x, int y, int width, int height, HDC source, int sourceX, int sourceY, int sourceWidth,
               int sourceHeight, DWORD rop),
              x, y, width, height, CDC::FromHandle(source), sourceX, sourceY, sourceWidth, sourceHeight, rop)
TVX_BY_HANDLE(BOOL, TextOut, (int x, int y, LPCSTR text, int count), x, y, text, count)
TVX_BY_HANDLE(BOOL, ExtTextOut,
              (int x, int y, UINT options, const RECT* rect, LPCSTR text, UINT count, const int* advances), x, y,
              options, rect, text, count, advances)
TVX_BY_HANDLE(int, DrawText, (LPCSTR text, int count, RECT* rect, UINT format), text, count, rect, format)
inline BOOL MoveToEx(HDC dc, int x, int y, POINT* before) {
    tvx::afx::HandleDc context(dc);
    return context.store<POINT>(context->MoveTo(x, y), before);
}
inline BOOL FrameRect(HDC dc, const RECT* rect, HBRUSH brush) {
    tvx::afx::HandleDc context(dc);
    context->FrameRect(rect, CBrush::FromHandle(brush));
    return context.isThere();
}
inline BOOL InvertRect(HDC dc, const RECT* rect) {
    tvx::afx::HandleDc context(dc);
    context->InvertRect(rect);
    return context.isThere();
}
inline BOOL DrawFocusRect(HDC dc, const RECT* rect) {
    tvx::afx::HandleDc context(dc);
    context->DrawFocusRect(rect);
    return context.isThere();
}
/// @}

/// State of the context
/// @{
TVX_BY_HANDLE(int, SaveDC, ())
TVX_BY_HANDLE(BOOL, RestoreDC, (int saved), saved)
TVX_BY_HANDLE(COLORREF, SetTextColor, (COLORREF color), color)
TVX_BY_HANDLE(COLORREF, GetTextColor, ())
TVX_BY_HANDLE(COLORREF, SetBkColor, (COLORREF color), color)
TVX_BY_HANDLE(COLORREF, GetBkColor, ())
TVX_BY_HANDLE(int, SetBkMode, (int mode), mode)
TVX_BY_HANDLE(int, SetROP2, (int mode), mode)
TVX_BY_HANDLE(int, SetStretchBltMode, (int mode), mode)
TVX_BY_HANDLE(UINT, SetTextAlign, (UINT flags), flags)
TVX_BY_HANDLE(int, SetMapMode, (int mode), mode)
TVX_BY_HANDLE(int, SelectClipRgn, (HRGN region), CRgn::FromHandle(region))
TVX_BY_HANDLE(int, IntersectClipRect, (int left, int top, int right, int bottom), left, top, right, bottom)
TVX_BY_HANDLE(int, ExcludeClipRect, (int left, int top, int right, int bottom), left, top, right, bottom)
TVX_BY_HANDLE(int, GetClipBox, (RECT * rect), rect)
inline BOOL SetViewportOrgEx(HDC dc, int x, int y, POINT* before) {
    tvx::afx::HandleDc context(dc);
    return context.store<POINT>(context->SetViewportOrg(x, y), before);
}
inline BOOL SetWindowOrgEx(HDC dc, int x, int y, POINT* before) {
    tvx::afx::HandleDc context(dc);
    return context.store<POINT>(context->SetWindowOrg(x, y), before);
}
inline BOOL SetViewportExtEx(HDC dc, int cx, int cy, SIZE* before) {
    tvx::afx::HandleDc context(dc);
    return context.store<SIZE>(context->SetViewportExt(cx, cy), before);
}
inline BOOL SetWindowExtEx(HDC dc, int cx, int cy, SIZE* before) {
    tvx::afx::HandleDc context(dc);
    return context.store<SIZE>(context->SetWindowExt(cx, cy), before);
}
/// @}

/// Tools by handle; null on failure. Who creates one deletes it with DeleteObject.
/// @{
inline HBRUSH CreateHatchBrush(int hatch, COLORREF color) {
    return static_cast<HBRUSH>(CBrush(hatch, color).Detach());
}
inline HBRUSH CreatePatternBrush(HBITMAP bitmap) {
    return static_cast<HBRUSH>(CBrush(CBitmap::FromHandle(bitmap)).Detach());
}
inline HRGN CreateRectRgn(int left, int top, int right, int bottom) {
    CRgn region;
    region.CreateRectRgn(left, top, right, bottom);
    return static_cast<HRGN>(region.Detach());
}
/// @}
