#pragma once

#include "platform/win/detail/ProcessObject.h"

#include <csignal>
#include <sys/wait.h>

/// Whether this process has children, ended ones that were not collected included.
inline bool hasChildren() {
    siginfo_t status;
    return ::waitid(P_ALL, 0, &status, WEXITED | WNOHANG | WNOWAIT) == 0;
}

/// Waits until children that were let go have ended, and for their collection.
inline void awaitReleased() {
    auto& released = tvx::win::ReleasedChildren::instance();
    while (released.count() > 0) {
        tvx::win::waitReadable(released.bell(), 0xFFFFFFFF);
        released.collect();
    }
}
