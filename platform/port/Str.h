#pragma once

#include "platform/base/Export.h"

#include <string>

/// Conversions between the narrow texts of hosts (UTF-8) and the wide texts of the message managers.
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
};
