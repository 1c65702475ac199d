#include "platform/win/detail/ProgramSearch.h"

#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/win/Error.h"
#include "platform/win/Module.h"

#include <cstdlib>
#include <filesystem>
#include <optional>
#include <unistd.h>

namespace tvx::win {

namespace {

namespace fs = std::filesystem;

constexpr std::string_view extension = ".exe";

/// Whether a file can be started, or else why not.
DWORD checkProgram(const std::string& file) {
    std::error_code error;
    const fs::file_status status = fs::status(file, error);
    if (status.type() == fs::file_type::regular) {
        return ::access(file.c_str(), X_OK) == 0 ? ERROR_SUCCESS : ERROR_ACCESS_DENIED;
    }
    if (error == std::errc::filename_too_long) {
        return ERROR_FILENAME_EXCED_RANGE;
    }
    if (status.type() != fs::file_type::not_found) {
        return ERROR_ACCESS_DENIED;
    }
    const fs::path folder = fs::path(file).parent_path();
    return folder.empty() || fs::is_directory(folder, error) ? ERROR_FILE_NOT_FOUND : ERROR_PATH_NOT_FOUND;
}

/// The name as it is, and without the extension that programs of the system do not have.
std::vector<std::string> spellings(const std::string& name) {
    std::vector<std::string> names{name};
    if (name.size() > extension.size() &&
        text::equalNoCase(std::string_view(name).substr(name.size() - extension.size()), extension)) {
        names.push_back(name.substr(0, name.size() - extension.size()));
    }
    return names;
}

std::string absolute(const std::string& file) {
    std::error_code error;
    const fs::path path = fs::absolute(file, error);
    return error ? file : path.string();
}

/// Entries of PATH that are empty or relative mean the current folder or are seen from it; they do not count.
std::vector<std::string> searchedFolders() {
    std::vector<std::string> folders{fs::path(moduleFileName(nullptr)).parent_path().string()};
    const char* variable = std::getenv("PATH");
    std::string_view path = variable ? variable : "/usr/local/bin:/usr/bin:/bin";
    for (std::size_t end = 0; end != std::string_view::npos; path.remove_prefix(std::min(end + 1, path.size()))) {
        end = path.find(':');
        if (path.starts_with('/')) {
            folders.emplace_back(path.substr(0, end));
        }
    }
    return folders;
}

/// Keeps the first file that can be started, and until then the reason worth most to the user.
void consider(Program& program, const std::string& file, const std::string& name) {
    const DWORD error = checkProgram(file);
    if (error == ERROR_SUCCESS) {
        program.file = absolute(file);
        program.name = name;
    } else if (program.error == ERROR_SUCCESS || error == ERROR_ACCESS_DENIED) {
        program.error = error;
    }
}

void findByPath(Program& program, const std::string& name) {
    for (const std::string& spelling : spellings(name)) {
        const std::optional<std::string> file = systemPath(spelling);
        if (program.file.empty() && file) {
            consider(program, *file, *file);
        }
    }
    if (program.file.empty() && program.error == ERROR_SUCCESS) {
        program.error = ERROR_PATH_NOT_FOUND; // an unknown drive or share
    }
}

void findByName(Program& program, const std::string& name) {
    for (const std::string& folder : searchedFolders()) {
        for (const std::string& spelling : spellings(name)) {
            consider(program, (fs::path(folder) / spelling).string(), spelling);
            if (!program.file.empty()) {
                return;
            }
        }
    }
    // Folders of PATH that are missing say nothing about the program.
    if (program.error == ERROR_PATH_NOT_FOUND) {
        program.error = ERROR_FILE_NOT_FOUND;
    }
}

} // namespace

Program findProgram(std::string_view commandLine) {
    Program program;
    for (const CommandLine& reading : readings(commandLine)) {
        const std::string name(reading.program);
        program.arguments = reading.arguments;
        if (name.find_first_of("\\/") != std::string::npos || hasDrive(name)) {
            findByPath(program, name);
        } else if (!name.empty()) {
            findByName(program, name);
        }
        if (!program.file.empty()) {
            return program;
        }
    }
    if (program.error == ERROR_SUCCESS) {
        program.error = ERROR_FILE_NOT_FOUND;
    }
    return program;
}

} // namespace tvx::win
