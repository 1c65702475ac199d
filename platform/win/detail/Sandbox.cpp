#include "platform/win/detail/Sandbox.h"

#include <algorithm>
#include <array>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <optional>
#include <sstream>
#include <string_view>

namespace tvx::win {

namespace {

namespace fs = std::filesystem;

/// More links than this lead in circles.
constexpr int mostLinks = 40;
/// A start script is shorter.
constexpr std::size_t longestScript = 16 * 1024;

/// A program's file and all that it is a link to. The system's own name for a snap's program is a link to one program
/// that starts them all, so what counts is met on the way and not at its end.
std::vector<fs::path> steps(const fs::path& file) {
    std::vector<fs::path> found{file};
    std::error_code error;
    for (int count = 0; count < mostLinks && fs::is_symlink(found.back(), error); ++count) {
        const fs::path target = fs::read_symlink(found.back(), error);
        const fs::path folder =
            fs::weakly_canonical(found.back().parent_path(), error); // "..", seen from a linked folder
        found.push_back((folder / target).lexically_normal());
    }
    return found;
}

bool endsWith(const fs::path& folder, std::string_view end) {
    return folder.string().ends_with(end);
}

/// Name of a program of the sandboxes by the folder that it is started from.
Sandbox byFolder(const fs::path& file) {
    const std::string name = file.filename().string();
    if (endsWith(file.parent_path(), "/snap/bin")) {
        return {SandboxKind::Snap, name.substr(0, name.find('.'))};
    }
    if (endsWith(file.parent_path(), "/flatpak/exports/bin")) {
        return {SandboxKind::Flatpak, name};
    }
    return {};
}

/// "flatpak run --command=x org.name @@u file @@": the first word behind "run" that is no option is the application.
Sandbox byFlatpakCall(const std::vector<std::string>& words) {
    const auto run = std::ranges::find(words, "run");
    const auto application = std::find_if(run == words.end() ? run : run + 1, words.end(),
                                          [](const auto& word) { return !word.starts_with('-'); });
    if (application == words.end()) {
        return {};
    }
    const bool forwards = std::ranges::find_if(application, words.end(),
                                               [](const auto& word) { return word.starts_with("@@"); }) != words.end();
    return {SandboxKind::Flatpak, *application, forwards};
}

/// What a start script that a distribution left in the place of a program hands over to.
Sandbox byScript(const fs::path& file) {
    std::ifstream stream(file, std::ios::binary);
    std::string text(longestScript, '\0');
    stream.read(text.data(), static_cast<std::streamsize>(text.size()));
    text.resize(static_cast<std::size_t>(stream.gcount()));
    std::istringstream lines(text.starts_with("#!") ? text : std::string());
    for (std::string line; std::getline(lines, line);) {
        std::istringstream stream_of_words(line);
        const std::vector<std::string> words(std::istream_iterator<std::string>(stream_of_words), {});
        if (words.size() < 2 || words[0] != "exec") {
            continue;
        }
        Sandbox found = byFolder(words[1]);
        if (found.kind == SandboxKind::None && fs::path(words[1]).filename() == "flatpak") {
            found = byFlatpakCall(words);
        }
        if (found.kind != SandboxKind::None) {
            return found;
        }
    }
    return {};
}

/// Whether a file lies in a folder; the folder's own name counts.
bool isWithin(const fs::path& file, const fs::path& folder) {
    const auto [end, other] = std::ranges::mismatch(folder, file);
    return end == folder.end() || (end->empty() && std::next(end) == folder.end());
}

bool isWithinAny(const fs::path& file, std::initializer_list<const char*> folders) {
    return std::ranges::any_of(folders, [&](const char* folder) { return isWithin(file, folder); });
}

fs::path variable(const char* name) {
    const char* value = std::getenv(name);
    return value ? value : "";
}

fs::path home() {
    std::error_code error;
    const fs::path folder = fs::weakly_canonical(variable("HOME"), error);
    return error ? variable("HOME") : folder;
}

/// What of a file's name stands behind the user's home; nothing when it does not lie there.
std::optional<fs::path> withinHome(const fs::path& file) {
    const fs::path folder = home();
    return !folder.empty() && isWithin(file, folder) ? std::optional(file.lexically_relative(folder)) : std::nullopt;
}

bool isClassicSnap(const std::string& name) {
    std::ifstream description("/snap/" + name + "/current/meta/snap.yaml");
    for (std::string line; std::getline(description, line);) {
        if (line.starts_with("confinement:")) {
            return line.find("classic") != std::string::npos;
        }
    }
    return false;
}

bool snapReads(const Sandbox& sandbox, const fs::path& file) {
    if (const auto name = withinHome(file)) {
        return !name->begin()->string().starts_with('.') || isClassicSnap(sandbox.application);
    }
    return isWithinAny(file, {"/usr/share/doc", "/media", "/mnt", "/run/media"}) || isClassicSnap(sandbox.application);
}

/// The values of "filesystems" in the section "Context" of a flatpak's metadata or of what the user has changed of it.
std::vector<std::string> fileSystems(const fs::path& metadata) {
    std::vector<std::string> values;
    std::ifstream stream(metadata);
    bool isContext = false;
    for (std::string line; std::getline(stream, line);) {
        constexpr std::string_view key = "filesystems=";
        if (line.starts_with('[')) {
            isContext = line == "[Context]";
        } else if (isContext && line.starts_with(key)) {
            std::istringstream list(line.substr(key.size()));
            for (std::string value; std::getline(list, value, ';');) {
                values.push_back(value);
            }
        }
    }
    return values;
}

/// Where the permissions of a flatpak stand, those that count more behind those that count less.
std::vector<fs::path> permissionFiles(const std::string& application) {
    fs::path own = variable("FLATPAK_USER_DIR");
    if (own.empty()) {
        const fs::path data = variable("XDG_DATA_HOME");
        own = (data.empty() ? variable("HOME") / ".local/share" : data) / "flatpak";
    }
    fs::path shared = variable("FLATPAK_SYSTEM_DIR");
    if (shared.empty()) {
        shared = "/var/lib/flatpak";
    }
    std::vector<fs::path> files;
    for (const fs::path& installation : {shared, own}) {
        files.push_back(installation / "app" / application / "current/active/metadata");
    }
    for (const fs::path& installation : {shared, own}) {
        files.push_back(installation / "overrides/global");
        files.push_back(installation / "overrides" / application);
    }
    return files;
}

/// Folders that a flatpak has of its own under these names, whatever it may see of the host's.
bool isReplaced(const fs::path& file) {
    return isWithinAny(file, {"/app", "/bin", "/boot", "/dev", "/efi", "/etc", "/lib", "/lib32", "/lib64", "/proc",
                              "/root", "/sbin", "/sys", "/usr", "/var"}) ||
           (isWithin(file, "/run") && !isWithin(file, "/run/media"));
}

/// Whether a permission such as "host", "home:ro", "~/Documents" or "/opt" covers a file.
bool permits(std::string permission, const fs::path& file) {
    permission = permission.substr(0, permission.rfind(':'));
    const std::optional<fs::path> own = withinHome(file);
    if (permission == "host") {
        return !isWithin(file, "/tmp");
    }
    if (permission == "home") {
        return own.has_value();
    }
    if (permission.starts_with("~/")) {
        return own && isWithin(*own, permission.substr(2));
    }
    return permission.starts_with('/') && isWithin(file, permission);
}

bool flatpakReads(const Sandbox& sandbox, const fs::path& file) {
    bool reads = false;
    for (const fs::path& metadata : permissionFiles(sandbox.application)) {
        for (const std::string& permission : fileSystems(metadata)) {
            const bool isTaken = permission.starts_with('!');
            reads = permits(permission.substr(isTaken ? 1 : 0), file) ? !isTaken : reads;
        }
    }
    return reads;
}

} // namespace

Sandbox sandboxOf(const std::vector<std::string>& words) {
    const std::vector<fs::path> files = steps(words.front());
    for (const fs::path& file : files) {
        if (const Sandbox found = byFolder(file); found.kind != SandboxKind::None) {
            return found;
        }
        if (file.filename() == "flatpak") {
            return byFlatpakCall(words);
        }
    }
    return byScript(files.back());
}

bool canRead(const Sandbox& sandbox, const fs::path& file) {
    switch (sandbox.kind) {
    case SandboxKind::None:
        return true;
    case SandboxKind::Snap:
        return snapReads(sandbox, file);
    case SandboxKind::Flatpak:
        break;
    }
    const std::string extension = file.extension().string();
    const bool standsAlone = extension != ".htm" && extension != ".html";
    return !isReplaced(file) && (flatpakReads(sandbox, file) || (sandbox.forwards && standsAlone));
}

} // namespace tvx::win
