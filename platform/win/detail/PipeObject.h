#pragma once

#include "platform/win/detail/KernelObject.h"

namespace tvx::win {

/// One end of a pipe.
class PipeObject : public KernelObject {
public:
    using KernelObject::KernelObject;
};

} // namespace tvx::win
