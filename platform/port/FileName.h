#pragma once

#include "platform/base/Export.h"
#include "platform/port/StringBase.h"

namespace Port {

/// A file's name, in the form of hosts (`C:\a\b`) or in the system's (`/a/b`).
class TVX_PLATFORM_API FileName {
public:
    /// A name as it is written.
    explicit FileName(const StringBase<char>& name);

    /// The name in a form in which two names of one file are equal: whole, in the system's form and the spelling that
    /// the file has, without "." and "..".
    /// @param followLinks whether a link stands for what it leads to. Without that, two names of one file may differ.
    /// @return the name as it is written when it is empty or its drive is unknown
    [[nodiscard]] StringBase<char> Normalize(bool followLinks) const;

private:
    StringBase<char> m_name;
};

} // namespace Port
