#pragma once

#include <string>
#include <vector>

namespace tvx::registry {

/// Tells the user by the installed function. Not to be called while a store is locked.
void deliver(const std::vector<std::string>& notices);

} // namespace tvx::registry
