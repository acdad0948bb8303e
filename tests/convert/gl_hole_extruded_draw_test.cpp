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

// The whole presented frame, read once, as RGBA rows from the top.
class Frame {
public:
    Frame()
    {
        glFinish();
        // NOTE: under Wine the front buffer reads back as zeros; Mesa swaps by copying, so the
        // back buffer still holds the presented frame.
        glReadBuffer(GL_BACK);
        glPixelStorei(GL_PACK_ALIGNMENT, 1);
        glReadPixels(0, 0, kWidth, kHeight, GL_RGBA, GL_UNSIGNED_BYTE, rgba.data());
    }
    bool IsBackground(int col, int row) const
    {
        const unsigned char* p = &rgba[4 * ((kHeight - 1 - row) * kWidth + col)];
        return p[0] == 0 && p[1] == 0 && p[2] == 0;
    }

private:
    std::vector<unsigned char> rgba = std::vector<unsigned char>(4 * kWidth * kHeight);
};

// A 6 x 4 wall in the x-z plane with a 2 x 2 window in its middle, its face at y = -1 and
// 6 deep along +y, seen from (0, -10, 0) along +y with a 90-degree field of view: a point x
// across (or z up) at depth d from the eye lands 60 x / d pixels right of (or above) the centre.
class WallWithWindowOnScreen : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_EQ(karvel.Initialize(window.dc), 1);
        _VelCamera current;
        karvel.GetCamera(current);
        _VelCamera camera = {DorVector3(0, -10, 0), DorVector3(0, 0, 0), 90, 1, 1000, current.aspect};
        karvel.SetCamera(camera);
    }
    void TearDown() override { karvel.Finalize(); }

    void AddWall(bool windowClockwise)
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
        ASSERT_NE(karvel.AddShape(shape), nullptr);
        karvel.DrawModel(window.dc);
    }

    // The window's right side: its front edge (depth 9) at column 80 + 60 / 9, its back edge
    // (depth 15) at 80 + 60 / 15; its wall lies between them.
    const int windowWallColumn = 85;
    const int middleRow = kHeight / 2;

    TestWindow window{kWidth, kHeight};
    CVelGLKarvel karvel;
    CDorHoleExtruded wall;
    CDorShape shape;
};
}  // namespace

TEST_F(WallWithWindowOnScreen, OpeningShowsTheBackgroundAndTheWallItsMaterial)
{
    AddWall(false);
    Frame frame;
    EXPECT_TRUE(frame.IsBackground(80, middleRow));                   // through the window
    EXPECT_FALSE(frame.IsBackground(80 + 60 * 2 / 9, middleRow));    // the wall beside it
    EXPECT_FALSE(frame.IsBackground(80, middleRow - 60 * 3 / 2 / 9));  // above it
    EXPECT_TRUE(frame.IsBackground(80 + 60 * 4 / 9, middleRow));     // beyond the wall
    EXPECT_FALSE(frame.IsBackground(windowWallColumn, middleRow));   // the opening's wall faces into it
}

TEST_F(WallWithWindowOnScreen, OpeningGivenClockwiseHasWallsFacingAwayAndCulled)
{
    AddWall(true);
    Frame frame;
    EXPECT_TRUE(frame.IsBackground(80, middleRow));
    EXPECT_FALSE(frame.IsBackground(80 + 60 * 2 / 9, middleRow));
    EXPECT_TRUE(frame.IsBackground(windowWallColumn, middleRow));
}
