#pragma once

/// @file
/// File addresses ("file:///srv/my%20doc.htm#sec"): how names are written in them.

#include "platform/base/Export.h"

#include <string>
#include <string_view>

namespace tvx {

/// A part of an address with what is coded in it ("%20") as the bytes themselves. A percent sign that begins no code
/// stays as it is.
[[nodiscard]] TVX_PLATFORM_API std::string decodeAddress(std::string_view part);

/// A file name as an address has it: what has a meaning there, blanks and everything outside ASCII is coded.
[[nodiscard]] TVX_PLATFORM_API std::string encodeAddress(std::string_view path);

/// Whether a text is an address of any kind: a scheme and a colon. "C:\a" and "C|\a" are none, they have a drive.
[[nodiscard]] TVX_PLATFORM_API bool isAddress(std::string_view text) noexcept;

/// Whether a text is the address of a file.
[[nodiscard]] TVX_PLATFORM_API bool isFileAddress(std::string_view text) noexcept;

} // namespace tvx
