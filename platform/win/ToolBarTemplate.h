#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Module.h"
#include "platform/win/ResourceError.h"

#include <vector>

namespace tvx {

/// A tool bar as its resource describes it. Its pictures stand side by side in the bitmap resource of the same name,
/// one for each button that is no separator.
struct ToolBarTemplate {
    int buttonWidth = 0;        ///< of one picture, in pixels
    int buttonHeight = 0;       ///< of one picture, in pixels
    std::vector<WORD> commands; ///< command of each button; 0 is a separator
};

/// Reads the data of an RT_TOOLBAR resource.
[[nodiscard]] TVX_PLATFORM_API ResourceResult<ToolBarTemplate> parseToolBarTemplate(ResourceBytes data);

} // namespace tvx
