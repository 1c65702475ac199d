#pragma once

#include "platform/afx/gdi/detail/DeviceContext.h"

#include <QHash>
#include <QObject>
#include <QPointer>
#include <QWidget>

#include <functional>
#include <memory>

class QBackingStore;

namespace tvx::afx {

/// The pixels of one top-level window, for drawing outside the toolkit's paint events: its backing store.
///
/// The toolkit frees and replaces those pixels whenever it likes (a resize, hiding, another buffer), so they are asked
/// for anew in each operation and never kept. Between operations the toolkit may paint the window; there is no session
/// that would have to be closed first. What was drawn is shown (flushed) when a context is released; what was
/// drawn through one that is kept open, when the program looks for its next event.
class TVX_PLATFORM_API WindowSurface : public QObject {
public:
    /// The surface of the window that `widget` is in. It lives as long as that window.
    static WindowSurface& of(const QWidget& widget);

    /// Opens the pixels as an RGB32 image that begins where the window does. Null while the window is hidden or was
    /// never painted: there is nothing to draw on then, and all of it will be painted anyway.
    /// @param wanted the part, in units of the window, that may be read or drawn, for windows whose pixels have to be
    ///               copied
    [[nodiscard]] QImage* open(const QRect& wanted);
    /// Pixels to a unit of the window.
    [[nodiscard]] double ratio() const {
        return m_window.devicePixelRatio();
    }
    /// Who shows what was drawn: `flush`, or the toolkit at the end of its paint event.
    enum class ShownBy { Flush, Toolkit };
    /// Ends what `open` began, with the part that was changed, in units of the window.
    void close(const QRect& touched, ShownBy shownBy);
    /// Shows what was drawn since the last time.
    void flush();

    /// While the toolkit paints the window, its pixels are open already and are shown by the toolkit.
    void beginPaint() {
        ++m_painting;
    }
    void endPaint();

private:
    explicit WindowSurface(QWidget& window);
    void readCopy(const QImage* image, const QRect& wanted);
    void writeCopy(const QRect& touched);
    void showLater(const QRect& part);

    QWidget& m_window;
    QBackingStore* m_store = nullptr; ///< while open
    QImage m_alias;                   ///< the store's pixels while they can be used as they are
    QImage m_copy;                    ///< else what is drawn on instead
    QRect m_unshown;
    int m_painting = 0;
    bool m_began = false;
    bool m_flushIsPosted = false;
};

/// What a window's context covers.
enum class WindowPart {
    Client, ///< child widgets keep their pixels
    Whole   ///< the same, but the menu bar belongs to the frame
};

/// A part of a widget to draw on.
class TVX_PLATFORM_API WindowTarget : public DrawTarget {
public:
    /// @param area the part in the widget's coordinates, asked for in each operation; it may reach beyond the widget
    WindowTarget(QWidget& widget, WindowPart part, std::function<QRect()> area);

    bool open(Canvas& canvas, QRegion& visible) override;
    void close(const QRect& touched) override;
    [[nodiscard]] QSize size() const override;
    [[nodiscard]] double ratio() const override;
    void release() override;

    /// Nothing outside of this, in the widget's coordinates, is drawn.
    std::optional<QRegion> limit;
    WindowSurface::ShownBy shownBy = WindowSurface::ShownBy::Flush;
    /// Whether windows are laid out as they are until the target's end, so that what is visible is found out once.
    bool layoutIsFixed = false;

private:
    QPointer<QWidget> m_widget;
    WindowPart m_part;
    std::function<QRect()> m_area;
    QPoint m_origin;     ///< of the area in the window, while open
    bool m_used = false; ///< A context that only measures has nothing to show.
    std::optional<QRegion> m_drawable;
};

/// What a widget's paint event draws on: the window's pixels, or those of a picture that is being taken of it.
class TVX_PLATFORM_API PaintTarget : public DrawTarget {
public:
    /// @param update what needs painting, in the widget's coordinates
    PaintTarget(QWidget& widget, const QRegion& update, std::function<QRect()> area);
    ~PaintTarget() override;

    bool open(Canvas& canvas, QRegion& visible) override;
    void close(const QRect& touched) override;
    [[nodiscard]] QSize size() const override;
    [[nodiscard]] double ratio() const override;
    void release() override;

private:
    void takePicture();

    QPointer<QWidget> m_widget;
    QRegion m_update;
    std::function<QRect()> m_area;
    WindowTarget m_window;
    QPointer<WindowSurface> m_surface; ///< while the toolkit paints it
    QImage m_picture;                  ///< of the widget, when it is painted on anything else
    double m_pictureRatio = 1;
    QRect m_drawn;
};

/// What can be drawn of a widget, in its coordinates: the visible part without its child widgets.
[[nodiscard]] TVX_PLATFORM_API QRegion drawableRegion(const QWidget& widget, WindowPart part);

} // namespace tvx::afx
