#pragma once

#include <string>

namespace opening {

/// Makes a page that leads on to an address, for programs that take names of files only. It lies in a folder that only
/// the user can look into; pages of the day before are removed.
/// @return the page's file
/// @throw Failure when it cannot be made
[[nodiscard]] std::string makeForwardPage(const std::string& address);

} // namespace opening
