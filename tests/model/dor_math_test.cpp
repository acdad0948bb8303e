#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "model/dor_math.h"

namespace {
const double kPi = 3.14159265358979323846;
}

TEST(Rotations, RightAnglesAreExact)
{
    DorMatrix4x4 rz = DorRotateZ(kPi / 2);
    EXPECT_EQ(rz.m[0][0], 0.0);
    EXPECT_EQ(rz.m[1][1], 0.0);
    EXPECT_EQ(rz.m[0][1], 1.0);
    DorVector3 p = DorTransformPoint(DorVector3(1, 0, 0), rz);  // counter-clockwise about +z
    EXPECT_EQ(p.x, 0.0);
    EXPECT_EQ(p.y, 1.0);
    DorVector3 q = DorTransformPoint(DorVector3(0, 1, 0), DorRotateX(kPi / 2));
    EXPECT_EQ(q.z, 1.0);
    DorVector3 r = DorTransformPoint(DorVector3(0, 0, 1), DorRotateY(kPi / 2));
    EXPECT_EQ(r.x, 1.0);
}

TEST(Matrices, ProductAppliesLeftFactorFirst)
{
    DorMatrix4x4 m = DorTranslate(1, 0, 0) * DorRotateZ(kPi / 2);
    DorVector3 p = DorTransformPoint(DorVector3(0, 0, 0), m);  // moved to (1,0,0), then turned
    EXPECT_EQ(p.x, 0.0);
    EXPECT_EQ(p.y, 1.0);
    DorVector3 d = DorTransformDirection(DorVector3(1, 0, 0), m);
    EXPECT_EQ(d.y, 1.0);
}

TEST(NewellNormal, PointsTowardTheViewerOfACounterClockwiseLoop)
{
    DorVector3 square[4] = {DorVector3(0, 0, 0), DorVector3(2, 0, 0), DorVector3(2, 2, 0), DorVector3(0, 2, 0)};
    DorVector3 n = DorNewellNormal(square, 4);
    EXPECT_EQ(n.x, 0.0);
    EXPECT_EQ(n.y, 0.0);
    EXPECT_EQ(n.z, 8.0);  // twice the area
    EXPECT_TRUE(DorNormalize(n));
    EXPECT_EQ(n.z, 1.0);
    DorVector3 tiny(0, 0, 0.00005);
    EXPECT_FALSE(DorNormalize(tiny));
    EXPECT_EQ(tiny.z, 0.00005);
}

TEST(DirectionAngles, QuadrantsAndVertical)
{
    double el = 9, az = 9;
    EXPECT_EQ(DorDirectionAngles(DorVector3(-1, 0, 0), el, az), DorDirectionSloped);
    EXPECT_DOUBLE_EQ(az, kPi);
    EXPECT_EQ(DorDirectionAngles(DorVector3(0, -2, 0), el, az), DorDirectionSloped);
    EXPECT_DOUBLE_EQ(az, -kPi / 2);
    EXPECT_EQ(DorDirectionAngles(DorVector3(1, 1, std::sqrt(2.0)), el, az), DorDirectionSloped);
    EXPECT_DOUBLE_EQ(el, kPi / 4);
    EXPECT_DOUBLE_EQ(az, kPi / 4);
    EXPECT_EQ(DorDirectionAngles(DorVector3(0, 0, -3), el, az), DorDirectionVertical);
    EXPECT_DOUBLE_EQ(el, -kPi / 2);
    EXPECT_EQ(DorDirectionAngles(DorVector3(0, 0, 0.00001), el, az), DorDirectionTooShort);
}

TEST(PlaneProjection, AnchorToExactOriginAndNormalToPlusZWhateverTheRotation)
{
    std::mt19937 rng(7);
    std::uniform_real_distribution<double> unit(-1.0, 1.0);
    for (int i = 0; i < 20000; ++i) {
        DorVector3 n(unit(rng), unit(rng), unit(rng));
        if (!DorNormalize(n))
            continue;
        DorVector3 anchor(unit(rng) * 100, unit(rng) * 100, unit(rng) * 100);
        DorMatrix4x4 m = DorPlaneProjection(n, anchor);
        DorVector3 a = DorTransformPoint(anchor, m);
        ASSERT_EQ(a.x, 0.0);
        ASSERT_EQ(a.y, 0.0);
        ASSERT_EQ(a.z, 0.0);
        DorVector3 z = DorTransformDirection(n, m);
        ASSERT_NEAR(z.z, 1.0, 1e-12);
        ASSERT_NEAR(z.x, 0.0, 1e-12);
    }
    DorVector3 down(0, 0, -1);
    DorVector3 turned = DorTransformDirection(down, DorPlaneProjection(down, DorVector3()));
    EXPECT_EQ(turned.z, 1.0);  // the vertical case uses the single Y rotation
}

TEST(Invert, UndoesARigidMoveAndRefusesSingularMatrices)
{
    DorMatrix4x4 m = DorTranslate(3, -2, 7) * DorRotateX(0.4) * DorRotateZ(-1.1) * DorTranslate(0, 0, 5);
    DorMatrix4x4 inverse;
    ASSERT_TRUE(DorInvert(m, 1e-7, inverse));
    DorVector3 p(1.5, -0.25, 4);
    DorVector3 back = DorTransformPoint(DorTransformPoint(p, m), inverse);
    EXPECT_NEAR(back.x, p.x, 1e-12);
    EXPECT_NEAR(back.y, p.y, 1e-12);
    EXPECT_NEAR(back.z, p.z, 1e-12);

    DorMatrix4x4 scaled;  // determinant 2 * 3 * 4 = 24: the inverse divides by each scale
    scaled.m[0][0] = 2;
    scaled.m[1][1] = 3;
    scaled.m[2][2] = 4;
    ASSERT_TRUE(DorInvert(scaled, 1e-7, inverse));
    EXPECT_DOUBLE_EQ(inverse.m[1][1], 1.0 / 3.0);

    DorMatrix4x4 flat;
    flat.m[2][2] = 0;  // squashes z: no inverse
    DorMatrix4x4 untouched = DorTranslate(9, 9, 9);
    EXPECT_FALSE(DorInvert(flat, 1e-7, untouched));
    EXPECT_EQ(untouched.m[3][0], 9.0);
    flat.m[2][2] = 1e-8;  // below the threshold
    EXPECT_FALSE(DorInvert(flat, 1e-7, untouched));
    flat.m[2][2] = std::nan("");
    EXPECT_FALSE(DorInvert(flat, 1e-7, untouched));
}

TEST(TruncateToInt, TowardZeroWithinIntRangeOnly)
{
    int out = 7;
    EXPECT_TRUE(DorTruncateToInt(-2.9, out));
    EXPECT_EQ(out, -2);
    EXPECT_TRUE(DorTruncateToInt(2147483647.9, out));
    EXPECT_EQ(out, 2147483647);
    EXPECT_TRUE(DorTruncateToInt(-2147483648.9, out));
    EXPECT_EQ(out, -2147483647 - 1);
    out = 7;
    EXPECT_FALSE(DorTruncateToInt(2147483648.0, out));
    EXPECT_FALSE(DorTruncateToInt(-2147483649.0, out));
    EXPECT_FALSE(DorTruncateToInt(std::nan(""), out));
    EXPECT_FALSE(DorTruncateToInt(-HUGE_VAL, out));
    EXPECT_EQ(out, 7);
}

TEST(DirectionAngles, AzimuthFallsBackToZeroWithoutADirection)
{
    EXPECT_DOUBLE_EQ(DorAzimuth(DorVector3(-2, 0, 5)), kPi);
    EXPECT_DOUBLE_EQ(DorAzimuth(DorVector3(0, 3, 0)), kPi / 2);
    EXPECT_EQ(DorAzimuth(DorVector3(0, 0, 4)), 0.0);        // vertical
    EXPECT_EQ(DorAzimuth(DorVector3(0.00005, 0, 0)), 0.0);  // too short
}
