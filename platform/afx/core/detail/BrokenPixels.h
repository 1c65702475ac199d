#pragma once

#include "platform/base/Export.h"

#include <QRegion>

class QEvent;
class QWidget;

/// @file
/// Displays on which a unit is a broken number of pixels, as 1.5. The toolkit rounds what it repaints and shows to
/// pixels, so that a pixel at the edge of an area may be left as it was: lines stay behind what has moved.

namespace tvx::afx {

/// The area with a unit more around it where a unit of the widget is a broken number of pixels: whatever the rounding
/// leaves out then lies in the unit added.
[[nodiscard]] TVX_PLATFORM_API QRegion withBrokenPixels(const QWidget& widget, const QRegion& units);

/// Has the edges repainted that a widget leaves behind in its parent, or gets, by being moved, resized, shown or
/// hidden.
TVX_PLATFORM_API void repaintBrokenEdges(QWidget& widget, const QEvent& event);

} // namespace tvx::afx
