#include "platform/win/detail/CodeModule.h"

#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/win/Error.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/Installation.h"
#include "platform/win/Module.h"
#include "platform/win/detail/ModuleTable.h"

#include <dlfcn.h>

#include <array>
#include <filesystem>
#include <fstream>
#include <vector>

namespace tvx::detail {

namespace {

namespace fs = std::filesystem;

/// "plot" for "plot", "plot.dll", "plot.so" and "plot.": a point at the end means that there is no ending.
std::string_view stem(std::string_view name) {
    return name.substr(0, name.rfind('.'));
}

std::vector<fs::path> folders() {
    const fs::path layer = fs::path(moduleFileName(platformModule())).parent_path();
    std::vector<fs::path> found{layer / "tarvex", fs::path(moduleFileName(nullptr)).parent_path(), layer};
    for (const std::string& root : installationRoots()) {
        found.push_back(fs::path(root) / "lib");
    }
    std::erase_if(found, [](const fs::path& folder) { return !folder.is_absolute(); });
    return found;
}

} // namespace

bool meansCode(std::string_view name) {
    if (name.find_first_of("/\\:") != std::string_view::npos) {
        return false;
    }
    const std::string ending = text::toLower(name.substr(stem(name).size()));
    return ending.empty() || ending == "." || ending == ".dll" || ending == ".so";
}

std::optional<std::string> locateCode(std::string_view name) {
    const std::string file = std::string(stem(name)) + ".so";
    for (const fs::path& folder : folders()) {
        for (const std::string& written : {file, "lib" + file}) {
            const auto path = systemPath((folder / written).string());
            std::error_code error;
            if (path && fs::is_regular_file(*path, error)) {
                return path;
            }
        }
    }
    return std::nullopt;
}

bool isCode(const std::string& path) {
    std::array<char, 4> start{};
    std::ifstream(path, std::ios::binary).read(start.data(), start.size());
    return start == std::array{'\x7F', 'E', 'L', 'F'};
}

HMODULE loadCode(const std::string& path) {
    void* code = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (!code) {
        SetLastError(ERROR_BAD_EXE_FORMAT);
        return nullptr;
    }
    return ModuleTable::instance().useCode(code);
}

} // namespace tvx::detail
