#pragma once
// Plane geometry shared by both triangulations. They work on outlines already projected into
// their own plane (x, y of the plane projection), where counter-clockwise is positive.
#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

#include "model/dor_types.h"

inline double VelCross2(const DorVector2& a, const DorVector2& b) { return a.x * b.y - a.y * b.x; }
inline double VelDot2(const DorVector2& a, const DorVector2& b) { return a.x * b.x + a.y * b.y; }
inline DorVector2 VelSub2(const DorVector2& a, const DorVector2& b) { return DorVector2(a.x - b.x, a.y - b.y); }
inline DorVector2 VelMidpoint2(const DorVector2& a, const DorVector2& b)
{
    return DorVector2((a.x + b.x) * 0.5, (a.y + b.y) * 0.5);
}

// Divides v by its length when that is at least 0.0001.
void VelNormalize2(DorVector2& v);

// The determinant and the numerators of s and t in p0 + s d = a0 + t e.
struct VelCrossingTerms {
    double det, sNum, tNum;
    VelCrossingTerms(const DorVector2& p0, const DorVector2& d, const DorVector2& a0, const DorVector2& e)
    {
        det = VelCross2(e, d);
        DorVector2 w = VelSub2(a0, p0);
        sNum = VelCross2(e, w);
        tNum = VelCross2(d, w);
    }
    // A quotient lies in (0, 1) only when its numerator is smaller than det: without this, the
    // segments do not cross. Also false for det = 0 and for NaN, as the quotients would be.
    bool MayCross() const { return std::fabs(sNum) < std::fabs(det) && std::fabs(tNum) < std::fabs(det); }
};

// Whether segment p0 to p0 + d crosses segment a0 to a0 + e at a point strictly inside both.
// Parallel segments (cross product exactly 0) never cross. Inline: the triangulations call it
// for every candidate against every listed edge.
inline bool VelSegmentsCrossAlong(const DorVector2& p0, const DorVector2& d, const DorVector2& a0, const DorVector2& e)
{
    VelCrossingTerms terms(p0, d, a0, e);
    if (!terms.MayCross())
        return false;  // most edges are settled without dividing
    double s = terms.sNum / terms.det, t = terms.tNum / terms.det;
    return s > 0.0 && s < 1.0 && t > 0.0 && t < 1.0;
}

// The signed angle that the closed loop[0..count-1] subtends at q, summed edge by edge with
// atan2(cross, dot). An edge with an end exactly on q (cross and dot both 0) adds nothing.
// About +-2 pi inside, about 0 outside.
double VelWindingAngle(const DorVector2& q, const DorVector2* loop, int count);

// Bounds of a few points; empty at first. The bounds leave out NaN: finite tells.
struct VelBox {
    double minX = std::numeric_limits<double>::infinity(), minY = minX, maxX = -minX, maxY = -minX;
    bool finite = true;  // whether every point is
    void Grow(const DorVector2& p)
    {
        finite = finite && std::isfinite(p.x) && std::isfinite(p.y);
        minX = std::min(minX, p.x);
        minY = std::min(minY, p.y);
        maxX = std::max(maxX, p.x);
        maxY = std::max(maxY, p.y);
    }
    void Grow(const VelBox& box)
    {
        finite = finite && box.finite;
        minX = std::min(minX, box.minX);
        minY = std::min(minY, box.minY);
        maxX = std::max(maxX, box.maxX);
        maxY = std::max(maxY, box.maxY);
    }
    // The least and the most of c.x (x - a.x) + c.y (y - a.y) over the box, each rounded in
    // five operations: within 6 ulps of 2 (|c.x| + |c.y|) m, m the largest coordinate magnitude
    // of the box and a. Inline: the searches call it for every block.
    void Extremes(const DorVector2& a, const DorVector2& c, double& least, double& most) const
    {
        bool xUp = c.x >= 0.0, yUp = c.y >= 0.0;
        least = c.x * ((xUp ? minX : maxX) - a.x) + c.y * ((yUp ? minY : maxY) - a.y);
        most = c.x * ((xUp ? maxX : minX) - a.x) + c.y * ((yUp ? maxY : minY) - a.y);
    }
};

// A run of consecutive points of a loop, first..end-1 counted from the loop's first point,
// and their bounds.
struct VelRun {
    int first, end;
    VelBox box;
};

// A loop's edges (edge k from point k to the next) listed under each band of y that their ends
// span, the bands cut evenly over the loop's bounds: a horizontal line through a point meets only
// the edges of the point's band, and every other edge lies strictly above or below the point.
// Empty for a loop too small to pay for it, for one whose edges would be listed over 16 times
// over on average, and out of the range where that holds by a margin.
class VelLoopBands {
public:
    static constexpr int kLeastPoints = 16;  // below, going round the loop costs less

    VelLoopBands() = default;
    VelLoopBands(const DorVector2* loop, int count, const VelBox& bounds);
    bool Empty() const { return bandCount == 0; }
    // Whether the bands cover y: false when empty, or when y lies too near 0 for the margin.
    bool Covers(double y) const;
    // The edges listed under y's band, by number: [first, last).
    void EdgesNear(double y, const int*& first, const int*& last) const;

private:
    int Band(double y) const;
    double low = 0.0, scale = 0.0;
    int bandCount = 0;
    std::vector<int> starts, edges;  // band b's edges are edges[starts[b]..starts[b + 1])
};

// Whether a winding sum puts its point inside: |sum| > pi.
bool VelWindingInside(double angleSum);

// VelWindingInside(VelWindingAngle(q, loop, count)), without the angles wherever the winding
// number alone provably gives the same answer. The loop is cut into runs, in order and covering
// it (or runs is null): the edges within a run whose bounds keep clear of the count's ray and its
// line are settled together. A q clear of the whole loop's bounds (null for unknown) is outside.
// Bands (null or empty for none, the loop's own, its bounds given) leave out every edge away
// from the ray's line at once.
bool VelInsideLoop(const DorVector2& q, const DorVector2* loop, int count, const VelRun* runs, int runCount,
                   const VelBox* bounds, const VelLoopBands* bands);

// Whether q lies on an edge of the closed loop[0..count-1], loosely: the cross product of the
// vectors from q to the edge's ends is below 0.0001 in magnitude and, once both are normalised,
// their dot product lies between -1.0001 and -0.0009.
bool VelOnLoopEdge(const DorVector2& q, const DorVector2* loop, int count);

// Whether p lies on segment a-b strictly between its ends: its parameter t along a-b satisfies
// 0 < t < 1 and is at least 1e-6 from both ends, and its distance from the segment is below
// 1e-6. A zero-length segment holds no point.
bool VelPointOnSegment(const DorVector2& p, const DorVector2& a, const DorVector2& b);
