// Picking and depth read-back on a live modeller: what is under a pixel, how deep, and where.
#include <gtest/gtest.h>

#include <cmath>

#include "gl/vel_gl_karvel.h"
#include "model/dor_math.h"
#include "support/gl_live_modeller.h"

namespace {
typedef CDorArray<_VelSelect, _VelSelect&> Hits;

// The window depth of a point dist in front of the eye: what gluPerspective and the default
// depth range make of it.
double WindowDepth(double dist, double zNear, double zFar) { return zFar / (zFar - zNear) * (1 - zNear / dist); }
}  // namespace

class Picking : public LiveModeller {
protected:
    Hits PickAt(double x, double y, double z)
    {
        int col, row;
        PixelOf(x, y, z, col, row);
        Hits hits;
        karvel.HitTest(window.dc, col, row, hits);
        return hits;
    }
};

TEST_F(Picking, OverlappingEntitiesComeBackNearestFirst)
{
    _DorPosition* farther = Add(Rectangle(-6, -6, 6, 6, 5, Matte(0, 0, 1)));
    _DorPosition* nearer = Add(Rectangle(-2, -2, 2, 2, 0, Matte(1, 0, 0)));
    Hits hits = PickAt(0, 0, 0);
    ASSERT_EQ(hits.GetSize(), 2);
    EXPECT_EQ(hits[0].position, nearer);
    EXPECT_EQ(hits[1].position, farther);
    EXPECT_GT(hits[0].depth, 0.0);
    EXPECT_LT(hits[0].depth, hits[1].depth);
    EXPECT_LT(hits[1].depth, 1.0);
    // Flat rectangles facing the eye: their depth is the window depth of their distance.
    EXPECT_NEAR(hits[0].depth, WindowDepth(10, 1, 1000), 1e-6);
    EXPECT_NEAR(hits[1].depth, WindowDepth(15, 1, 1000), 1e-6);
    EXPECT_EQ(karvel.HitTestS(window.dc, kWidth / 2, kHeight / 2), nearer);
    // Only the far one reaches out to x = 4.5.
    Hits edge = PickAt(4.5, 5, 0);
    ASSERT_EQ(edge.GetSize(), 1);
    EXPECT_EQ(edge[0].position, farther);
}

TEST_F(Picking, PickableDecidesNotVisible)
{
    _DorPosition* hidden = Add(Rectangle(-3, -3, 3, 3, 5, Matte(0, 0, 1)));
    _DorPosition* plain = Add(Rectangle(-2, -2, 2, 2, 0, Matte(1, 0, 0)));
    karvel.SetDrawMode(hidden, 3);
    karvel.SetDrawMode(plain, 0);
    Hits hits = PickAt(0, 0, 0);
    ASSERT_EQ(hits.GetSize(), 1);
    EXPECT_EQ(hits[0].position, hidden);
}

TEST_F(Picking, EmptyBackgroundLeavesTheArrayAlone)
{
    Add(Rectangle(1, 1, 4, 4, 0, Matte(1, 0, 0)));  // upper right only
    Hits hits;
    _VelSelect sentinel = {nullptr, 0.125};
    hits.Add(sentinel);
    int col, row;
    PixelOf(2.5, 0, -2.5, col, row);  // mirrored in z: a y flip would hit here
    karvel.HitTest(window.dc, col, row, hits);
    ASSERT_EQ(hits.GetSize(), 1);
    EXPECT_EQ(hits[0].depth, 0.125);
    EXPECT_EQ(PickAt(2.5, 0, 2.5).GetSize(), 1);
    EXPECT_EQ(karvel.HitTestS(window.dc, 2, 2), nullptr);
}

TEST_F(Picking, SelectionBufferOverflowCountsAsNoHit)
{
    for (int i = 0; i < 100; ++i)
        Add(Rectangle(-2, -2, 2, 2, 5 - 0.05 * i, Matte(1, 0, 0)));  // each one nearer
    Hits hits = PickAt(0, 0, 0);
    ASSERT_EQ(hits.GetSize(), 100);
    for (int i = 1; i < 100; ++i)
        EXPECT_LE(hits[i - 1].depth, hits[i].depth);
    EXPECT_EQ(hits[0].position, karvel.model.entities.GetTailPosition());
    for (int i = 0; i < 30; ++i)
        Add(Rectangle(-2, -2, 2, 2, 6, Matte(1, 0, 0)));  // 130 records need 520 words
    EXPECT_EQ(PickAt(0, 0, 0).GetSize(), 0);
}

TEST_F(Picking, DrawingIsUnchangedAfterManyPicks)
{
    Add(Rectangle(2, 1, 5, 4, 0, Matte(1, 0, 0)));
    for (int i = 0; i < 40; ++i)  // past the depth of the projection stack
        PickAt(3.5, 0, 2.5);
    EXPECT_GT(Draw(3.5, 0, 2.5).r, 150);
    EXPECT_TRUE(IsBackground(Draw(1.7, 0, 2.5)));
    EXPECT_TRUE(IsBackground(Draw(3.5, 0, -2.5)));
}

// The depth of the nearest hit, turned back into a model point, lies on the picked plane.
// Tolerance: a 2^-24 step of the single-precision depth near 0.9 is 6e-8; at 10 units from the
// eye the window depth changes by n / d^2 = 0.01 per unit, so one step is 6e-6 units. 1e-4
// allows some fifteen steps. Across the view, a pixel is 20 / 120 units wide: the point lies
// within one pixel of the place the camera maths gives for the pixel's corner.
TEST_F(Picking, PointUnderAPixelLiesOnThePlane)
{
    _DorPosition* plane = Add(Rectangle(-20, -20, 20, 20, 0, Matte(0, 1, 0)));
    const double pixel = 20.0 / kHeight;
    const int probes[][2] = {{80, 60}, {20, 15}, {140, 100}, {33, 97}};
    for (const auto& probe : probes) {
        Hits hits;
        karvel.HitTest(window.dc, probe[0], probe[1], hits);
        ASSERT_EQ(hits.GetSize(), 1);
        double depth = hits[0].depth;
        DorVector3 point;
        karvel.GetDepthToPoint3(window.dc, probe[0], probe[1], depth, point);
        EXPECT_NEAR(point.y, 0, 1e-4);
        EXPECT_NEAR(point.x, (probe[0] - kWidth / 2.0) * pixel, pixel);
        EXPECT_NEAR(point.z, (kHeight / 2.0 - probe[1]) * pixel, pixel);

        DorVector3 precise;
        karvel.GetDepthToPoint3_Hi(window.dc, plane, probe[0], probe[1], depth, precise);
        EXPECT_NEAR(precise.y, 0, 1e-4);
    }
    _VelCamera camera;
    karvel.GetCamera(camera);
    EXPECT_EQ(camera.zNear, 1);  // the narrowed clip range is undone
    EXPECT_EQ(camera.zFar, 1000);
}

TEST_F(Picking, DepthZeroAndOneAreTheClipPlanes)
{
    double zero = 0, one = 1;
    DorVector3 nearer, farther;
    karvel.GetDepthToPoint3(window.dc, 80, 60, zero, nearer);
    karvel.GetDepthToPoint3(window.dc, 80, 60, one, farther);
    EXPECT_NEAR(nearer.y, -10 + 1, 1e-6);
    EXPECT_NEAR(farther.y, -10 + 1000, 1e-3);
}

TEST_F(Picking, OffsetModelIsPickedWhereItIsDrawn)
{
    // The offset moves the camera with the model (it only keeps the numbers small), so the
    // rectangle is drawn and picked at x 2..4 as without it.
    DorVector3 offset(3, 0, 0);
    karvel.SetOffset(offset);
    Add(Rectangle(2, -1, 4, 1, 0, Matte(1, 0, 0)));
    EXPECT_GT(Draw(3, 0, 0).r, 150);
    EXPECT_TRUE(IsBackground(Draw(0, 0, 0)));
    EXPECT_EQ(PickAt(0, 0, 0).GetSize(), 0);
    Hits hits = PickAt(3, 0, 0);
    ASSERT_EQ(hits.GetSize(), 1);
    int col, row;
    PixelOf(3, 0, 0, col, row);
    DorVector3 point;
    karvel.GetDepthToPoint3(window.dc, col, row, hits[0].depth, point);
    EXPECT_NEAR(point.x, 3, 20.0 / kHeight);
    EXPECT_NEAR(point.y, 0, 1e-4);
}

TEST_F(Picking, ApproachWithDepthMovesTheEyeTowardThePickedEntity)
{
    Add(Rectangle(-2, -2, 2, 2, 0, Matte(1, 0, 0)));
    // Height half the viewport's: things at the picked depth double, so the eye covers half
    // the 10 units to the rectangle; the target stays.
    karvel.ApproachCamera(DorVector2(kWidth / 2.0, kHeight / 2.0), kHeight / 2.0, 1);
    _VelCamera camera;
    karvel.GetCamera(camera);
    EXPECT_NEAR(camera.eye.y, -5, 0.01);
    EXPECT_NEAR(camera.eye.x, 0, 1e-9);
    EXPECT_EQ(camera.target.y, 0);

    // On empty background it turns instead of moving.
    karvel.ApproachCamera(DorVector2(5, 5), kHeight / 2.0, 1);
    _VelCamera turned;
    karvel.GetCamera(turned);
    EXPECT_NEAR(turned.eye.y, camera.eye.y, 1e-9);
    EXPECT_LT(turned.target.x, 0);
}
