#pragma once

/// @file
/// Drawing tools: pens, brushes, fonts, bitmaps, regions, and the colours and sizes of the desktop.
///
/// A tool is an object known by a handle. Handles are numbers that are looked up at each use: one that was deleted
/// makes a call fail and nothing else. The classes below own the handle they hold and delete it when they are
/// destroyed. A tool may be deleted while a device context still has it selected; the context goes on drawing with it
/// until another one is selected.
///
/// @code
/// CPen pen(PS_DASH, 1, RGB(255, 0, 0));
/// CPen* old = dc.SelectObject(&pen);
/// dc.MoveTo(0, 0);
/// dc.LineTo(100, 50);
/// dc.SelectObject(old);
/// @endcode
///
/// Drawing belongs to the user-interface thread.

#include "platform/afx/gdi/GdiTypes.h"
#include "platform/base/Export.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"

class CBitmap;
class CDC;

/// Base of the drawing tools: owner of one handle. Hosts make the derived classes; objects that `FromHandle` makes for
/// a bare handle belong to the layer, own nothing, and live until the program is idle.
class TVX_PLATFORM_API CGdiObject : public CObject {
    DECLARE_DYNAMIC(CGdiObject)
public:
    CGdiObject() = default;
    /// Deletes the tool it holds.
    ~CGdiObject() override;

    /// The handle; null when nothing is held. For reading only.
    HGDIOBJ m_hObject = nullptr;

    /// The handle; null when nothing is held.
    operator HGDIOBJ() const {
        return m_hObject;
    }
    /// The handle, also when called through a null pointer's worth of object: null when nothing is held.
    HGDIOBJ GetSafeHandle() const {
        return m_hObject;
    }
    /// The object that holds `object`, else one that the layer makes until the program is idle. Null for a handle that
    /// is no tool (any more).
    static CGdiObject* FromHandle(HGDIOBJ object);
    /// Deletes the objects that `FromHandle` made. Done by the framework when the program is idle.
    static void DeleteTempMap();

    /// Takes over an existing tool. FALSE for null, for a handle that is no tool, and when one is held already.
    BOOL Attach(HGDIOBJ object);
    /// Gives the tool away: the caller deletes it from now on. Null when nothing was held.
    HGDIOBJ Detach();
    /// Deletes the tool at once. FALSE when nothing is held or it was deleted otherwise. Stock objects stay.
    BOOL DeleteObject();

    /// Copies the description of the tool (LOGPEN, LOGBRUSH, LOGFONT, BITMAP) to `buffer`, at most `count` bytes.
    /// The result is the number of bytes copied, 0 on failure.
    int GetObject(int count, LPVOID buffer) const;
    /// Kind of the tool (OBJ_PEN, ...), 0 when nothing is held.
    UINT GetObjectType() const;
    /// Takes one of the predefined tools (BLACK_PEN, DEFAULT_GUI_FONT, ...), which is not deleted with the object.
    BOOL CreateStockObject(int index);
    /// Whether both stand for one tool: two objects may, if one of them is temporary.
    BOOL operator==(const CGdiObject& other) const {
        return m_hObject == other.m_hObject;
    }
};

/// Draws lines and outlines.
class TVX_PLATFORM_API CPen : public CGdiObject {
    DECLARE_DYNAMIC(CPen)
public:
    /// Holds nothing until `CreatePen`.
    CPen() = default;
    /// As `CreatePen`.
    CPen(int style, int width, COLORREF color);

    /// The handle; null when nothing is held.
    operator HPEN() const {
        return static_cast<HPEN>(m_hObject);
    }
    /// As `CGdiObject::FromHandle`; null when the handle is no pen.
    static CPen* FromHandle(HPEN pen);

    /// @param style PS_SOLID, PS_NULL, PS_INSIDEFRAME, or one of the dashed styles, which are one pixel wide
    /// @param width logical units; 0 is one pixel in every mapping mode. Wide lines have round ends and joins
    BOOL CreatePen(int style, int width, COLORREF color);
    /// As `CreatePen`, from a description.
    BOOL CreatePenIndirect(const LOGPEN* description);
    /// Describes the pen. FALSE when nothing is held.
    BOOL GetLogPen(LOGPEN* description) const;
};

/// Fills areas.
class TVX_PLATFORM_API CBrush : public CGdiObject {
    DECLARE_DYNAMIC(CBrush)
public:
    /// Holds nothing until one of the `Create` calls.
    CBrush() = default;
    /// As `CreateSolidBrush`.
    explicit CBrush(COLORREF color);
    /// As `CreateHatchBrush`.
    CBrush(int hatch, COLORREF color);
    /// As `CreatePatternBrush`.
    explicit CBrush(CBitmap* bitmap);

    /// The handle; null when nothing is held.
    operator HBRUSH() const {
        return static_cast<HBRUSH>(m_hObject);
    }
    /// As `CGdiObject::FromHandle`; null when the handle is no brush.
    static CBrush* FromHandle(HBRUSH brush);

    /// A brush of one colour.
    BOOL CreateSolidBrush(COLORREF color);
    /// A brush of lines (HS_...) in squares of 8 pixels. Between the lines the context's background colour shows, or
    /// what was there before when its background mode is TRANSPARENT.
    BOOL CreateHatchBrush(int hatch, COLORREF color);
    /// A brush that repeats a copy of `bitmap`. A monochrome one takes the context's text and background colours.
    BOOL CreatePatternBrush(CBitmap* bitmap);
    /// A brush of the kind that the description tells (BS_...). FALSE for an unknown kind.
    BOOL CreateBrushIndirect(const LOGBRUSH* description);
    /// A brush in the system colour COLOR_... .
    BOOL CreateSysColorBrush(int index);
    /// Describes the brush. FALSE when nothing is held.
    BOOL GetLogBrush(LOGBRUSH* description) const;
};

/// Draws text. Faces that the desktop lacks are replaced by the ones that come nearest; see detail/Fonts.
class TVX_PLATFORM_API CFont : public CGdiObject {
    DECLARE_DYNAMIC(CFont)
public:
    /// Holds nothing until one of the `Create` calls.
    CFont() = default;

    /// The handle; null when nothing is held.
    operator HFONT() const {
        return static_cast<HFONT>(m_hObject);
    }
    /// As `CGdiObject::FromHandle`; null when the handle is no font.
    static CFont* FromHandle(HFONT font);

    /// The fields of LOGFONT, in order.
    BOOL CreateFont(int height, int width, int escapement, int orientation, int weight, BYTE italic, BYTE underline,
                    BYTE strikeOut, BYTE charSet, BYTE outPrecision, BYTE clipPrecision, BYTE quality,
                    BYTE pitchAndFamily, LPCSTR faceName);
    /// A font from a description. FALSE for null.
    BOOL CreateFontIndirect(const LOGFONT* description);
    /// @param pointSize tenths of a point
    /// @param dc        whose mapping mode the height is made for; null is the screen in pixels
    BOOL CreatePointFont(int pointSize, LPCSTR faceName, CDC* dc = nullptr);
    /// As `CreatePointFont`, the height of `description` being in tenths of a point.
    BOOL CreatePointFontIndirect(const LOGFONT* description, CDC* dc = nullptr);
    /// Describes the font as it was asked for. FALSE when nothing is held.
    BOOL GetLogFont(LOGFONT* description) const;
};

/// A picture in memory, drawn on through a memory context that it is selected into. Colour bitmaps have 32 bits a pixel
/// whatever they were made from; monochrome ones have 1.
class TVX_PLATFORM_API CBitmap : public CGdiObject {
    DECLARE_DYNAMIC(CBitmap)
public:
    /// Holds nothing until one of the `Create` or `Load` calls.
    CBitmap() = default;

    /// The handle; null when nothing is held.
    operator HBITMAP() const {
        return static_cast<HBITMAP>(m_hObject);
    }
    /// As `CGdiObject::FromHandle`; null when the handle is no bitmap.
    static CBitmap* FromHandle(HBITMAP bitmap);

    /// The resource of that name (number), looked for in the whole chain of modules.
    BOOL LoadBitmap(LPCSTR name);
    BOOL LoadBitmap(UINT id);
    /// @param width,height pixels, above 0
    /// @param planes       always 1
    /// @param bitsPerPixel 1 or 32
    /// @param bits         rows from the top, padded to even numbers of bytes; null: black
    BOOL CreateBitmap(int width, int height, UINT planes, UINT bitsPerPixel, LPCVOID bits);
    /// A black bitmap in the format of `dc`: monochrome exactly if a monochrome bitmap is selected into it.
    BOOL CreateCompatibleBitmap(CDC* dc, int width, int height);

    /// Size and format. FALSE when nothing is held.
    BOOL GetBitmap(BITMAP* description) const;
    /// Copies pixels (as `CreateBitmap` takes them) to `bits`, at most `count` bytes. The result is the number copied.
    DWORD GetBitmapBits(DWORD count, LPVOID bits) const;
    /// Replaces pixels from the top row on, at most `count` bytes of them. The result is the number of bytes taken.
    DWORD SetBitmapBits(DWORD count, LPCVOID bits);
};

/// An area of any shape in device units, for clipping.
class TVX_PLATFORM_API CRgn : public CGdiObject {
    DECLARE_DYNAMIC(CRgn)
public:
    /// Holds nothing until one of the `Create` calls.
    CRgn() = default;

    /// The handle; null when nothing is held.
    operator HRGN() const {
        return static_cast<HRGN>(m_hObject);
    }
    /// As `CGdiObject::FromHandle`; null when the handle is no region.
    static CRgn* FromHandle(HRGN region);

    /// A rectangle; the corners may come in any order.
    BOOL CreateRectRgn(int left, int top, int right, int bottom);
    /// The same from a rectangle. FALSE for null.
    BOOL CreateRectRgnIndirect(const RECT* rect);
    /// The largest ellipse inside a rectangle.
    BOOL CreateEllipticRgn(int left, int top, int right, int bottom);
    /// What CDC::Polygon would fill, within 32768 units around the origin. FALSE for fewer than two points.
    /// @param mode ALTERNATE or WINDING
    BOOL CreatePolygonRgn(const POINT* points, int count, int mode);

    /// Makes this region, which must exist, the combination RGN_... of two others. The result is the kind of region
    /// (NULLREGION, SIMPLEREGION, COMPLEXREGION) or ERROR.
    int CombineRgn(const CRgn* first, const CRgn* second, int mode);
    /// Makes the region, which must exist, a rectangle; the corners may come in any order.
    void SetRectRgn(int left, int top, int right, int bottom);
    /// Moves the region; the result is its kind.
    int OffsetRgn(int x, int y);
    /// The rectangle around the region; the result is its kind.
    int GetRgnBox(RECT* rect) const;
    /// Whether the pixel belongs to the region.
    BOOL PtInRegion(int x, int y) const;
    BOOL PtInRegion(POINT point) const {
        return PtInRegion(point.x, point.y);
    }
    /// Whether any of the rectangle belongs to the region.
    BOOL RectInRegion(const RECT* rect) const;
};

// The tools by handle. Who creates one deletes it.

/// As `CPen::CreatePen`.
TVX_PLATFORM_API HPEN CreatePen(int style, int width, COLORREF color);
/// As `CBrush::CreateSolidBrush`.
TVX_PLATFORM_API HBRUSH CreateSolidBrush(COLORREF color);
/// The fields of LOGFONT, in order.
TVX_PLATFORM_API HFONT CreateFontA(int height, int width, int escapement, int orientation, int weight, DWORD italic,
                                   DWORD underline, DWORD strikeOut, DWORD charSet, DWORD outPrecision,
                                   DWORD clipPrecision, DWORD quality, DWORD pitchAndFamily, LPCSTR faceName);
/// A font from a description; null for null.
TVX_PLATFORM_API HFONT CreateFontIndirectA(const LOGFONTA* description);
/// As `CBitmap::CreateBitmap`; null on failure.
TVX_PLATFORM_API HBITMAP CreateBitmap(int width, int height, UINT planes, UINT bitsPerPixel, LPCVOID bits);
/// As `CBitmap::CreateCompatibleBitmap`; null on failure.
TVX_PLATFORM_API HBITMAP CreateCompatibleBitmap(HDC dc, int width, int height);
/// A bitmap in the format of the screen from device-independent bits: 1, 4, 8, 24 or 32 a pixel, not compressed.
/// @param dc      not looked at beyond being valid; null is the screen
/// @param initialise CBM_INIT: take pixels from `bits`, 0: leave the bitmap black
/// @param usage   DIB_RGB_COLORS
/// @return null when the header is not understood
TVX_PLATFORM_API HBITMAP CreateDIBitmap(HDC dc, const BITMAPINFOHEADER* header, DWORD initialise, LPCVOID bits,
                                        const BITMAPINFO* info, UINT usage);
/// A bitmap of one module (null: the application's resources as the framework sees them).
/// @return null when the module has no such bitmap or it is damaged
TVX_PLATFORM_API HBITMAP LoadBitmapA(HINSTANCE module, LPCSTR name);
/// Deletes a tool. FALSE for a handle that is no tool; stock objects stay and answer TRUE.
TVX_PLATFORM_API BOOL DeleteObject(HGDIOBJ object);
/// As `CGdiObject::GetObject`. Without `buffer` the result is the size of the description.
TVX_PLATFORM_API int GetObjectA(HGDIOBJ object, int count, LPVOID buffer);
/// Kind of a tool (OBJ_PEN, ...), 0 for a handle that is no tool.
TVX_PLATFORM_API DWORD GetObjectType(HGDIOBJ object);
/// A predefined tool (BLACK_PEN, NULL_BRUSH, DEFAULT_GUI_FONT, ...); null for an unknown number. Not to be deleted.
TVX_PLATFORM_API HGDIOBJ GetStockObject(int index);

/// As `CreateFontA`.
inline HFONT CreateFont(int height, int width, int escapement, int orientation, int weight, DWORD italic,
                        DWORD underline, DWORD strikeOut, DWORD charSet, DWORD outPrecision, DWORD clipPrecision,
                        DWORD quality, DWORD pitchAndFamily, LPCSTR faceName) {
    return CreateFontA(height, width, escapement, orientation, weight, italic, underline, strikeOut, charSet,
                       outPrecision, clipPrecision, quality, pitchAndFamily, faceName);
}
/// As `CreateFontIndirectA`.
inline HFONT CreateFontIndirect(const LOGFONT* description) {
    return CreateFontIndirectA(description);
}
/// As `LoadBitmapA`.
inline HBITMAP LoadBitmap(HINSTANCE module, LPCSTR name) {
    return LoadBitmapA(module, name);
}
/// As `GetObjectA`.
inline int GetObject(HGDIOBJ object, int count, LPVOID buffer) {
    return GetObjectA(object, count, buffer);
}

// Icons

/// An icon of one module in the size that it has nearest to SM_CXICON, or with a null module one of the predefined ones
/// (IDI_...). Icons of modules are loaded once and shared: they need not be destroyed.
/// @return null when there is no such icon or it is damaged
TVX_PLATFORM_API HICON LoadIconA(HINSTANCE module, LPCSTR name);
/// Destroys an icon that the caller created. FALSE for a handle that is no icon.
TVX_PLATFORM_API BOOL DestroyIcon(HICON icon);
/// A copy that the caller destroys; null for a handle that is no icon.
TVX_PLATFORM_API HICON CopyIcon(HICON icon);
/// As `LoadIconA`.
inline HICON LoadIcon(HINSTANCE module, LPCSTR name) {
    return LoadIconA(module, name);
}

// The desktop

/// A colour of the desktop (COLOR_...), taken from the visual style's palette. Black for an unknown number.
TVX_PLATFORM_API COLORREF GetSysColor(int index);
/// The brush in that colour, which is never to be deleted; null for an unknown number. It follows the palette.
TVX_PLATFORM_API HBRUSH GetSysColorBrush(int index);
/// A size or count of the desktop (SM_...) in pixels; 0 for an unknown number.
TVX_PLATFORM_API int GetSystemMetrics(int index);
