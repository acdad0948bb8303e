#include <gtest/gtest.h>

#include <cmath>

#include "convert/vel_plane2d.h"

namespace {
const double kPi = 3.14159265358979323846;
const DorVector2 kSquare[4] = {DorVector2(0, 0), DorVector2(2, 0), DorVector2(2, 2), DorVector2(0, 2)};
}  // namespace

// Crossings only strictly inside both segments; points on a segment only inside it, within
// 1e-6; on a loop's edge loosely (cross product below 1e-4) but never at a corner.
TEST(Plane2d, CrossingsAndPointsOnSegmentsAndEdges)
{
    const DorVector2 o(0, 0), a(10, 0);
    EXPECT_TRUE(VelSegmentsCross(DorVector2(0, 0), DorVector2(2, 2), DorVector2(0, 2), DorVector2(2, 0)));
    EXPECT_FALSE(VelSegmentsCross(DorVector2(0, 0), DorVector2(1, 1), DorVector2(1, 1), DorVector2(2, 0)));  // touch at an end
    EXPECT_FALSE(VelSegmentsCross(DorVector2(0, 0), DorVector2(2, 0), DorVector2(1, 0), DorVector2(3, 0)));  // overlapping, parallel
    EXPECT_FALSE(VelSegmentsCross(DorVector2(0, 0), DorVector2(1, 1), DorVector2(3, 0), DorVector2(2, 2)));  // would meet beyond
    EXPECT_FALSE(VelSegmentsCross(DorVector2(0, 0), DorVector2(0, 0), DorVector2(-1, 0), DorVector2(1, 0)));  // zero length
    EXPECT_TRUE(VelPointOnSegment(DorVector2(5, 0), o, a) && VelPointOnSegment(DorVector2(5, 5e-7), o, a));
    for (const DorVector2& p : {DorVector2(5, 2e-6), DorVector2(0, 0), DorVector2(11, 0)})
        EXPECT_FALSE(VelPointOnSegment(p, o, a)) << p.x << "," << p.y;
    EXPECT_FALSE(VelPointOnSegment(o, o, o));  // zero length holds nothing
    EXPECT_TRUE(VelOnLoopEdge(DorVector2(1, 0), kSquare, 4) && VelOnLoopEdge(DorVector2(1, -4e-5), kSquare, 4));
    for (const DorVector2& p : {DorVector2(1, -6e-5), DorVector2(0, 0), DorVector2(3, 0), DorVector2(1, 1)})
        EXPECT_FALSE(VelOnLoopEdge(p, kSquare, 4)) << p.x << "," << p.y;
    EXPECT_FALSE(VelOnLoopEdge(DorVector2(1, 1), kSquare, 0));
}

TEST(Plane2d, WindingAngleInsideOutsideAndOnTheOutline)
{
    EXPECT_NEAR(VelWindingAngle(DorVector2(1, 1), kSquare, 4), 2 * kPi, 1e-12);
    EXPECT_TRUE(VelWindingInside(VelWindingAngle(DorVector2(1, 1), kSquare, 4)));
    EXPECT_NEAR(VelWindingAngle(DorVector2(3, 1), kSquare, 4), 0, 1e-12);
    EXPECT_FALSE(VelWindingInside(VelWindingAngle(DorVector2(3, 1), kSquare, 4)));
    // At a corner the two edges that meet there add nothing; the others subtend the right angle.
    EXPECT_NEAR(VelWindingAngle(DorVector2(2, 2), kSquare, 4), kPi / 2, 1e-12);
    const int clockwise[4] = {3, 2, 1, 0};
    EXPECT_NEAR(VelWindingAngle(DorVector2(1, 1), kSquare, clockwise, 4), -2 * kPi, 1e-12);
}
