#include "Drawing.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace board {

namespace {

/// How far from a line a click may be, in pixels.
constexpr double reach = 5;

double distanceToLine(Point point, Point from, Point to) {
    const double dx = to.x - from.x;
    const double dy = to.y - from.y;
    const double length = dx * dx + dy * dy;
    const double along = length == 0 ? 0 : ((point.x - from.x) * dx + (point.y - from.y) * dy) / length;
    const double part = std::clamp(along, 0.0, 1.0);
    return std::hypot(point.x - (from.x + part * dx), point.y - (from.y + part * dy));
}

bool insideEllipse(Point point, Point from, Point to) {
    const double a = std::max(std::abs(to.x - from.x) / 2.0, reach);
    const double b = std::max(std::abs(to.y - from.y) / 2.0, reach);
    const double x = (point.x - (from.x + to.x) / 2.0) / a;
    const double y = (point.y - (from.y + to.y) / 2.0) / b;
    return x * x + y * y <= 1;
}

int clampMove(int distance, int first, int second) {
    return std::clamp(distance, -maxCoordinate - std::min(first, second), maxCoordinate - std::max(first, second));
}

} // namespace

bool Shape::contains(Point point) const {
    switch (kind) {
    case ShapeKind::Line:
        return distanceToLine(point, from, to) <= reach + width / 2.0;
    case ShapeKind::Ellipse:
        return insideEllipse(point, from, to);
    default:
        return point.x >= std::min(from.x, to.x) && point.x <= std::max(from.x, to.x) &&
               point.y >= std::min(from.y, to.y) && point.y <= std::max(from.y, to.y);
    }
}

void Shape::moveBy(int dx, int dy) {
    dx = clampMove(dx, from.x, to.x);
    dy = clampMove(dy, from.y, to.y);
    from = {from.x + dx, from.y + dy};
    to = {to.x + dx, to.y + dy};
}

int Drawing::shapeAt(Point point) const {
    const auto found =
        std::find_if(shapes.rbegin(), shapes.rend(), [point](const Shape& shape) { return shape.contains(point); });
    return static_cast<int>(shapes.rend() - found) - 1;
}

Point Drawing::extent() const {
    Point corner;
    for (const Shape& shape : shapes) {
        corner.x = std::max({corner.x, shape.from.x, shape.to.x});
        corner.y = std::max({corner.y, shape.from.y, shape.to.y});
    }
    return corner;
}

void History::clear() {
    m_past.clear();
    m_future.clear();
}

void History::remember(Drawing before) {
    m_past.push_back(std::move(before));
    m_future.clear();
}

void History::undo(Drawing& current) {
    if (canUndo()) {
        m_future.push_back(std::exchange(current, std::move(m_past.back())));
        m_past.pop_back();
    }
}

void History::redo(Drawing& current) {
    if (canRedo()) {
        m_past.push_back(std::exchange(current, std::move(m_future.back())));
        m_future.pop_back();
    }
}

} // namespace board
