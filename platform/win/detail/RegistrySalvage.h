#pragma once

#include "platform/base/Export.h"
#include "platform/win/detail/RegistryPath.h"
#include "platform/win/detail/RegistryValue.h"

#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <utility>

namespace tvx::registry {

/// What can be read of a damaged file.
struct Salvage {
    std::map<std::int64_t, KeyPath> keys;
    std::map<std::pair<std::int64_t, std::string>, Value> values; ///< by key and name without case
};

/// Reads what is whole. Any bytes do: what does not hold together is left out.
/// @param file  the file's bytes
/// @param log   those of the log beside it, empty when there is none
[[nodiscard]] TVX_PLATFORM_API Salvage salvage(std::string_view file, std::string_view log);

} // namespace tvx::registry
