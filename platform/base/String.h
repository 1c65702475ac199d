#pragma once

#include "platform/base/Export.h"
#include "platform/base/FormatArgument.h"
#include "platform/base/Types.h"

#include <compare>
#include <cstdarg>
#include <cstddef>
#include <cstring>
#include <functional>
#include <string_view>
#include <utility>

template <typename Char>
class CStringT;

/// The framework's text: a value that holds its length, and so may hold embedded zeros. Always zero-terminated as well.
///
/// A string is one pointer to a shared, counted buffer; copying one costs an increment, whatever its length, and texts
/// are passed and returned by value everywhere in hosts. The first change of a shared buffer makes a copy. The count is
/// atomic: strings of different threads may share a buffer, one string must not be changed by two threads at a time.
///
/// Text is UTF-8. Lengths and positions are bytes; where characters matter (case, reversing, sets of characters) whole
/// sequences are handled, a byte of a broken sequence being a character of its own.
///
/// A position outside the text raises CInvalidArgException where a character is asked for; ranges are cut to the text.
/// A text that would be larger than 2 GB, or that no memory is left for, raises CMemoryException.
///
/// Null pointers stand for the empty text. Format and TRACE take a string for "%s"; through the "..." of other calls it
/// cannot be passed: `printf("%s", text)` does not compile here. Pass `text.GetString()` or `(LPCTSTR)text`.
///
/// @code
/// CString name = "drawing";
/// name += ".brd";
/// CString title;
/// title.Format("%s (%d)", name.Left(7), 3); // "drawing (3)"
/// @endcode
template <>
class TVX_PLATFORM_API CStringT<char> {
public:
    /// The character type and pointers to it, for code that is written over several string classes.
    using XCHAR = char;
    using PXSTR = char*;
    using PCXSTR = const char*;

    // Making and assigning

    /// The empty text, or another string's text.
    CStringT() noexcept;
    CStringT(const CStringT& other);
    CStringT(CStringT&& other) noexcept;
    ~CStringT();
    /// @param text  zero-terminated; null gives the empty text
    CStringT(const char* text);
    /// The first `length` bytes, zeros included. A negative length raises CInvalidArgException.
    CStringT(const char* text, int length);
    /// `repeat` copies of a character; none when `repeat` is 0 or negative.
    CStringT(char character, int repeat = 1);
    CStringT(const unsigned char* text);
    /// Wide text, converted to UTF-8.
    CStringT(const wchar_t* text);
    /// The first `length` elements of a wide text.
    CStringT(const wchar_t* text, int length);
    explicit CStringT(std::string_view text);

    /// Becomes another text. A part of this text may be given.
    CStringT& operator=(const CStringT& other);
    CStringT& operator=(CStringT&& other) noexcept;
    CStringT& operator=(const char* text);
    CStringT& operator=(char character);
    CStringT& operator=(const unsigned char* text);
    CStringT& operator=(const wchar_t* text);
    /// Becomes the zero-terminated text, which may be a part of this one.
    void SetString(const char* text);
    /// Becomes the first `length` bytes of the text, which may be a part of this one.
    void SetString(const char* text, int length);

    // Reading

    /// The text, zero-terminated. Valid until the string is changed or destroyed.
    operator LPCSTR() const noexcept {
        return m_text;
    }
    /// As the conversion, by name.
    LPCSTR GetString() const noexcept {
        return m_text;
    }
    /// The text with its length, embedded zeros included. Valid as long as GetString()'s pointer.
    std::string_view View() const noexcept {
        return {m_text, static_cast<std::size_t>(GetLength())};
    }
    /// Length in bytes.
    int GetLength() const noexcept {
        int length = 0;
        std::memcpy(&length, m_text - lengthBeforeText, sizeof length);
        return length;
    }
    /// Whether the length is 0.
    bool IsEmpty() const noexcept {
        return GetLength() == 0;
    }
    /// The byte at a position; the terminator at the length.
    char GetAt(int index) const;
    /// As GetAt().
    char operator[](INT_PTR index) const;
    /// Replaces a byte; the position must be inside the text.
    void SetAt(int index, char character);
    /// Becomes the empty text and gives its memory back.
    void Empty() noexcept;
    /// Bytes that fit without a new buffer.
    int GetAllocLength() const noexcept;

    // Comparing: negative, 0 or positive

    /// By bytes.
    int Compare(const CStringT& other) const noexcept;
    int Compare(LPCSTR text) const noexcept;
    /// Without regard to case, by the rules of Text.h.
    int CompareNoCase(const CStringT& other) const noexcept;
    int CompareNoCase(LPCSTR text) const noexcept;
    /// In the order of the user's language.
    int Collate(LPCSTR text) const noexcept;
    /// In the order of the user's language, without regard to case.
    int CollateNoCase(LPCSTR text) const;

    // Parts

    /// The text from `first` to the end. A negative position counts as 0.
    CStringT Mid(int first) const;
    /// At most `count` bytes from `first`; a negative count counts as 0.
    CStringT Mid(int first, int count) const;
    /// The first, or last, `count` bytes; the whole text when it is shorter.
    /// @{
    CStringT Left(int count) const;
    CStringT Right(int count) const;
    /// @}
    /// The longest beginning made only of characters of `set`.
    CStringT SpanIncluding(LPCSTR set) const;
    /// The longest beginning without any character of `set`.
    CStringT SpanExcluding(LPCSTR set) const;
    /// The next field between characters of `separators`. Runs of them count as one.
    /// @param start  where to look, 0 at first; moves behind the field, and becomes -1 when there is none left
    CStringT Tokenize(LPCSTR separators, int& start) const;

    // Finding: positions in bytes, -1 for not found

    /// The first place at or behind `start`.
    int Find(char character, int start = 0) const noexcept;
    /// An empty text is found at `start`.
    int Find(LPCSTR text, int start = 0) const noexcept;
    /// The last place.
    int ReverseFind(char character) const noexcept;
    /// The first character that belongs to `set`.
    int FindOneOf(LPCSTR set) const noexcept;

    // Changing

    /// Appending: a text, its first `length` bytes, or one character. A part of this text may be appended.
    /// @{
    CStringT& operator+=(const CStringT& text);
    CStringT& operator+=(LPCSTR text);
    CStringT& operator+=(char character);
    void Append(LPCSTR text);
    void Append(LPCSTR text, int length);
    void Append(const CStringT& text);
    void AppendChar(char character);
    /// @}
    /// Changes letters one to one; other characters and broken bytes stay.
    /// @{
    CStringT& MakeUpper();
    CStringT& MakeLower();
    /// @}
    /// Reverses the characters.
    CStringT& MakeReverse();
    /// Removes white space (blank, tab, line ends) at both ends.
    CStringT& Trim();
    /// Removes every copy of a character at both ends.
    CStringT& Trim(char character);
    /// Removes the characters of a set at both ends.
    CStringT& Trim(LPCSTR set);
    /// As Trim(), at the beginning only.
    CStringT& TrimLeft();
    CStringT& TrimLeft(char character);
    CStringT& TrimLeft(LPCSTR set);
    /// As Trim(), at the end only.
    CStringT& TrimRight();
    CStringT& TrimRight(char character);
    CStringT& TrimRight(LPCSTR set);
    /// @return how many were replaced
    int Replace(char before, char after);
    /// Replaces every occurrence, from the beginning, without looking at what was put in. An empty `before` replaces
    /// nothing.
    /// @return how many were replaced
    int Replace(LPCSTR before, LPCSTR after);
    /// @return how many were removed
    int Remove(char character);
    /// Inserts at a position cut to the text's range.
    /// @return the new length
    int Insert(int index, char character);
    int Insert(int index, LPCSTR text);
    /// Deletes up to `count` bytes from `index`.
    /// @return the new length
    int Delete(int index, int count = 1);
    /// Cuts the text to at most `length` bytes.
    void Truncate(int length);

    // Formatting: as printf, in the C locale whatever the user's locale is. Arguments may point into this text.

    /// Becomes the formatted text.
    void Format(LPCSTR format, ...) __attribute__((format(printf, 2, 3)));
    /// The format is a string of the resources; an unknown one raises CInvalidArgException.
    void Format(UINT formatId, ...);
    /// The same with strings among the arguments.
    /// @{
    template <class... Arguments>
        requires(tvx::FormattedText<Arguments> || ...)
    void Format(LPCSTR format, Arguments... arguments) {
        Format(format, tvx::formatArgument(arguments)...);
    }
    template <class... Arguments>
        requires(tvx::FormattedText<Arguments> || ...)
    void Format(UINT formatId, Arguments... arguments) {
        Format(formatId, tvx::formatArgument(arguments)...);
    }
    /// @}
    /// As Format(), with the arguments in a list.
    void FormatV(LPCSTR format, std::va_list arguments) __attribute__((format(printf, 2, 0)));
    /// Appends the formatted text.
    void AppendFormat(LPCSTR format, ...) __attribute__((format(printf, 2, 3)));
    void AppendFormat(UINT formatId, ...);
    /// The same with strings among the arguments.
    /// @{
    template <class... Arguments>
        requires(tvx::FormattedText<Arguments> || ...)
    void AppendFormat(LPCSTR format, Arguments... arguments) {
        AppendFormat(format, tvx::formatArgument(arguments)...);
    }
    template <class... Arguments>
        requires(tvx::FormattedText<Arguments> || ...)
    void AppendFormat(UINT formatId, Arguments... arguments) {
        AppendFormat(formatId, tvx::formatArgument(arguments)...);
    }
    /// @}
    /// As AppendFormat(), with the arguments in a list.
    void AppendFormatV(LPCSTR format, std::va_list arguments) __attribute__((format(printf, 2, 0)));

    // Elsewhere

    /// Loads a string through the application's resources and its extension modules.
    /// @return whether the string exists; if not, the text stays as it was
    BOOL LoadString(UINT id);
    /// Loads a string of one module; null is the application and its extension modules.
    BOOL LoadString(HINSTANCE module, UINT id);
    /// Becomes the value of an environment variable.
    /// @return whether the variable exists; if not, the text becomes empty
    BOOL GetEnvironmentVariable(LPCSTR name);

    // Writing into the buffer: call ReleaseBuffer before anything else is done with the string.

    /// The text, to be changed in place without getting longer.
    char* GetBuffer();
    /// As GetBuffer(), with room for `minimum` bytes and a terminator. The text's length stays until it is released.
    char* GetBuffer(int minimum);
    /// As GetBuffer(length), and the text has that length at once.
    char* GetBufferSetLength(int length);
    /// Ends writing. -1: the text ends at the first zero.
    void ReleaseBuffer(int length = -1);
    /// Ends writing; the text has `length` bytes, zeros included.
    void ReleaseBufferSetLength(int length);
    /// As GetBuffer(), and copies of the string do not share this buffer until UnlockBuffer.
    char* LockBuffer();
    /// Lets copies share the buffer again.
    void UnlockBuffer() noexcept;
    /// Gets room for `length` bytes, to append without new buffers.
    void Preallocate(int length);
    /// Gives back memory beyond the text.
    void FreeExtra();

private:
    explicit CStringT(char* adopted, std::nullptr_t) noexcept : m_text(adopted) {}
    static CStringT join(std::string_view left, std::string_view right);
    void assign(std::string_view text);
    void append(std::string_view text);
    void makeOwn(int capacity);
    void setLength(int length) noexcept;
    void replaceRange(int index, int count, std::string_view text);
    void keepRange(std::size_t begin, std::size_t end);

    /// How far before the text its length is kept.
    static constexpr std::size_t lengthBeforeText = 8;

    char* m_text;

    friend CStringT operator+(const CStringT& left, const CStringT& right) {
        return join(left.View(), right.View());
    }
    friend CStringT operator+(const CStringT& left, LPCSTR right) {
        return join(left.View(), viewOf(right));
    }
    friend CStringT operator+(LPCSTR left, const CStringT& right) {
        return join(viewOf(left), right.View());
    }
    friend CStringT operator+(const CStringT& left, char right) {
        return join(left.View(), {&right, 1});
    }
    friend CStringT operator+(char left, const CStringT& right) {
        return join({&left, 1}, right.View());
    }
    friend bool operator==(const CStringT& left, const CStringT& right) noexcept {
        return left.View() == right.View();
    }
    friend bool operator==(const CStringT& left, LPCSTR right) noexcept {
        return left.View() == viewOf(right);
    }
    friend std::strong_ordering operator<=>(const CStringT& left, const CStringT& right) noexcept {
        return left.View() <=> right.View();
    }
    friend std::strong_ordering operator<=>(const CStringT& left, LPCSTR right) noexcept {
        return left.View() <=> viewOf(right);
    }
    static std::string_view viewOf(LPCSTR text) noexcept {
        return text ? std::string_view(text) : std::string_view();
    }
};

using CString = CStringT<char>;
using CStringA = CString;

/// Strings as keys of the standard hash containers.
template <>
struct std::hash<CString> {
    /// Of the whole text, embedded zeros included.
    std::size_t operator()(const CString& text) const noexcept {
        return std::hash<std::string_view>()(text.View());
    }
};

/// The field with number `index` (from 0) of a text of fields.
/// @param result     receives the field; emptied when there is none
/// @param text       zero-terminated; null has no fields
/// @param separator  ends a field
/// @return whether the text has so many fields
TVX_PLATFORM_API BOOL AfxExtractSubString(CString& result, LPCSTR text, int index, char separator = '\n');
