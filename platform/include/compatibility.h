#pragma once

/// @file
/// Old names of the language's library, of basic types and of calling conventions, which sources moved from elsewhere
/// hold. Hosts that tvx_add_application builds get this header before their first line; other targets of theirs include
/// it, or "windows.h". The library itself does not use it.

#include "platform/base/Text.h"
#include "platform/base/Types.h"
#include "platform/win/FindFile.h"

#include <algorithm>
#include <cerrno>
#include <concepts>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <type_traits>

// The smaller and the larger one, also of numbers of different types. They are functions, as macros of these names
// would break the standard headers.
using std::max;
using std::min;
/// Of two numbers of different types, in the type that both have in an expression.
/// @{
template <class Left, class Right>
    requires(std::is_arithmetic_v<Left> && std::is_arithmetic_v<Right> && !std::same_as<Left, Right>)
constexpr std::common_type_t<Left, Right> min(Left left, Right right) {
    return std::min<std::common_type_t<Left, Right>>(left, right);
}
template <class Left, class Right>
    requires(std::is_arithmetic_v<Left> && std::is_arithmetic_v<Right> && !std::same_as<Left, Right>)
constexpr std::common_type_t<Left, Right> max(Left left, Right right) {
    return std::max<std::common_type_t<Left, Right>>(left, right);
}
/// @}

// Types
#define VOID void
#define CONST const
#define __int64 long long
using UCHAR = unsigned char;
using PVOID = void*;
using PBYTE = BYTE*;
using errno_t = int;

/// A moment in parts. Nothing here tells or takes one.
struct SYSTEMTIME {
    /// Months begin with 1, days of the week with 0 for Sunday.
    WORD wYear;
    WORD wMonth;
    WORD wDayOfWeek;
    WORD wDay;
    WORD wHour;
    WORD wMinute;
    WORD wSecond;
    WORD wMilliseconds;
};

// What stood before names of functions and pointers: it means nothing here.
#define FAR
#define NEAR
#define __cdecl
#define _cdecl
#define __stdcall
#define __fastcall
#define __declspec(what)

// Sizes of buffers for names of files and their parts
#define _MAX_PATH MAX_PATH
#define _MAX_DRIVE 3
#define _MAX_DIR 256
#define _MAX_FNAME 256
#define _MAX_EXT 256
#define _countof(array) (sizeof(array) / sizeof((array)[0]))
#define ARRAYSIZE(array) _countof(array)

/// There are no palettes: a colour by its parts is that colour.
#define PALETTERGB(red, green, blue) RGB(red, green, blue)

/// number * numerator / denominator, rounded to the nearest, without overflow between; -1 when the result does not fit,
/// and for the denominator 0.
constexpr int MulDiv(int number, int numerator, int denominator) {
    if (denominator == 0) {
        return -1;
    }
    const long long product = (denominator < 0 ? -1LL : 1LL) * number * numerator;
    const long long divisor = denominator < 0 ? -static_cast<long long>(denominator) : denominator;
    const long long result = (product + (product < 0 ? -divisor / 2 : divisor / 2)) / divisor;
    return result < INT_MIN || result > INT_MAX ? -1 : static_cast<int>(result);
}

// Memory
#define ZeroMemory(target, size) std::memset((target), 0, (size))
#define CopyMemory(target, source, size) std::memcpy((target), (source), (size))

/// Texts without regard to case, letter by letter in UTF-8.
/// @{
inline int stricmp(const char* left, const char* right) {
    return tvx::text::compareNoCase(left, right);
}
/// At most `count` bytes of each.
inline int strnicmp(const char* left, const char* right, std::size_t count) {
    return tvx::text::compareNoCase({left, strnlen(left, count)}, {right, strnlen(right, count)});
}
/// @}
/// Changes letters in place and answers the text; those whose other case takes more room stay.
/// @{
inline char* strupr(char* text) {
    const std::string changed = tvx::text::toUpper(text);
    return changed.size() == std::strlen(text) ? std::strcpy(text, changed.c_str()) : text;
}
inline char* strlwr(char* text) {
    const std::string changed = tvx::text::toLower(text);
    return changed.size() == std::strlen(text) ? std::strcpy(text, changed.c_str()) : text;
}
/// @}
#define strcmpi stricmp
#define _stricmp stricmp
#define _strnicmp strnicmp
#define _strupr strupr
#define _strlwr strlwr
#define _strdup strdup
#define _snprintf std::snprintf
#define _atoi64 std::atoll

/// Writes a number in a base of 2 to 36; only the base 10 knows a sign. Room for 33 characters is enough.
inline char* itoa(int number, char* buffer, int base) {
    std::string digits;
    const bool isNegative = base == 10 && number < 0;
    unsigned rest = isNegative ? 0U - static_cast<unsigned>(number) : static_cast<unsigned>(number);
    do {
        digits += "0123456789abcdefghijklmnopqrstuvwxyz"[rest % static_cast<unsigned>(base)];
        rest /= static_cast<unsigned>(base);
    } while (rest != 0);
    digits += isNegative ? "-" : "";
    std::ranges::reverse(digits);
    return std::strcpy(buffer, digits.c_str());
}
#define _itoa itoa
#define ltoa(number, buffer, base) itoa(static_cast<int>(number), buffer, base)

/// Copies or appends at most `count` bytes of a text when all of them and a zero have room in a buffer of `size` bytes.
/// @return 0; ERANGE when there is too little room: the buffer is empty then
/// @{
inline errno_t strncpy_s(char* buffer, std::size_t size, const char* text, std::size_t count) {
    if (tvx::text::copyWhole({text, strnlen(text, count)}, buffer, size)) {
        return 0;
    }
    *buffer = '\0';
    return ERANGE;
}
inline errno_t strcpy_s(char* buffer, std::size_t size, const char* text) {
    return strncpy_s(buffer, size, text, std::strlen(text));
}
inline errno_t strcat_s(char* buffer, std::size_t size, const char* text) {
    const std::size_t used = strnlen(buffer, size);
    if (used < size && tvx::text::copyWhole(text, buffer + used, size - used)) {
        return 0;
    }
    *buffer = '\0';
    return ERANGE;
}
template <std::size_t Size>
errno_t strcpy_s(char (&buffer)[Size], const char* text) {
    return strcpy_s(buffer, Size, text);
}
template <std::size_t Size>
errno_t strcat_s(char (&buffer)[Size], const char* text) {
    return strcat_s(buffer, Size, text);
}
/// @}
/// What printf makes of a format, cut to a buffer of 1024 bytes.
/// @return bytes written, the zero not counted
inline int wsprintf(char* buffer, const char* format, ...) __attribute__((format(printf, 2, 3)));
inline int wsprintf(char* buffer, const char* format, ...) {
    std::va_list arguments;
    va_start(arguments, format);
    const std::string text = tvx::text::formatV(format, arguments);
    va_end(arguments);
    return static_cast<int>(tvx::text::copyCut(text, buffer, 1024));
}
#define sprintf_s std::snprintf

// Texts by the names of the system
#define lstrlen(text) static_cast<int>(std::strlen(text))
#define lstrcpy std::strcpy
#define lstrcat std::strcat
#define lstrcmp std::strcmp
#define lstrcmpi stricmp

// Texts by the names for two character widths: here characters are bytes of UTF-8.
#define _tcslen std::strlen
#define _tcscpy std::strcpy
#define _tcsncpy std::strncpy
#define _tcscat std::strcat
#define _tcscmp std::strcmp
#define _tcsncmp std::strncmp
#define _tcsicmp stricmp
#define _tcsnicmp strnicmp
#define _tcschr std::strchr
#define _tcsrchr std::strrchr
#define _tcsstr std::strstr
#define _tcstok std::strtok
#define _tcstol std::strtol
#define _tcstod std::strtod
#define _tcsdup strdup
#define _tcslwr strlwr
#define _tcscpy_s strcpy_s
#define _tcscat_s strcat_s
#define _tcsupr strupr
#define _stprintf std::sprintf
#define _stprintf_s std::snprintf
#define _sntprintf std::snprintf
#define _ttoi std::atoi
#define _ttol std::atol
