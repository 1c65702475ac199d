#include "platform/base/detail/Locate.h"

#include "platform/base/Text.h"

#include <algorithm>
#include <climits>
#include <dirent.h>
#include <filesystem>
#include <memory>
#include <utility>

namespace tvx {
namespace {

std::optional<std::string> onlyFolder(std::string_view root) {
    if (text::equalNoCase(root, "C:")) {
        return "/";
    }
    return std::nullopt;
}

std::optional<DriveRoot> onlyDrive(std::string_view) {
    return DriveRoot{"C:", "/"};
}

constexpr RootResolver onlyDriveC{&onlyFolder, &onlyDrive};
constinit const RootResolver* rootResolver = &onlyDriveC;

bool isSeparator(char character) {
    return character == '\\' || character == '/';
}

std::string withSlashes(std::string_view name) {
    std::string result(name);
    std::ranges::replace(result, '\\', '/');
    return result;
}

/// Whether a name can only be meant in the framework's form. Such a name is never looked for as it is written: nobody
/// may put a file called "C:\setup" into the current folder and have it taken for that of the drive.
bool isRooted(std::string_view name) {
    return name.front() == '\\' || (hasDrive(name) && name.size() > 2 && isSeparator(name[2]));
}

std::string currentFolder() {
    std::error_code error;
    return std::filesystem::current_path(error).string();
}

std::optional<DriveRoot> currentDrive() {
    const std::string folder = currentFolder();
    return folder.empty() ? std::nullopt : rootResolver->driveOf(folder);
}

/// A name below a folder; `rest` begins with a separator or is empty.
std::string below(const std::string& folder, std::string_view rest) {
    if (folder == "/") {
        return rest.empty() ? folder : withSlashes(rest);
    }
    return folder + withSlashes(rest);
}

/// The name with its root looked up and its separators turned, in the spelling it came in.
std::optional<std::string> mapped(std::string_view name) {
    const std::size_t length = rootLength(name);
    const std::string_view rest = name.substr(length);
    if (length == 0) {
        const auto drive = name.front() == '\\' ? currentDrive() : std::nullopt;
        return drive ? below(drive->folder, rest) : withSlashes(rest);
    }
    const std::optional<std::string> folder = rootResolver->folderOf(name.substr(0, length));
    if (!folder) {
        return std::nullopt;
    }
    if (rest.empty() || isSeparator(rest.front())) {
        return below(*folder, rest);
    }
    const auto drive = currentDrive();
    return drive && drive->folder == *folder ? withSlashes(rest) : below(*folder, "/" + std::string(rest));
}

bool find(Location& location) {
    location.exists = ::lstat(location.path.c_str(), &location.state) == 0;
    return location.exists;
}

bool exists(const std::string& path) {
    struct stat state{};
    return ::lstat(path.c_str(), &state) == 0;
}

/// The entry of a folder that equals `part` without regard to case.
std::optional<std::string> findEntry(const std::string& folder, std::string_view part) {
    const std::unique_ptr<DIR, int (*)(DIR*)> entries(::opendir(folder.empty() ? "." : folder.c_str()), &::closedir);
    std::optional<std::string> best;
    while (const dirent* entry = entries ? ::readdir(entries.get()) : nullptr) {
        const std::string_view name(entry->d_name);
        if (text::equalNoCase(name, part) && (!best || name < *best)) {
            best = name;
        }
    }
    return best;
}

std::size_t withoutLastPart(std::string_view path) {
    const std::size_t end = path.find_last_not_of('/');
    const std::size_t slash = end == std::string_view::npos ? end : path.rfind('/', end);
    return slash == std::string_view::npos ? 0 : slash + 1;
}

/// Length of the longest beginning of a path that exists as it is written, up to a separator.
std::size_t existingLength(const std::string& path) {
    std::size_t length = withoutLastPart(path);
    while (length > 0 && !exists(path.substr(0, length))) {
        length = withoutLastPart(std::string_view(path).substr(0, length));
    }
    return length;
}

/// Corrects the spelling of the parts of a path that exist in another one. No file has a name too long for the system,
/// and to look for its parts could take for ever.
std::string corrected(const std::string& path, PathUse use) {
    if (path.size() >= PATH_MAX) {
        return path;
    }
    std::size_t at = existingLength(path);
    std::string result = path.substr(0, at);
    while (at < path.size()) {
        const std::size_t end = std::min(path.find('/', at), path.size());
        const std::size_t next = std::min(path.find_first_not_of('/', end), path.size());
        const std::string_view part = std::string_view(path).substr(at, end - at);
        const bool isFixed =
            part.empty() || (next == path.size() && use == PathUse::Creating) || exists(result + std::string(part));
        const std::optional<std::string> entry = isFixed ? std::string(part) : findEntry(result, part);
        if (!entry) {
            return result + path.substr(at);
        }
        result.append(*entry).append(path, end, next - end);
        at = next;
    }
    return result;
}

/// The system's name that a missing one on the current drive came from, when that exists; see systemPath().
std::optional<std::string> belowSystemRoot(std::string_view name, const std::string& missing, PathUse use) {
    if (!isRooted(name)) {
        return std::nullopt;
    }
    const std::string plain = withSlashes(name.substr(rootLength(name)));
    const auto drive = plain == missing ? std::nullopt : currentDrive();
    if (!drive || drive->folder == "/" || !missing.starts_with(drive->folder + "/")) {
        return std::nullopt;
    }
    const auto wanted = [use](const std::string& path) {
        return use == PathUse::Existing ? path : path.substr(0, withoutLastPart(path));
    };
    return !exists(wanted(missing)) && exists(wanted(plain)) ? std::optional(plain) : std::nullopt;
}

} // namespace

const RootResolver* setRootResolver(const RootResolver* resolver) noexcept {
    return std::exchange(rootResolver, resolver ? resolver : &onlyDriveC);
}

bool hasDrive(std::string_view name) noexcept {
    return name.size() >= 2 && name[1] == ':' &&
           ((name[0] >= 'A' && name[0] <= 'Z') || (name[0] >= 'a' && name[0] <= 'z'));
}

std::size_t rootLength(std::string_view name) noexcept {
    if (hasDrive(name)) {
        return 2;
    }
    if (!name.starts_with("\\\\")) {
        return 0;
    }
    const std::size_t server = name.find_first_of("\\/", 2);
    if (server == std::string_view::npos) {
        return name.size();
    }
    return std::min(name.find_first_of("\\/", server + 1), name.size());
}

std::optional<Location> locate(std::string_view name, PathUse use) {
    if (name.empty() || name.find('\0') != std::string_view::npos) {
        return std::nullopt;
    }
    Location location;
    if (!isRooted(name)) {
        location.path = name;
        if (find(location)) {
            return location;
        }
    }
    std::optional<std::string> path = mapped(name);
    if (!path) {
        return std::nullopt;
    }
    location.path = *std::move(path);
    if ((location.path != name || isRooted(name)) && find(location)) {
        return location;
    }
    location.path = corrected(location.path, use);
    if (!find(location)) {
        if (const auto plain = belowSystemRoot(name, location.path, use)) {
            location.path = *plain;
            find(location);
        }
    }
    return location;
}

std::optional<std::string> systemPath(std::string_view name, PathUse use) {
    std::optional<Location> location = locate(name, use);
    return location ? std::optional(std::move(location->path)) : std::nullopt;
}

bool isNamedPipe(std::string_view name) {
    std::error_code unknown;
    return std::filesystem::is_fifo(systemPath(name).value_or(""), unknown);
}

std::string driveName(std::string_view path) {
    std::string name(path);
    if (path.find('\\') != std::string_view::npos) {
        return name;
    }
    if (path.starts_with('/')) {
        const auto root = rootResolver->driveOf(path);
        if (!root) {
            return name;
        }
        name = root->drive + name.substr(root->folder == "/" ? 0 : root->folder.size());
        name += name.size() == root->drive.size() ? "/" : "";
    }
    std::ranges::replace(name, '/', '\\');
    return name;
}

std::string shownName(std::string_view name) {
    return systemPath(name).value_or(std::string(name));
}

std::string currentFolderName() {
    return driveName(currentFolder());
}

} // namespace tvx
