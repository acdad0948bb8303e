#include <gtest/gtest.h>

#include <cmath>

#include "gl/vel_gl_render_state.h"
#include "gl/vel_gl_store.h"
#include "model/dor_math.h"

namespace {
double Off(const float* v, const DorVector3& w) { return DorLength(DorVector3(v[0], v[1], v[2]) - w); }
}  // namespace

// Only light 0 is on (it follows the camera, as the live modeller shows). The host's light type counts the other way from the
// stored kind; the direction is stored towards the light, unit unless too short; positions scale
// with the model; indices outside the table are refused.
TEST(RenderState, LightsConvertKindDirectionAndScale)
{
    CVelGLStructure model;
    CVelGLRenderState state(model);
    const _VelGLLight& off = state.lights[VelLightCount - 1];
    EXPECT_TRUE(state.lights[0].kind == 1 && state.lights[0].enabled == 1 && state.cullMode == 0 && off.kind == 0 && off.enabled == 0);
    EXPECT_TRUE(off.attenuation == 0.00001f && off.ambient.r == 0.1f && off.diffuse.a == 0.0f);
    for (int i : {0, 1, 4})  // the first five point from the corners of the view
        EXPECT_LE(Off(state.lights[i].direction, DorVector3(i == 1 ? 1 : -1, i == 1 ? 2 : -2, -2) * (1 / 3.0)), 1e-6) << i;
    DorLight spot, out;
    spot.type = 0;
    spot.position = DorVector3(1, 2, 3);
    spot.direction = DorVector3(0, 3, -4);
    spot.diffuse = DorColorValue(0.5f, 0.25f, 0.125f, 1);
    spot.enabled = 1;
    spot.attenuation = 0.5f;
    for (int index : {0, 3, 8, -1})
        state.SetLight(index, spot, 2.0);
    out.type = 42;
    state.GetLight(3, out, 2.0);
    EXPECT_TRUE(state.lights[3].kind == 1 && Off(state.lights[3].direction, DorVector3(0, -0.6, 0.8)) + Off(state.lights[3].position, DorVector3(2, 4, 6)) < 1e-6);
    EXPECT_TRUE(out.type == 0 && out.enabled == 1 && out.attenuation == 0.5f && out.diffuse.g == 0.25f);
    EXPECT_LE(DorLength(out.position - DorVector3(1, 2, 3)) + DorLength(out.direction - DorVector3(0, 0.6, -0.8)), 1e-6);
    spot.type = 1;
    spot.direction = DorVector3(0.00001, 0, 0);
    state.SetLight(2, spot, 1.0);
    state.GetLight(2, out, 1.0);
    EXPECT_TRUE(state.lights[2].kind == 0 && out.type == 1 && state.lights[2].direction[0] == -0.00001f);
    out.type = 7;
    state.GetLight(-1, out, 1.0);
    state.GetLight(8, out, 1.0);
    EXPECT_EQ(out.type, 7);
}

// The camera scales with the model both ways. Screen-up straight down
// or up is +y or -y (the sloped views are drawn by the live modeller).
TEST(RenderState, CameraScaleRoundTripsAndScreenUp)
{
    CVelGLStructure model;
    CVelGLRenderState state(model);
    _VelCamera camera = {DorVector3(1, 2, 3), DorVector3(4, 5, 6), 30, 0.5, 500, 1.25}, out;
    state.SetCamera(camera, 4.0);
    state.GetCamera(out, 4.0);
    EXPECT_TRUE(state.camera.eye.x == 4.0 && state.camera.target.z == 24.0 && state.camera.zNear == 2.0 && state.camera.zFar == 2000.0);
    EXPECT_LE(DorLength(out.eye - camera.eye) + DorLength(out.target - camera.target), 1e-12);
    EXPECT_TRUE(out.zNear == 0.5 && out.zFar == 500 && out.fovy == 30.0 && out.aspect == 1.25);
    EXPECT_TRUE(DorLength(VelCameraUp(DorVector3(0, 0, -10)) - DorVector3(0, 1, 0)) == 0 &&
                DorLength(VelCameraUp(DorVector3(0, 0, 10)) - DorVector3(0, -1, 0)) == 0);
}
