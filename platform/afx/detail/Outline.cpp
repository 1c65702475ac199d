#include "platform/afx/detail/Outline.h"

#include <QPainterPathStroker>

#include <algorithm>
#include <span>

namespace tvx::afx {

namespace {

/// Pixels on and off in turn of the dashed styles.
std::span<const int> dashPattern(UINT style) {
    static constexpr int dash[] = {18, 6};
    static constexpr int dot[] = {3, 3};
    static constexpr int dashDot[] = {9, 6, 3, 6};
    static constexpr int dashDotDot[] = {9, 3, 3, 3, 3, 3};
    switch (style) {
    case PS_DASH:
        return dash;
    case PS_DOT:
        return dot;
    case PS_DASHDOT:
        return dashDot;
    case PS_DASHDOTDOT:
        return dashDotDot;
    default:
        return {};
    }
}

bool isOn(std::span<const int> pattern, int phase) {
    int length = 0;
    for (const int part : pattern)
        length += part;
    phase %= std::max(1, length);
    for (std::size_t i = 0; i < pattern.size(); ++i) {
        if (phase < pattern[i])
            return i % 2 == 0;
        phase -= pattern[i];
    }
    return true;
}

int deviceWidth(const DeviceContext& context) {
    const int width = context.state.pen->description.lopnWidth.x;
    return std::max(1, context.state.mapping.sizeToDevice({width, 0}).width());
}

} // namespace

Outline::Outline(const DeviceContext& context, Canvas& canvas)
    : context_(context),
      canvas_(canvas),
      ink_(context.penInk()),
      style_(context.state.pen->description.lopnStyle),
      width_(deviceWidth(context)) {
    if (isWide() && style_ != PS_INSIDEFRAME)
        style_ = PS_SOLID;
    if (ink_ && context.state.backMode == OPAQUE)
        gap_ = context.ink(context.state.backColor, ink_->rop);
}

void Outline::dot(QPoint point) {
    const auto& ink = isOn(dashPattern(style_), phase_++) ? ink_ : gap_;
    if (ink)
        canvas_.plot(point, *ink);
}

void Outline::thin(const QPolygon& points) {
    const QRect bounds = canvas_.bounds();
    for (qsizetype i = 0; i + 1 < points.size(); ++i) {
        const LinePixels pixels(points[i], points[i + 1]);
        const LinePixels::Range range = pixels.within(bounds);
        const int before = phase_;
        phase_ += range.first;
        for (int index = range.first; index < range.last; ++index)
            dot(pixels.at(index));
        phase_ = before + pixels.count();
    }
}

void Outline::wide(const QPainterPath& path) {
    QPainterPathStroker stroker;
    stroker.setWidth(width_);
    stroker.setCapStyle(Qt::RoundCap);
    stroker.setJoinStyle(style_ == PS_INSIDEFRAME ? Qt::MiterJoin : Qt::RoundJoin);
    // Points mean centres of pixels.
    const QList<QPolygonF> areas = stroker.createStroke(path.translated(0.5, 0.5)).toSubpathPolygons();
    canvas_.fill(
        polygonSpans({areas.data(), static_cast<std::size_t>(areas.size())}, FillRule::winding, canvas_.bounds()),
        *ink_);
}

void Outline::line(const QPolygon& points, LastPoint last) {
    if (!ink_ || points.isEmpty())
        return;
    if (isWide()) {
        QPainterPath path;
        path.addPolygon(QPolygonF(points));
        wide(path);
        return;
    }
    thin(points);
    if (last == LastPoint::drawn)
        dot(points.last());
}

void Outline::closed(const QPolygon& points) {
    if (!ink_ || points.isEmpty())
        return;
    if (isWide()) {
        QPainterPath path;
        path.addPolygon(QPolygonF(points));
        path.closeSubpath();
        wide(path);
        return;
    }
    thin(points);
    thin(QPolygon({points.last(), points.first()}));
}

void Outline::rectangle(const QRect& box) {
    if (isWide())
        rounded(box, {}, {});
    else if (box.width() == 1 || box.height() == 1)
        line(QPolygon({box.topLeft(), box.bottomRight()}), LastPoint::drawn);
    else
        closed(QPolygon({box.topLeft(), box.topRight(), box.bottomRight(), box.bottomLeft()}));
}

void Outline::rounded(const QRect& box, QSize corner, const Spans& rows) {
    if (!ink_ || box.isEmpty())
        return;
    if (!isWide()) {
        for (const QPoint& point : outlineOf(rows))
            dot(point);
        return;
    }
    QRectF middle = QRectF(box.topLeft(), box.bottomRight());
    if (style_ == PS_INSIDEFRAME) {
        const double half = (width_ - 1) / 2.0;
        middle.adjust(half, half, -half, -half);
    }
    QPainterPath path;
    path.addRoundedRect(middle.normalized(), corner.width() / 2.0, corner.height() / 2.0);
    wide(path);
}

} // namespace tvx::afx
