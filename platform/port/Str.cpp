#include "platform/port/Str.h"

#include "platform/base/Text.h"

#include <cstdarg>
#include <cstdio>
#include <cstring>

std::string UT_STR::WstrToMbstr(const wchar_t* text) {
    return text ? tvx::text::narrow(std::wstring_view(text)) : std::string();
}

std::wstring UT_STR::MbstrToWstr(const char* text) {
    return text ? tvx::text::widen(text) : std::wstring();
}

void UT_STR::WDelStrings(wchar_t** lines, int count) {
    if (!lines) {
        return;
    }
    for (int i = 0; i < count; ++i) {
        delete[] lines[i];
    }
    delete[] lines;
}

int UT_STR::FindString(std::string_view text, std::string_view pattern) {
    const std::size_t at = text.find(pattern);
    return at == std::string_view::npos ? -1 : static_cast<int>(at);
}

char UT_STR::GetToken(std::string& source, std::string& token, const char* delimiters) {
    const std::size_t end = source.find_first_of(delimiters);
    if (end == std::string::npos) {
        token = std::move(source);
        source.clear();
        return '\0';
    }
    const char delimiter = source[end];
    token = source.substr(0, end);
    source.erase(0, end + 1);
    return delimiter;
}

void UT_STR::Trim(std::string& text) {
    static constexpr const char* space = " \t\r\n\v\f";
    text.erase(text.find_last_not_of(space) + 1);
    text.erase(0, text.find_first_not_of(space));
}

int UT_STR::Compare(std::string_view left, std::string_view right) {
    return left.compare(right);
}

int UT_STR::AToI(const char* text) {
    return tvx::text::toInt32(text);
}

int UT_STR::SScanf(const char* text, const char* format, ...) {
    std::va_list arguments;
    va_start(arguments, format);
    const int count = std::vsscanf(text, format, arguments);
    va_end(arguments);
    return count;
}

bool UT_STR::Copy(char* buffer, std::size_t size, const char* text) {
    return tvx::text::copyWhole(text, buffer, size);
}

bool UT_STR::Cat(char* buffer, std::size_t size, const char* text) {
    const std::size_t used = std::strlen(buffer);
    return Copy(buffer + used, size - used, text);
}
