#pragma once

#include <optional>
#include <string>
#include <vector>

namespace helpmap {

/// The roots of an installation and what lies below them.
class Installation {
public:
    explicit Installation(std::vector<std::string> roots);
    /// The one that the environment names.
    static Installation fromEnvironment();

    /// The full name of an installed map, such as "board.map"; empty when there is none.
    [[nodiscard]] std::string findMap(const std::string& name) const;
    /// The full name of a document in a language; empty when it is not there.
    [[nodiscard]] std::string findDocument(const std::string& language, const std::string& name) const;
    /// The folders below "doc" of all roots, American English first if it is one of them.
    [[nodiscard]] const std::vector<std::string>& languages() const {
        return m_languages;
    }

private:
    [[nodiscard]] std::string find(const std::string& relativeName) const;

    std::vector<std::string> m_roots;
    std::vector<std::string> m_languages;
};

/// All that is in a file; nothing when it cannot be read.
[[nodiscard]] std::optional<std::string> readFile(const std::string& name);

} // namespace helpmap
