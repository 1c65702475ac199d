#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/afx/gdi/detail/Regions.h"

#include <span>
#include <utility>

using namespace tvx::afx;

// Colours and modes

namespace {

/// Sets one field of a context's state; the result is the value before, `failure` without a context.
template <class Value>
Value exchange(HDC handle, Value DcState::* field, Value value, Value failure = {}) {
    const auto dc = findContext(handle);
    return dc ? std::exchange(dc->state.*field, value) : failure;
}

template <class Value>
Value read(HDC handle, Value DcState::* field, Value failure = {}) {
    const auto dc = findContext(handle);
    return dc ? dc->state.*field : failure;
}

int exchangeMode(HDC handle, int DcState::* field, int value, int least, int most) {
    return value < least || value > most ? 0 : exchange(handle, field, value);
}

CPoint asPoint(QPoint point) {
    return {point.x(), point.y()};
}

CSize asSize(QSize size) {
    return {size.width(), size.height()};
}

} // namespace

COLORREF CDC::SetTextColor(COLORREF color) {
    return exchange(m_hDC, &DcState::textColor, color, CLR_INVALID);
}

COLORREF CDC::GetTextColor() const {
    return read(m_hDC, &DcState::textColor, CLR_INVALID);
}

COLORREF CDC::SetBkColor(COLORREF color) {
    return exchange(m_hDC, &DcState::backColor, color, CLR_INVALID);
}

COLORREF CDC::GetBkColor() const {
    return read(m_hDC, &DcState::backColor, CLR_INVALID);
}

int CDC::SetBkMode(int mode) {
    return exchangeMode(m_hDC, &DcState::backMode, mode, TRANSPARENT, OPAQUE);
}

int CDC::GetBkMode() const {
    return read(m_hDC, &DcState::backMode);
}

int CDC::SetROP2(int mode) {
    return exchangeMode(m_hDC, &DcState::rop2, mode, R2_BLACK, R2_WHITE);
}

int CDC::GetROP2() const {
    return read(m_hDC, &DcState::rop2);
}

int CDC::SetPolyFillMode(int mode) {
    return exchangeMode(m_hDC, &DcState::polyFillMode, mode, ALTERNATE, WINDING);
}

int CDC::GetPolyFillMode() const {
    return read(m_hDC, &DcState::polyFillMode);
}

int CDC::SetStretchBltMode(int mode) {
    return exchangeMode(m_hDC, &DcState::stretchMode, mode, BLACKONWHITE, HALFTONE);
}

int CDC::GetStretchBltMode() const {
    return read(m_hDC, &DcState::stretchMode);
}

int CDC::SetArcDirection(int direction) {
    return exchangeMode(m_hDC, &DcState::arcDirection, direction, AD_COUNTERCLOCKWISE, AD_CLOCKWISE);
}

int CDC::GetArcDirection() const {
    return read(m_hDC, &DcState::arcDirection);
}

UINT CDC::SetTextAlign(UINT flags) {
    return exchange(m_hDC, &DcState::textAlign, flags);
}

UINT CDC::GetTextAlign() const {
    return read(m_hDC, &DcState::textAlign);
}

CPoint CDC::SetBrushOrg(int x, int y) {
    return asPoint(exchange(m_hDC, &DcState::brushOrigin, QPoint(x, y)));
}

CPoint CDC::SetBrushOrg(POINT point) {
    return SetBrushOrg(point.x, point.y);
}

CPoint CDC::GetBrushOrg() const {
    return asPoint(read(m_hDC, &DcState::brushOrigin));
}

CPoint CDC::GetCurrentPosition() const {
    return asPoint(read(m_hDC, &DcState::position));
}

CPoint CDC::MoveTo(int x, int y) {
    return asPoint(exchange(m_hDC, &DcState::position, QPoint(x, y)));
}

CPoint CDC::MoveTo(POINT point) {
    return MoveTo(point.x, point.y);
}

// Mapping

namespace {

Mapping* mappingOf(HDC handle) {
    const auto dc = findContext(handle);
    return dc ? &dc->state.mapping : nullptr;
}

CPoint exchangeOrigin(HDC handle, QPoint Mapping::* field, QPoint value) {
    Mapping* mapping = mappingOf(handle);
    return mapping ? asPoint(std::exchange(mapping->*field, value)) : CPoint();
}

CPoint origin(HDC handle, QPoint Mapping::* field) {
    const Mapping* mapping = mappingOf(handle);
    return mapping ? asPoint(mapping->*field) : CPoint();
}

} // namespace

int CDC::SetMapMode(int mode) {
    Mapping* mapping = mappingOf(m_hDC);
    const int before = mapping ? mapping->mode() : 0;
    return mapping && mapping->setMode(mode) ? before : 0;
}

int CDC::GetMapMode() const {
    const Mapping* mapping = mappingOf(m_hDC);
    return mapping ? mapping->mode() : 0;
}

CPoint CDC::SetViewportOrg(int x, int y) {
    return exchangeOrigin(m_hDC, &Mapping::viewportOrigin, {x, y});
}

CPoint CDC::SetViewportOrg(POINT point) {
    return SetViewportOrg(point.x, point.y);
}

CPoint CDC::GetViewportOrg() const {
    return origin(m_hDC, &Mapping::viewportOrigin);
}

CPoint CDC::OffsetViewportOrg(int x, int y) {
    const CPoint before = GetViewportOrg();
    return SetViewportOrg(before.x + x, before.y + y);
}

CPoint CDC::SetWindowOrg(int x, int y) {
    return exchangeOrigin(m_hDC, &Mapping::windowOrigin, {x, y});
}

CPoint CDC::SetWindowOrg(POINT point) {
    return SetWindowOrg(point.x, point.y);
}

CPoint CDC::GetWindowOrg() const {
    return origin(m_hDC, &Mapping::windowOrigin);
}

CPoint CDC::OffsetWindowOrg(int x, int y) {
    const CPoint before = GetWindowOrg();
    return SetWindowOrg(before.x + x, before.y + y);
}

CSize CDC::SetViewportExt(int cx, int cy) {
    const CSize before = GetViewportExt();
    if (Mapping* mapping = mappingOf(m_hDC)) {
        mapping->setViewportExtent({cx, cy});
    }
    return before;
}

CSize CDC::SetViewportExt(SIZE size) {
    return SetViewportExt(size.cx, size.cy);
}

CSize CDC::GetViewportExt() const {
    const Mapping* mapping = mappingOf(m_hDC);
    return mapping ? asSize(mapping->viewportExtent()) : CSize();
}

CSize CDC::SetWindowExt(int cx, int cy) {
    const CSize before = GetWindowExt();
    if (Mapping* mapping = mappingOf(m_hDC)) {
        mapping->setWindowExtent({cx, cy});
    }
    return before;
}

CSize CDC::SetWindowExt(SIZE size) {
    return SetWindowExt(size.cx, size.cy);
}

CSize CDC::GetWindowExt() const {
    const Mapping* mapping = mappingOf(m_hDC);
    return mapping ? asSize(mapping->windowExtent()) : CSize();
}

namespace {

using Conversion = QPoint (Mapping::*)(QPoint) const;
using SizeConversion = QSize (Mapping::*)(QSize) const;

void convert(HDC handle, Conversion conversion, std::span<POINT> points) {
    const Mapping* mapping = mappingOf(handle);
    if (!mapping) {
        return;
    }
    for (POINT& point : points) {
        point = asPoint((mapping->*conversion)(toQt(point)));
    }
}

void convert(HDC handle, Conversion conversion, RECT* rect) {
    POINT corners[] = {{rect->left, rect->top}, {rect->right, rect->bottom}};
    convert(handle, conversion, corners);
    *rect = {corners[0].x, corners[0].y, corners[1].x, corners[1].y};
}

void convert(HDC handle, SizeConversion conversion, SIZE* size) {
    if (const Mapping* mapping = mappingOf(handle)) {
        *size = asSize((mapping->*conversion)({size->cx, size->cy}));
    }
}

constexpr Conversion toDevice = &Mapping::toDevice;
constexpr Conversion toLogical = &Mapping::toLogical;

std::span<POINT> pointSpan(POINT* points, int count) {
    return points && count > 0 ? std::span(points, static_cast<std::size_t>(count)) : std::span<POINT>();
}

} // namespace

void CDC::LPtoDP(POINT* points, int count) const {
    convert(m_hDC, toDevice, pointSpan(points, count));
}

void CDC::LPtoDP(RECT* rect) const {
    convert(m_hDC, toDevice, rect);
}

void CDC::LPtoDP(SIZE* size) const {
    convert(m_hDC, &Mapping::sizeToDevice, size);
}

void CDC::DPtoLP(POINT* points, int count) const {
    convert(m_hDC, toLogical, pointSpan(points, count));
}

void CDC::DPtoLP(RECT* rect) const {
    convert(m_hDC, toLogical, rect);
}

void CDC::DPtoLP(SIZE* size) const {
    convert(m_hDC, &Mapping::sizeToLogical, size);
}

// Clipping

int CDC::GetClipBox(RECT* rect) const {
    const auto dc = findContext(m_hDC);
    if (!dc || !rect) {
        return RGN_ERROR;
    }
    Drawing drawing(*dc);
    // The screen has no pixels to open, but what fits on it is what can be asked about it.
    const QRegion clip = dc->kind == DcKind::Screen ? QRegion(QRect(QPoint(), dc->target->size())) : drawing.visible;
    *rect = fromQt(clip.boundingRect());
    DPtoLP(rect);
    return regionKind(clip);
}

BOOL CDC::PtVisible(int x, int y) const {
    const auto dc = findContext(m_hDC);
    if (!dc) {
        return FALSE;
    }
    Drawing drawing(*dc);
    return drawing && drawing.visible.contains(dc->state.mapping.toPixel(QPoint(x, y)));
}

BOOL CDC::PtVisible(POINT point) const {
    return PtVisible(point.x, point.y);
}

BOOL CDC::RectVisible(const RECT* rect) const {
    const auto dc = findContext(m_hDC);
    if (!dc || !rect) {
        return FALSE;
    }
    Drawing drawing(*dc);
    return drawing && drawing.visible.intersects(dc->state.mapping.toPixels(*rect));
}

namespace {

/// A region that no target reaches beyond: what clipping starts from.
QRegion everything() {
    constexpr int farAway = 1 << 24;
    return QRect(QPoint(-farAway, -farAway), QPoint(farAway, farAway));
}

int clipBy(HDC handle, const QRegion& region, int mode) {
    const auto dc = findContext(handle);
    if (!dc) {
        return RGN_ERROR;
    }
    auto& clip = dc->state.clip;
    // Kept apart from what can be seen of the target: that may change while the clipping stays.
    clip = mode == RGN_COPY ? region : combined(clip.value_or(everything()), region, mode);
    return regionKind(*clip);
}

int clipByRect(HDC handle, const RECT& logical, int mode) {
    const auto dc = findContext(handle);
    return dc ? clipBy(handle, dc->state.mapping.toPixels(logical), mode) : RGN_ERROR;
}

} // namespace

int CDC::SelectClipRgn(CRgn* region) {
    const auto dc = findContext(m_hDC);
    if (!dc) {
        return RGN_ERROR;
    }
    if (region && region->m_hObject) {
        return SelectClipRgn(region, RGN_COPY);
    }
    dc->state.clip.reset();
    return SIMPLEREGION;
}

int CDC::SelectClipRgn(CRgn* region, int mode) {
    const auto found = findTool<RegionObject>(region ? region->m_hObject : nullptr);
    if (!found) {
        return mode == RGN_COPY && !region ? SelectClipRgn(nullptr) : RGN_ERROR;
    }
    return clipBy(m_hDC, found->region, mode);
}

int CDC::ExcludeClipRect(int left, int top, int right, int bottom) {
    return clipByRect(m_hDC, {left, top, right, bottom}, RGN_DIFF);
}

int CDC::ExcludeClipRect(const RECT* rect) {
    return rect ? clipByRect(m_hDC, *rect, RGN_DIFF) : RGN_ERROR;
}

int CDC::IntersectClipRect(int left, int top, int right, int bottom) {
    return clipByRect(m_hDC, {left, top, right, bottom}, RGN_AND);
}

int CDC::IntersectClipRect(const RECT* rect) {
    return rect ? clipByRect(m_hDC, *rect, RGN_AND) : RGN_ERROR;
}

int CDC::OffsetClipRgn(int x, int y) {
    const auto dc = findContext(m_hDC);
    if (!dc) {
        return RGN_ERROR;
    }
    if (dc->state.clip) {
        dc->state.clip->translate(dc->state.mapping.toPixel(QPoint(x, y)) - dc->state.mapping.toPixel(QPoint(0, 0)));
    }
    return dc->state.clip ? regionKind(*dc->state.clip) : SIMPLEREGION;
}
