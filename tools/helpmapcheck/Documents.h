#pragma once

#include "tools/helpmapcheck/Installation.h"

#include <string>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace helpmap {

/// The documents that a map names, as far as they are installed. Each is looked at once, however often it is named.
class Documents {
public:
    /// What is wrong with a document.
    struct Fault {
        const char* kind;
        std::string text;
    };

    /// @param besideMap the folder of the map, where documents are looked for at last; ends in "/"
    Documents(const Installation& installation, std::string besideMap);

    /// What is wrong with a document under the name that a map gives it: where it is missing, and where it does not
    /// have the place behind "#".
    [[nodiscard]] std::vector<Fault> faultsOf(const std::string& name);

private:
    /// The language and the file that its users get.
    struct Copy {
        std::string language;
        std::string path;
    };

    const std::vector<Copy>& copiesOf(const std::string& document);
    const std::unordered_set<std::string>& anchorsIn(const std::string& path);
    void addMissing(const std::string& document, std::vector<Fault>& faults);
    void addAnchors(const std::string& document, const std::string& anchor, std::vector<Fault>& faults);

    const Installation& m_installation;
    std::string m_besideMap;
    std::unordered_map<std::string, std::vector<Copy>> m_copies;
    std::unordered_map<std::string, std::unordered_set<std::string>> m_anchors;
};

} // namespace helpmap
