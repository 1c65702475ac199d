#pragma once

#include "platform/base/Export.h"

#include <cstdint>
#include <ctime>

/// The portability library's times: seconds since 1970, UTC, in 64 bits; -1 stands for an unknown time.
class TVX_PLATFORM_API UT_TIME {
public:
    /// The seconds from @p earlier to @p later, negative when they are the other way round.
    [[nodiscard]] static double DiffTime(std::int64_t later, std::int64_t earlier);

    /// The time that a clock on the wall shows, as the user's time zone has it.
    /// @param local only the fields from `tm_sec` to `tm_year` and `tm_isdst` count; they may be out of range, the 32nd
    ///     of January is the 1st of February
    /// @return -1 for a time before 1970 and one that cannot be represented
    [[nodiscard]] static std::int64_t MkTime(const std::tm& local);
};
