#pragma once
// Render primitive records: what every shape becomes before it is drawn. A primitive is a list
// of groups; a group is one material and one run of points, lines or triangles in double
// precision. Copies are deep.
#include "../model/dor_types.h"
#include "../model/export.h"

struct _VelVertex {
    DorVector3 position;
    DorVector3 normal;     // not normalised by the records
    DorColorValue colour;  // used by per-vertex colour groups only
    DorVector2 texcoord;   // x = s, y = t; used by textured groups only
};

struct _VelTriangleIndex {
    int a, b, c;  // corners in winding order

    _VelTriangleIndex() : a(0), b(0), c(0) {}
    _VelTriangleIndex(int a_, int b_, int c_) : a(a_), b(b_), c(c_) {}
};

// How a group's vertex list is read.
enum VelGroupType {
    VelGroupPoints = 0,
    VelGroupLines = 1,          // separate segments, vertices in pairs
    VelGroupLineStrip = 2,
    VelGroupTriangles = 3,      // separate triangles, vertices in threes
    VelGroupTriangleStrip = 4,
    VelGroupTriangleFan = 5,
    VelGroupIndexed = 6         // the entries of `triangles` index the vertex pool
};

enum VelRenderKind { VelRenderLit = 0, VelRenderVertexColour = 1, VelRenderTextured = 2 };

// The number of elements drawn for a group; false for a type outside 0..6, which leaves the
// drawn count undefined. Counts at or below zero draw nothing.
bool VelDrawnElementCount(int groupType, int vertexCount, int triangleCount, int& count);

class KARVEL_API CVelTrianglePolys {
public:
    int GroupType;  // VelGroupType; default triangle strip
    _DorMaterial material;
    CDorArray<_VelVertex, _VelVertex&> vertices;
    CDorArray<_VelTriangleIndex, _VelTriangleIndex&> triangles;  // group type 6 only
    int RenderKind;   // VelRenderKind; other values draw as lit
    float lineWidth;  // line width and point size in pixels
    unsigned int texture;  // name from AddTexture; 0 = none
    int OverlayFlag;  // 1 = drawn flat in pixel units over the scene

    // Type 4, the default yellow material, no vertices, line width 1.
    CVelTrianglePolys();
    // Deep copy. The destination keeps its spare capacity; growth steps are not copied.
    CVelTrianglePolys(const CVelTrianglePolys& other);
    CVelTrianglePolys& operator=(const CVelTrianglePolys& other);
    virtual ~CVelTrianglePolys();

    // Frees both arrays and resets type, render kind and texture; material, line width and
    // overlay flag are kept.
    void RemoveAll();
};

class KARVEL_API CVelPrimitive {
public:
    CDorArray<CVelTrianglePolys, CVelTrianglePolys&> groups;  // in drawing order
    long DrawMode;  // bit 0 (1) hidden, bit 1 (2) pickable; other bits carried along

    CVelPrimitive();
    CVelPrimitive(const CVelPrimitive& other);
    CVelPrimitive& operator=(const CVelPrimitive& other);
    virtual ~CVelPrimitive();

    // Destroys every group and frees the group storage; DrawMode is kept.
    void DeleteAll();
};
