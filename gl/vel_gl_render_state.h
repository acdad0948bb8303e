#pragma once
/// @file
/// CVelGLRenderState, the part of a modeller that lives with its OpenGL context.
//
// The portable members are defined in vel_gl_render_state.cpp; the ones that issue OpenGL calls
// (marked "GL") in gl_render_state.cpp and need the context current.
#include "../camera/vel_camera.h"
#include "../model/dor_types.h"

class CVelGLStructure;

/// One OpenGL light as the render state keeps it.
struct _VelGLLight {
    int kind;  ///< 0 directional, 1 positional (note: DorLight::type counts the other way).
    DorColorValue diffuse;   ///< Diffuse colour.
    DorColorValue ambient;   ///< Ambient colour.
    DorColorValue specular;  ///< Specular colour.
    float position[3];   ///< Times the model scale.
    float direction[4];  ///< Unit vector towards the light, then w = kind.
    int enabled;         ///< Non-zero: on.
    float attenuation;   ///< Linear, positional lights only.
};

/// The number of lights, GL_LIGHT0 to GL_LIGHT7.
const int VelLightCount = 8;

/// Everything of a modeller that lives with an OpenGL context: the camera, the viewports, the
/// eight lights, the cull mode and the switches applied at context start-up. Created by the first
/// CVelGLKarvel::Initialize, deleted by Finalize; owned by the modeller. Camera and light
/// positions are kept multiplied by the modeller's model scale; the getters and setters here take
/// and give model units. Members marked "GL" issue OpenGL calls and need the context current on
/// the calling thread.
class CVelGLRenderState {
public:
    CVelGLStructure* model;  ///< The modeller's model; not owned.
    _VelCamera camera;  ///< Scaled by the model scale.
    _VelViewport viewport;       ///< The one in force.
    _VelViewport resetViewport;  ///< What ResetViewport returns to: the context's own at start-up.
    _VelGLLight lights[VelLightCount];  ///< Light 0 positional and on, following the camera; 1..7 off.
    int cullMode;  ///< 0 back faces culled; otherwise two-sided.
    int depthTest;  ///< 1: depth test on at start-up.
    int lighting;   ///< 1: lighting on at start-up.
    int blending;   ///< 1: alpha blending on at start-up.
    int shadeModel;     ///< GL_SMOOTH.
    double drawScale;  ///< The modeller's model scale, copied before each frame.
    unsigned long ownerThread;  ///< The thread that initialised the modeller last (checked mode).

    /// The defaults: a camera from (100, -100, 100) at the origin, fovy 45, clip 1 to 10000;
    /// zero viewports until start-up; the default lights; back faces culled.
    explicit CVelGLRenderState(CVelGLStructure& model);
    /// Nothing to free.
    virtual ~CVelGLRenderState() {}

    /// CVelKarvel::GetLight; out of range indices (below 0, 8 or more) do nothing.
    void GetLight(int index, DorLight& light, double modelScale) const;
    /// CVelKarvel::SetLight; out of range indices do nothing.
    void SetLight(int index, const DorLight& light, double modelScale);
    /// Light 0 stands at the eye and shines along the view.
    void FollowCamera();

    /// CVelKarvel::GetCamera.
    void GetCamera(_VelCamera& out, double modelScale) const;
    /// Refuses (leaves the camera whole) when the scaled eye and target are closer than 0.0001.
    void SetCamera(const _VelCamera& in, double modelScale);

    /// GL: the start-up of a fresh context; reads both viewports back. Returns 1.
    int StartUp();
    /// GL: light 0 follows the camera, then all eight lights are loaded.
    void LoadLights();
    /// GL: stores and applies the viewport.
    void ApplyViewport(const _VelViewport& vp);
    /// GL: the perspective of the camera into the projection matrix; the modelview matrix stays
    /// selected.
    void LoadProjection() const;
    /// GL: the camera's view, less the offset, onto the modelview matrix.
    void LookAt(const DorVector3& offset) const;
};

/// @cond KARVEL_INTERNAL
// The up vector that stands at right angles to the view direction d, tilted from +Z.
DorVector3 VelCameraUp(const DorVector3& d);
/// @endcond
