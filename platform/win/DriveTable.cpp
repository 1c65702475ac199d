#include "platform/win/detail/DriveTable.h"

#include "platform/base/Text.h"
#include "platform/win/detail/Mounts.h"

#include <algorithm>
#include <array>
#include <map>
#include <optional>

namespace tvx::win {
namespace {

std::string_view trimSlashes(std::string_view text) {
    while (text.starts_with('/')) {
        text.remove_prefix(1);
    }
    while (text.ends_with('/')) {
        text.remove_suffix(1);
    }
    return text;
}

std::string_view lastPart(std::string_view path) {
    return path.substr(path.rfind('/') + 1);
}

std::string joined(std::string_view path) {
    std::string name(path);
    std::ranges::replace(name, '/', '-');
    return name;
}

/// A server and the folder of it that is mounted.
struct Remote {
    std::string server;
    std::string folder;
    bool isShare = false; ///< the folder begins with the name of a share
};

std::optional<Remote> parseSource(std::string_view source) {
    Remote remote;
    const std::size_t scheme = source.find("://");
    if (scheme != std::string_view::npos || source.starts_with("//")) {
        source = source.substr(scheme == std::string_view::npos ? 2 : scheme + 3);
        remote.isShare = scheme == std::string_view::npos;
        remote.server = takeField(source, '/');
    } else {
        // The folder stands behind the last colon before it, addresses hold colons themselves.
        const std::size_t slash = source.find(":/");
        const std::size_t colon = slash == std::string_view::npos ? source.rfind(':') : slash;
        if (colon == std::string_view::npos) {
            return std::nullopt;
        }
        remote.server = source.substr(0, std::min(colon, source.find(',')));
        source.remove_prefix(colon + 1);
    }
    remote.folder = trimSlashes(source);
    remote.server.erase(0, remote.server.find('@') + 1);
    std::erase_if(remote.server, [](char character) { return character == '[' || character == ']'; });
    std::ranges::replace_if(
        remote.server,
        [](char character) { return std::string_view(":/\\").find(character) != std::string_view::npos; }, '-');
    return remote.server.empty() ? std::nullopt : std::optional(remote);
}

/// "\\server\share" for a network mount, not yet one of `taken`. The share is one word: the last folder, or all of them
/// joined where that name is taken or would mean another folder of the share.
std::string remoteName(const Mount& mount, const std::vector<Drive>& taken) {
    const auto remote = parseSource(mount.source);
    if (!remote) {
        return {};
    }
    const std::string server = "\\\\" + remote->server + "\\";
    const std::string_view folder = remote->folder.empty() ? lastPart(mount.point) : std::string_view(remote->folder);
    std::string name = server + (remote->isShare ? joined(folder) : std::string(lastPart(folder)));
    const auto isTaken = [&](const Drive& drive) { return text::equalNoCase(drive.remoteName, name); };
    if (std::ranges::any_of(taken, isTaken)) {
        name = server + joined(folder);
    }
    std::ranges::replace(name.begin() + static_cast<std::ptrdiff_t>(server.size()), name.end(), '\\', '-');
    return name;
}

/// Where desktops and people mount what they plug in, also disks that are not marked as removable.
bool isMediaFolder(std::string_view point) {
    return point.starts_with("/media/") || point.starts_with("/run/media/");
}

/// The drive that a mount is; nothing for one that only is a folder.
std::optional<Drive> driveOf(const Mount& mount, const std::vector<Drive>& others, const RemovableTest& isRemovable) {
    if (mount.point == "/") {
        return std::nullopt;
    }
    if (isNetwork(mount.fileSystem)) {
        Drive drive{0, mount.point, DriveKind::Remote, remoteName(mount, others)};
        return drive.remoteName.empty() ? std::nullopt : std::optional(drive);
    }
    if (!mount.source.starts_with("/dev/")) {
        return std::nullopt;
    }
    const bool isDisc = mount.fileSystem == "iso9660" || mount.source.starts_with("/dev/sr");
    if (isDisc || isMediaFolder(mount.point) || isRemovable(mount.source)) {
        return Drive{0, mount.point, isDisc ? DriveKind::Optical : DriveKind::Removable, {}};
    }
    return std::nullopt;
}

bool isLetter(char character) {
    return character >= 'A' && character <= 'Z';
}

char upper(char character) {
    return character >= 'a' && character <= 'z' ? static_cast<char>(character - 'a' + 'A') : character;
}

/// Whether a name is "\\server\share" and no more: that is what names are looked up by.
bool isShare(std::string_view name) {
    if (!name.starts_with("\\\\")) {
        return false;
    }
    name.remove_prefix(2);
    const std::string_view server = takeField(name, '\\');
    return !server.empty() && !name.empty() && server.find('/') == std::string_view::npos &&
           name.find_first_of("\\/") == std::string_view::npos;
}

bool setKind(Drive& drive, std::string_view kind) {
    if (isShare(kind)) {
        drive.kind = DriveKind::Remote;
        drive.remoteName = kind;
        return true;
    }
    if (kind == "removable") {
        drive.kind = DriveKind::Removable;
    } else if (kind == "cdrom") {
        drive.kind = DriveKind::Optical;
    } else {
        return kind.empty() || kind == "fixed";
    }
    return true;
}

std::optional<Drive> parseEntry(std::string_view entry) {
    Drive drive;
    const std::string_view letter = takeField(entry, '=');
    const std::string_view folder = withoutEndSlashes(takeField(entry, '|'));
    if (letter.size() != 1 || !isLetter(upper(letter.front())) || !folder.starts_with('/') || !setKind(drive, entry)) {
        return std::nullopt;
    }
    drive.letter = upper(letter.front());
    drive.folder = folder;
    return drive;
}

} // namespace

DriveTable DriveTable::fromMounts(std::string_view mountInfo, const RemovableTest& isRemovable) {
    DriveTable table;
    table.m_drives.push_back({'C', "/", DriveKind::Fixed, {}});
    char letter = 'D';
    for (const auto& [point, mount] : parseMounts(mountInfo)) {
        std::optional<Drive> drive = driveOf(mount, table.m_drives, isRemovable);
        if (!drive || (!isLetter(letter) && drive->kind != DriveKind::Remote)) {
            continue;
        }
        drive->letter = isLetter(letter) ? letter++ : '\0';
        table.m_drives.push_back(*std::move(drive));
    }
    return table;
}

DriveTable DriveTable::fromText(std::string_view text, std::vector<std::string>& mistakes) {
    DriveTable table;
    while (!text.empty()) {
        const std::string_view entry = takeField(text, ';');
        std::optional<Drive> drive = parseEntry(entry);
        if (drive && !table.find(drive->letter)) {
            table.m_drives.push_back(*std::move(drive));
        } else if (!entry.empty()) {
            mistakes.emplace_back(entry);
        }
    }
    std::ranges::sort(table.m_drives, {}, &Drive::letter);
    return table;
}

const Drive* DriveTable::find(char letter) const noexcept {
    const char wanted = upper(letter);
    const auto found = std::ranges::find(m_drives, wanted, &Drive::letter);
    return isLetter(wanted) && found != m_drives.end() ? &*found : nullptr;
}

const Drive* DriveTable::findShare(std::string_view remoteName) const noexcept {
    const auto found = std::ranges::find_if(m_drives, [remoteName](const Drive& drive) {
        return !drive.remoteName.empty() && text::equalNoCase(drive.remoteName, remoteName);
    });
    return found == m_drives.end() ? nullptr : &*found;
}

const Drive* DriveTable::holding(std::string_view path) const noexcept {
    const Drive* best = nullptr;
    for (const Drive& drive : m_drives) {
        if (drive.letter && isBelow(path, drive.folder) && (!best || drive.folder.size() > best->folder.size())) {
            best = &drive;
        }
    }
    return best;
}

} // namespace tvx::win
