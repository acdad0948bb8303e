#pragma once
// The model of the drawing, picking and capture benchmarks: lit grids of 10,000 triangles each,
// facing -y and stacked along z, filling the view of a camera 12 units out on -y.
#include "gl/vel_gl_karvel.h"
#include "model/vel_primitive.h"

const int kGridColumns = 100;  // quads per row of one grid
const int kGridRows = 50;      // 100 x 50 quads = 10,000 triangles

// The grid at place strip of the stack.
inline CVelPrimitive BenchGrid(int strip)
{
    CVelTrianglePolys g;
    g.GroupType = VelGroupIndexed;
    g.vertices.SetSize((kGridColumns + 1) * (kGridRows + 1));
    for (int r = 0; r <= kGridRows; ++r) {
        for (int c = 0; c <= kGridColumns; ++c) {
            _VelVertex& v = g.vertices[r * (kGridColumns + 1) + c];
            v.position = DorVector3(c * 0.1 - 5, 0, strip * 0.5 + r * 0.01 - 5);
            v.normal = DorVector3(0, -1, 0);
        }
    }
    for (int r = 0; r < kGridRows; ++r) {
        for (int c = 0; c < kGridColumns; ++c) {
            int a = r * (kGridColumns + 1) + c;
            _VelTriangleIndex lower(a, a + 1, a + kGridColumns + 2);
            _VelTriangleIndex upper(a, a + kGridColumns + 2, a + kGridColumns + 1);
            g.triangles.Add(lower);
            g.triangles.Add(upper);
        }
    }
    CVelPrimitive p;
    p.groups.Add(g);
    return p;
}

// Initialises karvel on dc, puts the camera 12 units out on -y with a 60 degree field of view
// and adds grids 0 .. grids - 1. False when there is no context.
inline bool LoadBenchModel(CVelGLKarvel& karvel, HDC& dc, int grids)
{
    if (!karvel.Initialize(dc))
        return false;
    _VelCamera camera;
    karvel.GetCamera(camera);
    camera.eye = DorVector3(0, -12, 0);
    camera.target = DorVector3(0, 0, 0);
    camera.fovy = 60;
    karvel.SetCamera(camera);
    for (int i = 0; i < grids; ++i) {
        CVelPrimitive p = BenchGrid(i);
        karvel.AddPrimitive(p);
    }
    return true;
}
