#pragma once

#include "platform/base/Export.h"
#include "platform/win/Locale.h"

#include <span>
#include <string_view>

namespace tvx::detail {

/// One of the platform's languages.
struct Language {
    LANGID id;
    const char* name;         ///< as locales of this system are named: "de_AT"
    const char* abbreviation; ///< three letters: "DEA"
};

/// All of them, those of one language together with the one first that a name without a country means.
[[nodiscard]] TVX_PLATFORM_API std::span<const Language> languages();

/// The language of a locale's name without its encoding ("de_AT", "sr_RS@latin"): the very name, the name without its
/// modifier, or the language alone, whichever is known first. Null when the language is unknown.
[[nodiscard]] TVX_PLATFORM_API const Language* languageNamed(std::string_view name);

/// The language of a locale, null when there is none of that number.
[[nodiscard]] const Language* languageOf(LCID locale);

} // namespace tvx::detail
