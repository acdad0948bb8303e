// Picking through the OpenGL selection mode, and the model point under a pixel.
#include "gl/vel_gl_karvel.h"
#include "gl/vel_pick.h"

#include <windows.h>
#include <GL/gl.h>
#include <GL/glu.h>

#include <vector>

void CVelGLKarvel::HitTest(HDC, int x, int y, CDorArray<_VelSelect, _VelSelect&>& hits)
{
    CheckDrawing("HitTest");
    if (!renderState)
        return;
    const DorColorValue& background = context.background;
    glClearColor(background.r, background.g, background.b, 0.0f);
    glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    LoadViewingTransform();

    GLuint buffer[VelSelectBufferWords];
    glSelectBuffer(VelSelectBufferWords, buffer);
    glRenderMode(GL_SELECT);
    glInitNames();

    const _VelCamera& camera = renderState->camera;
    GLint viewport[4];
    glMatrixMode(GL_PROJECTION);
    glGetIntegerv(GL_VIEWPORT, viewport);
    glPushMatrix();
    glLoadIdentity();
    gluPickMatrix(x, renderState->resetViewport.height - y, 5.0, 5.0, viewport);
    gluPerspective(camera.fovy, camera.aspect, camera.zNear, camera.zFar);
    glMatrixMode(GL_MODELVIEW);

    // Names index this table: a handle does not fit a 32-bit name on 64-bit Windows.
    std::vector<_DorPosition*> pushed;
    BeginEntityPass();
    for (_DorPosition* p = model.entities.GetHeadPosition(); p; p = CDorList::GetNextPosition(p)) {
        const CVelGLEntity* entity = CVelGLStructure::ListedEntity(p);
        if (!entity || !(entity->DrawMode & 2))
            continue;
        glPushName(static_cast<GLuint>(pushed.size()));
        pushed.push_back(p);
        DrawEntity(*entity);
        glPopName();
    }
    // NOTE: the modelview matrix is selected, so this pops that stack and the pick projection
    // stays pushed; the next frame reloads the projection. Hosts have always had it so.
    glPopMatrix();
    const _VelViewport& current = renderState->viewport;
    glViewport(current.x, current.y, current.width, current.height);
    glMatrixMode(GL_MODELVIEW);
    int hitCount = glRenderMode(GL_RENDER);
    ApplyCullMode();

    VelDecodeHits(buffer, VelSelectBufferWords, hitCount, pushed.data(), static_cast<int>(pushed.size()), hits);
    if (hitCount >= 1)
        VelSortHits(hits.GetData(), hits.GetSize());
}

void CVelGLKarvel::GetDepthToPoint3(HDC, int x, int y, double& depth, DorVector3& point)
{
    CheckDrawing("GetDepthToPoint3");
    if (!renderState)
        return;
    LoadViewingTransform();
    GLint viewport[4];
    glGetIntegerv(GL_VIEWPORT, viewport);
    renderState->LoadProjection();
    const _VelViewport& current = renderState->viewport;
    glViewport(current.x, current.y, current.width, current.height);

    GLdouble modelview[16], projection[16];
    glGetDoublev(GL_MODELVIEW_MATRIX, modelview);
    glGetDoublev(GL_PROJECTION_MATRIX, projection);
    GLdouble px = 0, py = 0, pz = 0;
    if (gluUnProject(x, viewport[3] - y, depth, modelview, projection, viewport, &px, &py, &pz) != GL_TRUE)
        return;
    point.x = px / modelScale;
    point.y = py / modelScale;
    point.z = pz / modelScale;
}
