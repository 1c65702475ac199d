#pragma once

#include "tools/helpmapcheck/Installation.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace helpmap {

/// Something that whoever wrote a map should look at.
struct Finding {
    std::string file;
    std::size_t line;
    std::string kind; ///< one word
    std::string text;
};

/// Checks a map with what it includes and the documents that it names.
/// @return findings in the order of files and lines; nothing when the map cannot be read
[[nodiscard]] std::optional<std::vector<Finding>> checkMap(const std::string& file, const Installation& installation);

} // namespace helpmap
