#include "tests/ui/afx/gdi/MemoryDc.h"

#include <gtest/gtest.h>

#include <climits>

namespace {

TEST(Lines, LeaveTheEndPointOut) {
    MemoryDc dc(6, 3);
    dc.MoveTo(1, 1);
    dc.LineTo(4, 1);
    EXPECT_EQ(dc.picture(), "......\n"
                            ".###..\n"
                            "......\n");
    EXPECT_EQ(dc.GetCurrentPosition(), CPoint(4, 1));
}

TEST(Lines, DrawnTwiceByExclusiveOrAreGone) {
    MemoryDc dc(30, 30);
    CPen pen(PS_SOLID, 1, RGB(255, 255, 255));
    dc.SelectObject(&pen);
    dc.SetROP2(R2_XORPEN);
    const POINT corners[] = {{2, 3}, {20, 8}, {11, 27}, {2, 3}};
    dc.Polyline(corners, 4);
    EXPECT_GT(dc.inked(), 40);
    EXPECT_EQ(dc.GetPixel(20, 8), 0U) << "a corner between two lines is drawn once";
    dc.MoveTo(corners[0]);
    dc.PolylineTo(corners + 1, 3);
    EXPECT_EQ(dc.inked(), 0);
}

TEST(Lines, OfChevronsAreTheGlyphTheyAreMeantToBe) {
    MemoryDc dc(5, 5);
    const POINT chevron[] = {{1, 0}, {3, 2}, {0, 5}};
    dc.Polyline(chevron, 3);
    EXPECT_EQ(dc.picture(), ".#...\n"
                            "..#..\n"
                            "...#.\n"
                            "..#..\n"
                            ".#...\n");
}

TEST(Pens, DashWithTheBackgroundColourInTheGaps) {
    MemoryDc dc(14, 2);
    CPen dots(PS_DOT, 1, RGB(255, 0, 0));
    dc.SelectObject(&dots);
    dc.SetBkColor(RGB(0, 0, 255));
    dc.MoveTo(0, 0);
    dc.LineTo(14, 0);
    dc.SetBkMode(TRANSPARENT);
    dc.MoveTo(0, 1);
    dc.LineTo(14, 1);
    EXPECT_EQ(dc.picture(), "rrrbbbrrrbbbrr\n"
                            "rrr...rrr...rr\n");
}

TEST(Pens, OfZeroWidthStayOnePixelWideInEveryMode) {
    MemoryDc dc(40, 40);
    CPen thin(PS_SOLID, 0, 0), wide(PS_SOLID, 1, 0);
    dc.SetMapMode(MM_ANISOTROPIC);
    dc.SetWindowExt(1, 1);
    dc.SetViewportExt(4, 4);
    dc.SelectObject(&thin);
    dc.MoveTo(2, 2);
    dc.LineTo(7, 2);
    EXPECT_EQ(dc.inked(), 20);
    dc.SelectObject(&wide);
    dc.LineTo(7, 7);
    EXPECT_EQ(dc.picture({24, 20, 34, 21}), "..####....\n");
}

TEST(Pens, OfNullStyleDrawNothingAndSpareTheRightAndBottomPixels) {
    MemoryDc dc(6, 5);
    CBrush red(RGB(255, 0, 0));
    dc.SelectObject(&red);
    dc.Rectangle(0, 0, 5, 4);
    EXPECT_EQ(dc.picture(), "#####.\n"
                            "#rrr#.\n"
                            "#rrr#.\n"
                            "#####.\n"
                            "......\n");
    dc.PatBlt(0, 0, 6, 5, WHITENESS);
    dc.SelectStockObject(NULL_PEN);
    dc.Rectangle(0, 0, 5, 4);
    EXPECT_EQ(dc.picture(), "rrrr..\n"
                            "rrrr..\n"
                            "rrrr..\n"
                            "......\n"
                            "......\n");
}

TEST(Pens, InsideTheFrameDoNotLeaveIt) {
    MemoryDc dc(20, 20);
    CPen inside(PS_INSIDEFRAME, 5, 0);
    dc.SelectObject(&inside);
    dc.SelectStockObject(NULL_BRUSH);
    dc.Rectangle(3, 3, 17, 17);
    EXPECT_EQ(dc.inked(), 14 * 14 - 4 * 4);
    EXPECT_EQ(dc.GetPixel(3, 3), 0U);
    EXPECT_EQ(dc.GetPixel(2, 10), RGB(255, 255, 255));
    EXPECT_EQ(dc.GetPixel(17, 10), RGB(255, 255, 255));
    dc.PatBlt(0, 0, 20, 20, WHITENESS);
    dc.Ellipse(3, 3, 17, 17);
    EXPECT_EQ(dc.GetPixel(2, 10), RGB(255, 255, 255));
    EXPECT_EQ(dc.GetPixel(3, 10), 0U);
}

TEST(Brushes, HatchFromTheirOrigin) {
    MemoryDc dc(16, 8);
    CBrush hatch(HS_VERTICAL, RGB(255, 0, 0));
    const RECT all = {0, 0, 16, 8};
    dc.SetBkColor(RGB(0, 0, 255));
    dc.FillRect(&all, &hatch);
    EXPECT_EQ(dc.picture({0, 0, 16, 1}), "bbbbrbbbbbbbrbbb\n");
    dc.PatBlt(0, 0, 16, 8, WHITENESS);
    dc.SetBkMode(TRANSPARENT);
    dc.SetBrushOrg(-4, 0);
    dc.FillRect(&all, &hatch);
    EXPECT_EQ(dc.picture({0, 0, 16, 1}), "r.......r.......\n");
}

TEST(Brushes, RepeatAPattern) {
    const BYTE bits[] = {0x80, 0x00, 0x40, 0x00};
    CBitmap bitmap;
    bitmap.CreateBitmap(2, 2, 1, 1, bits);
    CBrush pattern(&bitmap);
    bitmap.DeleteObject(); // the brush has a copy
    MemoryDc dc(5, 3);
    dc.SetTextColor(RGB(255, 0, 0));
    dc.SetBkColor(RGB(0, 0, 255));
    dc.SelectObject(&pattern);
    dc.PatBlt(0, 0, 5, 3, PATCOPY);
    EXPECT_EQ(dc.picture(), "brbrb\n"
                            "rbrbr\n"
                            "brbrb\n");
}

TEST(Shapes, DrawnTwiceByExclusiveOrAreGone) {
    MemoryDc dc(60, 60);
    CBrush brush(RGB(90, 200, 30));
    dc.SelectObject(&brush);
    dc.SetROP2(R2_NOT);
    const POINT star[] = {{30, 2}, {48, 58}, {2, 22}, {58, 22}, {12, 58}};
    const auto draw = [&] {
        dc.Ellipse(3, 4, 50, 33);
        dc.RoundRect(1, 20, 59, 58, 13, 17);
        dc.Pie(5, 5, 55, 50, 50, 10, 20, 55);
        dc.Chord(5, 5, 55, 50, 50, 10, 20, 55);
        dc.Arc(5, 5, 55, 50, 20, 55, 50, 10);
        dc.Polygon(star, 5);
        CPen wide(PS_SOLID, 7, 0);
        CPen* old = dc.SelectObject(&wide);
        dc.Polygon(star, 5);
        dc.SelectObject(old);
    };
    draw();
    EXPECT_GT(dc.inked(), 500);
    draw();
    EXPECT_EQ(dc.inked(), 0);
}

TEST(Arcs, RunCounterClockwiseUnlessToldOtherwise) {
    MemoryDc dc(21, 21);
    dc.Arc(0, 0, 21, 21, 20, 10, 10, 0); // from the right to the top: the upper right quarter
    EXPECT_EQ(dc.GetPixel(17, 3), 0U);
    EXPECT_EQ(dc.GetPixel(3, 3), RGB(255, 255, 255));
    dc.PatBlt(0, 0, 21, 21, WHITENESS);
    dc.SetArcDirection(AD_CLOCKWISE);
    dc.Arc(0, 0, 21, 21, 20, 10, 10, 0);
    EXPECT_EQ(dc.GetPixel(17, 3), RGB(255, 255, 255));
    EXPECT_EQ(dc.GetPixel(3, 3), 0U);
    EXPECT_EQ(dc.GetPixel(3, 17), 0U);
    dc.PatBlt(0, 0, 21, 21, WHITENESS);
    const int full = (dc.Arc(0, 0, 21, 21, 20, 10, 20, 10), dc.inked());
    dc.PatBlt(0, 0, 21, 21, WHITENESS);
    dc.SelectStockObject(NULL_BRUSH);
    dc.Ellipse(0, 0, 21, 21);
    EXPECT_EQ(full, dc.inked()) << "the same direction twice is the whole ellipse";
}

TEST(Pie, IsFilledUpToItsOutline) {
    MemoryDc dc(41, 41);
    CBrush red(RGB(255, 0, 0));
    dc.SelectObject(&red);
    dc.Pie(0, 0, 41, 41, 40, 20, 20, 0);
    for (int y = 1; y < 20; ++y) {
        const std::string row = dc.picture({20, y, 41, y + 1});
        const std::size_t end = row.find_last_of('#');
        EXPECT_EQ(row[0], '#');
        EXPECT_EQ(row.substr(0, end).find('.'), std::string::npos) << "a gap in row " << y << ": " << row;
    }
    EXPECT_EQ(dc.GetPixel(25, 25), RGB(255, 255, 255));
}

TEST(Polygons, FollowTheFillMode) {
    const POINT star[] = {{20, 0}, {32, 39}, {0, 15}, {39, 15}, {8, 39}};
    MemoryDc dc(40, 40);
    CBrush red(RGB(255, 0, 0));
    dc.SelectObject(&red);
    dc.Polygon(star, 5);
    EXPECT_EQ(dc.GetPixel(20, 20), RGB(255, 255, 255));
    dc.SetPolyFillMode(WINDING);
    dc.Polygon(star, 5);
    EXPECT_EQ(dc.GetPixel(20, 20), RGB(255, 0, 0));
    EXPECT_FALSE(dc.Polygon(star, 1));
    EXPECT_FALSE(dc.Polygon(nullptr, 5));
}

TEST(Areas, FrameInvertAndShade) {
    MemoryDc dc(7, 5);
    CBrush red(RGB(255, 0, 0));
    RECT rect = {0, 0, 5, 4};
    dc.FrameRect(&rect, &red);
    EXPECT_EQ(dc.picture(), "rrrrr..\n"
                            "r...r..\n"
                            "r...r..\n"
                            "rrrrr..\n"
                            ".......\n");
    rect = {1, 1, 3, 2};
    dc.InvertRect(&rect);
    EXPECT_EQ(dc.picture({0, 1, 5, 2}), "r##.r\n");
    dc.Draw3dRect(0, 0, 7, 5, RGB(0, 255, 0), RGB(0, 0, 255));
    EXPECT_EQ(dc.picture(), "ggggggb\n"
                            "g##.r.b\n"
                            "g...r.b\n"
                            "grrrr.b\n"
                            "bbbbbbb\n");
    EXPECT_EQ(dc.GetBkColor(), RGB(0, 0, 255)) << "filling leaves its colour as background colour";
}

TEST(Areas, FocusRectanglesComeAndGo) {
    MemoryDc dc(20, 20);
    const RECT rect = {2, 2, 17, 12};
    dc.DrawFocusRect(&rect);
    EXPECT_EQ(dc.inked(), 23) << "every second pixel of the 46 around the rectangle is dotted";
    dc.DrawFocusRect(&rect);
    EXPECT_EQ(dc.inked(), 0);
}

TEST(Areas, EdgesShrinkTheRectangleOnRequest) {
    MemoryDc dc(20, 20);
    CRect rect(2, 2, 18, 18);
    EXPECT_TRUE(dc.DrawEdge(&rect, EDGE_RAISED, BF_RECT));
    EXPECT_EQ(rect, CRect(2, 2, 18, 18));
    dc.DrawEdge(&rect, EDGE_RAISED, BF_LEFT | BF_TOP | BF_ADJUST);
    EXPECT_EQ(rect, CRect(4, 4, 18, 18));
    EXPECT_EQ(dc.GetPixel(17, 10), GetSysColor(COLOR_3DDKSHADOW));
    EXPECT_EQ(dc.GetPixel(3, 10), GetSysColor(COLOR_BTNHIGHLIGHT));
}

TEST(Clipping, LimitsEveryKindOfDrawing) {
    MemoryDc dc(20, 20);
    EXPECT_EQ(dc.IntersectClipRect(5, 5, 15, 15), SIMPLEREGION);
    EXPECT_EQ(dc.ExcludeClipRect(8, 8, 12, 12), COMPLEXREGION);
    dc.SelectStockObject(BLACK_BRUSH);
    dc.Ellipse(-5, -5, 25, 25);
    dc.Rectangle(0, 0, 20, 20);
    dc.MoveTo(0, 10);
    dc.LineTo(20, 10);
    dc.SelectStockObject(SYSTEM_FONT);
    dc.TextOut(0, 0, "MMMM", 4);
    dc.SetPixel(0, 0, 0);
    dc.DrawFocusRect(CRect(0, 0, 20, 20));
    dc.PatBlt(0, 0, 20, 20, BLACKNESS);
    EXPECT_EQ(dc.inked(), 100 - 16);
    CRect box;
    EXPECT_EQ(dc.GetClipBox(&box), COMPLEXREGION);
    EXPECT_EQ(box, CRect(5, 5, 15, 15));
    EXPECT_TRUE(dc.PtVisible(5, 5));
    EXPECT_FALSE(dc.PtVisible(9, 9));
    EXPECT_EQ(dc.GetPixel(9, 9), CLR_INVALID);
    EXPECT_FALSE(dc.RectVisible(CRect(8, 8, 12, 12)));
    EXPECT_TRUE(dc.RectVisible(CRect(0, 0, 6, 6)));
    EXPECT_EQ(dc.SelectClipRgn(nullptr), SIMPLEREGION);
    EXPECT_TRUE(dc.PtVisible(9, 9));
    EXPECT_FALSE(dc.PtVisible(20, 5));
}

TEST(Clipping, ByARegionUsesDeviceUnits) {
    MemoryDc dc(20, 20);
    CRgn region;
    region.CreateEllipticRgn(0, 0, 10, 10);
    dc.SetViewportOrg(10, 10);
    dc.SelectObject(&region);
    region.DeleteObject(); // the context has a copy
    dc.PatBlt(-10, -10, 20, 20, BLACKNESS);
    EXPECT_EQ(dc.GetPixel(-5, -5), 0U);
    EXPECT_EQ(dc.picture({10, 10, 20, 20}).find('#'), std::string::npos);
    EXPECT_EQ(dc.picture({0, 0, 1, 1}), ".\n");
    EXPECT_EQ(dc.OffsetClipRgn(10, 10), COMPLEXREGION);
    dc.PatBlt(-10, -10, 20, 20, BLACKNESS);
    EXPECT_EQ(dc.picture({14, 14, 16, 15}), "##\n");
}

TEST(Shapes, WithHugeCoordinatesEndSoonAndStayInside) {
    MemoryDc dc(10, 10);
    constexpr int far = INT_MAX;
    dc.MoveTo(-far, 5);
    dc.LineTo(far, 5);
    EXPECT_EQ(dc.picture({0, 5, 10, 6}), "##########\n");
    const RECT all = {INT_MIN, INT_MIN, far, far};
    const POINT triangle[] = {{INT_MIN, INT_MIN}, {far, INT_MIN}, {5, far}};
    CPen wide(PS_SOLID, 5, 0), dotted(PS_DOT, 1, 0);
    CBrush red(RGB(255, 0, 0));
    dc.SelectObject(&red);
    for (CPen* pen : {&wide, &dotted}) {
        dc.SelectObject(pen);
        dc.PatBlt(0, 0, 10, 10, WHITENESS);
        EXPECT_TRUE(dc.Polygon(triangle, 3));
        EXPECT_EQ(dc.GetPixel(5, 5), RGB(255, 0, 0));
        EXPECT_TRUE(dc.Rectangle(&all));
        EXPECT_TRUE(dc.Ellipse(&all));
        EXPECT_TRUE(dc.RoundRect(&all, {far, far}));
        EXPECT_TRUE(dc.Pie(&all, {far, 0}, {0, far}));
        EXPECT_TRUE(dc.Arc(&all, {far, 0}, {0, far}));
        EXPECT_EQ(dc.GetPixel(9, 9), RGB(255, 0, 0));
    }
    dc.InvertRect(&all);
    dc.FrameRect(&all, &red);
    dc.DrawFocusRect(&all);
    dc.Draw3dRect(&all, 0, 0);
    dc.TextOut(far, INT_MIN, "x", 1);
    dc.BitBlt(far, far, far, far, &dc, far, far, SRCCOPY);
    dc.BitBlt(INT_MIN, INT_MIN, far, far, &dc, 0, 0, SRCCOPY);
    RECT rect = all;
    dc.DrawText("x", 1, &rect, DT_CENTER | DT_WORDBREAK);
    dc.SetBrushOrg(INT_MIN, far);
    dc.SetViewportOrg(far, INT_MIN);
    dc.SetWindowOrg(INT_MIN, far);
    EXPECT_TRUE(dc.PatBlt(INT_MIN, INT_MIN, far, far, WHITENESS));
    EXPECT_TRUE(dc.Rectangle(&all));
}

TEST(Shapes, ThatAreLargeLookLikeThePartOfASmallerOneThatIsSeen) {
    // Seen from so near, both ellipses pass through the same place: the rightmost point.
    MemoryDc large(20, 20);
    CBrush red(RGB(255, 0, 0));
    large.SelectObject(&red);
    large.Ellipse(-40000, -20000, 10, 20020);
    EXPECT_EQ(large.picture({0, 10, 20, 11}), "rrrrrrrrr#..........\n");
    large.PatBlt(0, 0, 20, 20, WHITENESS);
    large.Chord(-40000, -20000, 10, 20020, 10, 20020, 10, -20000); // from below to above, on the right
    EXPECT_EQ(large.picture({0, 10, 20, 11}), "rrrrrrrrr#..........\n");
}

} // namespace
