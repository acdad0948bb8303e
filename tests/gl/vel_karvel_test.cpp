// The interface's own members, on a modeller that records what they ask of it.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "camera/vel_math_camera.h"
#include "support/recording_karvel.h"

namespace {
const double kNaN = std::numeric_limits<double>::quiet_NaN();
}  // namespace

// Each move reads the camera once, applies the camera maths and writes the result back; a refused
// move writes back the same camera, a non-finite camera is never written back, and a zoom sets
// the viewport only when it succeeds. Nothing redraws.
TEST(KarvelCameraWrappers, EachMoveReadsComputesAndWritesBackOnce)
{
    RecordingKarvel k;
    k.camera.target = DorVector3(10, 0, 5);
    _VelCamera expected = k.camera;
    for (int refused : {0, 1}) {  // a tilt past the pole, a NaN move
        CVelMathCamera::PanTilt(expected, 90, refused ? 180 : 10);
        CVelMathCamera::Dolly(expected, refused ? kNaN : 1, 2, 3, 1);
        CVelMathCamera::Fly(expected, 3, 2, 1, 0);
        CVelMathCamera::RoundDolly(expected, 20, 30);
        k.PanTilt(90, refused ? 180 : 10);
        k.Dolly(refused ? kNaN : 1, 2, 3, 1);
        k.Fly(3, 2, 1, 0);
        k.RoundDolly(20, 30);
    }
    EXPECT_TRUE(k.getCameraCalls == 8 && k.setCameraCalls == 8 && SameCameraBits(k.camera, expected));

    k.camera = Camera(DorVector3(0, 0, 0), DorVector3(0, 1, 0));
    EXPECT_EQ(k.ViewportZoom(DorVector2(300, 75), DorVector2(100, 225)) + k.ViewportZoom(DorVector2(100, 100), DorVector2(150, 130)) + k.setViewportCalls, 0);
    EXPECT_EQ(k.ViewportZoom(DorVector2(100, 75), DorVector2(300, 225)), 1);
    EXPECT_TRUE(k.setViewportCalls == 1 && k.viewport.x == -200 && k.viewport.height == 600 && k.drawCalls == 0);

    k.camera.zFar = std::numeric_limits<double>::infinity();  // the moves share one write-back
    k.RoundDolly(0, 10);
    k.current = reinterpret_cast<HDC>(static_cast<uintptr_t>(0x1234));  // pixels no int holds are not picked
    k.hits = {{k.HandleOf(3), 0.5}};
    k.ApproachCamera(DorVector2(kNaN, 150), 100, 1);
    EXPECT_TRUE(k.setCameraCalls == 8 && k.camerasAtHitTest.empty());
}

// Two groups edited through the part flags 2 (material) and 16 (DrawMode); a null handle never
// reaches the store. (MoveShape's normals are checked on the live modeller.)
TEST(KarvelEntityEdits, ChangeMaterialReachesEveryGroupAndDrawModeRoundTrips)
{
    RecordingKarvel k;
    CVelPrimitive primitive;
    primitive.groups.SetSize(2);
    primitive.groups[1].vertices.SetSize(3);
    primitive.DrawMode = 2;
    _DorPosition *handle = k.AddPrimitive(primitive), *unknown = k.HandleOf(9), *none = nullptr;
    _DorMaterial red;
    red.diffuse = DorColorValue(1, 0, 0, 1);
    k.ChangeMaterial(handle, red);
    const CVelPrimitive& stored = k.entities[handle];
    EXPECT_TRUE(k.lastGetFlags == 2 && k.lastChangeFlags == 2 && stored.groups[1].vertices.GetSize() == 3);
    EXPECT_TRUE(stored.groups[0].material.diffuse.g == 0 && stored.groups[1].material.diffuse.g == 0);
    k.SetDrawMode(handle, 3);
    k.SetDrawMode(none, 1);
    EXPECT_TRUE(k.lastChangeFlags == 16 && k.GetDrawMode(handle) == 3 && k.lastGetFlags == 16 && stored.groups.GetSize() == 2);
    EXPECT_TRUE(k.GetDrawMode(unknown) == -1 && k.GetDrawMode(none) == -1);
}
