#pragma once

/// @file
/// The folders in a folder, in the order in which they are shown.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <string>
#include <string_view>
#include <vector>

namespace tvx {

/// What was found in a folder.
struct FolderNames {
    /// The bytes that they have on the disk, ordered as tvx::text::compareNoCase does, and by their bytes where that
    /// sees no difference. Sorted insertion into trees gives the same order.
    std::vector<std::string> names;
    /// 0, or why the folder could not be read or not to its end: an ERROR_... number.
    DWORD error = 0;
};

/// Those whose names begin with a dot.
enum class HiddenFolders { LeaveOut, Include };

/// Reads the names of the folders in a folder, and of the links that lead to folders, as FindFirstFileA tells them
/// apart. May take as long as its file system likes: see Question. For any thread.
/// @param folder  its name in either form, with a separator at the end or without
[[nodiscard]] TVX_PLATFORM_API FolderNames readFolders(std::string_view folder, HiddenFolders hidden);

} // namespace tvx
