#include "platform/afx/gdi/detail/Raster.h"

#include <gtest/gtest.h>

#include <array>
#include <map>
#include <set>

using namespace tvx::afx;

namespace {

std::vector<QPoint> pixelsOf(const LinePixels& line) {
    std::vector<QPoint> points;
    for (int i = 0; i < line.count(); ++i) {
        points.push_back(line.at(i));
    }
    return points;
}

bool isBefore(QPoint left, QPoint right) {
    return std::pair(left.y(), left.x()) < std::pair(right.y(), right.x());
}
using PointSet = std::set<QPoint, decltype(&isBefore)>;

PointSet setOf(const std::vector<QPoint>& points) {
    return {points.begin(), points.end(), &isBefore};
}

PointSet setOf(const Spans& spans) {
    PointSet points(&isBefore);
    for (const Span& span : spans) {
        for (int x = span.left; x < span.right; ++x) {
            points.emplace(x, span.y);
        }
    }
    return points;
}

TEST(LinePixels, AreTheSameBothWaysExceptForTheEnds) {
    for (const QPoint to : {QPoint(7, 2), QPoint(2, 7), QPoint(-5, 3), QPoint(4, 4), QPoint(-6, -3), QPoint(0, -4)}) {
        const QPoint from(1, -2);
        std::vector<QPoint> there = pixelsOf(LinePixels(from, from + to));
        std::vector<QPoint> back = pixelsOf(LinePixels(from + to, from));
        EXPECT_EQ(there.front(), from);
        there.push_back(from + to);
        back.push_back(from);
        EXPECT_EQ(setOf(there), setOf(back)) << to.x() << ',' << to.y();
        EXPECT_EQ(there.size(), static_cast<std::size_t>(std::max(std::abs(to.x()), std::abs(to.y())) + 1));
    }
}

TEST(LinePixels, OfAFarAwayEndAreFoundWithoutWalkingThere) {
    const LinePixels line(QPoint(-2'000'000'000, -2'000'000'000), QPoint(2'000'000'000, 2'000'000'000));
    const LinePixels::Range range = line.within(QRect(0, 0, 10, 10));
    ASSERT_EQ(range.last - range.first, 10);
    EXPECT_EQ(line.at(range.first), QPoint(0, 0));
    EXPECT_EQ(line.at(range.last - 1), QPoint(9, 9));
    const LinePixels aside(QPoint(20, 0), QPoint(30, 5));
    EXPECT_EQ(aside.within(QRect(0, 0, 10, 10)).first, aside.within(QRect(0, 0, 10, 10)).last);
}

class EllipseRows : public testing::TestWithParam<QSize> {};

TEST_P(EllipseRows, TouchTheBoxAndAreSymmetric) {
    const QRect box(QPoint(3, -2), GetParam());
    const PointSet points = setOf(ellipseSpans(box));
    int left = INT_MAX, top = INT_MAX, right = INT_MIN, bottom = INT_MIN;
    for (const QPoint point : points) {
        left = std::min(left, point.x());
        top = std::min(top, point.y());
        right = std::max(right, point.x());
        bottom = std::max(bottom, point.y());
        EXPECT_TRUE(points.contains(QPoint(box.left() + box.right() - point.x(), point.y())));
        EXPECT_TRUE(points.contains(QPoint(point.x(), box.top() + box.bottom() - point.y())));
    }
    EXPECT_EQ(QRect(QPoint(left, top), QPoint(right, bottom)), box);
}

TEST_P(EllipseRows, HaveAClosedOutlineOfEachBorderPixelOnce) {
    const Spans rows = ellipseSpans(QRect(QPoint(), GetParam()));
    const std::vector<QPoint> outline = outlineOf(rows);
    const PointSet border = setOf(outline);
    EXPECT_EQ(border.size(), outline.size()) << "a pixel comes twice";
    for (std::size_t i = 0; i < outline.size() && GetParam().width() > 1 && GetParam().height() > 1; ++i) {
        const QPoint step = outline[(i + 1) % outline.size()] - outline[i];
        EXPECT_LE(std::max(std::abs(step.x()), std::abs(step.y())), 1) << "a gap after pixel " << i;
    }
    const PointSet inside = setOf(rows);
    for (const QPoint point : inside) {
        const bool atBorder = !inside.contains(point + QPoint(1, 0)) || !inside.contains(point - QPoint(1, 0)) ||
                              !inside.contains(point + QPoint(0, 1)) || !inside.contains(point - QPoint(0, 1));
        EXPECT_EQ(border.contains(point), atBorder) << point.x() << ',' << point.y();
    }
}

INSTANTIATE_TEST_SUITE_P(Sizes, EllipseRows,
                         testing::Values(QSize(1, 1), QSize(2, 2), QSize(3, 3), QSize(4, 4), QSize(5, 9), QSize(9, 5),
                                         QSize(2, 20), QSize(20, 2), QSize(1, 7), QSize(40, 31), QSize(101, 100)));

TEST(RoundRect, IsARectangleWithoutCornersAndAnEllipseWithFullOnes) {
    const QRect box(0, 0, 12, 9);
    EXPECT_EQ(setOf(roundRectSpans(box, {})).size(), 12U * 9U);
    EXPECT_EQ(roundRectSpans(box, QSize(99, 99)), ellipseSpans(box));
    EXPECT_TRUE(roundRectSpans(QRect(), {}).empty());
}

Spans fill(const std::vector<QPolygonF>& polygons, FillRule rule) {
    return polygonSpans(polygons, rule, QRect(-100, -100, 300, 300));
}

TEST(PolygonSpans, LeaveTheRightAndBottomEdgesOut) {
    const QPolygonF square({{1, 1}, {4, 1}, {4, 3}, {1, 3}});
    EXPECT_EQ(fill({square}, FillRule::Alternate), (Spans{{1, 1, 4}, {2, 1, 4}}));
}

TEST(PolygonSpans, OfNeighboursNeitherOverlapNorLeaveGaps) {
    const QPointF a(0, 0), b(37, 11), c(23, 50), d(-9, 31), middle(14, 19);
    std::map<std::pair<int, int>, int> covered;
    for (const auto& triangle :
         {QPolygonF({a, b, middle}), QPolygonF({b, c, middle}), QPolygonF({c, d, middle}), QPolygonF({d, a, middle})}) {
        for (const QPoint point : setOf(fill({triangle}, FillRule::Winding))) {
            ++covered[{point.x(), point.y()}];
        }
    }
    const PointSet whole = setOf(fill({QPolygonF({a, b, c, d})}, FillRule::Winding));
    EXPECT_EQ(covered.size(), whole.size());
    for (const auto& [point, times] : covered) {
        EXPECT_EQ(times, 1) << point.first << ',' << point.second;
    }
}

TEST(PolygonSpans, FollowTheFillRule) {
    const QPolygonF outer({{0, 0}, {9, 0}, {9, 9}, {0, 9}});
    const QPolygonF inner({{3, 3}, {6, 3}, {6, 6}, {3, 6}});
    EXPECT_EQ(setOf(fill({outer, inner}, FillRule::Alternate)).size(), 81U - 9U);
    EXPECT_EQ(setOf(fill({outer, inner}, FillRule::Winding)).size(), 81U);
    const QPolygonF turned({{3, 3}, {3, 6}, {6, 6}, {6, 3}});
    EXPECT_EQ(setOf(fill({outer, turned}, FillRule::Winding)).size(), 81U - 9U);
}

TEST(RasterOperations, AreTheTruthTablesOfTheirCodes) {
    // One pixel whose bits run through all eight combinations of the three inputs.
    constexpr Pixel brush = 0xF0, source = 0xCC, destination = 0xAA;
    for (unsigned code = 0; code < 256; ++code) {
        const auto rop = static_cast<Rop3>(code);
        EXPECT_EQ(combine(rop, brush, source, destination) & 0xFF, code);
        EXPECT_EQ(usesSource(rop), (code & 0x33) != ((code >> 2) & 0x33)) << code;
    }
    for (int code = 1; code <= 16; ++code) {
        // Seen as bits of pen and destination: 3 2 1 0.
        EXPECT_EQ(combine(rop2FromCode(code), 0xC, 0xA) & 0xF, static_cast<unsigned>(code - 1));
    }
    EXPECT_EQ(rop2FromRop3(0x5A), Rop2::XorPen);
    EXPECT_EQ(rop2FromRop3(0x55), Rop2::NotDestination);
    EXPECT_EQ(rop2FromRop3(0xF0), Rop2::Copy);
}

} // namespace
