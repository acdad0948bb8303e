#include "convert/vel_polygon_triangulation.h"

#include "convert/vel_edge_graph.h"
#include "convert/vel_plane2d.h"
#include "model/dor_math.h"

namespace {
const int kAddedEdgeBudget = 100;

// All three tests must hold, so the order does not change the result: the cheap ones first,
// the midpoint's, which always goes round the whole outline, last.
bool Admissible(const VelEdgeGraph& graph, int i, int j)
{
    if (graph.CrossesRecentlyCrossed(i, j) || graph.PassesThroughPoint(i, j) || graph.CrossesListedEdge(i, j))
        return false;
    DorVector2 mid = VelMidpoint2(graph.plane[i], graph.plane[j]);
    return graph.InsideLoop(mid, 0, static_cast<int>(graph.plane.size()));
}

// Every ordered pair is a candidate, so a diagonal enters twice, an outline edge may re-enter
// and a reflex point enters as a zero-length edge; all of them spend the budget.
void AddAdmissibleSegments(VelEdgeGraph& graph, int n)
{
    for (int i = 0; i < n; ++i) {
        for (int j = 0; j < n; ++j) {
            // Once full, every later candidate would be dropped: stop testing them.
            if (!graph.HasRoom())
                return;
            if (Admissible(graph, i, j))
                graph.AddSegment(i, j);
        }
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
    VelEdgeGraph graph(n, n + kAddedEdgeBudget);
    graph.AddProjectedPoints(polygon->points.GetData(), n, DorPlaneProjection(normal, polygon->points[0]));
    graph.AddLoopEdges(0, n);
    AddAdmissibleSegments(graph, n);
    graph.CloseTrianglesOnAddedEdges(false);
    graph.EmitDistinct(indices, false);
}
