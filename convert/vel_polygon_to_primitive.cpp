#include "convert/vel_polygon_to_primitive.h"

#include "convert/vel_face_geometry.h"
#include "convert/vel_polygon_triangulation.h"

void CVelPolygonToPrimitive::ConvertPolygon(CDorPolygon* polygon, CVelGroupArray& groups, int reverse)
{
    if (!polygon)
        return;
    if (polygon->style == DorStyleSolid)
        ConvertSolidPolygon(polygon, groups, reverse);
    else if (polygon->style == DorStyleWire)
        ConvertWirePolygon(polygon, groups, reverse);
}

void CVelPolygonToPrimitive::ConvertSolidPolygon(CDorPolygon* polygon, CVelGroupArray& groups, int reverse)
{
    const int n = polygon->points.GetSize();
    DorVector3 normal = VelFaceNormal(polygon->points, reverse);
    CDorArray<int, int> indices;
    TriangulatePolygon(polygon, indices);
    if (indices.GetSize() == 0 || n == 0)
        return;

    CVelTrianglePolys group;
    VelFillIndexedFace(polygon->points, indices, normal, reverse, group);
    group.material = polygon->material;
    if (polygon->texture != 0)
        group.RenderKind = VelRenderTextured;
    group.texture = polygon->texture;
    VelSetPlanarTexCoords(group, polygon->textureAxis, polygon->textureOrigin, polygon->textureScaleU,
                          polygon->textureScaleV);
    groups.Add(group);
}

// Separate segments over n + 1 points: the outline shows every other side. Two identical groups
// are appended. Hosts draw with both, keep it so.
void CVelPolygonToPrimitive::ConvertWirePolygon(CDorPolygon* polygon, CVelGroupArray& groups, int reverse)
{
    const int n = polygon->points.GetSize();
    if (n == 0)  // no point 0 to close the outline with
        return;
    DorVector3 normal = VelFaceNormal(polygon->points, reverse);
    CVelTrianglePolys group;
    group.GroupType = VelGroupLines;
    group.material = polygon->material;
    group.vertices.SetSize(n + 1);
    for (int i = 0; i <= n; ++i) {
        group.vertices[i].position = polygon->points[i < n ? i : 0];
        group.vertices[i].normal = normal;
    }
    groups.Add(group);
    groups.Add(group);
}
