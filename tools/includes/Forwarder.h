#pragma once

/// @file
/// Headers that sources name in another case than the file's, or with backslashes: each gets a file of the name as it
/// is written, which includes the real one.

#include <filesystem>
#include <string>
#include <vector>

namespace includes {

/// What is looked at, where, and what is made.
struct Options {
    std::vector<std::filesystem::path> sources;
    std::vector<std::filesystem::path> folders; ///< of headers, searched behind the including file's own
    std::vector<std::filesystem::path> systems; ///< the compiler's, searched last; their headers are not looked into
    std::filesystem::path output;               ///< holds the made files and nothing else
    std::filesystem::path stamp;                ///< rewritten each time
    std::filesystem::path dependencies;         ///< a make rule of the stamp for every file that was read; may be empty
};

/// The folder below `output` that the compiler is to search. Names may climb out of it by "../", so it lies deep.
[[nodiscard]] std::filesystem::path searchFolder(const std::filesystem::path& output);

/// Looks through the sources and all headers that they reach, and makes `output` hold what they need. Files that are
/// right already stay untouched, others are removed.
/// @return warnings: names that mean different files in different places, "FILE:LINE: warning: ..."
[[nodiscard]] std::vector<std::string> forward(const Options& options);

} // namespace includes
