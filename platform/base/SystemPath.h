#pragma once

/// @file
/// The one place where file names take the form that the system knows. Whatever opens, creates, asks about or starts a
/// file sends its name through systemPath() at the last moment.

#include "platform/base/Export.h"

#include <optional>
#include <string>
#include <string_view>

namespace tvx {

/// Finds the folder that a root stands for.
/// @param root  a drive ("D:", in the spelling of the name) or a share ("\\server\share")
/// @return the folder in the system's form, without a separator at the end except for "/"; nothing for an unknown root
using RootResolver = std::optional<std::string> (*)(std::string_view root);

/// Installs the owner of the drive table; null goes back to the one drive "C:", which is "/".
TVX_PLATFORM_API void setRootResolver(RootResolver resolver) noexcept;

/// What a name is wanted for.
enum class PathUse {
    existing, ///< an existing file: one that differs only in case will do
    creating, ///< the last part is taken as it is written, so that no file of another spelling is overwritten
};

/// The system's form of a file name.
///
/// Names come as `C:\a\b`, `\a\b`, `a\b`, `\\server\share\a`, or in the system's own form, `/a/b` or `a/b`. A name that
/// exists exactly as it is written is itself, backslashes included. Otherwise backslashes separate, a drive or share is
/// looked up, and what is then missing is looked for part by part without regard to case (first in byte order when
/// several match). What cannot be found keeps its spelling.
///
/// @return nothing for an empty name, one that holds a zero, or one whose drive or share is unknown
[[nodiscard]] TVX_PLATFORM_API std::optional<std::string> systemPath(std::string_view name,
                                                                     PathUse use = PathUse::existing);

/// Whether a name begins with a drive, such as "C:".
[[nodiscard]] TVX_PLATFORM_API bool hasDrive(std::string_view name) noexcept;

} // namespace tvx
