#include "convert/vel_extrusion_geometry.h"

#include "model/dor_math.h"

namespace {
DorVector3 Centroid(const DorPointArray& points)
{
    DorVector3 sum;
    const int n = points.GetSize();
    if (n == 0)
        return sum;
    for (int i = 0; i < n; ++i)
        sum = sum + points[i];
    return DorVector3(sum.x / n, sum.y / n, sum.z / n);
}

DorVector3 UnitCross(const DorVector3& a, const DorVector3& b)
{
    DorVector3 c = DorCross(a, b);
    DorNormalize(c);
    return c;
}

void FillWireSides(const CDorGeometry& head, const DorVector3 quad[4], bool faceIn, CVelTrianglePolys& sides)
{
    DorVector3 normals[4];
    VelWallCornerNormals(quad[0], quad[1], quad[2], quad[3], normals);
    sides.GroupType = VelGroupLines;
    sides.vertices.SetSize(4);
    for (int k = 0; k < 4; ++k) {
        sides.vertices[k].position = quad[k];
        sides.vertices[k].normal = faceIn ? normals[k] * -1.0 : normals[k];
    }
    sides.material = head.material;
}

void FillWireLoop(const CDorGeometry& head, const std::vector<DorVector3>& loop, const DorVector3& normal,
                  CVelTrianglePolys& outline)
{
    outline.GroupType = VelGroupLineStrip;
    outline.material = head.material;
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

DorVector3 VelExtrusionDirection(const DorPointArray& bottom, const DorPointArray& top)
{
    DorVector3 e = Centroid(top) - Centroid(bottom);
    DorNormalize(e);
    return e;
}

void VelOrientProfile(DorPointArray& profile, const DorVector3& direction)
{
    const int n = profile.GetSize();
    if (n < 3)
        return;
    DorVector3 reference = direction;
    if (direction.x == 0.0 && direction.z == 0.0) {
        reference = DorNewellNormal(profile.GetData(), n);
        DorNormalize(reference);
    }
    DorMatrix4x4 projection = DorPlaneProjection(reference, profile[0]);
    std::vector<DorVector3> projected(n);
    for (int i = 0; i < n; ++i)
        projected[i] = DorTransformPoint(profile[i], projection);
    if (!(DorNewellNormal(projected.data(), n).z < 0.0))
        return;
    for (int lo = 1, hi = n - 1; lo < hi; ++lo, --hi) {
        DorVector3 swap = profile[lo];
        profile[lo] = profile[hi];
        profile[hi] = swap;
    }
}

std::vector<DorVector3> VelClosedLoop(const DorPointArray& profile)
{
    std::vector<DorVector3> loop(profile.GetData(), profile.GetData() + profile.GetSize());
    if (!loop.empty())
        loop.push_back(loop[0]);
    return loop;
}

DorVector3 VelQuadNormal(const DorVector3& a, const DorVector3& b, const DorVector3& c, const DorVector3& d)
{
    const DorVector3 loop[4] = {a, b, c, d};
    DorVector3 normal = DorNewellNormal(loop, 4);
    DorNormalize(normal);
    return normal;
}

void VelWallCornerNormals(const DorVector3& ti, const DorVector3& bi, const DorVector3& ti1, const DorVector3& bi1,
                          DorVector3 normals[4])
{
    normals[0] = UnitCross(bi - ti, ti1 - ti);
    normals[1] = UnitCross(bi1 - bi, ti - bi);
    normals[2] = UnitCross(ti1 - ti, ti1 - bi1);
    normals[3] = UnitCross(bi1 - ti1, bi1 - bi);
}

DorMatrix4x4 VelWallTextureFrame(const DorVector3& wallNormal, const DorVector3& anchor, const DorVector3& axis)
{
    DorMatrix4x4 frame = DorPlaneProjection(wallNormal, anchor);
    if (axis.x == 0.0 && axis.y == 0.0 && axis.z == 0.0)
        return frame;
    DorVector3 along = axis;
    DorNormalize(along);
    return frame * DorRotateZ(-DorAzimuth(DorTransformDirection(along, frame)));
}

void VelFillSolidWall(const CDorGeometry& head, const DorVector3& textureAxis, const DorVector3 quad[4],
                      const DorVector3& anchor, bool withTexCoords, CVelTrianglePolys& wall)
{
    DorVector3 normal = VelQuadNormal(quad[0], quad[1], quad[3], quad[2]);
    wall.vertices.SetSize(4);
    for (int k = 0; k < 4; ++k) {
        wall.vertices[k].position = quad[k];
        wall.vertices[k].normal = normal;
    }
    if (withTexCoords) {
        DorMatrix4x4 frame = VelWallTextureFrame(normal, anchor, textureAxis);
        for (int k = 0; k < 4; ++k) {
            DorVector3 q = DorTransformPoint(quad[k], frame);
            wall.vertices[k].texcoord = DorVector2(q.x / head.textureScaleU, q.y / head.textureScaleV);
        }
    }
    wall.material = head.material;
    if (head.texture != 0)
        wall.RenderKind = VelRenderTextured;
    wall.texture = head.texture;
}

void VelFillWireFrame(const CDorGeometry& head, const DorPointArray& bottomPoints, const DorPointArray& topPoints,
                      bool sidesFaceIn, CVelTrianglePolys* groups)
{
    const int m = bottomPoints.GetSize();
    std::vector<DorVector3> bottom = VelClosedLoop(bottomPoints), top = VelClosedLoop(topPoints);
    for (int k = 0; k < m; ++k) {
        const DorVector3 quad[4] = {top[k], bottom[k], top[k + 1], bottom[k + 1]};
        FillWireSides(head, quad, sidesFaceIn, groups[k]);
    }
    FillWireLoop(head, bottom, UnitNormal(bottom) * -1.0, groups[m]);  // away from the solid
    FillWireLoop(head, top, UnitNormal(top), groups[m + 1]);
}
