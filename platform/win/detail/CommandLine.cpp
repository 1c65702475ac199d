#include "platform/win/detail/CommandLine.h"

#include "platform/base/Address.h"
#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"

#include <algorithm>
#include <climits>
#include <filesystem>
#include <optional>

namespace tvx::win {

namespace {

constexpr std::string_view blanks = " \t";

bool isBlank(char character) {
    return blanks.find(character) != std::string_view::npos;
}

bool hasFolder(std::string_view name) {
    return name.find_first_of("\\/") != std::string_view::npos || hasDrive(name);
}

/// Reads words one after the other.
class WordReader {
public:
    explicit WordReader(std::string_view text) : m_text(text) {}

    /// False at the end.
    bool next(std::string& word) {
        m_at = std::min(m_text.find_first_not_of(blanks, m_at), m_text.size());
        word.clear();
        bool quoted = false;
        const bool found = m_at < m_text.size();
        while (m_at < m_text.size() && (quoted || !isBlank(m_text[m_at]))) {
            take(word, quoted);
        }
        return found;
    }

private:
    void take(std::string& word, bool& quoted) {
        const std::size_t slashes = std::min(m_text.find_first_not_of('\\', m_at), m_text.size()) - m_at;
        const bool beforeQuote = m_at + slashes < m_text.size() && m_text[m_at + slashes] == '"';
        word.append(beforeQuote ? slashes / 2 : slashes, '\\');
        m_at += slashes;
        if (beforeQuote) {
            takeQuote(word, quoted, slashes % 2 != 0);
        } else if (slashes == 0) {
            word += m_text[m_at++];
        }
    }

    void takeQuote(std::string& word, bool& quoted, bool ordinary) {
        const bool twice = quoted && !ordinary && m_text.substr(m_at + 1).starts_with('"');
        if (ordinary || twice) {
            word += '"';
        } else {
            quoted = !quoted;
        }
        m_at += twice ? 2 : 1;
    }

    std::string_view m_text;
    std::size_t m_at = 0;
};

bool isAbsolute(std::string_view name) {
    return name.starts_with("\\\\") || (hasDrive(name) && name.size() > 2 && (name[2] == '\\' || name[2] == '/'));
}

/// The name in a file address of the platform, "C:\a" for "file:///C|\a".
std::optional<std::string> nameInAddress(const std::string& word) {
    if (!isFileAddress(word)) {
        return std::nullopt;
    }
    std::string name = word.substr(5);
    if (name.starts_with("///")) {
        name.erase(0, 3);
    }
    if (name.size() > 2 && name[1] == '|') {
        name[1] = ':';
    }
    return isAbsolute(name) ? std::optional(name) : std::nullopt;
}

std::string addressOf(std::string_view path, std::string_view rest) {
    return "file://" + encodeAddress(path) + std::string(rest);
}

/// Addresses come with their characters as they are, from this family, or coded, from elsewhere; a file that exists
/// tells which. Only the latter have a place within the document behind "#".
std::string addressForChild(const std::string& name, const std::string& word) {
    std::error_code error;
    const std::optional<std::string> plain = systemPath(name);
    if (!plain || std::filesystem::exists(*plain, error)) {
        return plain ? addressOf(*plain, {}) : word;
    }
    const std::size_t place = std::min(name.find_first_of("?#"), name.size());
    const std::optional<std::string> path = systemPath(decodeAddress(std::string_view(name).substr(0, place)));
    return path ? addressOf(*path, std::string_view(name).substr(place)) : word;
}

} // namespace

std::vector<CommandLine> readings(std::string_view line) {
    line.remove_prefix(std::min(line.find_first_not_of(blanks), line.size()));
    if (line.starts_with('"')) {
        const std::size_t end = std::min(line.find('"', 1), line.size());
        return {{line.substr(1, end - 1), line.substr(std::min(end + 1, line.size()))}};
    }
    std::vector<CommandLine> found;
    for (std::size_t end = 0; end < line.size() && end < PATH_MAX;) {
        end = std::min(line.find_first_of(blanks, end), line.size());
        found.push_back({line.substr(0, end), line.substr(end)});
        if (!hasFolder(found.front().program)) {
            break;
        }
        end = std::min(line.find_first_not_of(blanks, end), line.size());
    }
    return found;
}

std::vector<std::string> splitArguments(std::string_view arguments) {
    std::vector<std::string> words;
    WordReader reader(arguments);
    for (std::string word; reader.next(word);) {
        words.push_back(word);
    }
    return words;
}

std::string wordForChild(const std::string& word) {
    if (isAbsolute(word)) {
        return systemPath(word).value_or(word);
    }
    const std::optional<std::string> name = nameInAddress(word);
    return name ? addressForChild(*name, word) : word;
}

} // namespace tvx::win
