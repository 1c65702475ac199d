#pragma once

/// @file
/// Libraries of code that are loaded by name: this system's shared objects under the framework's names.

#include "platform/base/Types.h"

#include <optional>
#include <string>
#include <string_view>

namespace tvx::detail {

/// Whether a name without a folder means code: one without an ending, or with one of shared libraries.
[[nodiscard]] bool meansCode(std::string_view name);
/// The system's name of the file that such a name means.
[[nodiscard]] std::optional<std::string> locateCode(std::string_view name);
/// Whether a file begins as code does.
[[nodiscard]] bool isCode(const std::string& path);
/// Loads it, or uses it once more. Null, with the last error, when the system's loader refuses it.
[[nodiscard]] HMODULE loadCode(const std::string& path);

} // namespace tvx::detail
