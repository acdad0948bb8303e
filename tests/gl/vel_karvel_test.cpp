// The interface's own members, on a modeller that records what they ask of it.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "camera/vel_math_camera.h"
#include "support/recording_karvel.h"

namespace {
const double kNaN = std::numeric_limits<double>::quiet_NaN();
HDC FakeDC() { return reinterpret_cast<HDC>(static_cast<uintptr_t>(0x1234)); }
}  // namespace

// Each move reads the camera once, applies the camera maths and writes the result back; a
// refused move writes back the same camera, a non-finite camera is never written back.
TEST(KarvelCameraWrappers, EachMoveReadsComputesAndWritesBackOnce)
{
    RecordingKarvel k;
    k.camera.target = DorVector3(10, 0, 5);
    _VelCamera expected = k.camera;
    CVelMathCamera::PanTilt(expected, 90, 10);
    CVelMathCamera::Dolly(expected, 1, 2, 3, 1);
    CVelMathCamera::Fly(expected, 3, 2, 1, 0);
    CVelMathCamera::RoundDolly(expected, 20, 30);
    k.PanTilt(90, 10);
    k.Dolly(1, 2, 3, 1);
    k.Fly(3, 2, 1, 0);
    k.RoundDolly(20, 30);
    k.PanTilt(30, 180);  // refused
    k.Dolly(kNaN, 0, 0, 0);
    EXPECT_TRUE(k.getCameraCalls == 6 && k.setCameraCalls == 6 && k.drawCalls == 0);
    EXPECT_TRUE(SameCameraBits(k.camera, expected));

    k.camera.zFar = std::numeric_limits<double>::infinity();
    k.PanTilt(10, 0);
    k.Dolly(1, 0, 0, 0);
    k.Fly(1, 0, 0, 0);
    k.RoundDolly(0, 10);
    k.ApproachCamera(DorVector2(200, 150), 100, 0);
    EXPECT_EQ(k.setCameraCalls, 6);
}

TEST(KarvelViewportZoom, AppliesTheViewportOnlyOnSuccess)
{
    RecordingKarvel k;
    EXPECT_EQ(k.ViewportZoom(DorVector2(300, 75), DorVector2(100, 225)), 0);
    EXPECT_EQ(k.ViewportZoom(DorVector2(100, 100), DorVector2(150, 130)), 0);
    EXPECT_TRUE(k.setViewportCalls == 0 && k.viewport.width == 400);
    EXPECT_EQ(k.ViewportZoom(DorVector2(100, 75), DorVector2(300, 225)), 1);
    EXPECT_TRUE(k.setViewportCalls == 1 && k.viewport.x == -200 && k.viewport.height == 600 && k.drawCalls == 0);
}

// Looking along +y from the origin, fovy 90, viewport 400 x 200; a click at the centre, where the
// depth 0.5 lies 8 units ahead.
class ApproachOnRecordingModeller : public ::testing::Test {
protected:
    RecordingKarvel k;
    void SetUp() override
    {
        k.camera.fovy = 90.0;
        k.viewport = {0, 0, 400, 200};
        k.depthStep = DorVector3(0, 16, 0);
        k.hits = {{k.HandleOf(3), 0.5}};
    }
    void Click(int useDepth, double x = 200) { k.ApproachCamera(DorVector2(x, 100), 100, useDepth); }
};

TEST_F(ApproachOnRecordingModeller, HitUnderTheCursorMovesTheEyeByTheGrowthFactor)
{
    k.current = FakeDC();
    Click(1);
    EXPECT_EQ(k.camerasAtHitTest.size(), 2u);  // the wrapper's pick and the precise depth's
    EXPECT_NEAR(k.camera.eye.y, 4.0, 1e-12);   // 8 * (1 - 100 / 200)
    EXPECT_EQ(k.camera.target.y, 10.0);
}

TEST_F(ApproachOnRecordingModeller, WithoutCurrentDCOrHitOrDepthOrIntPixelItTurnsInstead)
{
    Click(1);  // no current DC
    k.current = FakeDC();
    Click(0);  // depth not asked for
    k.hits.clear();
    Click(1);  // nothing under the cursor
    EXPECT_TRUE(k.camerasAtHitTest.size() == 1 && k.depthsAsked.empty() && k.setCameraCalls == 3);
    EXPECT_EQ(k.camera.eye.y, 0.0);
    EXPECT_NEAR(k.camera.target.y, 10.0, 1e-12);  // centre click: direction kept
    Click(1, 1e12);  // no pick outside the int range
    Click(1, kNaN);
    EXPECT_EQ(k.camerasAtHitTest.size(), 1u);
}

// The first estimate lies 5000 units ahead; the clip range is 1 .. 100000.
class DepthHiAtFiveThousand : public ::testing::Test {
protected:
    RecordingKarvel k;
    DorVector3 point;
    void SetUp() override
    {
        k.camera.zFar = 100000.0;
        k.depthStep = DorVector3(0, 10000, 0);
    }
    void Pick()
    {
        double depth = 0.5;
        k.GetDepthToPoint3_Hi(FakeDC(), k.HandleOf(2), 7, 9, depth, point);
    }
};

TEST_F(DepthHiAtFiveThousand, NarrowsTheClipRangeForTheSecondPickAndRestoresTheCamera)
{
    const _VelCamera before = k.camera;
    k.hits = {{k.HandleOf(1), 0.25}, {k.HandleOf(2), 0.75}};
    Pick();
    ASSERT_EQ(k.camerasAtHitTest.size(), 1u);
    EXPECT_TRUE(k.camerasAtHitTest[0].zNear == 4000.0 && k.camerasAtHitTest[0].zFar == 6000.0);
    EXPECT_EQ(k.depthsAsked, (std::vector<double>{0.5, 0.75}));  // the target's own hit, not the nearest
    EXPECT_EQ(point.y, 7500.0);
    EXPECT_TRUE(SameCameraBits(k.camera, before));
}

TEST_F(DepthHiAtFiveThousand, ANearPointKeepsTheNearPlaneAndAMissKeepsTheEstimate)
{
    k.depthStep = DorVector3(0, 100, 0);  // 50 ahead: d - 1000 is below zNear
    k.hits = {{k.HandleOf(1), 0.25}};
    Pick();
    EXPECT_TRUE(k.camerasAtHitTest[0].zNear == 1.0 && k.camerasAtHitTest[0].zFar == 1050.0);
    EXPECT_TRUE(point.y == 50.0 && k.depthsAsked.size() == 1u);
    EXPECT_EQ(k.HitTestS(FakeDC(), 5, 5), k.HandleOf(1));
    k.hits.clear();
    EXPECT_EQ(k.HitTestS(FakeDC(), 5, 5), nullptr);
}

// Two groups of three vertices with normal (0, 0, 2), edited through the part flags 1, 2 and 16.
class TwoGroupEntity : public ::testing::Test {
protected:
    RecordingKarvel k;
    _DorPosition* handle = nullptr;
    void SetUp() override
    {
        CVelPrimitive primitive;
        primitive.groups.SetSize(2);
        for (int v = 0; v < 6; ++v) {
            primitive.groups[v / 3].vertices.SetSize(3);
            primitive.groups[v / 3].vertices[v % 3].position = DorVector3(v % 3, v / 3, 0);
            primitive.groups[v / 3].vertices[v % 3].normal = DorVector3(0, 0, 2);
        }
        primitive.DrawMode = 2;
        handle = k.AddPrimitive(primitive);
    }
    const _VelVertex& Vertex(int g, int v) { return k.entities[handle].groups[g].vertices[v]; }
};

TEST_F(TwoGroupEntity, MoveShapeTakesNormalsThroughTheWholeMatrixThenRenormalises)
{
    DorMatrix4x4 m = DorRotateY(DorPi / 2) * DorTranslate(0, 0, 1);  // +z turns to +x, then shifts up
    k.MoveShape(handle, m);
    EXPECT_TRUE(k.lastGetFlags == 1 && k.lastChangeFlags == 1);
    for (int g = 0; g < 2; ++g) {
        EXPECT_LE(DorLength(Vertex(g, 2).position - DorVector3(0, g, -1)), 1e-12) << g;
        EXPECT_LE(DorLength(Vertex(g, 2).normal - DorVector3(2, 0, 1) * (1 / std::sqrt(5.0))), 1e-12) << g;
    }
}

TEST_F(TwoGroupEntity, ChangeMaterialReachesEveryGroupAndDrawModeRoundTrips)
{
    _DorMaterial red;
    red.diffuse = DorColorValue(1, 0, 0, 1);
    k.ChangeMaterial(handle, red);
    EXPECT_TRUE(k.lastGetFlags == 2 && k.lastChangeFlags == 2);
    for (int g = 0; g < 2; ++g)
        EXPECT_EQ(k.entities[handle].groups[g].material.diffuse.g, 0.0f) << g;

    EXPECT_EQ(k.GetDrawMode(handle), 2);
    k.SetDrawMode(handle, 3);
    EXPECT_TRUE(k.lastChangeFlags == 16 && k.GetDrawMode(handle) == 3 && k.lastGetFlags == 16);
    EXPECT_EQ(Vertex(1, 2).position.x, 2.0);
    _DorPosition* unknown = k.HandleOf(9);
    _DorPosition* none = nullptr;
    EXPECT_TRUE(k.GetDrawMode(unknown) == -1 && k.GetDrawMode(none) == -1);
    k.SetDrawMode(none, 1);
    k.ChangeMaterial(nullptr, red);
    DorMatrix4x4 identity;
    k.MoveShape(nullptr, identity);
    EXPECT_EQ(k.lastChangeFlags, 16);  // null handles never reach the store
}
