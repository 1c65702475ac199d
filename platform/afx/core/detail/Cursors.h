#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <QCursor>

namespace tvx::afx {

/// The toolkit's cursor for a handle; the arrow for an unknown one.
TVX_PLATFORM_API QCursor cursorOf(HCURSOR cursor);
/// Tells which window the pointer is in, so that SetCursor knows where its cursor is to be shown.
void noteCursorWindow(HWND window);
/// Shows a cursor over an edge of a window that the mouse can take hold of, until it is elsewhere.
void showEdgeCursor(HWND window, Qt::CursorShape shape);

} // namespace tvx::afx
