#include "platform/base/Text.h"
#include "platform/base/detail/Locale.h"

#include <algorithm>
#include <cwctype>

namespace tvx::text {
namespace {

constexpr char32_t brokenByteBase = 0xDC00;
constexpr char32_t replacementCharacter = 0xFFFD;

bool isAscii(unsigned char byte) {
    return byte < 0x80;
}

bool isContinuation(unsigned char byte) {
    return (byte & 0xC0) == 0x80;
}

bool isBrokenByte(char32_t codePoint) {
    return codePoint >= 0xDC80 && codePoint <= 0xDCFF;
}

bool isHighSurrogate(char32_t unit) {
    return unit >= 0xD800 && unit <= 0xDBFF;
}

bool isLowSurrogate(char32_t unit) {
    return unit >= 0xDC00 && unit <= 0xDFFF;
}

char32_t mapUpper(char32_t codePoint) {
    if (codePoint < 0x80) {
        return codePoint >= 'a' && codePoint <= 'z' ? codePoint - 32 : codePoint;
    }
    return static_cast<char32_t>(towupper_l(static_cast<wint_t>(codePoint), detail::neutralLocale()));
}

char32_t mapLower(char32_t codePoint) {
    if (codePoint < 0x80) {
        return codePoint >= 'A' && codePoint <= 'Z' ? codePoint + 32 : codePoint;
    }
    return static_cast<char32_t>(towlower_l(static_cast<wint_t>(codePoint), detail::neutralLocale()));
}

char32_t fold(char32_t codePoint) {
    const char32_t folded = mapLower(mapUpper(codePoint));
    return codePoint >= 0x80 && folded < 0x80 ? codePoint : folded;
}

/// The folded character at `at`, which moves behind it.
char32_t nextFolded(std::string_view text, std::size_t& at) {
    const auto byte = static_cast<unsigned char>(text[at]);
    if (!isAscii(byte)) {
        return fold(decode(text, at));
    }
    ++at;
    return mapLower(byte);
}

template <typename Map>
std::string mapped(std::string_view text, Map map) {
    std::string result;
    result.reserve(text.size());
    for (std::size_t at = 0; at < text.size();) {
        append(result, map(decode(text, at)));
    }
    return result;
}

struct SequenceShape {
    std::size_t length;
    unsigned char secondLow;
    unsigned char secondHigh;
};

/// Length and allowed second byte by lead byte: the table of well-formed byte sequences of the Unicode standard, which
/// rules out overlong forms, surrogates and numbers beyond U+10FFFF.
SequenceShape shapeOf(unsigned char lead) {
    if (lead >= 0xC2 && lead <= 0xDF) {
        return {2, 0x80, 0xBF};
    }
    if (lead >= 0xE0 && lead <= 0xEF) {
        return {3, static_cast<unsigned char>(lead == 0xE0 ? 0xA0 : 0x80),
                static_cast<unsigned char>(lead == 0xED ? 0x9F : 0xBF)};
    }
    if (lead >= 0xF0 && lead <= 0xF4) {
        return {4, static_cast<unsigned char>(lead == 0xF0 ? 0x90 : 0x80),
                static_cast<unsigned char>(lead == 0xF4 ? 0x8F : 0xBF)};
    }
    return {1, 0, 0};
}

template <typename Text>
std::string narrowUnits(const Text& text) {
    std::string result;
    result.reserve(text.size());
    for (std::size_t at = 0; at < text.size(); ++at) {
        char32_t unit = static_cast<char32_t>(text[at]);
        if (isHighSurrogate(unit) && at + 1 < text.size() && isLowSurrogate(static_cast<char32_t>(text[at + 1]))) {
            unit = 0x10000 + ((unit - 0xD800) << 10) + (static_cast<char32_t>(text[++at]) - 0xDC00);
        }
        append(result, unit);
    }
    return result;
}

} // namespace

int compareNoCase(std::string_view left, std::string_view right) noexcept {
    // Names that are sorted often begin alike.
    std::size_t leftAt = 0;
    const std::size_t common = std::min(left.size(), right.size());
    while (leftAt < common && left[leftAt] == right[leftAt] && isAscii(static_cast<unsigned char>(left[leftAt]))) {
        ++leftAt;
    }
    std::size_t rightAt = leftAt;
    while (leftAt < left.size() && rightAt < right.size()) {
        const char32_t a = nextFolded(left, leftAt);
        const char32_t b = nextFolded(right, rightAt);
        if (a != b) {
            return a < b ? -1 : 1;
        }
    }
    return static_cast<int>(leftAt < left.size()) - static_cast<int>(rightAt < right.size());
}

bool equalNoCase(std::string_view left, std::string_view right) noexcept {
    return compareNoCase(left, right) == 0;
}

bool startsWithNoCase(std::string_view text, std::string_view prefix) noexcept {
    std::size_t at = 0;
    for (std::size_t prefixAt = 0; prefixAt < prefix.size();) {
        if (at >= text.size() || nextFolded(text, at) != nextFolded(prefix, prefixAt)) {
            return false;
        }
    }
    return true;
}

std::string foldCase(std::string_view text) {
    return mapped(text, fold);
}

std::string toUpper(std::string_view text) {
    return mapped(text, mapUpper);
}

bool isLetter(char32_t codePoint) noexcept {
    return !isLowSurrogate(codePoint) && iswalpha_l(static_cast<wint_t>(codePoint), detail::neutralLocale()) != 0;
}

std::string toLower(std::string_view text) {
    return mapped(text, mapLower);
}

std::size_t characterLength(std::string_view text, std::size_t at) noexcept {
    if (at >= text.size()) {
        return 0;
    }
    const SequenceShape shape = shapeOf(static_cast<unsigned char>(text[at]));
    if (shape.length == 1 || text.size() - at < shape.length) {
        return 1;
    }
    const auto second = static_cast<unsigned char>(text[at + 1]);
    if (second < shape.secondLow || second > shape.secondHigh) {
        return 1;
    }
    for (std::size_t i = 2; i < shape.length; ++i) {
        if (!isContinuation(static_cast<unsigned char>(text[at + i]))) {
            return 1;
        }
    }
    return shape.length;
}

std::size_t previousCharacter(std::string_view text, std::size_t at) noexcept {
    at = std::min(at, text.size());
    if (at == 0) {
        return 0;
    }
    const std::size_t farthest = std::min<std::size_t>(at, 4);
    for (std::size_t back = 2; back <= farthest; ++back) {
        if (characterLength(text, at - back) == back) {
            return at - back;
        }
    }
    return at - 1;
}

std::size_t characterCount(std::string_view text) noexcept {
    std::size_t count = 0;
    for (std::size_t at = 0; at < text.size(); at += characterLength(text, at)) {
        ++count;
    }
    return count;
}

std::size_t characterStart(std::string_view text, std::size_t at) noexcept {
    at = std::min(at, text.size());
    const std::size_t farthest = std::min<std::size_t>(at, 3);
    for (std::size_t back = 1; back <= farthest; ++back) {
        if (characterLength(text, at - back) > back) {
            return at - back;
        }
    }
    return at;
}

char32_t decode(std::string_view text, std::size_t& at) noexcept {
    const std::size_t length = characterLength(text, at);
    if (length == 0) {
        return 0;
    }
    const auto lead = static_cast<unsigned char>(text[at]);
    const std::size_t begin = at;
    at += length;
    if (length == 1) {
        return isAscii(lead) ? lead : brokenByteBase + lead;
    }
    char32_t codePoint = lead & (0xFF >> (length + 1));
    for (std::size_t i = 1; i < length; ++i) {
        codePoint = (codePoint << 6) | (static_cast<unsigned char>(text[begin + i]) & 0x3F);
    }
    return codePoint;
}

void append(std::string& text, char32_t codePoint) {
    if (codePoint > 0x10FFFF) {
        codePoint = replacementCharacter;
    }
    if (codePoint < 0x80 || isBrokenByte(codePoint)) {
        text += static_cast<char>(codePoint & 0xFF);
        return;
    }
    const int continuations = codePoint < 0x800 ? 1 : codePoint < 0x10000 ? 2 : 3;
    const unsigned leadMark = 0xF00u >> (continuations + 1) & 0xFF;
    text += static_cast<char>(leadMark | (codePoint >> (6 * continuations)));
    for (int i = continuations - 1; i >= 0; --i) {
        text += static_cast<char>(0x80 | ((codePoint >> (6 * i)) & 0x3F));
    }
}

bool isWellFormed(std::string_view text) noexcept {
    for (std::size_t at = 0; at < text.size();) {
        if (isBrokenByte(decode(text, at))) {
            return false;
        }
    }
    return true;
}

bool copyWhole(std::string_view text, char* buffer, std::size_t size) noexcept {
    return text.size() < size && copyCut(text, buffer, size) == text.size();
}

std::size_t copyCut(std::string_view text, char* buffer, std::size_t size) noexcept {
    const std::size_t length = characterStart(text, std::min(text.size(), size - 1));
    text.copy(buffer, length);
    buffer[length] = '\0';
    return length;
}

std::wstring widen(std::string_view text) {
    std::wstring result;
    result.reserve(text.size());
    for (std::size_t at = 0; at < text.size();) {
        result += static_cast<wchar_t>(decode(text, at));
    }
    return result;
}

std::string narrow(std::wstring_view text) {
    return narrowUnits(text);
}

std::string narrow(std::u16string_view text) {
    return narrowUnits(text);
}

std::u16string widen16(std::string_view text) {
    std::u16string result;
    result.reserve(text.size());
    for (std::size_t at = 0; at < text.size();) {
        const char32_t codePoint = decode(text, at);
        if (codePoint >= 0x10000) {
            result += static_cast<char16_t>(0xD7C0 + (codePoint >> 10));
            result += static_cast<char16_t>(0xDC00 + (codePoint & 0x3FF));
        } else {
            result += static_cast<char16_t>(codePoint);
        }
    }
    return result;
}

} // namespace tvx::text
