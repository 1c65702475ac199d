#pragma once

#include "platform/base/Export.h"

#include <cstddef>
#include <string>
#include <string_view>

/// What the portability library does with plain texts: taking lines apart, reading numbers, and converting between the
/// narrow texts of hosts (UTF-8) and the wide ones of the message managers. Numbers are read in the C locale always.
class TVX_PLATFORM_API UT_STR {
public:
    /// The narrow form of the zero-terminated @p text; null gives an empty text.
    static std::string WstrToMbstr(const wchar_t* text);

    /// The wide form of the zero-terminated @p text; null gives an empty text. A byte that belongs to no valid sequence
    /// becomes a wide character of its own, which WstrToMbstr turns into that same byte: there and back nothing is
    /// lost.
    static std::wstring MbstrToWstr(const char* text);

    /// Frees @p count lines and the array that holds them, as handed out by `Port_MsgManDefault::msgFormat`. A null
    /// array is ignored.
    static void WDelStrings(wchar_t** lines, int count);

    /// Where @p pattern first stands in @p text, in bytes from its beginning, or -1.
    [[nodiscard]] static int FindString(std::string_view text, std::string_view pattern);
    /// Takes the first token off the front of @p source.
    /// @param source     loses the token and the delimiter behind it
    /// @param token      receives what stands before the first delimiter: nothing when @p source begins with one, all
    ///     of @p source when it has none
    /// @param delimiters the bytes that end a token
    /// @return the delimiter that ended the token, 0 when @p source ended first
    static char GetToken(std::string& source, std::string& token, const char* delimiters);
    /// Removes white space (blanks, tabs, line ends) from both ends.
    static void Trim(std::string& text);
    /// Compares byte by byte, letter case counts: negative, 0 or positive.
    [[nodiscard]] static int Compare(std::string_view left, std::string_view right);

    /// The decimal number at the beginning of @p text, behind white space and sign; 0 when there is none, the nearest
    /// limit when it has more than 32 bits. What follows the number does not matter.
    [[nodiscard]] static int AToI(const char* text);
    /// What `sscanf` reads.
    /// @return the number of values stored, negative when @p text ended before the first
    [[gnu::format(scanf, 2, 3)]] static int SScanf(const char* text, const char* format, ...);

    /// Puts @p text, with its zero, into a buffer of @p size bytes.
    /// @return whether it fits; if not, the buffer is left as it was
    [[nodiscard]] static bool Copy(char* buffer, std::size_t size, const char* text);
    /// The same behind the text that the buffer holds.
    [[nodiscard]] static bool Cat(char* buffer, std::size_t size, const char* text);
};
