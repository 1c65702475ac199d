#pragma once

#include "tools/rc/Script.h"

#include <filesystem>
#include <string>
#include <vector>

namespace rc {

/// What to compile and with which programs.
struct Options {
    std::filesystem::path script;
    std::filesystem::path output;                ///< the `.res` file
    std::filesystem::path dependencies;          ///< a make rule for the output; empty writes none
    std::vector<std::filesystem::path> includes; ///< searched behind the script's own folder
    std::vector<std::string> definitions;        ///< NAME or NAME=VALUE
    std::string preprocessor = "c++";            ///< a C compiler driver with the usual switches
    std::string compiler = "llvm-rc";
};

/// Compiles a script as its author wrote it into standard `.res` data. Throws `Fault` with the author's file and line;
/// the output is written only when all went well.
void compile(const Options& options);

} // namespace rc
