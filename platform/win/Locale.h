#pragma once

/// @file
/// The user's language. It comes from the environment: the first of `LC_ALL`, `LC_MESSAGES` and `LANG` that is not
/// empty, as in "de_AT.UTF-8". A country that the platform does not know is passed over ("de_XX" is German); a language
/// that it does not know, "C" and "POSIX" are American English.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

/// A locale: the low 16 bits are the language.
using LCID = DWORD;
/// A language: 10 bits for itself, 6 above them for the country or script.
using LANGID = WORD;
/// What is asked about a locale.
using LCTYPE = DWORD;

/// A language from a LANG_ and a SUBLANG_ number.
constexpr LANGID MAKELANGID(int primary, int sub) {
    return static_cast<LANGID>((sub << 10) | primary);
}
/// The low 10 bits: the language without its country.
constexpr WORD PRIMARYLANGID(LANGID language) {
    return static_cast<WORD>(language & 0x3FF);
}
/// The high 6 bits: the country or script.
constexpr WORD SUBLANGID(LANGID language) {
    return static_cast<WORD>(language >> 10);
}
/// The language of a locale.
constexpr LANGID LANGIDFROMLCID(LCID locale) {
    return static_cast<LANGID>(locale & 0xFFFF);
}

/// The user's locale, where a locale is asked for.
#define LOCALE_USER_DEFAULT 0x0400
/// The machine's locale; it is the user's here.
#define LOCALE_SYSTEM_DEFAULT 0x0800

/// The language's abbreviation in three letters, such as "DEU": the extension of resource libraries.
#define LOCALE_SABBREVLANGNAME 0x0003

/// The user's locale, as the environment names it at this moment.
TVX_PLATFORM_API LCID GetUserDefaultLCID();

/// Copies what a locale's language is called into `buffer` of `size` bytes.
/// @param locale one of the platform's locales, or `LOCALE_USER_DEFAULT`
/// @param type   `LOCALE_SABBREVLANGNAME`
/// @param size   0: nothing is copied, the result is the size needed
/// @return the bytes copied, the ending zero included; 0 with `ERROR_INVALID_PARAMETER` (unknown locale),
///     `ERROR_INVALID_FLAGS` (unknown type) or `ERROR_INSUFFICIENT_BUFFER`
TVX_PLATFORM_API int GetLocaleInfoA(LCID locale, LCTYPE type, LPSTR buffer, int size);

/// @copydoc GetLocaleInfoA
inline int GetLocaleInfo(LCID locale, LCTYPE type, LPSTR buffer, int size) {
    return GetLocaleInfoA(locale, type, buffer, size);
}
