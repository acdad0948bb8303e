// The render state's OpenGL side: start-up of a fresh context, lights, viewport and camera.
#include "gl/vel_gl_render_state.h"

#include <windows.h>
#include <GL/gl.h>
#include <GL/glu.h>

#include "model/dor_math.h"

static_assert(GL_SMOOTH == 0x1D01, "shade model constant");

namespace {
_VelViewport CurrentGLViewport()
{
    GLint v[4] = {};
    glGetIntegerv(GL_VIEWPORT, v);
    return _VelViewport{v[0], v[1], v[2], v[3]};
}
}  // namespace

int CVelGLRenderState::StartUp()
{
    LoadLights();
    glEnable(GL_NORMALIZE);
    if (lighting)
        glEnable(GL_LIGHTING);
    if (depthTest)
        glEnable(GL_DEPTH_TEST);
    glShadeModel(static_cast<GLenum>(shadeModel));
    if (blending) {
        glEnable(GL_BLEND);
        glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
        // NOTE: blend, not modulate: textured groups have always been drawn this way.
        glTexEnvf(GL_TEXTURE_ENV, GL_TEXTURE_ENV_MODE, GL_BLEND);
    }
    viewport = CurrentGLViewport();
    resetViewport = CurrentGLViewport();
    return 1;
}

void CVelGLRenderState::LoadLights()
{
    FollowCamera();
    for (int i = 0; i < VelLightCount; ++i) {
        _VelGLLight& light = lights[i];
        GLenum id = static_cast<GLenum>(GL_LIGHT0 + i);
        light.direction[3] = static_cast<float>(light.kind);
        if (light.kind == 0) {
            glLightfv(id, GL_POSITION, light.direction);
        } else if (light.kind == 1) {
            const GLfloat position[4] = {light.position[0], light.position[1], light.position[2], 1.0f};
            glLightfv(id, GL_POSITION, position);
            glLightf(id, GL_LINEAR_ATTENUATION, light.attenuation);
        }
        glLightfv(id, GL_DIFFUSE, &light.diffuse.r);
        glLightfv(id, GL_SPECULAR, &light.specular.r);
        glLightfv(id, GL_AMBIENT, &light.ambient.r);
        if (light.enabled)
            glEnable(id);
        else
            glDisable(id);
    }
}

void CVelGLRenderState::ApplyViewport(const _VelViewport& vp)
{
    viewport = vp;
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    glViewport(vp.x, vp.y, vp.width, vp.height);
    glMatrixMode(GL_MODELVIEW);
}

void CVelGLRenderState::LoadProjection() const
{
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    gluPerspective(camera.fovy, camera.aspect, camera.zNear, camera.zFar);
    glMatrixMode(GL_MODELVIEW);
}

void CVelGLRenderState::LookAt(const DorVector3& offset) const
{
    DorVector3 eye = camera.eye - offset;
    DorVector3 target = camera.target - offset;
    DorVector3 up = VelCameraUp(camera.target - camera.eye);
    gluLookAt(eye.x, eye.y, eye.z, target.x, target.y, target.z, up.x, up.y, up.z);
}
