#include "platform/afx/core/Clipboard.h"
#include "tests/ui/afx/frames/FrameTesting.h"

#include <QClipboard>
#include <cstring>

namespace {

HGLOBAL blockOf(const std::string& bytes) {
    HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE, bytes.size());
    std::memcpy(GlobalLock(block), bytes.data(), bytes.size());
    GlobalUnlock(block);
    return block;
}

} // namespace

TEST(Clipboard, TextGoesToOtherPrograms) {
    ASSERT_TRUE(OpenClipboard(nullptr));
    EXPECT_TRUE(EmptyClipboard());
    EXPECT_NE(SetClipboardData(CF_TEXT, blockOf(std::string("gr\xC3\xBC\xC3\x9F", 6) + '\0')), nullptr);
    EXPECT_TRUE(CloseClipboard());
    EXPECT_EQ(QApplication::clipboard()->text(), QString::fromUtf8("gr\xC3\xBC\xC3\x9F"));
    EXPECT_FALSE(CloseClipboard());
}

TEST(Clipboard, TextComesFromOtherPrograms) {
    QApplication::clipboard()->setText("theirs");
    EXPECT_TRUE(IsClipboardFormatAvailable(CF_TEXT));
    EXPECT_EQ(GetClipboardData(CF_TEXT), nullptr) << "not open";
    ASSERT_TRUE(OpenClipboard(nullptr));
    const HANDLE block = GetClipboardData(CF_TEXT);
    ASSERT_NE(block, nullptr);
    EXPECT_STREQ(static_cast<const char*>(GlobalLock(block)), "theirs");
    EXPECT_EQ(GlobalSize(block), 7U);
    EXPECT_TRUE(CloseClipboard());
}

TEST(Clipboard, OwnFormats) {
    const UINT format = RegisterClipboardFormat("Shapes of a board");
    EXPECT_GE(format, 0xC000U);
    EXPECT_EQ(RegisterClipboardFormat("Shapes of a board"), format);
    ASSERT_TRUE(OpenClipboard(nullptr));
    EmptyClipboard();
    EXPECT_FALSE(IsClipboardFormatAvailable(format));
    SetClipboardData(format, blockOf(std::string("a\0b", 3)));
    CloseClipboard();
    EXPECT_TRUE(IsClipboardFormatAvailable(format));
    EXPECT_FALSE(IsClipboardFormatAvailable(CF_TEXT));
    ASSERT_TRUE(OpenClipboard(nullptr));
    const HANDLE block = GetClipboardData(format);
    EXPECT_EQ(GlobalSize(block), 3U);
    EXPECT_EQ(std::memcmp(GlobalLock(block), "a\0b", 3), 0);
    CloseClipboard();
}

TEST(Clipboard, BlocksOfMemory) {
    HGLOBAL block = GlobalAlloc(GHND, 4);
    EXPECT_EQ(std::memcmp(GlobalLock(block), "\0\0\0\0", 4), 0);
    std::memcpy(GlobalLock(block), "abcd", 4);
    block = GlobalReAlloc(block, 100, GMEM_MOVEABLE);
    EXPECT_EQ(GlobalSize(block), 100U);
    EXPECT_EQ(std::memcmp(GlobalLock(block), "abcd", 4), 0);
    EXPECT_EQ(GlobalFree(block), nullptr);
    EXPECT_EQ(GlobalFree(block), block);
    EXPECT_EQ(GlobalLock(block), nullptr);
    EXPECT_NE(GlobalAlloc(0, 0), nullptr);
}
