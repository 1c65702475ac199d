#pragma once

#include "platform/afx/gdi/detail/DeviceContext.h"

#include <QPainterPath>
#include <QPolygon>

namespace tvx::afx {

/// Draws with a context's pen, in device units: one pixel wide with or without dashes, or wide with round ends.
class Outline {
public:
    Outline(const DeviceContext& context, Canvas& canvas);

    enum class LastPoint { left, drawn };
    /// An open line through points.
    void line(const QPolygon& points, LastPoint last = LastPoint::left);
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
        return width_ > 1;
    }

    const DeviceContext& context_;
    Canvas& canvas_;
    std::optional<Ink> ink_;
    std::optional<Ink> gap_; ///< between dashes
    UINT style_;
    int width_;
    int phase_ = 0; ///< pixels of the dash pattern used up
    std::vector<QPoint> on_;
    std::vector<QPoint> off_;
};

} // namespace tvx::afx
