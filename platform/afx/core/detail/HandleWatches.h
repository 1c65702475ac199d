#pragma once

#include "platform/base/Types.h"

namespace tvx::afx {

/// Ends the requests of a window that ends.
void forgetHandleWatches(HWND window);

/// Lets the event loop collect children that were let go, as soon as they end.
void watchReleasedChildren();

} // namespace tvx::afx
