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

// Dragging right turns the model right (the eye goes left), dragging down shows its top; a whole
// orbit movie comes back to the start.
TEST(ViewerControls, OrbitsFollowTheDragAndAMovieMakesOneWholeTurn)
{
    const struct {
        int dx, dy;
        DorVector3 eye;
    } rows[] = {{50, 0, {-20 * std::sin(DorPi / 9), -20 * std::cos(DorPi / 9), 0}}, {0, 50, {0, -20 * std::cos(DorPi / 9), 20 * std::sin(DorPi / 9)}}};
    for (const auto& r : rows) {
        _VelCamera camera = LookingNorth();
        OrbitStep step = OrbitForDrag(r.dx, r.dy);
        CVelMathCamera::RoundDolly(camera, step.elevation, step.azimuth);
        EXPECT_LE(DorLength(camera.eye - r.eye), 1e-9) << r.dx << "," << r.dy;
    }
    for (int frames : {1, 7, 72}) {
        _VelCamera camera = Camera(DorVector3(0, -20, 8), DorVector3(0, 0, 0));
        for (int i = 0; i < frames; ++i)
            CVelMathCamera::RoundDolly(camera, 0.0, OrbitFrameAzimuth(frames));
        EXPECT_LE(DorLength(camera.eye - DorVector3(0, -20, 8)), 1e-9) << frames;
    }
    EXPECT_EQ(OrbitFrameAzimuth(0), 0.0);
}

// After the pan the old target sits exactly where the cursor went, in pixels of a 200-pixel-high
// view (90 degrees: 20 units per half); the wheel flies a tenth of the distance per notch.
TEST(ViewerControls, PanKeepsThePointUnderTheCursorAndTheWheelFliesByNotches)
{
    _VelCamera camera = LookingNorth();
    PanStep pan = PanForDrag(30, -10, camera, 200);
    CVelMathCamera::Fly(camera, 0.0, pan.right, pan.up, 0);
    DorVector3 seen = DorVector3(0, 0, 0) - camera.target;  // the old target, from the view centre
    EXPECT_NEAR(seen.x * 5, 30.0, 1e-9);   // 30 pixels right
    EXPECT_NEAR(-seen.z * 5, -10.0, 1e-9);  // 10 pixels up (window y down)
    EXPECT_NEAR(DorLength(camera.target - camera.eye), 20.0, 1e-9);
    PanStep none = PanForDrag(30, 10, camera, 0);
    EXPECT_TRUE(none.right == 0.0 && none.up == 0.0);

    EXPECT_EQ((std::vector<double>{FlyForWheel(120, camera), FlyForWheel(-240, camera), FlyForWheel(60, camera)}),
              (std::vector<double>{2.0, -4.0, 1.0}));
}

// Click tolerance, rubber-band corners top-left first, and a highlight that keeps transparency.
TEST(ViewerControls, ClicksRubberBandAndHighlight)
{
    EXPECT_TRUE(IsClick(100, 100, 102, 98));
    EXPECT_FALSE(IsClick(100, 100, 103, 100) || IsClick(100, 100, 100, 97));
    DorVector2 a, b;
    ZoomCorners(300, 50, 100, 250, a, b);
    EXPECT_EQ((std::vector<double>{a.x, a.y, b.x, b.y}), (std::vector<double>{100, 50, 300, 250}));
    _DorMaterial glass;
    glass.diffuse = DorColorValue(0.2f, 0.3f, 0.9f, 0.4f);
    _DorMaterial lit = HighlightMaterial(glass);
    EXPECT_TRUE(lit.diffuse.a == 0.4f && lit.ambient.a == 0.4f && lit.diffuse.r > glass.diffuse.r);
}

TEST(ViewerControls, PickReportListsNearestFirstThenThePoint)
{
    std::vector<PickedEntity> hits = {{"front wall", 0.25}, {"ground", 0.5}};
    EXPECT_EQ(DescribePick(12, 34, hits, DorVector3(1, -2.5, 0.125)),
              (std::vector<std::string>{"pick 12,34: 2 entities, nearest first", "  1. front wall (depth 0.250000)",
                                        "  2. ground (depth 0.500000)", "point (1.000, -2.500, 0.125)"}));
    EXPECT_EQ(DescribePick(5, 6, {}, DorVector3()), std::vector<std::string>{"pick 5,6: no entity"});
    EXPECT_EQ(DescribeClick(hits, DorVector3(1, 2, 3)), "front wall at (1.000, 2.000, 3.000)");
    EXPECT_EQ(DescribeClick({}, DorVector3()), "Nothing here");
}
