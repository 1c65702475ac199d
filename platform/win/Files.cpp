#include "platform/win/Files.h"

#include "platform/base/Text.h"
#include "platform/base/detail/Locate.h"
#include "platform/win/Drives.h"
#include "platform/win/Error.h"
#include "platform/win/detail/KernelObject.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <memory>
#include <sys/file.h>
#include <unistd.h>
#include <vector>

namespace {

using tvx::PathUse;

constexpr std::string_view separators = "\\/";
constexpr mode_t newFileMode = 0666;
constexpr mode_t newFolderMode = 0777;

/// Hands a text to a caller's buffer; see GetCurrentDirectoryA.
DWORD copyOut(const std::string& text, DWORD size, LPSTR buffer) {
    const bool fits = buffer && tvx::text::copyWhole(text, buffer, size);
    return static_cast<DWORD>(fits ? text.size() : text.size() + 1);
}

std::optional<std::string> pathOf(LPCSTR name, PathUse use = PathUse::Existing) {
    auto path = tvx::systemPath(name ? name : "", use);
    if (!path) {
        SetLastError(ERROR_PATH_NOT_FOUND);
    }
    return path;
}

/// What a name leads to in the end, links followed; nothing, with the last error, when it leads nowhere.
std::optional<tvx::Location> follow(LPCSTR name) {
    auto location = tvx::locate(name ? name : "");
    if (!location) {
        SetLastError(ERROR_PATH_NOT_FOUND);
        return std::nullopt;
    }
    // Where the look-up failed, the system says why: missing, or not to be seen.
    if ((location->exists && !S_ISLNK(location->state.st_mode)) ||
        ::stat(location->path.c_str(), &location->state) == 0) {
        return location;
    }
    tvx::setLastErrorFromErrno();
    return std::nullopt;
}

int systemFlags(DWORD access, DWORD disposition) {
    const int mode = access & GENERIC_WRITE ? (access & GENERIC_READ ? O_RDWR : O_WRONLY) : O_RDONLY;
    switch (disposition) {
    case CREATE_NEW:
        return mode | O_CLOEXEC | O_CREAT | O_EXCL;
    case CREATE_ALWAYS:
    case OPEN_ALWAYS:
        return mode | O_CLOEXEC | O_CREAT;
    default:
        return mode | O_CLOEXEC;
    }
}

/// Makes an open file what CreateFileA promises; false with errno.
bool prepare(int descriptor, DWORD share, DWORD disposition) {
    struct stat state{};
    if (::fstat(descriptor, &state) != 0) {
        return false;
    }
    if (S_ISDIR(state.st_mode)) {
        errno = EISDIR;
        return false;
    }
    if (::flock(descriptor, (share ? LOCK_SH : LOCK_EX) | LOCK_NB) != 0 && errno == EWOULDBLOCK) {
        errno = ETXTBSY;
        return false;
    }
    const bool isEmptied = disposition == CREATE_ALWAYS || disposition == TRUNCATE_EXISTING;
    return !isEmptied || !S_ISREG(state.st_mode) || ::ftruncate(descriptor, 0) == 0;
}

HANDLE failed() {
    tvx::setLastErrorFromErrno();
    return INVALID_HANDLE_VALUE;
}

/// The current folder of the drive that a name begins with.
std::string folderOfDrive(std::string_view name) {
    const int number = (name.front() | 0x20) - 'a' + 1;
    const std::unique_ptr<char, void (*)(void*)> folder(::_getdcwd(number, nullptr, 0), &std::free);
    return folder ? folder.get() : std::string(name.substr(0, 2));
}

/// A name with everything in front that it leaves out, nothing resolved.
std::string completed(std::string_view name) {
    const std::size_t length = tvx::rootLength(name);
    const bool isAbsolute = name.substr(length).find_first_of(separators) == 0;
    if (length > 0 && (isAbsolute || !tvx::hasDrive(name))) {
        return std::string(name);
    }
    if (length > 0) {
        return folderOfDrive(name) + '\\' + std::string(name.substr(length));
    }
    const std::string folder = tvx::currentFolderName();
    if (isAbsolute) {
        return folder.substr(0, tvx::rootLength(folder)) + std::string(name);
    }
    return folder + '\\' + std::string(name);
}

/// A completed name without ".", ".." and repeated separators.
std::string resolved(std::string_view name) {
    const std::size_t root = tvx::rootLength(name);
    std::vector<std::string_view> parts;
    for (std::size_t at = root; at < name.size();) {
        const std::size_t end = std::min(name.find_first_of(separators, at), name.size());
        const std::string_view part = name.substr(at, end - at);
        if (part == ".." && !parts.empty()) {
            parts.pop_back();
        } else if (part != ".." && part != "." && !part.empty()) {
            parts.push_back(part);
        }
        at = end + 1;
    }
    std::string result(name.substr(0, root));
    for (const std::string_view part : parts) {
        result.append("\\").append(part);
    }
    const bool isFolder = separators.find(name.back()) != std::string_view::npos;
    return isFolder || parts.empty() ? result + '\\' : result;
}

/// The whole name in the system's form.
std::string systemFullName(std::string_view name) {
    std::error_code error;
    const auto path = std::filesystem::absolute(std::filesystem::path(name), error);
    return error ? std::string(name) : path.lexically_normal().string();
}

} // namespace

DWORD GetFileAttributesA(LPCSTR name) {
    const auto location = follow(name);
    if (!location) {
        return INVALID_FILE_ATTRIBUTES;
    }
    DWORD attributes = tvx::attributesOf(location->state, location->path);
    if (::access(location->path.c_str(), W_OK) != 0) {
        attributes |= FILE_ATTRIBUTE_READONLY;
    }
    return attributes ? attributes : FILE_ATTRIBUTE_NORMAL;
}

HANDLE CreateFileA(LPCSTR name, DWORD access, DWORD share, const SECURITY_ATTRIBUTES* /*security*/, DWORD disposition,
                   DWORD /*flags*/, HANDLE /*pattern*/) {
    if (disposition < CREATE_NEW || disposition > TRUNCATE_EXISTING) {
        SetLastError(ERROR_INVALID_PARAMETER);
        return INVALID_HANDLE_VALUE;
    }
    const bool isExisting = disposition == OPEN_EXISTING || disposition == TRUNCATE_EXISTING;
    const auto path = pathOf(name, isExisting ? PathUse::Existing : PathUse::Creating);
    if (!path) {
        return INVALID_HANDLE_VALUE;
    }
    tvx::win::Descriptor file(::open(path->c_str(), systemFlags(access, disposition), newFileMode));
    if (!file || !prepare(file.number(), share, disposition)) {
        return failed();
    }
    return tvx::win::makeHandle(std::make_shared<tvx::win::KernelObject>(std::move(file)), tvx::win::Inheritance::None);
}

BOOL DeleteFileA(LPCSTR name) {
    const auto path = pathOf(name);
    if (!path) {
        return FALSE;
    }
    if (::unlink(path->c_str()) == 0) {
        return TRUE;
    }
    tvx::setLastErrorFromErrno();
    return FALSE;
}

BOOL CreateDirectoryA(LPCSTR name, const SECURITY_ATTRIBUTES* /*security*/) {
    const auto path = pathOf(name, PathUse::Creating);
    if (!path) {
        return FALSE;
    }
    if (::mkdir(path->c_str(), newFolderMode) == 0) {
        return TRUE;
    }
    SetLastError(errno == EEXIST   ? ERROR_ALREADY_EXISTS
                 : errno == ENOENT ? ERROR_PATH_NOT_FOUND
                                   : tvx::errorFromErrno(errno));
    return FALSE;
}

DWORD GetCurrentDirectoryA(DWORD size, LPSTR buffer) {
    const std::string folder = tvx::currentFolderName();
    if (!folder.empty()) {
        return copyOut(folder, size, buffer);
    }
    SetLastError(ERROR_FILE_NOT_FOUND);
    return 0;
}

DWORD GetFullPathNameA(LPCSTR name, DWORD size, LPSTR buffer, LPSTR* filePart) {
    if (!name || !*name) {
        SetLastError(ERROR_INVALID_NAME);
        return 0;
    }
    const std::string full = tvx::fullName(name);
    const DWORD length = copyOut(full, size, buffer);
    if (filePart && length == full.size()) {
        const std::size_t last = full.find_last_of(separators) + 1;
        *filePart = last < full.size() ? buffer + last : nullptr;
    }
    return length;
}

tvx::FileKind tvx::fileKind(LPCSTR name) {
    const auto location = follow(name);
    if (!location) {
        return FileKind::None;
    }
    const mode_t mode = location->state.st_mode;
    return S_ISDIR(mode) ? FileKind::Folder : S_ISREG(mode) ? FileKind::File : FileKind::Device;
}

std::string tvx::fullName(std::string_view name) {
    if (name.empty()) {
        return {};
    }
    const bool isSystemForm = name.front() == '/' || systemPath(name) == name;
    const std::string full = isSystemForm ? driveName(systemFullName(name)) : completed(name);
    return full.front() == '/' ? full : resolved(full);
}
