#include "convert/vel_extruded_to_primitive.h"

#include "convert/vel_extrusion_geometry.h"
#include "convert/vel_polygon_to_primitive.h"
#include "model/dor_math.h"

namespace {
// Wall i as a strip top i, bottom i, top i+1, bottom i+1 with one flat normal and texture
// coordinates in a frame anchored at bottom point 0 for every wall.
void FillSolidWall(const CDorExtruded& extruded, const std::vector<DorVector3>& bottom,
                   const std::vector<DorVector3>& top, int i, CVelTrianglePolys& wall)
{
    const DorVector3 quad[4] = {top[i], bottom[i], top[i + 1], bottom[i + 1]};
    DorVector3 normal = VelQuadNormal(quad[0], quad[1], quad[3], quad[2]);
    DorMatrix4x4 frame = VelWallTextureFrame(normal, bottom[0], extruded.textureAxis);
    wall.vertices.SetSize(4);
    for (int k = 0; k < 4; ++k) {
        _VelVertex& v = wall.vertices[k];
        v.position = quad[k];
        v.normal = normal;
        DorVector3 q = DorTransformPoint(quad[k], frame);
        v.texcoord = DorVector2(q.x / extruded.textureScaleU, q.y / extruded.textureScaleV);
    }
    wall.material = extruded.material;
    if (extruded.texture != 0)
        wall.RenderKind = VelRenderTextured;
    wall.texture = extruded.texture;
}

// Wall i as its two vertical edges, each normal the cross product at its own corner.
void FillWireWall(const CDorExtruded& extruded, const std::vector<DorVector3>& bottom,
                  const std::vector<DorVector3>& top, int i, CVelTrianglePolys& wall)
{
    const DorVector3 quad[4] = {top[i], bottom[i], top[i + 1], bottom[i + 1]};
    DorVector3 normals[4];
    VelWallCornerNormals(quad[0], quad[1], quad[2], quad[3], normals);
    wall.GroupType = VelGroupLines;
    wall.vertices.SetSize(4);
    for (int k = 0; k < 4; ++k) {
        wall.vertices[k].position = quad[k];
        wall.vertices[k].normal = normals[k];
    }
    wall.material = extruded.material;
}

void FillOutline(const CDorExtruded& extruded, const std::vector<DorVector3>& loop, const DorVector3& normal,
                 CVelTrianglePolys& outline)
{
    outline.GroupType = VelGroupLineStrip;
    outline.material = extruded.material;
    outline.vertices.SetSize(static_cast<int>(loop.size()));
    for (int k = 0; k < outline.vertices.GetSize(); ++k) {
        outline.vertices[k].position = loop[k];
        outline.vertices[k].normal = normal;
    }
}

DorVector3 UnitNormal(const std::vector<DorVector3>& loop)
{
    DorVector3 normal = DorNewellNormal(loop.data(), static_cast<int>(loop.size()));
    DorNormalize(normal);
    return normal;
}
}  // namespace

void CVelExtrudedToPrimitive::ConvertExtruded(CDorExtruded* extruded, CVelGroupArray& groups)
{
    if (!extruded)
        return;
    if (extruded->style == DorStyleSolid)
        ConvertSolidExtruded(extruded, groups);
    else if (extruded->style == DorStyleWire)
        ConvertWireExtruded(extruded, groups);
}

void CVelExtrudedToPrimitive::ConvertSolidExtruded(CDorExtruded* extruded, CVelGroupArray& groups)
{
    DorPointArray& bottomPoints = extruded->bottom.points;
    DorPointArray& topPoints = extruded->top.points;
    const int n = bottomPoints.GetSize();
    if (topPoints.GetSize() != n)
        return;
    DorVector3 direction = VelExtrusionDirection(bottomPoints, topPoints);
    VelOrientProfile(bottomPoints, direction);
    VelOrientProfile(topPoints, direction);
    std::vector<DorVector3> bottom = VelClosedLoop(bottomPoints), top = VelClosedLoop(topPoints);

    groups.SetSize(n, -1);
    for (int i = 0; i < n; ++i)
        FillSolidWall(*extruded, bottom, top, i, groups[i]);

    CVelPolygonToPrimitive caps;
    if (extruded->bottomCap)
        caps.ConvertPolygon(&extruded->bottom, groups, 1);
    if (extruded->topCap)
        caps.ConvertPolygon(&extruded->top, groups, 0);
}

void CVelExtrudedToPrimitive::ConvertWireExtruded(CDorExtruded* extruded, CVelGroupArray& groups)
{
    const int n = extruded->bottom.points.GetSize();
    if (extruded->top.points.GetSize() != n || n == 0)  // empty profiles have no point 0 to close with
        return;
    std::vector<DorVector3> bottom = VelClosedLoop(extruded->bottom.points);
    std::vector<DorVector3> top = VelClosedLoop(extruded->top.points);
    DorVector3 bottomNormal = UnitNormal(bottom) * -1.0;  // the bottom outline faces away from the solid
    DorVector3 topNormal = UnitNormal(top);

    groups.SetSize(n + 2, -1);
    for (int i = 0; i < n; ++i)
        FillWireWall(*extruded, bottom, top, i, groups[i]);
    FillOutline(*extruded, bottom, bottomNormal, groups[n]);
    FillOutline(*extruded, top, topNormal, groups[n + 1]);
}
