#pragma once

#include "platform/base/Export.h"
#include "platform/port/StringBase.h"

#include <vector>

namespace Port {

/// Folders in the order in which they are searched. It is gone through as any container is:
///
///     for (const Port::StringBase<char>& root : Port::TarvexPath::GetInstance())
///         lookIn(root);
class TVX_PLATFORM_API PathList {
public:
    /// Goes through the folders.
    using Iterator = std::vector<StringBase<char>>::const_iterator;

    /// The folders, in their order.
    explicit PathList(std::vector<StringBase<char>> folders);

    /// The first folder.
    Iterator begin() const;
    /// Behind the last one.
    Iterator end() const;

private:
    std::vector<StringBase<char>> m_folders;
};

/// Where the family is installed.
class TVX_PLATFORM_API TarvexPath {
public:
    /// The installation's root folders, as the environment names them at this moment: the user's own (`MYTARVEX`), then
    /// the shared one (`TARVEX`). A variable that is not set or empty contributes nothing. Blanks around a name do not
    /// count; backslashes in it are "/" here, except the two that begin the name of a share.
    [[nodiscard]] static PathList GetInstance();
};

} // namespace Port
