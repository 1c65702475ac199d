#pragma once

#include "platform/base/Types.h"

#include <QString>

namespace tvx::afx {

/// A string of the resources (TVX_IDS_... and others), in the user's language where it is translated.
[[nodiscard]] QString ownText(UINT id);

} // namespace tvx::afx
