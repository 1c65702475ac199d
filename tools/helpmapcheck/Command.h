#pragma once

#include <iosfwd>
#include <string>
#include <vector>

namespace helpmap {

/// How a run of the tool ended; the program's exit code.
enum class Outcome {
    Clean = 0,
    Findings = 1,
    Failed = 2, ///< the command line is wrong, or a map cannot be read
};

/// Does what a command line (without the program's name) asks for.
[[nodiscard]] Outcome run(const std::vector<std::string>& words, std::ostream& out, std::ostream& errors);

} // namespace helpmap
