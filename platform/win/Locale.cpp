#include "platform/win/Locale.h"

#include "platform/base/Text.h"
#include "platform/win/Error.h"
#include "platform/win/detail/LanguageTable.h"

#include <algorithm>
#include <cstdlib>
#include <string>
#include <string_view>

namespace {

constexpr LCID american = 0x0409;

std::string_view localeName() {
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"}) {
        if (const char* value = std::getenv(variable); value && *value != '\0') {
            return value;
        }
    }
    return {};
}

// "sr_RS@latin" for "sr_RS.UTF-8@latin": some modifiers tell a script, encodings tell nothing about the language.
std::string withoutEncoding(std::string_view name) {
    const std::size_t encoding = name.find('.');
    const std::size_t modifier = name.find('@');
    std::string result(name.substr(0, std::min(encoding, modifier)));
    if (modifier != std::string_view::npos) {
        result += name.substr(modifier);
    }
    return result;
}

} // namespace

LCID GetUserDefaultLCID() {
    const std::string name = withoutEncoding(localeName());
    // The most frequent answers need no look into the table.
    if (name.empty() || name == "C" || name == "POSIX") {
        return american;
    }
    const tvx::detail::Language* language = tvx::detail::languageNamed(name);
    return language ? language->id : american;
}

int GetLocaleInfoA(LCID locale, LCTYPE type, LPSTR buffer, int size) {
    if (type != LOCALE_SABBREVLANGNAME) {
        SetLastError(ERROR_INVALID_FLAGS);
        return 0;
    }
    if (locale == LOCALE_USER_DEFAULT || locale == LOCALE_SYSTEM_DEFAULT) {
        locale = GetUserDefaultLCID();
    }
    const tvx::detail::Language* language = tvx::detail::languageOf(locale);
    if (!language || size < 0 || (size > 0 && !buffer)) {
        SetLastError(ERROR_INVALID_PARAMETER);
        return 0;
    }
    const std::string_view text = language->abbreviation;
    const int needed = static_cast<int>(text.size()) + 1;
    if (size > 0 && !tvx::text::copyWhole(text, buffer, static_cast<std::size_t>(size))) {
        SetLastError(ERROR_INSUFFICIENT_BUFFER);
        return 0;
    }
    return needed;
}
