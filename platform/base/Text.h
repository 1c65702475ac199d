#pragma once

/// @file
/// What the whole layer does with text, done in one place: comparing without case, stepping through UTF-8, converting
/// to and from wide text, and numbers that never depend on the process's locale.
///
/// Narrow text is UTF-8. A byte that belongs to no well-formed sequence counts as a character of its own: it is never
/// dropped, replaced or merged with its neighbours. As a code point such a byte 0x80..0xFF is U+DC80..U+DCFF (a lone
/// low surrogate, which no well-formed UTF-8 text can hold), so that converting to wide text and back gives the same
/// bytes.

#include "platform/base/Export.h"

#include <cstdarg>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace tvx::text {

// Comparing without case
//
// Letters are folded one to one by the Unicode simple mappings (upper, then lower), so "É" equals "é" and "ς" equals
// "Σ". Nothing changes length: "ß" does not equal "SS". A letter outside ASCII never folds into ASCII (the Kelvin sign
// is not a "k"), no matter what language the user has chosen: names and switches mean the same on every machine.

/// Compares two texts without regard to case. Negative, 0 or positive, ordered by folded code point ('_' sorts before
/// letters).
[[nodiscard]] TVX_PLATFORM_API int compareNoCase(std::string_view left, std::string_view right) noexcept;
/// Whether two texts are equal without regard to case.
[[nodiscard]] TVX_PLATFORM_API bool equalNoCase(std::string_view left, std::string_view right) noexcept;
/// Whether `text` begins with `prefix` without regard to case. An empty prefix begins every text.
[[nodiscard]] TVX_PLATFORM_API bool startsWithNoCase(std::string_view text, std::string_view prefix) noexcept;
/// The text with every letter folded: two texts are equal without case exactly when their folded forms are the same
/// bytes. Made for keys of maps.
[[nodiscard]] TVX_PLATFORM_API std::string foldCase(std::string_view text);
/// Orders texts without regard to case, for `std::map` and `std::set`.
struct LessNoCase {
    using is_transparent = void;
    bool operator()(std::string_view left, std::string_view right) const noexcept {
        return compareNoCase(left, right) < 0;
    }
};
/// The text in upper case, letter by letter ("ß" stays).
[[nodiscard]] TVX_PLATFORM_API std::string toUpper(std::string_view text);
/// Whether a code point is a letter of any script; a broken byte is none.
[[nodiscard]] TVX_PLATFORM_API bool isLetter(char32_t codePoint) noexcept;
/// The text in lower case, letter by letter.
[[nodiscard]] TVX_PLATFORM_API std::string toLower(std::string_view text);

// Stepping through UTF-8

/// Bytes of the character that begins at `at`: 1 to 4, 1 for a byte of a broken sequence, 0 at the end of the text.
[[nodiscard]] TVX_PLATFORM_API std::size_t characterLength(std::string_view text, std::size_t at = 0) noexcept;
/// Where the character before `at` begins; 0 when there is none. `at` must be the start of a character or the end.
[[nodiscard]] TVX_PLATFORM_API std::size_t previousCharacter(std::string_view text, std::size_t at) noexcept;
/// Number of characters, each broken byte counting as one.
[[nodiscard]] TVX_PLATFORM_API std::size_t characterCount(std::string_view text) noexcept;
/// Largest character boundary that is not beyond `at`: cutting there splits no character.
[[nodiscard]] TVX_PLATFORM_API std::size_t characterStart(std::string_view text, std::size_t at) noexcept;
/// The code point at `at`, which moves behind it. A broken byte gives U+DC00 + byte. At the end: 0, and `at` stays.
[[nodiscard]] TVX_PLATFORM_API char32_t decode(std::string_view text, std::size_t& at) noexcept;
/// Appends a code point. U+DC80..U+DCFF append the single byte they stand for, numbers beyond U+10FFFF append U+FFFD.
TVX_PLATFORM_API void append(std::string& text, char32_t codePoint);
/// Whether every byte belongs to a well-formed sequence.
[[nodiscard]] TVX_PLATFORM_API bool isWellFormed(std::string_view text) noexcept;

// Into a caller's buffer

/// Copies a text with its zero when all of it fits.
/// @param size  bytes of `buffer`
/// @return false when it does not fit: the buffer is as before
[[nodiscard]] TVX_PLATFORM_API bool copyWhole(std::string_view text, char* buffer, std::size_t size) noexcept;
/// Copies what fits, cut before a character that does not, and ends it with a zero.
/// @param size  bytes of `buffer`, at least 1
/// @return bytes copied, the zero not counted
TVX_PLATFORM_API std::size_t copyCut(std::string_view text, char* buffer, std::size_t size) noexcept;

// Wide text

/// UTF-8 to wide text, one element a code point (wchar_t has 32 bits here); broken bytes become U+DC80..U+DCFF.
[[nodiscard]] TVX_PLATFORM_API std::wstring widen(std::string_view text);
/// Wide text to UTF-8, the inverse of widen(). A surrogate pair is joined to the one character it means.
[[nodiscard]] TVX_PLATFORM_API std::string narrow(std::wstring_view text);
/// UTF-16, as resource files hold it, to UTF-8. Surrogates without partner keep their value as a broken sequence.
[[nodiscard]] TVX_PLATFORM_API std::string narrow(std::u16string_view text);
/// UTF-8 to UTF-16; broken bytes become U+DC80..U+DCFF.
[[nodiscard]] TVX_PLATFORM_API std::u16string widen16(std::string_view text);

// Numbers, always in the C locale

/// What `strtol` gives on a platform whose `long` has 32 bits: leading white space, sign, the base's digits; a number
/// beyond the range gives the nearest limit.
/// @param text  zero-terminated
/// @param end   receives where the number ended: `text` itself when there is none; may be null
/// @param base  2 to 36, or 0 to let a prefix "0x" or "0" decide; any other base reads no number
TVX_PLATFORM_API std::int32_t toInt32(const char* text, const char** end = nullptr, int base = 10) noexcept;
/// Brings a number into the 32-bit range, to the nearest limit.
[[nodiscard]] constexpr std::int32_t clampToInt32(long long value) noexcept {
    return static_cast<std::int32_t>(value < INT32_MIN ? INT32_MIN : value > INT32_MAX ? INT32_MAX : value);
}
/// What `strtod` gives in the C locale: the decimal sign is ".", whatever the user's locale says.
TVX_PLATFORM_API double toDouble(const char* text, const char** end = nullptr) noexcept;
/// The shortest text that reads back as the same number, such as "0.1", "-2.5", "1e+300".
[[nodiscard]] TVX_PLATFORM_API std::string formatDouble(double value);
/// The number with `digits` significant digits as "%.*g" writes it in the C locale.
[[nodiscard]] TVX_PLATFORM_API std::string formatDouble(double value, int digits);

/// What `printf` makes of a format in the C locale (with wide arguments as UTF-8). The size prefixes "I64" and "I32"
/// that hosts use are understood. Raises CInvalidArgException when the result cannot be made, e.g. is larger than 2 GB.
[[nodiscard]] TVX_PLATFORM_API std::string formatV(const char* format, std::va_list arguments)
    __attribute__((format(printf, 1, 0)));
/// As formatV(), with the arguments in the call.
[[nodiscard]] TVX_PLATFORM_API std::string format(const char* format, ...) __attribute__((format(printf, 1, 2)));

} // namespace tvx::text
