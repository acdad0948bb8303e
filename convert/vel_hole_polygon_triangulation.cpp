#include <vector>

#include "convert/vel_edge_graph.h"
#include "convert/vel_hole_polygon_to_primitive.h"
#include "convert/vel_plane2d.h"
#include "model/dor_math.h"

namespace {
// The table holds N + 100 edges and a diagonal is admitted only while two slots stay free, so
// the last slot is never filled: hosts' meshes depend on exactly where the budget runs out.
const int kEdgeSlack = 100 - 1;

struct Loop {
    int first, count;
};

class HoledTriangulation {
public:
    HoledTriangulation(const CDorHolePolygon& shape, const DorMatrix4x4& projection);

    void AddDiagonals();
    VelEdgeGraph graph;

private:
    bool Admissible(int i, int j) const;
    bool MidpointInMaterial(const DorVector2& mid) const;
    bool ClosesLoop(int i, int j) const;

    std::vector<Loop> loops;  // the outline, then each hole
    std::vector<int> loopOf;  // per vertex
};

int VertexCount(const CDorHolePolygon& shape)
{
    int count = shape.points.GetSize();
    for (int h = 0; h < shape.holes.GetSize(); ++h)
        count += shape.holes[h].points.GetSize();
    return count;
}

HoledTriangulation::HoledTriangulation(const CDorHolePolygon& shape, const DorMatrix4x4& projection)
    : graph(VertexCount(shape), VertexCount(shape) + kEdgeSlack)
{
    loops.push_back(Loop{0, shape.points.GetSize()});
    graph.AddProjectedPoints(shape.points.GetData(), shape.points.GetSize(), projection);
    for (int h = 0; h < shape.holes.GetSize(); ++h) {
        const CDorArray<DorVector3, DorVector3&>& hole = shape.holes[h].points;
        loops.push_back(Loop{static_cast<int>(graph.plane.size()), hole.GetSize()});
        graph.AddProjectedPoints(hole.GetData(), hole.GetSize(), projection);
    }
    for (int l = 0; l < static_cast<int>(loops.size()); ++l) {
        loopOf.insert(loopOf.end(), loops[l].count, l);
        graph.AddLoopEdges(loops[l].first, loops[l].count);
    }
}

// A pair of a loop's first and last vertex is that loop's closing edge.
bool HoledTriangulation::ClosesLoop(int i, int j) const
{
    const Loop& loop = loops[loopOf[i]];
    return loopOf[i] == loopOf[j] && i == loop.first && j == loop.first + loop.count - 1;
}

// Inside the outline (its edge counts as inside) and in no hole (a hole's edge counts as
// outside it).
bool HoledTriangulation::MidpointInMaterial(const DorVector2& mid) const
{
    const DorVector2* plane = graph.plane.data();
    const Loop& outline = loops[0];
    if (!graph.InsideLoop(mid, 0) && !VelOnLoopEdge(mid, plane + outline.first, outline.count))
        return false;
    for (size_t h = 1; h < loops.size(); ++h) {
        const DorVector2* hole = plane + loops[h].first;
        if (graph.InsideLoop(mid, static_cast<int>(h)) && !VelOnLoopEdge(mid, hole, loops[h].count))
            return false;
    }
    return true;
}

// All tests must hold, so the order does not change the result: the cheap ones first, the
// midpoint, tested against every loop, last.
bool HoledTriangulation::Admissible(int i, int j) const
{
    if (ClosesLoop(i, j) || graph.CrossesRecentlyCrossed(i, j) || graph.Blocked(i, j))
        return false;
    return MidpointInMaterial(VelMidpoint2(graph.plane[i], graph.plane[j]));
}

// Unordered pairs, a vertex's successor in its own loop skipped: each diagonal enters once and
// no loop edge re-enters.
void HoledTriangulation::AddDiagonals()
{
    const int n = static_cast<int>(graph.plane.size());
    for (int i = 0; i < n; ++i) {
        int j = i + 1 < n && loopOf[i + 1] == loopOf[i] ? i + 2 : i + 1;
        for (; j < n; ++j) {
            // Once full, every later diagonal would be dropped: stop testing them.
            if (!graph.HasRoom())
                return;
            if (Admissible(i, j))
                graph.AddSegment(i, j);
        }
    }
}
}  // namespace

void CVelHolePolygonToPrimitive::TriangulateHolePolygon(const CDorHolePolygon* shape,
                                                        CDorArray<DorVector3, DorVector3&>& vertices,
                                                        CDorArray<int, int>& indices)
{
    indices.SetSize(0, -1);
    if (!shape)
        return;
    vertices.SetSize(VertexCount(*shape), -1);
    int at = 0;
    for (int k = 0; k < shape->points.GetSize(); ++k)
        vertices[at++] = shape->points[k];
    for (int h = 0; h < shape->holes.GetSize(); ++h) {
        for (int k = 0; k < shape->holes[h].points.GetSize(); ++k)
            vertices[at++] = shape->holes[h].points[k];
    }

    DorVector3 normal = DorNewellNormal(shape->points.GetData(), shape->points.GetSize());
    if (!DorNormalize(normal))
        return;
    HoledTriangulation triangulation(*shape, DorPlaneProjection(normal, shape->points[0]));
    triangulation.AddDiagonals();
    triangulation.graph.CloseTrianglesOnAddedEdges(true);
    triangulation.graph.EmitDistinct(indices, true);
}
