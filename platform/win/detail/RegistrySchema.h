#pragma once

#include "platform/win/detail/RegistryConnection.h"

#include <cstdint>

/// What is in a file of settings, and how it is known to be whole.
namespace tvx::registry::schema {

inline constexpr std::int64_t applicationId = 0x54565852; ///< "TVXR", as file(1) sees it
inline constexpr std::int64_t version = 1;

/// Makes the tables in an empty file, within a transaction.
extern const char* const make;

/// Looks at a file of ours: nothing in it is damaged, it has our tables and nothing that could do anything by itself,
/// each key stands below its parent, and names are those that they are found by.
/// @param version  that of the file; of a newer one less is known
/// @return SQLITE_OK, SQLITE_CORRUPT, or why it could not be looked at
[[nodiscard]] int examine(Connection& connection, std::int64_t version);

} // namespace tvx::registry::schema
