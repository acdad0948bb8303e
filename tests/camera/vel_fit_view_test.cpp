// Fit-all placements: every corner of the box ends up inside the view, checked with the view
// matrix and a perspective division of the test's own.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "camera/vel_math_camera.h"
#include "model/dor_math.h"
#include "support/camera_bits.h"
#include "support/recording_karvel.h"

namespace {
DorVector3 Corner(const DorVector3& low, const DorVector3& high, int i)
{
    return DorVector3((i & 1) ? high.x : low.x, (i & 2) ? high.y : low.y, (i & 4) ? high.z : low.z);
}

// How far the box reaches toward the edge of the view: 1 = touching; above 1 = outside.
// Also the nearest and farthest corner depths.
struct Reach {
    double edge, nearest, farthest;
};

Reach ReachOf(const _VelCamera& camera, const DorVector3& low, const DorVector3& high)
{
    DorMatrix4x4 view;
    CVelMathMatrix::GetToViewMatrix(camera, 0, view);
    double t = std::tan(camera.fovy / 2 / 180 * DorPi);
    Reach r = {0, HUGE_VAL, -HUGE_VAL};
    for (int i = 0; i < 8; ++i) {
        DorVector3 v = DorTransformPoint(Corner(low, high, i), view);
        double depth = -v.z;
        r.edge = std::max(r.edge, std::max(std::fabs(v.x) / (depth * t * camera.aspect), std::fabs(v.y) / (depth * t)));
        r.nearest = std::min(r.nearest, depth);
        r.farthest = std::max(r.farthest, depth);
    }
    return r;
}

DorVector3 Direction(const _VelCamera& c)
{
    DorVector3 d = c.target - c.eye;
    DorNormalize(d);
    return d;
}

void ExpectSameDirection(const _VelCamera& a, const _VelCamera& b)
{
    DorVector3 da = Direction(a), db = Direction(b);
    EXPECT_NEAR(da.x, db.x, 1e-12);
    EXPECT_NEAR(da.y, db.y, 1e-12);
    EXPECT_NEAR(da.z, db.z, 1e-12);
}
}  // namespace

// A long flat slab, off the origin, seen from several directions (one vertical) through wide and
// tall windows.
class SlabFit : public ::testing::TestWithParam<int> {
protected:
    DorVector3 low = DorVector3(10, -4, 2);
    DorVector3 high = DorVector3(70, 6, 5);

    _VelCamera Start() const
    {
        static const DorVector3 eyes[] = {DorVector3(0, -100, 30), DorVector3(-50, 20, -40), DorVector3(300, 300, 300),
                                          DorVector3(40, 1, 3), DorVector3(40, 1, 300)};  // the last straight down
        static const double aspects[] = {4.0 / 3.0, 0.5, 2.5, 1.0, 2.0};
        int i = GetParam();
        return Camera(eyes[i], DorVector3(40, 1, 10), 45, aspects[i]);
    }
};

TEST_P(SlabFit, SphereShowsEveryCornerAndBoxTouchesTheEdgeFromCloser)
{
    _VelCamera sphere = Start();
    CVelMathCamera::FitViewToSphere(sphere, low, high);
    ExpectSameDirection(sphere, Start());
    Reach r = ReachOf(sphere, low, high);
    EXPECT_LE(r.edge, 1.0);
    EXPECT_GT(r.nearest, sphere.zNear);
    EXPECT_LT(r.farthest, sphere.zFar);
    EXPECT_NEAR(sphere.target.x, 40, 1e-12);
    EXPECT_NEAR(sphere.target.z, 3.5, 1e-12);

    _VelCamera box = Start();
    CVelMathCamera::FitViewToBox(box, low, high);
    ExpectSameDirection(box, Start());
    r = ReachOf(box, low, high);
    EXPECT_NEAR(r.edge, 1.0, 1e-9);
    EXPECT_GT(r.nearest, box.zNear);
    EXPECT_LE(DorLength(box.target - box.eye), DorLength(sphere.target - sphere.eye) + 1e-9);
    EXPECT_EQ(box.fovy, 45);
    EXPECT_EQ(box.zNear, 1);
}

INSTANTIATE_TEST_SUITE_P(Views, SlabFit, ::testing::Range(0, 5));

TEST(FitView, SphereFitTouchesTheNarrowerFieldOfView)
{
    DorVector3 low(-10, -10, -10), high(10, 10, 10);
    double radius = std::sqrt(300.0);
    for (double aspect : {0.5, 2.0}) {
        _VelCamera c = Camera(DorVector3(0, -50, 0), DorVector3(0, 0, 0), 90, aspect);
        CVelMathCamera::FitViewToSphere(c, low, high);
        double narrower = aspect < 1 ? std::atan(aspect) : DorPi / 4;  // half angles
        EXPECT_NEAR(-c.eye.y, radius / std::sin(narrower), 1e-9) << aspect;
    }
}

TEST(FitView, ClipPlanesNeverCutTheBox)
{
    // A tiny box stays beyond a far-out near plane, smaller than a fit but whole.
    DorVector3 low(0, 0, 0), high(0.01, 0.01, 0.01);
    _VelCamera c = Camera(DorVector3(0, -50, 0), DorVector3(0, 0, 0), 60, 1);
    c.zNear = 5;
    CVelMathCamera::FitViewToBox(c, low, high);
    Reach r = ReachOf(c, low, high);
    EXPECT_GT(r.nearest, 5.0);
    EXPECT_LT(r.edge, 1.0);
    // A huge one pushes the far plane out.
    DorVector3 wideLow(-50000, -50000, 0), wideHigh(50000, 50000, 100);
    c = Camera(DorVector3(0, -50, 10), DorVector3(0, 0, 0), 45, 1);
    CVelMathCamera::FitViewToBox(c, wideLow, wideHigh);
    r = ReachOf(c, wideLow, wideHigh);
    EXPECT_LT(r.farthest, c.zFar);
    EXPECT_LE(r.edge, 1.0 + 1e-9);
}

TEST(FitView, PointBoxKeepsTheDistanceAndAimsAtThePoint)
{
    DorVector3 p(5, 5, 5);
    _VelCamera c = Camera(DorVector3(0, -30, 0), DorVector3(0, 10, 0), 45, 1);
    CVelMathCamera::FitViewToBox(c, p, p);
    EXPECT_NEAR(DorLength(c.target - c.eye), 40, 1e-9);
    EXPECT_EQ(c.target.x, 5);
    EXPECT_EQ(c.target.z, 5);
}

TEST(FitView, CamerasThatCannotBeFittedAreLeftAlone)
{
    DorVector3 low(-1, -1, -1), high(1, 1, 1);
    _VelCamera cameras[] = {Camera(DorVector3(0, -5, 0), DorVector3(0, 0, 0), 0, 1),
                            Camera(DorVector3(0, -5, 0), DorVector3(0, 0, 0), 180, 1),
                            Camera(DorVector3(3, 3, 3), DorVector3(3, 3, 3), 45, 1),
                            Camera(DorVector3(0, -5, 0), DorVector3(0, 0, 0), NAN, 1)};
    for (_VelCamera& c : cameras) {
        _VelCamera before = c;
        CVelMathCamera::FitViewToSphere(c, low, high);
        CVelMathCamera::FitViewToBox(c, low, high);
        EXPECT_EQ(c.eye.y, before.eye.y);
        EXPECT_EQ(c.target.x, before.target.x);
    }
}

// A modeller whose fit moves the camera to a known place, and whose reset viewport is known.
class FittingKarvel : public RecordingKarvel {
public:
    _VelCamera fitted;
    bool fits = true;
    _VelViewport resetTo = {0, 0, 640, 480};
    _VelViewport viewportAtFit = {0, 0, 0, 0};

    void SetCameraForAllView_Hi(int) override
    {
        viewportAtFit = viewport;
        if (fits)
            SetCamera(fitted);
    }
    void ResetViewport() override { viewport = resetTo; }
};

TEST(AllModelView, GlidesToTheFitAndEndsExactlyOnIt)
{
    FittingKarvel k;
    k.fitted = Camera(DorVector3(50, -50, 50), DorVector3(5, 5, 5), 45, 4.0 / 3.0);
    std::vector<double> eyesX;
    k.onDraw = [&] { eyesX.push_back(k.camera.eye.x); };
    k.KarvelAllmodelView(nullptr, 0, 40);
    ASSERT_GE(eyesX.size(), 2u);
    for (size_t i = 1; i + 1 < eyesX.size(); ++i)
        EXPECT_LE(eyesX[i - 1], eyesX[i]);  // steadily toward the fit
    EXPECT_EQ(k.camera.eye.x, 50);           // the last frame is the fit itself
    EXPECT_EQ(k.camera.target.y, 5);
    EXPECT_EQ(eyesX.back(), 50);
}

TEST(AllModelView, NothingToFitDrawsNothing)
{
    FittingKarvel k;
    k.fits = false;
    _VelCamera before = k.camera;
    k.KarvelAllmodelView(nullptr, 0, 1000);
    EXPECT_EQ(k.drawCalls, 0);
    EXPECT_EQ(k.camera.eye.y, before.eye.y);
}

TEST(AllModelView, ViewportVariantAppliesTheResetViewportBeforeFitting)
{
    FittingKarvel k;
    k.viewport = {-200, -150, 800, 600};  // zoomed
    k.fitted = Camera(DorVector3(1, 2, 3), DorVector3(0, 0, 0), 45, 1);
    k.KarvelAllmodelView_vp(nullptr, 0, 0);
    EXPECT_EQ(k.setViewportCalls, 1);
    EXPECT_EQ(k.viewportAtFit.x, 0);
    EXPECT_EQ(k.viewportAtFit.width, 640);
    EXPECT_EQ(k.camera.eye.z, 3);
    EXPECT_EQ(k.drawCalls, 1);  // no glide for duration 0, one frame on the fit
}
