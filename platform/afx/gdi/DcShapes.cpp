#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/afx/gdi/detail/Outline.h"
#include "platform/afx/gdi/detail/Regions.h"

#include <QPainterPath>

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>
#include <vector>

using namespace tvx::afx;

namespace {

/// The context and its opened pixels for one shape; false when nothing is to be drawn.
class Shape {
public:
    explicit Shape(HDC handle) : dc(findContext(handle)) {
        if (dc) {
            m_drawing.emplace(*dc);
        }
    }
    /// What a drawing call answers: whether the context was valid.
    [[nodiscard]] BOOL valid() const {
        return dc != nullptr;
    }
    [[nodiscard]] bool visible() const {
        return m_drawing && *m_drawing;
    }
    [[nodiscard]] Canvas& canvas() {
        return m_drawing->canvas;
    }
    [[nodiscard]] const Mapping& mapping() const {
        return dc->state.mapping;
    }
    /// Fills with the brush. @param area spans or a rectangle, in pixels
    template <class Area>
    void fill(const Area& area) {
        QImage pattern;
        if (const auto ink = dc->brushInk(canvas(), pattern)) {
            canvas().fill(area, *ink);
        }
    }

    std::shared_ptr<DeviceContext> dc;

private:
    std::optional<Drawing> m_drawing;
};

QPolygonF placed(const Canvas& canvas, const QPolygonF& corners) {
    QPolygonF result;
    result.reserve(corners.size());
    for (const QPointF& corner : corners) {
        result << canvas.place(corner);
    }
    return result;
}

/// A polygon over pixels is filled as the area between the pixels' centres; its outline covers the rest.
Spans areaOf(const Canvas& canvas, const QPolygonF& corners, FillRule rule) {
    const std::array polygons = {placed(canvas, corners)};
    return polygonSpans(polygons, rule, canvas.bounds());
}

QPolygon devicePoints(const Mapping& mapping, const POINT* points, int count) {
    QPolygon result;
    result.reserve(count);
    for (int i = 0; i < count; ++i) {
        result << mapping.toPixel(toQt(points[i]));
    }
    return result;
}

} // namespace

// Lines

BOOL CDC::LineTo(int x, int y) {
    const CPoint from = GetCurrentPosition();
    const POINT points[] = {from, {x, y}};
    if (!Polyline(points, 2)) {
        return FALSE;
    }
    MoveTo(x, y);
    return TRUE;
}

BOOL CDC::LineTo(POINT point) {
    return LineTo(point.x, point.y);
}

BOOL CDC::Polyline(const POINT* points, int count) {
    if (!points || count < 2) {
        return FALSE;
    }
    Shape shape(m_hDC);
    if (shape.visible()) {
        Outline(*shape.dc, shape.canvas()).line(devicePoints(shape.mapping(), points, count));
    }
    return shape.valid();
}

BOOL CDC::PolylineTo(const POINT* points, int count) {
    if (!points || count < 1) {
        return FALSE;
    }
    std::vector<POINT> all = {GetCurrentPosition()};
    all.insert(all.end(), points, points + count);
    if (!Polyline(all.data(), count + 1)) {
        return FALSE;
    }
    MoveTo(points[count - 1]);
    return TRUE;
}

// Rectangles and ellipses

namespace {

/// The box in which outline and filling of a rectangular shape go, in device units. Without an outline the right and
/// bottom units stay free, as with it they belong to the outline.
QRect shapeBox(const Shape& shape, const RECT& rect) {
    const QRect box = shape.mapping().toPixels(rect);
    return shape.dc->penInk() ? box : box.adjusted(0, 0, -1, -1);
}

/// Shapes larger than this are drawn as polygons: going through all of their rows and pixels, of which few can be seen,
/// would take too long.
constexpr int largestByPixels = 1 << 14;

bool isLarge(const QRect& box) {
    return std::max(box.width(), box.height()) > largestByPixels;
}

QPolygon roundedPolygon(const QRect& box, QSize corner) {
    QPainterPath path;
    path.addRoundedRect(QRectF(box.topLeft(), box.bottomRight()), corner.width() / 2.0, corner.height() / 2.0);
    QPolygon polygon = path.toFillPolygon().toPolygon();
    polygon.removeLast(); // the first one again
    return polygon;
}

void drawRounded(Shape& shape, const QRect& box, QSize corner) {
    shape.fill(roundedRows(shape.canvas(), box, corner));
    Outline(*shape.dc, shape.canvas()).rounded(box, corner);
}

void drawLargeRounded(Shape& shape, const QRect& box, QSize corner) {
    const QPolygon polygon = roundedPolygon(box, corner);
    shape.fill(areaOf(shape.canvas(), QPolygonF(polygon), FillRule::Winding));
    Outline(*shape.dc, shape.canvas()).closed(polygon);
}

void drawRectangle(Shape& shape, const QRect& box) {
    shape.fill(shape.canvas().pixels(box));
    Outline(*shape.dc, shape.canvas()).rectangle(box);
}

BOOL drawRounded(HDC handle, const RECT& rect, QSize corner) {
    Shape shape(handle);
    if (!shape.visible()) {
        return shape.valid();
    }
    const QRect box = shapeBox(shape, rect);
    if (box.isEmpty()) {
        return TRUE;
    }
    if (corner.isEmpty()) {
        drawRectangle(shape, box);
    } else if (isLarge(box)) {
        drawLargeRounded(shape, box, corner);
    } else {
        drawRounded(shape, box, corner);
    }
    return TRUE;
}

} // namespace

BOOL CDC::Rectangle(int left, int top, int right, int bottom) {
    return drawRounded(m_hDC, {left, top, right, bottom}, {});
}

BOOL CDC::Rectangle(const RECT* rect) {
    return rect ? drawRounded(m_hDC, *rect, {}) : FALSE;
}

BOOL CDC::RoundRect(int left, int top, int right, int bottom, int cornerWidth, int cornerHeight) {
    const auto dc = findContext(m_hDC);
    return dc &&
           drawRounded(m_hDC, {left, top, right, bottom}, dc->state.mapping.sizeToDevice({cornerWidth, cornerHeight}));
}

BOOL CDC::RoundRect(const RECT* rect, POINT corner) {
    return rect ? RoundRect(rect->left, rect->top, rect->right, rect->bottom, corner.x, corner.y) : FALSE;
}

BOOL CDC::Ellipse(int left, int top, int right, int bottom) {
    const auto dc = findContext(m_hDC);
    const RECT rect = {left, top, right, bottom};
    return dc && drawRounded(m_hDC, rect, dc->state.mapping.toPixels(rect).size());
}

BOOL CDC::Ellipse(const RECT* rect) {
    return rect ? Ellipse(rect->left, rect->top, rect->right, rect->bottom) : FALSE;
}

// Parts of ellipses

namespace {

enum class ArcShape { Arc, Pie, Chord };

/// A stretch of an ellipse's outline, found by the directions from its centre to two points.
class ArcPixels {
public:
    ArcPixels(const QRect& box, QPoint start, QPoint end, int direction)
        : m_box(box),
          m_counterClockwise(direction == AD_COUNTERCLOCKWISE),
          m_start(angle(start)),
          m_sweep(turn(m_start, angle(end))) {
        if (m_sweep == 0) {
            m_sweep = 2 * std::numbers::pi;
        }
    }

    /// The pixels in drawing order, from start to end.
    [[nodiscard]] QPolygon pixels() const {
        if (isLarge(m_box)) {
            return corners().toPolygon();
        }
        std::vector<QPoint> all = outlineOf(ellipseSpans(m_box));
        std::erase_if(all, [&](QPoint point) { return turn(m_start, angle(point)) > m_sweep; });
        std::ranges::sort(all, {}, [&](QPoint point) { return turn(m_start, angle(point)); });
        return QPolygon(QList<QPoint>(all.begin(), all.end()));
    }
    /// Corners of a polygon that stands for the line between the ellipse's outermost pixels' middles.
    [[nodiscard]] QPolygonF corners() const {
        constexpr int mostCorners = 4096;
        const int count = std::min(mostCorners, 64 + m_box.width() + m_box.height());
        QPolygonF result;
        for (int i = 0; i <= count; ++i) {
            const double direction = m_start + (m_counterClockwise ? -1 : 1) * m_sweep * i / count;
            result << QPointF(m_box.left() + (m_box.width() - 1) * (1 + std::cos(direction)) / 2,
                              m_box.top() + (m_box.height() - 1) * (1 + std::sin(direction)) / 2);
        }
        return result;
    }
    [[nodiscard]] QPoint centre() const {
        return m_box.center();
    }

private:
    /// Direction of a point in a picture where the ellipse is a circle: 0 right, growing clockwise.
    [[nodiscard]] double angle(QPoint point) const {
        const double x = 2.0 * (point.x() - m_box.left()) + 1 - m_box.width();
        const double y = 2.0 * (point.y() - m_box.top()) + 1 - m_box.height();
        return std::atan2(y / m_box.height(), x / m_box.width());
    }
    /// How far it is from one direction to another, in the direction of drawing: 0 .. 2 pi.
    [[nodiscard]] double turn(double from, double to) const {
        const double turned = m_counterClockwise ? from - to : to - from;
        return turned < 0 ? turned + 2 * std::numbers::pi : turned;
    }

    QRect m_box;
    bool m_counterClockwise;
    double m_start;
    double m_sweep;
};

BOOL drawArc(HDC handle, const RECT& rect, const std::array<POINT, 2>& rays, ArcShape kind) {
    Shape shape(handle);
    if (!shape.visible()) {
        return shape.valid();
    }
    const QRect box = shape.mapping().toPixels(rect);
    if (box.isEmpty()) {
        return TRUE;
    }
    const ArcPixels arc(box, shape.mapping().toPixel(toQt(rays[0])), shape.mapping().toPixel(toQt(rays[1])),
                        shape.dc->state.arcDirection);
    const Canvas& canvas = shape.canvas();
    // Where a unit has several pixels, those of the units' outline would show as steps.
    QPolygonF outline = canvas.isPlain() ? QPolygonF(arc.pixels()) : arc.corners();
    if (kind == ArcShape::Pie) {
        outline << arc.centre();
    }
    if (kind != ArcShape::Arc) {
        shape.fill(areaOf(canvas, outline, FillRule::Winding));
    }
    Outline(*shape.dc, shape.canvas()).curve(outline, kind == ArcShape::Arc ? Outline::Ends::Open : Outline::Ends::Met);
    return TRUE;
}

} // namespace

BOOL CDC::Arc(int left, int top, int right, int bottom, int startX, int startY, int endX, int endY) {
    return drawArc(m_hDC, {left, top, right, bottom}, {POINT{startX, startY}, POINT{endX, endY}}, ArcShape::Arc);
}

BOOL CDC::Arc(const RECT* rect, POINT start, POINT end) {
    return rect ? drawArc(m_hDC, *rect, {start, end}, ArcShape::Arc) : FALSE;
}

BOOL CDC::Pie(int left, int top, int right, int bottom, int startX, int startY, int endX, int endY) {
    return drawArc(m_hDC, {left, top, right, bottom}, {POINT{startX, startY}, POINT{endX, endY}}, ArcShape::Pie);
}

BOOL CDC::Pie(const RECT* rect, POINT start, POINT end) {
    return rect ? drawArc(m_hDC, *rect, {start, end}, ArcShape::Pie) : FALSE;
}

BOOL CDC::Chord(int left, int top, int right, int bottom, int startX, int startY, int endX, int endY) {
    return drawArc(m_hDC, {left, top, right, bottom}, {POINT{startX, startY}, POINT{endX, endY}}, ArcShape::Chord);
}

BOOL CDC::Chord(const RECT* rect, POINT start, POINT end) {
    return rect ? drawArc(m_hDC, *rect, {start, end}, ArcShape::Chord) : FALSE;
}

// Polygons

BOOL CDC::Polygon(const POINT* points, int count) {
    return PolyPolygon(points, &count, 1);
}

BOOL CDC::PolyPolygon(const POINT* points, const int* counts, int count) {
    if (!points || !counts || count < 1 ||
        std::any_of(counts, counts + count, [](int corners) { return corners < 2; })) {
        return FALSE;
    }
    Shape shape(m_hDC);
    if (!shape.visible()) {
        return shape.valid();
    }
    std::vector<QPolygonF> areas;
    std::vector<QPolygon> outlines;
    for (int i = 0; i < count; points += counts[i++]) {
        outlines.push_back(devicePoints(shape.mapping(), points, counts[i]));
        areas.push_back(placed(shape.canvas(), QPolygonF(outlines.back())));
    }
    const FillRule rule = shape.dc->state.polyFillMode == WINDING ? FillRule::Winding : FillRule::Alternate;
    shape.fill(polygonSpans(areas, rule, shape.canvas().bounds()));
    Outline pen(*shape.dc, shape.canvas());
    for (const QPolygon& outline : outlines) {
        pen.closed(outline);
    }
    return TRUE;
}
