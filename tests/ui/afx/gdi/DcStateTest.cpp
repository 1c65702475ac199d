#include "tests/ui/afx/gdi/MemoryDc.h"

#include <gtest/gtest.h>

namespace {

TEST(DcState, AnswersTheValueBeforeAndRefusesNumbersThatAreNoMode) {
    const struct {
        int (CDC::*set)(int);
        int (CDC::*get)() const;
        int first, other, least, most;
    } modes[] = {
        {&CDC::SetBkMode, &CDC::GetBkMode, OPAQUE, TRANSPARENT, TRANSPARENT, OPAQUE},
        {&CDC::SetROP2, &CDC::GetROP2, R2_COPYPEN, R2_XORPEN, R2_BLACK, R2_WHITE},
        {&CDC::SetPolyFillMode, &CDC::GetPolyFillMode, ALTERNATE, WINDING, ALTERNATE, WINDING},
        {&CDC::SetStretchBltMode, &CDC::GetStretchBltMode, BLACKONWHITE, COLORONCOLOR, BLACKONWHITE, HALFTONE},
        {&CDC::SetArcDirection, &CDC::GetArcDirection, AD_COUNTERCLOCKWISE, AD_CLOCKWISE, AD_COUNTERCLOCKWISE,
         AD_CLOCKWISE},
    };
    MemoryDc dc;
    for (const auto& mode : modes) {
        SCOPED_TRACE(&mode - modes);
        EXPECT_EQ((dc.*mode.get)(), mode.first);
        const int saved = dc.SaveDC();
        EXPECT_EQ((dc.*mode.set)(mode.other), mode.first);
        EXPECT_EQ((dc.*mode.set)(mode.least - 1), 0);
        EXPECT_EQ((dc.*mode.set)(mode.most + 1), 0);
        EXPECT_EQ((dc.*mode.get)(), mode.other);
        dc.RestoreDC(saved);
        EXPECT_EQ((dc.*mode.get)(), mode.first);
    }
    EXPECT_EQ(dc.SetTextAlign(TA_RIGHT | TA_BASELINE), UINT{TA_LEFT});
    EXPECT_EQ(dc.GetTextAlign(), UINT{TA_RIGHT | TA_BASELINE});
    EXPECT_EQ(dc.SetBrushOrg(3, 5), CPoint(0, 0));
    EXPECT_EQ(dc.GetBrushOrg(), CPoint(3, 5));
    dc.SetViewportOrg(10, 20);
    EXPECT_EQ(dc.OffsetViewportOrg(-3, 4), CPoint(10, 20));
    EXPECT_EQ(dc.GetViewportOrg(), CPoint(7, 24));
    EXPECT_FALSE(dc.IsPrinting());
}

} // namespace
