#include "platform/win/FolderNames.h"

#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/win/Error.h"
#include "platform/win/detail/FolderWalk.h"

#include <algorithm>

namespace tvx {

namespace {

bool isWanted(const win::FolderWalk::Entry& entry, HiddenFolders hidden) {
    if (!entry.isFolder || entry.name == "." || entry.name == "..") {
        return false;
    }
    return hidden == HiddenFolders::Include || !entry.name.starts_with('.');
}

} // namespace

FolderNames readFolders(std::string_view folder, HiddenFolders hidden) {
    FolderNames found;
    const auto path = systemPath(folder);
    if (!path) {
        found.error = ERROR_PATH_NOT_FOUND;
        return found;
    }
    win::FolderWalk walk(*path);
    while (const auto entry = walk.next()) {
        if (isWanted(*entry, hidden)) {
            found.names.emplace_back(entry->name);
        }
    }
    found.error = errorFromErrno(walk.error());
    std::ranges::sort(found.names, [](const std::string& left, const std::string& right) {
        const int order = text::compareNoCase(left, right);
        return order != 0 ? order < 0 : left < right;
    });
    return found;
}

} // namespace tvx
