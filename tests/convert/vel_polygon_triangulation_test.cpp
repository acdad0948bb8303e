#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>
#include <set>

#include "convert/vel_polygon_triangulation.h"
#include "convert_test_support.h"

using namespace convert_test;

namespace {
CDorArray<int, int> Triangulate(const std::vector<DorVector3>& points)
{
    CDorPolygon polygon = Polygon(points);
    CDorArray<int, int> indices;
    TriangulatePolygon(&polygon, indices);
    return indices;
}

DorVector3 UnitNormal(const std::vector<DorVector3>& points)
{
    DorVector3 n = DorNewellNormal(points.data(), static_cast<int>(points.size()));
    DorNormalize(n);
    return n;
}

// Every index in range, every triangle strictly counter-clockwise about the outline's normal;
// returns the triangles' total area.
double CheckTriangles(const std::vector<DorVector3>& points, const CDorArray<int, int>& indices)
{
    EXPECT_EQ(indices.GetSize() % 3, 0);
    DorVector3 normal = UnitNormal(points);
    const int n = static_cast<int>(points.size());
    double area = 0;
    for (int t = 0; t + 2 < indices.GetSize(); t += 3) {
        for (int k = 0; k < 3; ++k) {
            EXPECT_GE(indices[t + k], 0);
            EXPECT_LT(indices[t + k], n);
            if (indices[t + k] < 0 || indices[t + k] >= n)
                return -1;
        }
        double twice = SignedDoubleArea(points[indices[t]], points[indices[t + 1]], points[indices[t + 2]], normal);
        EXPECT_GT(twice, 1e-12) << "triangle " << t / 3 << " is clockwise or degenerate";
        area += twice * 0.5;
    }
    return area;
}

void ExpectCoversOnce(const std::vector<DorVector3>& points, const CDorArray<int, int>& indices)
{
    double area = CheckTriangles(points, indices);
    EXPECT_NEAR(area, LoopArea(points), 1e-9 * LoopArea(points));
    EXPECT_EQ(indices.GetSize() / 3, static_cast<int>(points.size()) - 2);
}

std::set<std::set<int>> TriangleSet(const CDorArray<int, int>& indices)
{
    std::set<std::set<int>> triangles;
    for (int t = 0; t + 2 < indices.GetSize(); t += 3)
        triangles.insert({indices[t], indices[t + 1], indices[t + 2]});
    return triangles;
}
}  // namespace

TEST(TriangulateSquare, CounterClockwiseGivesTwoTrianglesCoveringIt)
{
    std::vector<DorVector3> square = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 1, 0), DorVector3(0, 1, 0)};
    CDorArray<int, int> indices = Triangulate(square);
    ASSERT_EQ(indices.GetSize(), 6);
    ExpectCoversOnce(square, indices);
}

TEST(TriangulateSquare, ClockwiseFollowsItsOwnNormal)
{
    std::vector<DorVector3> square = {DorVector3(0, 0, 0), DorVector3(0, 1, 0), DorVector3(1, 1, 0), DorVector3(1, 0, 0)};
    ASSERT_LT(UnitNormal(square).z, 0);
    CDorArray<int, int> indices = Triangulate(square);
    ASSERT_EQ(indices.GetSize(), 6);
    ExpectCoversOnce(square, indices);  // counter-clockwise about -z
}

TEST(TriangulateTriangle, OneTriangleWhateverTheRotation)
{
    std::mt19937 rng(11);
    std::uniform_real_distribution<double> angle(-kPi, kPi), shift(-50, 50);
    std::vector<DorVector3> triangle = {DorVector3(0, 0, 0), DorVector3(3, 0, 0), DorVector3(1, 2, 0)};
    for (int trial = 0; trial < 20000; ++trial) {
        DorMatrix4x4 m = RotationXYZ(angle(rng), angle(rng), angle(rng)) * DorTranslate(shift(rng), shift(rng), shift(rng));
        std::vector<DorVector3> moved = Transformed(triangle, m);
        CDorArray<int, int> indices = Triangulate(moved);
        ASSERT_EQ(indices.GetSize(), 3) << "trial " << trial;
        ASSERT_GT(CheckTriangles(moved, indices), 0);
    }
}

TEST(TriangulateLShape, FourTrianglesNoneOutsideTheL)
{
    std::vector<DorVector3> l = LShape();
    CDorArray<int, int> indices = Triangulate(l);
    ASSERT_EQ(indices.GetSize(), 12);
    ExpectCoversOnce(l, indices);
    for (int t = 0; t < indices.GetSize(); t += 3) {
        DorVector3 centre = (l[indices[t]] + l[indices[t + 1]] + l[indices[t + 2]]) * (1.0 / 3);
        EXPECT_FALSE(centre.x > 1 && centre.y > 1) << "triangle " << t / 3 << " lies in the notch";
    }
}

TEST(TriangulateLShape, TiltedInSpaceStillCovered)
{
    std::vector<DorVector3> l = Transformed(LShape(), RotationXYZ(0.7, -1.1, 2.3) * DorTranslate(5, -3, 8));
    ExpectCoversOnce(l, Triangulate(l));
}

TEST(TriangulatePointOnEdge, NoSegmentPassesThroughTheMiddlePoint)
{
    // Point 1 lies on the bottom side: the chord 0-2 would pass through it.
    std::vector<DorVector3> pentagon = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0),
                                        DorVector3(2, 2, 0), DorVector3(0, 2, 0)};
    CDorArray<int, int> indices = Triangulate(pentagon);
    EXPECT_NEAR(CheckTriangles(pentagon, indices), 4.0, 1e-12);
    EXPECT_EQ(TriangleSet(indices).count({0, 1, 2}), 0u);
}

TEST(TriangulateConvex, SixtyPointsCompletely)
{
    std::vector<DorVector3> circle = RegularPolygon(60);
    ExpectCoversOnce(circle, Triangulate(circle));
}

TEST(TriangulateConvex, HundredTwentyPointsGiveTheFanFromPointZeroToPointHundred)
{
    std::vector<DorVector3> circle = RegularPolygon(120);
    CDorArray<int, int> indices = Triangulate(circle);
    ASSERT_EQ(indices.GetSize(), 99 * 3);
    CheckTriangles(circle, indices);
    std::set<std::set<int>> fan;
    for (int k = 1; k <= 99; ++k)
        fan.insert({0, k, k + 1});
    EXPECT_EQ(TriangleSet(indices), fan);
}

TEST(TriangulateStar, FortyPointsInRangeCounterClockwiseNoRepeatsNoOverlap)
{
    std::vector<DorVector3> star = Star(20, 2.0, 1.0);
    CDorArray<int, int> indices = Triangulate(star);
    ASSERT_GT(indices.GetSize(), 0);
    double area = CheckTriangles(star, indices);
    EXPECT_LE(area, LoopArea(star) * (1 + 1e-12));
    EXPECT_EQ(TriangleSet(indices).size(), static_cast<size_t>(indices.GetSize() / 3));
}

TEST(TriangulateStar, FiveTipsCompletely)
{
    std::vector<DorVector3> star = Star(5, 2.0, 0.8);
    ExpectCoversOnce(star, Triangulate(star));
}

TEST(TriangulateDegenerate, NoNormalLeavesTheOutputAsHandedIn)
{
    const std::vector<std::vector<DorVector3>> outlines = {
        {},
        {DorVector3(1, 2, 3)},
        {DorVector3(0, 0, 0), DorVector3(1, 0, 0)},
        {DorVector3(0, 0, 0), DorVector3(1, 1, 1), DorVector3(2, 2, 2)},               // collinear
        {DorVector3(4, 4, 4), DorVector3(4, 4, 4), DorVector3(4, 4, 4), DorVector3(4, 4, 4)},  // one point repeated
        {DorVector3(0, 0, 0), DorVector3(1, 1, 0), DorVector3(1, 0, 0), DorVector3(0, 1, 0)},  // figure eight
    };
    for (const std::vector<DorVector3>& outline : outlines) {
        CDorPolygon polygon = Polygon(outline);
        CDorArray<int, int> indices;
        indices.Add(7);
        TriangulatePolygon(&polygon, indices);
        ASSERT_EQ(indices.GetSize(), 1) << outline.size() << " points";
        EXPECT_EQ(indices[0], 7);
    }
}

TEST(TriangulateDegenerate, RepeatedClosingPointStillCovers)
{
    std::vector<DorVector3> square = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 1, 0),
                                      DorVector3(0, 1, 0), DorVector3(0, 0, 0)};
    CDorArray<int, int> indices = Triangulate(square);
    EXPECT_NEAR(CheckTriangles(square, indices), 1.0, 1e-12);
}

TEST(TriangulateDegenerate, NonFiniteCoordinatesGiveIndicesInRangeOrNothing)
{
    const double nan = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
    for (double bad : {nan, inf, -inf}) {
        std::vector<DorVector3> outline = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(bad, 1, 0),
                                           DorVector3(0, 1, 0)};
        CDorArray<int, int> indices = Triangulate(outline);
        for (int k = 0; k < indices.GetSize(); ++k) {
            EXPECT_GE(indices[k], 0);
            EXPECT_LT(indices[k], 4);
        }
    }
    CDorArray<int, int> untouched;
    TriangulatePolygon(nullptr, untouched);
    EXPECT_EQ(untouched.GetSize(), 0);
}
