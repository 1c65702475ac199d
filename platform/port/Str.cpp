#include "platform/port/Str.h"

#include "platform/base/Text.h"

std::string UT_STR::WstrToMbstr(const wchar_t* text) {
    return text ? tvx::text::narrow(std::wstring_view(text)) : std::string();
}

std::wstring UT_STR::MbstrToWstr(const char* text) {
    return text ? tvx::text::widen(text) : std::wstring();
}

void UT_STR::WDelStrings(wchar_t** lines, int count) {
    if (!lines)
        return;
    for (int i = 0; i < count; ++i)
        delete[] lines[i];
    delete[] lines;
}
