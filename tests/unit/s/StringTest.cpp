#include "s/String.h"

#include <gtest/gtest.h>
#include <memory>
#include <string>
#include <vector>

namespace {

using Fields = std::vector<std::string>;
enum Empty { Keep = 0, Skip = 1 };
enum Quotes { Heed = 0, Ignore = 1 };

Fields split(const Gui_String& text, const char* separators, Empty empty, Quotes quotes) {
    const std::unique_ptr<CStringArray> array(text.GetStringArray(separators, empty, quotes));
    Fields fields;
    for (INT_PTR i = 0; i < array->GetSize(); ++i) {
        fields.emplace_back(array->GetAt(i).View());
    }
    return fields;
}

/// The number, or `kept` when the text is refused.
int number(const char* text, int base, int kept = -77) {
    int value = kept;
    const int result = Gui_String(text).GetIntValue(value, base);
    EXPECT_EQ(result, value == kept ? 0 : 1) << text;
    return value;
}

} // namespace

TEST(String, IntegersMustBeTheWholeText) {
    EXPECT_EQ(number("42", 10), 42);
    EXPECT_EQ(number(" 42", 10), 42);
    EXPECT_EQ(number("-42", 10), -42);
    EXPECT_EQ(number("", 10), 0);
    for (const char* text : {"42 ", "4x2", "x", " ", "0x1A", "+", "1.5"}) {
        EXPECT_EQ(number(text, 10), -77) << text;
    }
    int value = 5;
    EXPECT_EQ(Gui_String("42\0", 3).GetIntValue(value, 10), 0);
    EXPECT_EQ(value, 5);
}

TEST(String, IntegersKnowTheirBase) {
    EXPECT_EQ(number("0x1A", 16), 26);
    EXPECT_EQ(number("0x1A", 0), 26);
    EXPECT_EQ(number("017", 0), 15);
    EXPECT_EQ(number("zz", 36), 35 * 36 + 35);
}

TEST(String, IntegersBeyond32BitsClamp) {
    EXPECT_EQ(number("2147483648", 10), 2147483647);
    EXPECT_EQ(number("-2147483649", 10), -2147483647 - 1);
    EXPECT_EQ(number("99999999999999999999999", 10), 2147483647);
    EXPECT_EQ(number("FFFFFFFF", 16), 2147483647);
}

TEST(String, DoublesMustBeTheWholeText) {
    double value = 7;
    EXPECT_EQ(Gui_String("2.5kg").GetDoubleValue(value), 0);
    EXPECT_EQ(Gui_String("2,5").GetDoubleValue(value), 0);
    EXPECT_EQ(value, 7);
    EXPECT_EQ(Gui_String("2.5").GetDoubleValue(value), 1);
    EXPECT_EQ(value, 2.5);
    EXPECT_EQ(Gui_String("-1e3").GetDoubleValue(value), 1);
    EXPECT_EQ(value, -1000);
    EXPECT_EQ(Gui_String("").GetDoubleValue(value), 1);
    EXPECT_EQ(value, 0);
}

TEST(String, SplitsAtSeparators) {
    EXPECT_EQ(split("C:\\a;;C:\\b;", ";", Skip, Heed), (Fields{"C:\\a", "C:\\b"}));
    EXPECT_EQ(split("C:\\a;;C:\\b;", ";", Keep, Heed), (Fields{"C:\\a", "", "C:\\b"}));
    EXPECT_EQ(split(";x", ";", Keep, Heed), (Fields{"", "x"}));
    EXPECT_EQ(split(";;x", ";", Skip, Heed), (Fields{"x"}));
    EXPECT_EQ(split("a,b;c", ",;", Keep, Heed), (Fields{"a", "b", "c"}));
    EXPECT_EQ(split("whole", ";", Keep, Heed), (Fields{"whole"}));
    EXPECT_EQ(split("whole", nullptr, Skip, Ignore), (Fields{"whole"}));
    EXPECT_TRUE(split("", ";", Keep, Heed).empty());
}

TEST(String, QuotedStretchesAreFieldsWithTheirQuotes) {
    EXPECT_EQ(split("run  -f 'my file' x", " ", Skip, Heed), (Fields{"run", "-f", "'my file'", "x"}));
    EXPECT_EQ(split("run  -f \"my file\" x", " ", Skip, Heed), (Fields{"run", "-f", "\"my file\"", "x"}));
    EXPECT_EQ(split("a 'b c", " ", Skip, Heed), (Fields{"a", "'b c"}));
    EXPECT_EQ(split("ab'c d'", " ", Skip, Heed), (Fields{"ab", "'c d'"}));
    EXPECT_EQ(split("a 'b'", " ", Keep, Heed), (Fields{"a", "", "'b'"}));
    EXPECT_EQ(split("'it\"s' \"'\"", " ", Skip, Heed), (Fields{"'it\"s'", "\"'\""}));
    EXPECT_EQ(split("a 'b c'", " ", Skip, Ignore), (Fields{"a", "'b", "c'"}));
    EXPECT_EQ(split("'", " ", Skip, Heed), (Fields{"'"}));
}

TEST(String, SplitsBetweenWholeCharacters) {
    // "ä" is C3 A4, "¤" is C2 A4: they share a byte.
    EXPECT_EQ(split("1¤2ä3¤4", "¤", Keep, Heed), (Fields{"1", "2ä3", "4"}));
    EXPECT_EQ(split("ä;ö", ";", Keep, Heed), (Fields{"ä", "ö"}));
    EXPECT_EQ(split("\xC3;\xA4", ";", Keep, Heed), (Fields{"\xC3", "\xA4"}));
    EXPECT_EQ(split("a¤¤b", "¤", Skip, Heed), (Fields{"a", "b"}));
}

TEST(String, KeepsEmbeddedZeros) {
    const Gui_String text("a\0b;c", 5);
    EXPECT_EQ(split(text, ";", Keep, Heed), (Fields{std::string("a\0b", 3), "c"}));
}

TEST(String, IsMadeFromEveryKindOfText) {
    EXPECT_STREQ(Gui_String('x', 3), "xxx");
    EXPECT_STREQ(Gui_String("hello", 2), "he");
    EXPECT_STREQ(Gui_String(L"Größe"), "Größe");
    EXPECT_STREQ(Gui_String(CString("text")), "text");
    EXPECT_STREQ(Gui_String(static_cast<const char*>(nullptr)), "");
    EXPECT_STREQ(Gui_String::GetEndOfLineChars(), "\r\n");
}
