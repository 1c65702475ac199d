#pragma once

/// @file
/// Going through a folder without asking its entries for anything.

#include "platform/win/detail/Mounts.h"

#include <dirent.h>

#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace tvx::win {

/// The entries of a folder, each with whether it is a folder.
///
/// The system tells that together with the name, so no entry is asked and nothing is mounted that lies below. Only a
/// link must be followed. One that leads to a mount of another machine, or to what would be mounted by that, is taken
/// for a folder unseen; so is nothing else. File systems that do not tell kinds are asked entry by entry.
class FolderWalk {
public:
    struct Entry {
        std::string_view name; ///< until the next call
        bool isFolder = false;
    };

    /// Opens a folder by its name in the system's form. With a failure there are no entries and `error` is `errno`'s
    /// number.
    explicit FolderWalk(const std::string& folder);

    /// The next entry, "." and ".." among them; nothing at the end, and when reading fails.
    [[nodiscard]] std::optional<Entry> next();
    [[nodiscard]] int error() const {
        return m_error;
    }

private:
    struct Close {
        void operator()(DIR* folder) const {
            ::closedir(folder);
        }
    };
    [[nodiscard]] bool isFolder(const dirent& entry);
    [[nodiscard]] bool isFolder(const char* name, int flags) const;
    [[nodiscard]] bool leadsToFolder(const char* link);

    std::unique_ptr<DIR, Close> m_folder;
    int m_error = 0;
    std::optional<Mounts> m_mounts; ///< read when the first link is met
    std::string m_path;             ///< of the folder, links resolved; from then on
};

} // namespace tvx::win
