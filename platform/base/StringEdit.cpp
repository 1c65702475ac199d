#include "platform/base/String.h"

#include "platform/base/Exception.h"
#include "platform/base/Text.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <string>
#include <vector>

namespace {

constexpr std::string_view whiteSpace = " \t\n\v\f\r";

std::string_view viewOrEmpty(LPCSTR text) {
    return text ? std::string_view(text) : std::string_view();
}

/// A set of characters. Those of ASCII, which are most of them, are looked up in a table.
class CharacterSet {
public:
    explicit CharacterSet(std::string_view set) {
        for (std::size_t at = 0; at < set.size();) {
            const std::size_t length = tvx::text::characterLength(set, at);
            const auto byte = static_cast<unsigned char>(set[at]);
            if (byte < m_ascii.size()) {
                m_ascii[byte] = true;
            } else {
                m_others.push_back(set.substr(at, length));
            }
            at += length;
        }
    }
    bool contains(std::string_view character) const {
        const auto byte = static_cast<unsigned char>(character.front());
        if (byte < m_ascii.size()) {
            return m_ascii[byte];
        }
        return std::ranges::find(m_others, character) != m_others.end();
    }

private:
    std::array<bool, 128> m_ascii{};
    std::vector<std::string_view> m_others;
};

enum class Member { Yes, No };

/// Where the first character at or after `at` stands that is, or is not, in the set; the length when there is none.
std::size_t findMember(std::string_view text, std::string_view characters, Member wanted, std::size_t at = 0) {
    const CharacterSet set(characters);
    while (at < text.size()) {
        const bool isAscii = static_cast<unsigned char>(text[at]) < 0x80;
        const std::size_t length = isAscii ? 1 : tvx::text::characterLength(text, at);
        if (set.contains(text.substr(at, length)) == (wanted == Member::Yes)) {
            return at;
        }
        at += length;
    }
    return text.size();
}

/// Where the end of the text is when the set's characters are cut off behind.
std::size_t trimmedEnd(std::string_view text, std::string_view characters) {
    const CharacterSet set(characters);
    std::size_t end = text.size();
    while (end > 0) {
        const std::size_t last = tvx::text::previousCharacter(text, end);
        if (!set.contains(text.substr(last, end - last))) {
            break;
        }
        end = last;
    }
    return end;
}

int positionOf(std::size_t found) {
    return found == std::string_view::npos ? -1 : static_cast<int>(found);
}

int sign(int comparison) {
    return comparison < 0 ? -1 : comparison > 0 ? 1 : 0;
}

} // namespace

int CStringT<char>::Compare(const CStringT& other) const noexcept {
    return sign(View().compare(other.View()));
}

int CStringT<char>::Compare(LPCSTR text) const noexcept {
    return sign(View().compare(viewOf(text)));
}

int CStringT<char>::CompareNoCase(const CStringT& other) const noexcept {
    return tvx::text::compareNoCase(View(), other.View());
}

int CStringT<char>::CompareNoCase(LPCSTR text) const noexcept {
    return tvx::text::compareNoCase(View(), viewOf(text));
}

int CStringT<char>::Collate(LPCSTR text) const noexcept {
    return sign(std::strcoll(m_text, text ? text : ""));
}

int CStringT<char>::CollateNoCase(LPCSTR text) const {
    return sign(std::strcoll(tvx::text::foldCase(View()).c_str(), tvx::text::foldCase(viewOf(text)).c_str()));
}

CStringT<char> CStringT<char>::Mid(int first) const {
    return Mid(first, GetLength());
}

CStringT<char> CStringT<char>::Mid(int first, int count) const {
    const int begin = std::clamp(first, 0, GetLength());
    const int length = std::clamp(count, 0, GetLength() - begin);
    if (length == GetLength()) {
        return *this;
    }
    return CStringT(View().substr(static_cast<std::size_t>(begin), static_cast<std::size_t>(length)));
}

CStringT<char> CStringT<char>::Left(int count) const {
    return Mid(0, count);
}

CStringT<char> CStringT<char>::Right(int count) const {
    return Mid(GetLength() - std::clamp(count, 0, GetLength()));
}

CStringT<char> CStringT<char>::SpanIncluding(LPCSTR set) const {
    return Left(static_cast<int>(findMember(View(), viewOrEmpty(set), Member::No)));
}

CStringT<char> CStringT<char>::SpanExcluding(LPCSTR set) const {
    return Left(static_cast<int>(findMember(View(), viewOrEmpty(set), Member::Yes)));
}

CStringT<char> CStringT<char>::Tokenize(LPCSTR separators, int& start) const {
    if (start < 0) {
        AfxThrowInvalidArgException();
    }
    const std::string_view set = viewOrEmpty(separators);
    const std::size_t begin = findMember(View(), set, Member::No, static_cast<std::size_t>(start));
    if (begin >= View().size()) {
        start = -1;
        return {};
    }
    const std::size_t end = findMember(View(), set, Member::Yes, begin);
    start = static_cast<int>(end);
    return Mid(static_cast<int>(begin), static_cast<int>(end - begin));
}

int CStringT<char>::Find(char character, int start) const noexcept {
    return start < 0 ? -1 : positionOf(View().find(character, static_cast<std::size_t>(start)));
}

int CStringT<char>::Find(LPCSTR text, int start) const noexcept {
    return start < 0 ? -1 : positionOf(View().find(viewOf(text), static_cast<std::size_t>(start)));
}

int CStringT<char>::ReverseFind(char character) const noexcept {
    return positionOf(View().rfind(character));
}

int CStringT<char>::FindOneOf(LPCSTR set) const noexcept {
    const std::size_t found = findMember(View(), viewOrEmpty(set), Member::Yes);
    return found == View().size() ? -1 : static_cast<int>(found);
}

CStringT<char>& CStringT<char>::operator+=(const CStringT& text) {
    Append(text);
    return *this;
}

CStringT<char>& CStringT<char>::operator+=(LPCSTR text) {
    append(viewOf(text));
    return *this;
}

CStringT<char>& CStringT<char>::operator+=(char character) {
    AppendChar(character);
    return *this;
}

void CStringT<char>::Append(LPCSTR text) {
    append(viewOf(text));
}

void CStringT<char>::Append(LPCSTR text, int length) {
    if (length < 0) {
        AfxThrowInvalidArgException();
    }
    append(text ? std::string_view(text, static_cast<std::size_t>(length)) : std::string_view());
}

void CStringT<char>::Append(const CStringT& text) {
    if (IsEmpty() && GetAllocLength() == 0) {
        *this = text;
    } else {
        append(text.View());
    }
}

void CStringT<char>::AppendChar(char character) {
    append({&character, 1});
}

CStringT<char>& CStringT<char>::MakeUpper() {
    assign(tvx::text::toUpper(View()));
    return *this;
}

CStringT<char>& CStringT<char>::MakeLower() {
    assign(tvx::text::toLower(View()));
    return *this;
}

CStringT<char>& CStringT<char>::MakeReverse() {
    std::string reversed;
    const std::string_view text = View();
    reversed.reserve(text.size());
    for (std::size_t end = text.size(); end > 0;) {
        const std::size_t begin = tvx::text::previousCharacter(text, end);
        reversed += text.substr(begin, end - begin);
        end = begin;
    }
    assign(reversed);
    return *this;
}

CStringT<char>& CStringT<char>::Trim() {
    return TrimRight().TrimLeft();
}

CStringT<char>& CStringT<char>::Trim(char character) {
    return TrimRight(character).TrimLeft(character);
}

CStringT<char>& CStringT<char>::Trim(LPCSTR set) {
    return TrimRight(set).TrimLeft(set);
}

CStringT<char>& CStringT<char>::TrimLeft() {
    keepRange(findMember(View(), whiteSpace, Member::No), View().size());
    return *this;
}

CStringT<char>& CStringT<char>::TrimLeft(char character) {
    keepRange(std::min(View().find_first_not_of(character), View().size()), View().size());
    return *this;
}

CStringT<char>& CStringT<char>::TrimLeft(LPCSTR set) {
    keepRange(findMember(View(), viewOrEmpty(set), Member::No), View().size());
    return *this;
}

CStringT<char>& CStringT<char>::TrimRight() {
    keepRange(0, trimmedEnd(View(), whiteSpace));
    return *this;
}

CStringT<char>& CStringT<char>::TrimRight(char character) {
    keepRange(0, View().find_last_not_of(character) + 1);
    return *this;
}

CStringT<char>& CStringT<char>::TrimRight(LPCSTR set) {
    keepRange(0, trimmedEnd(View(), viewOrEmpty(set)));
    return *this;
}

int CStringT<char>::Replace(char before, char after) {
    const auto count = static_cast<int>(std::ranges::count(View(), before));
    if (count > 0 && before != after) {
        char* const text = GetBuffer();
        std::replace(text, text + GetLength(), before, after);
    }
    return count;
}

int CStringT<char>::Replace(LPCSTR before, LPCSTR after) {
    const std::string_view wanted = viewOf(before);
    const std::string_view replacement = viewOf(after);
    const std::string_view text = View();
    std::size_t found = wanted.empty() ? std::string_view::npos : text.find(wanted);
    if (found == std::string_view::npos) {
        return 0;
    }
    CStringT result;
    int count = 0;
    std::size_t copied = 0;
    for (; found != std::string_view::npos; found = text.find(wanted, copied)) {
        result.append(text.substr(copied, found - copied));
        result.append(replacement);
        copied = found + wanted.size();
        ++count;
    }
    result.append(text.substr(copied));
    *this = std::move(result);
    return count;
}

int CStringT<char>::Remove(char character) {
    const auto count = static_cast<int>(std::ranges::count(View(), character));
    if (count > 0) {
        char* const text = GetBuffer();
        ReleaseBufferSetLength(static_cast<int>(std::remove(text, text + GetLength(), character) - text));
    }
    return count;
}

int CStringT<char>::Insert(int index, char character) {
    replaceRange(index, 0, {&character, 1});
    return GetLength();
}

int CStringT<char>::Insert(int index, LPCSTR text) {
    replaceRange(index, 0, viewOf(text));
    return GetLength();
}

int CStringT<char>::Delete(int index, int count) {
    replaceRange(index, count, {});
    return GetLength();
}

/// Puts a text, which may be a part of this one, in the place of a range that is cut to this text.
void CStringT<char>::replaceRange(int index, int count, std::string_view text) {
    const auto begin = static_cast<std::size_t>(std::clamp(index, 0, GetLength()));
    const auto removed = static_cast<std::size_t>(std::clamp(count, 0, GetLength() - static_cast<int>(begin)));
    if (removed == 0 && text.empty()) {
        return;
    }
    CStringT result = join(View().substr(0, begin), text);
    result.append(View().substr(begin + removed));
    *this = std::move(result);
}

void CStringT<char>::keepRange(std::size_t begin, std::size_t end) {
    if (begin > 0 || end < View().size()) {
        assign(View().substr(begin, std::max(begin, end) - begin));
    }
}

BOOL AfxExtractSubString(CString& result, LPCSTR text, int index, char separator) {
    const char* field = text;
    for (; field && index > 0; --index) {
        field = std::strchr(field, separator);
        if (field) {
            ++field;
        }
    }
    if (!field || index < 0) {
        result.Empty();
        return FALSE;
    }
    const char* const end = std::strchr(field, separator);
    result = end ? CString(field, static_cast<int>(end - field)) : CString(field);
    return TRUE;
}
