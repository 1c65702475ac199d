#include "platform/win/detail/Mounts.h"

#include "platform/win/detail/DriveTable.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <fstream>
#include <iterator>
#include <optional>

namespace tvx::win {

namespace {

/// Blanks, tabs, line ends and backslashes are written as three octal digits behind a backslash.
std::string unescaped(std::string_view text) {
    std::string result;
    for (std::size_t at = 0; at < text.size(); ++at) {
        unsigned value = 0;
        const char* const digits = text.data() + at + 1;
        const bool isEscape = text[at] == '\\' && text.size() - at > 3 &&
                              std::from_chars(digits, digits + 3, value, 8).ptr == digits + 3 && value < 256;
        result += isEscape ? static_cast<char>(value) : text[at];
        at += isEscape ? 3 : 0;
    }
    return result;
}

std::optional<Mount> parseLine(std::string_view line) {
    constexpr int fieldsBeforePoint = 4;
    constexpr std::string_view endOfOptions = " - ";
    const std::size_t end = line.find(endOfOptions);
    if (end == std::string_view::npos) {
        return std::nullopt;
    }
    std::string_view left = line.substr(0, end);
    std::string_view right = line.substr(end + endOfOptions.size());
    for (int field = 0; field < fieldsBeforePoint; ++field) {
        takeField(left, ' ');
    }
    Mount mount{
        std::string(withoutEndSlashes(unescaped(takeField(left, ' ')))), std::string(takeField(right, ' ')), {}};
    mount.source = unescaped(takeField(right, ' '));
    return mount.point.starts_with('/') && mount.point.find('\0') == std::string::npos ? std::optional(mount)
                                                                                       : std::nullopt;
}

} // namespace

std::string_view takeField(std::string_view& text, char separator) {
    const std::string_view field = text.substr(0, text.find(separator));
    text.remove_prefix(std::min(field.size() + 1, text.size()));
    return field;
}

std::string_view withoutEndSlashes(std::string_view folder) {
    while (folder.size() > 1 && folder.ends_with('/')) {
        folder.remove_suffix(1);
    }
    return folder;
}

bool isBelow(std::string_view path, std::string_view folder) {
    return folder == "/" || (path.starts_with(folder) && (path.size() == folder.size() || path[folder.size()] == '/'));
}

std::map<std::string, Mount> parseMounts(std::string_view mountInfo) {
    std::map<std::string, Mount> mounts;
    while (!mountInfo.empty()) {
        if (auto mount = parseLine(takeField(mountInfo, '\n'))) {
            mounts.insert_or_assign(mount->point, *mount);
        }
    }
    return mounts;
}

bool isNetwork(std::string_view fileSystem) {
    static constexpr std::array<std::string_view, 12> names{
        "nfs",        "nfs4",       "cifs",           "smb3",           "smbfs",     "ceph",
        "fuse.sshfs", "fuse.davfs", "fuse.glusterfs", "fuse.curlftpfs", "fuse.ceph", "davfs"};
    return std::ranges::find(names, fileSystem) != names.end();
}

Mounts Mounts::current() {
    std::ifstream file("/proc/self/mountinfo", std::ios::binary);
    Mounts list;
    list.m_mounts = parseMounts(std::string(std::istreambuf_iterator<char>(file), {}));
    // Folders that are said to be network drives are treated as such.
    for (const auto table = currentDrives(); const Drive& drive : table->drives()) {
        if (drive.kind == DriveKind::Remote) {
            list.m_mounts.insert_or_assign(drive.folder, Mount{drive.folder, "nfs", drive.remoteName});
        }
    }
    return list;
}

std::string Mounts::pointOf(std::string_view path) const {
    std::string folder(withoutEndSlashes(path));
    while (folder.size() > 1 && !m_mounts.contains(folder)) {
        folder.erase(std::max<std::size_t>(folder.rfind('/'), 1));
    }
    return folder;
}

bool Mounts::isFar(std::string_view path) const {
    const auto mount = m_mounts.find(pointOf(path));
    if (mount == m_mounts.end()) {
        return false;
    }
    // What programs serve ("fuse.gvfsd-fuse") may lead anywhere; only disks that a program reads are as near as others.
    const std::string& kind = mount->second.fileSystem;
    return isNetwork(kind) || kind == "autofs" || kind == "fuse" || kind.starts_with("fuse.");
}

} // namespace tvx::win
