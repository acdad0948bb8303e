#include "convert/vel_hole_polygon_to_primitive.h"

#include "convert/vel_face_geometry.h"

namespace {
// The loop's points, its first point again, every normal the face's. An empty loop has no
// point to close with and stays an empty line strip; any other becomes separate segments.
void FillWireLoop(const CDorArray<DorVector3, DorVector3&>& loop, const DorVector3& normal,
                  const _DorMaterial& material, CVelTrianglePolys& group)
{
    const int m = loop.GetSize();
    group.GroupType = m > 0 ? VelGroupLines : VelGroupLineStrip;
    group.material = material;
    group.vertices.SetSize(m > 0 ? m + 1 : 0);
    for (int k = 0; k < group.vertices.GetSize(); ++k) {
        group.vertices[k].position = loop[k < m ? k : 0];
        group.vertices[k].normal = normal;
    }
}
}  // namespace

void CVelHolePolygonToPrimitive::ConvertHolePolygon(CDorHolePolygon* shape, CVelGroupArray& groups, int flip)
{
    if (!shape)
        return;
    if (shape->style == DorStyleSolid)
        ConvertSolidHolePolygon(shape, groups, flip);
    else if (shape->style == DorStyleWire)
        ConvertWireHolePolygon(shape, groups, flip);
}

void CVelHolePolygonToPrimitive::ConvertSolidHolePolygon(CDorHolePolygon* shape, CVelGroupArray& groups, int flip)
{
    DorVector3 normal = VelFaceNormal(shape->points, flip);
    CDorArray<DorVector3, DorVector3&> vertices;
    CDorArray<int, int> indices;
    TriangulateHolePolygon(shape, vertices, indices);
    if (indices.GetSize() == 0) {
        // A triangle has no diagonal, and a degenerate outline none that counts: hosts still
        // get the first three points as a face.
        if (vertices.GetSize() < 3)
            return;
        for (int k = 0; k < 3; ++k)
            indices.Add(k);
    }

    CVelTrianglePolys group;
    VelFillIndexedFace(vertices, indices, normal, flip, group);
    group.material = shape->material;
    if (shape->texture != 0) {
        group.RenderKind = VelRenderTextured;
        group.texture = shape->texture;
        VelSetPlanarTexCoords(group, shape->holeTextureAxis, shape->holeTextureOrigin, shape->textureScaleU,
                              shape->textureScaleV);
    }
    groups.Add(group);
}

void CVelHolePolygonToPrimitive::ConvertWireHolePolygon(CDorHolePolygon* shape, CVelGroupArray& groups, int flip)
{
    DorVector3 normal = VelFaceNormal(shape->points, flip);
    CVelTrianglePolys group;
    FillWireLoop(shape->points, normal, shape->material, group);
    groups.Add(group);
    for (int h = 0; h < shape->holes.GetSize(); ++h) {
        group.RemoveAll();
        FillWireLoop(shape->holes[h].points, normal, shape->material, group);
        groups.Add(group);
    }
}
