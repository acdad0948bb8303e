#include <gtest/gtest.h>

#include <cmath>

#include "gl/vel_gl_render_state.h"
#include "gl/vel_gl_store.h"
#include "model/dor_math.h"

namespace {
DorVector3 Stored(const float* v) { return DorVector3(v[0], v[1], v[2]); }

void ExpectNear(const DorVector3& a, double x, double y, double z, double tolerance = 1e-6)
{
    EXPECT_NEAR(a.x, x, tolerance);
    EXPECT_NEAR(a.y, y, tolerance);
    EXPECT_NEAR(a.z, z, tolerance);
}

DorLight SpotAbove()
{
    DorLight light;
    light.type = 0;
    light.position = DorVector3(1, 2, 3);
    light.direction = DorVector3(0, 0, -4);
    light.diffuse = DorColorValue(0.5f, 0.25f, 0.125f, 1);
    light.enabled = 1;
    light.attenuation = 0.5f;
    return light;
}
}  // namespace

class RenderStateLights : public ::testing::Test {
protected:
    CVelGLStructure model;
    CVelGLRenderState state{model};
};

TEST_F(RenderStateLights, DefaultsLightTheSceneFromTheCameraOnly)
{
    EXPECT_EQ(state.lights[0].kind, 1);
    EXPECT_EQ(state.lights[0].enabled, 1);
    ExpectNear(Stored(state.lights[0].direction), -1.0 / 3, -2.0 / 3, -2.0 / 3);
    ExpectNear(Stored(state.lights[1].direction), 1.0 / 3, 2.0 / 3, -2.0 / 3);
    ExpectNear(Stored(state.lights[4].direction), -1.0 / 3, -2.0 / 3, -2.0 / 3);
    for (int i = 1; i < VelLightCount; ++i) {
        EXPECT_EQ(state.lights[i].kind, 0) << i;
        EXPECT_EQ(state.lights[i].enabled, 0) << i;
        EXPECT_EQ(state.lights[i].attenuation, 0.00001f);
        EXPECT_EQ(state.lights[i].ambient.r, 0.1f);
        EXPECT_EQ(state.lights[i].diffuse.a, 0.0f);
    }
    EXPECT_EQ(state.cullMode, 0);
}

TEST_F(RenderStateLights, SetThenGetConvertsKindDirectionAndScale)
{
    state.SetLight(3, SpotAbove(), 2.0);
    const _VelGLLight& stored = state.lights[3];
    EXPECT_EQ(stored.kind, 1);                                   // positional
    ExpectNear(Stored(stored.direction), 0, 0, 1);               // towards the light, unit
    ExpectNear(Stored(stored.position), 2, 4, 6);                // times the model scale

    DorLight out;
    out.type = 42;
    out.position.dimension = 99;
    state.GetLight(3, out, 2.0);
    EXPECT_EQ(out.type, 0);
    ExpectNear(out.position, 1, 2, 3);
    ExpectNear(out.direction, 0, 0, -1);  // the unit vector, not the length that was set
    EXPECT_EQ(out.position.dimension, 99);
    EXPECT_EQ(out.diffuse.g, 0.25f);
    EXPECT_EQ(out.enabled, 1);
    EXPECT_EQ(out.attenuation, 0.5f);
}

TEST_F(RenderStateLights, UnknownTypeKeepsTheKindAndShortDirectionsStayAsGiven)
{
    DorLight light = SpotAbove();
    light.type = 1;
    light.direction = DorVector3(0, 0, 2);
    state.SetLight(2, light, 1.0);
    DorLight out;
    state.GetLight(2, out, 1.0);
    EXPECT_EQ(out.type, 1);
    ExpectNear(out.direction, 0, 0, 1);

    light.type = 5;
    light.direction = DorVector3(0.00001, 0, 0);
    state.SetLight(2, light, 1.0);
    EXPECT_EQ(state.lights[2].kind, 0);
    EXPECT_FLOAT_EQ(state.lights[2].direction[0], -0.00001f);
}

TEST_F(RenderStateLights, IndicesOutsideTheTableAreRefused)
{
    CVelGLRenderState before(model);
    state.SetLight(8, SpotAbove(), 1.0);
    state.SetLight(-1, SpotAbove(), 1.0);
    for (int i = 0; i < VelLightCount; ++i)
        EXPECT_EQ(state.lights[i].position[0], before.lights[i].position[0]);
    DorLight out;
    out.type = 7;
    state.GetLight(-1, out, 1.0);
    state.GetLight(8, out, 1.0);
    EXPECT_EQ(out.type, 7);
}

TEST_F(RenderStateLights, LightZeroFollowsTheCamera)
{
    state.SetLight(0, SpotAbove(), 1.0);
    state.camera.eye = DorVector3(0, -30, 40);
    state.camera.target = DorVector3(0, 0, 0);
    state.FollowCamera();
    ExpectNear(Stored(state.lights[0].position), 0, -30, 40);
    ExpectNear(Stored(state.lights[0].direction), 0, -0.6, 0.8);
    EXPECT_EQ(state.lights[0].diffuse.g, 0.25f);  // the host's colours stay
}

TEST(RenderStateCamera, ScaleRoundTripsAndTooShortViewsAreRefused)
{
    CVelGLStructure model;
    CVelGLRenderState state(model);
    _VelCamera camera = {DorVector3(1, 2, 3), DorVector3(4, 5, 6), 30, 0.5, 500, 1.25};
    state.SetCamera(camera, 4.0);
    EXPECT_EQ(state.camera.eye.x, 4.0);
    EXPECT_EQ(state.camera.zFar, 2000.0);
    _VelCamera out;
    state.GetCamera(out, 4.0);
    ExpectNear(out.target, 4, 5, 6, 1e-12);
    EXPECT_EQ(out.zNear, 0.5);
    EXPECT_EQ(out.fovy, 30.0);
    EXPECT_EQ(out.aspect, 1.25);

    _VelCamera degenerate = camera;
    degenerate.target = degenerate.eye;
    degenerate.fovy = 90;
    state.SetCamera(degenerate, 4.0);
    EXPECT_EQ(state.camera.fovy, 30.0);
    degenerate.target.x += 0.00002;  // 0.00008 once scaled: still too short
    state.SetCamera(degenerate, 4.0);
    EXPECT_EQ(state.camera.fovy, 30.0);
}

TEST(CameraUp, StandsAtRightAnglesToTheViewAndLeansToPlusZ)
{
    DorVector3 views[] = {DorVector3(1, 0, 0), DorVector3(-3, 4, -5), DorVector3(0.5, 0.5, 7)};
    for (const DorVector3& d : views) {
        DorVector3 up = VelCameraUp(d);
        EXPECT_NEAR(DorDot(up, d), 0, 1e-12);
        EXPECT_NEAR(DorLength(up), 1, 1e-12);
        EXPECT_GT(up.z, 0);
    }
    ExpectNear(VelCameraUp(DorVector3(0, 0, -10)), 0, 1, 0);
    ExpectNear(VelCameraUp(DorVector3(0, 0, 10)), 0, -1, 0);
}
