#include "platform/base/Text.h"

#include "platform/base/Exception.h"

#include <gtest/gtest.h>

#include <climits>
#include <clocale>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <random>

namespace text = tvx::text;

namespace {

/// Well-formed, broken and cut sequences: lone continuation, overlong, surrogate, beyond U+10FFFF, cut at the end.
const std::string brokenTexts[] = {"a\x80z",           "\xC0\xAF",         "\xE2\x82",
                                   "\xED\xA0\x80",     "\xF4\x90\x80\x80", "\xF0\x9F\x98z",
                                   "ok \xFF\xFE \xC3", "\xC3\xA4\x80\xC3", "\xE2\x28\xA1"};

std::string randomBytes(std::mt19937& generator) {
    // Bytes that take part in sequences come often.
    static const std::string pool = "aZ\x80\xBF\xC3\xA4\xE2\x82\xAC\xED\xA0\xF0\x9F\x98\x80\xF4\x90\xFF";
    std::string result(generator() % 12, '\0');
    for (char& byte : result) {
        byte = pool[generator() % pool.size()];
    }
    return result;
}

} // namespace

TEST(Text, FoldsLettersOneToOneWithoutTouchingAscii) {
    EXPECT_EQ(0, text::compareNoCase("Software\\TARVEX", "SOFTWARE\\tarvex"));
    EXPECT_TRUE(text::equalNoCase("ÉCRAN Ж ΣΊΣΥΦΟΣ", "écran ж σίσυφος"));
    EXPECT_FALSE(text::equalNoCase("straße", "STRASSE"));
    // The Kelvin sign, the long s and the dotless i are no ASCII letters in disguise.
    EXPECT_FALSE(text::equalNoCase("\u212A", "k"));
    EXPECT_FALSE(text::equalNoCase("\u017Fmoketest", "smoketest"));
    EXPECT_FALSE(text::equalNoCase("\u0131", "I"));
    EXPECT_FALSE(text::equalNoCase("\xC4", "\xE4"));
    EXPECT_EQ("ÉTÉ \xFF", text::toUpper("été \xFF"));
    for (const char32_t letter : {U'a', U'Z', U'é', U'ß', U'語', U'п'}) {
        EXPECT_TRUE(text::isLetter(letter)) << static_cast<unsigned>(letter);
    }
    for (const char32_t other : {U'\0', U'1', U'!', U'_', U' ', U'、', U'\u2014', char32_t{0xDCFF}}) {
        EXPECT_FALSE(text::isLetter(other)) << static_cast<unsigned>(other);
    }
}

TEST(Text, OrdersWithoutCaseAsTheLowerCaseLetters) {
    EXPECT_LT(text::compareNoCase("_", "A"), 0);
    EXPECT_LT(text::compareNoCase("abc", "ABCD"), 0);
    EXPECT_GT(text::compareNoCase("b", "A"), 0);
    EXPECT_LT(text::compareNoCase(std::string_view("a\0b", 3), std::string_view("A\0c", 3)), 0);
}

TEST(Text, EqualWithoutCaseMeansEqualFoldedForms) {
    std::mt19937 generator(1);
    for (int i = 0; i < 2000; ++i) {
        const std::string left = randomBytes(generator);
        const std::string right = i % 2 ? text::toUpper(left) : randomBytes(generator);
        EXPECT_EQ(text::equalNoCase(left, right), text::foldCase(left) == text::foldCase(right));
        EXPECT_EQ(text::compareNoCase(left, right), -text::compareNoCase(right, left));
    }
}

TEST(Text, FindsPrefixesWithoutCase) {
    EXPECT_TRUE(text::startsWithNoCase("FILE:///x", "file:"));
    EXPECT_TRUE(text::startsWithNoCase("x", ""));
    EXPECT_FALSE(text::startsWithNoCase("fil", "file"));
    EXPECT_FALSE(text::startsWithNoCase("Ä", "\xC3"));
}

TEST(Text, StepsOverWholeSequencesAndSingleBrokenBytes) {
    const std::string mixed = "aä€😀\x80\xC3";
    std::vector<std::size_t> lengths;
    for (std::size_t at = 0; at < mixed.size(); at += lengths.back()) {
        lengths.push_back(text::characterLength(mixed, at));
    }
    EXPECT_EQ((std::vector<std::size_t>{1, 2, 3, 4, 1, 1}), lengths);
    EXPECT_EQ(6u, text::characterCount(mixed));
    EXPECT_EQ(0u, text::characterLength(mixed, mixed.size()));
    for (const std::string& broken : brokenTexts) {
        EXPECT_FALSE(text::isWellFormed(broken));
    }
    EXPECT_EQ(3u, text::characterCount("\xED\xA0\x80"));
}

TEST(Text, StepsBackToWhereSteppingForwardCameFrom) {
    std::mt19937 generator(2);
    for (int i = 0; i < 2000; ++i) {
        const std::string bytes = randomBytes(generator);
        for (std::size_t at = 0; at < bytes.size();) {
            const std::size_t next = at + text::characterLength(bytes, at);
            EXPECT_EQ(at, text::previousCharacter(bytes, next)) << testing::PrintToString(bytes);
            for (std::size_t inside = at; inside < next; ++inside) {
                EXPECT_EQ(at, text::characterStart(bytes, inside));
            }
            at = next;
        }
    }
}

TEST(Text, GoesIntoBuffersWholeOrCutBetweenCharacters) {
    char buffer[6] = "as is";
    EXPECT_FALSE(text::copyWhole("123456", buffer, sizeof buffer));
    EXPECT_FALSE(text::copyWhole("", buffer, 0));
    EXPECT_STREQ("as is", buffer);
    EXPECT_TRUE(text::copyWhole("12345", buffer, sizeof buffer));
    EXPECT_STREQ("12345", buffer);
    EXPECT_EQ(5u, text::copyCut("abcé", buffer, sizeof buffer));
    EXPECT_STREQ("abcé", buffer);
    EXPECT_EQ(4u, text::copyCut("abcdé", buffer, sizeof buffer));
    EXPECT_STREQ("abcd", buffer);
    EXPECT_EQ(0u, text::copyCut("é", buffer, 2));
    EXPECT_EQ(0u, text::copyCut("a", buffer, 1));
    EXPECT_STREQ("", buffer);
}

TEST(Text, KeepsEveryByteOnTheWayThroughWideText) {
    for (const std::string& broken : brokenTexts) {
        EXPECT_EQ(broken, text::narrow(text::widen(broken)));
        EXPECT_EQ(broken, text::narrow(text::widen16(broken)));
    }
    std::mt19937 generator(3);
    for (int i = 0; i < 2000; ++i) {
        const std::string bytes = randomBytes(generator);
        EXPECT_EQ(bytes, text::narrow(text::widen(bytes)));
        EXPECT_EQ(bytes, text::narrow(text::widen16(bytes)));
    }
    EXPECT_EQ(L"a\xDC80ä😀", text::widen("a\x80ä😀"));
    EXPECT_EQ("😀", text::narrow(std::u16string_view(u"😀")));
    // Halves of a pair alone, and numbers beyond Unicode, give something that is not taken for another character.
    EXPECT_EQ("\xED\xA0\x80", text::narrow(std::wstring(1, static_cast<wchar_t>(0xD800))));
    EXPECT_EQ("\uFFFD", text::narrow(std::wstring(1, static_cast<wchar_t>(0x110000))));
}

TEST(Text, ReadsIntegersAsA32BitPlatformDoes) {
    const auto read = [](const char* source, int base) {
        const char* end = nullptr;
        const int value = text::toInt32(source, &end, base);
        return std::pair(value, std::string(end));
    };
    using Result = std::pair<int, std::string>;
    EXPECT_EQ(Result(42, ""), read(" \t42", 10));
    EXPECT_EQ(Result(-42, " "), read("-42 ", 10));
    EXPECT_EQ(Result(26, ""), read("0x1A", 0));
    EXPECT_EQ(Result(26, ""), read("0x1A", 16));
    EXPECT_EQ(Result(0, "x1A"), read("0x1A", 10));
    EXPECT_EQ(Result(15, ""), read("017", 0));
    EXPECT_EQ(Result(35, ""), read("z", 36));
    EXPECT_EQ(Result(0, " x"), read(" x", 10));
    EXPECT_EQ(Result(0, ""), read("", 10));
    EXPECT_EQ(Result(0, "12"), read("12", 1));
    EXPECT_EQ(Result(INT_MAX, ""), read("2147483648", 10));
    EXPECT_EQ(Result(INT_MIN, ""), read("-2147483649", 10));
    EXPECT_EQ(Result(INT_MAX, "!"), read("99999999999999999999999!", 10));
    EXPECT_EQ(Result(INT_MIN, ""), read("-99999999999999999999999", 10));
}

TEST(Text, ReadsAndWritesRealNumbersWithAPoint) {
    const char* end = nullptr;
    EXPECT_EQ(-1000.0, text::toDouble("-1e3", &end));
    EXPECT_STREQ("", end);
    EXPECT_EQ(2.0, text::toDouble("2,5", &end));
    EXPECT_STREQ(",5", end);
    EXPECT_TRUE(std::isinf(text::toDouble("1e999")));
    EXPECT_EQ("0.1", text::formatDouble(0.1));
    EXPECT_EQ("0.333", text::formatDouble(1.0 / 3, 3));
    std::mt19937_64 generator(4);
    for (int i = 0; i < 500; ++i) {
        const double value = std::ldexp(static_cast<double>(generator()), static_cast<int>(generator() % 400) - 200);
        EXPECT_EQ(value, text::toDouble(text::formatDouble(value).c_str()));
    }
}

TEST(Text, NumbersIgnoreTheProcessLocale) {
    const std::filesystem::path folder = std::filesystem::temp_directory_path() / "locales";
    std::filesystem::create_directories(folder);
    const std::string command =
        "localedef -i de_DE -f ISO-8859-1 '" + (folder / "de_DE.ISO-8859-1").string() + "' 2>/dev/null";
    if (std::system(command.c_str()) != 0) {
        GTEST_SKIP() << "this machine cannot make a locale with a decimal comma";
    }
    ::setenv("LOCPATH", folder.c_str(), 1);
    ASSERT_NE(nullptr, std::setlocale(LC_ALL, "de_DE.ISO-8859-1"));
    char byTheLocale[16];
    std::snprintf(byTheLocale, sizeof byTheLocale, "%.1f", 2.5);
    EXPECT_STREQ("2,5", byTheLocale);
    EXPECT_EQ("2.5", text::format("%.1f", 2.5));
    EXPECT_EQ("2.5", text::formatDouble(2.5));
    EXPECT_EQ(2.5, text::toDouble("2.5"));
    std::snprintf(byTheLocale, sizeof byTheLocale, "%.1f", 2.5);
    EXPECT_STREQ("2,5", byTheLocale);
    std::setlocale(LC_ALL, "C");
    ::unsetenv("LOCPATH");
}

TEST(Text, FormatsLongAndHostsSpecialTexts) {
    EXPECT_EQ(std::string(100000, 'x') + "1.50", text::format("%s%.2f", std::string(100000, 'x').c_str(), 1.5));
    EXPECT_EQ("grün 7%", text::format("%ls %d%%", L"grün", 7));
    // Formats with the size prefixes of hosts come from resources, where the compiler does not see them.
    const char* const hostFormat = "%I64d|%-6I32u|%%I64d|%5.1f";
    const auto formatUnchecked = [](const char* format, ...) {
        std::va_list arguments;
        va_start(arguments, format);
        const std::string result = text::formatV(format, arguments);
        va_end(arguments);
        return result;
    };
    EXPECT_EQ("-5000000000|42    |%I64d|  2.5", formatUnchecked(hostFormat, -5000000000LL, 42u, 2.5));
    EXPECT_EQ("100%", formatUnchecked("100%%"));
}
