#pragma once

#include "platform/afx/gdi/detail/Mapping.h"
#include "platform/base/Types.h"

#include <QRect>

/// @file
/// Points and rectangles of the framework and of the toolkit.

namespace tvx::afx {

/// Rectangles wider than the numbers of the toolkit end at the last one.
inline QRect toQt(const RECT& rect) {
    return {QPoint(rect.left, rect.top), QSize(distance(rect.left, rect.right), distance(rect.top, rect.bottom))};
}
inline RECT fromQt(const QRect& rect) {
    return {rect.x(), rect.y(), rect.x() + rect.width(), rect.y() + rect.height()};
}
inline QPoint toQt(const POINT& point) {
    return {point.x, point.y};
}
inline POINT fromQt(const QPoint& point) {
    return {point.x(), point.y()};
}

} // namespace tvx::afx
