#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "camera/vel_math_camera.h"
#include "model/dor_math.h"
#include "support/camera_bits.h"
#include "viewer_controls.h"

namespace {
// Looking along +y from 20 units away: screen right is +x, screen up is +z.
_VelCamera LookingNorth() { return Camera(DorVector3(0, -20, 0), DorVector3(0, 0, 0), 90.0, 1.0); }
}  // namespace

TEST(ViewerControls, DraggingRightTurnsTheModelRightAndDraggingDownShowsItsTop)
{
    _VelCamera camera = LookingNorth();
    OrbitStep right = OrbitForDrag(50, 0);
    CVelMathCamera::RoundDolly(camera, right.elevation, right.azimuth);
    EXPECT_LT(camera.eye.x, -1.0);  // the eye went to the user's left
    EXPECT_NEAR(DorLength(camera.eye), 20.0, 1e-9);

    camera = LookingNorth();
    OrbitStep down = OrbitForDrag(0, 50);
    CVelMathCamera::RoundDolly(camera, down.elevation, down.azimuth);
    EXPECT_GT(camera.eye.z, 1.0);
    EXPECT_NEAR(camera.eye.x, 0.0, 1e-9);
}

// The target sits in the middle of the view; after the pan it must sit exactly where the
// cursor went, measured in pixels of a 200-pixel-high view (90 degrees: 20 units per half).
TEST(ViewerControls, PanKeepsThePointUnderTheCursor)
{
    _VelCamera camera = LookingNorth();
    DorVector3 oldTarget = camera.target;
    PanStep pan = PanForDrag(30, -10, camera, 200);
    CVelMathCamera::Fly(camera, 0.0, pan.right, pan.up, 0);
    DorVector3 seen = oldTarget - camera.target;  // where the old target is, relative to the view centre
    double pixelsPerUnit = 100.0 / 20.0;
    EXPECT_NEAR(seen.x * pixelsPerUnit, 30.0, 1e-9);   // 30 pixels right
    EXPECT_NEAR(-seen.z * pixelsPerUnit, -10.0, 1e-9);  // 10 pixels up (window y down)
    EXPECT_NEAR(DorLength(camera.target - camera.eye), 20.0, 1e-9);

    PanStep none = PanForDrag(30, 10, camera, 0);
    EXPECT_EQ(none.right, 0.0);
    EXPECT_EQ(none.up, 0.0);
}

// Small conversions of mouse input: click tolerance, wheel notches (a tenth of the distance
// each, high-resolution wheels sending parts of one) and rubber-band corners top-left first.
TEST(ViewerControls, ClicksWheelAndRubberBand)
{
    EXPECT_TRUE(IsClick(100, 100, 102, 98));
    EXPECT_FALSE(IsClick(100, 100, 103, 100));
    EXPECT_FALSE(IsClick(100, 100, 100, 97));

    _VelCamera camera = LookingNorth();
    EXPECT_DOUBLE_EQ(FlyForWheel(120, camera), 2.0);
    EXPECT_DOUBLE_EQ(FlyForWheel(-240, camera), -4.0);
    EXPECT_DOUBLE_EQ(FlyForWheel(60, camera), 1.0);

    DorVector2 a, b;
    ZoomCorners(300, 50, 100, 250, a, b);
    EXPECT_EQ((std::vector<double>{a.x, a.y, b.x, b.y}), (std::vector<double>{100, 50, 300, 250}));
}

TEST(ViewerControls, OrbitMovieFramesMakeOneWholeTurn)
{
    for (int frames : {1, 7, 72}) {
        _VelCamera camera = LookingNorth();
        camera.eye.z = 8.0;
        for (int i = 0; i < frames; ++i)
            CVelMathCamera::RoundDolly(camera, 0.0, OrbitFrameAzimuth(frames));
        EXPECT_NEAR(camera.eye.x, 0.0, 1e-9) << frames;
        EXPECT_NEAR(camera.eye.y, -20.0, 1e-9) << frames;
        EXPECT_NEAR(camera.eye.z, 8.0, 1e-9) << frames;
    }
    EXPECT_EQ(OrbitFrameAzimuth(0), 0.0);
}

TEST(ViewerControls, HighlightKeepsTransparency)
{
    _DorMaterial glass;
    glass.diffuse = DorColorValue(0.2f, 0.3f, 0.9f, 0.4f);
    _DorMaterial lit = HighlightMaterial(glass);
    EXPECT_FLOAT_EQ(lit.diffuse.a, 0.4f);
    EXPECT_FLOAT_EQ(lit.ambient.a, 0.4f);
    EXPECT_GT(lit.diffuse.r, glass.diffuse.r);
}

TEST(ViewerControls, PickReportListsNearestFirstThenThePoint)
{
    std::vector<PickedEntity> hits = {{"front wall", 0.25}, {"ground", 0.5}};
    std::vector<std::string> lines = DescribePick(12, 34, hits, DorVector3(1, -2.5, 0.125));
    ASSERT_EQ(lines.size(), 4u);
    EXPECT_EQ(lines[0], "pick 12,34: 2 entities, nearest first");
    EXPECT_EQ(lines[1], "  1. front wall (depth 0.250000)");
    EXPECT_EQ(lines[2], "  2. ground (depth 0.500000)");
    EXPECT_EQ(lines[3], "point (1.000, -2.500, 0.125)");
    EXPECT_EQ(DescribePick(5, 6, {}, DorVector3()), std::vector<std::string>{"pick 5,6: no entity"});
    EXPECT_EQ(DescribeClick(hits, DorVector3(1, 2, 3)), "front wall at (1.000, 2.000, 3.000)");
    EXPECT_EQ(DescribeClick({}, DorVector3()), "Nothing here");
}
