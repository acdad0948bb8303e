#include "convert/vel_face_geometry.h"

#include "model/dor_math.h"

namespace {
// The texture transform applied after the plane frame and the scales.
DorMatrix4x4 TextureTransform(int vertexCount, const DorMatrix4x4& frame, const DorVector3& axis,
                              const DorVector3& origin, double scaleU, double scaleV)
{
    DorMatrix4x4 texture;
    if (vertexCount > 1 && DorLength(axis) != 0.0) {
        texture = DorRotateZ(DorAzimuth(DorTransformPoint(axis, frame)));
        DorVector3 shift = DorTransformPoint(origin, frame);
        texture = texture * DorTranslate(shift.x / scaleU, shift.y / scaleV, shift.z);
    }
    return texture;
}
}  // namespace

DorVector3 VelFaceNormal(const CDorArray<DorVector3, DorVector3&>& loop, int reverse)
{
    DorVector3 normal = DorNewellNormal(loop.GetData(), loop.GetSize());
    DorNormalize(normal);
    if (reverse == 1)
        normal = normal * -1.0;
    return normal;
}

void VelFillIndexedFace(const CDorArray<DorVector3, DorVector3&>& points, const CDorArray<int, int>& indices,
                        const DorVector3& normal, int reverse, CVelTrianglePolys& group)
{
    group.GroupType = VelGroupIndexed;
    group.vertices.SetSize(points.GetSize());
    for (int k = 0; k < points.GetSize(); ++k) {
        group.vertices[k].position = points[k];
        group.vertices[k].normal = normal;
    }
    group.triangles.SetSize(indices.GetSize() / 3);
    for (int t = 0; t < group.triangles.GetSize(); ++t) {
        int a = indices[3 * t], b = indices[3 * t + 1], c = indices[3 * t + 2];
        group.triangles[t] = reverse == 1 ? _VelTriangleIndex(c, b, a) : _VelTriangleIndex(a, b, c);
    }
}

void VelSetPlanarTexCoords(CVelTrianglePolys& group, const DorVector3& axis, const DorVector3& origin, double scaleU,
                           double scaleV)
{
    const int n = group.vertices.GetSize();
    if (n == 0)
        return;
    DorMatrix4x4 frame = DorPlaneProjection(group.vertices[0].normal, group.vertices[0].position);
    DorMatrix4x4 texture = TextureTransform(n, frame, axis, origin, scaleU, scaleV);
    for (int i = 0; i < n; ++i) {
        DorVector3 q = DorTransformPoint(group.vertices[i].position, frame);
        DorVector3 scaled(q.x / scaleU, q.y / scaleV, 0.0);
        DorVector3 w = DorTransformPoint(scaled, texture);
        group.vertices[i].texcoord = DorVector2(w.x, w.y);
    }
}
