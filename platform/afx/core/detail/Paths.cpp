#include "platform/afx/core/detail/Paths.h"

#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/win/Files.h"

#include <filesystem>
#include <string_view>

namespace tvx::afx {

namespace {

namespace fs = std::filesystem;

std::size_t lastPartAt(std::string_view path) {
    const std::size_t at = path.find_last_of("/\\");
    if (at != std::string_view::npos) {
        return at + 1;
    }
    return hasDrive(path) ? 2 : 0;
}

CString make(std::string_view text) {
    return CString(text.data(), static_cast<int>(text.size()));
}

fs::path canonical(LPCSTR path) {
    std::error_code error;
    const fs::path named = systemPath(path).value_or(path);
    const fs::path result = fs::weakly_canonical(named, error);
    return error ? named : result;
}

} // namespace

CString lastPart(LPCSTR path) {
    const std::string_view text(path);
    return make(text.substr(lastPartAt(text)));
}

CString extensionOf(LPCSTR path) {
    const std::string_view text(path);
    const std::size_t dot = text.rfind('.');
    return dot != std::string_view::npos && dot >= lastPartAt(text) ? make(text.substr(dot)) : CString();
}

CString withoutExtension(const CString& name) {
    return name.Left(name.GetLength() - extensionOf(name).GetLength());
}

CString fullPath(LPCSTR path) {
    return make(fullName(path));
}

CString spelledPath(LPCSTR path) {
    const std::string full = fullName(path);
    const auto found = systemPath(full);
    return found ? make(driveName(*found)) : make(full);
}

CString realPath(LPCSTR path) {
    return make(driveName(canonical(path).string()));
}

bool sameFile(LPCSTR first, LPCSTR second) {
    return *first != '\0' && *second != '\0' && canonical(first) == canonical(second);
}

} // namespace tvx::afx
