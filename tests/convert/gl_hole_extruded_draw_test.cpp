// A holed extrusion converted through AddShape and drawn by the OpenGL modeller: the opening
// shows the background, the wall around it its material, and the opening's own walls show only
// when they face into it.
#include <gtest/gtest.h>
#include <windows.h>
#include <GL/gl.h>

#include <utility>
#include <vector>

#include "convert/dor_shape.h"
#include "gl/vel_gl_karvel.h"
#include "support/win32_test_window.h"

namespace {
const int kWidth = 160;
const int kHeight = 120;

// A 6 x 4 wall in the x-z plane with a 2 x 2 window in its middle, its face at y = -1 and
// 6 deep along +y, seen from (0, -10, 0) along +y with a 90-degree field of view: a point x
// across (or z up) at depth d from the eye lands 60 x / d pixels right of (or above) the centre.
class WallWithWindowOnScreen : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_EQ(karvel.Initialize(window.dc), 1);
        _VelCamera camera;
        karvel.GetCamera(camera);
        karvel.SetCamera(_VelCamera{DorVector3(0, -10, 0), DorVector3(0, 0, 0), 90, 1, 1000, camera.aspect});
    }
    void TearDown() override { karvel.Finalize(); }

    // Draws the wall and reads back whether each of the given pixels (column, row from the top)
    // shows the black background.
    std::vector<bool> DrawAndTestBackground(bool windowClockwise, const std::vector<std::pair<int, int>>& pixels)
    {
        CDorHolePolygon face({DorVector3(-3, -1, -2), DorVector3(-3, -1, 2), DorVector3(3, -1, 2), DorVector3(3, -1, -2)});
        DorVector3 opening[4] = {DorVector3(-1, -1, -1), DorVector3(-1, -1, 1), DorVector3(1, -1, 1), DorVector3(1, -1, -1)};
        if (windowClockwise)
            std::swap(opening[1], opening[3]);
        face.AddHole(opening, 4);
        wall = CDorHoleExtruded(face, DorVector3(0, 6, 0));
        wall.material.ambient = DorColorValue(0.6f, 0, 0, 1);
        wall.MatchCapsToWalls();
        shape.Add(&wall);
        EXPECT_NE(karvel.AddShape(shape), nullptr);
        karvel.DrawModel(window.dc);
        glFinish();
        // NOTE: under Wine the front buffer reads back as zeros; Mesa swaps by copying, so the
        // back buffer still holds the presented frame.
        glReadBuffer(GL_BACK);
        glPixelStorei(GL_PACK_ALIGNMENT, 1);
        std::vector<unsigned char> rgba(4 * kWidth * kHeight);
        glReadPixels(0, 0, kWidth, kHeight, GL_RGBA, GL_UNSIGNED_BYTE, rgba.data());
        std::vector<bool> background;
        for (const auto& p : pixels) {
            const unsigned char* c = &rgba[4 * ((kHeight - 1 - p.second) * kWidth + p.first)];
            background.push_back(c[0] == 0 && c[1] == 0 && c[2] == 0);
        }
        return background;
    }

    // Through the window, the wall beside it, above it, beyond the wall; and the window's right
    // side, between its front edge (depth 9) at column 80 + 60 / 9 and its back edge (depth 15)
    // at 80 + 60 / 15.
    const int row = kHeight / 2;
    const std::vector<std::pair<int, int>> pixels = {
        {80, row}, {80 + 60 * 2 / 9, row}, {80, row - 60 * 3 / 2 / 9}, {80 + 60 * 4 / 9, row}, {85, row}};

    TestWindow window{kWidth, kHeight};
    CVelGLKarvel karvel;
    CDorHoleExtruded wall;
    CDorShape shape;
};
}  // namespace

TEST_F(WallWithWindowOnScreen, OpeningShowsTheBackgroundAndItsWallsFacingIntoIt)
{
    EXPECT_EQ(DrawAndTestBackground(false, pixels), std::vector<bool>({true, false, false, true, false}));
}

TEST_F(WallWithWindowOnScreen, OpeningGivenClockwiseHasWallsFacingAwayAndCulled)
{
    EXPECT_EQ(DrawAndTestBackground(true, pixels), std::vector<bool>({true, false, false, true, true}));
}
