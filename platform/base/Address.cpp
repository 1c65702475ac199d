#include "platform/base/Address.h"

#include <algorithm>
#include <charconv>
#include <optional>

namespace tvx {

namespace {

constexpr std::string_view letters = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz";
constexpr std::string_view kept = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789-._~/!$&'()*+,;=:@";

/// The byte that two hexadecimal digits name.
std::optional<char> codedByte(std::string_view digits) {
    unsigned value = 0;
    const char* begin = digits.data();
    const char* end = begin + digits.size();
    const auto [read, error] = std::from_chars(begin, end, value, 16);
    return digits.size() == 2 && read == end && error == std::errc() ? std::optional(static_cast<char>(value))
                                                                     : std::nullopt;
}

} // namespace

std::string decodeAddress(std::string_view part) {
    std::string result;
    for (std::size_t at = 0; at < part.size(); ++at) {
        const std::optional<char> byte = part[at] == '%' ? codedByte(part.substr(at + 1, 2)) : std::nullopt;
        result += byte.value_or(part[at]);
        at += byte ? 2 : 0;
    }
    return result;
}

std::string encodeAddress(std::string_view path) {
    constexpr std::string_view digits = "0123456789ABCDEF";
    std::string result;
    for (const char character : path) {
        const auto byte = static_cast<unsigned char>(character);
        if (kept.find(character) != std::string_view::npos) {
            result += character;
        } else {
            result.append({'%', digits[byte >> 4], digits[byte & 15]});
        }
    }
    return result;
}

bool isAddress(std::string_view text) noexcept {
    const std::size_t end = text.find(':');
    return end != std::string_view::npos && end > 1 && letters.find(text[0]) != std::string_view::npos &&
           std::ranges::all_of(text.substr(0, end), [](char character) {
               return letters.find(character) != std::string_view::npos ||
                      std::string_view("0123456789+-.").find(character) != std::string_view::npos;
           });
}

bool isFileAddress(std::string_view text) noexcept {
    return text.size() >= 5 &&
           std::ranges::equal(text.substr(0, 5), std::string_view("file:"),
                              [](char left, char right) { return (left | 0x20) == (right | 0x20); });
}

} // namespace tvx
