#pragma once

#include "platform/base/Types.h"

#include <string>

namespace tvx::registry {

struct Value {
    std::string name; ///< as it was first written
    DWORD type = 0;
    std::string data;
};

} // namespace tvx::registry
