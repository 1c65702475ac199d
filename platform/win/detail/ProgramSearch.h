#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/detail/CommandLine.h"

#include <string>

namespace tvx::win {

/// A program and how to call it.
struct Program {
    std::string file;           ///< absolute, in the system's form; empty when nothing fits
    std::string name;           ///< what the program is to know itself by
    std::string_view arguments; ///< the rest of the command line
    DWORD error = 0; ///< `ERROR_FILE_NOT_FOUND`, `ERROR_PATH_NOT_FOUND` or `ERROR_ACCESS_DENIED` without file
};

/// Finds the program of a command line. A name with folders is that file, seen from the current folder. Any other is
/// looked for in the application's own folder, then along PATH, and never in the current folder: a file that somebody
/// put beside a drawing must not stand in for a program of the system that is missing. Where "name.exe" is missing,
/// "name" will do.
[[nodiscard]] TVX_PLATFORM_API Program findProgram(std::string_view commandLine);

} // namespace tvx::win
