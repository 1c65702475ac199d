#pragma once

#include "platform/base/Export.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Port::detail {

/// What a command file holds.
struct CommandWords {
    std::vector<std::string> words;
    /// The lines, from 1, with a quote that is not closed. The word there reaches to the end of its line.
    std::vector<std::size_t> unclosedLines;
};

/// Splits the text of a command file into words. The text holds no zero byte.
[[nodiscard]] TVX_PLATFORM_API CommandWords splitCommandText(std::string_view text);

} // namespace Port::detail
