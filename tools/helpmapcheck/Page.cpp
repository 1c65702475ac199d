#include "tools/helpmapcheck/Page.h"

#include "platform/base/Text.h"

#include <algorithm>

namespace helpmap {

namespace {

constexpr std::string_view space = " \t\r\n\f";

/// Goes through the attributes of one element.
class Attributes {
public:
    /// @param text from behind the element's name on
    explicit Attributes(std::string_view text) : m_text(text) {}

    struct Attribute {
        std::string_view name;
        std::string_view value;
    };
    /// @return false at the end of the element
    bool next(Attribute& attribute) {
        m_text.remove_prefix(std::min(m_text.find_first_not_of(" \t\r\n\f/"), m_text.size()));
        if (m_text.empty() || m_text.front() == '>') {
            return false;
        }
        // One byte at least, so that a stray "=" is passed over.
        attribute = {take(std::max<std::size_t>(m_text.find_first_of(" \t\r\n\f/>=", 1), 1)), {}};
        skipSpace();
        if (m_text.starts_with('=')) {
            m_text.remove_prefix(1);
            skipSpace();
            attribute.value = takeValue();
        }
        return true;
    }
    [[nodiscard]] std::string_view rest() const {
        return m_text;
    }

private:
    void skipSpace() {
        m_text.remove_prefix(std::min(m_text.find_first_not_of(space), m_text.size()));
    }
    std::string_view take(std::size_t length) {
        const std::string_view taken = m_text.substr(0, length);
        m_text.remove_prefix(taken.size());
        return taken;
    }
    std::string_view takeValue() {
        const char quote = m_text.empty() ? '\0' : m_text.front();
        if (quote != '"' && quote != '\'') {
            return take(m_text.find_first_of(" \t\r\n\f>"));
        }
        m_text.remove_prefix(1);
        const std::string_view value = take(m_text.find(quote));
        take(1);
        return value;
    }

    std::string_view m_text;
};

/// What follows an end mark; empty when there is none.
std::string_view behind(std::string_view text, std::string_view mark) {
    const std::size_t at = text.find(mark);
    return at == std::string_view::npos ? std::string_view() : text.substr(at + mark.size());
}

bool isLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

} // namespace

std::unordered_set<std::string> anchorsOf(std::string_view page) {
    std::unordered_set<std::string> anchors;
    for (page = behind(page, "<"); !page.empty(); page = behind(page, "<")) {
        if (page.starts_with("!--")) {
            page = behind(page.substr(3), "-->");
            continue;
        }
        if (!isLetter(page.front())) {
            continue;
        }
        Attributes attributes(page.substr(std::min(page.find_first_of(" \t\r\n\f/>"), page.size())));
        for (Attributes::Attribute attribute; attributes.next(attribute);) {
            if (tvx::text::equalNoCase(attribute.name, "id") || tvx::text::equalNoCase(attribute.name, "name")) {
                anchors.emplace(attribute.value);
            }
        }
        page = attributes.rest();
    }
    return anchors;
}

} // namespace helpmap
