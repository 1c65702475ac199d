#include "tools/open/ForwardPage.h"

#include "tools/open/Call.h"

#include <cerrno>
#include <chrono>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

namespace opening {

namespace {

namespace fs = std::filesystem;

fs::path variable(const char* name) {
    const char* value = std::getenv(name);
    return value ? value : "";
}

/// The session's own folder, which ends with it, else the user's folder for what can be made again.
fs::path parentFolder() {
    for (const char* name : {"XDG_RUNTIME_DIR", "XDG_CACHE_HOME"}) {
        if (const fs::path folder = variable(name); folder.is_absolute()) {
            return folder;
        }
    }
    return variable("HOME") / ".cache";
}

/// A folder of this name that another user has made, or can look into, is not used.
fs::path ownFolder() {
    fs::path folder = parentFolder() / "tvxopen";
    std::error_code error;
    fs::create_directories(folder.parent_path(), error);
    ::mkdir(folder.c_str(), 0700);
    struct stat status{};
    const bool isOwn = ::lstat(folder.c_str(), &status) == 0 && S_ISDIR(status.st_mode) &&
                       status.st_uid == ::geteuid() && (status.st_mode & 077) == 0;
    if (!isOwn) {
        throw Failure{folder.string() + " is no folder of the user's alone"};
    }
    return folder;
}

void removeOld(const fs::path& folder) {
    const auto yesterday = fs::file_time_type::clock::now() - std::chrono::hours(24);
    std::error_code error;
    for (const fs::directory_entry& entry : fs::directory_iterator(folder, error)) {
        if (entry.last_write_time(error) < yesterday && !error) {
            fs::remove(entry.path(), error);
        }
    }
}

std::string inMarkup(std::string_view text) {
    std::string result;
    for (const char character : text) {
        if (character == '&' || character == '"' || character == '\'' || character == '<' || character == '>') {
            result += "&#" + std::to_string(static_cast<int>(character)) + ";";
        } else {
            result += character;
        }
    }
    return result;
}

std::string pageFor(const std::string& address) {
    const std::string target = inMarkup(address);
    return "<!DOCTYPE html>\n<html><head><meta charset=\"utf-8\"><meta http-equiv=\"refresh\" content=\"0; url=" +
           target + "\">\n<title>" + target + "</title></head>\n<body><a href=\"" + target + "\">" + target +
           "</a></body></html>\n";
}

} // namespace

std::string makeForwardPage(const std::string& address) {
    const fs::path folder = ownFolder();
    removeOld(folder);
    constexpr std::string_view extension = ".html";
    std::string file = (folder / "XXXXXX").string() + std::string(extension);
    const int descriptor = ::mkstemps(file.data(), static_cast<int>(extension.size()));
    const std::string page = pageFor(address);
    const bool isWritten =
        descriptor >= 0 && ::write(descriptor, page.data(), page.size()) == static_cast<ssize_t>(page.size());
    if ((descriptor >= 0 && ::close(descriptor) != 0) || !isWritten) {
        throw Failure{file + ": " + std::strerror(errno)};
    }
    return file;
}

} // namespace opening
