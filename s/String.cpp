#include "s/String.h"

#include "platform/base/Text.h"
#include "s/Record.h"

#include <algorithm>
#include <memory>
#include <string>
#include <string_view>

namespace {

bool isQuote(std::string_view character) {
    return character == "\"" || character == "'";
}

/// A set of characters in UTF-8. Where all of them are ASCII, which no other character contains, bytes are searched.
class CharacterSet {
public:
    explicit CharacterSet(std::string characters)
        : m_characters(std::move(characters)),
          m_isAscii(std::all_of(m_characters.begin(), m_characters.end(),
                                [](char byte) { return static_cast<unsigned char>(byte) < 0x80; })) {}

    /// Bytes of the character of the set that `text` begins with, 0 when it begins with another.
    std::size_t matchAtStart(std::string_view text) const {
        const std::size_t length = tvx::text::characterLength(text);
        for (std::size_t at = 0; length > 0 && at < m_characters.size();) {
            const std::size_t step = tvx::text::characterLength(m_characters, at);
            if (text.substr(0, length) == std::string_view(m_characters).substr(at, step))
                return length;
            at += step;
        }
        return 0;
    }

    /// Where the first character of the set stands in `text`, `npos` when there is none.
    std::size_t find(std::string_view text) const {
        if (m_isAscii)
            return text.find_first_of(m_characters);
        for (std::size_t at = 0; at < text.size(); at += tvx::text::characterLength(text, at))
            if (matchAtStart(text.substr(at)) > 0)
                return at;
        return std::string_view::npos;
    }

private:
    std::string m_characters;
    bool m_isAscii;
};

void add(CStringArray& fields, std::string_view field) {
    fields.Add(CString(field));
}

/// Takes a quoted field off `rest`, which begins behind the opening quote; the field keeps its quotes.
void takeQuoted(CStringArray& fields, std::string_view& rest, std::string_view quote) {
    const std::size_t closing = rest.find(quote);
    const std::size_t length = closing == std::string_view::npos ? rest.size() : closing + quote.size();
    add(fields, std::string_view(quote.data(), quote.size() + length));
    rest.remove_prefix(length);
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
    if (end != GetString() + GetLength())
        return 0;
    value = number;
    return 1;
}

int Gui_String::GetDoubleValue(double& value) const {
    const char* end = nullptr;
    const double number = tvx::text::toDouble(GetString(), &end);
    if (end != GetString() + GetLength())
        return 0;
    value = number;
    return 1;
}

const char* Gui_String::GetEndOfLineChars() {
    return "\r\n";
}

CStringArray* Gui_String::GetStringArray(const char* separators, int skipEmpty, int ignoreQuotes) const {
    const std::string given = separators ? separators : "";
    const CharacterSet skipped(given);
    const CharacterSet stops(ignoreQuotes ? given : given + "\"'");
    auto fields = MakeRecord<CStringArray>();
    std::string_view rest = View();
    for (std::size_t at = stops.find(rest); at != std::string_view::npos; at = stops.find(rest)) {
        if (at > 0 || !skipEmpty)
            add(*fields, rest.substr(0, at));
        const std::string_view stop = rest.substr(at, tvx::text::characterLength(rest, at));
        rest.remove_prefix(at + stop.size());
        if (!ignoreQuotes && isQuote(stop))
            takeQuoted(*fields, rest, stop);
        while (skipEmpty && skipped.matchAtStart(rest) > 0)
            rest.remove_prefix(skipped.matchAtStart(rest));
    }
    if (!rest.empty())
        add(*fields, rest);
    return fields.release();
}
