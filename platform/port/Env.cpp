#include "platform/port/Env.h"

#include "platform/port/File.h"
#include "platform/port/TarvexPath.h"
#include "platform/port/detail/DocumentFolder.h"

#include <cstdlib>
#include <string>
#include <string_view>

namespace {

/// The first file of that name below a root; empty when there is none.
std::string firstBelowRoots(std::string_view relativeName) {
    for (const Port::StringBase<char>& root : Port::TarvexPath::GetInstance()) {
        std::string name = root.str() + "/";
        name += relativeName;
        if (Port::File::exist(name.c_str())) {
            return name;
        }
    }
    return {};
}

const char* orNull(const std::string& name) {
    return name.empty() ? nullptr : name.c_str();
}

std::string dataFile(std::string_view folder, const char* name) {
    return name ? firstBelowRoots("share/" + std::string(folder) + name) : std::string();
}

std::string document(std::string name) {
    if (name.find('.', name.find_last_of("/\\") + 1) == std::string::npos) {
        name += ".pdf";
    }
    std::string found = firstBelowRoots("doc/" + std::string(Port_Env::GetLang()) + "/" + name);
    return found.empty() ? firstBelowRoots("doc/usenglish/" + name) : found;
}

} // namespace

const char* Port_Env::GetEnv(const char* name) {
    return name ? std::getenv(name) : nullptr;
}

const char* Port_Env::GetLang() {
    return Port::detail::documentFolder(GetUserDefaultLCID());
}

const char* Port_Env::GetDataFileName(const char* relativeName, int) {
    static std::string found;
    found = dataFile("", relativeName);
    return orNull(found);
}

const char* Port_Env::GetDocFileName(const char* name, int) {
    static std::string found;
    found = name ? document(name) : std::string();
    return orNull(found);
}

const char* Port_Env::GetHelpFileName(const char* name, int) {
    static std::string found;
    found = dataFile("help/", name);
    return orNull(found);
}
