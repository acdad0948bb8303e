#pragma once
// CVelGLRenderState: everything of a modeller that lives with an OpenGL context: the camera, the
// viewports, the eight lights, the cull mode and the switches applied at context start-up.
// Camera and light positions are kept multiplied by the modeller's model scale; the getters and
// setters here take and give model units.
//
// The portable members are defined in vel_gl_render_state.cpp; the ones that issue OpenGL calls
// (marked "GL") in gl_render_state.cpp and need the context current.
#include "../camera/vel_camera.h"
#include "../model/dor_types.h"

class CVelGLStructure;

// One OpenGL light as the render state keeps it.
struct _VelGLLight {
    int kind;  // 0 directional, 1 positional (note: DorLight::type counts the other way)
    DorColorValue diffuse;
    DorColorValue ambient;
    DorColorValue specular;
    float position[3];
    float direction[4];  // unit vector towards the light, then w = kind
    int enabled;
    float attenuation;  // linear, positional lights only
};

const int VelLightCount = 8;

class CVelGLRenderState {
public:
    CVelGLStructure* model;
    _VelCamera camera;
    _VelViewport viewport;       // the one in force
    _VelViewport resetViewport;  // what ResetViewport returns to
    _VelGLLight lights[VelLightCount];
    int cullMode;  // 0 back faces culled; otherwise two-sided
    int depthTest;
    int lighting;
    int blending;
    int shadeModel;     // GL_SMOOTH
    double drawScale;  // the modeller's model scale, copied before each frame

    explicit CVelGLRenderState(CVelGLStructure& model);
    virtual ~CVelGLRenderState() {}

    // Out of range indices (below 0, 8 or more) do nothing.
    void GetLight(int index, DorLight& light, double modelScale) const;
    void SetLight(int index, const DorLight& light, double modelScale);
    // Light 0 stands at the eye and shines along the view.
    void FollowCamera();

    void GetCamera(_VelCamera& out, double modelScale) const;
    // Refuses (leaves the camera whole) when the scaled eye and target are closer than 0.0001.
    void SetCamera(const _VelCamera& in, double modelScale);

    // GL: the start-up of a fresh context; reads both viewports back. Returns 1.
    int StartUp();
    // GL: light 0 follows the camera, then all eight lights are loaded.
    void LoadLights();
    // GL: stores and applies the viewport.
    void ApplyViewport(const _VelViewport& vp);
    // GL: the perspective of the camera into the projection matrix; the modelview matrix stays
    // selected.
    void LoadProjection() const;
    // GL: the camera's view, less the offset, onto the modelview matrix.
    void LookAt(const DorVector3& offset) const;
};

// The up vector that stands at right angles to the view direction d, tilted from +Z.
DorVector3 VelCameraUp(const DorVector3& d);
