#include "platform/win/detail/FolderWalk.h"

#include <cerrno>
#include <climits>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

namespace tvx::win {

namespace {

namespace fs = std::filesystem;

/// As many links in a row as the system follows.
constexpr int mostLinks = 40;

std::optional<std::string> readLink(const std::string& path) {
    char target[PATH_MAX];
    const ssize_t length = ::readlink(path.c_str(), target, sizeof(target));
    return length < 0 ? std::nullopt : std::optional(std::string(target, static_cast<std::size_t>(length)));
}

} // namespace

FolderWalk::FolderWalk(const std::string& folder) : m_folder(::opendir(folder.c_str())) {
    m_error = m_folder ? 0 : errno;
}

std::optional<FolderWalk::Entry> FolderWalk::next() {
    if (!m_folder) {
        return std::nullopt;
    }
    errno = 0;
    const dirent* entry = ::readdir(m_folder.get());
    if (!entry) {
        m_error = errno;
        return std::nullopt;
    }
    return Entry{entry->d_name, isFolder(*entry)};
}

bool FolderWalk::isFolder(const dirent& entry) {
    switch (entry.d_type) {
    case DT_DIR:
        return true;
    case DT_LNK:
        return leadsToFolder(entry.d_name);
    case DT_UNKNOWN:
        return isFolder(entry.d_name, AT_SYMLINK_NOFOLLOW) || leadsToFolder(entry.d_name);
    default:
        return false;
    }
}

bool FolderWalk::isFolder(const char* name, int flags) const {
    struct stat state{};
    return ::fstatat(::dirfd(m_folder.get()), name, &state, flags | AT_NO_AUTOMOUNT) == 0 && S_ISDIR(state.st_mode);
}

bool FolderWalk::leadsToFolder(const char* link) {
    if (!m_mounts) {
        m_mounts = Mounts::current();
        m_path = readLink("/proc/self/fd/" + std::to_string(::dirfd(m_folder.get()))).value_or("/");
    }
    // The links of a row are read one by one, so that none of them leads away unnoticed.
    const std::string home = m_mounts->pointOf(m_path);
    std::string path = m_path + "/" + link;
    for (int i = 0; i < mostLinks; ++i) {
        const auto target = readLink(path);
        if (!target) {
            break;
        }
        path = (fs::path(path).parent_path() / *target).lexically_normal().string();
        if (m_mounts->isFar(path) && m_mounts->pointOf(path) != home) {
            return true;
        }
    }
    return isFolder(link, 0);
}

} // namespace tvx::win
