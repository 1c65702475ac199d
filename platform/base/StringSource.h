#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <string>

namespace tvx {

/// Finds a string of a module's string table. Resources live one floor up, so their owner installs this function and
/// CString::LoadString calls it.
/// @param module  where to look; null means the application and the chain of extension modules
/// @param id      the string's number
/// @param text    receives the string; left alone when there is none
/// @return whether the string exists
using StringLoader = bool (*)(HINSTANCE module, UINT id, std::string& text);

/// Installs the function that CString::LoadString uses; null takes it away. Called once, while the layer is loaded.
TVX_PLATFORM_API void setStringLoader(StringLoader loader) noexcept;
/// Loads a string through the installed function. Without one there are no strings: false, `text` stays.
[[nodiscard]] TVX_PLATFORM_API bool loadString(HINSTANCE module, UINT id, std::string& text);

} // namespace tvx
