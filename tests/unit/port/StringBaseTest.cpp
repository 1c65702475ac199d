#include "platform/port/StringBase.h"

#include "platform/port/Str.h"

#include <gtest/gtest.h>
#include <map>
#include <vector>

namespace {

using Text = Port::StringBase<char>;

TEST(StringBase, TrimsAndSplits) {
    Text line("\t topic 1001  view \t");
    line.Trim(" \t");
    EXPECT_EQ(line, Text("topic 1001  view"));
    std::vector<Text> words;
    for (Text::Range range; line.NextTokenRange(range, " ");) {
        words.push_back(line.Extract(range));
    }
    EXPECT_EQ(words, (std::vector<Text>{"topic", "1001", "view"}));

    Text blank("  ");
    blank.Trim();
    EXPECT_TRUE(blank.IsEmpty());
    Text::Range range;
    EXPECT_FALSE(blank.NextTokenRange(range, " "));
}

TEST(StringBase, FindsAndExtracts) {
    const Text name("doc/german/page.htm#top");
    EXPECT_EQ(name.GetIndexOfFirstChar("/\\"), 3);
    EXPECT_EQ(name.GetIndexOfFirstChar("/\\", 4), 10);
    EXPECT_EQ(name.GetIndexOfLastChar("/"), 10);
    EXPECT_EQ(name.GetIndexOfLastChar("?"), -1);
    EXPECT_EQ(name.GetIndexOfString("page"), 11);
    EXPECT_EQ(name.GetIndexOfString("page", 12), -1);
    EXPECT_EQ(name.GetIndexOfFirstChar("/", 1000), -1);
    EXPECT_EQ(name.Extract(19), Text("#top"));
    EXPECT_EQ(name.Extract(4, 6), Text("german"));
    EXPECT_EQ(name.Extract(1000), Text());
    EXPECT_EQ(name.Extract(-5, 3), Text("doc"));
}

TEST(StringBase, ComparesAndOrders) {
    EXPECT_NE(Text("URL").Compare("url"), 0);
    EXPECT_EQ(Text("URL").Compare("url", Text::Case::Ignored), 0);
    EXPECT_LT(Text("a").Compare("b"), 0);
    std::map<Text, int> map{{"b", 2}, {"a", 1}};
    EXPECT_EQ(map.begin()->second, 1);
    EXPECT_EQ(Text(static_cast<const char*>(nullptr)), Text());
}

TEST(StringBase, ReplacesAndFormats) {
    Text path("C:\\a\\b");
    path.ReplaceChars("\\", '/');
    EXPECT_EQ(path, Text("C:/a/b"));
    path.Format("%s/%s", path.c_str(), "doc");
    EXPECT_EQ(path, Text("C:/a/b/doc"));
    EXPECT_EQ((path + "x").GetLength(), 11);
}

TEST(Str, WideConversionLosesNothing) {
    for (const std::string& text :
         {std::string("Grüße 図面 😀"), std::string("\x80\xFF\xC0\xAF \xED\xB2\x80 \xE2\x82")}) {
        EXPECT_EQ(UT_STR::WstrToMbstr(UT_STR::MbstrToWstr(text.c_str()).c_str()), text);
    }
    EXPECT_EQ(UT_STR::WstrToMbstr(nullptr), "");
    EXPECT_EQ(UT_STR::MbstrToWstr(nullptr), L"");
    UT_STR::WDelStrings(nullptr, 3);
}

} // namespace
