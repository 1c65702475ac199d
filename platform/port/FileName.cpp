#include "platform/port/FileName.h"

#include "platform/base/SystemPath.h"

#include <filesystem>
#include <optional>
#include <string>
#include <system_error>

namespace Port {

FileName::FileName(const StringBase<char>& name) : m_name(name) {}

StringBase<char> FileName::Normalize(bool followLinks) const {
    namespace fs = std::filesystem;
    const std::optional<std::string> path = tvx::systemPath(m_name.str());
    if (!path) {
        return m_name;
    }
    std::error_code error;
    const fs::path whole = followLinks ? fs::weakly_canonical(*path, error) : fs::absolute(*path, error);
    return error ? m_name : StringBase<char>(whole.lexically_normal().string());
}

} // namespace Port
