#pragma once

/// @file
/// The one place where file names take the form that the system knows, and back. Whatever opens, creates, asks about or
/// starts a file sends its name through systemPath() at the last moment; whatever hands a name of the system's to hosts
/// sends it through driveName(). docs/file-names.md has the rules.

#include "platform/base/Export.h"

#include <optional>
#include <string>
#include <string_view>

namespace tvx {

/// A drive and the folder that it stands for.
struct DriveRoot {
    std::string drive;  ///< "D:"
    std::string folder; ///< in the system's form, without a separator at the end except for "/"
};

/// How the mapping asks the drive table, whose owner lives one floor up.
struct RootResolver {
    /// Finds the folder that a drive ("D:", in the spelling of the name) or a share ("\\server\share") stands for, in
    /// the form of DriveRoot::folder; nothing for an unknown root.
    std::optional<std::string> (*folderOf)(std::string_view root);
    /// Finds the drive on which an absolute name of the system's lies; nothing when it lies on none.
    std::optional<DriveRoot> (*driveOf)(std::string_view path);
};

/// Installs the owner of the drive table; null goes back to the one drive "C:", which is "/".
/// @return who was installed before
TVX_PLATFORM_API const RootResolver* setRootResolver(const RootResolver* resolver) noexcept;

/// What a name is wanted for.
enum class PathUse {
    Existing, ///< an existing file: one that differs only in case will do
    Creating, ///< the last part is taken as it is written, so that no file of another spelling is overwritten
};

/// The system's form of a file name.
///
/// Names come as `C:\a\b`, `\a\b`, `a\b`, `\\server\share\a`, or in the system's own form, `/a/b` or `a/b`. A relative
/// name, or one in the system's form, that exists exactly as it is written is itself, backslashes included. Otherwise
/// backslashes separate, a drive or share is looked up, and what is then missing is looked for part by part without
/// regard to case (first in byte order when several match). What cannot be found keeps its spelling.
///
/// `\a` lies on the current drive, `D:a` in the current folder when that lies on D:, else in the drive's root. What the
/// current drive does not have, though the system has it under its root, is that: `/a/b` becomes `\a\b` and later
/// `D:\a\b` in the hands of hosts, and must still be found.
///
/// @return nothing for an empty name, one that holds a zero, or one whose drive or share is unknown
[[nodiscard]] TVX_PLATFORM_API std::optional<std::string> systemPath(std::string_view name,
                                                                     PathUse use = PathUse::Existing);

/// The framework's form of a name of the system's: `/a/b` becomes `C:\a\b`, a relative `a/b` becomes `a\b`. A name that
/// lies on no drive, or that holds a backslash, cannot be written so and stays as it is.
[[nodiscard]] TVX_PLATFORM_API std::string driveName(std::string_view path);

/// A name as messages show it: in the system's form, so that it can be pasted into a file dialog or a shell. A name
/// whose drive or share is unknown stays as it is.
[[nodiscard]] TVX_PLATFORM_API std::string shownName(std::string_view name);

/// The current folder in the framework's form, such as "C:\work", and in the system's where it lies on no drive. Empty
/// when it has been removed.
[[nodiscard]] TVX_PLATFORM_API std::string currentFolderName();

/// Whether a name is that of a named pipe. To open one is to wait for its other end.
[[nodiscard]] TVX_PLATFORM_API bool isNamedPipe(std::string_view name);

/// Whether a name begins with a drive, such as "C:".
[[nodiscard]] TVX_PLATFORM_API bool hasDrive(std::string_view name) noexcept;

/// Length of the drive or share that a name begins with; 0 when there is none.
[[nodiscard]] TVX_PLATFORM_API std::size_t rootLength(std::string_view name) noexcept;

} // namespace tvx
