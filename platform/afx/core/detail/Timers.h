#pragma once

#include "platform/afx/core/Message.h"

namespace tvx::afx {

/// Calls the function of a timer message that carries one.
LRESULT callTimer(const MSG& msg);
/// Stops the timers of a window that ends.
void forgetTimers(HWND window);

} // namespace tvx::afx
