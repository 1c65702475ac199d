#include "tests/ui/afx/gdi/MemoryDc.h"

#include "platform/afx/gdi/detail/Mapping.h"

#include <gtest/gtest.h>

#include <climits>

using tvx::afx::Mapping;
using tvx::afx::scaled;

namespace {

CPoint device(const CDC& dc, int x, int y) {
    CPoint point(x, y);
    dc.LPtoDP(&point);
    return point;
}

CPoint logical(const CDC& dc, int x, int y) {
    CPoint point(x, y);
    dc.DPtoLP(&point);
    return point;
}

TEST(Scaled, RoundsHalvesUpWhateverTheSigns) {
    EXPECT_EQ(scaled(5, 1, 2), 3);
    EXPECT_EQ(scaled(-5, 1, 2), -2);
    EXPECT_EQ(scaled(5, 1, -2), -2);
    EXPECT_EQ(scaled(5, -1, 2), -2);
    EXPECT_EQ(scaled(-5, -1, 2), 3);
    EXPECT_EQ(scaled(4, 1, 3), 1);
    EXPECT_EQ(scaled(INT_MAX, INT_MAX, 1), INT_MAX);
    EXPECT_EQ(scaled(INT_MIN, INT_MAX, 1), INT_MIN);
    EXPECT_EQ(scaled(INT_MIN, -1, 1), INT_MAX);
}

TEST(MapMode, OfFixedScaleCountsFromAnInchOf96PixelsUpwards) {
    struct Scale {
        int mode;
        int unitsPerInch;
    };
    MemoryDc dc;
    for (const Scale scale :
         {Scale{MM_LOMETRIC, 254}, {MM_HIMETRIC, 2540}, {MM_LOENGLISH, 100}, {MM_HIENGLISH, 1000}, {MM_TWIPS, 1440}}) {
        ASSERT_NE(dc.SetMapMode(scale.mode), 0);
        EXPECT_EQ(device(dc, scale.unitsPerInch, scale.unitsPerInch), CPoint(96, -96)) << scale.mode;
        EXPECT_EQ(logical(dc, 192, 96), CPoint(2 * scale.unitsPerInch, -scale.unitsPerInch)) << scale.mode;
        dc.SetWindowExt(1, 1);
        dc.SetViewportExt(7, 7);
        EXPECT_EQ(device(dc, scale.unitsPerInch, 0), CPoint(96, 0)) << "extents are fixed in mode " << scale.mode;
    }
    EXPECT_EQ(dc.SetMapMode(MM_TEXT), MM_TWIPS);
    EXPECT_EQ(device(dc, 12, 34), CPoint(12, 34));
    EXPECT_EQ(dc.SetMapMode(0), 0);
    EXPECT_EQ(dc.SetMapMode(9), 0);
    EXPECT_EQ(dc.GetMapMode(), MM_TEXT);
}

TEST(MapMode, AnisotropicScalesEachDirectionByItself) {
    MemoryDc dc;
    dc.SetMapMode(MM_ANISOTROPIC);
    dc.SetWindowExt(1440, 1440);
    dc.SetViewportExt(96, -48);
    dc.SetWindowOrg(720, 0);
    dc.SetViewportOrg(10, 20);
    EXPECT_EQ(device(dc, 720 + 1440, 1440), CPoint(106, -28));
    EXPECT_EQ(logical(dc, 106, -28), CPoint(2160, 1440));
    EXPECT_EQ(dc.SetWindowExt(0, 5), CSize(1440, 1440));
    EXPECT_EQ(dc.GetWindowExt(), CSize(1440, 1440));
    CSize size(1440, 1440);
    dc.LPtoDP(&size);
    EXPECT_EQ(size, CSize(96, 48));
    CRect rect(720, 0, 2160, 1440);
    dc.LPtoDP(&rect);
    EXPECT_EQ(rect, CRect(10, 20, 106, -28));
}

TEST(MapMode, IsotropicShrinksOneExtentSoThatUnitsAreSquare) {
    MemoryDc dc;
    dc.SetMapMode(MM_ISOTROPIC);
    dc.SetWindowExt(1000, 500);
    dc.SetViewportExt(300, -300);
    EXPECT_EQ(dc.GetViewportExt(), CSize(300, -150));
    EXPECT_EQ(device(dc, 1000, 500), CPoint(300, -150));
    dc.SetViewportExt(400, 100);
    EXPECT_EQ(dc.GetViewportExt(), CSize(200, 100));
}

TEST(MapMode, KeepsNumbersBeyondTheRangeAtItsEnds) {
    MemoryDc dc;
    dc.SetMapMode(MM_ANISOTROPIC);
    dc.SetWindowExt(1, 1);
    dc.SetViewportExt(1000, -1000);
    EXPECT_EQ(device(dc, INT_MAX, INT_MAX), CPoint(INT_MAX, INT_MIN));
    dc.SetViewportOrg(INT_MAX, INT_MIN);
    EXPECT_EQ(device(dc, INT_MAX, INT_MAX), CPoint(INT_MAX, INT_MIN));
}

TEST(MapMode, AppliesToShapes) {
    MemoryDc dc(20, 20);
    dc.SetMapMode(MM_ANISOTROPIC);
    dc.SetWindowExt(100, 100);
    dc.SetViewportExt(10, -10);
    dc.SetViewportOrg(0, 20);
    dc.FillSolidRect(10, 10, 20, 20, RGB(255, 0, 0));
    EXPECT_EQ(dc.inked(), 4);
    EXPECT_EQ(dc.picture({0, 16, 5, 20}), ".....\n"
                                          ".rr..\n"
                                          ".rr..\n"
                                          ".....\n");
}

} // namespace
