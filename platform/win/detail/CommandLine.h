#pragma once

/// @file
/// Command lines as programs of the platform write them: one text for the program and all its arguments.

#include "platform/base/Export.h"

#include <string>
#include <string_view>
#include <vector>

namespace tvx::win {

/// A way to read a command line.
struct CommandLine {
    std::string_view program;   ///< the program's name as it is written, without quotes
    std::string_view arguments; ///< what follows it
};

/// The ways to read a command line, to be tried one after the other. There is one for a program's name in quotes and
/// for a plain name. A name with folders may have blanks without being quoted: then the name may end at each of them,
/// or at the end, the shortest name first, as long as the system's names can be. None for a blank line.
[[nodiscard]] TVX_PLATFORM_API std::vector<CommandLine> readings(std::string_view line);

/// Splits arguments into words. Blanks and tabs separate words, except in quotes. Backslashes stand for themselves
/// unless they stand before a quote: there two of them give one, and an odd one makes the quote an ordinary character.
/// Two quotes within quotes give one. A quote that is not closed reaches to the end.
[[nodiscard]] TVX_PLATFORM_API std::vector<std::string> splitArguments(std::string_view arguments);

/// A word in the form in which a program of the system understands it: absolute names with a drive or share become the
/// system's, as do the names in addresses such as `file:///C|\a b\x.htm`, which become well-formed. Words of other
/// forms, and those whose drive or share is unknown, stay as they are.
[[nodiscard]] TVX_PLATFORM_API std::string wordForChild(const std::string& word);

} // namespace tvx::win
