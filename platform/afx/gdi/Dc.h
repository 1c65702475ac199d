#pragma once

/// @file
/// Device contexts: what drawing is done through.
///
/// Any time is right for drawing. What is drawn through a window's context appears at the latest when the context is
/// released or the program waits for the next message, and stays until that part of the window is invalidated. Pixels
/// are exact: nothing but text is ever antialiased.
///
/// @code
/// CClientDC dc(this);                     // or CPaintDC in OnPaint, or CDC memory; memory.CreateCompatibleDC(&dc);
/// dc.FillSolidRect(0, 0, 50, 20, RGB(255, 255, 255));
/// dc.TextOut(2, 2, "Text");
/// @endcode
///
/// Arguments are in logical units of the mapping mode unless a comment says otherwise; rectangles do not include their
/// right and bottom edges. A call through a context that is no longer valid answers FALSE (0, null) and does nothing.

#include "platform/afx/gdi/Gdi.h"

class CWnd;

/// A device context. Hosts make one for memory (`CreateCompatibleDC`), get one in a call, or use one of the classes
/// below. The destructor deletes the context that the object holds, except for those that `FromHandle` made.
class TVX_PLATFORM_API CDC : public CObject {
    DECLARE_DYNAMIC(CDC)
public:
    CDC() = default;
    ~CDC() override;

    /// The handle; null when nothing is held. For reading only.
    HDC m_hDC = nullptr;
    /// The context that sizes are asked of: always the same as `m_hDC`.
    HDC m_hAttribDC = nullptr;

    /// The handle; null when nothing is held.
    operator HDC() const {
        return m_hDC;
    }
    /// The handle, null when nothing is held.
    HDC GetSafeHdc() const {
        return m_hDC;
    }
    /// The object that holds `dc`, else one that the layer makes until the program is idle. Null for a handle that is
    /// no context (any more).
    static CDC* FromHandle(HDC dc);
    /// Deletes the objects that `FromHandle` made. Done by the framework when the program is idle.
    static void DeleteTempMap();
    /// Takes over a context. FALSE for a handle that is none, and when one is held already.
    BOOL Attach(HDC dc);
    /// Gives the context away: the caller deletes or releases it from now on.
    HDC Detach();

    /// Makes a memory context, with a monochrome bitmap of one pixel selected until another one is.
    /// @param dc null: compatible with the screen
    BOOL CreateCompatibleDC(CDC* dc);
    /// Deletes the context. FALSE when there is none.
    BOOL DeleteDC();
    /// A capability of the device (LOGPIXELSX, HORZRES, ...); 0 for an unknown number.
    int GetDeviceCaps(int index) const;
    /// FALSE: contexts of printers do not exist here.
    BOOL IsPrinting() const {
        return FALSE;
    }

    /// Remembers the state (tools, colours, modes, mapping, clipping, position). The result is the number to restore,
    /// 0 on failure.
    int SaveDC();
    /// Goes back to a remembered state and forgets it and all later ones.
    /// @param saved the result of `SaveDC`, or below 0 counted from the latest (-1: the latest)
    BOOL RestoreDC(int saved);

    // Tools. The result is the tool selected before, null when nothing changed.

    /// Makes a tool the one to draw with, until another one of its kind is selected.
    CPen* SelectObject(CPen* pen);
    CBrush* SelectObject(CBrush* brush);
    CFont* SelectObject(CFont* font);
    /// For memory contexts only; a bitmap can be selected into one context at a time.
    CBitmap* SelectObject(CBitmap* bitmap);
    /// Selects a region as clipping area: `SelectClipRgn`, whose result this is.
    int SelectObject(CRgn* region);
    /// Selects one of the predefined tools (BLACK_PEN, NULL_BRUSH, DEFAULT_GUI_FONT, ...).
    CGdiObject* SelectStockObject(int index);
    /// The pen that is selected.
    CPen* GetCurrentPen() const;
    /// The brush that is selected.
    CBrush* GetCurrentBrush() const;
    /// The font that is selected.
    CFont* GetCurrentFont() const;
    /// The bitmap that a memory context draws on; null for other contexts.
    CBitmap* GetCurrentBitmap() const;

    // Colours and modes. The result of a setter is the value before, 0 (CLR_INVALID) on failure.

    /// The colour of text, and of the black pixels of monochrome pictures.
    COLORREF SetTextColor(COLORREF color);
    /// Answers `SetTextColor`'s value.
    COLORREF GetTextColor() const;
    /// The colour behind text, between dashes and hatch lines, and of monochrome pictures' white pixels.
    COLORREF SetBkColor(COLORREF color);
    /// Answers `SetBkColor`'s value.
    COLORREF GetBkColor() const;
    /// TRANSPARENT or OPAQUE (the default).
    int SetBkMode(int mode);
    /// Answers `SetBkMode`'s value.
    int GetBkMode() const;
    /// How pens and brushes combine with what is there (R2_...).
    int SetROP2(int mode);
    /// Answers `SetROP2`'s value.
    int GetROP2() const;
    /// ALTERNATE (the default) or WINDING.
    int SetPolyFillMode(int mode);
    /// Answers `SetPolyFillMode`'s value.
    int GetPolyFillMode() const;
    /// BLACKONWHITE (the default), WHITEONBLACK, COLORONCOLOR or HALFTONE.
    int SetStretchBltMode(int mode);
    /// Answers `SetStretchBltMode`'s value.
    int GetStretchBltMode() const;
    /// AD_COUNTERCLOCKWISE (the default) or AD_CLOCKWISE.
    int SetArcDirection(int direction);
    /// Answers `SetArcDirection`'s value.
    int GetArcDirection() const;
    /// TA_... values combined.
    UINT SetTextAlign(UINT flags);
    /// Answers `SetTextAlign`'s value.
    UINT GetTextAlign() const;
    /// Where hatches and patterns begin, in device units.
    CPoint SetBrushOrg(int x, int y);
    CPoint SetBrushOrg(POINT point);
    /// Answers `SetBrushOrg`'s value.
    CPoint GetBrushOrg() const;

    // Mapping. A logical point is first moved by the window origin, then scaled by the extents, then moved by the
    // viewport origin, and rounded to the nearest pixel. There are 96 pixels to an inch.

    /// Chooses MM_TEXT (pixels, the default), one of the metric modes (y grows upwards), MM_ISOTROPIC or
    /// MM_ANISOTROPIC. The result is the mode before, 0 for a number that is none.
    int SetMapMode(int mode);
    /// The mode that is set, 0 on failure.
    int GetMapMode() const;
    /// The device point that the window origin is mapped to. The result is the one before.
    CPoint SetViewportOrg(int x, int y);
    CPoint SetViewportOrg(POINT point);
    /// Answers `SetViewportOrg`'s value.
    CPoint GetViewportOrg() const;
    /// Moves the viewport origin by device units. The result is the one before.
    CPoint OffsetViewportOrg(int x, int y);
    /// Changes MM_ISOTROPIC (after the window extents; one of the two is then made smaller) and MM_ANISOTROPIC only.
    CSize SetViewportExt(int cx, int cy);
    CSize SetViewportExt(SIZE size);
    /// The device units that the window extents are mapped to.
    CSize GetViewportExt() const;
    /// The logical point that is mapped to the viewport origin. The result is the one before.
    CPoint SetWindowOrg(int x, int y);
    CPoint SetWindowOrg(POINT point);
    /// Answers `SetWindowOrg`'s value.
    CPoint GetWindowOrg() const;
    /// Moves the window origin by logical units. The result is the one before.
    CPoint OffsetWindowOrg(int x, int y);
    /// Changes MM_ISOTROPIC and MM_ANISOTROPIC only. Extents of 0 are refused.
    CSize SetWindowExt(int cx, int cy);
    CSize SetWindowExt(SIZE size);
    /// The logical units that the viewport extents stand for.
    CSize GetWindowExt() const;
    /// Converts logical to device units in place.
    void LPtoDP(POINT* points, int count = 1) const;
    void LPtoDP(RECT* rect) const;
    /// Converts a size: the result is never negative.
    void LPtoDP(SIZE* size) const;
    /// Converts device to logical units in place.
    void DPtoLP(POINT* points, int count = 1) const;
    void DPtoLP(RECT* rect) const;
    void DPtoLP(SIZE* size) const;

    // Clipping. The result is the kind of the new area (NULLREGION, SIMPLEREGION, COMPLEXREGION) or ERROR.

    /// The rectangle around what can be drawn to at all.
    int GetClipBox(RECT* rect) const;
    /// Whether drawing at the point would be seen.
    BOOL PtVisible(int x, int y) const;
    BOOL PtVisible(POINT point) const;
    /// Whether any of the rectangle would be seen.
    BOOL RectVisible(const RECT* rect) const;
    /// @param region in device units, copied; null takes the clipping away
    int SelectClipRgn(CRgn* region);
    int SelectClipRgn(CRgn* region, int mode);
    /// Takes a rectangle out of the clipping area.
    int ExcludeClipRect(int left, int top, int right, int bottom);
    int ExcludeClipRect(const RECT* rect);
    /// Cuts the clipping area down to what lies in a rectangle.
    int IntersectClipRect(int left, int top, int right, int bottom);
    int IntersectClipRect(const RECT* rect);
    /// Moves the clipping area by logical units.
    int OffsetClipRgn(int x, int y);

    // Lines. The end point of a line is not drawn.

    /// Where the next line begins.
    CPoint GetCurrentPosition() const;
    /// Sets the position without drawing. The result is the one before.
    CPoint MoveTo(int x, int y);
    CPoint MoveTo(POINT point);
    /// Draws from the position to a point, which becomes the position.
    BOOL LineTo(int x, int y);
    BOOL LineTo(POINT point);
    /// Draws through points; the position stays. FALSE for fewer than two points.
    BOOL Polyline(const POINT* points, int count);
    /// Draws from the position through points; the last one becomes the position.
    BOOL PolylineTo(const POINT* points, int count);
    /// Part of the ellipse inside a rectangle, between its crossings with the rays from its centre through two points.
    BOOL Arc(int left, int top, int right, int bottom, int startX, int startY, int endX, int endY);
    BOOL Arc(const RECT* rect, POINT start, POINT end);

    // Shapes: outlined with the pen, filled with the brush.

    /// A rectangle. Without a pen it is one pixel smaller at the right and at the bottom.
    BOOL Rectangle(int left, int top, int right, int bottom);
    BOOL Rectangle(const RECT* rect);
    /// A rectangle whose corners are quarters of an ellipse of the size given.
    BOOL RoundRect(int left, int top, int right, int bottom, int cornerWidth, int cornerHeight);
    BOOL RoundRect(const RECT* rect, POINT corner);
    /// The largest ellipse inside a rectangle.
    BOOL Ellipse(int left, int top, int right, int bottom);
    BOOL Ellipse(const RECT* rect);
    /// What an arc and the lines from its ends to the centre enclose; see `Arc`.
    BOOL Pie(int left, int top, int right, int bottom, int startX, int startY, int endX, int endY);
    BOOL Pie(const RECT* rect, POINT start, POINT end);
    /// What an arc and the line between its ends enclose; see `Arc`.
    BOOL Chord(int left, int top, int right, int bottom, int startX, int startY, int endX, int endY);
    BOOL Chord(const RECT* rect, POINT start, POINT end);
    /// A polygon, closed by a line from the last point to the first. FALSE for fewer than two points.
    BOOL Polygon(const POINT* points, int count);
    /// Several polygons as one area.
    /// @param counts number of points of each
    BOOL PolyPolygon(const POINT* points, const int* counts, int count);

    // Areas

    /// Fills a rectangle, whatever the binary raster operation is.
    void FillRect(const RECT* rect, CBrush* brush);
    /// A border of one logical unit inside the rectangle.
    void FrameRect(const RECT* rect, CBrush* brush);
    /// Inverts the colours of a rectangle.
    void InvertRect(const RECT* rect);
    /// Fills a region, which is in device units.
    BOOL FillRgn(CRgn* region, CBrush* brush);
    /// Fills and leaves `color` as background colour.
    void FillSolidRect(const RECT* rect, COLORREF color);
    void FillSolidRect(int x, int y, int cx, int cy, COLORREF color);
    /// A frame of one unit inside the rectangle, the left and top sides in one colour, the others in another.
    void Draw3dRect(const RECT* rect, COLORREF topLeft, COLORREF bottomRight);
    void Draw3dRect(int x, int y, int cx, int cy, COLORREF topLeft, COLORREF bottomRight);
    /// @param edge  BDR_... or EDGE_...
    /// @param flags BF_...; with BF_ADJUST `rect` becomes what lies inside the edges
    BOOL DrawEdge(RECT* rect, UINT edge, UINT flags);
    /// A dotted frame by exclusive or: drawn again, it is gone.
    void DrawFocusRect(const RECT* rect);
    /// An icon in its own size.
    BOOL DrawIcon(int x, int y, HICON icon);
    BOOL DrawIcon(POINT point, HICON icon);

    // Pixels

    /// The result is the colour really set, CLR_INVALID when the point is clipped away.
    COLORREF SetPixel(int x, int y, COLORREF color);
    COLORREF SetPixel(POINT point, COLORREF color);
    /// As `SetPixel`, without asking what was set.
    BOOL SetPixelV(int x, int y, COLORREF color);
    /// CLR_INVALID when the point lies outside the clipping area.
    COLORREF GetPixel(int x, int y) const;
    COLORREF GetPixel(POINT point) const;
    /// Combines brush and what is there by one of the raster operations without a source (PATCOPY, DSTINVERT, ...).
    BOOL PatBlt(int x, int y, int width, int height, DWORD rop);
    /// Copies pixels of `source`, combined by `rop` (any of the 256 ternary codes). Monochrome sources take this
    /// context's text colour (black pixels) and background colour (white ones); on a monochrome target pixels in the
    /// source's background colour become white. When the mapping modes differ the picture is stretched.
    BOOL BitBlt(int x, int y, int width, int height, CDC* source, int sourceX, int sourceY, DWORD rop);
    /// As `BitBlt`, stretched by the stretching mode. Sizes of different signs mirror the picture; one
    /// below 0 runs down from the pixel given, that pixel included.
    BOOL StretchBlt(int x, int y, int width, int height, CDC* source, int sourceX, int sourceY, int sourceWidth,
                    int sourceHeight, DWORD rop);

    // Text. `count` is in bytes, -1 up to the NUL.

    /// Draws one line of text at a point, placed by `SetTextAlign`.
    BOOL TextOut(int x, int y, LPCSTR text, int count);
    BOOL TextOut(int x, int y, const CString& text);
    /// @param options ETO_OPAQUE fills `rect` with the background colour, ETO_CLIPPED cuts the text at it
    /// @param advances distance from each character to the next in logical units, null: the font's
    BOOL ExtTextOut(int x, int y, UINT options, const RECT* rect, LPCSTR text, UINT count, const int* advances);
    BOOL ExtTextOut(int x, int y, UINT options, const RECT* rect, const CString& text, const int* advances);
    /// Text in a rectangle (DT_...). With DT_CALCRECT nothing is drawn and `rect` becomes as large as needed.
    /// The result is the height of the text, 0 on failure.
    int DrawText(LPCSTR text, int count, RECT* rect, UINT format);
    int DrawText(const CString& text, RECT* rect, UINT format);
    /// @param tabCount 0: a stop every eight average characters; 1: a stop every `tabs[0]` units
    /// @param tabOrigin where stops are counted from
    /// @return width and height of the text
    CSize TabbedTextOut(int x, int y, LPCSTR text, int count, int tabCount, const int* tabs, int tabOrigin);
    CSize TabbedTextOut(int x, int y, const CString& text, int tabCount, const int* tabs, int tabOrigin);
    /// The size of what `TabbedTextOut` would draw.
    CSize GetTabbedTextExtent(LPCSTR text, int count, int tabCount, const int* tabs) const;
    CSize GetTabbedTextExtent(const CString& text, int tabCount, const int* tabs) const;
    /// Width and height of one line of text in the selected font: exactly what drawing it takes.
    CSize GetTextExtent(LPCSTR text, int count) const;
    CSize GetTextExtent(const CString& text) const;
    /// The sizes of the selected font.
    BOOL GetTextMetrics(TEXTMETRIC* metrics) const;
    /// Name of the selected font as it was asked for; of the face really used when no name was given.
    int GetTextFace(int count, LPSTR name) const;
    int GetTextFace(CString& name) const;
    /// Advances of the characters `first` to `last` (Unicode code points), for `last - first + 1` numbers.
    BOOL GetCharWidth(UINT first, UINT last, int* widths) const;
};

/// Draws into the client area of a window, at any time.
class TVX_PLATFORM_API CClientDC : public CDC {
    DECLARE_DYNAMIC(CClientDC)
public:
    /// @param window null: the screen, which can be measured but not drawn to. Raises CResourceException for a CWnd
    ///               without a window.
    explicit CClientDC(CWnd* window);
    ~CClientDC() override;

protected:
    HWND m_hWnd;
};

/// Draws into a whole window, its frame included; (0, 0) is the frame's top left corner.
class TVX_PLATFORM_API CWindowDC : public CDC {
    DECLARE_DYNAMIC(CWindowDC)
public:
    /// As `CClientDC`.
    explicit CWindowDC(CWnd* window);
    ~CWindowDC() override;

protected:
    HWND m_hWnd;
};

/// Paints a window in its WM_PAINT handler: makes BeginPaint and EndPaint. Drawing is clipped to what needs painting.
class TVX_PLATFORM_API CPaintDC : public CDC {
    DECLARE_DYNAMIC(CPaintDC)
public:
    /// The background is erased (WM_ERASEBKGND) where that was asked for.
    explicit CPaintDC(CWnd* window);
    ~CPaintDC() override;

    /// What is being painted.
    PAINTSTRUCT m_ps;

protected:
    HWND m_hWnd;
};

// Contexts by handle.

/// Context of a window's client area, to be given back with `ReleaseDC`. Null window: the screen, which can be measured
/// but not drawn to. Null for a handle that is no window.
TVX_PLATFORM_API HDC GetDC(HWND window);
/// Context of a whole window, to be given back with `ReleaseDC`.
TVX_PLATFORM_API HDC GetWindowDC(HWND window);
/// Shows what was drawn and ends the context. 0 for a handle that is no window's context.
TVX_PLATFORM_API int ReleaseDC(HWND window, HDC dc);
/// Begins painting a window: the context is clipped to what needs painting, whose background is erased first
/// (WM_ERASEBKGND; `fErase` tells when nobody did). Outside WM_PAINT nothing needs painting. Null on failure.
TVX_PLATFORM_API HDC BeginPaint(HWND window, PAINTSTRUCT* paint);
/// Ends what `BeginPaint` began.
TVX_PLATFORM_API BOOL EndPaint(HWND window, const PAINTSTRUCT* paint);
/// A memory context; see `CDC::CreateCompatibleDC`.
TVX_PLATFORM_API HDC CreateCompatibleDC(HDC dc);
/// Ends a memory context.
TVX_PLATFORM_API BOOL DeleteDC(HDC dc);
/// Selects a pen, brush, font or bitmap; the result is the one selected before, null on failure.
TVX_PLATFORM_API HGDIOBJ SelectObject(HDC dc, HGDIOBJ object);
/// As `CDC::GetTextExtent`; FALSE for a handle that is no context.
TVX_PLATFORM_API BOOL GetTextExtentPoint32A(HDC dc, LPCSTR text, int count, SIZE* size);
/// As `CDC::GetTextMetrics`.
TVX_PLATFORM_API BOOL GetTextMetricsA(HDC dc, TEXTMETRICA* metrics);
/// As `CDC::GetDeviceCaps`.
TVX_PLATFORM_API int GetDeviceCaps(HDC dc, int index);
/// As `CDC::BitBlt`.
TVX_PLATFORM_API BOOL BitBlt(HDC dc, int x, int y, int width, int height, HDC source, int sourceX, int sourceY,
                             DWORD rop);
/// As `CDC::GetPixel`.
TVX_PLATFORM_API COLORREF GetPixel(HDC dc, int x, int y);
/// As `CDC::SetPixel`.
TVX_PLATFORM_API COLORREF SetPixel(HDC dc, int x, int y, COLORREF color);
/// Fills with a brush, or with a system colour given as `(HBRUSH)(COLOR_... + 1)`.
TVX_PLATFORM_API int FillRect(HDC dc, const RECT* rect, HBRUSH brush);
/// Draws an icon, scaled unless a size is 0, over `background` when that is not null. `step` and `flags` are not used.
TVX_PLATFORM_API BOOL DrawIconEx(HDC dc, int x, int y, HICON icon, int width, int height, UINT step, HBRUSH background,
                                 UINT flags);

/// As `GetTextMetricsA`.
inline BOOL GetTextMetrics(HDC dc, TEXTMETRIC* metrics) {
    return GetTextMetricsA(dc, metrics);
}
/// As `GetTextExtentPoint32A`.
inline BOOL GetTextExtentPoint32(HDC dc, LPCSTR text, int count, SIZE* size) {
    return GetTextExtentPoint32A(dc, text, count, size);
}
