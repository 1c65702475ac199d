#pragma once

/// @file
/// Texts that the user has asked for, as against those that warn.

#include "platform/base/Export.h"

namespace tvx::afx {

/// While one lives, message boxes say what was asked for, such as a summary of the options. Without a display they go
/// to standard output then, without their captions, where scripts and pagers look for it; all others go to standard
/// error.
class TVX_PLATFORM_API AskedFor {
public:
    AskedFor();
    ~AskedFor();
    AskedFor(const AskedFor&) = delete;
    AskedFor& operator=(const AskedFor&) = delete;
    /// Whether one lives.
    [[nodiscard]] static bool isNow();
};

} // namespace tvx::afx
