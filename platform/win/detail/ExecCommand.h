#pragma once

#include "platform/base/Export.h"

#include <string>
#include <vector>

namespace tvx::win {

/// What a program is to open.
enum class Opens {
    Pages,       ///< web addresses and addresses of files, with places in them
    Papers,      ///< PDF documents, with places in them
    Texts,       ///< files by their names
    TextsBehind, ///< the same, for a caller that puts the name behind the command without a marker for it
};

/// A desktop entry's call as a command of the settings: "%1" stands for the document.
///
/// The call goes through the helper program where the document must become something else on its way: pages and papers
/// for programs that take only names of files, places in papers, and what cannot be written in a command of the
/// settings (a percent sign).
///
/// @param words   of the entry's "Exec", with field codes
/// @param helper  the helper program's file; empty: there is none, and the plain command is answered
/// @return empty when the call cannot be written as a command
[[nodiscard]] TVX_PLATFORM_API std::string commandFor(const std::vector<std::string>& words, Opens opens,
                                                      const std::string& helper);

/// A word of a command line, in quotes where it needs them to stay one word.
[[nodiscard]] TVX_PLATFORM_API std::string quoted(const std::string& word);

} // namespace tvx::win
