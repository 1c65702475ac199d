#include "s/String.h"

#include "platform/base/Text.h"
#include "s/Record.h"

#include <array>
#include <memory>
#include <string>
#include <string_view>

namespace {

bool isQuote(char character) {
    return character == '"' || character == '\'';
}

/// A set of characters in UTF-8.
class CharacterSet {
public:
    explicit CharacterSet(std::string characters) : m_characters(std::move(characters)) {
        for (std::size_t at = 0; at < m_characters.size(); at += tvx::text::characterLength(m_characters, at)) {
            m_isLead[static_cast<unsigned char>(m_characters[at])] = true;
        }
    }

    /// Bytes of the character of the set that stands at `at`, 0 when another one does.
    std::size_t match(std::string_view text, std::size_t at) const {
        if (at >= text.size() || !m_isLead[static_cast<unsigned char>(text[at])]) {
            return 0;
        }
        return static_cast<unsigned char>(text[at]) < 0x80 ? 1 : matchSequence(text, at);
    }

    /// Where the first character of the set stands from `at` on; the text's length when there is none.
    std::size_t find(std::string_view text, std::size_t at) const {
        while (at < text.size() && match(text, at) == 0) {
            ++at;
        }
        return at;
    }

private:
    std::size_t matchSequence(std::string_view text, std::size_t at) const {
        const std::string_view character = text.substr(at, tvx::text::characterLength(text, at));
        if (tvx::text::characterStart(text, at) != at) {
            return 0;
        }
        for (std::size_t own = 0; own < m_characters.size();) {
            const std::size_t length = tvx::text::characterLength(m_characters, own);
            if (std::string_view(m_characters).substr(own, length) == character) {
                return length;
            }
            own += length;
        }
        return 0;
    }

    std::string m_characters;
    std::array<bool, 256> m_isLead{};
};

void add(CStringArray& fields, std::string_view field) {
    fields.Add(CString(field));
}

/// Adds the quoted field whose opening quote stands at `at`.
/// @return where the text goes on behind it
std::size_t addQuoted(CStringArray& fields, std::string_view text, std::size_t at) {
    const std::size_t closing = text.find(text[at], at + 1);
    const std::size_t end = closing == std::string_view::npos ? text.size() : closing + 1;
    add(fields, text.substr(at, end - at));
    return end;
}

} // namespace

Gui_String::Gui_String() = default;
Gui_String::Gui_String(const CString& text) : CString(text) {}
Gui_String::Gui_String(const Gui_String& text) = default;
Gui_String::Gui_String(char ch, int repeat) : CString(ch, repeat) {}
Gui_String::Gui_String(const char* text) : CString(text) {}
Gui_String::Gui_String(const char* text, int length) : CString(text, length) {}
Gui_String::Gui_String(const unsigned char* text) : CString(text) {}
Gui_String::Gui_String(const wchar_t* text) : CString(text) {}
Gui_String::~Gui_String() = default;
Gui_String& Gui_String::operator=(const Gui_String& text) = default;

int Gui_String::GetIntValue(int& value, int base) const {
    const char* end = nullptr;
    const int number = tvx::text::toInt32(GetString(), &end, base);
    if (end != GetString() + GetLength()) {
        return 0;
    }
    value = number;
    return 1;
}

int Gui_String::GetDoubleValue(double& value) const {
    const char* end = nullptr;
    const double number = tvx::text::toDouble(GetString(), &end);
    if (end != GetString() + GetLength()) {
        return 0;
    }
    value = number;
    return 1;
}

const char* Gui_String::GetEndOfLineChars() {
    return "\r\n";
}

namespace {

std::unique_ptr<CStringArray> split(std::string_view text, const char* separators, int skipEmpty, int ignoreQuotes) {
    const std::string given = separators ? separators : "";
    const CharacterSet skipped(given);
    const CharacterSet stops(ignoreQuotes ? given : given + "\"'");
    auto fields = MakeRecord<CStringArray>();
    std::size_t start = 0;
    for (std::size_t at = stops.find(text, 0); at < text.size(); at = stops.find(text, start)) {
        if (at > start || !skipEmpty) {
            add(*fields, text.substr(start, at - start));
        }
        start = !ignoreQuotes && isQuote(text[at]) ? addQuoted(*fields, text, at) : at + stops.match(text, at);
        while (const std::size_t length = skipEmpty ? skipped.match(text, start) : 0) {
            start += length;
        }
    }
    if (start < text.size()) {
        add(*fields, text.substr(start));
    }
    return fields;
}

} // namespace

CStringArray* Gui_String::GetStringArray(const char* separators, int skipEmpty, int ignoreQuotes) const {
    return tvx::allocating([&] { return split(View(), separators, skipEmpty, ignoreQuotes); }).release();
}
