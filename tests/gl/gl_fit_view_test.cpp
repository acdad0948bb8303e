// Fit-all views on a live modeller: afterwards every entity lies inside the viewport.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "camera/vel_math_camera.h"
#include "gl/vel_gl_karvel.h"
#include "model/dor_math.h"
#include "support/gl_live_modeller.h"

// Three rectangles spread over x -50..80, y 0..40, z -10..30, seen from a sloped camera that
// shows little of them.
class FitAll : public LiveModeller {
protected:
    void SetUp() override
    {
        LiveModeller::SetUp();
        Add(Rectangle(-50, -10, -30, 10, 0, Matte(1, 0, 0)));
        Add(Rectangle(60, 10, 80, 30, 40, Matte(0, 1, 0)));
        Add(Rectangle(-5, -5, 5, 5, 20, Matte(0, 0, 1)));
        _VelCamera camera;
        karvel.GetCamera(camera);
        camera.eye = DorVector3(30, -20, 15);
        camera.target = DorVector3(35, 0, 12);
        camera.fovy = 45;
        karvel.SetCamera(camera);
        karvel.GetCamera(start);
    }

    // How far the model's corners reach toward the edge of the view (1 = touching); infinite
    // when one lies before the near plane.
    double Reach()
    {
        _VelCamera camera;
        karvel.GetCamera(camera);
        DorMatrix4x4 view;
        CVelMathMatrix::GetToViewMatrix(camera, 0, view);
        double t = std::tan(camera.fovy / 2 / 180 * DorPi);
        double reach = 0;
        for (double x : {-50.0, 80.0})
            for (double y : {0.0, 40.0})
                for (double z : {-10.0, 30.0}) {
                    DorVector3 v = DorTransformPoint(DorVector3(x, y, z), view);
                    double depth = -v.z;
                    if (depth <= camera.zNear)
                        return HUGE_VAL;
                    reach = std::max(reach, std::max(std::fabs(v.x) / (depth * t * camera.aspect), std::fabs(v.y) / (depth * t)));
                }
        return reach;
    }

    // Each rectangle's centre shows its colour in the drawn frame.
    void ExpectEveryEntityDrawn()
    {
        karvel.DrawModel(window.dc);
        _VelCamera camera;
        karvel.GetCamera(camera);
        DorMatrix4x4 view;
        CVelMathMatrix::GetToViewMatrix(camera, 0, view);
        double t = std::tan(camera.fovy / 2 / 180 * DorPi);
        const DorVector3 centres[] = {DorVector3(-40, 0, 0), DorVector3(70, 40, 20), DorVector3(0, 20, 0)};
        for (int i = 0; i < 3; ++i) {
            DorVector3 v = DorTransformPoint(centres[i], view);
            double scale = kHeight / 2.0 / (-v.z * t);
            Rgb c = PixelAt(static_cast<int>(kWidth / 2.0 + v.x * scale), static_cast<int>(kHeight / 2.0 - v.y * scale));
            int channel[] = {c.r, c.g, c.b};
            EXPECT_GT(channel[i], 100) << "entity " << i;
        }
    }

    _VelCamera start;
};

// The direction of view kept is checked with the placement maths; here: what the host sees.
TEST_F(FitAll, LowShowsEveryEntityAndHiFitsTighterTouchingTheEdge)
{
    EXPECT_GT(Reach(), 1.0);  // the starting view misses most of it
    karvel.SetCameraForAllView_Low(0);
    EXPECT_LE(Reach(), 1.0);
    ExpectEveryEntityDrawn();
    _VelCamera low;
    karvel.GetCamera(low);

    karvel.SetCamera(start);
    karvel.SetCameraForAllView_Hi(0);
    EXPECT_NEAR(Reach(), 1.0, 1e-6);
    ExpectEveryEntityDrawn();
    _VelCamera hi;
    karvel.GetCamera(hi);
    EXPECT_LT(DorLength(hi.target - hi.eye), DorLength(low.target - low.eye));
}

TEST_F(FitAll, EmptyModelLeavesTheCameraAlone)
{
    karvel.RemoveShapeAll();
    karvel.SetCameraForAllView_Low(0);
    karvel.SetCameraForAllView_Hi(0);
    karvel.KarvelAllmodelView(window.dc, 0, 2000);  // returns at once: no glide
    _VelCamera camera;
    karvel.GetCamera(camera);
    EXPECT_EQ(camera.eye.x, start.eye.x);
    EXPECT_EQ(camera.target.z, start.target.z);
}

TEST_F(FitAll, GlideEndsOnTheHiFit)
{
    karvel.SetCameraForAllView_Hi(0);
    _VelCamera fitted;
    karvel.GetCamera(fitted);
    karvel.SetCamera(start);
    karvel.KarvelAllmodelView(window.dc, 0, 150);
    _VelCamera camera;
    karvel.GetCamera(camera);
    EXPECT_EQ(camera.eye.x, fitted.eye.x);
    EXPECT_EQ(camera.eye.z, fitted.eye.z);
    ExpectEveryEntityDrawn();
}

TEST_F(FitAll, ViewportVariantUndoesAZoom)
{
    ASSERT_EQ(karvel.ViewportZoom(DorVector2(40, 30), DorVector2(120, 90)), 1);
    karvel.KarvelAllmodelView_vp(window.dc, 0, 0);
    _VelViewport viewport;
    karvel.GetViewport(viewport);
    EXPECT_EQ(viewport.x, 0);
    EXPECT_EQ(viewport.width, kWidth);
    _VelCamera camera;
    karvel.GetCamera(camera);
    EXPECT_DOUBLE_EQ(camera.aspect, static_cast<double>(kWidth) / kHeight);
    EXPECT_NEAR(Reach(), 1.0, 1e-6);
    ExpectEveryEntityDrawn();
}
