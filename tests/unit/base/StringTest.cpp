#include "afx.h"

#include <gtest/gtest.h>

TEST(CString, SharesUntilChanged) {
    CString first = "drawing";
    CString second = first;
    EXPECT_EQ(first.GetString(), second.GetString());
    second += ".brd";
    EXPECT_STREQ("drawing", first);
    EXPECT_STREQ("drawing.brd", second);
}
