#include "platform/win/ResourceLibrary.h"

#include "platform/base/SystemPath.h"
#include "platform/win/Error.h"
#include "platform/win/Installation.h"
#include "platform/win/Locale.h"
#include "platform/win/Module.h"
#include "platform/win/ResourceConstants.h"
#include "platform/win/detail/CodeModule.h"
#include "platform/win/detail/ModuleTable.h"

#include <array>
#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <optional>
#include <string_view>
#include <vector>

namespace {

namespace fs = std::filesystem;
using tvx::detail::ModuleTable;

constexpr std::uintmax_t largest = 64U << 20;

bool isRegularFile(const std::string& path) {
    std::error_code error;
    return fs::is_regular_file(path, error);
}

bool isAbsolute(std::string_view name) {
    return name.starts_with('/') || name.starts_with('\\') || tvx::hasDrive(name);
}

void addFolderOf(std::vector<std::string>& folders, HMODULE module) {
    const fs::path file = tvx::moduleFileName(module);
    if (file.is_absolute()) {
        folders.push_back(file.parent_path());
    }
}

bool hasFolder(std::string_view name) {
    return name.find_first_of("/\\:") != std::string_view::npos;
}

std::vector<std::string> searchFolders(std::string_view name) {
    std::vector<std::string> folders;
    const std::string base(name.substr(0, name.rfind('.')));
    if (const HMODULE module = ModuleTable::instance().fromName(base)) {
        addFolderOf(folders, module);
    }
    addFolderOf(folders, nullptr);
    for (const std::string& root : tvx::installationRoots()) {
        folders.push_back(root + "/lib");
        folders.push_back(root + "/share/locale");
    }
    const char* variable = std::getenv("TVX_RESOURCE_PATH");
    for (std::string_view rest = variable ? variable : ""; !rest.empty();) {
        const std::size_t length = std::min(rest.find(':'), rest.size());
        folders.emplace_back(rest.substr(0, length));
        rest.remove_prefix(std::min(length + 1, rest.size()));
    }
    std::erase_if(folders, [](const std::string& folder) { return !isAbsolute(folder); });
    return folders;
}

// The system's name of the file that is meant.
std::optional<std::string> locate(std::string_view name) {
    if (hasFolder(name)) {
        return isAbsolute(name) ? tvx::systemPath(name) : std::nullopt;
    }
    for (const std::string& folder : searchFolders(name)) {
        auto path = tvx::systemPath(folder + '/' + std::string(name));
        if (path && isRegularFile(*path)) {
            return path;
        }
    }
    return std::nullopt;
}

/// The file's bytes; nothing, and the last error, when it cannot be read.
std::optional<std::vector<std::uint8_t>> read(const std::string& path) {
    std::error_code error;
    const std::uintmax_t size = fs::file_size(path, error);
    if (error || size > largest) {
        SetLastError(error ? tvx::errorFromErrno(error.value()) : ERROR_FILE_TOO_LARGE);
        return std::nullopt;
    }
    std::vector<std::uint8_t> bytes(size);
    errno = 0;
    std::ifstream file(path, std::ios::binary);
    if (!file.read(reinterpret_cast<char*>(bytes.data()), static_cast<std::streamsize>(size))) {
        tvx::setLastErrorFromErrno();
        return std::nullopt;
    }
    return bytes;
}

} // namespace

HMODULE LoadLibraryA(LPCSTR name) {
    if (!name || *name == '\0') {
        SetLastError(ERROR_INVALID_PARAMETER);
        return nullptr;
    }
    const bool meansCode = tvx::detail::meansCode(name);
    const auto path = meansCode ? tvx::detail::locateCode(name) : locate(name);
    if (!path || !isRegularFile(*path)) {
        SetLastError(ERROR_MOD_NOT_FOUND);
        return nullptr;
    }
    if (meansCode || (hasFolder(name) && tvx::detail::isCode(*path))) {
        return tvx::detail::loadCode(*path);
    }
    std::error_code error;
    const fs::path resolved = fs::canonical(*path, error);
    ModuleTable& table = ModuleTable::instance();
    if (const HMODULE loaded = table.useFile(resolved.string())) {
        return loaded;
    }
    auto bytes = read(resolved.string());
    if (!bytes) {
        return nullptr;
    }
    if (!tvx::detail::ResourceIndex(*bytes).damage().empty()) {
        SetLastError(ERROR_BAD_EXE_FORMAT);
        return nullptr;
    }
    return table.addFile(resolved.string(), std::move(*bytes));
}

BOOL FreeLibrary(HMODULE library) {
    if (library && ModuleTable::instance().release(library)) {
        return TRUE;
    }
    SetLastError(ERROR_INVALID_HANDLE);
    return FALSE;
}

namespace tvx {

HMODULE loadTranslation(HMODULE module) {
    const LCID locale = GetUserDefaultLCID();
    if (PRIMARYLANGID(LANGIDFROMLCID(locale)) == LANG_ENGLISH) {
        return nullptr;
    }
    std::array<char, 4> abbreviation{};
    GetLocaleInfoA(locale, LOCALE_SABBREVLANGNAME, abbreviation.data(), abbreviation.size());
    const fs::path file = plainModuleName(moduleFileName(module));
    return LoadLibraryA((file.filename().string() + '.' + abbreviation.data()).c_str());
}

} // namespace tvx
