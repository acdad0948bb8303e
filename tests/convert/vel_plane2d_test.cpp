#include <gtest/gtest.h>

#include <cmath>

#include "convert/vel_plane2d.h"

namespace {
const double kPi = 3.14159265358979323846;
const DorVector2 kSquare[4] = {DorVector2(0, 0), DorVector2(2, 0), DorVector2(2, 2), DorVector2(0, 2)};
}  // namespace

// The winding angle behind the inside test's exact fallback; the segment and edge predicates are
// exercised through the triangulation corpus.
TEST(Plane2d, WindingAngleInsideOutsideAndOnTheOutline)
{
    EXPECT_NEAR(VelWindingAngle(DorVector2(1, 1), kSquare, 4), 2 * kPi, 1e-12);
    EXPECT_TRUE(VelWindingInside(VelWindingAngle(DorVector2(1, 1), kSquare, 4)));
    EXPECT_NEAR(VelWindingAngle(DorVector2(3, 1), kSquare, 4), 0, 1e-12);
    EXPECT_FALSE(VelWindingInside(VelWindingAngle(DorVector2(3, 1), kSquare, 4)));
    // At a corner the two edges that meet there add nothing; the others subtend the right angle.
    EXPECT_NEAR(VelWindingAngle(DorVector2(2, 2), kSquare, 4), kPi / 2, 1e-12);
}
