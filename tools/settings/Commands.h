#pragma once

#include <iosfwd>
#include <string>
#include <vector>

namespace settings {

/// How a run of the tool ended; the program's exit code.
enum class Outcome {
    Done = 0,
    Missing = 1, ///< there is no such key or value
    Misused = 2, ///< the command line is wrong
    Failed = 3,  ///< the settings could not be read or written
    BadFile = 4, ///< the file cannot be read or written, or holds no exchange text; nothing was changed
};

/// Does what a command line (without the program's name) asks for.
[[nodiscard]] Outcome run(const std::vector<std::string>& words, std::istream& in, std::ostream& out,
                          std::ostream& errors);

} // namespace settings
