#include "convert/vel_polygon_triangulation.h"

#include <algorithm>
#include <vector>

#include "convert/vel_edge_graph.h"
#include "convert/vel_plane2d.h"
#include "model/dor_math.h"

namespace {
const int kAddedEdgeBudget = 100;

// The midpoint's inside verdicts by unordered pair, as many as fit, the latest kept: a pair's
// two orders share their midpoint ((a + b) * 0.5 is the same either way round), so a diagonal's
// second entry and an outline edge's other order need not go round the outline again.
class MidpointVerdicts {
public:
    explicit MidpointVerdicts(int n)
    {
        size_t size = 16;
        while (size < 4096 && size < 4 * static_cast<size_t>(n))
            size *= 2;
        slots.resize(size);
    }
    bool Known(int i, int j) { return Holds(SlotOf(i, j), i, j); }
    bool Inside(const VelEdgeGraph& graph, int i, int j)
    {
        Slot& slot = SlotOf(i, j);
        if (!Holds(slot, i, j)) {
            DorVector2 mid = VelMidpoint2(graph.plane[i], graph.plane[j]);
            slot = Slot{std::min(i, j), std::max(i, j), graph.InsideLoop(mid, 0)};
        }
        return slot.inside;
    }

private:
    struct Slot {
        int low = -1, high = -1;
        bool inside = false;
    };
    Slot& SlotOf(int i, int j)
    {
        return slots[(static_cast<size_t>(std::min(i, j)) * 31 + std::max(i, j)) & (slots.size() - 1)];
    }
    static bool Holds(const Slot& slot, int i, int j)
    {
        return slot.low == std::min(i, j) && slot.high == std::max(i, j);
    }
    std::vector<Slot> slots;
};

// All three tests must hold, so the order does not change the result: the cheap ones first,
// the midpoint's, which always goes round the whole outline, last, unless it is known already
// or the pair is an outline edge, whose midpoint is seldom inside.
bool Admissible(const VelEdgeGraph& graph, MidpointVerdicts& verdicts, int i, int j, int n)
{
    if (graph.CrossesRecentlyCrossed(i, j))
        return false;
    const bool alongOutline = j == (i + 1) % n || i == (j + 1) % n;
    if ((alongOutline || verdicts.Known(i, j)) && !verdicts.Inside(graph, i, j))
        return false;
    return !graph.Blocked(i, j) && verdicts.Inside(graph, i, j);
}

// Every ordered pair is a candidate, so a diagonal enters twice, an outline edge may re-enter
// and a reflex point enters as a zero-length edge; all of them spend the budget.
void AddAdmissibleSegments(VelEdgeGraph& graph, int n)
{
    MidpointVerdicts verdicts(n);
    for (int i = 0; i < n; ++i) {
        for (int j = 0; j < n; ++j) {
            // Once full, every later candidate would be dropped: stop testing them.
            if (!graph.HasRoom())
                return;
            if (Admissible(graph, verdicts, i, j, n))
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
