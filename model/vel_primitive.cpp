#include "model/vel_primitive.h"

bool VelDrawnElementCount(int groupType, int vertexCount, int triangleCount, int& count)
{
    switch (groupType) {
    case VelGroupPoints: count = vertexCount; return true;
    case VelGroupLines: count = static_cast<int>(vertexCount * 0.5); return true;
    case VelGroupLineStrip: count = vertexCount - 1; return true;
    // NOTE: a single-precision third, as the drawing code has always used.
    case VelGroupTriangles: count = static_cast<int>(static_cast<float>(vertexCount) * 0.33333334f); return true;
    case VelGroupTriangleStrip:
    case VelGroupTriangleFan: count = vertexCount - 2; return true;
    case VelGroupIndexed: count = triangleCount; return true;
    default: return false;
    }
}

CVelTrianglePolys::CVelTrianglePolys()
    : GroupType(VelGroupTriangleStrip), RenderKind(VelRenderLit), lineWidth(1.0f), texture(0), OverlayFlag(0)
{
    material.diffuse = DorColorValue(0.8f, 0.8f, 0.0f, 1.0f);
    material.ambient = DorColorValue(0.4f, 0.4f, 0.0f, 1.0f);
    material.specular = DorColorValue(1.0f, 1.0f, 0.0f, 1.0f);
    material.emission = DorColorValue(0.0f, 0.0f, 0.0f, 0.0f);
    material.shininess = 80.0f;
}

CVelTrianglePolys::CVelTrianglePolys(const CVelTrianglePolys& other) : CVelTrianglePolys() { *this = other; }

CVelTrianglePolys& CVelTrianglePolys::operator=(const CVelTrianglePolys& other)
{
    if (this == &other)
        return *this;
    GroupType = other.GroupType;
    material = other.material;
    vertices = other.vertices;
    triangles = other.triangles;
    RenderKind = other.RenderKind;
    lineWidth = other.lineWidth;
    texture = other.texture;
    OverlayFlag = other.OverlayFlag;
    return *this;
}

CVelTrianglePolys::~CVelTrianglePolys() { RemoveAll(); }

void CVelTrianglePolys::RemoveAll()
{
    vertices.SetSize(0);
    triangles.SetSize(0);
    GroupType = VelGroupTriangleStrip;
    RenderKind = VelRenderLit;
    texture = 0;
}

CVelPrimitive::CVelPrimitive() : DrawMode(2) {}

CVelPrimitive::CVelPrimitive(const CVelPrimitive& other) : CVelPrimitive() { *this = other; }

CVelPrimitive& CVelPrimitive::operator=(const CVelPrimitive& other)
{
    if (this != &other) {
        groups = other.groups;
        DrawMode = other.DrawMode;
    }
    return *this;
}

CVelPrimitive::~CVelPrimitive() { DeleteAll(); }

void CVelPrimitive::DeleteAll() { groups.SetSize(0); }
