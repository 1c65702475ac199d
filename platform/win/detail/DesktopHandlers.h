#pragma once

#include <string>
#include <vector>

namespace tvx::win {

/// The calls of the programs that the desktop opens a type of document with, the user's default first: the words of
/// their desktop entries, with field codes. Programs that need a terminal are left out, and those that are missing.
/// None where the desktop's library is not installed; it is loaded with the first question.
[[nodiscard]] std::vector<std::vector<std::string>> handlersOf(const char* type);

} // namespace tvx::win
