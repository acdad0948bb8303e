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
