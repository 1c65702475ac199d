#include "s/FileNameText.h"

#include <algorithm>

namespace FileNameText {

std::string WithBackslashes(std::string_view name) {
    std::string result(name);
    std::ranges::replace(result, '/', Separator);
    return result;
}

std::string AsFolder(std::string_view name) {
    std::string folder = WithBackslashes(name);
    if (!folder.ends_with(Separator)) {
        folder += Separator;
    }
    return folder;
}

std::string AsPath(std::string_view folders) {
    return folders.empty() ? std::string() : AsFolder(folders);
}

std::string WithDot(std::string_view extension) {
    return extension.empty() || extension.front() == '.' ? std::string(extension) : '.' + std::string(extension);
}

std::string_view PopFirst(std::string_view& path) {
    if (path.starts_with(Separator)) {
        path.remove_prefix(1);
    }
    const std::string_view folder = path.substr(0, path.find(Separator));
    path.remove_prefix(std::min(folder.size() + 1, path.size()));
    return folder;
}

bool IsDrive(std::string_view mount) {
    const char letter = mount.empty() ? '\0' : static_cast<char>(mount.front() | 0x20);
    return mount.size() >= 2 && letter >= 'a' && letter <= 'z' && mount[1] == ':';
}

} // namespace FileNameText
