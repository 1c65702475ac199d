// The texts of the sample application: what is not changed is written as it was read.
#include "samples/notes/FileText.h"

#include <gtest/gtest.h>

using namespace std::string_view_literals;

TEST(FileText, WritesWhatWasRead) {
    for (const std::string_view bytes : {""sv, "\n"sv, "one"sv, "one\n"sv, "one\r\ntwo\rthree\n\n\r\n"sv,
                                         "\xEF\xBB\xBFmark\r\n"sv, "\r\r\n\n\r"sv, "Latin-1 caf\xE9\n\xFF\xFE\x80"sv,
                                         "par\xE2\x80\xA9"
                                         "agraph"sv,
                                         "\x01\x0B\x0C\x1B\x7F\t"sv, "\xE2\x80"sv}) {
        EXPECT_TRUE(FileText::isText(bytes));
        const FileText text(bytes);
        EXPECT_EQ(text.bytesOf(text.edited()), bytes) << bytes;
    }
    EXPECT_FALSE(FileText::isText("PNG\0\1"sv));
}

TEST(FileText, GivesControlsOneKindOfLineEnd) {
    EXPECT_EQ(FileText("\xEF\xBB\xBF"
                       "a\nb\rc\r\nd\xE2\x80\xA9")
                  .edited(),
              "a\r\nb\r\nc\r\nd\r\n");
    EXPECT_EQ(FileText().edited(), "");
}

TEST(FileText, KeepsTheEndsOfLinesAroundAChange) {
    struct Case {
        std::string_view file, edited, written;
    };
    for (const auto& [file, edited, written] : {
             Case{"", "a\r\nb", "a\nb"},                               // a new file
             Case{"a\r\nb\r\n", "a\r\nb\r\nc\r\n", "a\r\nb\r\nc\r\n"}, // the file's own
             Case{"a\rb\nc\r\nd", "a\r\nX\r\nc\r\nd", "a\rX\nc\r\nd"}, // changed in its place
             Case{"a\rb\nc\nd", "a\r\nb\r\nX\r\nc\r\nd", "a\rb\nX\nc\nd"},
             Case{"a\rb\nc\r\nd\r\n", "a\r\nd\r\n", "a\rd\r\n"}, // lines taken out
             Case{"a\rb\nc", "c", "c"},
             Case{"a\r\nb", "b\r\na", "b\r\na"},
             Case{"a\r\nb", "", ""},
             Case{"x\r\nx\rx\nx", "x\r\nx\r\nx", "x\r\nx\rx"}, // equal lines
             Case{"\xEF\xBB\xBF"
                  "a\n",
                  "b\r\n\r\n",
                  "\xEF\xBB\xBF"
                  "b\n\n"},
         }) {
        EXPECT_EQ(FileText(file).bytesOf(edited), written) << file;
    }
}
