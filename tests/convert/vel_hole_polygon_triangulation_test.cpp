#include <gtest/gtest.h>

#include <limits>

#include "convert/vel_polygon_triangulation.h"
#include "hole_test_support.h"

using namespace hole_test;

namespace {
// A 4 x 4 square with a triangular hole: seven vertices, seven triangles around the hole.
class SquareWithTriangularHole : public ::testing::Test {
protected:
    Loop outline = Square(0, 0, 4);
    std::vector<Loop> holes = {{DorVector3(1, 1, 0), DorVector3(3, 1, 0), DorVector3(2, 3, 0)}};
};

class SquareWithSquareHole : public ::testing::Test {
protected:
    Loop outline = Square(0, 0, 4);
    std::vector<Loop> holes = {Square(1, 1, 2)};
};

std::vector<DorVector3> Flattened(const Loop& outline, const std::vector<Loop>& holes)
{
    std::vector<DorVector3> all(outline);
    for (const Loop& hole : holes)
        all.insert(all.end(), hole.begin(), hole.end());
    return all;
}
}  // namespace

TEST_F(SquareWithTriangularHole, SevenTrianglesCoverTheRing)
{
    Triangulated t;
    Triangulate(HolePolygon(outline, holes), t);
    ASSERT_EQ(t.Count(), 7);
    EXPECT_NEAR(CheckFlatRing(outline, holes, t), RingArea(outline, holes), 1e-12);
}

TEST_F(SquareWithTriangularHole, VerticesAreTheOutlineThenTheHoleUnchanged)
{
    Triangulated t;
    Triangulate(HolePolygon(outline, holes), t);
    std::vector<DorVector3> expected = Flattened(outline, holes);
    ASSERT_EQ(t.vertices.GetSize(), static_cast<int>(expected.size()));
    for (int k = 0; k < t.vertices.GetSize(); ++k) {
        EXPECT_EQ(t.vertices[k].x, expected[k].x);
        EXPECT_EQ(t.vertices[k].y, expected[k].y);
        EXPECT_EQ(t.vertices[k].z, expected[k].z);
    }
}

TEST_F(SquareWithTriangularHole, HoleGivenClockwiseGivesTheSameRing)
{
    std::swap(holes[0][1], holes[0][2]);
    Triangulated t;
    Triangulate(HolePolygon(outline, holes), t);
    ASSERT_EQ(t.Count(), 7);
    EXPECT_NEAR(CheckFlatRing(outline, holes, t), RingArea(outline, holes), 1e-12);
}

TEST_F(SquareWithTriangularHole, TiltedInSpaceStillCounterClockwiseAboutItsNormal)
{
    DorMatrix4x4 m = convert_test::RotationXYZ(0.7, -1.1, 2.3) * DorTranslate(5, -3, 8);
    Loop tiltedOutline = convert_test::Transformed(outline, m);
    std::vector<Loop> tiltedHoles = {convert_test::Transformed(holes[0], m)};
    Triangulated t;
    Triangulate(HolePolygon(tiltedOutline, tiltedHoles), t);
    DorVector3 normal = DorNewellNormal(tiltedOutline.data(), 4);
    DorNormalize(normal);
    ASSERT_EQ(t.Count(), 7);
    EXPECT_NEAR(CheckTriangles(t, normal), RingArea(outline, holes), 1e-9);
}

TEST_F(SquareWithTriangularHole, ClockwiseOutlineFollowsItsOwnNormal)
{
    Loop clockwise = Square(0, 0, 4, true);
    Triangulated t;
    Triangulate(HolePolygon(clockwise, holes), t);
    ASSERT_EQ(t.Count(), 7);
    EXPECT_NEAR(CheckTriangles(t, DorVector3(0, 0, -1)), RingArea(outline, holes), 1e-12);
}

TEST_F(SquareWithSquareHole, EightTrianglesAroundTheHoleNoneInside)
{
    Triangulated t;
    Triangulate(HolePolygon(outline, holes), t);
    ASSERT_EQ(t.Count(), 8);
    EXPECT_NEAR(CheckFlatRing(outline, holes, t), 12.0, 1e-12);
}

TEST_F(SquareWithSquareHole, IndicesAreEmptiedFirst)
{
    Triangulated t;
    for (int k = 0; k < 5; ++k)
        t.indices.Add(k);
    Triangulate(HolePolygon(outline, holes), t);
    EXPECT_EQ(t.Count(), 8);
}

TEST(TriangulateHoleGrid, FourAndNineHolesAreFullyTriangulated)
{
    for (int k : {2, 3}) {
        Loop outline = Square(0, 0, 3 * k + 1);
        std::vector<Loop> holes = HoleGrid(k);
        Triangulated t;
        Triangulate(HolePolygon(outline, holes), t);
        const int vertices = 4 + 4 * k * k;
        EXPECT_EQ(t.Count(), vertices + 2 * k * k - 2) << k * k << " holes";
        EXPECT_NEAR(CheckFlatRing(outline, holes, t), RingArea(outline, holes), 1e-9) << k * k << " holes";
    }
}

TEST(TriangulateHoleless, ATriangleHasNoDiagonalAndSoNoTriangles)
{
    Triangulated t;
    Triangulate(HolePolygon({DorVector3(0, 0, 0), DorVector3(3, 0, 0), DorVector3(1, 2, 0)}, {}), t);
    EXPECT_EQ(t.indices.GetSize(), 0);
    EXPECT_EQ(t.vertices.GetSize(), 3);
}

TEST(TriangulateHoleless, ConvexSixtyPointsCompletely)
{
    Loop circle = convert_test::RegularPolygon(60);
    Triangulated t;
    Triangulate(HolePolygon(circle, {}), t);
    EXPECT_EQ(t.Count(), 58);
    EXPECT_NEAR(CheckFlatRing(circle, {}, t), LoopArea(circle), 1e-9);
}

// Point 0's pass spends the budget of N + 98 diagonals on 0-2 .. 0-100: the fan stops at 100.
TEST(TriangulateHoleless, ConvexHundredTwentyPointsStopAtTheBudget)
{
    Loop circle = convert_test::RegularPolygon(120);
    Triangulated t;
    Triangulate(HolePolygon(circle, {}), t);
    std::set<std::set<int>> fan;
    for (int k = 1; k <= 99; ++k)
        fan.insert({0, k, k + 1});
    EXPECT_EQ(TriangleSet(t.indices), fan);
    CheckTriangles(t, DorVector3(0, 0, 1));
}

TEST(TriangulateHoleless, NoDiagonalPassesThroughAThirdVertex)
{
    Loop pentagon = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0), DorVector3(2, 2, 0),
                     DorVector3(0, 2, 0)};
    Triangulated t;
    Triangulate(HolePolygon(pentagon, {}), t);
    EXPECT_NEAR(CheckFlatRing(pentagon, {}, t), 4.0, 1e-12);
    EXPECT_EQ(TriangleSet(t.indices).count({0, 1, 2}), 0u);
}

// Vertex 2 sits 1e-5 above the segment 1-3, so the midpoint of 1-3 lies just outside the outline,
// but close enough to the edge 1-2 to count as on it: the notch below vertex 2 is filled.
TEST(TriangulateTolerance, MidpointJustOutsideTheOutlineCountsAsInside)
{
    Loop notched = {DorVector3(0, 0, 0), DorVector3(4, 0, 0), DorVector3(8, 1e-5, 0), DorVector3(9, 0, 0),
                    DorVector3(10, 0, 0), DorVector3(10, 10, 0), DorVector3(0, 10, 0)};
    Triangulated t;
    Triangulate(HolePolygon(notched, {}), t);
    CheckTriangles(t, DorVector3(0, 0, 1));
    EXPECT_EQ(TriangleSet(t.indices).count({1, 2, 3}), 1u);

    // The plain triangulation has no such tolerance and leaves the notch open.
    CDorPolygon plain = convert_test::Polygon(notched);
    CDorArray<int, int> plainIndices;
    TriangulatePolygon(&plain, plainIndices);
    EXPECT_EQ(TriangleSet(plainIndices).count({1, 2, 3}), 0u);
}

// Hole vertex b sits 1e-5 below the segment a-c, so the midpoint of a-c lies just inside the
// hole, but close enough to its edge a-b to count as outside it: the sliver a, b, c is emitted.
TEST(TriangulateTolerance, MidpointJustInsideAHoleCountsAsOutsideIt)
{
    Loop outline = Square(0, 0, 12);
    Loop hole = {DorVector3(4, 5, 0), DorVector3(8, 5 - 1e-5, 0), DorVector3(9, 5, 0), DorVector3(6, 7, 0)};
    Triangulated t;
    Triangulate(HolePolygon(outline, {hole}), t);
    CheckTriangles(t, DorVector3(0, 0, 1));
    EXPECT_EQ(TriangleSet(t.indices).count({4, 5, 6}), 1u);
}

// The corner at (100, 0) replaced by a tip of three points 1e-5 apart: the tip's triangle is too
// small to keep.
TEST(TriangulateTolerance, TinyTrianglesAreDropped)
{
    Loop bumped = {DorVector3(0, 0, 0), DorVector3(100 - 5e-6, 0, 0), DorVector3(100 + 5e-6, -5e-6, 0),
                   DorVector3(100, 5e-6, 0), DorVector3(100, 100, 0), DorVector3(0, 100, 0)};
    Triangulated t;
    Triangulate(HolePolygon(bumped, {}), t);
    EXPECT_EQ(TriangleSet(t.indices).count({1, 2, 3}), 0u);
    EXPECT_NEAR(CheckTriangles(t, DorVector3(0, 0, 1)), LoopArea(bumped), 1e-9);

    CDorPolygon plain = convert_test::Polygon(bumped);
    CDorArray<int, int> plainIndices;
    TriangulatePolygon(&plain, plainIndices);
    EXPECT_EQ(TriangleSet(plainIndices).count({1, 2, 3}), 1u);
}

TEST(TriangulateDegenerate, NoNormalGivesNoTrianglesButTheVertices)
{
    const std::vector<Loop> outlines = {
        {},
        {DorVector3(1, 2, 3)},
        {DorVector3(0, 0, 0), DorVector3(1, 1, 1), DorVector3(2, 2, 2)},
        {DorVector3(0, 0, 0), DorVector3(1, 1, 0), DorVector3(1, 0, 0), DorVector3(0, 1, 0)},  // figure eight
    };
    for (const Loop& outline : outlines) {
        Triangulated t;
        t.indices.Add(7);
        Triangulate(HolePolygon(outline, {Square(0.2, 0.2, 0.1)}), t);
        EXPECT_EQ(t.indices.GetSize(), 0) << outline.size() << " points";
        EXPECT_EQ(t.vertices.GetSize(), static_cast<int>(outline.size()) + 4);
    }
    Triangulated t;
    CVelHolePolygonToPrimitive().TriangulateHolePolygon(nullptr, t.vertices, t.indices);
    EXPECT_EQ(t.indices.GetSize(), 0);
}

TEST(TriangulateDegenerate, BadHolesGiveIndicesInRange)
{
    const Loop outline = Square(0, 0, 10);
    const std::vector<std::vector<Loop>> holeSets = {
        {{}, {DorVector3(5, 5, 0)}, Square(2, 2, 2)},                   // empty, one point, fine
        {Square(20, 20, 2)},                                            // outside the outline
        {Square(2, 2, 4), Square(4, 4, 4)},                             // overlapping
        {Square(-2, -2, 4)},                                            // across the outline
        {{DorVector3(3, 3, 0), DorVector3(6, 6, 0)}},                   // two points
        {{DorVector3(std::numeric_limits<double>::quiet_NaN(), 1, 0), DorVector3(2, 2, 0), DorVector3(1, 3, 0)}},
    };
    for (const std::vector<Loop>& holes : holeSets) {
        Triangulated t;
        Triangulate(HolePolygon(outline, holes), t);
        CheckTriangles(t, DorVector3(0, 0, 1));
    }
    Loop nanOutline = outline;
    nanOutline[2].x = std::numeric_limits<double>::quiet_NaN();
    Triangulated t;
    Triangulate(HolePolygon(nanOutline, {Square(2, 2, 2)}), t);
    EXPECT_EQ(t.indices.GetSize(), 0);
}
