#include "tools/helpmapcheck/Installation.h"

#include "platform/base/SystemPath.h"
#include "platform/port/File.h"
#include "platform/port/TarvexPath.h"

#include <algorithm>
#include <filesystem>
#include <memory>
#include <system_error>
#include <utility>

namespace helpmap {

namespace {

namespace fs = std::filesystem;

std::vector<std::string> foldersIn(const std::string& path) {
    std::vector<std::string> names;
    std::error_code error;
    for (fs::directory_iterator entry(tvx::shownName(path), error), end; !error && entry != end;
         entry.increment(error)) {
        std::error_code unknown;
        if (entry->is_directory(unknown)) {
            names.push_back(entry->path().filename().string());
        }
    }
    return names;
}

} // namespace

Installation::Installation(std::vector<std::string> roots) : m_roots(std::move(roots)) {
    for (const std::string& root : m_roots) {
        std::ranges::copy(foldersIn(root + "/doc"), std::back_inserter(m_languages));
    }
    std::ranges::sort(m_languages);
    m_languages.erase(std::ranges::unique(m_languages).begin(), m_languages.end());
    std::ranges::stable_partition(m_languages, [](const std::string& name) { return name == "usenglish"; });
}

Installation Installation::fromEnvironment() {
    std::vector<std::string> roots;
    for (const Port::StringBase<char>& root : Port::TarvexPath::GetInstance()) {
        roots.push_back(root.str());
    }
    return Installation(std::move(roots));
}

std::string Installation::findMap(const std::string& name) const {
    return find("share/helpmap/" + name);
}

std::string Installation::findDocument(const std::string& language, const std::string& name) const {
    return find("doc/" + language + "/" + name);
}

std::string Installation::find(const std::string& relativeName) const {
    for (const std::string& root : m_roots) {
        std::string name = root;
        name.append("/").append(relativeName);
        if (Port::File::exist(name.c_str())) {
            return name;
        }
    }
    return {};
}

std::optional<std::string> readFile(const std::string& name) {
    const std::unique_ptr<Port::Stream, Port::File::Closer> stream(
        Port::File::open(name.c_str(), Port::File::AccessRead, Port::File::FlagText));
    return stream ? std::optional(stream->readall()) : std::nullopt;
}

} // namespace helpmap
