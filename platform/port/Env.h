#pragma once

#include "platform/base/Export.h"

#include <string>
#include <vector>

/// The process's environment and the roots of the family's installation.
class TVX_PLATFORM_API Port_Env {
public:
    /// The value of the environment variable @p name, or null when it is not set (or @p name is null). The text belongs
    /// to the environment and holds until the variable is changed.
    static const char* GetEnv(const char* name);

    /// The installation's root directories in the order in which they are searched: the user's own (`MYTARVEX`), then
    /// the shared one (`TARVEX`). A variable that is not set or empty contributes nothing.
    static std::vector<std::string> GetRoots();
};
