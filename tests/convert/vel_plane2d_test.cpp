#include <gtest/gtest.h>

#include <cmath>

#include "convert/vel_plane2d.h"

namespace {
const double kPi = 3.14159265358979323846;
const DorVector2 kSquare[4] = {DorVector2(0, 0), DorVector2(2, 0), DorVector2(2, 2), DorVector2(0, 2)};
}  // namespace

TEST(SegmentsCross, OnlyStrictlyInsideBoth)
{
    EXPECT_TRUE(VelSegmentsCross(DorVector2(0, 0), DorVector2(2, 2), DorVector2(0, 2), DorVector2(2, 0)));
    EXPECT_FALSE(VelSegmentsCross(DorVector2(0, 0), DorVector2(1, 1), DorVector2(1, 1), DorVector2(2, 0)));  // touch at an end
    EXPECT_FALSE(VelSegmentsCross(DorVector2(0, 0), DorVector2(2, 0), DorVector2(1, 0), DorVector2(3, 0)));  // overlapping, parallel
    EXPECT_FALSE(VelSegmentsCross(DorVector2(0, 0), DorVector2(1, 1), DorVector2(3, 0), DorVector2(2, 2)));  // would meet beyond
    EXPECT_FALSE(VelSegmentsCross(DorVector2(0, 0), DorVector2(0, 0), DorVector2(-1, 0), DorVector2(1, 0)));  // zero length
}

TEST(WindingAngle, InsideOutsideAndOnTheOutline)
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

TEST(PointOnSegment, InteriorWithinToleranceOnly)
{
    DorVector2 a(0, 0), b(10, 0);
    EXPECT_TRUE(VelPointOnSegment(DorVector2(5, 0), a, b));
    EXPECT_TRUE(VelPointOnSegment(DorVector2(5, 5e-7), a, b));
    EXPECT_FALSE(VelPointOnSegment(DorVector2(5, 2e-6), a, b));
    EXPECT_FALSE(VelPointOnSegment(DorVector2(0, 0), a, b));    // an end
    EXPECT_FALSE(VelPointOnSegment(DorVector2(11, 0), a, b));   // beyond
    EXPECT_FALSE(VelPointOnSegment(DorVector2(0, 0), a, a));    // zero length holds nothing
}

TEST(OnLoopEdge, LooseNearAnEdgeButNotAtACornerOrBeyond)
{
    EXPECT_TRUE(VelOnLoopEdge(DorVector2(1, 0), kSquare, 4));
    EXPECT_TRUE(VelOnLoopEdge(DorVector2(1, -4e-5), kSquare, 4));  // cross 8e-5: still on it
    EXPECT_FALSE(VelOnLoopEdge(DorVector2(1, -6e-5), kSquare, 4));  // cross 1.2e-4
    EXPECT_FALSE(VelOnLoopEdge(DorVector2(0, 0), kSquare, 4));      // a corner: no direction to it
    EXPECT_FALSE(VelOnLoopEdge(DorVector2(3, 0), kSquare, 4));      // on the line, beyond the end
    EXPECT_FALSE(VelOnLoopEdge(DorVector2(1, 1), kSquare, 4));
    EXPECT_FALSE(VelOnLoopEdge(DorVector2(1, 1), kSquare, 0));
}
