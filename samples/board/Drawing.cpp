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

namespace {

/// Takes as many shapes out as `removed` has, and puts others in.
void exchange(std::vector<Shape>& shapes, int from, const std::vector<Shape>& removed, int to,
              const std::vector<Shape>& added) {
    if (from == to && removed.size() == added.size()) { // the others need not move
        std::copy(added.begin(), added.end(), shapes.begin() + from);
        return;
    }
    shapes.erase(shapes.begin() + from, shapes.begin() + from + static_cast<std::ptrdiff_t>(removed.size()));
    shapes.insert(shapes.begin() + to, added.begin(), added.end());
}

} // namespace

Change Change::addition(const Drawing& drawing, Shape shape) {
    const int end = static_cast<int>(drawing.shapes.size());
    return {end, {}, end, {std::move(shape)}, {}};
}

Change Change::replacement(const Drawing& drawing, int number, Shape shape) {
    return {number, {drawing.shapes[number]}, number, {std::move(shape)}, {}};
}

Change Change::deletion(const Drawing& drawing, int number) {
    const Shape& shape = drawing.shapes[number];
    Change change{number, {shape}, number, {}, {}};
    if (number + 1 == static_cast<int>(drawing.shapes.size())) {
        change.linesBehind = shape.linesBefore;
    } else if (!shape.linesBefore.empty()) {
        Shape next = drawing.shapes[number + 1];
        change.removed.push_back(next);
        next.linesBefore.insert(0, shape.linesBefore);
        change.added.push_back(std::move(next));
    }
    return change;
}

Change Change::move(const Drawing& drawing, int from, int to) {
    return {from, {drawing.shapes[from]}, to, {drawing.shapes[from]}, {}};
}

void Change::make(Drawing& drawing) const {
    exchange(drawing.shapes, from, removed, to, added);
    drawing.linesAfter.insert(0, linesBehind);
}

void Change::takeBack(Drawing& drawing) const {
    drawing.linesAfter.erase(0, linesBehind.size());
    exchange(drawing.shapes, to, added, from, removed);
}

void History::clear() {
    *this = {};
}

const Change& History::make(Change change, Drawing& drawing) {
    if (m_saved > m_made) { // no way leads back there
        m_saved.reset();
    }
    m_changes.resize(m_made);
    change.make(drawing);
    m_changes.push_back(std::move(change));
    ++m_made;
    return m_changes.back();
}

const Change& History::undo(Drawing& drawing) {
    const Change& change = m_changes[--m_made];
    change.takeBack(drawing);
    return change;
}

const Change& History::redo(Drawing& drawing) {
    const Change& change = m_changes[m_made++];
    change.make(drawing);
    return change;
}

void History::save() {
    m_saved = m_made;
}

} // namespace board
