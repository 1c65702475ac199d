#pragma once

#include "platform/base/Export.h"
#include "platform/port/Stream.h"

namespace Port {

/// The portability library's files: the output streams that every process has.
class TVX_PLATFORM_API File {
public:
    /// The stream onto standard output. It belongs to the library and is usable at any time, before `main` and while
    /// the process ends.
    static Stream& getCout();
    /// The same for standard error.
    static Stream& getCerr();
};

} // namespace Port
