#include "platform/afx/gdi/detail/Outline.h"

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

/// All patterns repeat after this many pixels.
constexpr int kDashPeriod = 24;

bool isOn(std::span<const int> pattern, int phase) {
    if (pattern.empty()) {
        return true;
    }
    std::size_t part = 0;
    for (phase %= kDashPeriod; phase >= pattern[part % pattern.size()]; ++part) {
        phase -= pattern[part % pattern.size()];
    }
    return part % 2 == 0;
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
    if (isWide() && style_ != PS_INSIDEFRAME) {
        style_ = PS_SOLID;
    }
    if (ink_ && context.state.backMode == OPAQUE) {
        gap_ = context.ink(context.state.backColor, ink_->rop);
    }
}

void Outline::addPixel(QPoint point, int phase) {
    (isOn(dashPattern(style_), phase) ? on_ : off_).push_back(point);
}

void Outline::plotPixels() {
    canvas_.plot(on_, *ink_);
    if (gap_) {
        canvas_.plot(off_, *gap_);
    }
    on_.clear();
    off_.clear();
}

void Outline::thin(const QPolygon& points) {
    const QRect bounds = canvas_.bounds();
    for (qsizetype i = 0; i + 1 < points.size(); ++i) {
        const LinePixels pixels(points[i], points[i + 1]);
        pixels.forEach(pixels.within(bounds), [&](int index, QPoint point) { addPixel(point, phase_ + index); });
        phase_ = (phase_ + pixels.count() % kDashPeriod) % kDashPeriod;
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
    if (!ink_ || points.isEmpty()) {
        return;
    }
    if (isWide()) {
        QPainterPath path;
        path.addPolygon(QPolygonF(points));
        wide(path);
        return;
    }
    thin(points);
    if (last == LastPoint::drawn) {
        addPixel(points.last(), phase_);
    }
    plotPixels();
}

void Outline::closed(const QPolygon& points) {
    if (!ink_ || points.isEmpty()) {
        return;
    }
    if (isWide()) {
        QPainterPath path;
        path.addPolygon(QPolygonF(points));
        path.closeSubpath();
        wide(path);
        return;
    }
    thin(points);
    thin(QPolygon({points.last(), points.first()}));
    plotPixels();
}

void Outline::rectangle(const QRect& box) {
    if (isWide()) {
        rounded(box, {}, {});
    } else if (box.width() == 1 || box.height() == 1) {
        line(QPolygon({box.topLeft(), box.bottomRight()}), LastPoint::drawn);
    } else {
        closed(QPolygon({box.topLeft(), box.topRight(), box.bottomRight(), box.bottomLeft()}));
    }
}

void Outline::rounded(const QRect& box, QSize corner, const Spans& rows) {
    if (!ink_ || box.isEmpty()) {
        return;
    }
    if (!isWide()) {
        for (const QPoint& point : outlineOf(rows)) {
            addPixel(point, phase_++);
        }
        plotPixels();
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
