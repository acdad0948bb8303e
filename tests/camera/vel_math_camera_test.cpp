#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "camera/vel_camera_motion.h"
#include "camera/vel_math_camera.h"
#include "model/dor_math.h"
#include "support/camera_bits.h"

namespace {
const double kInf = std::numeric_limits<double>::infinity(), kH = std::sqrt(0.5);

enum Op { Pan, Dolly, Fly, Round };
void Apply(_VelCamera& c, Op op, double a, double b, double d, int eyeOnly)
{
    switch (op) {
    case Pan: CVelMathCamera::PanTilt(c, a, b); break;
    case Dolly: CVelMathCamera::Dolly(c, a, b, d, eyeOnly); break;
    case Fly: CVelMathCamera::Fly(c, a, b, d, eyeOnly); break;
    case Round: CVelMathCamera::RoundDolly(c, a, b); break;
    }
}
}  // namespace

TEST(ViewMatrices, HandDerivedImages)
{
    const struct { DorVector3 eye, target; double dist; DorVector3 point, image; } rows[] = {
        {{0, 0, 0}, {1, 0, 0}, 0, {1, -1, 1}, {1, 1, -1}},    // right of the view is +x, world up is +y
        {{0, 0, 10}, {0, 0, 0}, 0, {1, 2, 0}, {1, 2, -10}},  // straight down: no turn about z
        {{1, 2, 3}, {1, 7, 3}, 5, {2, 7, 4}, {1, 1, 0}},     // dist shifts along +z
        {{0, 0, 0}, {0, 1, 1}, 1, {1, 1, 0}, {1, -kH, 1 - kH}},  // sloped
    };
    for (const auto& r : rows) {
        DorMatrix4x4 view;
        CVelMathMatrix::GetToViewMatrix(Camera(r.eye, r.target), r.dist, view);
        EXPECT_LE(DorLength(DorTransformPoint(r.point, view) - r.image), 1e-12) << r.point.x << r.point.y << r.point.z;
    }
    // The projection from the plane dist ahead: dist 0 gives NaN depth, as hosts expect.
    DorMatrix4x4 m;
    CVelMathMatrix::GetPerspectiveMatrix(Camera(DorVector3(1, 2, 3), DorVector3(4, 10, 5)), 0.0, m);
    for (int row = 0; row < 4; ++row)
        EXPECT_TRUE(std::isnan(m.m[row][2]) && std::isnan(m.m[row][3]) && std::isfinite(m.m[row][0] + m.m[row][1]));
}

// Exact rows (tolerance 0) must match bit for bit, the refusals among them included.
TEST(Moves, HandDerivedResultsAndRefusals)
{
    const double c30 = std::cos(DorPi / 6), az = std::atan2(4.0, 3.0) - DorPi / 9, c40 = std::cos(DorPi * 2 / 9);
    const struct {
        DorVector3 eye, target;
        Op op;
        double a, b, d;
        int eyeOnly;
        DorVector3 eyeAfter, targetAfter;
        double tolerance;
    } rows[] = {
        {{0, 0, 0}, {10, 0, 0}, Pan, 90, 0, 0, 0, {0, 0, 0}, {0, -10, 0}, 0},  // clockwise from above
        {{1, 2, 3}, {4, 6, 3}, Pan, 20, 30, 0, 0, {1, 2, 3}, {1 + 5 * c30 * std::cos(az), 2 + 5 * c30 * std::sin(az), 5.5}, 1e-9},
        {{0, 0, 0}, {0, 5, 3}, Dolly, 1, 0, 0, 1, {0, 1, 0}, {0, 5, 3}, 0},  // along the ground projection
        {{0, 0, 0}, {0, 5, -3}, Dolly, 0, 2, 3, 0, {-2, 0, 3}, {-2, 5, 0}, 0},  // left across the view, up is z
        {{0, 0, 0}, {1, 0, 1}, Fly, 1, 0, 0, 1, {kH, 0, kH}, {1, 0, 1}, 1e-12},
        {{0, 0, 0}, {1, 0, 1}, Fly, 0, 1, 1, 0, {-kH, -1, kH}, {1 - kH, -1, 1 + kH}, 1e-12},
        {{10, 0, 0}, {0, 0, 0}, Round, 0, 90, 0, 0, {0, 10, 0}, {0, 0, 0}, 0},  // a quarter turn
        {{1, -5, 1}, {1, 1, 1}, Round, 40, 0, 0, 0, {1, 1 - 6 * c40, 1 + 6 * std::sin(DorPi * 2 / 9)}, {1, 1, 1}, 1e-9},
        // Refused: a tilt past the vertical refuses the pan too; onto either pole; 1e308 + 1e308.
        {{0, 0, 0}, {1, 0, 1}, Pan, 30, 50, 0, 0, {0, 0, 0}, {1, 0, 1}, 0},
        {{0, 0, 0}, {5, 0, 0}, Pan, 0, 90, 0, 0, {0, 0, 0}, {5, 0, 0}, 0},
        {{0, 0, 0}, {5, 0, 0}, Pan, 0, -90, 0, 0, {0, 0, 0}, {5, 0, 0}, 0},
        {{0, -1, 1}, {0, 0, 0}, Round, 45, 10, 0, 0, {0, -1, 1}, {0, 0, 0}, 0},
        {{1e308, 0, 0}, {1e308, 5, 0}, Dolly, 0, -1e308, 0, 0, {1e308, 0, 0}, {1e308, 5, 0}, 0},
        // Vertical or too short views have no direction to move along.
        {{0, 0, 5}, {0, 0, -5}, Dolly, 1, 1, 1, 0, {0, 0, 5}, {0, 0, -5}, 0},
        {{1, 1, 1}, {1, 1, 1.00005}, Round, 10, 10, 0, 0, {1, 1, 1}, {1, 1, 1.00005}, 0},
    };
    for (int i = 0; i < static_cast<int>(sizeof rows / sizeof rows[0]); ++i) {
        _VelCamera c = Camera(rows[i].eye, rows[i].target), want = Camera(rows[i].eyeAfter, rows[i].targetAfter);
        Apply(c, rows[i].op, rows[i].a, rows[i].b, rows[i].d, rows[i].eyeOnly);
        EXPECT_TRUE(rows[i].tolerance ? DorLength(c.eye - want.eye) <= rows[i].tolerance &&
                                            DorLength(c.target - want.target) <= rows[i].tolerance && c.fovy == 45.0
                                      : SameCameraBits(c, want))
            << "row " << i;
    }
}

TEST(ViewportZoom, FitsTheDraggedBoxWithinFiveTimes)
{
    const int kAny = -99999;  // a refusal may have written the box's size: only some rows pin it
    const struct { double aspect, x0, y0, x1, y1; int ok, x, y, width, height; } rows[] = {
        {4.0 / 3, 100, 75, 300, 225, 1, -200, -150, 800, 600},     // doubles about the centre, GL y upward
        {4.0 / 3, 100, 100, 180, 160, 1, -500, -700, 2000, 1500},  // exactly five times
        {4.0 / 3, 100, 100, 150, 130, 0, kAny, kAny, kAny, kAny},  // eight times
        {4.0 / 3, 300, 75, 100, 225, 0, 0, 0, -200, 150},          // reversed: size written, then refused
        {4.0 / 3, -kInf, -kInf, kInf, kInf, 1, 0, 0, 400, 300},    // clamped to the window
        {-kInf, 100, 75, 300, 225, 0, kAny, kAny, kAny, kAny},     // a scale of -0 is negative too
        // w / h is 1 as an integer: the fit keeps the width, runs past the bottom and moves back up.
        {1.5, 100, 300, 290, 400, 1, static_cast<int>(-100 * 600 / 190.0), 0, static_cast<int>(600 * 600 / 190.0),
         static_cast<int>(400 * 600 / 190.0)},
    };
    for (const auto& r : rows) {
        _VelCamera camera = Camera(DorVector3(0, 0, 0), DorVector3(0, 1, 0), 45, r.aspect);
        _VelViewport v = {0, 0, r.aspect == 1.5 ? 600 : 400, r.aspect == 1.5 ? 400 : 300};
        SCOPED_TRACE(::testing::Message() << r.aspect << " " << r.x0 << "," << r.y0 << " " << r.x1 << "," << r.y1);
        EXPECT_EQ(CVelMathCamera::ViewportZoom(camera, v, DorVector2(r.x0, r.y0), DorVector2(r.x1, r.y1)), r.ok);
        const int got[] = {v.x, v.y, v.width, v.height}, want[] = {r.x, r.y, r.width, r.height};
        for (int k = 0; k < 4; ++k)
            EXPECT_TRUE(want[k] == kAny || got[k] == want[k]) << "field " << k << " is " << got[k];
    }
}

TEST(ApproachCamera, TurnsToHalfThePointedOffsetOrMovesByTheGrowthFactor)
{
    // fovy 90, viewport 200 high: the pointed plane lies 100 pixels ahead of an eye looking along +y.
    const double s3 = std::sqrt(5.25);
    const struct { double px, py, height, depth; DorVector3 eye, target; } rows[] = {
        {100, 50, 100, 0, {0, 0, 0}, {10 / s3, 20 / s3, 5 / s3}},  // y of the point is up
        {30, -20, 100, 10, {0, 5, 0}, {0, 10, 0}},         // depth moves the eye only
    };
    for (const auto& r : rows) {
        _VelCamera c = Camera(DorVector3(0, 0, 0), DorVector3(0, 10, 0), 90.0);
        CVelMathCamera::ApproachCamera(c, DorVector2(r.px, r.py), 200, r.height, r.depth);
        EXPECT_LE(DorLength(c.eye - r.eye) + DorLength(c.target - r.target), 1e-12) << r.px << "," << r.py;
    }
}

// The orbit after elapsed milliseconds: the eye turned counter-clockwise about the target's
// vertical by the angle reached, whole turns dropped.
TEST(OrbitCamera, TurnsTheEyeByTheAngleReached)
{
    const _VelCamera start = Camera(DorVector3(10, 0, 3), DorVector3(0, 0, 0));
    const struct { int rate; unsigned int elapsed; double degrees; } rows[] = {{90, 1000, 90}, {-90, 500, -45}, {30, 13000, 30}};
    for (const auto& r : rows) {
        const _VelCamera c = VelOrbitCamera(start, r.rate, r.elapsed);
        const double a = r.degrees * DorPi / 180;
        EXPECT_LE(DorLength(c.eye - DorVector3(10 * std::cos(a), 10 * std::sin(a), 3)) + DorLength(c.target), 1e-9) << r.elapsed;
    }
}
