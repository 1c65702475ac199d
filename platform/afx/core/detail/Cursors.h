#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <QCursor>

namespace tvx::afx {

/// The toolkit's cursor for a handle; the arrow for an unknown one.
TVX_PLATFORM_API QCursor cursorOf(HCURSOR cursor);
/// Tells which window the pointer is in, so that SetCursor knows where its cursor is to be shown.
void noteCursorWindow(HWND window);

} // namespace tvx::afx
