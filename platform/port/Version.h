#pragma once

#include "platform/base/Export.h"
#include "platform/port/StringBase.h"

namespace Port {

/// What the installation says about itself:
///
///     const Port::StringBase<char> version = Port::Version::getValue("version");
///
/// The library reads the installation's file (`Gui_InstallInfo`, docs/installation.md). It makes itself the reader when
/// it is loaded; a program without the library gets no values.
class TVX_PLATFORM_API Version {
public:
    /// The value recorded for @p key, such as "version"; empty when there is none. The file is looked at with every
    /// call, so a change shows at once and a missing file gives an error message each time.
    [[nodiscard]] static StringBase<char> getValue(const char* key);

    /// Answers the value of a key, or null. The text need only hold until the next call.
    using Reader = const char* (*)(const char* key);
    /// Installs the one reader of the installation's file; null takes it out.
    static void setReader(Reader reader) noexcept;
};

} // namespace Port
