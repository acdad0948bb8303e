// One frame of the model: clear, camera, lights, then every visible entity in list order.
#include "gl/vel_gl_karvel.h"

#include <windows.h>
#include <GL/gl.h>
#include <GL/glu.h>

#include <cmath>

static_assert(GL_POINTS == VelGLPoints && GL_LINES == VelGLLines && GL_LINE_LOOP == VelGLLineLoop &&
                  GL_LINE_STRIP == VelGLLineStrip && GL_TRIANGLES == VelGLTriangles &&
                  GL_TRIANGLE_STRIP == VelGLTriangleStrip && GL_TRIANGLE_FAN == VelGLTriangleFan,
              "stored modes are OpenGL's");

namespace {
// Ambient, specular, diffuse, shininess, in this order; emission is never sent.
void SendMaterial(const _DorMaterial& m)
{
    glMaterialfv(GL_FRONT, GL_AMBIENT, &m.ambient.r);
    glMaterialfv(GL_FRONT, GL_SPECULAR, &m.specular.r);
    glMaterialfv(GL_FRONT, GL_DIFFUSE, &m.diffuse.r);
    glMaterialf(GL_FRONT, GL_SHININESS, m.shininess);
}

// A transparent group is drawn without writing depth.
void SetDepthWrites(const _DorMaterial& m) { glDepthMask(m.diffuse.a >= 1.0f ? GL_TRUE : GL_FALSE); }

void SendColouredVertex(const CVelGLTrianglePolygons& group, int i)
{
    glMaterialfv(GL_FRONT, GL_AMBIENT, &group.colours[4 * i]);
    glNormal3fv(&group.normals[3 * i]);
    glVertex3fv(&group.positions[3 * i]);
}

// Eye over the viewport centre, looking along +z with y down the screen, at the distance where
// one model unit is one pixel.
void LookAtPixels(const _VelViewport& viewport, double fovyDegrees)
{
    const double pi = 3.14159265358979323846;
    double cx = viewport.width * 0.5;
    double cy = viewport.height * 0.5;
    double f = fovyDegrees * (1.0 / 180.0) * pi;
    gluLookAt(cx, cy, -cy / std::tan(f / 2), cx, cy, 0, 0, -1, 0);
}
}  // namespace

void CVelGLKarvel::DrawModel(HDC& dc)
{
    CheckDrawing("DrawModel");
    if (!renderState)
        return;
    renderState->drawScale = modelScale;
    const DorColorValue& background = context.background;
    glClearColor(background.r, background.g, background.b, 1.0f);
    glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    SetUpScene();
    BeginEntityPass();
    for (_DorPosition* p = model.entities.GetHeadPosition(); p; p = CDorList::GetNextPosition(p)) {
        const CVelGLEntity* entity = CVelGLStructure::ListedEntity(p);
        if (entity && !(entity->DrawMode & 1))
            DrawEntity(*entity);
    }
    SwapBuffers(dc);
    glFlush();
}

void CVelGLKarvel::SetUpScene()
{
    renderState->LoadProjection();
    LoadViewingTransform();
    renderState->LoadLights();
    glLineWidth(1);
    glPointSize(1);
    glColor3f(1, 1, 1);
    ApplyCullMode();
}

void CVelGLKarvel::LoadViewingTransform()
{
    const DorVector3& offset = model.offset;
    glLoadIdentity();
    renderState->LookAt(offset);
    glTranslatef(static_cast<GLfloat>(-offset.x), static_cast<GLfloat>(-offset.y), static_cast<GLfloat>(-offset.z));
}

void CVelGLKarvel::ApplyCullMode()
{
    if (renderState->cullMode) {
        glDisable(GL_CULL_FACE);
        glLightModeli(GL_LIGHT_MODEL_TWO_SIDE, 1);
    } else {
        glEnable(GL_CULL_FACE);
        glCullFace(GL_BACK);
    }
}

void CVelGLKarvel::BeginEntityPass()
{
    // NOTE: culling goes back on for the entities even in two-sided mode; hosts have always
    // seen back faces culled there.
    glEnable(GL_CULL_FACE);
    glCullFace(GL_BACK);
    glEnableClientState(GL_VERTEX_ARRAY);
    glEnableClientState(GL_NORMAL_ARRAY);
}

void CVelGLKarvel::DrawEntity(const CVelGLEntity& entity)
{
    for (int i = 0; i < entity.groups.GetSize(); ++i)
        DrawGroup(entity.groups[i]);
}

void CVelGLKarvel::DrawGroup(const CVelGLTrianglePolygons& group)
{
    bool overlay = group.OverlayFlag == 1;
    if (overlay) {
        glDisable(GL_LIGHTING);
        glPushMatrix();
        glLoadIdentity();
        LookAtPixels(renderState->viewport, renderState->camera.fovy);
        glColor3f(group.material.ambient.r, group.material.ambient.g, group.material.ambient.b);
    }
    if (group.RenderKind == VelRenderVertexColour)
        DrawImmediate(group);
    else
        DrawArrays(group);
    if (overlay) {
        glEnable(GL_LIGHTING);
        glPopMatrix();
    }
}

void CVelGLKarvel::DrawArrays(const CVelGLTrianglePolygons& group)
{
    SetDepthWrites(group.material);
    SendMaterial(group.material);
    glVertexPointer(3, GL_FLOAT, 0, group.positions.GetData());
    glNormalPointer(GL_FLOAT, 0, group.normals.GetData());
    glLineWidth(group.lineWidth);
    glPointSize(group.lineWidth);
    if (group.RenderKind == VelRenderTextured) {
        glEnable(GL_TEXTURE_2D);
        glEnableClientState(GL_TEXTURE_COORD_ARRAY);
        glBindTexture(GL_TEXTURE_2D, group.texture);
        glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_LINEAR);
        glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_LINEAR);
        glTexCoordPointer(2, GL_FLOAT, 0, group.texcoords.GetData());
    }
    if (group.indexed == 1) {
        int count = group.indices.GetSize();
        // An index past the vertices would make OpenGL read outside the arrays: skip the draw.
        if (VelIndicesInRange(group.indices.GetData(), count, group.vertexCount))
            glDrawElements(GL_TRIANGLES, count, GL_UNSIGNED_INT, group.indices.GetData());
    } else if (group.glMode != VelGLModeNone) {
        glDrawArrays(static_cast<GLenum>(group.glMode), 0, group.vertexCount);
    }
    // NOTE: zero is rejected by OpenGL, which keeps the group's width for whatever follows;
    // the calls stay as hosts have always had them.
    glLineWidth(0);
    glPointSize(0);
    glDepthMask(GL_TRUE);
    glDisableClientState(GL_TEXTURE_COORD_ARRAY);
    glDisable(GL_TEXTURE_2D);
}

void CVelGLKarvel::DrawImmediate(const CVelGLTrianglePolygons& group)
{
    glEnableClientState(GL_COLOR_ARRAY);
    SetDepthWrites(group.material);
    glTexCoordPointer(2, GL_FLOAT, 0, group.texcoords.GetData());
    SendMaterial(group.material);
    if (group.indexed != 1) {
        if (group.glMode != VelGLModeNone) {
            glBegin(static_cast<GLenum>(group.glMode));
            for (int i = 0; i < group.vertexCount; ++i)
                SendColouredVertex(group, i);
            glEnd();
        }
    } else {
        // NOTE: indexed groups have always sent vertex 0 three times per triangle here (nothing
        // visible) and closed with one glEnd too many, which OpenGL rejects. Kept as it is.
        if (group.vertexCount > 0) {
            for (int t = 0; t < group.elementCount; ++t) {
                glBegin(GL_TRIANGLES);
                for (int corner = 0; corner < 3; ++corner)
                    SendColouredVertex(group, 0);
                glEnd();
            }
        }
        glEnd();
    }
    glDepthMask(GL_TRUE);
    glDisableClientState(GL_COLOR_ARRAY);
}
