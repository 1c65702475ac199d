#include "platform/port/TarvexPath.h"

#include "platform/win/Installation.h"

#include <algorithm>
#include <string>
#include <utility>

namespace Port {

namespace {

StringBase<char> withSlashes(std::string root) {
    std::replace(root.begin() + (root.starts_with("\\\\") ? 2 : 0), root.end(), '\\', '/');
    return root;
}

} // namespace

PathList::PathList(std::vector<StringBase<char>> folders) : m_folders(std::move(folders)) {}

PathList::Iterator PathList::begin() const {
    return m_folders.begin();
}

PathList::Iterator PathList::end() const {
    return m_folders.end();
}

PathList TarvexPath::GetInstance() {
    std::vector<StringBase<char>> folders;
    for (StringBase<char> root : tvx::installationRoots()) {
        root.Trim(" \t");
        if (!root.IsEmpty()) {
            folders.push_back(withSlashes(root.str()));
        }
    }
    return PathList(std::move(folders));
}

} // namespace Port
