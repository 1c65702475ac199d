#include "platform/afx/gdi/detail/DeviceContext.h"

#include "platform/afx/toolkit/detail/Gui.h"

#include <QGuiApplication>

#include <algorithm>
#include <array>
#include <cmath>

namespace tvx::afx {

namespace {

constexpr std::uint32_t contextTag = 2;

HandleTable<DeviceContext>& contexts() {
    // Never destroyed, like the tools.
    static auto& table = *new HandleTable<DeviceContext>(contextTag);
    return table;
}

} // namespace

bool MemoryTarget::open(Canvas& canvas, QRegion& visible) {
    canvas.image = &bitmap->image;
    canvas.origin = {};
    canvas.ratio = bitmap->ratio;
    canvas.format = bitmap->format;
    visible = QRect(QPoint(), bitmap->size());
    return true;
}

QSize MemoryTarget::size() const {
    return bitmap->size();
}

double MemoryTarget::ratio() const {
    return bitmap->ratio;
}

PixelFormat MemoryTarget::format() const {
    return bitmap->format;
}

Tool<BitmapObject> MemoryTarget::select(Tool<BitmapObject> next) {
    std::swap(bitmap, next);
    return next;
}

QSize ScreenTarget::size() const {
    return {GetSystemMetrics(SM_CXSCREEN), GetSystemMetrics(SM_CYSCREEN)};
}

double ScreenTarget::ratio() const {
    return ensureGui() ? qGuiApp->devicePixelRatio() : 1;
}

DeviceContext::DeviceContext(DcKind kind, std::unique_ptr<DrawTarget> target) : kind(kind), target(std::move(target)) {
    static const auto pen = stockTool<PenObject>(BLACK_PEN);
    static const auto brush = stockTool<BrushObject>(WHITE_BRUSH);
    static const auto font = stockTool<FontObject>(SYSTEM_FONT);
    state.pen = pen;
    state.brush = brush;
    state.font = font;
}

DeviceContext::~DeviceContext() {
    if (MemoryTarget* own = memory()) {
        own->bitmap->selectedInto = nullptr;
    }
}

MemoryTarget* DeviceContext::memory() const {
    return kind == DcKind::Memory ? static_cast<MemoryTarget*>(target.get()) : nullptr;
}

std::shared_ptr<const RealizedFont> DeviceContext::font() const {
    LOGFONTA device = state.font->description;
    if (state.font.object->owner == GdiOwner::Stock) {
        return realizeFont(device); // of the device, whatever the mapping
    }
    const QSize size = state.mapping.sizeToDevice({std::abs(device.lfWidth), std::abs(device.lfHeight)});
    // A height that a mapping mode makes smaller than a pixel must not become 0, which means the default height.
    if (device.lfHeight != 0) {
        device.lfHeight = device.lfHeight < 0 ? -std::max(1, size.height()) : std::max(1, size.height());
    }
    device.lfWidth = size.width();
    return realizeFont(device);
}

Ink DeviceContext::ink(COLORREF color, Rop2 rop) const {
    return {nearest(pixelOf(color), target->format()), rop, nullptr, {}};
}

std::optional<Ink> DeviceContext::penInk() const {
    const LOGPEN& pen = state.pen->description;
    if (pen.lopnStyle == PS_NULL) {
        return std::nullopt;
    }
    return ink(pen.lopnColor, rop2FromCode(state.rop2));
}

std::optional<Ink> DeviceContext::brushInk(const Canvas& canvas, QImage& pattern) const {
    return brushInk(canvas, *state.brush, rop2FromCode(state.rop2), pattern);
}

namespace {

constexpr int hatchSize = 8;

bool onHatchLine(int hatch, int x, int y) {
    const bool horizontal = y == 3;
    const bool vertical = x == 4;
    const bool falling = x == y;
    const bool rising = x + y == hatchSize - 1;
    switch (hatch) {
    case HS_HORIZONTAL:
        return horizontal;
    case HS_VERTICAL:
        return vertical;
    case HS_FDIAGONAL:
        return falling;
    case HS_BDIAGONAL:
        return rising;
    case HS_CROSS:
        return horizontal || vertical;
    default:
        return falling || rising;
    }
}

QImage hatchImage(int hatch, Pixel line, Pixel between) {
    QImage image(hatchSize, hatchSize, QImage::Format_ARGB32);
    for (int y = 0; y < hatchSize; ++y) {
        for (int x = 0; x < hatchSize; ++x) {
            reinterpret_cast<Pixel*>(image.scanLine(y))[x] = onHatchLine(hatch, x, y) ? line : between;
        }
    }
    return image;
}

QImage recolored(const QImage& image, Pixel black, Pixel white) {
    QImage result = image.copy();
    for (int y = 0; y < result.height(); ++y) {
        auto* row = reinterpret_cast<Pixel*>(result.scanLine(y));
        std::transform(row, row + result.width(), row,
                       [&](Pixel pixel) { return pixel == whitePixel ? white : black; });
    }
    return result;
}

} // namespace

std::optional<Ink> DeviceContext::brushInk(const Canvas& canvas, const BrushObject& brush, Rop2 rop,
                                           QImage& pattern) const {
    const LOGBRUSH& description = brush.description;
    if (description.lbStyle == BS_NULL) {
        return std::nullopt;
    }
    const COLORREF color = brush.systemColor >= 0 ? GetSysColor(brush.systemColor) : description.lbColor;
    Ink result = ink(color, rop);
    if (description.lbStyle == BS_SOLID) {
        return result;
    }
    const Pixel back = ink(state.backColor).color;
    if (description.lbStyle == BS_HATCHED) {
        // A pixel of 0 is not opaque: what was there stays between the lines.
        pattern = hatchImage(static_cast<int>(description.lbHatch), result.color, state.backMode == OPAQUE ? back : 0);
    } else if (brush.patternFormat == PixelFormat::Monochrome) {
        pattern = recolored(brush.pattern, ink(state.textColor).color, back);
    } else {
        pattern = brush.pattern;
    }
    if (const auto times = static_cast<int>(std::lround(canvas.ratio)); times > 1) {
        pattern = pattern.scaled(pattern.size() * times);
    }
    result.pattern = &pattern;
    result.patternOrigin = canvas.pixel(state.brushOrigin);
    return result;
}

HDC addContext(std::shared_ptr<DeviceContext> context) {
    return reinterpret_cast<HDC>(contexts().add(std::move(context)));
}

std::shared_ptr<DeviceContext> findContext(HDC dc) {
    return contexts().find(reinterpret_cast<std::uintptr_t>(dc));
}

bool removeContext(HDC dc) {
    const auto context = contexts().take(reinterpret_cast<std::uintptr_t>(dc));
    if (context) {
        context->target->release();
    }
    return context != nullptr;
}

std::size_t contextCount() {
    return contexts().size();
}

Drawing::Drawing(DeviceContext& context) : m_context(context), m_open(context.target->open(canvas, visible)) {
    if (!m_open) {
        return;
    }
    if (context.state.clip) {
        visible &= *context.state.clip;
    }
    canvas.clip = canvas.pixels(visible) & canvas.image->rect();
}

Drawing::~Drawing() {
    if (m_open) {
        m_context.target->close(canvas.units(canvas.touched()));
    }
}

} // namespace tvx::afx
