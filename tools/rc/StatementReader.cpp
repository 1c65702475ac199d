#include "tools/rc/StatementReader.h"

#include "tools/rc/Encoding.h"

#include <algorithm>
#include <array>
#include <charconv>

namespace rc {

namespace {

constexpr std::array<std::string_view, 8> memoryFlags = {"DISCARDABLE", "MOVEABLE", "PURE",       "FIXED",
                                                         "IMPURE",      "PRELOAD",  "LOADONCALL", "NONDISCARDABLE"};

// Reads up to `most` digits of an escape and answers the unit they mean.
char16_t numberEscape(std::string_view text, std::size_t& at, std::size_t most, int base) {
    unsigned value = 0;
    const char* const first = text.data() + at;
    const char* const last = first + std::min(most, text.size() - at);
    at += static_cast<std::size_t>(std::from_chars(first, last, value, base).ptr - first);
    return static_cast<char16_t>(value);
}

// The unit of the escape whose letter stands at `at`, which moves behind it.
char16_t escapedUnit(std::string_view text, std::size_t& at) {
    const char letter = text[at];
    if (letter >= '0' && letter <= '7') {
        return numberEscape(text, at, 3, 8);
    }
    ++at;
    switch (letter) {
    case 'a':
        return u'\b'; // what resource compilers make of it
    case 'n':
        return u'\n';
    case 'r':
        return u'\r';
    case 't':
    case 'T':
        return u'\t';
    case 'x':
    case 'X':
        return numberEscape(text, at, 4, 16);
    default:
        return static_cast<char16_t>(letter);
    }
}

} // namespace

const Token* StatementReader::peek() const {
    return m_at < m_tokens.size() ? &m_tokens[m_at] : nullptr;
}

bool StatementReader::ahead(std::string_view keyword) const {
    return peek() && peek()->is(keyword);
}

bool StatementReader::blockEndAhead() const {
    return peek() && peek()->closesBlock();
}

const Token& StatementReader::next(std::string_view expected) {
    if (!peek()) {
        throw Fault{m_script.placeOf(m_tokens.back()), "expected " + std::string(expected) + " behind this line"};
    }
    return m_tokens[m_at++];
}

bool StatementReader::accept(std::string_view keyword) {
    const bool isThere = ahead(keyword);
    m_at += isThere ? 1 : 0;
    return isThere;
}

const Token& StatementReader::expect(std::string_view keyword) {
    const Token& token = next(keyword);
    if (!token.is(keyword)) {
        fail(token, keyword);
    }
    return token;
}

void StatementReader::skipMemoryFlags() {
    while (std::ranges::any_of(memoryFlags, [&](std::string_view flag) { return accept(flag); })) {
    }
}

void StatementReader::beginBlock() {
    skipMemoryFlags();
    if (const Token& token = next("BEGIN"); !token.opensBlock()) {
        fail(token, "BEGIN");
    }
}

std::int64_t StatementReader::number() {
    std::int64_t value = sum();
    while (ahead("|") || ahead("&")) {
        const bool isOr = next("|").is("|");
        const std::int64_t right = sum();
        value = isOr ? value | right : value & right;
    }
    return value;
}

std::int64_t StatementReader::sum() {
    std::int64_t value = operand();
    while (ahead("+") || ahead("-")) {
        const bool isPlus = next("+").is("+");
        const std::int64_t right = operand();
        value += isPlus ? right : -right;
    }
    return value;
}

std::int64_t StatementReader::operand() {
    const Token& token = next("a number");
    if (token.is("-")) {
        return -operand();
    }
    if (token.is("~") || token.is("NOT")) {
        return ~operand();
    }
    if (token.is("(")) {
        const std::int64_t value = number();
        expect(")");
        return value;
    }
    const bool isHex = token.text.starts_with("0x") || token.text.starts_with("0X");
    const char* const first = token.text.data() + (isHex ? 2 : 0);
    const char* const last = token.text.data() + token.text.size();
    std::uint32_t value = 0;
    const auto [end, error] = std::from_chars(first, last, value, isHex ? 16 : 10);
    const std::string suffix = upperCase(std::string_view(end, last));
    if (token.kind != Token::Kind::Number || error != std::errc() ||
        !(suffix.empty() || suffix == "L" || suffix == "UL")) {
        fail(token, "a number");
    }
    return value;
}

std::uint16_t StatementReader::word() {
    const Token* first = peek();
    const std::int64_t value = number();
    if (value < -0x8000 || value > 0xFFFF) {
        fail(*first, "a number of 16 bits");
    }
    return static_cast<std::uint16_t>(value);
}

std::u16string StatementReader::text() {
    const Token& token = next("a text");
    if (token.kind != Token::Kind::String) {
        fail(token, "a text");
    }
    return decodeString(token.text);
}

void StatementReader::fail(const Token& token, std::string_view expected) const {
    throw Fault{m_script.placeOf(token), "expected " + std::string(expected) + ", got " + token.text};
}

std::u16string decodeString(std::string_view quoted) {
    quoted.remove_prefix(quoted.find('"') + 1);
    if (quoted.ends_with('"')) {
        quoted.remove_suffix(1);
    }
    std::u16string result;
    for (std::size_t at = 0; at < quoted.size();) {
        const char c = quoted[at];
        if (c == '\\' && at + 1 < quoted.size()) {
            result += escapedUnit(quoted, ++at);
        } else if (c == '"') {
            result += u'"';
            at += 2;
        } else {
            const std::size_t end = std::min(quoted.find_first_of("\\\"", at), quoted.size());
            result += utf8ToUtf16(quoted.substr(at, end - at));
            at = end;
        }
    }
    return result;
}

} // namespace rc
