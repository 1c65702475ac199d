#include "tests/ui/gdi/MemoryDc.h"

#include <gtest/gtest.h>

namespace {

TEST(DcLines, LeaveTheEndPointOut) {
    MemoryDc dc(6, 3);
    dc.MoveTo(1, 1);
    dc.LineTo(4, 1);
    EXPECT_EQ(dc.picture(), "......\n"
                            ".###..\n"
                            "......\n");
    EXPECT_EQ(dc.GetCurrentPosition(), CPoint(4, 1));
}

} // namespace
