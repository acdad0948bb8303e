#include "gl/vel_gl_render_state.h"

#include "model/dor_math.h"

namespace {
const int kGLSmooth = 0x1D01;

void SetVector(float* out, const DorVector3& v)
{
    out[0] = static_cast<float>(v.x);
    out[1] = static_cast<float>(v.y);
    out[2] = static_cast<float>(v.z);
}

_VelGLLight DefaultLight()
{
    _VelGLLight light = {};
    light.kind = 0;
    light.diffuse = DorColorValue(1, 1, 1, 0);
    light.ambient = DorColorValue(0.1f, 0.1f, 0.1f, 0);
    light.specular = DorColorValue(1, 1, 1, 0);
    light.enabled = 0;
    light.attenuation = 0.00001f;
    return light;
}

// Stores the direction towards the light, unit length unless too short to normalise.
void SetTowardsLight(_VelGLLight& light, DorVector3 towards)
{
    DorNormalize(towards);
    SetVector(light.direction, towards);
}

bool InRange(int index) { return index >= 0 && index < VelLightCount; }
}  // namespace

CVelGLRenderState::CVelGLRenderState(CVelGLStructure& model_)
    : model(&model_), viewport{0, 0, 0, 0}, resetViewport{0, 0, 0, 0}, cullMode(0), depthTest(1), lighting(1),
      blending(1), shadeModel(kGLSmooth), drawScale(1.0), ownerThread(0)
{
    // A three-quarter view of the origin from the front right, above the ground.
    camera.eye = DorVector3(100, -100, 100);
    camera.target = DorVector3(0, 0, 0);
    camera.fovy = 45.0;
    camera.zNear = 1.0;
    camera.zFar = 10000.0;
    camera.aspect = 1.0;

    static const DorVector3 towards[] = {DorVector3(-5, -10, -10), DorVector3(5, 10, -10), DorVector3(-5, 10, 10),
                                         DorVector3(5, -10, 10), DorVector3(-5, -10, -10)};
    for (int i = 0; i < VelLightCount; ++i) {
        lights[i] = DefaultLight();
        if (i < 5)
            SetTowardsLight(lights[i], towards[i]);
    }
    lights[0].kind = 1;
    lights[0].enabled = 1;
}

void CVelGLRenderState::GetLight(int index, DorLight& light, double modelScale) const
{
    if (!InRange(index))
        return;
    const _VelGLLight& stored = lights[index];
    if (stored.kind == 0)
        light.type = 1;
    else if (stored.kind == 1)
        light.type = 0;
    light.enabled = stored.enabled;
    light.attenuation = stored.attenuation;
    light.position.x = stored.position[0] / modelScale;
    light.position.y = stored.position[1] / modelScale;
    light.position.z = stored.position[2] / modelScale;
    light.direction.x = -stored.direction[0];
    light.direction.y = -stored.direction[1];
    light.direction.z = -stored.direction[2];
    light.diffuse = stored.diffuse;
    light.ambient = stored.ambient;
    light.specular = stored.specular;
}

void CVelGLRenderState::SetLight(int index, const DorLight& light, double modelScale)
{
    if (!InRange(index))
        return;
    _VelGLLight& stored = lights[index];
    if (light.type == 0)
        stored.kind = 1;
    else if (light.type == 1)
        stored.kind = 0;
    stored.enabled = light.enabled;
    stored.attenuation = light.attenuation;
    SetTowardsLight(stored, light.direction * -1.0);
    SetVector(stored.position, light.position * modelScale);
    stored.diffuse = light.diffuse;
    stored.ambient = light.ambient;
    stored.specular = light.specular;
}

void CVelGLRenderState::FollowCamera()
{
    SetVector(lights[0].position, camera.eye);
    SetTowardsLight(lights[0], camera.eye - camera.target);
}

void CVelGLRenderState::GetCamera(_VelCamera& out, double modelScale) const
{
    out = camera;
    out.eye.x /= modelScale;
    out.eye.y /= modelScale;
    out.eye.z /= modelScale;
    out.target.x /= modelScale;
    out.target.y /= modelScale;
    out.target.z /= modelScale;
    out.zNear /= modelScale;
    out.zFar /= modelScale;
}

void CVelGLRenderState::SetCamera(const _VelCamera& in, double modelScale)
{
    _VelCamera scaled = in;
    scaled.eye.x *= modelScale;
    scaled.eye.y *= modelScale;
    scaled.eye.z *= modelScale;
    scaled.target.x *= modelScale;
    scaled.target.y *= modelScale;
    scaled.target.z *= modelScale;
    scaled.zNear *= modelScale;
    scaled.zFar *= modelScale;
    if (DorLength(scaled.target - scaled.eye) >= 0.0001)
        camera = scaled;
}

DorVector3 VelCameraUp(const DorVector3& d)
{
    DorVector3 up(-d.x * d.z, -d.y * d.z, d.x * d.x + d.y * d.y);
    if (DorNormalize(up))
        return up;
    // Straight down or up: screen-up is the world's +Y or -Y, as the camera maths has it.
    return DorVector3(0, d.z > 0 ? -1.0 : 1.0, 0);
}
