#include "convert/vel_polygon_to_primitive.h"

#include "convert/vel_polygon_triangulation.h"
#include "model/dor_math.h"

namespace {
// The outline's unit Newell normal (left as summed when too short), turned over for a back face.
DorVector3 FaceNormal(const CDorPolygon& polygon, int reverse)
{
    DorVector3 normal = DorNewellNormal(polygon.points.GetData(), polygon.points.GetSize());
    DorNormalize(normal);
    if (reverse == 1)
        normal = DorVector3(-normal.x, -normal.y, -normal.z);
    return normal;
}

// The texture transform applied after the plane projection and the scales. The axis is taken
// through the projection as a point, translation included, and the origin is added, not
// subtracted: hosts place their textures by these rules.
DorMatrix4x4 TextureTransform(const CDorPolygon& polygon, const DorMatrix4x4& projection)
{
    DorMatrix4x4 texture;
    if (polygon.points.GetSize() > 1 && DorLength(polygon.textureAxis) != 0.0) {
        texture = DorRotateZ(DorAzimuth(DorTransformPoint(polygon.textureAxis, projection)));
        DorVector3 origin = DorTransformPoint(polygon.textureOrigin, projection);
        texture = texture * DorTranslate(origin.x / polygon.textureScaleU, origin.y / polygon.textureScaleV, origin.z);
    }
    return texture;
}

void SetPlanarTexCoords(const CDorPolygon& polygon, const DorVector3& normal, CVelTrianglePolys& group)
{
    DorMatrix4x4 projection = DorPlaneProjection(normal, polygon.points[0]);
    DorMatrix4x4 texture = TextureTransform(polygon, projection);
    for (int i = 0; i < group.vertices.GetSize(); ++i) {
        DorVector3 q = DorTransformPoint(group.vertices[i].position, projection);
        DorVector3 scaled(q.x / polygon.textureScaleU, q.y / polygon.textureScaleV, 0.0);
        DorVector3 w = DorTransformPoint(scaled, texture);
        group.vertices[i].texcoord = DorVector2(w.x, w.y);
    }
}
}  // namespace

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
    DorVector3 normal = FaceNormal(*polygon, reverse);
    CDorArray<int, int> indices;
    TriangulatePolygon(polygon, indices);
    if (indices.GetSize() == 0 || n == 0)
        return;

    CVelTrianglePolys group;
    group.GroupType = VelGroupIndexed;
    group.vertices.SetSize(n);
    for (int i = 0; i < n; ++i) {
        group.vertices[i].position = polygon->points[i];
        group.vertices[i].normal = normal;
    }
    group.triangles.SetSize(indices.GetSize() / 3);
    for (int t = 0; t < group.triangles.GetSize(); ++t) {
        int a = indices[3 * t], b = indices[3 * t + 1], c = indices[3 * t + 2];
        group.triangles[t] = reverse == 1 ? _VelTriangleIndex(c, b, a) : _VelTriangleIndex(a, b, c);
    }
    group.material = polygon->material;
    if (polygon->texture != 0)
        group.RenderKind = VelRenderTextured;
    group.texture = polygon->texture;
    SetPlanarTexCoords(*polygon, normal, group);
    groups.Add(group);
}

// Separate segments over n + 1 points: the outline shows every other side. Two identical groups
// are appended. Hosts draw with both, keep it so.
void CVelPolygonToPrimitive::ConvertWirePolygon(CDorPolygon* polygon, CVelGroupArray& groups, int reverse)
{
    const int n = polygon->points.GetSize();
    if (n == 0)  // no point 0 to close the outline with
        return;
    DorVector3 normal = FaceNormal(*polygon, reverse);
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
