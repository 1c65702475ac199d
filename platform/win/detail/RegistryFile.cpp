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
#include <iterator>
#include <pwd.h>
#include <string_view>
#include <sys/stat.h>
#include <sys/vfs.h>
#include <unistd.h>

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
        return fs::absolute(named).string();
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

std::string makeCopyFolder(const std::string& place) {
    if (!place.starts_with('/')) {
        return {};
    }
    std::string folder = place + "/tvx-settings-XXXXXX";
    return mkdtemp(folder.data()) ? folder : std::string();
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
        path = (path.parent_path() / target).lexically_normal(); // an absolute target stands alone
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
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
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
        m_folder = makeCopyFolder(place);
        if (m_folder.empty()) {
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
        fs::remove_all(m_folder, error);
    }
}

FileCopy::~FileCopy() {
    std::error_code error;
    if (!m_name.empty()) {
        fs::remove_all(m_folder, error);
    }
}

} // namespace tvx::registry
