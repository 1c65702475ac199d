#pragma once

#include "platform/base/Types.h"

#include <cstdint>
#include <optional>
#include <string>
#include <sys/types.h>

namespace tvx::registry {

/// The two files of settings.
enum class Hive { User, Machine };

/// Where the file of a hive is expected. Empty when there is no such place: the machine has no settings, or the user no
/// home.
[[nodiscard]] std::string locate(Hive hive);
/// The file that a name leads to, links followed to their end whether or not something is there.
[[nodiscard]] std::string resolve(const std::string& name);

/// What stands under a name.
enum class FileKind { Missing, Regular, Other, Unreachable };
[[nodiscard]] FileKind kindOf(const std::string& file);

/// Which file a name led to at some moment: another one has taken its place when this differs.
struct FileIdentity {
    dev_t device = 0;
    ino_t number = 0;

    bool operator==(const FileIdentity&) const = default;
};
/// The file under a name, all zero when there is none.
[[nodiscard]] FileIdentity identityOf(const std::string& file);

/// Identity, size and time of a file that nobody can be asked about.
struct FileStamp {
    FileIdentity identity;
    off_t size = 0;
    std::int64_t changed = 0; ///< nanoseconds

    bool operator==(const FileStamp&) const = default;
};
[[nodiscard]] FileStamp stampOf(const std::string& file);

/// Whether shared memory between processes works on the file system of a file: not for files on other machines.
[[nodiscard]] bool allowsSharedMemory(const std::string& file);

/// Makes the folders above a file that are missing, private to the user.
/// @return the platform's number
[[nodiscard]] DWORD makeFolderOf(const std::string& file);
/// Makes an empty file that is private to the user. One that exists is left as it is.
/// @return the platform's number
[[nodiscard]] DWORD makeFile(const std::string& file);

/// Held by the process that creates a file or sets one aside; the others wait. Let go by the system when the process
/// ends.
class FolderLock {
public:
    /// Waits for at most five seconds.
    explicit FolderLock(const std::string& file);
    ~FolderLock();
    FolderLock(const FolderLock&) = delete;
    FolderLock& operator=(const FolderLock&) = delete;

    [[nodiscard]] bool isHeld() const {
        return m_isHeld;
    }

private:
    int m_folder;
    bool m_isHeld = false;
};

/// Gives a damaged file, with what the database keeps beside it, a new name in the same folder: "registry.db" becomes
/// "registry-damaged-20260131-235959.db". To be called under the folder's lock.
/// @return the new name; nothing when that was not possible
[[nodiscard]] std::optional<std::string> setAside(const std::string& file);

/// A copy of a file and its log in a folder of its own in memory or among the temporary files, for reading what is in a
/// place where nothing can be written. Deleted with this object.
class FileCopy {
public:
    explicit FileCopy(const std::string& file);
    ~FileCopy();
    FileCopy(const FileCopy&) = delete;
    FileCopy& operator=(const FileCopy&) = delete;

    /// The copy's name, empty when there is none.
    [[nodiscard]] const std::string& name() const {
        return m_name;
    }

private:
    std::string m_folder;
    std::string m_name;
};

} // namespace tvx::registry
