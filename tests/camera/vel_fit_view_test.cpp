// Fit-all placements: every corner of the box ends up inside the view, checked with the view
// matrix and a perspective division of the test's own.
#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <cmath>
#include <thread>

#include "camera/vel_math_camera.h"
#include "support/recording_karvel.h"

namespace {
// How far the box reaches toward the edge of the view (1 = touching, above 1 = outside), and
// whether every corner lies between the clip planes.
double ReachOf(const _VelCamera& camera, const DorVector3& low, const DorVector3& high, bool& clipped)
{
    DorMatrix4x4 view;
    CVelMathMatrix::GetToViewMatrix(camera, 0, view);
    const double t = std::tan(camera.fovy / 360 * DorPi);
    double edge = 0;
    for (int i = 0; i < 8; ++i) {
        DorVector3 v = DorTransformPoint(DorVector3((i & 1 ? high : low).x, (i & 2 ? high : low).y, (i & 4 ? high : low).z), view);
        edge = std::max({edge, std::fabs(v.x) / (-v.z * t * camera.aspect), std::fabs(v.y) / (-v.z * t)});
        clipped = clipped || -v.z <= camera.zNear || -v.z >= camera.zFar;
    }
    return edge;
}

DorVector3 Direction(const _VelCamera& c) { return (c.target - c.eye) * (1 / DorLength(c.target - c.eye)); }
}  // namespace

// Both fits keep the direction, the field of view and zNear, aim at the box centre and leave every
// corner inside the view and between the clip planes; the box fit comes no farther back than the
// sphere fit and touches the edge unless the near plane holds it back. The sphere touches the
// narrower field of view.
TEST(FitView, EveryCornerInsideTheViewAndTheClipPlanes)
{
    const DorVector3 slabLow(10, -4, 2), slabHigh(70, 6, 5), aim(40, 1, 10), cube(10, 10, 10), o(0, 0, 0);
    // sphereDistance 0: not pinned
    const struct { DorVector3 eye, target; double fovy, aspect, zNear; DorVector3 low, high; double sphereDistance; } rows[] = {
        {{0, -100, 30}, aim, 45, 0.5, 1, slabLow, slabHigh, 0},  // a long flat slab off the origin
        {{0, -50, 0}, o, 90, 0.5, 1, cube * -1.0, cube, std::sqrt(300.0) / std::sin(std::atan(0.5))},
        {{0, -50, 0}, o, 90, 2.0, 1, cube * -1.0, cube, std::sqrt(300.0) / std::sin(DorPi / 4)},
        {{0, -50, 0}, o, 60, 1, 5, o, {0.01, 0.01, 0.01}, 0},  // a tiny box beyond a far-out near plane
        {{0, -50, 10}, o, 45, 1, 1, {-50000, -50000, 0}, {50000, 50000, 100}, 0},  // a huge one: zFar moves out
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(::testing::Message() << "eye " << row.eye.x << "," << row.eye.y << "," << row.eye.z);
        _VelCamera start = Camera(row.eye, row.target, row.fovy, row.aspect), sphere, box;
        start.zNear = row.zNear;
        CVelMathCamera::FitViewToSphere(sphere = start, row.low, row.high);
        CVelMathCamera::FitViewToBox(box = start, row.low, row.high);
        for (const _VelCamera* c : {&sphere, &box}) {
            bool clipped = false;
            EXPECT_LE(ReachOf(*c, row.low, row.high, clipped), c == &sphere ? 1.0 : 1.0 + 1e-9);
            EXPECT_TRUE(!clipped && DorLength(c->target - (row.low + row.high) * 0.5) <= 1e-12);
            EXPECT_TRUE(DorLength(Direction(*c) - Direction(start)) <= 1e-12 && c->fovy == row.fovy && c->zNear == row.zNear);
        }
        bool clipped = false;
        const double boxEdge = ReachOf(box, row.low, row.high, clipped), sphereDistance = DorLength(sphere.target - sphere.eye);
        EXPECT_TRUE(row.zNear > 1 ? boxEdge < 1.0 : std::fabs(boxEdge - 1.0) <= 1e-9) << boxEdge;
        EXPECT_LE(DorLength(box.target - box.eye), sphereDistance + 1e-9);
        EXPECT_TRUE(row.sphereDistance == 0 || std::fabs(sphereDistance - row.sphereDistance) <= 1e-9);
    }
}

// A point box keeps the eye's distance; a camera without a direction or with a field of view
// outside 0..180 degrees is not fitted at all, nor any camera on a box with a corner that is not
// finite or too large for doubles.
TEST(FitView, PointBoxKeepsTheDistanceAndUnfittableCamerasAreLeftAlone)
{
    const DorVector3 o(0, 0, 0), south(0, -30, 0), one(1, 1, 1);
    _VelCamera c = Camera(south, DorVector3(0, 10, 0), 45, 1);
    CVelMathCamera::FitViewToBox(c, one * 5, one * 5);
    EXPECT_TRUE(std::fabs(DorLength(c.target - c.eye) - 40) < 1e-9 && c.target.x == 5 && c.target.z == 5);
    const struct { _VelCamera before; DorVector3 corner; } unfittable[] = {
        {Camera(south, o, 0, 1), one}, {Camera(south, o, 180, 1), one}, {Camera(one, one, 45, 1), one},
        {Camera(south, o, NAN, 1), one}, {Camera(south, o, 45, 1), DorVector3(NAN, 0, 0)},
        {Camera(south, o, 45, 1), DorVector3(0, HUGE_VAL, 0)}, {Camera(south, o, 45, 1), one * 1e308}};
    for (const auto& u : unfittable) {
        c = u.before;
        CVelMathCamera::FitViewToSphere(c, u.corner * -1.0, u.corner);
        CVelMathCamera::FitViewToBox(c, o, u.corner);
        EXPECT_TRUE(SameCameraBits(c, u.before)) << u.before.fovy << " " << u.corner.x << " " << u.corner.y;
    }
}

// A modeller whose fit moves the camera to a known place.
class FittingKarvel : public RecordingKarvel {
public:
    _VelCamera fitted = Camera(DorVector3(50, -50, 50), DorVector3(5, 5, 5));
    void SetCameraForAllView_Hi(int) override { SetCamera(fitted); }
};

// The glide eases out from the camera to the fit over the whole duration, eye and target moving
// along their lines, never back and never all the way, then lands exactly on the fit; nothing is
// drawn for a bad duration, and non-finite frames are drawn but never set. (Where the fit lands,
// and the viewport variant, are checked on the live modeller.)
TEST(AllModelView, GlidesFromTheCameraToTheFitAndEndsExactlyOnIt)
{
    FittingKarvel k, still;
    std::vector<double> eased;
    k.onDraw = [&] {
        const double f = DorLength(k.camera.eye) / DorLength(k.fitted.eye);  // from an eye at the origin
        const DorVector3 target = DorVector3(0, 10, 0) + (k.fitted.target - DorVector3(0, 10, 0)) * f;
        EXPECT_LE(DorLength(k.camera.eye - k.fitted.eye * f) + DorLength(k.camera.target - target), 1e-9);
        eased.push_back(f);
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    };
    const auto start = std::chrono::steady_clock::now();
    k.KarvelAllmodelView(nullptr, 0, 40);
    EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(38));  // whole-ms clock
    ASSERT_GE(eased.size(), 3u);
    EXPECT_TRUE(std::is_sorted(eased.begin(), eased.end() - 1) && eased.front() < 0.5 && eased[eased.size() - 2] < 1);
    EXPECT_TRUE(SameCameraBits(k.camera, k.fitted) && eased.back() == 1.0 && k.setCameraCalls == static_cast<int>(eased.size()) + 1);
    for (double duration : {0.0, -5.0, double(NAN), HUGE_VAL})
        CVelMathCamera::AnimationCamera_Sec(&still, still.camera, k.fitted, duration, nullptr);
    EXPECT_EQ(still.drawCalls, 0);
    still.fitted.eye.x = HUGE_VAL;
    still.AnimationCamera(still.camera, still.fitted, 10.0, nullptr);  // the member glides its own modeller
    EXPECT_TRUE(still.drawCalls > 0 && still.setCameraCalls == 0);
    FittingKarvel brief;  // a duration whose square underflows still gives finite frames
    CVelMathCamera::AnimationCamera_Sec(&brief, brief.camera, brief.fitted, 1e-200, nullptr);
    EXPECT_TRUE(brief.drawCalls > 0 && brief.setCameraCalls == brief.drawCalls);
    // A camera holding inf: no fit, no glide, nothing drawn; with a fit, one jump to it.
    for (bool fits : {false, true}) {
        FittingKarvel lost;
        lost.camera.eye.x = HUGE_VAL;
        lost.fitted.zFar = fits ? 1000 : HUGE_VAL;
        lost.KarvelAllmodelView(nullptr, 0, 1000);
        EXPECT_EQ(lost.drawCalls, fits ? 1 : 0);
    }
}
