#pragma once

/// @file
/// Looking a file up, for those who want to know what it is as well as where: the look-up has asked the system already.

#include "platform/base/SystemPath.h"
#include "platform/base/Types.h"

#include <sys/stat.h>

namespace tvx {

/// Where a name leads.
struct Location {
    std::string path;
    bool exists = false;
    /// What lstat says of it: a link is a link. Only when it exists.
    struct stat state{};
};

/// As systemPath(), with what the look-up learned.
[[nodiscard]] std::optional<Location> locate(std::string_view name, PathUse use = PathUse::Existing);

/// What a file is like, in bits of CFile::Attribute.
/// @param name  whose last part tells whether the file is hidden
[[nodiscard]] BYTE attributesOf(const struct stat& state, std::string_view name);

} // namespace tvx
