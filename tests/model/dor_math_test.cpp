#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "model/dor_math.h"

// Right angles are exact, the left factor applies first and directions ignore the translation;
// the Newell normal is twice the area toward the viewer, normalised only from 0.0001 up.
TEST(Matrices, RightAnglesAreExactAndTheLeftFactorAppliesFirst)
{
    const struct { DorMatrix4x4 m; DorVector3 point, image; bool direction; } rows[] = {
        {DorRotateZ(DorPi / 2), {1, 0, 0}, {0, 1, 0}, false},  // counter-clockwise about +z
        {DorRotateX(DorPi / 2), {0, 1, 0}, {0, 0, 1}, false},
        {DorRotateY(DorPi / 2), {0, 0, 1}, {1, 0, 0}, false},
        {DorTranslate(1, 0, 0) * DorRotateZ(DorPi / 2), {0, 0, 0}, {0, 1, 0}, false},  // moved, then turned
        {DorTranslate(1, 0, 0) * DorRotateZ(DorPi / 2), {1, 1, 0}, {-1, 1, 0}, true},
    };
    for (const auto& r : rows) {
        DorVector3 p = r.direction ? DorTransformDirection(r.point, r.m) : DorTransformPoint(r.point, r.m);
        EXPECT_TRUE(p.x == r.image.x && p.y == r.image.y && p.z == r.image.z) << p.x << "," << p.y << "," << p.z;
    }
    DorVector3 square[4] = {DorVector3(0, 0, 0), DorVector3(2, 0, 0), DorVector3(2, 2, 0), DorVector3(0, 2, 0)};
    DorVector3 n = DorNewellNormal(square, 4), tiny(0, 0, 0.00005);
    EXPECT_TRUE(n.x == 0.0 && n.y == 0.0 && n.z == 8.0);
    EXPECT_TRUE(DorNormalize(n) && n.z == 1.0);
    EXPECT_FALSE(DorNormalize(tiny));
    EXPECT_EQ(tiny.z, 0.00005);
}

TEST(PlaneProjection, AnchorToExactOriginAndNormalToPlusZWhateverTheRotation)
{
    std::mt19937 rng(7);
    std::uniform_real_distribution<double> unit(-1.0, 1.0);
    for (int i = 0; i < 20000; ++i) {
        DorVector3 n(unit(rng), unit(rng), unit(rng)), anchor(unit(rng) * 100, unit(rng) * 100, unit(rng) * 100);
        if (!DorNormalize(n))
            continue;
        DorMatrix4x4 m = DorPlaneProjection(n, anchor);
        DorVector3 a = DorTransformPoint(anchor, m), z = DorTransformDirection(n, m);
        ASSERT_TRUE(a.x == 0.0 && a.y == 0.0 && a.z == 0.0) << a.x << "," << a.y << "," << a.z;
        ASSERT_TRUE(std::fabs(z.z - 1) < 1e-12 && std::fabs(z.x) < 1e-12) << z.x << "," << z.z;
    }
    DorVector3 down(0, 0, -1);
    EXPECT_EQ(DorTransformDirection(down, DorPlaneProjection(down, DorVector3())).z, 1.0);  // the vertical case
}

TEST(Invert, UndoesARigidMoveAndScalesAndRefusesSingularMatrices)
{
    DorMatrix4x4 scale;  // determinant 24: the inverse divides by each scale
    scale.m[0][0] = 2;
    scale.m[1][1] = 3;
    scale.m[2][2] = 4;
    DorMatrix4x4 m = DorTranslate(3, -2, 7) * DorRotateX(0.4) * scale * DorRotateZ(-1.1) * DorTranslate(0, 0, 5), inverse;
    ASSERT_TRUE(DorInvert(m, 1e-7, inverse));
    const DorVector3 p(1.5, -0.25, 4);
    EXPECT_NEAR(DorLength(DorTransformPoint(DorTransformPoint(p, m), inverse) - p), 0.0, 1e-12);
    DorMatrix4x4 untouched = DorTranslate(9, 9, 9);
    for (double squash : {0.0, 1e-8, std::nan("")}) {  // no inverse, below the threshold, not a number
        DorMatrix4x4 flat;
        flat.m[2][2] = squash;
        EXPECT_FALSE(DorInvert(flat, 1e-7, untouched)) << squash;
    }
    EXPECT_EQ(untouched.m[3][0], 9.0);
}
