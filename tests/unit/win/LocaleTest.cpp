#include "platform/win/Locale.h"

#include "platform/win/Error.h"
#include "platform/win/detail/LanguageTable.h"
#include "tests/unit/SavedEnvironment.h"

#include <gtest/gtest.h>

#include <cctype>
#include <cstdlib>
#include <set>
#include <string>

namespace {

class Locale : public testing::Test {
    SavedEnvironment m_environment;
};

void setLanguage(const char* all, const char* messages = nullptr, const char* lang = nullptr) {
    const std::pair<const char*, const char*> variables[] = {
        {"LC_ALL", all}, {"LC_MESSAGES", messages}, {"LANG", lang}};
    for (const auto& [name, value] : variables) {
        value ? setenv(name, value, 1) : unsetenv(name);
    }
}

LCID localeFor(const char* name) {
    setLanguage(name);
    return GetUserDefaultLCID();
}

std::string abbreviation(LCID locale) {
    char text[4] = "";
    return GetLocaleInfoA(locale, LOCALE_SABBREVLANGNAME, text, sizeof text) == 4 ? text : "";
}

} // namespace

TEST_F(Locale, ComesFromTheEnvironment) {
    EXPECT_EQ(localeFor("de_DE.UTF-8"), 0x0407u);
    EXPECT_EQ(localeFor("de_AT@euro"), 0x0C07u);
    EXPECT_EQ(localeFor("ja_JP.eucJP"), 0x0411u);
    EXPECT_EQ(localeFor("en_GB"), 0x0809u);
    EXPECT_EQ(localeFor("zh_TW.Big5"), 0x0404u);
    // A country or modifier that is unknown is passed over, a language that is unknown is English.
    EXPECT_EQ(localeFor("de_XX"), 0x0407u);
    EXPECT_EQ(localeFor("pt"), 0x0416u);
    EXPECT_EQ(localeFor("sr_RS.UTF-8@latin"), 0x081Au);
    EXPECT_EQ(localeFor("sr_RS@elsewhere"), 0x0C1Au);
    for (const char* english : {"C", "C.UTF-8", "POSIX", "eo", "xx_YY", "@", "_", ".", "de.", "DE"}) {
        EXPECT_EQ(localeFor(english), std::string_view(english) == "de." ? 0x0407u : 0x0409u) << english;
    }
}

TEST_F(Locale, TakesTheFirstVariableThatIsNotEmpty) {
    setLanguage(nullptr, nullptr, nullptr);
    EXPECT_EQ(GetUserDefaultLCID(), 0x0409u);
    setLanguage(nullptr, nullptr, "fr_FR");
    EXPECT_EQ(GetUserDefaultLCID(), 0x040Cu);
    setLanguage("", "it_IT", "fr_FR");
    EXPECT_EQ(GetUserDefaultLCID(), 0x0410u);
    setLanguage("es_MX", "it_IT", "fr_FR");
    EXPECT_EQ(GetUserDefaultLCID(), 0x080Au);
}

TEST_F(Locale, TellsTheLanguagesAbbreviation) {
    setLanguage("de_CH");
    EXPECT_EQ(abbreviation(LOCALE_USER_DEFAULT), "DES");
    EXPECT_EQ(abbreviation(0x0407), "DEU");
    EXPECT_EQ(abbreviation(0x0411), "JPN");
    EXPECT_EQ(abbreviation(0x0409), "ENU");
    EXPECT_EQ(GetLocaleInfoA(0x0407, LOCALE_SABBREVLANGNAME, nullptr, 0), 4);
    char text[3] = "-";
    EXPECT_EQ(GetLocaleInfoA(0x0407, LOCALE_SABBREVLANGNAME, text, sizeof text), 0);
    EXPECT_EQ(GetLastError(), ERROR_INSUFFICIENT_BUFFER);
    EXPECT_STREQ(text, "-");
    EXPECT_EQ(GetLocaleInfoA(0x7777, LOCALE_SABBREVLANGNAME, text, sizeof text), 0);
    EXPECT_EQ(GetLastError(), ERROR_INVALID_PARAMETER);
    EXPECT_EQ(GetLocaleInfoA(0x0407, 0x7777, text, sizeof text), 0);
    EXPECT_EQ(GetLastError(), ERROR_INVALID_FLAGS);
}

TEST_F(Locale, LanguagesHaveOneAbbreviationEach) {
    std::set<std::string> abbreviations;
    std::set<LANGID> numbers;
    for (const tvx::detail::Language& language : tvx::detail::languages()) {
        const std::string text = language.abbreviation;
        EXPECT_EQ(text.size(), 3u) << language.name;
        EXPECT_TRUE(std::isupper(text[0]) && std::isupper(text[1]) && std::isupper(text[2])) << text;
        EXPECT_EQ(abbreviations.insert(text).second, numbers.insert(language.id).second) << text;
        EXPECT_EQ(tvx::detail::languageNamed(language.name)->abbreviation, text) << language.name;
        EXPECT_NE(SUBLANGID(language.id), 0) << text;
    }
    EXPECT_GT(abbreviations.size(), 100u);
}
