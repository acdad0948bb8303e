#include "convert/vel_plane2d.h"

#include <cmath>

namespace {
const double kPi = 3.14159265358979323846;

double EdgeAngle(const DorVector2& q, const DorVector2& a, const DorVector2& b)
{
    DorVector2 u = VelSub2(a, q), v = VelSub2(b, q);
    double cross = VelCross2(u, v), dot = VelDot2(u, v);
    if (cross == 0.0 && dot == 0.0)
        return 0.0;
    return std::atan2(cross, dot);
}
}  // namespace

void VelNormalize2(DorVector2& v)
{
    double length = std::sqrt(v.x * v.x + v.y * v.y);
    if (length >= 0.0001) {
        v.x /= length;
        v.y /= length;
    }
}

double VelWindingAngle(const DorVector2& q, const DorVector2* loop, int count)
{
    double sum = 0.0;
    for (int k = 0; k < count; ++k)
        sum += EdgeAngle(q, loop[k], loop[k + 1 < count ? k + 1 : 0]);
    return sum;
}

double VelWindingAngle(const DorVector2& q, const DorVector2* points, const int* indices, int count)
{
    double sum = 0.0;
    for (int k = 0; k < count; ++k)
        sum += EdgeAngle(q, points[indices[k]], points[indices[k + 1 < count ? k + 1 : 0]]);
    return sum;
}

bool VelWindingInside(double angleSum) { return std::fabs(angleSum) > kPi; }

bool VelOnLoopEdge(const DorVector2& q, const DorVector2* loop, int count)
{
    for (int k = 0; k < count; ++k) {
        DorVector2 u = VelSub2(loop[k], q), v = VelSub2(loop[k + 1 < count ? k + 1 : 0], q);
        if (!(std::fabs(VelCross2(u, v)) < 0.0001))
            continue;
        VelNormalize2(u);
        VelNormalize2(v);
        double dot = VelDot2(u, v);
        if (dot > -1.0001 && dot < -0.0009)
            return true;
    }
    return false;
}

bool VelPointOnSegment(const DorVector2& p, const DorVector2& a, const DorVector2& b)
{
    DorVector2 d = VelSub2(b, a);
    double lengthSquared = VelDot2(d, d);
    if (lengthSquared == 0.0)
        return false;
    double t = VelDot2(VelSub2(p, a), d) / lengthSquared;
    if (!(std::fabs(t) >= 1e-6 && std::fabs(1.0 - t) >= 1e-6 && t > 0.0 && t < 1.0))
        return false;
    DorVector2 foot(a.x + t * d.x, a.y + t * d.y);
    DorVector2 off = VelSub2(p, foot);
    return std::sqrt(VelDot2(off, off)) < 1e-6;
}
