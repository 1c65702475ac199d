// Wildcard patterns against a matcher that is too simple to be wrong.
#include "platform/base/Text.h"
#include "s/ComboBox.h"
#include "s/ListBox.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <string>
#include <string_view>
#include <vector>

namespace {

int match(const std::string& text, const std::string& pattern) {
    return Gui_ListBox::MatchString(CString(text), CString(pattern));
}

/// One row of the table of what begins where: which ends of the text the pattern so far can reach.
bool referenceMatch(std::string_view text, std::string_view pattern) {
    if (std::ranges::count(pattern, '*') > 10) {
        return false;
    }
    std::vector<bool> reached(text.size() + 1);
    reached[0] = true;
    for (const char wanted : pattern) {
        std::vector<bool> next(text.size() + 1);
        for (std::size_t at = 0; at <= text.size(); ++at) {
            const std::size_t length = at < text.size() ? tvx::text::characterLength(text, at) : 0;
            if (!reached[at]) {
                continue;
            }
            if (wanted == '*') {
                next[at] = true;
                if (length != 0) {
                    reached[at + length] = true;
                }
            } else if (length != 0 && (wanted == '?' || text[at] == wanted)) {
                next[at + (wanted == '?' ? length : 1)] = true;
            }
        }
        reached = next;
    }
    return reached[text.size()];
}

} // namespace

TEST(Wildcard, MatchesWholeTexts) {
    for (const char* pattern : {"*.cpp", "m?in.*", "*", "main.cpp", "*main.cpp*", "m*.*p", "????????", "m*i*.*p*"}) {
        EXPECT_EQ(match("main.cpp", pattern), 1) << pattern;
    }
    for (const char* pattern : {"*.CPP", "main", "", "?", "main.cpp?", "ain.cpp", "m*x*p", "*.cppx", "main.cpp*p"}) {
        EXPECT_EQ(match("main.cpp", pattern), 0) << pattern;
    }
    EXPECT_EQ(match("", ""), 1);
    EXPECT_EQ(match("", "***"), 1);
    EXPECT_EQ(match("", "?"), 0);
    CString text = "main.cpp";
    CString pattern = "m?in.*";
    EXPECT_EQ(Gui_ComboBox::MatchString(text, pattern), 1);
}

TEST(Wildcard, HasRoomForTenStars) {
    EXPECT_EQ(match("", std::string(10, '*')), 1);
    EXPECT_EQ(match("abc", std::string(10, '*')), 1);
    EXPECT_EQ(match("", std::string(11, '*')), 0);
    EXPECT_EQ(match("abc", std::string(11, '*')), 0);
    EXPECT_EQ(match("a.b.c.d.e.f.g.h.i.j.k.l", "*.*.*.*.*.*.*.*.*.*l"), 1);
    EXPECT_EQ(match("a.b.c.d.e.f.g.h.i.j.k.l", "*.*.*.*.*.*.*.*.*.*.*l"), 0);
}

TEST(Wildcard, TakesCharactersWhole) {
    EXPECT_EQ(match("größe.txt", "gr??e.txt"), 1);
    EXPECT_EQ(match("größe.txt", "gr???e.txt"), 0);
    EXPECT_EQ(match("日本語", "*?語"), 1);
    EXPECT_EQ(match("日本語", "???"), 1);
    EXPECT_EQ(match("ü", "*\xBC"), 0);         // half of a letter
    EXPECT_EQ(match("ü", "*\xBC*"), 0);        //
    EXPECT_EQ(match("a\xBC", "*\xBC"), 1);     // a byte that stands alone is a character
    EXPECT_EQ(match("a\xFF\xFEz", "a??z"), 1); //
}

TEST(Wildcard, AgreesWithTheTableOfAllWays) {
    std::mt19937 random(7);
    const std::vector<std::string> texts = {"a", "b", "é", "aa", "\xC3"};
    const std::vector<std::string> signs = {"a", "b", "é", "*", "?", "*a", "**", "\xA9"};
    const auto build = [&](const std::vector<std::string>& parts, unsigned most) {
        std::string built;
        for (unsigned left = random() % (most + 1); left > 0; --left) {
            built += parts[random() % parts.size()];
        }
        return built;
    };
    int matched = 0;
    for (int i = 0; i < 200000; ++i) {
        const std::string text = build(texts, 8);
        const std::string pattern = build(signs, 7);
        const bool expected = referenceMatch(text, pattern);
        ASSERT_EQ(match(text, pattern), expected ? 1 : 0) << text << " | " << pattern;
        matched += expected ? 1 : 0;
    }
    EXPECT_GT(matched, 10000); // both answers were asked for
}

TEST(Wildcard, EndsOnPatternsMadeToGoBack) {
    const std::string many(100000, 'a');
    EXPECT_EQ(match(many, "*a*a*a*a*a*a*a*a*b"), 0);
    EXPECT_EQ(match("b" + many, "*a*a*a*a*a*b"), 0);
    EXPECT_EQ(match(many + "b", "*a*a*a*a*a*b"), 1);
    EXPECT_EQ(match(many, "*" + std::string(1000, 'a') + "b*"), 0);
}
