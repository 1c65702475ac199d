#pragma once

#include "platform/base/Export.h"

#include <compare>
#include <string>
#include <string_view>

namespace Port {

template <typename Char>
class StringBase;

/// The portability library's text: a value of bytes in UTF-8, over `std::string`, with the operations that the code
/// around the portability library uses. Positions and lengths count bytes; a position of -1 means "not found".
///
///     Port::StringBase<char> line("  topic 1001\t");
///     line.Trim(" \t");
///     Port::StringBase<char>::Range word;
///     while (line.NextTokenRange(word, " "))
///         use(line.Extract(word));
template <>
class TVX_PLATFORM_API StringBase<char> {
public:
    /// A stretch of a text. One that begins at 0 with length 0 stands before the first token.
    struct Range {
        int start = 0;  ///< position of the first byte
        int length = 0; ///< number of bytes
    };
    /// Whether letter case counts in a comparison.
    enum class Case { Sensitive, Ignored };

    /// An empty text.
    StringBase() = default;
    /// A copy of the zero-terminated @p text; null gives an empty text.
    StringBase(const char* text);
    /// A copy of the bytes of @p text.
    StringBase(std::string_view text);
    StringBase(const std::string& text);

    /// The text, zero-terminated; holds until the text is changed.
    const char* c_str() const;
    /// The text as the standard library's string.
    const std::string& str() const;
    /// The number of bytes.
    int GetLength() const;
    /// Whether there is not a single byte.
    bool IsEmpty() const;

    /// Appends @p other.
    StringBase& operator+=(const StringBase& other);
    friend StringBase operator+(StringBase left, const StringBase& right) {
        return left += right;
    }
    /// Bytewise, so that texts can be the keys of ordered maps.
    friend bool operator==(const StringBase&, const StringBase&) = default;
    friend auto operator<=>(const StringBase&, const StringBase&) = default;

    /// Compares with @p other: negative, 0 or positive.
    int Compare(const StringBase& other, Case letterCase = Case::Sensitive) const;

    /// Removes from both ends every byte that is among @p characters.
    void Trim(const char* characters = " \t\r\n\v\f");
    /// Puts @p replacement in the place of every byte that is among @p characters.
    void ReplaceChars(const char* characters, char replacement);
    /// Makes the text what `printf` would write, with "." as decimal point whatever the locale.
    [[gnu::format(printf, 2, 3)]] void Format(const char* format, ...);

    /// The first position from @p from on of a byte that is among @p characters, or -1.
    int GetIndexOfFirstChar(const char* characters, int from = 0) const;
    /// The last position of a byte that is among @p characters, or -1.
    int GetIndexOfLastChar(const char* characters) const;
    /// The first position from @p from on where @p text stands, or -1.
    int GetIndexOfString(const char* text, int from = 0) const;

    /// The stretch @p range of the text, cut to what the text has.
    StringBase Extract(Range range) const;
    /// @p length bytes from @p start on; a negative length means all that follow.
    StringBase Extract(int start, int length = -1) const;

    /// Moves @p range on to the next run of bytes that are not among @p delimiters, begun after the end of @p range.
    /// @return whether there is one; if not, @p range is left as it was.
    bool NextTokenRange(Range& range, const char* delimiters) const;

private:
    std::string m_text;
};

} // namespace Port
