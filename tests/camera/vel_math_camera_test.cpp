#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "camera/vel_math_camera.h"
#include "model/dor_math.h"
#include "support/camera_bits.h"

namespace {
const double kNaN = std::numeric_limits<double>::quiet_NaN();
const double kInf = std::numeric_limits<double>::infinity();

void ExpectNear(const DorVector3& actual, double x, double y, double z, double tolerance = 1e-9)
{
    EXPECT_NEAR(actual.x, x, tolerance);
    EXPECT_NEAR(actual.y, y, tolerance);
    EXPECT_NEAR(actual.z, z, tolerance);
}

double ElevationDegrees(const DorVector3& d) { return std::asin(d.z / DorLength(d)) * 180.0 / DorPi; }
double AzimuthDegrees(const DorVector3& d) { return std::atan2(d.y, d.x) * 180.0 / DorPi; }
}  // namespace

// ---- view and perspective matrices ----

TEST(ToViewMatrix, LookingAlongPlusXPutsTheTargetOnMinusZ)
{
    DorMatrix4x4 view;
    CVelMathMatrix::GetToViewMatrix(Camera(DorVector3(0, 0, 0), DorVector3(1, 0, 0)), 0.0, view);
    ExpectNear(DorTransformPoint(DorVector3(1, 0, 0), view), 0, 0, -1);
    ExpectNear(DorTransformPoint(DorVector3(0, 0, 1), view), 0, 1, 0);   // world up is screen up
    ExpectNear(DorTransformPoint(DorVector3(0, -1, 0), view), 1, 0, 0);  // right of the view is +x
}

TEST(ToViewMatrix, StraightDownLeavesOutTheTurnAboutZ)
{
    DorMatrix4x4 view;
    CVelMathMatrix::GetToViewMatrix(Camera(DorVector3(0, 0, 10), DorVector3(0, 0, 0)), 0.0, view);
    EXPECT_EQ(DorTransformPoint(DorVector3(0, 0, 0), view).z, -10.0);
    ExpectNear(DorTransformPoint(DorVector3(1, 2, 0), view), 1, 2, -10);  // x and y untouched
}

TEST(ToViewMatrix, DistShiftsAlongPlusZSoThatAPointDistAheadLandsOnZero)
{
    _VelCamera c = Camera(DorVector3(1, 2, 3), DorVector3(1, 7, 3));
    DorMatrix4x4 view;
    CVelMathMatrix::GetToViewMatrix(c, 5.0, view);
    ExpectNear(DorTransformPoint(c.eye, view), 0, 0, 5);
    ExpectNear(DorTransformPoint(c.target, view), 0, 0, 0);
    ExpectNear(DorTransformPoint(DorVector3(2, 7, 4), view), 1, 1, 0);
}

TEST(ToViewMatrix, SlopedViewsKeepDistancesAndPutTheTargetOnTheAxis)
{
    const DorVector3 eye(3, -2, 1);
    const DorVector3 directions[] = {DorVector3(1, 1, 1), DorVector3(-2, 0.5, -3), DorVector3(0, -4, 2),
                                     DorVector3(-1, -1, 0.2)};
    for (const DorVector3& d : directions) {
        _VelCamera c = Camera(eye, eye + d);
        DorMatrix4x4 view;
        CVelMathMatrix::GetToViewMatrix(c, 2.0, view);
        ExpectNear(DorTransformPoint(c.target, view), 0, 0, 2.0 - DorLength(d));
        // World up seen from the camera points to screen-up (positive y, no sideways part).
        DorVector3 up = DorTransformDirection(DorVector3(0, 0, 1), view);
        EXPECT_NEAR(up.x, 0.0, 1e-12);
        EXPECT_GT(up.y, 0.0);
        DorVector3 p(0.3, 0.7, -1.1);
        EXPECT_NEAR(DorLength(DorTransformPoint(p, view) - DorTransformPoint(eye, view)), DorLength(p - eye), 1e-12);
    }
}

TEST(PerspectiveMatrix, UpperEdgeOfTheFieldOfViewMapsToOneAndXIsScaledLikeY)
{
    // fovy 90: half-angle tangent 1. Everything is measured from the plane dist ahead of the eye.
    _VelCamera c = Camera(DorVector3(0, 0, 0), DorVector3(0, 10, 0), 90.0);
    const double dist = 5.0;
    DorMatrix4x4 m;
    CVelMathMatrix::GetPerspectiveMatrix(c, dist, m);
    auto project = [&](DorVector3 p, double& x, double& y, double& z) {
        double w = p.x * m.m[0][3] + p.y * m.m[1][3] + p.z * m.m[2][3] + m.m[3][3];
        DorVector3 q = DorTransformPoint(p, m);
        x = q.x / w;
        y = q.y / w;
        z = q.z / w;
    };
    double x, y, z;
    project(DorVector3(0, dist + 8, 8), x, y, z);  // 8 beyond the plane, 8 up
    EXPECT_NEAR(x, 0.0, 1e-12);
    EXPECT_NEAR(y, 1.0, 1e-12);
    EXPECT_NEAR(z, 3.0 / 8.0, 1e-12);
    project(DorVector3(-4, dist + 8, 0), x, y, z);  // to the left
    EXPECT_NEAR(x, -0.5, 1e-12);
    EXPECT_NEAR(y, 0.0, 1e-12);
}

TEST(PerspectiveMatrix, ZeroDistGivesNaNInTheDepthColumns)
{
    DorMatrix4x4 m;
    CVelMathMatrix::GetPerspectiveMatrix(Camera(DorVector3(1, 2, 3), DorVector3(4, 10, 5)), 0.0, m);
    for (int row = 0; row < 4; ++row) {
        EXPECT_TRUE(std::isnan(m.m[row][2]));
        EXPECT_TRUE(std::isnan(m.m[row][3]));
        EXPECT_TRUE(std::isfinite(m.m[row][0]));
        EXPECT_TRUE(std::isfinite(m.m[row][1]));
    }
}

// ---- moves ----

TEST(PanTilt, PanTurnsTheViewClockwiseSeenFromAbove)
{
    _VelCamera c = Camera(DorVector3(0, 0, 0), DorVector3(10, 0, 0));
    CVelMathCamera::PanTilt(c, 90.0, 0.0);
    EXPECT_EQ(c.target.x, 0.0);
    EXPECT_EQ(c.target.y, -10.0);
    EXPECT_EQ(c.target.z, 0.0);
    EXPECT_EQ(c.eye.x, 0.0);
}

TEST(PanTilt, TiltRaisesElevationAndKeepsAzimuthDistanceAndEye)
{
    const DorVector3 eye(1, 2, 3);
    _VelCamera c = Camera(eye, eye + DorVector3(3, 4, 0));
    const double azimuth = AzimuthDegrees(c.target - c.eye);
    CVelMathCamera::PanTilt(c, 20.0, 30.0);
    DorVector3 d = c.target - c.eye;
    EXPECT_NEAR(ElevationDegrees(d), 30.0, 1e-9);
    EXPECT_NEAR(AzimuthDegrees(d), azimuth - 20.0, 1e-9);
    EXPECT_NEAR(DorLength(d), 5.0, 1e-12);
    EXPECT_EQ(c.eye.x, eye.x);
    EXPECT_EQ(c.fovy, 45.0);
}

TEST(PanTilt, TiltOntoOrPastTheVerticalRefusesThePanToo)
{
    _VelCamera up45 = Camera(DorVector3(0, 0, 0), DorVector3(1, 0, 1));
    _VelCamera before = up45;
    CVelMathCamera::PanTilt(up45, 30.0, 50.0);  // 95 degrees
    EXPECT_TRUE(SameCameraBits(up45, before));

    _VelCamera level = Camera(DorVector3(0, 0, 0), DorVector3(5, 0, 0));
    before = level;
    CVelMathCamera::PanTilt(level, 0.0, 90.0);  // exactly vertical
    EXPECT_TRUE(SameCameraBits(level, before));
    CVelMathCamera::PanTilt(level, 0.0, -90.0);
    EXPECT_TRUE(SameCameraBits(level, before));
    CVelMathCamera::PanTilt(level, 0.0, 89.5);
    EXPECT_NEAR(ElevationDegrees(level.target - level.eye), 89.5, 1e-9);
}

TEST(Moves, VerticalOrShortViewsRefuseEveryMove)
{
    const _VelCamera cameras[] = {Camera(DorVector3(0, 0, 0), DorVector3(0, 0, 5)),
                                  Camera(DorVector3(0, 0, 5), DorVector3(0, 0, -5)),
                                  Camera(DorVector3(1, 1, 1), DorVector3(1, 1, 1.00005))};
    for (const _VelCamera& original : cameras) {
        _VelCamera c = original;
        CVelMathCamera::PanTilt(c, 10, 0);
        CVelMathCamera::Dolly(c, 1, 1, 1, 0);
        CVelMathCamera::Fly(c, 1, 1, 1, 0);
        CVelMathCamera::RoundDolly(c, 0, 10);
        EXPECT_TRUE(SameCameraBits(c, original));
    }
}

TEST(Dolly, ForwardRunsAlongTheGroundProjectionOfTheView)
{
    _VelCamera c = Camera(DorVector3(0, 0, 0), DorVector3(0, 5, 3));
    CVelMathCamera::Dolly(c, 1, 0, 0, 0);
    EXPECT_EQ(c.eye.x, 0.0);
    EXPECT_EQ(c.eye.y, 1.0);
    EXPECT_EQ(c.eye.z, 0.0);
    ExpectNear(c.target, 0, 6, 3, 0);

    _VelCamera eyeOnly = Camera(DorVector3(0, 0, 0), DorVector3(0, 5, 3));
    CVelMathCamera::Dolly(eyeOnly, 1, 0, 0, 1);
    ExpectNear(eyeOnly.eye, 0, 1, 0, 0);
    ExpectNear(eyeOnly.target, 0, 5, 3, 0);
}

TEST(Dolly, LeftIsAcrossTheViewAndUpIsWorldZ)
{
    _VelCamera c = Camera(DorVector3(0, 0, 0), DorVector3(0, 5, -3));  // looking +y, down
    CVelMathCamera::Dolly(c, 0, 2, 3, 0);
    ExpectNear(c.eye, -2, 0, 3, 0);
    ExpectNear(c.target, -2, 5, 0, 0);
}

TEST(Fly, ForwardFollowsTheSlopedView)
{
    _VelCamera c = Camera(DorVector3(0, 0, 0), DorVector3(1, 0, 1));
    CVelMathCamera::Fly(c, 1, 0, 0, 1);
    ExpectNear(c.eye, std::sqrt(0.5), 0, std::sqrt(0.5));
    ExpectNear(c.target, 1, 0, 1, 0);
}

TEST(Fly, RightAndUpAreTheCameraAxes)
{
    _VelCamera c = Camera(DorVector3(0, 0, 0), DorVector3(1, 0, 1));
    CVelMathCamera::Fly(c, 0, 1, 0, 0);  // right of a view along +x is -y
    ExpectNear(c.eye, 0, -1, 0);
    ExpectNear(c.target, 1, -1, 1);
    CVelMathCamera::Fly(c, 0, 0, 1, 0);  // up is at right angles to the view, in its vertical plane
    ExpectNear(c.eye, -std::sqrt(0.5), -1, std::sqrt(0.5));
    ExpectNear(c.target - c.eye, 1, 0, 1);
}

TEST(RoundDolly, QuarterTurnIsExact)
{
    _VelCamera c = Camera(DorVector3(10, 0, 0), DorVector3(0, 0, 0));
    CVelMathCamera::RoundDolly(c, 0, 90);
    EXPECT_EQ(c.eye.x, 0.0);
    EXPECT_EQ(c.eye.y, 10.0);
    EXPECT_EQ(c.eye.z, 0.0);
    EXPECT_EQ(c.target.x, 0.0);
}

TEST(RoundDolly, ClimbsOverTheTargetKeepingDistanceAndRefusesThePole)
{
    const DorVector3 target(1, 1, 1);
    _VelCamera c = Camera(target + DorVector3(0, -6, 0), target);
    CVelMathCamera::RoundDolly(c, 40, 0);
    DorVector3 e = c.eye - c.target;
    EXPECT_NEAR(ElevationDegrees(e), 40.0, 1e-9);
    EXPECT_NEAR(AzimuthDegrees(e), -90.0, 1e-9);
    EXPECT_NEAR(DorLength(e), 6.0, 1e-12);

    _VelCamera before = c;
    CVelMathCamera::RoundDolly(c, 50, 10);  // 90 degrees
    EXPECT_TRUE(SameCameraBits(c, before));
}

TEST(Moves, NonFiniteCamerasAndArgumentsAreRefused)
{
    _VelCamera nanEye = Camera(DorVector3(kNaN, 0, 0), DorVector3(1, 0, 0));
    _VelCamera infTarget = Camera(DorVector3(0, 0, 0), DorVector3(kInf, 1, 0));
    _VelCamera nanAspect = Camera(DorVector3(0, 0, 0), DorVector3(1, 0, 0));
    nanAspect.aspect = kNaN;
    for (_VelCamera original : {nanEye, infTarget, nanAspect}) {
        _VelCamera c = original;
        CVelMathCamera::PanTilt(c, 10, 10);
        CVelMathCamera::Dolly(c, 1, 1, 1, 0);
        CVelMathCamera::Fly(c, 1, 1, 1, 0);
        CVelMathCamera::RoundDolly(c, 10, 10);
        EXPECT_TRUE(SameCameraBits(c, original));
    }

    const _VelCamera fine = Camera(DorVector3(0, 0, 0), DorVector3(3, 4, 1));
    _VelCamera c = fine;
    CVelMathCamera::PanTilt(c, kInf, 0);
    CVelMathCamera::PanTilt(c, 0, kNaN);
    CVelMathCamera::Dolly(c, kNaN, 0, 0, 0);
    CVelMathCamera::Dolly(c, 0, 0, kInf, 1);
    CVelMathCamera::Fly(c, 0, kInf, 0, 0);
    CVelMathCamera::RoundDolly(c, 0, kNaN);
    CVelMathCamera::RoundDolly(c, kNaN, 0);
    EXPECT_TRUE(SameCameraBits(c, fine));

    _VelCamera distant = Camera(DorVector3(1e308, 0, 0), DorVector3(1e308, 5, 0));
    _VelCamera distantBefore = distant;
    CVelMathCamera::Dolly(distant, 0, -1e308, 0, 0);  // left of +y is -x: 1e308 + 1e308 overflows
    EXPECT_TRUE(SameCameraBits(distant, distantBefore));
}

// ---- viewport zoom ----

class ViewportZoom400x300 : public ::testing::Test {
protected:
    _VelCamera camera = Camera(DorVector3(0, 0, 0), DorVector3(0, 1, 0));
    _VelViewport viewport = {0, 0, 400, 300};
    void SetUp() override { camera.aspect = 400.0 / 300.0; }
    int Zoom(double x0, double y0, double x1, double y1)
    {
        return CVelMathCamera::ViewportZoom(camera, viewport, DorVector2(x0, y0), DorVector2(x1, y1));
    }
};

TEST_F(ViewportZoom400x300, CentredRectangleDoublesAboutTheCentre)
{
    ASSERT_EQ(Zoom(100, 75, 300, 225), 1);
    EXPECT_EQ(viewport.x, -200);
    EXPECT_EQ(viewport.y, -150);
    EXPECT_EQ(viewport.width, 800);
    EXPECT_EQ(viewport.height, 600);
}

TEST_F(ViewportZoom400x300, TopLeftQuadrantKeepsTheLeftEdgeAndDropsTheBottomHalf)
{
    ASSERT_EQ(Zoom(0, 0, 200, 150), 1);
    EXPECT_EQ(viewport.x, 0);
    EXPECT_EQ(viewport.y, -300);  // y of the GL viewport grows upward
    EXPECT_EQ(viewport.width, 800);
    EXPECT_EQ(viewport.height, 600);
}

TEST_F(ViewportZoom400x300, MoreThanFiveTimesIsRefused)
{
    const _VelViewport before = viewport;
    EXPECT_EQ(Zoom(100, 100, 150, 130), 0);  // 50 wide: eight times
    EXPECT_EQ(viewport.x, before.x);
    EXPECT_EQ(viewport.y, before.y);
    viewport = before;  // the refusal wrote the rectangle's size into it
    EXPECT_EQ(Zoom(100, 100, 180, 160), 1);  // 80 wide: exactly five
    EXPECT_EQ(viewport.width, 2000);
}

TEST_F(ViewportZoom400x300, EmptyOrReversedRectanglesAreRefusedWithTheirSizeWritten)
{
    EXPECT_EQ(Zoom(300, 75, 100, 225), 0);
    EXPECT_EQ(viewport.width, -200);  // the clamped size is written before the refusal
    EXPECT_EQ(viewport.height, 150);
    EXPECT_EQ(viewport.x, 0);
    EXPECT_EQ(Zoom(100, 100, 100.9, 200), 0);  // truncates to no width
}

TEST_F(ViewportZoom400x300, InfiniteCornersClampToTheWindow)
{
    ASSERT_EQ(Zoom(-kInf, -kInf, kInf, kInf), 1);
    EXPECT_EQ(viewport.x, 0);
    EXPECT_EQ(viewport.y, 0);
    EXPECT_EQ(viewport.width, 400);
    EXPECT_EQ(viewport.height, 300);
}

TEST_F(ViewportZoom400x300, NaNCornersAndBrokenAspectsAreRefused)
{
    EXPECT_EQ(Zoom(kNaN, 0, 200, 150), 0);
    EXPECT_EQ(Zoom(0, 0, 200, kNaN), 0);
    EXPECT_EQ(Zoom(0, 0, 1e300, 1e300), 1);  // clamped, so fine
    for (double aspect : {0.0, -1.0, kNaN}) {
        camera.aspect = aspect;
        viewport = {0, 0, 400, 300};
        EXPECT_EQ(Zoom(100, 75, 300, 225), 0);
    }
    camera.aspect = kInf;  // a window of no height: the box collapses onto its top edge
    viewport = {0, 0, 400, 300};
    EXPECT_EQ(Zoom(100, 75, 300, 225), 1);
    EXPECT_EQ(viewport.width, 800);
}

TEST(ViewportZoom, IntegerQuotientFitsByWidthAndShiftsBackInsideTheWindow)
{
    // 190 x 100 at aspect 1.5: w / h is 1 as an integer, so the fit keeps the width and makes
    // the box 126.67 high, which runs past the bottom and is moved back up.
    _VelCamera camera = Camera(DorVector3(0, 0, 0), DorVector3(0, 1, 0));
    camera.aspect = 1.5;
    _VelViewport viewport = {0, 0, 600, 400};
    ASSERT_EQ(CVelMathCamera::ViewportZoom(camera, viewport, DorVector2(100, 300), DorVector2(290, 400)), 1);
    const double scale = 600.0 / 190.0;
    EXPECT_EQ(viewport.width, static_cast<int>(600 * scale));
    EXPECT_EQ(viewport.height, static_cast<int>(400 * scale));
    EXPECT_EQ(viewport.x, static_cast<int>(-100 * scale));
    EXPECT_EQ(viewport.y, 0);  // the box's bottom is the window's bottom
}

// ---- approach ----

class ApproachAlongPlusY : public ::testing::Test {
protected:
    // fovy 90, viewport 200 high: the pointed plane lies 100 pixels ahead.
    _VelCamera camera = Camera(DorVector3(0, 0, 0), DorVector3(0, 10, 0), 90.0);
};

TEST_F(ApproachAlongPlusY, CentreWithoutDepthKeepsTheDirection)
{
    CVelMathCamera::ApproachCamera(camera, DorVector2(0, 0), 200, 100, 0);
    ExpectNear(camera.target, 0, 10, 0, 1e-12);
    ExpectNear(camera.eye, 0, 0, 0, 0);
}

TEST_F(ApproachAlongPlusY, TurnGoesToHalfThePointedOffset)
{
    CVelMathCamera::ApproachCamera(camera, DorVector2(100, 0), 200, 100, 0);
    ExpectNear(camera.target, 10 / std::sqrt(5.0), 20 / std::sqrt(5.0), 0, 1e-12);
    EXPECT_NEAR(DorLength(camera.target - camera.eye), 10.0, 1e-12);
    ExpectNear(camera.eye, 0, 0, 0, 0);

    _VelCamera up = Camera(DorVector3(0, 0, 0), DorVector3(0, 10, 0), 90.0);
    CVelMathCamera::ApproachCamera(up, DorVector2(0, 100), 200, 100, 0);  // y of the point is up
    EXPECT_GT(up.target.z, 0.0);
    EXPECT_NEAR(up.target.x, 0.0, 1e-12);
}

TEST_F(ApproachAlongPlusY, DepthMovesTheEyeByTheGrowthFactorAndKeepsTheTarget)
{
    CVelMathCamera::ApproachCamera(camera, DorVector2(30, -20), 200, 100, 10);
    ExpectNear(camera.eye, 0, 5, 0, 1e-12);
    ExpectNear(camera.target, 0, 10, 0, 0);

    _VelCamera still = Camera(DorVector3(0, 0, 0), DorVector3(0, 10, 0), 90.0);
    CVelMathCamera::ApproachCamera(still, DorVector2(0, 0), 200, 200, 10);
    ExpectNear(still.eye, 0, 0, 0, 0);
}

TEST_F(ApproachAlongPlusY, NonFiniteInputLeavesTheCameraAlone)
{
    const _VelCamera before = camera;
    CVelMathCamera::ApproachCamera(camera, DorVector2(kNaN, 0), 200, 100, 0);
    CVelMathCamera::ApproachCamera(camera, DorVector2(0, 0), kInf, 100, 0);
    CVelMathCamera::ApproachCamera(camera, DorVector2(0, 0), 200, 100, kNaN);
    camera.fovy = kNaN;
    _VelCamera nanFovy = camera;
    CVelMathCamera::ApproachCamera(camera, DorVector2(10, 10), 200, 100, 0);
    EXPECT_TRUE(SameCameraBits(camera, nanFovy));
    nanFovy.fovy = before.fovy;
    EXPECT_TRUE(SameCameraBits(nanFovy, before));
}

// Extreme numbers in every slot: each operation either leaves the camera as it was or leaves it
// entirely finite, and never crashes (the sanitizers watch the conversions).
TEST(Moves, ExtremeInputsNeverStoreANonFiniteCamera)
{
    const double values[] = {0.0, -0.0, 1e-300, 3.0, -7.5, 1e300, -1e308, kInf, -kInf, kNaN};
    const int n = sizeof values / sizeof values[0];
    for (int i = 0; i < n; ++i) {
        for (int j = 0; j < n; ++j) {
            const _VelCamera original = Camera(DorVector3(values[i], 1, 2), DorVector3(4, values[j], -1));
            const double a = values[(i + j) % n], b = values[(i * 3 + j) % n];
            for (int op = 0; op < 6; ++op) {
                _VelCamera c = original;
                switch (op) {
                case 0: CVelMathCamera::PanTilt(c, a, b); break;
                case 1: CVelMathCamera::Dolly(c, a, b, a, j & 1); break;
                case 2: CVelMathCamera::Fly(c, b, a, b, 0); break;
                case 3: CVelMathCamera::RoundDolly(c, a, b); break;
                case 4: CVelMathCamera::ApproachCamera(c, DorVector2(a, b), 300, 150, 0); break;
                default: CVelMathCamera::ApproachCamera(c, DorVector2(1, 2), a, b, values[j]); break;
                }
                EXPECT_TRUE(SameCameraBits(c, original) || VelCameraIsFinite(c))
                    << "op " << op << " i " << i << " j " << j;
                _VelViewport v = {static_cast<int>(i * 1000) - 2000, 0, 400, 300};
                CVelMathCamera::ViewportZoom(c, v, DorVector2(a, b), DorVector2(b, a));
                DorMatrix4x4 m;
                CVelMathMatrix::GetPerspectiveMatrix(c, a, m);
            }
        }
    }
}
