#pragma once

#include "platform/base/Types.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
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

/// The bytes of a file, none when there is no such file. Not for a database's file that this process has open: that
/// would end its locks.
[[nodiscard]] std::string contentsOf(const std::string& file);

/// Keeps what a damaged file and its log held under a new name in the same folder, private to the user: that of
/// "registry.db" as "registry-damaged-20260131-235959.db". It is on the disk when this returns.
/// @return the new name; nothing when that was not possible
[[nodiscard]] std::optional<std::string> keepAside(const std::string& file, std::string_view bytes,
                                                   std::string_view log);

/// Takes back what keepAside() has made.
void removeAside(const std::string& aside);
/// Removes what the database has made beside a copy that was only looked at.
void removeShared(const std::string& copy);

/// A copy of a file and its log in a folder of its own in memory or among the temporary files, for reading what is in a
/// place where nothing can be written. Deleted with this object; what processes left that were ended from outside is
/// deleted by the next one.
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
    [[nodiscard]] bool makeFolder(const std::string& place);
    void removeFolder();

    std::string m_folder;
    int m_lock = -1;
    std::string m_name;
};

} // namespace tvx::registry
