#pragma once

#include "platform/afx/gdi/detail/DeviceContext.h"

#include <QPainterPath>
#include <QPolygon>

namespace tvx::afx {

/// Draws with a context's pen, in device units: one pixel wide with or without dashes, or wide with round ends.
class Outline {
public:
    Outline(const DeviceContext& context, Canvas& canvas);

    enum class LastPoint { Left, Drawn };
    /// An open line through points.
    void line(const QPolygon& points, LastPoint last = LastPoint::Left);
    /// A closed line through points.
    void closed(const QPolygon& points);
    /// Along the inside of a rectangle.
    void rectangle(const QRect& box);
    /// Around a round rectangle or an ellipse whose rows are `rows`.
    void rounded(const QRect& box, QSize corner, const Spans& rows);

private:
    void thin(const QPolygon& points);
    void addPixel(QPoint point, int phase);
    void plotPixels();
    void wide(const QPainterPath& path);
    [[nodiscard]] bool isWide() const {
        return m_width > 1;
    }

    const DeviceContext& m_context;
    Canvas& m_canvas;
    std::optional<Ink> m_ink;
    std::optional<Ink> m_gap; ///< between dashes
    UINT m_style;
    int m_width;
    int m_phase = 0; ///< pixels of the dash pattern used up
    std::vector<QPoint> m_on;
    std::vector<QPoint> m_off;
};

} // namespace tvx::afx
