#include "platform/win/detail/RegistryPath.h"

#include "platform/base/Text.h"
#include "platform/win/Error.h"

#include <algorithm>
#include <utility>

namespace tvx::registry {

namespace {

constexpr std::size_t longestPart = 255;
constexpr std::size_t longestValueName = 16383;
constexpr std::size_t longestPath = 32767;
constexpr std::ptrdiff_t mostLevels = 512;

} // namespace

DWORD append(KeyPath& path, std::string_view subKey) {
    while (!subKey.empty()) {
        const std::size_t end = std::min(subKey.find('\\'), subKey.size());
        const std::string_view part = subKey.substr(0, end);
        subKey.remove_prefix(std::min(end + 1, subKey.size()));
        if (part.empty()) {
            continue;
        }
        if (text::characterCount(part) > longestPart || path.spelled.size() + part.size() > longestPath) {
            return ERROR_INVALID_PARAMETER;
        }
        if (!path.spelled.empty()) {
            path.spelled += '\\';
        }
        path.spelled += part;
    }
    if (std::ranges::count(path.spelled, '\\') >= mostLevels) {
        return ERROR_INVALID_PARAMETER;
    }
    path.folded = text::foldCase(path.spelled);
    return ERROR_SUCCESS;
}

std::optional<KeyPath> soundKey(std::string_view path, std::string_view name) {
    KeyPath key;
    const bool isOne = name.find('\\') == std::string_view::npos && append(key, parentOf(path)) == ERROR_SUCCESS &&
                       key.folded == parentOf(path) && append(key, name) == ERROR_SUCCESS && key.folded == path;
    return isOne && !name.empty() ? std::optional(std::move(key)) : std::nullopt;
}

bool isValueName(std::string_view name) {
    return text::characterCount(name) <= longestValueName;
}

std::string_view parentOf(std::string_view path) {
    const std::size_t at = path.rfind('\\');
    return at == std::string_view::npos ? std::string_view() : path.substr(0, at);
}

std::string_view lastPart(std::string_view path) {
    const std::size_t at = path.rfind('\\');
    return at == std::string_view::npos ? path : path.substr(at + 1);
}

std::vector<KeyPath> levelsOf(const KeyPath& path) {
    std::vector<KeyPath> levels;
    // Folding changes the length of letters, so the two are walked apart.
    for (std::size_t spelled = 0, folded = 0; spelled != std::string::npos;) {
        spelled = path.spelled.find('\\', spelled + 1);
        folded = path.folded.find('\\', folded + 1);
        levels.push_back({path.spelled.substr(0, spelled), path.folded.substr(0, folded)});
    }
    return levels;
}

} // namespace tvx::registry
