#pragma once

#include "platform/afx/gdi/detail/Fonts.h"
#include "platform/afx/gdi/detail/GdiObjects.h"
#include "platform/afx/gdi/detail/Geometry.h"
#include "platform/afx/gdi/detail/Mapping.h"

#include <memory>
#include <optional>
#include <vector>

namespace tvx::afx {

/// What a context draws on: a bitmap, a part of a window, or nothing.
class TVX_PLATFORM_API DrawTarget {
public:
    virtual ~DrawTarget() = default;
    /// Opens the pixels for one operation. False when nothing of them can be seen; `canvas` is then empty. What can be
    /// seen is left in `visible`, in units of the context; the canvas's own clipping area follows from it.
    [[nodiscard]] virtual bool open(Canvas& canvas, QRegion& visible) = 0;
    /// Ends the operation; `touched` is what has been changed, in units of the context.
    virtual void close(const QRect& touched) = 0;
    /// Size of the whole target in units.
    [[nodiscard]] virtual QSize size() const = 0;
    /// Pixels to a unit, which compatible bitmaps have too.
    [[nodiscard]] virtual double ratio() const {
        return 1;
    }
    /// Colour format of bitmaps that are compatible with the target.
    [[nodiscard]] virtual PixelFormat format() const {
        return PixelFormat::Color;
    }
    /// Shows what was drawn; called when the context is released.
    virtual void release() {}
};

/// A memory context's bitmap.
class MemoryTarget : public DrawTarget {
public:
    bool open(Canvas& canvas, QRegion& visible) override;
    void close(const QRect&) override {}
    [[nodiscard]] QSize size() const override;
    [[nodiscard]] double ratio() const override;
    [[nodiscard]] PixelFormat format() const override;
    /// Exchanges the bitmap that is drawn on; the result is the one before.
    Tool<BitmapObject> select(Tool<BitmapObject> bitmap);

    Tool<BitmapObject> bitmap;
};

/// The screen: it can be measured, but not drawn to.
class ScreenTarget : public DrawTarget {
public:
    bool open(Canvas&, QRegion&) override {
        return false;
    }
    void close(const QRect&) override {}
    [[nodiscard]] QSize size() const override;
    [[nodiscard]] double ratio() const override;
};

enum class DcKind { Memory, Window, Paint, Screen };

/// What `SaveDC` remembers.
struct DcState {
    Tool<PenObject> pen;
    Tool<BrushObject> brush;
    Tool<FontObject> font;
    COLORREF textColor = 0;
    COLORREF backColor = RGB(255, 255, 255);
    int backMode = OPAQUE;
    int rop2 = R2_COPYPEN;
    int polyFillMode = ALTERNATE;
    int stretchMode = BLACKONWHITE;
    int arcDirection = AD_COUNTERCLOCKWISE;
    UINT textAlign = TA_LEFT | TA_TOP;
    QPoint brushOrigin;
    QPoint position; ///< logical
    Mapping mapping;
    std::optional<QRegion> clip; ///< device units
};

/// The object behind a HDC.
class TVX_PLATFORM_API DeviceContext {
public:
    DeviceContext(DcKind kind, std::unique_ptr<DrawTarget> target);
    ~DeviceContext();
    DeviceContext(const DeviceContext&) = delete;
    DeviceContext& operator=(const DeviceContext&) = delete;

    const DcKind kind;
    DcState state;
    std::vector<DcState> saved;
    std::unique_ptr<DrawTarget> target;
    /// The window of a window's context.
    HWND window = nullptr;

    /// The target of a memory context, else null.
    [[nodiscard]] MemoryTarget* memory() const;
    /// The font at the size it has on the device.
    [[nodiscard]] std::shared_ptr<const RealizedFont> font() const;
    /// Pen and brush as ink; `patterns` holds the pixels of a hatch or picture as long as the ink is used.
    /// Empty for a null pen or brush.
    [[nodiscard]] std::optional<Ink> penInk() const;
    [[nodiscard]] std::optional<Ink> brushInk(const Canvas& canvas, QImage& pattern) const;
    [[nodiscard]] std::optional<Ink> brushInk(const Canvas& canvas, const BrushObject& brush, Rop2 rop,
                                              QImage& pattern) const;
    /// `color` as the target can show it.
    [[nodiscard]] Ink ink(COLORREF color, Rop2 rop = Rop2::Copy) const;
};

[[nodiscard]] TVX_PLATFORM_API HDC addContext(std::shared_ptr<DeviceContext> context);
[[nodiscard]] TVX_PLATFORM_API std::shared_ptr<DeviceContext> findContext(HDC dc);
/// Ends a context and shows what was drawn. False for a handle that is none.
TVX_PLATFORM_API bool removeContext(HDC dc);
/// Number of contexts in use: leaks of window contexts show here.
[[nodiscard]] TVX_PLATFORM_API std::size_t contextCount();

/// One drawing operation: opens the target's pixels and closes them at the end of the scope.
class TVX_PLATFORM_API Drawing {
public:
    explicit Drawing(DeviceContext& context);
    ~Drawing();
    Drawing(const Drawing&) = delete;
    Drawing& operator=(const Drawing&) = delete;

    /// False when no pixel can be seen: there is nothing to do then.
    explicit operator bool() const {
        return m_open;
    }
    Canvas canvas;
    /// What can be seen and is not clipped away, in units of the context.
    QRegion visible;

    /// The pixels of a rectangle in logical units.
    [[nodiscard]] QRect pixels(const RECT& logical) const {
        return canvas.pixels(m_context.state.mapping.toPixels(logical));
    }

private:
    DeviceContext& m_context;
    bool m_open;
};

} // namespace tvx::afx
