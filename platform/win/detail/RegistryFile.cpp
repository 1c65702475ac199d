#include "platform/win/detail/RegistryFile.h"

#include "platform/win/Error.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <climits>
#include <cstdlib>
#include <ctime>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <pwd.h>
#include <sstream>
#include <string_view>
#include <sys/file.h>
#include <sys/stat.h>
#include <sys/vfs.h>
#include <unistd.h>
#include <vector>

namespace tvx::registry {

namespace fs = std::filesystem;

namespace {

constexpr const char* fileName = "tarvex/registry.db";
constexpr int longestLinkChain = 40; // that of the system

std::string_view environment(const char* name) {
    const char* value = std::getenv(name);
    return value ? value : "";
}

std::string home() {
    if (const std::string_view named = environment("HOME"); named.starts_with('/')) {
        return std::string(named);
    }
    const passwd* user = getpwuid(getuid());
    return user && user->pw_dir ? user->pw_dir : "";
}

std::string userFile() {
    if (const std::string_view named = environment("TVX_REGISTRY"); !named.empty()) {
        std::error_code error; // the current folder may be gone
        const fs::path file = fs::absolute(named, error);
        return error ? std::string() : file.string();
    }
    // Relative names in these variables are to be ignored.
    if (const std::string_view folder = environment("XDG_CONFIG_HOME"); folder.starts_with('/')) {
        return (fs::path(folder) / fileName).string();
    }
    const std::string folder = home();
    return folder.empty() ? std::string() : (fs::path(folder) / ".config" / fileName).string();
}

std::string machineFile() {
    std::string_view folders = environment("XDG_CONFIG_DIRS");
    folders = folders.empty() ? "/etc/xdg" : folders;
    while (!folders.empty()) {
        const std::size_t end = std::min(folders.find(':'), folders.size());
        const fs::path folder(folders.substr(0, end));
        folders.remove_prefix(std::min(end + 1, folders.size()));
        std::error_code error;
        if (const fs::path file = folder / fileName; folder.is_absolute() && fs::exists(file, error)) {
            return file.string();
        }
    }
    return {};
}

DWORD makeFolders(const fs::path& folder) {
    std::error_code error;
    if (folder.empty() || fs::is_directory(folder, error)) {
        return ERROR_SUCCESS;
    }
    if (const DWORD result = makeFolders(folder.parent_path()); result != ERROR_SUCCESS) {
        return result;
    }
    return mkdir(folder.c_str(), 0700) == 0 || errno == EEXIST ? ERROR_SUCCESS : errorFromErrno(errno);
}

std::string timeText() {
    const std::time_t now = std::time(nullptr);
    std::tm parts{};
    gmtime_r(&now, &parts);
    std::array<char, 32> text{};
    std::strftime(text.data(), text.size(), "%Y%m%d-%H%M%S", &parts);
    return text.data();
}

/// A name beside `file` that nothing has.
std::string asideName(const fs::path& file) {
    const std::string stem = (file.parent_path() / file.stem()).string() + "-damaged-" + timeText();
    std::string name = stem + file.extension().string();
    std::error_code error;
    for (int i = 2; fs::exists(name, error); ++i) {
        name = stem + "-" + std::to_string(i) + file.extension().string();
    }
    return name;
}

/// Makes a file that is private to the user, and waits until the disk has it.
bool writeNew(const std::string& file, std::string_view bytes) {
    const int descriptor = ::open(file.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0600);
    while (descriptor >= 0 && !bytes.empty()) {
        const ssize_t written = ::write(descriptor, bytes.data(), bytes.size());
        if (written < 0 && errno != EINTR) {
            break;
        }
        bytes.remove_prefix(static_cast<std::size_t>(std::max<ssize_t>(written, 0)));
    }
    const bool isKept = descriptor >= 0 && bytes.empty() && ::fsync(descriptor) == 0;
    if (descriptor >= 0) {
        ::close(descriptor);
    }
    return isKept;
}

/// Folders for copies, best first.
std::array<std::string, 4> copyPlaces() {
    return {std::string(environment("XDG_RUNTIME_DIR")), "/dev/shm", std::string(environment("TMPDIR")), "/tmp"};
}

constexpr const char* copyFolderName = "tvx-settings-";

/// Opens a folder of copies and locks it, which says that a process uses it: the lock goes with the process.
/// @return the descriptor, -1 when it is none of the user's or in use
int lockCopyFolder(const fs::path& folder) {
    const int descriptor = ::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC);
    struct stat status{};
    if (descriptor >= 0 && fstat(descriptor, &status) == 0 && status.st_uid == geteuid() &&
        flock(descriptor, LOCK_EX | LOCK_NB) == 0 && identityOf(folder) == FileIdentity{status.st_dev, status.st_ino}) {
        return descriptor;
    }
    if (descriptor >= 0) {
        ::close(descriptor);
    }
    return -1;
}

/// Removes the copies that processes have left which were ended from outside.
void clearCopies(const std::string& place) {
    std::error_code error;
    std::vector<fs::path> folders;
    for (fs::directory_iterator entry(place, error), end; !error && entry != end; entry.increment(error)) {
        if (entry->path().filename().string().starts_with(copyFolderName)) {
            folders.push_back(entry->path());
        }
    }
    for (const fs::path& folder : folders) {
        if (const int descriptor = lockCopyFolder(folder); descriptor >= 0) {
            fs::remove_all(folder, error);
            ::close(descriptor);
        }
    }
}

} // namespace

std::string locate(Hive hive) {
    return hive == Hive::User ? userFile() : machineFile();
}

std::string resolve(const std::string& name) {
    fs::path path(name);
    std::error_code error;
    for (int i = 0; i < longestLinkChain && fs::is_symlink(path, error); ++i) {
        const fs::path target = fs::read_symlink(path, error);
        const fs::path folder = fs::canonical(path.parent_path(), error); // what stands above ".." is not its link
        path = (error ? path.parent_path() : folder) / target;            // an absolute target stands alone
    }
    return path.string();
}

FileKind kindOf(const std::string& file) {
    struct stat status{};
    if (stat(file.c_str(), &status) == 0) {
        return S_ISREG(status.st_mode) ? FileKind::Regular : FileKind::Other;
    }
    return errno == ENOENT ? FileKind::Missing : FileKind::Unreachable;
}

FileIdentity identityOf(const std::string& file) {
    struct stat status{};
    if (stat(file.c_str(), &status) != 0) {
        return {};
    }
    return {status.st_dev, status.st_ino};
}

FileStamp stampOf(const std::string& file) {
    struct stat status{};
    if (stat(file.c_str(), &status) != 0) {
        return {};
    }
    return {
        {status.st_dev, status.st_ino}, status.st_size, status.st_mtim.tv_sec * 1'000'000'000 + status.st_mtim.tv_nsec};
}

bool allowsSharedMemory(const std::string& file) {
    // Numbers from linux/magic.h and the file systems' own sources. Behind FUSE may be another machine.
    constexpr std::array<std::uint32_t, 12> remote = {
        0x00006969, // NFS
        0x0000517B, // SMB
        0xFF534D42, // CIFS
        0xFE534D42, // SMB 2
        0x5346414F, // AFS
        0x6B414653, // kAFS
        0x73757245, // Coda
        0x01021997, // 9P
        0x65735546, // FUSE
        0x00C36400, // Ceph
        0x0BD00BD0, // Lustre
        0x01161970, // GFS2
    };
    struct statfs status{};
    if (statfs(file.c_str(), &status) != 0) {
        return false;
    }
    return std::ranges::find(remote, static_cast<std::uint32_t>(status.f_type)) == remote.end();
}

DWORD makeFolderOf(const std::string& file) {
    return makeFolders(fs::path(file).parent_path());
}

DWORD makeFile(const std::string& file) {
    const int descriptor = ::open(file.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, 0600);
    if (descriptor < 0) {
        return errno == EEXIST ? ERROR_SUCCESS : errorFromErrno(errno);
    }
    ::close(descriptor);
    return ERROR_SUCCESS;
}

std::string contentsOf(const std::string& file) {
    const std::ifstream stream(file, std::ios::binary);
    std::ostringstream bytes;
    if (stream) {
        bytes << stream.rdbuf(); // an iterator would throw where something that is no file has the name
    }
    return bytes.str();
}

std::optional<std::string> keepAside(const std::string& file, std::string_view bytes, std::string_view log) {
    std::string aside = asideName(file);
    if (writeNew(aside, bytes) && (log.empty() || writeNew(aside + "-wal", log))) {
        return aside;
    }
    removeAside(aside);
    return std::nullopt;
}

void removeAside(const std::string& aside) {
    unlink(aside.c_str());
    unlink((aside + "-wal").c_str());
}

void removeShared(const std::string& copy) {
    unlink((copy + "-shm").c_str());
}

FileCopy::FileCopy(const std::string& file) {
    for (const std::string& place : copyPlaces()) {
        if (!makeFolder(place)) {
            continue;
        }
        std::error_code error;
        const std::string copy = m_folder + "/registry.db";
        for (const char* part : {"", "-wal", "-journal"}) {
            if (!error && (*part == '\0' || fs::exists(file + part))) {
                fs::copy_file(file + part, copy + part, error);
            }
        }
        if (!error) {
            m_name = copy;
            return;
        }
        removeFolder();
    }
}

bool FileCopy::makeFolder(const std::string& place) {
    if (!place.starts_with('/')) {
        return false;
    }
    clearCopies(place);
    while (m_lock < 0) {
        m_folder = place + "/" + copyFolderName + "XXXXXX";
        if (!mkdtemp(m_folder.data())) {
            return false;
        }
        m_lock = lockCopyFolder(m_folder); // another process may have taken it for one that was left
    }
    return true;
}

void FileCopy::removeFolder() {
    std::error_code error;
    fs::remove_all(m_folder, error);
    ::close(m_lock);
    m_lock = -1;
}

FileCopy::~FileCopy() {
    if (!m_name.empty()) {
        removeFolder();
    }
}

} // namespace tvx::registry
