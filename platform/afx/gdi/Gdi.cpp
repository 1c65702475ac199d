#include "platform/afx/gdi/Gdi.h"

#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/afx/gdi/detail/HandleMap.h"
#include "platform/base/Text.h"

#include <algorithm>
#include <array>
#include <cstring>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CGdiObject, CObject)
IMPLEMENT_DYNAMIC(CPen, CGdiObject)
IMPLEMENT_DYNAMIC(CBrush, CGdiObject)
IMPLEMENT_DYNAMIC(CFont, CGdiObject)
IMPLEMENT_DYNAMIC(CBitmap, CGdiObject)
IMPLEMENT_DYNAMIC(CRgn, CGdiObject)

namespace {

HandleMap<CGdiObject>& objectMap() {
    static auto& map = *new HandleMap<CGdiObject>;
    return map;
}

std::unique_ptr<CGdiObject> makeWrapper(DWORD type) {
    switch (type) {
    case OBJ_PEN:
        return std::make_unique<CPen>();
    case OBJ_BRUSH:
        return std::make_unique<CBrush>();
    case OBJ_FONT:
        return std::make_unique<CFont>();
    case OBJ_BITMAP:
        return std::make_unique<CBitmap>();
    default:
        return std::make_unique<CRgn>();
    }
}

} // namespace

CGdiObject::~CGdiObject() {
    DeleteObject();
}

CGdiObject* CGdiObject::FromHandle(HGDIOBJ object) {
    const DWORD type = ::GetObjectType(object);
    if (type == 0) {
        return nullptr;
    }
    if (CGdiObject* known = objectMap().find(object)) {
        return known;
    }
    auto wrapper = makeWrapper(type);
    wrapper->m_hObject = object;
    return objectMap().addTemporary(object, std::move(wrapper));
}

void CGdiObject::DeleteTempMap() {
    // Their destructor must not delete tools that are not theirs.
    objectMap().deleteTemporaries([](CGdiObject& object) { object.m_hObject = nullptr; });
}

BOOL CGdiObject::Attach(HGDIOBJ object) {
    if (m_hObject || ::GetObjectType(object) == 0) {
        return FALSE;
    }
    m_hObject = object;
    objectMap().addPermanent(object, *this);
    return TRUE;
}

HGDIOBJ CGdiObject::Detach() {
    if (m_hObject) {
        objectMap().removePermanent(m_hObject, *this);
    }
    return std::exchange(m_hObject, nullptr);
}

BOOL CGdiObject::DeleteObject() {
    return m_hObject ? ::DeleteObject(Detach()) : FALSE;
}

int CGdiObject::GetObject(int count, LPVOID buffer) const {
    return GetObjectA(m_hObject, count, buffer);
}

UINT CGdiObject::GetObjectType() const {
    return ::GetObjectType(m_hObject);
}

BOOL CGdiObject::CreateStockObject(int index) {
    return Attach(GetStockObject(index));
}

namespace {

template <class Wrapper>
Wrapper* wrapperOf(HGDIOBJ handle) {
    return dynamic_cast<Wrapper*>(CGdiObject::FromHandle(handle));
}

} // namespace

CPen* CPen::FromHandle(HPEN pen) {
    return wrapperOf<CPen>(pen);
}

CBrush* CBrush::FromHandle(HBRUSH brush) {
    return wrapperOf<CBrush>(brush);
}

CFont* CFont::FromHandle(HFONT font) {
    return wrapperOf<CFont>(font);
}

CBitmap* CBitmap::FromHandle(HBITMAP bitmap) {
    return wrapperOf<CBitmap>(bitmap);
}

CRgn* CRgn::FromHandle(HRGN region) {
    return wrapperOf<CRgn>(region);
}

// Pens

CPen::CPen(int style, int width, COLORREF color) {
    CreatePen(style, width, color);
}

BOOL CPen::CreatePen(int style, int width, COLORREF color) {
    return Attach(::CreatePen(style, width, color));
}

BOOL CPen::CreatePenIndirect(const LOGPEN* description) {
    return description
               ? CreatePen(static_cast<int>(description->lopnStyle), description->lopnWidth.x, description->lopnColor)
               : FALSE;
}

BOOL CPen::GetLogPen(LOGPEN* description) const {
    return GetObject(sizeof(LOGPEN), description) != 0;
}

HPEN CreatePen(int style, int width, COLORREF color) {
    if (style < PS_SOLID || style > PS_INSIDEFRAME) {
        style = PS_SOLID;
    }
    const LOGPEN description = {static_cast<UINT>(style), {std::abs(width), 0}, color};
    return static_cast<HPEN>(addGdiObject(PenObject{description}));
}

// Brushes

CBrush::CBrush(COLORREF color) {
    CreateSolidBrush(color);
}

CBrush::CBrush(int hatch, COLORREF color) {
    CreateHatchBrush(hatch, color);
}

CBrush::CBrush(CBitmap* bitmap) {
    CreatePatternBrush(bitmap);
}

BOOL CBrush::CreateSolidBrush(COLORREF color) {
    return Attach(::CreateSolidBrush(color));
}

BOOL CBrush::CreateHatchBrush(int hatch, COLORREF color) {
    if (hatch < HS_HORIZONTAL || hatch > HS_DIAGCROSS) {
        return FALSE;
    }
    BrushObject brush;
    brush.description = {static_cast<UINT>(BS_HATCHED), color, static_cast<UINT_PTR>(hatch)};
    return Attach(addGdiObject(std::move(brush)));
}

BOOL CBrush::CreatePatternBrush(CBitmap* bitmap) {
    const auto source = findTool<BitmapObject>(bitmap ? bitmap->m_hObject : nullptr);
    if (!source) {
        return FALSE;
    }
    BrushObject brush;
    brush.description = {static_cast<UINT>(BS_PATTERN), 0, reinterpret_cast<UINT_PTR>(source.handle)};
    brush.pattern = source->plainImage().copy();
    brush.patternFormat = source->format;
    return Attach(addGdiObject(std::move(brush)));
}

BOOL CBrush::CreateBrushIndirect(const LOGBRUSH* description) {
    if (!description) {
        return FALSE;
    }
    switch (description->lbStyle) {
    case BS_SOLID:
        return CreateSolidBrush(description->lbColor);
    // There is one, which nobody can delete.
    case BS_NULL:
        return Attach(GetStockObject(NULL_BRUSH));
    case BS_HATCHED:
        return CreateHatchBrush(static_cast<int>(description->lbHatch), description->lbColor);
    case BS_PATTERN:
        return CreatePatternBrush(CBitmap::FromHandle(reinterpret_cast<HBITMAP>(description->lbHatch)));
    default:
        return FALSE;
    }
}

BOOL CBrush::CreateSysColorBrush(int index) {
    return Attach(GetSysColorBrush(index));
}

BOOL CBrush::GetLogBrush(LOGBRUSH* description) const {
    return GetObject(sizeof(LOGBRUSH), description) != 0;
}

HBRUSH CreateSolidBrush(COLORREF color) {
    BrushObject brush;
    brush.description = {static_cast<UINT>(BS_SOLID), color, 0};
    return static_cast<HBRUSH>(addGdiObject(std::move(brush)));
}

// Fonts

BOOL CFont::CreateFont(int height, int width, int escapement, int orientation, int weight, BYTE italic, BYTE underline,
                       BYTE strikeOut, BYTE charSet, BYTE outPrecision, BYTE clipPrecision, BYTE quality,
                       BYTE pitchAndFamily, LPCSTR faceName) {
    return Attach(CreateFontA(height, width, escapement, orientation, weight, italic, underline, strikeOut, charSet,
                              outPrecision, clipPrecision, quality, pitchAndFamily, faceName));
}

BOOL CFont::CreateFontIndirect(const LOGFONT* description) {
    return Attach(CreateFontIndirectA(description));
}

BOOL CFont::CreatePointFont(int pointSize, LPCSTR faceName, CDC* dc) {
    LOGFONT description = pointFont(pointSize, faceName ? faceName : "");
    description.lfHeight = pointSize;
    return CreatePointFontIndirect(&description, dc);
}

BOOL CFont::CreatePointFontIndirect(const LOGFONT* description, CDC* dc) {
    if (!description) {
        return FALSE;
    }
    LOGFONT font = *description;
    // A point is 1/72 of an inch.
    const int pixels = scaled(description->lfHeight, pixelsPerInch, 720);
    const auto context = findContext(dc ? dc->m_hDC : nullptr);
    font.lfHeight = -(context ? context->state.mapping.sizeToLogical({0, pixels}).height() : std::abs(pixels));
    return CreateFontIndirect(&font);
}

BOOL CFont::GetLogFont(LOGFONT* description) const {
    return GetObject(sizeof(LOGFONT), description) != 0;
}

HFONT CreateFontA(int height, int width, int escapement, int orientation, int weight, DWORD italic, DWORD underline,
                  DWORD strikeOut, DWORD charSet, DWORD outPrecision, DWORD clipPrecision, DWORD quality,
                  DWORD pitchAndFamily, LPCSTR faceName) {
    LOGFONT font{};
    font.lfHeight = height;
    font.lfWidth = width;
    font.lfEscapement = escapement;
    font.lfOrientation = orientation;
    font.lfWeight = weight;
    font.lfItalic = static_cast<BYTE>(italic);
    font.lfUnderline = static_cast<BYTE>(underline);
    font.lfStrikeOut = static_cast<BYTE>(strikeOut);
    font.lfCharSet = static_cast<BYTE>(charSet);
    font.lfOutPrecision = static_cast<BYTE>(outPrecision);
    font.lfClipPrecision = static_cast<BYTE>(clipPrecision);
    font.lfQuality = static_cast<BYTE>(quality);
    font.lfPitchAndFamily = static_cast<BYTE>(pitchAndFamily);
    if (faceName) {
        tvx::text::copyCut(faceName, font.lfFaceName, LF_FACESIZE);
    }
    return CreateFontIndirectA(&font);
}

HFONT CreateFontIndirectA(const LOGFONTA* description) {
    if (!description) {
        return nullptr;
    }
    LOGFONTA font = *description;
    font.lfFaceName[LF_FACESIZE - 1] = '\0';
    return static_cast<HFONT>(addGdiObject(FontObject{font}));
}

// Any tool

BOOL DeleteObject(HGDIOBJ object) {
    const auto number = reinterpret_cast<std::uintptr_t>(object);
    const auto found = gdiObjects().find(number);
    if (!found) {
        return FALSE;
    }
    // A tool that is selected somewhere lives on there: contexts share it, only its handle ends.
    if (found->owner == GdiOwner::Host) {
        gdiObjects().take(number);
    }
    return TRUE;
}

DWORD GetObjectType(HGDIOBJ object) {
    const auto found = gdiObjects().find(reinterpret_cast<std::uintptr_t>(object));
    return found ? found->type() : 0;
}

namespace {

template <class Record>
int copyRecord(const Record& record, int count, LPVOID buffer) {
    if (!buffer) {
        return sizeof(Record);
    }
    const int copied = std::clamp(count, 0, static_cast<int>(sizeof(Record)));
    std::memcpy(buffer, &record, static_cast<std::size_t>(copied));
    return copied;
}

BITMAP describe(const BitmapObject& bitmap) {
    const int bits = bitmap.format == PixelFormat::Monochrome ? 1 : 32;
    BITMAP record{};
    record.bmWidth = bitmap.size().width();
    record.bmHeight = bitmap.size().height();
    record.bmWidthBytes = (record.bmWidth * bits + 15) / 16 * 2;
    record.bmPlanes = 1;
    record.bmBitsPixel = static_cast<WORD>(bits);
    return record;
}

struct ObjectCopier {
    int count;
    LPVOID buffer;
    int operator()(const BitmapObject& bitmap) const {
        return copyRecord(describe(bitmap), count, buffer);
    }
    int operator()(const RegionObject&) const {
        return 0;
    }
    template <class Object>
    int operator()(const Object& object) const {
        return copyRecord(object.description, count, buffer);
    }
};

} // namespace

int GetObjectA(HGDIOBJ object, int count, LPVOID buffer) {
    const auto found = gdiObjects().find(reinterpret_cast<std::uintptr_t>(object));
    return found ? std::visit(ObjectCopier{count, buffer}, found->value) : 0;
}
