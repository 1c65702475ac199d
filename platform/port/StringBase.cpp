#include "platform/port/StringBase.h"

#include "platform/base/Text.h"

#include <algorithm>
#include <cstdarg>

namespace Port {

namespace {

/// "Not found" is the largest position, which becomes -1.
int toIndex(std::size_t position) {
    return position == std::string::npos ? -1 : static_cast<int>(position);
}

std::size_t toPosition(int index) {
    return static_cast<std::size_t>(std::max(index, 0));
}

std::string_view orEmpty(const char* text) {
    return text ? std::string_view(text) : std::string_view();
}

} // namespace

StringBase<char>::StringBase(const char* text) : m_text(orEmpty(text)) {}

StringBase<char>::StringBase(std::string_view text) : m_text(text) {}

StringBase<char>::StringBase(const std::string& text) : m_text(text) {}

const char* StringBase<char>::c_str() const {
    return m_text.c_str();
}

const std::string& StringBase<char>::str() const {
    return m_text;
}

int StringBase<char>::GetLength() const {
    return static_cast<int>(m_text.size());
}

bool StringBase<char>::IsEmpty() const {
    return m_text.empty();
}

StringBase<char>& StringBase<char>::operator+=(const StringBase& other) {
    m_text += other.m_text;
    return *this;
}

int StringBase<char>::Compare(const StringBase& other, Case letterCase) const {
    return letterCase == Case::Ignored ? tvx::text::compareNoCase(m_text, other.m_text) : m_text.compare(other.m_text);
}

void StringBase<char>::Trim(const char* characters) {
    const std::string_view set = orEmpty(characters);
    m_text.erase(0, std::min(m_text.find_first_not_of(set), m_text.size()));
    m_text.erase(m_text.find_last_not_of(set) + 1);
}

void StringBase<char>::ReplaceChars(const char* characters, char replacement) {
    const std::string_view set = orEmpty(characters);
    std::replace_if(
        m_text.begin(), m_text.end(), [&](char byte) { return set.find(byte) != std::string_view::npos; }, replacement);
}

void StringBase<char>::Format(const char* format, ...) {
    std::va_list arguments;
    va_start(arguments, format);
    m_text = tvx::text::formatV(format, arguments);
    va_end(arguments);
}

int StringBase<char>::GetIndexOfFirstChar(const char* characters, int from) const {
    return toIndex(m_text.find_first_of(orEmpty(characters), toPosition(from)));
}

int StringBase<char>::GetIndexOfLastChar(const char* characters) const {
    return toIndex(m_text.find_last_of(orEmpty(characters)));
}

int StringBase<char>::GetIndexOfString(const char* text, int from) const {
    return toIndex(m_text.find(orEmpty(text), toPosition(from)));
}

StringBase<char> StringBase<char>::Extract(Range range) const {
    return Extract(range.start, std::max(range.length, 0));
}

StringBase<char> StringBase<char>::Extract(int start, int length) const {
    const std::string_view rest = std::string_view(m_text).substr(std::min(toPosition(start), m_text.size()));
    return length < 0 ? rest : rest.substr(0, static_cast<std::size_t>(length));
}

bool StringBase<char>::NextTokenRange(Range& range, const char* delimiters) const {
    const std::string_view set = orEmpty(delimiters);
    const std::size_t start = m_text.find_first_not_of(set, toPosition(range.start) + toPosition(range.length));
    if (start == std::string::npos) {
        return false;
    }
    const std::size_t end = std::min(m_text.find_first_of(set, start), m_text.size());
    range = {static_cast<int>(start), static_cast<int>(end - start)};
    return true;
}

} // namespace Port
