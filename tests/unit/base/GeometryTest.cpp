#include "platform/base/Geometry.h"

#include <gtest/gtest.h>

TEST(Geometry, PointsAndSizesAreAddedAndPacked) {
    EXPECT_EQ(CPoint(4, 6), CPoint(1, 2) + CSize(3, 4));
    EXPECT_EQ(CSize(2, 2), CPoint(3, 4) - CPoint(1, 2));
    EXPECT_EQ(CPoint(-5, -70), CPoint(MAKELPARAM(-5, -70)));
    EXPECT_EQ(CSize(-1, 2), -CSize(1, -2));
    CPoint moved(1, 1);
    moved += CSize(2, 3);
    moved -= CPoint(1, 1);
    EXPECT_EQ(CPoint(2, 3), moved);
    // Hosts use the limits as marks; adding to them must not trap.
    EXPECT_EQ(CPoint(INT_MIN, 0), CPoint(INT_MAX, 0) + CSize(1, 0));
}

TEST(Geometry, RightAndBottomEdgesLieOutside) {
    const CRect rect(10, 20, 30, 40);
    EXPECT_EQ(CSize(20, 20), rect.Size());
    EXPECT_TRUE(rect.PtInRect(CPoint(10, 20)));
    EXPECT_TRUE(rect.PtInRect(CPoint(29, 39)));
    EXPECT_FALSE(rect.PtInRect(CPoint(30, 39)));
    EXPECT_FALSE(rect.PtInRect(CPoint(29, 40)));
    EXPECT_TRUE(CRect(5, 5, 5, 9).IsRectEmpty());
    EXPECT_FALSE(CRect(5, 5, 5, 9).IsRectNull());
    EXPECT_EQ(CPoint(20, 30), rect.CenterPoint());
    EXPECT_EQ(CPoint(INT_MAX, 0), CRect(INT_MAX, 0, INT_MAX, 0).CenterPoint());
}

TEST(Geometry, EdgesMoveTogetherAndApart) {
    CRect rect(30, 40, 10, 20);
    rect.NormalizeRect();
    EXPECT_EQ(CRect(10, 20, 30, 40), rect);
    rect.DeflateRect(1, 2);
    EXPECT_EQ(CRect(11, 22, 29, 38), rect);
    rect.InflateRect(1, 2, 3, 4);
    EXPECT_EQ(CRect(10, 20, 32, 42), rect);
    rect.MoveToXY(0, 0);
    EXPECT_EQ(CRect(0, 0, 22, 22), rect);
    EXPECT_EQ(CRect(5, 6, 27, 28), rect + CPoint(5, 6));
    rect.TopLeft() = CPoint(3, 4);
    rect.BottomRight().x = 50;
    EXPECT_EQ(CRect(3, 4, 50, 22), rect);
}

TEST(Geometry, RectanglesIntersectUniteAndSubtract) {
    const CRect left(0, 0, 10, 10);
    const CRect right(5, 5, 20, 20);
    EXPECT_EQ(CRect(5, 5, 10, 10), left & right);
    EXPECT_EQ(CRect(0, 0, 20, 20), left | right);
    CRect result(1, 2, 3, 4);
    EXPECT_FALSE(result.IntersectRect(left, CRect(10, 0, 20, 10)));
    EXPECT_TRUE(result.IsRectNull());
    EXPECT_TRUE(result.UnionRect(left, CRect(50, 50, 50, 60)));
    EXPECT_EQ(left, result);
    EXPECT_TRUE(result.SubtractRect(left, CRect(5, -1, 20, 11)));
    EXPECT_EQ(CRect(0, 0, 5, 10), result);
    EXPECT_TRUE(result.SubtractRect(left, right));
    EXPECT_EQ(left, result);
    EXPECT_FALSE(result.SubtractRect(left, CRect(-1, -1, 11, 11)));
    // The result may be one of the operands.
    result = left;
    result &= right;
    EXPECT_EQ(CRect(5, 5, 10, 10), result);
}

TEST(Geometry, AreSetAnew) {
    CPoint point(1, 2);
    point.SetPoint(-3, 4);
    EXPECT_EQ(CPoint(-3, 4), point);
    CRect rect;
    rect.SetRect(1, 2, 3, 4);
    EXPECT_EQ(CRect(1, 2, 3, 4), rect);
    rect.SetRect(CPoint(5, 6), CPoint(7, 8));
    EXPECT_EQ(CRect(5, 6, 7, 8), rect);
    const RECT other = {9, 8, 7, 6};
    rect.CopyRect(&other);
    EXPECT_EQ(CRect(9, 8, 7, 6), rect) << "edges that are the wrong way round stay so";
    rect.SetRectEmpty();
    EXPECT_TRUE(rect.IsRectNull());
}
