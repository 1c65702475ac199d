#include "s/CommandFilter.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace {

/// A command whose menus end at "|".
CommandText command(std::string label, std::string key = "") {
    CommandText text;
    text.nameStart = label.find('|');
    text.label = label.erase(text.nameStart, 1);
    text.key = std::move(key);
    return text;
}

int rank(const CommandText& text, const char* typed) {
    return MatchRank(text, FoldedWords(typed));
}

} // namespace

TEST(CommandFilter, FindsWordsBeginningsFirstLettersAndKeys) {
    const CommandText front = command("edit |bring to front", "ctrl+f");
    for (const char* typed : {"", "bring", "BRI FRO", "front bring", "bf", "btf", "tf", "brifro", "edit front", "ebf",
                              "ring", "ctrl+f", "bring ctrl", "  front  "}) {
        EXPECT_GT(rank(front, typed), 0) << typed;
    }
    for (const char* typed : {"fb", "bff", "bring x", "brxf", "backfront", "btfx", "ctrl+g"}) {
        EXPECT_EQ(rank(front, typed), 0) << typed;
    }
    const CommandText japanese = command("ファイル |名前を付けて保存(a)...");
    EXPECT_GT(rank(japanese, "保存"), 0);
    EXPECT_GT(rank(japanese, "ファイル 名前"), 0);
    EXPECT_GT(rank(command("bild |größe ändern"), "GRÖ Ä"), 0);
    EXPECT_GT(rank(command("bild |größe ändern"), "gä"), 0);
}

TEST(CommandFilter, RanksTheBestMatchFirst) {
    // In falling order for "text".
    const CommandText order[] = {command("draw |text"), command("edit |change text"), command("edit |texture"),
                                 command("text |size"), command("view |context")};
    EXPECT_TRUE(std::is_sorted(std::begin(order), std::end(order), [](const CommandText& a, const CommandText& b) {
        return rank(a, "text") > rank(b, "text");
    }));
    EXPECT_GT(rank(command("draw |line"), "l"), rank(command("view |tool bar"), "l"));
    EXPECT_GT(rank(command("file |save as"), "sa"), rank(command("edit |select all"), "sa"));
}

TEST(CommandFilter, AllWordsMustOccur) {
    EXPECT_TRUE(HasAllWords("file open...\nctrl+o", FoldedWords("OPEN ctrl")));
    EXPECT_FALSE(HasAllWords("file open...\nctrl+o", FoldedWords("open shift")));
    EXPECT_TRUE(HasAllWords("anything", FoldedWords(" \t ")));
}
