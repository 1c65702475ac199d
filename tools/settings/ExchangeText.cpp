#include "tools/settings/ExchangeText.h"

#include "platform/base/Text.h"
#include "platform/base/WesternCodePage.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <optional>

namespace settings {

namespace {

struct Root {
    std::string_view longName;
    std::string_view shortName;
    std::uintptr_t number;
};

constexpr std::array<Root, 3> roots{{
    {"HKEY_CURRENT_USER", "HKCU", 0x80000001},
    {"HKEY_LOCAL_MACHINE", "HKLM", 0x80000002},
    {"HKEY_CLASSES_ROOT", "HKCR", 0x80000000},
}};

std::string fromWestern(std::string_view text) {
    std::string result;
    for (const char c : text) {
        tvx::text::append(result, tvx::text::westernCodePoint(static_cast<unsigned char>(c)));
    }
    return result;
}

/// Goes through a text line by line.
class Reader {
public:
    explicit Reader(std::string_view text) : m_rest(text) {}

    std::vector<Change> read() {
        if (!nextLine() || trimmed(m_line) != "REGEDIT4") {
            fail("the first line must be REGEDIT4");
        }
        while (nextLine()) {
            readLine();
        }
        return std::move(m_changes);
    }

private:
    bool nextLine() {
        if (m_rest.empty()) {
            return false;
        }
        const std::size_t end = std::min(m_rest.find('\n'), m_rest.size());
        m_line = m_rest.substr(0, end);
        m_rest.remove_prefix(std::min(end + 1, m_rest.size()));
        if (m_line.ends_with('\r')) {
            m_line.remove_suffix(1);
        }
        ++m_number;
        return true;
    }

    void readLine() {
        m_line = trimmed(m_line);
        m_first = m_number;
        if (m_line.empty() || m_line.starts_with(';')) {
            return;
        }
        if (m_line.starts_with('[')) {
            readKey();
        } else {
            readValue();
        }
    }

    void readKey() {
        if (!m_line.ends_with(']')) {
            fail("the ] of the key is missing");
        }
        std::string_view name = m_line.substr(1, m_line.size() - 2);
        const bool isDeleted = name.starts_with('-');
        name.remove_prefix(isDeleted ? 1 : 0);
        KeyName key;
        if (!readKeyName(name, key)) {
            fail("the key does not begin with a root such as HKEY_CURRENT_USER");
        }
        if (isDeleted && key.path.empty()) {
            fail("a root cannot be deleted");
        }
        m_changes.push_back({isDeleted ? Change::Kind::DeleteKey : Change::Kind::MakeKey, m_first, key, {}});
        m_key = isDeleted ? std::nullopt : std::optional(key);
    }

    void readValue() {
        if (!m_key) {
            fail(m_changes.empty() ? "a value stands before the first key" : "a value stands below a deleted key");
        }
        Setting setting;
        if (m_line.starts_with('@')) {
            m_line.remove_prefix(1);
        } else if (m_line.starts_with('"')) {
            setting.name = readQuoted();
        } else {
            fail("expected a key in brackets, a name in quotes or @");
        }
        m_line = trimmed(m_line);
        if (!m_line.starts_with('=')) {
            fail("expected = behind the name");
        }
        m_line = trimmed(m_line.substr(1));
        const bool isDeleted = m_line == "-";
        if (!isDeleted) {
            readData(setting);
        }
        m_changes.push_back(
            {isDeleted ? Change::Kind::DeleteValue : Change::Kind::SetValue, m_first, *m_key, std::move(setting)});
    }

    void readData(Setting& setting) {
        if (m_line.starts_with('"')) {
            setting.data = readQuoted() + '\0';
            expectEnd();
        } else if (accept("dword:")) {
            setting.type = REG_DWORD;
            const DWORD number = readHex(8, "expected up to eight hexadecimal digits behind dword:");
            expectEnd();
            for (unsigned shift = 0; shift < 32; shift += 8) {
                setting.data += static_cast<char>(number >> shift & 0xFF);
            }
        } else if (accept("hex:")) {
            setting.type = REG_BINARY;
            setting.data = readBytes();
        } else if (accept("hex(")) {
            setting.type = readHex(8, "expected a type in hexadecimal digits behind hex(");
            if (!accept("):")) {
                fail("expected ): behind the type");
            }
            setting.data = readBytes();
        } else {
            fail("expected a text in quotes, dword:, hex: or -");
        }
    }

    /// The text between the quotes; what follows is left in the line. A backslash at the end of a line joins the next
    /// one to it.
    std::string readQuoted() {
        std::string result;
        m_line.remove_prefix(1);
        while (!m_line.starts_with('"')) {
            if (m_line.empty()) {
                fail("a quote is not closed");
            }
            const char c = m_line.front();
            m_line.remove_prefix(1);
            if (c != '\\') {
                result += c;
            } else if (!m_line.empty()) {
                result += readEscape();
            } else if (!nextLine()) {
                fail("the text goes on behind the end of the file");
            }
        }
        m_line.remove_prefix(1);
        return result;
    }

    char readEscape() {
        const char c = m_line.front();
        m_line.remove_prefix(1);
        switch (c) {
        case '\\':
        case '"':
            return c;
        case 'n':
            return '\n';
        case 'r':
            return '\r';
        case 't':
            return '\t';
        case 'x':
            return static_cast<char>(readHex(2, "expected two hexadecimal digits behind \\x"));
        default:
            fail(std::string("unknown escape \\") + c);
        }
    }

    std::string readBytes() {
        std::string bytes;
        for (skipBreaks(); !m_line.empty(); skipBreaks()) {
            bytes += static_cast<char>(readHex(2, "expected bytes of two hexadecimal digits"));
            skipBreaks();
            if (!m_line.empty() && !accept(",")) {
                fail("expected a comma between the bytes");
            }
        }
        return bytes;
    }

    /// Passes white space and the ends of lines that go on.
    void skipBreaks() {
        m_line = trimmed(m_line);
        while (m_line == "\\") {
            if (!nextLine()) {
                fail("the bytes go on behind the end of the file");
            }
            m_line = trimmed(m_line);
        }
    }

    DWORD readHex(std::size_t most, const char* expected) {
        DWORD number = 0;
        const char* const end = m_line.data() + std::min(most, m_line.size());
        const auto [last, error] = std::from_chars(m_line.data(), end, number, 16);
        if (error != std::errc()) {
            fail(expected);
        }
        m_line.remove_prefix(static_cast<std::size_t>(last - m_line.data()));
        return number;
    }

    bool accept(std::string_view word) {
        const bool isThere = tvx::text::startsWithNoCase(m_line, word);
        m_line.remove_prefix(isThere ? word.size() : 0);
        return isThere;
    }

    void expectEnd() {
        if (!trimmed(m_line).empty()) {
            fail("nothing may follow the value");
        }
    }

    static std::string_view trimmed(std::string_view text) {
        const std::size_t first = std::min(text.find_first_not_of(" \t\v\f"), text.size());
        text.remove_prefix(first);
        return text.substr(0, text.find_last_not_of(" \t\v\f") + 1);
    }

    [[noreturn]] void fail(const std::string& message) const {
        throw TextFault{m_number, message};
    }

    std::string_view m_rest;
    std::string_view m_line;
    int m_number = 0;
    int m_first = 0; ///< where the line that goes on began
    std::optional<KeyName> m_key;
    std::vector<Change> m_changes;
};

} // namespace

bool readKeyName(std::string_view text, KeyName& key) {
    const std::string_view name = text.substr(0, text.find('\\'));
    const auto* root = std::ranges::find_if(roots, [&](const Root& candidate) {
        return tvx::text::equalNoCase(name, candidate.longName) || tvx::text::equalNoCase(name, candidate.shortName);
    });
    if (root == roots.end()) {
        return false;
    }
    key.root = reinterpret_cast<HKEY>(root->number);
    key.path = text.substr(std::min(name.size() + 1, text.size()));
    return true;
}

std::string writeKeyName(const KeyName& key) {
    const auto* root = std::ranges::find_if(
        roots, [&](const Root& candidate) { return reinterpret_cast<HKEY>(candidate.number) == key.root; });
    return std::string(root->longName) + (key.path.empty() ? "" : "\\" + key.path);
}

std::vector<Change> readExchangeText(std::string_view text) {
    constexpr std::string_view byteOrderMark = "\xEF\xBB\xBF";
    if (text.starts_with(byteOrderMark)) {
        text.remove_prefix(byteOrderMark.size());
    }
    if (text.find('\0') != std::string_view::npos) {
        throw TextFault{1, "this is no text in UTF-8: it holds zero bytes"};
    }
    if (tvx::text::isWellFormed(text)) {
        return Reader(text).read();
    }
    return Reader(fromWestern(text)).read();
}

} // namespace settings
