#pragma once

#include <string>
#include <vector>

namespace rc {

/// What a finished child process left.
struct ChildResult {
    int exitCode = 0;   ///< that of the program; 127 when it could not be started
    std::string output; ///< standard output
    std::string errors; ///< standard error
};

/// Runs a program, found through PATH, with these arguments and waits for it.
/// @param arguments the program's name first
/// @param input     given to its standard input
[[nodiscard]] ChildResult run(const std::vector<std::string>& arguments, const std::string& input = {});

} // namespace rc
