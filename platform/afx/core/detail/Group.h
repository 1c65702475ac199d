#pragma once

#include "platform/base/Export.h"

#include <vector>

namespace tvx::afx {

class Window;

/// The controls of the group that a control belongs to: from one with WS_GROUP to before the next.
[[nodiscard]] TVX_PLATFORM_API std::vector<Window*> dialogGroup(const Window& control);

} // namespace tvx::afx
