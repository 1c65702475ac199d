#pragma once

#include "platform/base/Export.h"
#include "platform/win/Locale.h"

namespace Port::detail {

/// What the folder of documents in a locale's language is called. Countries do not count, except where they are written
/// or spoken differently (Chinese; Croatian and Serbian have one number). Unknown ones have the folder of American
/// English.
[[nodiscard]] TVX_PLATFORM_API const char* documentFolder(LCID locale);

} // namespace Port::detail
