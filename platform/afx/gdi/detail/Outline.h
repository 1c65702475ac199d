#pragma once

#include "platform/afx/gdi/detail/DeviceContext.h"

#include <QPainterPath>
#include <QPainterPathStroker>
#include <QPolygon>

namespace tvx::afx {

/// The rows, in pixels, of a rectangle whose corners are quarters of an ellipse of size `corner`. Both are given in
/// device units.
[[nodiscard]] Spans roundedRows(const Canvas& canvas, const QRect& box, QSize corner);

/// Draws with a context's pen, which is one device unit wide, with or without dashes, or wider with round ends.
///
/// All places are given in device units. Where a unit has several pixels, thin lines along an axis cover just the
/// pixels of their units, so that lines side by side leave no gaps, and others are a unit wide.
class Outline {
public:
    Outline(const DeviceContext& context, Canvas& canvas);

    enum class LastPoint { Left, Drawn };
    /// An open line through points.
    void line(const QPolygon& points, LastPoint last = LastPoint::Left);
    /// A closed line through points.
    void closed(const QPolygon& points);
    enum class Ends { Open, Met };
    /// A line through many points, which are whole numbers where a unit is a pixel.
    void curve(const QPolygonF& points, Ends ends);
    /// Along the inside of a rectangle.
    void rectangle(const QRect& box);
    /// Around a round rectangle or an ellipse.
    void rounded(const QRect& box, QSize corner);

private:
    void thin(const QPolygon& points);
    void thinPixels(const LinePixels& pixels);
    void thinStripes(const LinePixels& pixels);
    void addPixel(QPoint point, int phase);
    void plotPixels();
    void thinRing(const QRect& box, QSize corner);
    void wide(const QPainterPath& path);
    void fillStroke(const QPainterPathStroker& stroker, const QPainterPath& path, const Ink& ink);
    [[nodiscard]] bool isWide() const {
        return m_width > 1;
    }

    const DeviceContext& m_context;
    Canvas& m_canvas;
    std::optional<Ink> m_ink;
    std::optional<Ink> m_gap; ///< between dashes
    UINT m_style;
    int m_width;
    int m_phase = 0; ///< units of the dash pattern used up
    std::vector<QPoint> m_on;
    std::vector<QPoint> m_off;
    std::vector<QPolygonF> m_onStripes; ///< in pixels, where a unit has several
    std::vector<QPolygonF> m_offStripes;
};

} // namespace tvx::afx
