#include "platform/afx/gdi/Dc.h"

#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/afx/gdi/detail/HandleMap.h"
#include "platform/afx/gdi/detail/Regions.h"

#include <algorithm>
#include <utility>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CDC, CObject)

namespace {

HandleMap<CDC>& contextMap() {
    static auto& map = *new HandleMap<CDC>;
    return map;
}

void disown(CDC& dc) {
    dc.m_hDC = dc.m_hAttribDC = nullptr;
}

} // namespace

CDC::~CDC() {
    DeleteDC();
}

CDC* CDC::FromHandle(HDC dc) {
    if (!findContext(dc)) {
        return nullptr;
    }
    if (CDC* known = contextMap().find(dc)) {
        return known;
    }
    auto wrapper = std::make_unique<CDC>();
    wrapper->m_hDC = wrapper->m_hAttribDC = dc;
    return contextMap().addTemporary(dc, std::move(wrapper));
}

void CDC::DeleteTempMap() {
    contextMap().deleteTemporaries(disown);
}

BOOL CDC::Attach(HDC dc) {
    if (m_hDC || !findContext(dc)) {
        return FALSE;
    }
    m_hDC = m_hAttribDC = dc;
    contextMap().addPermanent(dc, *this);
    return TRUE;
}

HDC CDC::Detach() {
    if (m_hDC) {
        contextMap().removePermanent(m_hDC, *this);
    }
    m_hAttribDC = nullptr;
    return std::exchange(m_hDC, nullptr);
}

HDC CreateCompatibleDC(HDC dc) {
    if (dc && !findContext(dc)) {
        return nullptr;
    }
    // One pixel is what a memory context has until a bitmap is selected; the bitmap is the context's own.
    static const HGDIOBJ onePixel = [] {
        QImage pixel(1, 1, QImage::Format_RGB32);
        pixel.fill(Qt::black);
        return addGdiObject(BitmapObject{pixel, PixelFormat::Monochrome, nullptr, 1}, GdiOwner::Stock);
    }();
    auto target = std::make_unique<MemoryTarget>();
    target->bitmap = findTool<BitmapObject>(onePixel);
    return addContext(std::make_shared<DeviceContext>(DcKind::Memory, std::move(target)));
}

BOOL DeleteDC(HDC dc) {
    return removeContext(dc);
}

BOOL CDC::CreateCompatibleDC(CDC* dc) {
    return Attach(::CreateCompatibleDC(dc ? dc->m_hDC : nullptr));
}

BOOL CDC::DeleteDC() {
    return m_hDC ? ::DeleteDC(Detach()) : FALSE;
}

int CDC::SaveDC() {
    const auto dc = findContext(m_hDC);
    if (!dc) {
        return 0;
    }
    dc->saved.push_back(dc->state);
    return static_cast<int>(dc->saved.size());
}

BOOL CDC::RestoreDC(int saved) {
    const auto dc = findContext(m_hDC);
    if (!dc) {
        return FALSE;
    }
    const int count = static_cast<int>(dc->saved.size());
    const int index = saved < 0 ? count + saved : saved - 1;
    if (index < 0 || index >= count) {
        return FALSE;
    }
    dc->state = std::move(dc->saved[static_cast<std::size_t>(index)]);
    dc->saved.resize(static_cast<std::size_t>(index));
    return TRUE;
}

// Tools

namespace {

template <class T>
HGDIOBJ selectTool(Tool<T>& place, HGDIOBJ handle) {
    auto tool = findTool<T>(handle);
    if (!tool) {
        return nullptr;
    }
    std::swap(place, tool);
    return tool.handle;
}

HGDIOBJ selectBitmap(DeviceContext& context, HDC dc, HGDIOBJ handle) {
    const auto next = findTool<BitmapObject>(handle);
    MemoryTarget* memory = context.memory();
    if (!memory || !next || (next->selectedInto && next->selectedInto != dc)) {
        return nullptr;
    }
    memory->bitmap->selectedInto = nullptr;
    // The one pixel of fresh contexts may be selected into any number of them.
    if (next.object->owner == GdiOwner::Host) {
        next->selectedInto = dc;
    }
    return memory->select(next).handle;
}

HGDIOBJ selectInto(HDC handle, HGDIOBJ object) {
    const auto dc = findContext(handle);
    if (!dc) {
        return nullptr;
    }
    switch (::GetObjectType(object)) {
    case OBJ_PEN:
        return selectTool(dc->state.pen, object);
    case OBJ_BRUSH:
        return selectTool(dc->state.brush, object);
    case OBJ_FONT:
        return selectTool(dc->state.font, object);
    case OBJ_BITMAP:
        return selectBitmap(*dc, handle, object);
    default:
        return nullptr;
    }
}

/// The object for a tool that was selected before. It may have been deleted while it was selected: the stock object
/// that restores the same state is answered then.
CGdiObject* previousObject(HGDIOBJ handle, int substitute) {
    if (!handle) {
        return nullptr;
    }
    CGdiObject* object = CGdiObject::FromHandle(handle);
    return object ? object : CGdiObject::FromHandle(GetStockObject(substitute));
}

} // namespace

HGDIOBJ SelectObject(HDC dc, HGDIOBJ object) {
    return selectInto(dc, object);
}

CPen* CDC::SelectObject(CPen* pen) {
    return static_cast<CPen*>(previousObject(pen ? selectInto(m_hDC, pen->m_hObject) : nullptr, BLACK_PEN));
}

CBrush* CDC::SelectObject(CBrush* brush) {
    return static_cast<CBrush*>(previousObject(brush ? selectInto(m_hDC, brush->m_hObject) : nullptr, WHITE_BRUSH));
}

CFont* CDC::SelectObject(CFont* font) {
    return static_cast<CFont*>(previousObject(font ? selectInto(m_hDC, font->m_hObject) : nullptr, SYSTEM_FONT));
}

CBitmap* CDC::SelectObject(CBitmap* bitmap) {
    return CBitmap::FromHandle(static_cast<HBITMAP>(bitmap ? selectInto(m_hDC, bitmap->m_hObject) : nullptr));
}

int CDC::SelectObject(CRgn* region) {
    return SelectClipRgn(region);
}

CGdiObject* CDC::SelectStockObject(int index) {
    const HGDIOBJ object = GetStockObject(index);
    const int substitute = ::GetObjectType(object) == OBJ_PEN     ? BLACK_PEN
                           : ::GetObjectType(object) == OBJ_BRUSH ? WHITE_BRUSH
                                                                  : SYSTEM_FONT;
    return previousObject(selectInto(m_hDC, object), substitute);
}

CPen* CDC::GetCurrentPen() const {
    const auto dc = findContext(m_hDC);
    return dc ? CPen::FromHandle(static_cast<HPEN>(dc->state.pen.handle)) : nullptr;
}

CBrush* CDC::GetCurrentBrush() const {
    const auto dc = findContext(m_hDC);
    return dc ? CBrush::FromHandle(static_cast<HBRUSH>(dc->state.brush.handle)) : nullptr;
}

CFont* CDC::GetCurrentFont() const {
    const auto dc = findContext(m_hDC);
    return dc ? CFont::FromHandle(static_cast<HFONT>(dc->state.font.handle)) : nullptr;
}

CBitmap* CDC::GetCurrentBitmap() const {
    const auto dc = findContext(m_hDC);
    const MemoryTarget* memory = dc ? dc->memory() : nullptr;
    return memory ? CBitmap::FromHandle(static_cast<HBITMAP>(memory->bitmap.handle)) : nullptr;
}

// The device

namespace {

int millimetres(int pixels) {
    return scaled(std::int64_t{pixels} * 254, 1, pixelsPerInch * 10);
}

constexpr int rasterCapabilities = 0x2E99; // blits, stretched blits, bitmaps from bits, large bitmaps and fonts

} // namespace

int GetDeviceCaps(HDC handle, int index) {
    const auto dc = findContext(handle);
    if (!dc) {
        return 0;
    }
    switch (index) {
    case TECHNOLOGY:
        return DT_RASDISPLAY;
    case HORZRES:
        return GetSystemMetrics(SM_CXSCREEN);
    case VERTRES:
        return GetSystemMetrics(SM_CYSCREEN);
    case HORZSIZE:
        return millimetres(GetSystemMetrics(SM_CXSCREEN));
    case VERTSIZE:
        return millimetres(GetSystemMetrics(SM_CYSCREEN));
    case LOGPIXELSX:
    case LOGPIXELSY:
        return pixelsPerInch;
    case BITSPIXEL:
        return dc->target->format() == PixelFormat::Monochrome ? 1 : 32;
    case PLANES:
        return 1;
    case NUMCOLORS:
        return dc->target->format() == PixelFormat::Monochrome ? 2 : -1;
    case RASTERCAPS:
        return rasterCapabilities;
    case ASPECTX:
    case ASPECTY:
        // The sides of a square pixel and its diagonal: hosts divide these numbers by each other only.
        return 36;
    case ASPECTXY:
        return 51;
    default:
        return 0;
    }
}

int CDC::GetDeviceCaps(int index) const {
    return ::GetDeviceCaps(m_hDC, index);
}
