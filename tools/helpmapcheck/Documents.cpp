#include "tools/helpmapcheck/Documents.h"

#include "platform/base/Text.h"
#include "platform/port/File.h"
#include "tools/helpmapcheck/Page.h"

#include <algorithm>
#include <string_view>
#include <utility>

namespace helpmap {

namespace {

bool isPage(std::string_view name) {
    const std::string_view extension = name.substr(std::min(name.rfind('.'), name.size()));
    return std::ranges::any_of(std::vector<std::string_view>{".htm", ".html", ".xhtml"},
                               [&](std::string_view each) { return tvx::text::equalNoCase(each, extension); });
}

} // namespace

Documents::Documents(const Installation& installation, std::string besideMap)
    : m_installation(installation), m_besideMap(std::move(besideMap)) {}

std::vector<Documents::Fault> Documents::faultsOf(const std::string& name) {
    const std::string document = name.substr(0, name.find('#'));
    const std::size_t anchorStart = name.rfind('#');
    std::vector<Fault> faults;
    addMissing(document, faults);
    if (anchorStart != std::string::npos && isPage(document)) {
        addAnchors(document, name.substr(anchorStart + 1), faults);
    }
    return faults;
}

void Documents::addMissing(const std::string& document, std::vector<Fault>& faults) {
    const std::vector<Copy>& copies = copiesOf(document);
    if (copies.empty()) {
        faults.push_back({"missing", document + " is not installed, it will be looked for on the web"});
        return;
    }
    for (const std::string& language : m_installation.languages()) {
        if (copies.front().language.empty() || std::ranges::find(copies, language, &Copy::language) != copies.end()) {
            continue;
        }
        // Without the American one, users of other languages than those that have it get none.
        const bool isFallback = language == "usenglish";
        std::string text = document;
        text.append(" is not in ").append(language);
        faults.push_back({isFallback ? "missing" : "untranslated", std::move(text)});
    }
}

void Documents::addAnchors(const std::string& document, const std::string& anchor, std::vector<Fault>& faults) {
    for (const Copy& copy : copiesOf(document)) {
        if (!anchor.empty() && !anchorsIn(copy.path).contains(anchor)) {
            faults.push_back({"anchor", copy.path + " has no \"" + anchor + "\""});
        }
    }
}

/// The copies in all languages; one without language where only the map's folder has it.
const std::vector<Documents::Copy>& Documents::copiesOf(const std::string& document) {
    const auto [place, isNew] = m_copies.try_emplace(document);
    std::vector<Copy>& copies = place->second;
    if (!isNew || document.empty()) {
        return copies;
    }
    for (const std::string& language : m_installation.languages()) {
        if (std::string path = m_installation.findDocument(language, document); !path.empty()) {
            copies.push_back({language, std::move(path)});
        }
    }
    if (std::string path = m_besideMap + document; copies.empty() && Port::File::canread(path.c_str())) {
        copies.push_back({{}, std::move(path)});
    }
    return copies;
}

const std::unordered_set<std::string>& Documents::anchorsIn(const std::string& path) {
    const auto [place, isNew] = m_anchors.try_emplace(path);
    if (isNew) {
        place->second = anchorsOf(readFile(path).value_or(std::string()));
    }
    return place->second;
}

} // namespace helpmap
