#include "platform/base/String.h"

#include "platform/base/Exception.h"
#include "platform/base/StringSource.h"
#include "platform/base/Text.h"

#include <cstdlib>
#include <string>

namespace {

constinit tvx::StringLoader stringLoader = nullptr;

CString loadFormat(UINT id) {
    CString format;
    if (!format.LoadString(id)) {
        AfxThrowInvalidArgException();
    }
    return format;
}

} // namespace

void CStringT<char>::Format(LPCSTR format, ...) {
    std::va_list arguments;
    va_start(arguments, format);
    FormatV(format, arguments);
    va_end(arguments);
}

void CStringT<char>::Format(UINT formatId, ...) {
    const CString format = loadFormat(formatId);
    std::va_list arguments;
    va_start(arguments, formatId);
    FormatV(format, arguments);
    va_end(arguments);
}

void CStringT<char>::FormatV(LPCSTR format, std::va_list arguments) {
    *this = tvx::allocating([&] { return CStringT(tvx::text::formatV(format, arguments)); });
}

void CStringT<char>::AppendFormat(LPCSTR format, ...) {
    std::va_list arguments;
    va_start(arguments, format);
    AppendFormatV(format, arguments);
    va_end(arguments);
}

void CStringT<char>::AppendFormat(UINT formatId, ...) {
    const CString format = loadFormat(formatId);
    std::va_list arguments;
    va_start(arguments, formatId);
    AppendFormatV(format, arguments);
    va_end(arguments);
}

void CStringT<char>::AppendFormatV(LPCSTR format, std::va_list arguments) {
    append(tvx::allocating([&] { return tvx::text::formatV(format, arguments); }));
}

BOOL CStringT<char>::LoadString(UINT id) {
    return LoadString(nullptr, id);
}

BOOL CStringT<char>::LoadString(HINSTANCE module, UINT id) {
    std::string text;
    if (!tvx::allocating([&] { return tvx::loadString(module, id, text); })) {
        return FALSE;
    }
    assign(text);
    return TRUE;
}

BOOL CStringT<char>::GetEnvironmentVariable(LPCSTR name) {
    const char* const value = name ? std::getenv(name) : nullptr;
    assign(viewOf(value));
    return value != nullptr;
}

namespace tvx {

void setStringLoader(StringLoader loader) noexcept {
    stringLoader = loader;
}

bool loadString(HINSTANCE module, UINT id, std::string& text) {
    return stringLoader && stringLoader(module, id, text);
}

} // namespace tvx
