#pragma once

/// @file
/// The drawing calls by handle: each is the CDC member of its name for the context that a handle stands for, and
/// answers what that answers, for a handle that is no context what the member answers without one.

#include "platform/afx/gdi/Dc.h"

#include <utility>

namespace tvx::afx {

/// Calls a member through the object of a context, or through one that holds nothing.
template <class Call>
auto through(HDC dc, Call&& call) {
    CDC none;
    CDC* context = CDC::FromHandle(dc);
    return std::forward<Call>(call)(context ? *context : none);
}

} // namespace tvx::afx

/// Drawing, modes, mapping and clipping. The calls whose name ends in "Ex" store the value before where the last
/// argument points, if it is not null.
/// @{
inline BOOL MoveToEx(HDC dc, int x, int y, POINT* before) {
    return tvx::afx::through(dc, [&](CDC& c) {
        const CPoint old = c.MoveTo(x, y);
        if (before) {
            *before = old;
        }
        return c.m_hDC ? TRUE : FALSE;
    });
}
inline BOOL LineTo(HDC dc, int x, int y) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.LineTo(x, y); });
}
inline BOOL Polyline(HDC dc, const POINT* points, int count) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.Polyline(points, count); });
}
inline BOOL Polygon(HDC dc, const POINT* points, int count) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.Polygon(points, count); });
}
inline BOOL Rectangle(HDC dc, int left, int top, int right, int bottom) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.Rectangle(left, top, right, bottom); });
}
inline BOOL RoundRect(HDC dc, int left, int top, int right, int bottom, int cornerWidth, int cornerHeight) {
    return tvx::afx::through(dc,
                             [&](CDC& c) { return c.RoundRect(left, top, right, bottom, cornerWidth, cornerHeight); });
}
inline BOOL Ellipse(HDC dc, int left, int top, int right, int bottom) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.Ellipse(left, top, right, bottom); });
}
inline BOOL Arc(HDC dc, int left, int top, int right, int bottom, int startX, int startY, int endX, int endY) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.Arc(left, top, right, bottom, startX, startY, endX, endY); });
}
inline BOOL Pie(HDC dc, int left, int top, int right, int bottom, int startX, int startY, int endX, int endY) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.Pie(left, top, right, bottom, startX, startY, endX, endY); });
}
inline int FrameRect(HDC dc, const RECT* rect, HBRUSH brush) {
    return tvx::afx::through(dc, [&](CDC& c) {
        c.FrameRect(rect, CBrush::FromHandle(brush));
        return c.m_hDC ? 1 : 0;
    });
}
inline BOOL InvertRect(HDC dc, const RECT* rect) {
    return tvx::afx::through(dc, [&](CDC& c) {
        c.InvertRect(rect);
        return c.m_hDC ? TRUE : FALSE;
    });
}
inline BOOL DrawFocusRect(HDC dc, const RECT* rect) {
    return tvx::afx::through(dc, [&](CDC& c) {
        c.DrawFocusRect(rect);
        return c.m_hDC ? TRUE : FALSE;
    });
}
inline BOOL DrawEdge(HDC dc, RECT* rect, UINT edge, UINT flags) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.DrawEdge(rect, edge, flags); });
}
inline BOOL DrawIcon(HDC dc, int x, int y, HICON icon) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.DrawIcon(x, y, icon); });
}
inline BOOL PatBlt(HDC dc, int x, int y, int width, int height, DWORD rop) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.PatBlt(x, y, width, height, rop); });
}
inline BOOL StretchBlt(HDC dc, int x, int y, int width, int height, HDC source, int sourceX, int sourceY,
                       int sourceWidth, int sourceHeight, DWORD rop) {
    return tvx::afx::through(dc, [&](CDC& c) {
        return c.StretchBlt(x, y, width, height, CDC::FromHandle(source), sourceX, sourceY, sourceWidth, sourceHeight,
                            rop);
    });
}
inline BOOL TextOut(HDC dc, int x, int y, LPCSTR text, int count) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.TextOut(x, y, text, count); });
}
inline BOOL ExtTextOut(HDC dc, int x, int y, UINT options, const RECT* rect, LPCSTR text, UINT count,
                       const int* advances) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.ExtTextOut(x, y, options, rect, text, count, advances); });
}
inline int DrawText(HDC dc, LPCSTR text, int count, RECT* rect, UINT format) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.DrawText(text, count, rect, format); });
}
inline COLORREF SetTextColor(HDC dc, COLORREF color) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.SetTextColor(color); });
}
inline COLORREF SetBkColor(HDC dc, COLORREF color) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.SetBkColor(color); });
}
inline int SetBkMode(HDC dc, int mode) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.SetBkMode(mode); });
}
inline int SetROP2(HDC dc, int mode) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.SetROP2(mode); });
}
inline int SetMapMode(HDC dc, int mode) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.SetMapMode(mode); });
}
inline int SetStretchBltMode(HDC dc, int mode) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.SetStretchBltMode(mode); });
}
inline UINT SetTextAlign(HDC dc, UINT flags) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.SetTextAlign(flags); });
}
inline COLORREF GetTextColor(HDC dc) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.GetTextColor(); });
}
inline COLORREF GetBkColor(HDC dc) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.GetBkColor(); });
}
inline BOOL SetViewportOrgEx(HDC dc, int x, int y, POINT* before) {
    return tvx::afx::through(dc, [&](CDC& c) {
        const POINT old = c.SetViewportOrg(x, y);
        if (before) {
            *before = old;
        }
        return c.m_hDC ? TRUE : FALSE;
    });
}
inline BOOL SetWindowOrgEx(HDC dc, int x, int y, POINT* before) {
    return tvx::afx::through(dc, [&](CDC& c) {
        const POINT old = c.SetWindowOrg(x, y);
        if (before) {
            *before = old;
        }
        return c.m_hDC ? TRUE : FALSE;
    });
}
inline BOOL SetViewportExtEx(HDC dc, int cx, int cy, SIZE* before) {
    return tvx::afx::through(dc, [&](CDC& c) {
        const SIZE old = c.SetViewportExt(cx, cy);
        if (before) {
            *before = old;
        }
        return c.m_hDC ? TRUE : FALSE;
    });
}
inline BOOL SetWindowExtEx(HDC dc, int cx, int cy, SIZE* before) {
    return tvx::afx::through(dc, [&](CDC& c) {
        const SIZE old = c.SetWindowExt(cx, cy);
        if (before) {
            *before = old;
        }
        return c.m_hDC ? TRUE : FALSE;
    });
}
inline BOOL LPtoDP(HDC dc, POINT* points, int count) {
    return tvx::afx::through(dc, [&](CDC& c) {
        c.LPtoDP(points, count);
        return c.m_hDC ? TRUE : FALSE;
    });
}
inline BOOL DPtoLP(HDC dc, POINT* points, int count) {
    return tvx::afx::through(dc, [&](CDC& c) {
        c.DPtoLP(points, count);
        return c.m_hDC ? TRUE : FALSE;
    });
}
inline int SaveDC(HDC dc) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.SaveDC(); });
}
inline BOOL RestoreDC(HDC dc, int saved) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.RestoreDC(saved); });
}
inline int SelectClipRgn(HDC dc, HRGN region) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.SelectClipRgn(CRgn::FromHandle(region)); });
}
inline int IntersectClipRect(HDC dc, int left, int top, int right, int bottom) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.IntersectClipRect(left, top, right, bottom); });
}
inline int ExcludeClipRect(HDC dc, int left, int top, int right, int bottom) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.ExcludeClipRect(left, top, right, bottom); });
}
inline int GetClipBox(HDC dc, RECT* rect) {
    return tvx::afx::through(dc, [&](CDC& c) { return c.GetClipBox(rect); });
}
/// @}

/// Tools by handle. Who creates one deletes it with DeleteObject; null on failure.
/// @{
inline HBRUSH CreateHatchBrush(int hatch, COLORREF color) {
    CBrush tool;
    tool.CreateHatchBrush(hatch, color);
    return static_cast<HBRUSH>(tool.Detach());
}
inline HBRUSH CreateBrushIndirect(const LOGBRUSH* description) {
    CBrush tool;
    tool.CreateBrushIndirect(description);
    return static_cast<HBRUSH>(tool.Detach());
}
inline HBRUSH CreatePatternBrush(HBITMAP bitmap) {
    CBrush tool;
    tool.CreatePatternBrush(CBitmap::FromHandle(bitmap));
    return static_cast<HBRUSH>(tool.Detach());
}
inline HPEN CreatePenIndirect(const LOGPEN* description) {
    CPen tool;
    tool.CreatePenIndirect(description);
    return static_cast<HPEN>(tool.Detach());
}
inline HRGN CreateRectRgn(int left, int top, int right, int bottom) {
    CRgn tool;
    tool.CreateRectRgn(left, top, right, bottom);
    return static_cast<HRGN>(tool.Detach());
}
inline HRGN CreateRectRgnIndirect(const RECT* rect) {
    CRgn tool;
    tool.CreateRectRgnIndirect(rect);
    return static_cast<HRGN>(tool.Detach());
}
inline HRGN CreateEllipticRgn(int left, int top, int right, int bottom) {
    CRgn tool;
    tool.CreateEllipticRgn(left, top, right, bottom);
    return static_cast<HRGN>(tool.Detach());
}
inline HRGN CreatePolygonRgn(const POINT* points, int count, int mode) {
    CRgn tool;
    tool.CreatePolygonRgn(points, count, mode);
    return static_cast<HRGN>(tool.Detach());
}
/// Combines two regions into `target`, which must exist; the result is its kind.
inline int CombineRgn(HRGN target, HRGN first, HRGN second, int mode) {
    CRgn* region = CRgn::FromHandle(target);
    return region ? region->CombineRgn(CRgn::FromHandle(first), CRgn::FromHandle(second), mode) : ERROR;
}
inline BOOL PtInRegion(HRGN region, int x, int y) {
    const CRgn* area = CRgn::FromHandle(region);
    return area && area->PtInRegion(x, y);
}
/// @}
