#pragma once

#include "platform/base/Export.h"

#include <string>
#include <vector>

namespace tvx {

/// The installation's root directories in the order in which they are searched: the user's own (`MYTARVEX`), then the
/// shared one (`TARVEX`). A variable that is not set or empty contributes nothing.
[[nodiscard]] TVX_PLATFORM_API std::vector<std::string> installationRoots();

} // namespace tvx
