#pragma once

#include "platform/base/Export.h"

#include <string>
#include <string_view>
#include <vector>

namespace Port::detail {

/// Splits @p text at its line feeds and wraps each piece between words to @p width columns (0 or less: no wrapping).
/// The lines carry no line feed; a line feed at the very end begins no further line. The continuation of an indented
/// piece is indented alike, unless the indentation takes more than half of the width.
[[nodiscard]] TVX_PLATFORM_API std::vector<std::wstring> wrapText(std::wstring_view text, int width);

/// The columns that a character takes on a terminal: 2 for East-Asian wide ones, 0 for combining marks and controls.
[[nodiscard]] TVX_PLATFORM_API int columnsOf(wchar_t character);

} // namespace Port::detail
