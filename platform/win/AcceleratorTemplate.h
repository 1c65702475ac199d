#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Module.h"
#include "platform/win/ResourceError.h"

#include <vector>

namespace tvx {

/// One entry of an accelerator table.
struct AcceleratorTemplate {
    /// Bits of `flags`, as hosts know them from ACCEL: FVIRTKEY 1, FNOINVERT 2, FSHIFT 4, FCONTROL 8, FALT 16.
    BYTE flags = 0;
    WORD key = 0; ///< a virtual key with FVIRTKEY, else a character
    WORD command = 0;
};

/// Reads the data of an RT_ACCELERATOR resource.
[[nodiscard]] TVX_PLATFORM_API ResourceResult<std::vector<AcceleratorTemplate>>
parseAcceleratorTemplate(ResourceBytes data);

} // namespace tvx
