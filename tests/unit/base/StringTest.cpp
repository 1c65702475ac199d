#include "platform/base/String.h"

#include "platform/base/Exception.h"
#include "platform/base/StringSource.h"
#include "tests/unit/base/ExpectRaised.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <set>
#include <unordered_set>

using namespace std::string_view_literals;

namespace {

CString withZeros() {
    return CString("a\0b\0", 4);
}

} // namespace

TEST(CString, IsMadeFromEveryKindOfText) {
    EXPECT_EQ("", CString());
    EXPECT_EQ("", CString(static_cast<const char*>(nullptr)));
    EXPECT_EQ("xxx", CString('x', 3));
    EXPECT_EQ("", CString('x', -1));
    EXPECT_EQ("ab", CString("abc", 2));
    EXPECT_EQ("a\0b\0"sv, withZeros().View());
    EXPECT_EQ("grün", CString(reinterpret_cast<const unsigned char*>("grün")));
    EXPECT_EQ("grün 😀", CString(L"grün 😀"));
    EXPECT_EQ("gr", CString(L"grün", 2));
    expectRaised<CInvalidArgException>([] { CString("abc", -1); });
}

TEST(CString, SharesItsBufferUntilOneIsChanged) {
    const CString first = "drawing";
    CString second = first;
    CString third = first;
    EXPECT_EQ(first.GetString(), second.GetString());
    second += ".brd";
    third.SetAt(0, 'D');
    EXPECT_EQ("drawing", first);
    EXPECT_EQ("drawing.brd", second);
    EXPECT_EQ("Drawing", third);
}

TEST(CString, TakesPartsOfItselfAsArguments) {
    CString text = "abcdef";
    text += text;
    EXPECT_EQ("abcdefabcdef", text);
    text = text.GetString() + 6;
    EXPECT_EQ("abcdef", text);
    text.Append(text.GetString() + 1, 3);
    EXPECT_EQ("abcdefbcd", text);
    text.Insert(1, text);
    EXPECT_EQ("aabcdefbcdbcdefbcd", text);
    text = "ab";
    text.Replace(text, text + text);
    EXPECT_EQ("abab", text);
    text.Format("<%s|%s>", text.GetString(), text.GetString() + 2);
    EXPECT_EQ("<abab|ab>", text);
    text = "x";
    for (int i = 0; i < 12; ++i) {
        text.Append(text.GetString(), text.GetLength());
    }
    EXPECT_EQ(CString('x', 4096), text);
}

TEST(CString, HoldsEmbeddedZerosThroughout) {
    CString text = withZeros();
    text += withZeros();
    EXPECT_EQ("a\0b\0a\0b\0"sv, text.View());
    EXPECT_EQ("b\0a"sv, text.Mid(2, 3).View());
    EXPECT_EQ(4, text.Find('a', 1));
    EXPECT_EQ(4, text.Remove('\0'));
    EXPECT_EQ("abab", text);
    EXPECT_NE(withZeros(), CString("a"));
    EXPECT_GT(withZeros().Compare("a"), 0);
}

TEST(CString, ComparesWithTextsOnEitherSide) {
    const CString text = "Board";
    EXPECT_TRUE(text == "Board" && "Board" == text && text != "board" && "board" != text);
    EXPECT_TRUE(text < "Box" && "Apple" < text && CString("A") <= text && text > CString());
    EXPECT_EQ(0, text.CompareNoCase("bOARD"));
    EXPECT_EQ(-1, text.Compare("Box"));
    EXPECT_TRUE(CString() == static_cast<LPCSTR>(nullptr));
    EXPECT_EQ(1u, std::unordered_set<CString>({"a", CString('a')}).size());
    EXPECT_EQ("a", *std::set<CString>({"b", "a"}).begin());
}

TEST(CString, GivesCharactersOnlyInsideTheText) {
    const CString text = "ab";
    EXPECT_EQ('b', text[1]);
    EXPECT_EQ('\0', text.GetAt(2));
    expectRaised<CInvalidArgException>([&] { static_cast<void>(text[3]); });
    expectRaised<CInvalidArgException>([&] { static_cast<void>(text.GetAt(-1)); });
    expectRaised<CInvalidArgException>([&] { CString(text).SetAt(2, 'x'); });
}

TEST(CString, CutsRangesToTheText) {
    const CString text = "0123456789";
    EXPECT_EQ("789", text.Mid(7, 100));
    EXPECT_EQ("0123456789", text.Mid(-5));
    EXPECT_EQ("", text.Mid(20, 3));
    EXPECT_EQ("", text.Mid(3, -1));
    EXPECT_EQ("", text.Left(-1));
    EXPECT_EQ("89", text.Right(2));
    EXPECT_EQ("0123456789", text.Right(INT_MAX));
    CString changed = text;
    EXPECT_EQ(8, changed.Delete(8, INT_MAX));
    EXPECT_EQ(9, changed.Insert(100, '!'));
    EXPECT_EQ(10, changed.Insert(-3, '!'));
    EXPECT_EQ("!01234567!", changed);
}

TEST(CString, Finds) {
    const CString text = "a.b.c";
    EXPECT_EQ(1, text.Find('.'));
    EXPECT_EQ(3, text.Find(".", 2));
    EXPECT_EQ(3, text.ReverseFind('.'));
    EXPECT_EQ(-1, text.Find("x"));
    EXPECT_EQ(-1, text.Find('.', 5));
    EXPECT_EQ(-1, text.Find('.', -1));
    EXPECT_EQ(5, text.Find("", 5));
    EXPECT_EQ(-1, text.Find("", 6));
    EXPECT_EQ(2, text.FindOneOf("cb"));
    EXPECT_EQ(-1, text.FindOneOf(""));
}

TEST(CString, TreatsSetsAsCharactersNotBytes) {
    // "ä" and "ü" share their first byte.
    EXPECT_EQ(2, CString("üä").FindOneOf("ä"));
    EXPECT_EQ("üa", CString("üaä").SpanExcluding("ä"));
    EXPECT_EQ("ää", CString("ääü").SpanIncluding("ä"));
    EXPECT_EQ("ü", CString("äüä").Trim("ä"));
    EXPECT_EQ("€äx", CString("xä€").MakeReverse());
    EXPECT_EQ("\xC3z", CString("z\xC3").MakeReverse());
    EXPECT_EQ("ÄÖ\xFF", CString("äö\xFF").MakeUpper());
    EXPECT_EQ("äö", CString("ÄÖ").MakeLower());
}

TEST(CString, Trims) {
    EXPECT_EQ("a b", CString(" \t a b\r\n").Trim());
    EXPECT_EQ("", CString(" \n ").Trim());
    EXPECT_EQ("a  ", CString("  a  ").TrimLeft());
    EXPECT_EQ("a", CString("xxaxx").Trim('x'));
    EXPECT_EQ("xa", CString("xa--").TrimRight('-'));
    EXPECT_EQ("", CString("---").Trim('-'));
    EXPECT_EQ("a", CString("[<a>]").Trim("[]<>"));
}

TEST(CString, Replaces) {
    CString text = "aXXbXX";
    EXPECT_EQ(2, text.Replace("XX", "X"));
    EXPECT_EQ("aXbX", text);
    EXPECT_EQ(2, text.Replace("X", "XX"));
    EXPECT_EQ("aXXbXX", text);
    EXPECT_EQ(0, text.Replace("", "y"));
    EXPECT_EQ(4, text.Replace('X', 'Y'));
    EXPECT_EQ(2, text.Replace("YY", nullptr));
    EXPECT_EQ("ab", text);
}

TEST(CString, SplitsIntoFields) {
    const CString text = ";;a;b c;";
    CString fields;
    int start = 0;
    for (CString field = text.Tokenize("; ", start); start != -1; field = text.Tokenize("; ", start)) {
        fields += "<" + field + ">";
    }
    EXPECT_EQ("<a><b><c>", fields);
    expectRaised<CInvalidArgException>([&] { static_cast<void>(text.Tokenize(";", start)); });
    start = 0;
    EXPECT_EQ(text, text.Tokenize("", start));
    EXPECT_EQ("", text.Tokenize("", start));
    EXPECT_EQ(-1, start);

    CString part;
    EXPECT_TRUE(AfxExtractSubString(part, "one\n\nthree", 2));
    EXPECT_EQ("three", part);
    EXPECT_TRUE(AfxExtractSubString(part, "one\n\nthree", 1));
    EXPECT_EQ("", part);
    EXPECT_FALSE(AfxExtractSubString(part, "one\n\nthree", 3));
}

TEST(CString, IsWrittenThroughItsBuffer) {
    CString text = "abc";
    const CString copy = text;
    std::strcpy(text.GetBuffer(10), "0123456789");
    text.ReleaseBuffer();
    EXPECT_EQ("0123456789", text);
    EXPECT_EQ("abc", copy);

    std::memcpy(text.GetBufferSetLength(3), "x\0y", 3);
    EXPECT_EQ("x\0y"sv, text.View());
    text.ReleaseBuffer();
    EXPECT_EQ("x", text);

    // Without a zero in it, the text ends with the buffer.
    char* const buffer = text.GetBuffer(20);
    std::memset(buffer, 'z', static_cast<std::size_t>(text.GetAllocLength()));
    text.ReleaseBuffer();
    EXPECT_EQ(CString('z', text.GetAllocLength()), text);
    expectRaised<CInvalidArgException>([&] { text.ReleaseBuffer(text.GetAllocLength() + 1); });
    CString().ReleaseBuffer();
}

TEST(CString, IsNotSharedWhileItsBufferIsLocked) {
    CString text = "abc";
    char* const buffer = text.LockBuffer();
    const CString copy = text;
    buffer[0] = 'x';
    text.UnlockBuffer();
    EXPECT_EQ("abc", copy);
    EXPECT_EQ("xbc", text);
    EXPECT_EQ(text.GetString(), CString(text).GetString());
}

TEST(CString, KeepsRoomForWhatIsAppended) {
    CString text = "a";
    text.Preallocate(1000);
    const char* const buffer = text;
    for (int i = 0; i < 999; ++i) {
        text.AppendChar('b');
    }
    EXPECT_EQ(buffer, text.GetString());
    text.Truncate(2);
    text.FreeExtra();
    EXPECT_EQ("ab", text);
    EXPECT_EQ(2, text.GetAllocLength());
}

TEST(CString, FormatsAndAppends) {
    CString text;
    text.Format("%d items, %.1f %s", 3, 2.5, "mm");
    text.AppendFormat("%c%05d", ';', -42);
    CString whole;
    whole.Format("<%s> %d", text, 7);
    whole.AppendFormat(" %.2s%s", CString("abc"), "d");
    EXPECT_EQ("<" + text + "> 7 abd", whole);
    whole.Format("%s%s", whole, whole.Left(1));
    EXPECT_EQ("<" + text + "> 7 abd<", whole);
    EXPECT_EQ("3 items, 2.5 mm;-0042", text);
    // A lone surrogate has no text: the failure leaves the old one.
    const wchar_t lone[] = {static_cast<wchar_t>(0xD800), 0};
    expectRaised<CInvalidArgException>([&] { text.Format("%ls", lone); });
    EXPECT_EQ("3 items, 2.5 mm;-0042", text);
}

TEST(CString, LoadsStringsFromWhoeverHoldsThem) {
    CString text = "before";
    EXPECT_FALSE(text.LoadString(7));
    tvx::setStringLoader([](HINSTANCE, UINT id, std::string& loaded) {
        if (id == 7) {
            loaded = "%d of %d";
        }
        return id == 7;
    });
    EXPECT_FALSE(text.LoadString(8));
    EXPECT_EQ("before", text);
    expectRaised<CInvalidArgException>([&] { text.Format(8u, 1, 2); });
    text.Format(7u, 1, 2);
    EXPECT_EQ("1 of 2", text);
    EXPECT_TRUE(text.LoadString(7));
    EXPECT_EQ("%d of %d", text);
    tvx::setStringLoader(nullptr);
}

TEST(CString, ReadsEnvironmentVariables) {
    ::setenv("TVX_TEST_VARIABLE", "value", 1);
    CString text = "before";
    EXPECT_TRUE(text.GetEnvironmentVariable("TVX_TEST_VARIABLE"));
    EXPECT_EQ("value", text);
    EXPECT_FALSE(text.GetEnvironmentVariable("TVX_TEST_NO_VARIABLE"));
    EXPECT_EQ("", text);
}

TEST(CString, RefusesWhatIsTooLarge) {
    CString text = "x";
    expectRaised<CMemoryException>([&] { text.GetBuffer(INT_MAX); });
    EXPECT_EQ("x", text);
}
