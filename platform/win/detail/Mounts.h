#pragma once

/// @file
/// The mounts of the process, as the kernel lists them.

#include <map>
#include <string>
#include <string_view>

namespace tvx::win {

/// What a line of mountinfo tells (proc(5)).
struct Mount {
    std::string point;
    std::string fileSystem;
    std::string source;
};

/// Takes the first of the fields that single characters separate.
std::string_view takeField(std::string_view& text, char separator);
/// Of "/" nothing is taken.
[[nodiscard]] std::string_view withoutEndSlashes(std::string_view folder);
/// Whether a path is a folder or lies below it.
[[nodiscard]] bool isBelow(std::string_view path, std::string_view folder);

/// The mounts that can be reached, by mount point: of several on one point the last one lies on top.
[[nodiscard]] std::map<std::string, Mount> parseMounts(std::string_view mountInfo);
/// Whether the source of a file system names a server and a folder of it: "server:/folder", "user@server:folder",
/// "//server/share" or "https://server/folder".
[[nodiscard]] bool isNetwork(std::string_view fileSystem);

/// The mounts at one moment. To look at them asks no file system.
class Mounts {
public:
    static Mounts current();

    /// Where the mount of an absolute path is, links in it not followed.
    [[nodiscard]] std::string pointOf(std::string_view path) const;
    /// Whether asking about that path may wait for somebody: another machine, a program, or something that is mounted
    /// only when it is asked for.
    [[nodiscard]] bool isFar(std::string_view path) const;

private:
    std::map<std::string, Mount> m_mounts;
};

} // namespace tvx::win
