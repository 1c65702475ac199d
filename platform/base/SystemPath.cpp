#include "platform/base/SystemPath.h"

#include "platform/base/Text.h"

#include <algorithm>
#include <filesystem>

namespace tvx {
namespace {

std::optional<std::string> onlyDrive(std::string_view root) {
    if (text::equalNoCase(root, "C:"))
        return "/";
    return std::nullopt;
}

constinit RootResolver rootResolver = &onlyDrive;

bool exists(const std::string& path) {
    std::error_code error;
    return std::filesystem::exists(std::filesystem::symlink_status(path, error));
}

bool isSeparator(char character) {
    return character == '\\' || character == '/';
}

/// Length of the drive or share that a name begins with; 0 when there is none.
std::size_t rootLength(std::string_view name) {
    if (hasDrive(name))
        return 2;
    if (!name.starts_with("\\\\"))
        return 0;
    const std::size_t server = name.find_first_of("\\/", 2);
    if (server == std::string_view::npos)
        return name.size();
    return std::min(name.find_first_of("\\/", server + 1), name.size());
}

std::string withSlashes(std::string_view name) {
    std::string result(name);
    std::ranges::replace(result, '\\', '/');
    return result;
}

/// The name with its root looked up and its separators turned, in the spelling it came in.
std::optional<std::string> mapped(std::string_view name) {
    const std::size_t length = rootLength(name);
    if (length == 0)
        return withSlashes(name);
    std::optional<std::string> folder = rootResolver(name.substr(0, length));
    if (!folder)
        return std::nullopt;
    const std::string_view rest = name.substr(length);
    // A name relative to the main drive, "C:a", is relative to the current folder, which lies on it.
    if (*folder == "/")
        return rest.empty() ? "/" : withSlashes(rest);
    return *folder + (rest.empty() || isSeparator(rest.front()) ? "" : "/") + withSlashes(rest);
}

/// The entry of a folder that equals `part` without regard to case.
std::optional<std::string> findEntry(const std::string& folder, std::string_view part) {
    std::optional<std::string> best;
    std::error_code error;
    std::filesystem::directory_iterator entry(folder.empty() ? "." : folder, error);
    for (; !error && entry != std::filesystem::directory_iterator(); entry.increment(error)) {
        std::string name = entry->path().filename().string();
        if (text::equalNoCase(name, part) && (!best || name < *best))
            best = std::move(name);
    }
    return best;
}

/// Walks a path from its beginning and corrects the spelling of the parts that exist in another one.
std::string corrected(const std::string& path, PathUse use) {
    std::string result;
    for (std::size_t at = 0; at < path.size();) {
        const std::size_t end = std::min(path.find('/', at), path.size());
        const std::string_view part = std::string_view(path).substr(at, end - at);
        const bool last = path.find_first_not_of('/', end) == std::string::npos;
        const bool fixed = part.empty() || (last && use == PathUse::creating) || exists(result + std::string(part));
        const std::optional<std::string> entry = fixed ? std::nullopt : findEntry(result, part);
        if (!fixed && !entry)
            return result + path.substr(at);
        result += entry ? *entry : std::string(part);
        at = std::min(path.find_first_not_of('/', end), path.size());
        result.append(path, end, at - end);
    }
    return result;
}

} // namespace

void setRootResolver(RootResolver resolver) noexcept {
    rootResolver = resolver ? resolver : &onlyDrive;
}

bool hasDrive(std::string_view name) noexcept {
    return name.size() >= 2 && name[1] == ':' &&
           ((name[0] >= 'A' && name[0] <= 'Z') || (name[0] >= 'a' && name[0] <= 'z'));
}

std::optional<std::string> systemPath(std::string_view name, PathUse use) {
    if (name.empty() || name.find('\0') != std::string_view::npos)
        return std::nullopt;
    std::string exact(name);
    if (exists(exact))
        return exact;
    std::optional<std::string> path = mapped(name);
    if (!path || exists(*path))
        return path;
    return corrected(*path, use);
}

} // namespace tvx
