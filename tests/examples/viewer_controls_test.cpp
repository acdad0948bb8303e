#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "camera/vel_math_camera.h"
#include "model/dor_math.h"
#include "support/camera_bits.h"
#include "viewer_controls.h"

// Looking along +y from 20 units away (90 degrees, 200 pixels high: 5 pixels a unit at the target).
// Dragging right turns the model right (the eye goes left), dragging down shows its top; a pan
// keeps the old target under the cursor; the wheel flies a tenth of the distance per notch.
TEST(ViewerControls, OrbitsPansAndWheelFollowTheMouse)
{
    const double s = 20 * std::sin(DorPi / 9), c = 20 * std::cos(DorPi / 9);
    const struct {
        int dx, dy;
        bool pan;
        DorVector3 eye, target;
    } rows[] = {{50, 0, false, {-s, -c, 0}, {0, 0, 0}}, {0, 50, false, {0, -c, s}, {0, 0, 0}}, {30, -10, true, {-6, -20, -2}, {-6, 0, -2}}};
    for (const auto& r : rows) {
        _VelCamera camera = Camera(DorVector3(0, -20, 0), DorVector3(0, 0, 0), 90.0, 1.0);
        OrbitStep orbit = OrbitForDrag(r.dx, r.dy);
        PanStep pan = PanForDrag(r.dx, r.dy, camera, 200);
        r.pan ? CVelMathCamera::Fly(camera, 0.0, pan.right, pan.up, 0) : CVelMathCamera::RoundDolly(camera, orbit.elevation, orbit.azimuth);
        EXPECT_LE(DorLength(camera.eye - r.eye) + DorLength(camera.target - r.target), 1e-9) << r.dx << "," << r.dy;
    }
    const _VelCamera camera = Camera(DorVector3(0, -20, 0), DorVector3(0, 0, 0));
    EXPECT_EQ((std::vector<double>{FlyForWheel(120, camera), FlyForWheel(-240, camera), FlyForWheel(60, camera)}), (std::vector<double>{2, -4, 1}));
    EXPECT_TRUE(PanForDrag(30, 10, camera, 0).right == 0.0);
    EXPECT_TRUE(IsClick(100, 100, 102, 98) && !IsClick(100, 100, 103, 100) && !IsClick(100, 100, 100, 97));
}
