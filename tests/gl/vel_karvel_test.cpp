#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "camera/vel_math_camera.h"
#include "gl/vel_karvel.h"
#include "model/dor_math.h"
#include "support/camera_bits.h"
#include "support/recording_karvel.h"

namespace {
const double kNaN = std::numeric_limits<double>::quiet_NaN();

HDC FakeDC() { return reinterpret_cast<HDC>(static_cast<uintptr_t>(0x1234)); }

// A modeller that supplies only what the interface leaves abstract.
class BareKarvel : public CVelKarvel {
public:
    int Initialize(HDC&, _VelViewport) override { return 1; }
    int Initialize(HDC&) override { return 1; }
    void Finalize() override {}
    void RemoveShapeAt(_DorPosition*&) override {}
    void RemoveShapeAll() override {}
    CDorArray<long, long>* GetFreeProperty(_DorPosition*&) override { return nullptr; }
};
}  // namespace

TEST(KarvelBase, DefaultsOfTheVirtualOperations)
{
    BareKarvel bare;
    CVelKarvel& k = bare;
    HDC dc = FakeDC();
    EXPECT_EQ(k.SetCurrent(dc), dc);
    EXPECT_EQ(k.GetCurrent(), nullptr);
    EXPECT_EQ(k.GetCullMode(), 1);
    CVelPrimitive primitive;
    EXPECT_EQ(k.AddPrimitive(primitive), nullptr);
    _DorBitmap bitmap;
    EXPECT_EQ(k.AddTexture(bitmap), 0u);
    EXPECT_EQ(k.ChangeTexture(1, bitmap), 0);
    EXPECT_EQ(k.GetTextureList(), nullptr);

    // Nothing to read: camera wrappers and picking helpers are harmless no-ops.
    k.PanTilt(10, 10);
    k.Dolly(1, 1, 1, 0);
    k.Fly(1, 1, 1, 1);
    k.RoundDolly(10, 10);
    k.ApproachCamera(DorVector2(10, 10), 50, 1);
    EXPECT_EQ(k.ViewportZoom(DorVector2(0, 0), DorVector2(100, 100)), 0);
    EXPECT_EQ(k.HitTestS(dc, 1, 1), nullptr);
    _DorPosition* none = nullptr;
    EXPECT_EQ(k.GetDrawMode(none), -1);
}

// ---- camera wrappers go through the virtual table ----

TEST(KarvelCameraWrappers, EachMoveReadsComputesAndWritesBackOnce)
{
    RecordingKarvel modeller;
    CVelKarvel& k = modeller;
    modeller.camera.target = DorVector3(10, 0, 0);
    _VelCamera expected = modeller.camera;
    CVelMathCamera::PanTilt(expected, 90, 0);

    k.PanTilt(90, 0);
    EXPECT_EQ(modeller.getCameraCalls, 1);
    EXPECT_EQ(modeller.setCameraCalls, 1);
    EXPECT_TRUE(SameCameraBits(modeller.camera, expected));

    CVelMathCamera::Dolly(expected, 1, 2, 3, 1);
    k.Dolly(1, 2, 3, 1);
    CVelMathCamera::Fly(expected, 3, 2, 1, 0);
    k.Fly(3, 2, 1, 0);
    CVelMathCamera::RoundDolly(expected, 20, 30);
    k.RoundDolly(20, 30);
    EXPECT_EQ(modeller.setCameraCalls, 4);
    EXPECT_TRUE(SameCameraBits(modeller.camera, expected));
    EXPECT_EQ(modeller.drawCalls, 0);  // moves never redraw
}

TEST(KarvelCameraWrappers, RefusedMoveWritesBackTheSameCamera)
{
    RecordingKarvel modeller;
    modeller.camera.target = DorVector3(1, 0, 1);  // 45 degrees up
    const _VelCamera before = modeller.camera;
    modeller.PanTilt(30, 50);
    modeller.RoundDolly(-50, 0);
    EXPECT_TRUE(SameCameraBits(modeller.camera, before));
}

TEST(KarvelCameraWrappers, NonFiniteCameraIsNeverWrittenBack)
{
    RecordingKarvel modeller;
    modeller.camera.zFar = std::numeric_limits<double>::infinity();
    modeller.PanTilt(10, 0);
    modeller.Dolly(1, 0, 0, 0);
    modeller.Fly(1, 0, 0, 0);
    modeller.RoundDolly(0, 10);
    modeller.ApproachCamera(DorVector2(200, 150), 100, 0);
    EXPECT_EQ(modeller.setCameraCalls, 0);

    RecordingKarvel fine;
    fine.Dolly(kNaN, 0, 0, 0);  // refused: the finite camera is written back unchanged
    EXPECT_EQ(fine.camera.eye.x, 0.0);
    EXPECT_FALSE(std::isnan(fine.camera.eye.y));
}

TEST(KarvelViewportZoom, AppliesTheViewportOnlyOnSuccess)
{
    RecordingKarvel modeller;
    modeller.camera.aspect = 400.0 / 300.0;
    EXPECT_EQ(modeller.ViewportZoom(DorVector2(300, 75), DorVector2(100, 225)), 0);
    EXPECT_EQ(modeller.ViewportZoom(DorVector2(100, 100), DorVector2(150, 130)), 0);
    EXPECT_EQ(modeller.setViewportCalls, 0);
    EXPECT_EQ(modeller.viewport.width, 400);

    EXPECT_EQ(modeller.ViewportZoom(DorVector2(100, 75), DorVector2(300, 225)), 1);
    EXPECT_EQ(modeller.setViewportCalls, 1);
    EXPECT_EQ(modeller.viewport.x, -200);
    EXPECT_EQ(modeller.viewport.height, 600);
    EXPECT_EQ(modeller.drawCalls, 0);
}

// ---- approach: depth only with a current DC and a hit ----

class ApproachOnRecordingModeller : public ::testing::Test {
protected:
    // Looking along +y from the origin, fovy 90, viewport 400 x 200; a click at the centre.
    RecordingKarvel modeller;
    _DorPosition* entity = modeller.HandleOf(3);
    void SetUp() override
    {
        modeller.camera.fovy = 90.0;
        modeller.viewport = {0, 0, 400, 200};
        modeller.depthOrigin = DorVector3(0, 0, 0);
        modeller.depthStep = DorVector3(0, 16, 0);  // depth 0.5 -> 8 units ahead
        modeller.hits = {{entity, 0.5}};
    }
    void Click(int useDepth) { modeller.ApproachCamera(DorVector2(200, 100), 100, useDepth); }
};

TEST_F(ApproachOnRecordingModeller, HitUnderTheCursorMovesTheEyeByTheGrowthFactor)
{
    modeller.current = FakeDC();
    Click(1);
    EXPECT_EQ(modeller.hitTestCalls, 2);  // the wrapper's pick and the precise depth's
    EXPECT_NEAR(modeller.camera.eye.y, 4.0, 1e-12);  // 8 * (1 - 100 / 200)
    EXPECT_EQ(modeller.camera.target.y, 10.0);
}

TEST_F(ApproachOnRecordingModeller, WithoutCurrentDCOrHitOrDepthItTurnsInstead)
{
    Click(1);  // no current DC
    EXPECT_EQ(modeller.hitTestCalls, 0);
    EXPECT_EQ(modeller.camera.eye.y, 0.0);

    modeller.current = FakeDC();
    Click(0);  // depth not asked for
    EXPECT_EQ(modeller.hitTestCalls, 0);

    modeller.hits.clear();
    Click(1);
    EXPECT_EQ(modeller.hitTestCalls, 1);
    EXPECT_EQ(modeller.depthCalls, 0);
    EXPECT_EQ(modeller.camera.eye.y, 0.0);
    EXPECT_NEAR(modeller.camera.target.y, 10.0, 1e-12);  // centre click: direction kept
    EXPECT_EQ(modeller.setCameraCalls, 3);
}

TEST_F(ApproachOnRecordingModeller, PixelOutsideIntRangeSkipsThePick)
{
    modeller.current = FakeDC();
    modeller.ApproachCamera(DorVector2(1e12, 100), 100, 1);
    modeller.ApproachCamera(DorVector2(kNaN, 100), 100, 1);
    EXPECT_EQ(modeller.hitTestCalls, 0);
}

// ---- picking helpers ----

TEST(KarvelHitTestS, ReturnsTheFirstHitOrNull)
{
    RecordingKarvel modeller;
    EXPECT_EQ(modeller.HitTestS(FakeDC(), 5, 5), nullptr);
    modeller.hits = {{modeller.HandleOf(1), 0.2}, {modeller.HandleOf(2), 0.7}};
    EXPECT_EQ(modeller.HitTestS(FakeDC(), 5, 5), modeller.HandleOf(1));
}

class DepthHiAtFiveThousand : public ::testing::Test {
protected:
    // The first estimate lies 5000 units ahead; the clip range is 1 .. 100000.
    RecordingKarvel modeller;
    void SetUp() override
    {
        modeller.camera.zFar = 100000.0;
        modeller.depthStep = DorVector3(0, 10000, 0);
    }
};

TEST_F(DepthHiAtFiveThousand, NarrowsTheClipRangeForTheSecondPickAndRestoresTheCamera)
{
    const _VelCamera before = modeller.camera;
    modeller.hits = {{modeller.HandleOf(1), 0.25}, {modeller.HandleOf(2), 0.75}};
    double depth = 0.5;
    DorVector3 point;
    modeller.GetDepthToPoint3_Hi(FakeDC(), modeller.HandleOf(2), 7, 9, depth, point);

    ASSERT_EQ(modeller.camerasAtHitTest.size(), 1u);
    EXPECT_EQ(modeller.camerasAtHitTest[0].zNear, 4000.0);
    EXPECT_EQ(modeller.camerasAtHitTest[0].zFar, 6000.0);
    ASSERT_EQ(modeller.depthsAsked.size(), 2u);
    EXPECT_EQ(modeller.depthsAsked[1], 0.75);  // the target's own hit, not the nearest
    EXPECT_EQ(point.y, 7500.0);
    EXPECT_TRUE(SameCameraBits(modeller.camera, before));
}

TEST_F(DepthHiAtFiveThousand, TargetNotUnderThePixelKeepsTheFirstEstimate)
{
    modeller.hits = {{modeller.HandleOf(1), 0.25}};
    double depth = 0.5;
    DorVector3 point;
    modeller.GetDepthToPoint3_Hi(FakeDC(), modeller.HandleOf(2), 7, 9, depth, point);
    EXPECT_EQ(point.y, 5000.0);
    EXPECT_EQ(modeller.depthCalls, 1);
    EXPECT_EQ(modeller.camera.zNear, 1.0);
}

TEST_F(DepthHiAtFiveThousand, ANearPointKeepsTheNearPlane)
{
    modeller.depthStep = DorVector3(0, 100, 0);  // 50 ahead: d - 1000 is below zNear
    double depth = 0.5;
    DorVector3 point;
    modeller.GetDepthToPoint3_Hi(FakeDC(), modeller.HandleOf(2), 7, 9, depth, point);
    EXPECT_EQ(modeller.camerasAtHitTest[0].zNear, 1.0);
    EXPECT_EQ(modeller.camerasAtHitTest[0].zFar, 1050.0);
}

// ---- entity edits through GetPrimitive / ChangePrimitive ----

class TwoGroupEntity : public ::testing::Test {
protected:
    RecordingKarvel modeller;
    _DorPosition* handle = nullptr;
    void SetUp() override
    {
        CVelPrimitive primitive;
        primitive.groups.SetSize(2);
        for (int g = 0; g < 2; ++g) {
            primitive.groups[g].vertices.SetSize(3);
            for (int v = 0; v < 3; ++v) {
                primitive.groups[g].vertices[v].position = DorVector3(v, g, 0);
                primitive.groups[g].vertices[v].normal = DorVector3(0, 0, 2);
            }
        }
        primitive.DrawMode = 2;
        handle = modeller.AddPrimitive(primitive);
    }
    const CVelPrimitive& Stored() { return modeller.entities[handle]; }
};

TEST_F(TwoGroupEntity, MoveShapeTranslatesPositionsAndNormalsThenRenormalises)
{
    DorMatrix4x4 shift = DorTranslate(1, 0, 0);
    modeller.MoveShape(handle, shift);
    EXPECT_EQ(modeller.lastGetFlags, 1);
    EXPECT_EQ(modeller.lastChangeFlags, 1);
    for (int g = 0; g < 2; ++g) {
        const _VelVertex& last = Stored().groups[g].vertices[2];
        EXPECT_EQ(last.position.x, 3.0);
        EXPECT_EQ(last.position.y, g);
        // The normal takes the translation too: (0,0,2) + (1,0,0), then unit length.
        EXPECT_NEAR(last.normal.x, 1 / std::sqrt(5.0), 1e-15);
        EXPECT_NEAR(last.normal.z, 2 / std::sqrt(5.0), 1e-15);
    }
}

TEST_F(TwoGroupEntity, MoveShapeTurnsNormalsWithTheRotation)
{
    DorMatrix4x4 turn = DorRotateY(DorPi / 2);  // +z turns to +x
    modeller.MoveShape(handle, turn);
    const _VelVertex& v = Stored().groups[1].vertices[1];
    EXPECT_EQ(v.normal.x, 1.0);
    EXPECT_EQ(v.normal.z, 0.0);
    EXPECT_EQ(v.position.z, -1.0);
}

TEST_F(TwoGroupEntity, ChangeMaterialReachesEveryGroup)
{
    _DorMaterial red;
    red.diffuse = DorColorValue(1, 0, 0, 1);
    modeller.ChangeMaterial(handle, red);
    EXPECT_EQ(modeller.lastGetFlags, 2);
    EXPECT_EQ(modeller.lastChangeFlags, 2);
    for (int g = 0; g < 2; ++g) {
        EXPECT_EQ(Stored().groups[g].material.diffuse.g, 0.0f);
        EXPECT_EQ(Stored().groups[g].vertices.GetSize(), 3);  // geometry untouched
    }
}

TEST_F(TwoGroupEntity, DrawModeRoundTripsThroughFlag16)
{
    EXPECT_EQ(modeller.GetDrawMode(handle), 2);
    modeller.SetDrawMode(handle, 3);
    EXPECT_EQ(modeller.lastChangeFlags, 16);
    EXPECT_EQ(modeller.GetDrawMode(handle), 3);
    EXPECT_EQ(modeller.lastGetFlags, 16);
    EXPECT_EQ(Stored().groups[0].vertices.GetSize(), 3);

    _DorPosition* unknown = modeller.HandleOf(9);
    EXPECT_EQ(modeller.GetDrawMode(unknown), -1);
    _DorPosition* none = nullptr;
    modeller.SetDrawMode(none, 1);
    DorMatrix4x4 identity;
    modeller.MoveShape(nullptr, identity);
    EXPECT_EQ(modeller.lastChangeFlags, 16);  // null handles never reach the store
}
