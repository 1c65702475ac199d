#include "platform/base/Exception.h"
#include "platform/base/Text.h"
#include "platform/base/detail/Locale.h"

#include <charconv>
#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace tvx {
namespace detail {

locale_t neutralLocale() {
    static const locale_t locale = [] {
        const locale_t unicode = newlocale(LC_ALL_MASK, "C.UTF-8", nullptr);
        return unicode ? unicode : newlocale(LC_ALL_MASK, "C", nullptr);
    }();
    return locale;
}

} // namespace detail

namespace text {
namespace {

/// Copies one conversion, which begins at `percent`, and writes a size prefix "I64" as "ll" and "I32" as nothing.
/// Returns the place behind its flags, width, precision and prefix.
const char* copyConversionHead(const char* percent, std::string& result) {
    const char* at = percent + 1 + std::strspn(percent + 1, "-+ #0");
    at += std::strspn(at, "0123456789*.");
    result.append(percent, at);
    if (std::strncmp(at, "I64", 3) == 0) {
        result += "ll";
        return at + 3;
    }
    return std::strncmp(at, "I32", 3) == 0 ? at + 3 : at;
}

std::string withStandardSizes(const char* format) {
    std::string result;
    while (const char* percent = std::strchr(format, '%')) {
        result.append(format, percent);
        format = copyConversionHead(percent, result);
        if (*format) {
            result += *format++;
        }
    }
    return result + format;
}

} // namespace

std::int32_t toInt32(const char* text, const char** end, int base) noexcept {
    // strtoll leaves the end alone for a base it does not know.
    char* stop = const_cast<char*>(text);
    const long long value = strtoll_l(text, &stop, base, detail::neutralLocale());
    if (end) {
        *end = stop;
    }
    return clampToInt32(value);
}

double toDouble(const char* text, const char** end) noexcept {
    char* stop = const_cast<char*>(text);
    const double value = strtod_l(text, &stop, detail::neutralLocale());
    if (end) {
        *end = stop;
    }
    return value;
}

std::string formatDouble(double value) {
    char buffer[32];
    const auto result = std::to_chars(buffer, buffer + sizeof buffer, value);
    return {buffer, result.ptr};
}

std::string formatDouble(double value, int digits) {
    return format("%.*g", digits, value);
}

std::string formatV(const char* format, std::va_list arguments) {
    std::string translated;
    if (std::strstr(format, "I64") || std::strstr(format, "I32")) {
        translated = withStandardSizes(format);
        format = translated.c_str();
    }
    const detail::NeutralLocaleScope neutral;
    std::va_list measured;
    va_copy(measured, arguments);
    char buffer[256];
    const int length = std::vsnprintf(buffer, sizeof buffer, format, measured);
    va_end(measured);
    if (length < 0) {
        AfxThrowInvalidArgException();
    }
    if (static_cast<std::size_t>(length) < sizeof buffer) {
        return {buffer, static_cast<std::size_t>(length)};
    }
    std::string result(static_cast<std::size_t>(length), '\0');
    std::vsnprintf(result.data(), result.size() + 1, format, arguments);
    return result;
}

std::string format(const char* format, ...) {
    std::va_list arguments;
    va_start(arguments, format);
    // The exception that a bad format raises leaves the list open, which costs nothing on this platform.
    std::string result = formatV(format, arguments);
    va_end(arguments);
    return result;
}

} // namespace text
} // namespace tvx
