#pragma once

#include <cstdint>

/// Not for hosts: how many whole seconds a splash window stays.
inline constexpr std::int64_t splashTimeOut = 3;

/// Whether a splash window has been there for longer than that.
/// @param shownAt, now  seconds of one clock
constexpr bool IsSplashOver(std::int64_t shownAt, std::int64_t now) {
    return now - shownAt > splashTimeOut;
}
