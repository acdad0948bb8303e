#include "convert/vel_polygon_triangulation.h"

#include <vector>

#include "convert/vel_plane2d.h"
#include "model/dor_math.h"

namespace {
const int kAddedEdgeBudget = 100;

// Side marks of an edge: the triangle to the right of start->end, to its left, has been made.
const int kRightMade = 1;
const int kLeftMade = 2;

struct Edge {
    int start, end, sides;
};

class Triangulation {
public:
    Triangulation(const CDorPolygon& polygon, const DorVector3& normal);

    void AddOutlineEdges();
    void AddAdmissibleSegments();
    void CloseTrianglesOnAddedEdges();
    void EmitDistinct(CDorArray<int, int>& indices) const;

private:
    bool Admissible(int i, int j) const;
    bool CrossesListedEdge(int i, int j) const;
    bool PassesThroughPoint(int i, int j) const;
    int BestNeighbour(int c, int s, const DorVector2& u, bool clockwise) const;
    bool CloseTriangle(int a, int b, int x);
    void MarkSide(int edge, int a, int b, int x);
    int FindEdge(int p, int q) const;

    int n;
    std::vector<DorVector2> plane;  // n + 1 projected points, the last repeating point 0
    std::vector<Edge> edges;
    std::vector<int> candidates;  // three per triangle
};

Triangulation::Triangulation(const CDorPolygon& polygon, const DorVector3& normal)
    : n(polygon.points.GetSize()), plane(n + 1)
{
    DorMatrix4x4 projection = DorPlaneProjection(normal, polygon.points[0]);
    for (int k = 0; k < n; ++k) {
        DorVector3 p = DorTransformPoint(polygon.points[k], projection);
        plane[k] = DorVector2(p.x, p.y);
    }
    plane[n] = plane[0];
    edges.reserve(n + kAddedEdgeBudget);
}

void Triangulation::AddOutlineEdges()
{
    for (int i = 0; i < n; ++i)
        edges.push_back(Edge{i, i + 1 < n ? i + 1 : 0, 0});
}

// Every ordered pair is a candidate, so a diagonal enters twice, an outline edge may re-enter
// and a reflex point enters as a zero-length edge; all of them spend the budget.
void Triangulation::AddAdmissibleSegments()
{
    const int capacity = n + kAddedEdgeBudget;
    for (int i = 0; i < n; ++i) {
        for (int j = 0; j < n; ++j) {
            // Once full, every later candidate would be dropped: stop testing them.
            if (static_cast<int>(edges.size()) >= capacity)
                return;
            if (Admissible(i, j))
                edges.push_back(Edge{i, j, 0});
        }
    }
}

// The cheap tests first; all three must hold, so the order does not change the result.
bool Triangulation::Admissible(int i, int j) const
{
    if (CrossesListedEdge(i, j) || PassesThroughPoint(i, j))
        return false;
    DorVector2 mid = VelMidpoint2(plane[i], plane[j]);
    return VelWindingInside(VelWindingAngle(mid, plane.data(), n));
}

// The added edges are tried before the outline's: they are the ones that usually cross.
bool Triangulation::CrossesListedEdge(int i, int j) const
{
    const int count = static_cast<int>(edges.size());
    for (int k = n; k < count + n; ++k) {
        const Edge& e = edges[k < count ? k : k - count];
        if (e.start == i || e.start == j || e.end == i || e.end == j)
            continue;
        if (VelSegmentsCross(plane[i], plane[j], plane[e.start], plane[e.end]))
            return true;
    }
    return false;
}

bool Triangulation::PassesThroughPoint(int i, int j) const
{
    for (int k = 0; k < n; ++k) {
        if (k != i && k != j && VelPointOnSegment(plane[k], plane[i], plane[j]))
            return true;
    }
    return false;
}

// The other end of the edge at s whose direction is nearest to u on the wanted side of it,
// or -1. Among equals the earliest edge wins.
int Triangulation::BestNeighbour(int c, int s, const DorVector2& u, bool clockwise) const
{
    double best = -1024.0;
    int found = -1;
    for (int k = 0; k < static_cast<int>(edges.size()); ++k) {
        const Edge& e = edges[k];
        if (k == c || (e.start != s && e.end != s))
            continue;
        int x = e.start == s ? e.end : e.start;
        DorVector2 v = VelSub2(plane[x], plane[s]);
        VelNormalize2(v);
        double cross = VelCross2(u, v);
        if (clockwise ? !(cross < 0.0) : !(cross > 0.0))
            continue;
        double dot = VelDot2(u, v);
        if (dot > best) {
            best = dot;
            found = x;
        }
    }
    return found;
}

int Triangulation::FindEdge(int p, int q) const
{
    for (int k = 0; k < static_cast<int>(edges.size()); ++k) {
        const Edge& e = edges[k];
        if ((e.start == p && e.end == q) || (e.start == q && e.end == p))
            return k;
    }
    return -1;
}

// Marks the side of the edge on which the counter-clockwise triangle (a, b, x) lies: its left
// when the edge runs the way the triangle goes round, its right otherwise.
void Triangulation::MarkSide(int edge, int a, int b, int x)
{
    const Edge& e = edges[edge];
    bool alongTriangle = (e.start == a && e.end == b) || (e.start == b && e.end == x) || (e.start == x && e.end == a);
    edges[edge].sides |= alongTriangle ? kLeftMade : kRightMade;
}

// Marks the two closing edges of the counter-clockwise triangle (a, b, x) that the edge a-b
// opens; returns whether both exist.
bool Triangulation::CloseTriangle(int a, int b, int x)
{
    int toA = FindEdge(x, a);
    int toB = FindEdge(x, b);
    if (toA >= 0)
        MarkSide(toA, a, b, x);
    if (toB >= 0)
        MarkSide(toB, a, b, x);
    if (toA < 0 || toB < 0)
        return false;
    candidates.push_back(a);
    candidates.push_back(b);
    candidates.push_back(x);
    return true;
}

void Triangulation::CloseTrianglesOnAddedEdges()
{
    for (int c = n; c < static_cast<int>(edges.size()); ++c) {
        if (edges[c].sides == (kRightMade | kLeftMade))
            continue;
        int s = edges[c].start, e = edges[c].end;
        DorVector2 u = VelSub2(plane[e], plane[s]);
        VelNormalize2(u);
        if (!(edges[c].sides & kRightMade)) {
            int x = BestNeighbour(c, s, u, true);
            if (x >= 0 && CloseTriangle(e, s, x))
                edges[c].sides |= kRightMade;
        }
        if (!(edges[c].sides & kLeftMade)) {
            int x = BestNeighbour(c, s, u, false);
            if (x >= 0 && CloseTriangle(s, e, x))
                edges[c].sides |= kLeftMade;
        }
    }
}

// A triangle is a repeat when it equals an emitted one up to rotation; reversed is distinct.
void Triangulation::EmitDistinct(CDorArray<int, int>& indices) const
{
    for (size_t t = 0; t + 2 < candidates.size(); t += 3) {
        int a = candidates[t], b = candidates[t + 1], c = candidates[t + 2];
        bool repeat = false;
        for (int o = 0; o + 2 < indices.GetSize() && !repeat; o += 3) {
            int p = indices[o], q = indices[o + 1], r = indices[o + 2];
            repeat = (p == a && q == b && r == c) || (p == b && q == c && r == a) || (p == c && q == a && r == b);
        }
        if (repeat)
            continue;
        indices.Add(a);
        indices.Add(b);
        indices.Add(c);
    }
}
}  // namespace

void TriangulatePolygon(const CDorPolygon* polygon, CDorArray<int, int>& indices)
{
    if (!polygon)
        return;
    const int n = polygon->points.GetSize();
    DorVector3 normal = DorNewellNormal(polygon->points.GetData(), n);
    if (!DorNormalize(normal))
        return;
    indices.SetSize(0, -1);
    Triangulation triangulation(*polygon, normal);
    triangulation.AddOutlineEdges();
    triangulation.AddAdmissibleSegments();
    triangulation.CloseTrianglesOnAddedEdges();
    triangulation.EmitDistinct(indices);
}
