#pragma once

#include <string>
#include <string_view>
#include <unordered_set>

namespace helpmap {

/// The places in a page of HTML that an address can name behind "#": the values of "id" and "name" of its elements.
[[nodiscard]] std::unordered_set<std::string> anchorsOf(std::string_view page);

} // namespace helpmap
