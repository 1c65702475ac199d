#include "tools/rc/Encoding.h"

#include "platform/base/WesternCodePage.h"

#include <algorithm>
#include <cstdint>

namespace rc {

namespace {

void append(std::string& text, char32_t c) {
    const auto tail = [&](int shift) { text += static_cast<char>(0x80 | (c >> shift & 0x3F)); };
    if (c < 0x80) {
        text += static_cast<char>(c);
    } else if (c < 0x800) {
        text += static_cast<char>(0xC0 | c >> 6);
        tail(0);
    } else if (c < 0x10000) {
        text += static_cast<char>(0xE0 | c >> 12);
        tail(6);
        tail(0);
    } else {
        text += static_cast<char>(0xF0 | c >> 18);
        tail(12);
        tail(6);
        tail(0);
    }
}

std::size_t lengthByLead(std::uint8_t lead) {
    if (lead < 0x80) {
        return 1;
    }
    if (lead < 0xC2 || lead > 0xF4) {
        return 0;
    }
    return lead < 0xE0 ? 2 : lead < 0xF0 ? 3 : 4;
}

// Length of the well-formed sequence that begins at `at`, 0 for a broken one.
std::size_t sequenceLength(std::string_view text, std::size_t at) {
    const auto byte = [&](std::size_t i) {
        return at + i < text.size() ? static_cast<std::uint8_t>(text[at + i]) : std::uint8_t{0};
    };
    const std::uint8_t lead = byte(0);
    const std::size_t length = lengthByLead(lead);
    for (std::size_t i = 1; i < length; ++i) {
        if ((byte(i) & 0xC0) != 0x80) {
            return 0;
        }
    }
    const bool isOverlong = (lead == 0xE0 && byte(1) < 0xA0) || (lead == 0xF0 && byte(1) < 0x90);
    const bool isOutside = (lead == 0xED && byte(1) > 0x9F) || (lead == 0xF4 && byte(1) > 0x8F);
    return isOverlong || isOutside ? 0 : length;
}

std::string utf16ToUtf8(std::string_view bytes, bool isBigEndian) {
    const auto unit = [&](std::size_t at) -> char32_t {
        const auto first = static_cast<std::uint8_t>(bytes[at]);
        const auto second = static_cast<std::uint8_t>(bytes[at + 1]);
        return static_cast<char32_t>(isBigEndian ? first << 8 | second : second << 8 | first);
    };
    std::string result;
    for (std::size_t at = 0; at + 1 < bytes.size(); at += 2) {
        char32_t c = unit(at);
        if (c >= 0xD800 && c < 0xDC00 && at + 3 < bytes.size() && (unit(at + 2) & 0xFC00) == 0xDC00) {
            c = 0x10000 + ((c & 0x3FF) << 10) + (unit(at + 2) & 0x3FF);
            at += 2;
        }
        append(result, c);
    }
    return result;
}

} // namespace

bool isUtf8(std::string_view text) {
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t length = sequenceLength(text, at);
        if (length == 0) {
            return false;
        }
        at += length;
    }
    return true;
}

std::u16string utf8ToUtf16(std::string_view text) {
    std::u16string result;
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t length = std::max<std::size_t>(sequenceLength(text, at), 1);
        char32_t c = static_cast<std::uint8_t>(text[at]);
        if (length > 1) {
            c &= 0x7Fu >> length;
        }
        for (std::size_t i = 1; i < length; ++i) {
            c = c << 6 | (static_cast<std::uint8_t>(text[at + i]) & 0x3F);
        }
        at += length;
        if (c >= 0x10000) {
            result += static_cast<char16_t>(0xD800 + ((c - 0x10000) >> 10));
            c = 0xDC00 + (c & 0x3FF);
        }
        result += static_cast<char16_t>(c);
    }
    return result;
}

std::string westernToUtf8(std::string_view text) {
    std::string result;
    for (const char c : text) {
        append(result, tvx::text::westernCodePoint(static_cast<std::uint8_t>(c)));
    }
    return result;
}

std::string withoutByteOrderMark(std::string_view bytes) {
    if (bytes.starts_with("\xFF\xFE")) {
        return utf16ToUtf8(bytes.substr(2), false);
    }
    if (bytes.starts_with("\xFE\xFF")) {
        return utf16ToUtf8(bytes.substr(2), true);
    }
    if (bytes.starts_with("\xEF\xBB\xBF")) {
        bytes.remove_prefix(3);
    }
    return std::string(bytes);
}

} // namespace rc
