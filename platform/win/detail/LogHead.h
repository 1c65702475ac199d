#pragma once

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>
#include <optional>

namespace tvx::registry {

/// What tells whether anybody has written: the head of the database's shared index of its log. The database compares it
/// itself to know whether the pages that it holds are still right.
///
/// The format is SQLite's: sqlite.org/walformat.html, section 2.1 "The WAL-Index Header". A head is 48 bytes in the
/// machine's own order; its first word is the version of the format, followed by a word that is not used and the count
/// of changes, and it ends in its checksum. The file begins with two copies of it.
using LogHead = std::array<std::uint32_t, 12>;

/// The only version of the format that there is, and that the page named above describes.
inline constexpr std::uint32_t logHeadVersion = 3007000;

/// Reads the head.
/// @param index  the first bytes of the shared index, which other processes write meanwhile
/// @return nothing when it cannot be relied on: a format of another version, or a writer at work (the copies differ)
[[nodiscard]] inline std::optional<LogHead> readLogHead(const volatile std::uint32_t* index) {
    LogHead first;
    LogHead second;
    for (std::size_t i = 0; i < first.size(); ++i) {
        first[i] = index[i];
    }
    // A writer changes the second copy first, so a reader who takes them in this order and finds them equal has met
    // no writer between.
    std::atomic_thread_fence(std::memory_order_seq_cst);
    for (std::size_t i = 0; i < second.size(); ++i) {
        second[i] = index[first.size() + i];
    }
    std::atomic_thread_fence(std::memory_order_acquire);
    return first[0] == logHeadVersion && first == second ? std::optional(first) : std::nullopt;
}

} // namespace tvx::registry
