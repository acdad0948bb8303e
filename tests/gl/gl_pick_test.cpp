// Picking and depth read-back on a live modeller: what is under a pixel, how deep, and where.
#include <gtest/gtest.h>

#include <utility>
#include <vector>

#include "support/gl_live_modeller.h"

// A green plane at y = 0 with, in front of it, a red rectangle up and right (y = -1), a blue one
// drawn hidden but pickable (y = -2) and a white one shown but not pickable (y = -2). The model
// is offset, which moves the camera with it: it is drawn and picked as without the offset.
// Tolerances: a 2^-24 step of the single-precision depth near 0.9 is 6e-8; at 10 units from the
// eye the window depth changes by 0.01 per unit, so 1e-4 units allows some fifteen steps; across
// the view a point may lie anywhere in its pixel, 1/6 of a unit at most.
TEST_F(LiveModeller, HitsComeNearestFirstAndTheirDepthsGiveThePointsOnTheirPlanes)
{
    DorVector3 offset(3, 0, 0);
    karvel.SetOffset(offset);
    _DorPosition* plane = Add(Rectangle(-20, -20, 20, 20, 0, Matte(0, 1, 0)));
    _DorPosition* red = Add(Rectangle(2, 1, 4, 3, -1, Matte(1, 0, 0)));
    _DorPosition* blue = Add(Rectangle(-4, -1, -2, 1, -2, Matte(0, 0, 1)));
    karvel.SetDrawMode(blue, 3);
    _DorPosition* white = Add(Rectangle(-4, 3, -2, 5, -2, Matte(1, 1, 1)));
    karvel.SetDrawMode(white, 0);
    struct Spot {
        double x, z;
        std::vector<std::pair<_DorPosition*, double>> hits;  // and the y of each one's plane
    } spots[] = {{3, 2, {{red, -1}, {plane, 0}}}, {3, -2, {{plane, 0}}}, {-3.5, 0, {{blue, -2}, {plane, 0}}},
                 {-3.5, 5, {{plane, 0}}}};
    for (int round = 0; round < 10; ++round)  // past the depth of the projection stack
        for (const Spot& s : spots) {
            int col, row;
            PixelOf(s.x, s.z, col, row);
            CDorArray<_VelSelect, _VelSelect&> hits;
            karvel.HitTest(window.dc, col, row, hits);
            ASSERT_EQ(hits.GetSize(), static_cast<int>(s.hits.size())) << s.x << ", " << s.z;
            for (int i = 0; i < hits.GetSize(); ++i) {
                ASSERT_EQ(hits[i].position, s.hits[i].first) << s.x << ", " << s.z << " hit " << i;
                double y = s.hits[i].second, distance = 10 + y;
                EXPECT_NEAR(hits[i].depth, 1000.0 / 999 * (1 - 1 / distance), 1e-6);
                DorVector3 point;
                karvel.GetDepthToPoint3(window.dc, col, row, hits[i].depth, point);
                EXPECT_NEAR(point.y, y, 1e-4);
                EXPECT_NEAR(point.x, (col - kWidth / 2.0) * distance / 60, 1.0 / 6);
                EXPECT_NEAR(point.z, (kHeight / 2.0 - row) * distance / 60, 1.0 / 6);
            }
        }
    karvel.DrawModel(window.dc);  // the hidden blue one lets the plane show through
    EXPECT_GT(At(3, 2).r, 150);
    EXPECT_GT(At(-3.5, 0).g, 150);
}
