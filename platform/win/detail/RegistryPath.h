#pragma once

#include "platform/base/Types.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tvx::registry {

/// The path of a key below its root: parts joined with a backslash, none at the ends; empty for the root itself.
struct KeyPath {
    std::string spelled;
    std::string folded; ///< the same without case: equal for equal keys
};

/// Appends what a caller wrote behind a path. Backslashes too many are passed over.
/// @return the platform's number: a part with more than 255 characters, or more than 512 levels of keys, is
///         `ERROR_INVALID_PARAMETER`
[[nodiscard]] DWORD append(KeyPath& path, std::string_view subKey);

/// A key other than the root as a file has it: its path without case, and its name.
/// @return nothing when it cannot be one: the name is not that of the path, or nobody could have made the key
[[nodiscard]] std::optional<KeyPath> soundKey(std::string_view path, std::string_view name);

/// Whether a value may have this name: up to 16,383 characters.
[[nodiscard]] bool isValueName(std::string_view name);

/// The path of the key above; empty for a key below the root.
[[nodiscard]] std::string_view parentOf(std::string_view path);
/// The last part of a path.
[[nodiscard]] std::string_view lastPart(std::string_view path);
/// The paths from the root's first key down to the path itself.
[[nodiscard]] std::vector<KeyPath> levelsOf(const KeyPath& path);

} // namespace tvx::registry
