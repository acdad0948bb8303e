#include "convert/vel_edge_graph.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "convert/vel_plane2d.h"
#include "model/dor_math.h"

namespace {
const int kRightMade = 1;
const int kLeftMade = 2;
}  // namespace

VelEdgeGraph::VelEdgeGraph(int pointCount, int maxEdges_) : maxEdges(maxEdges_)
{
    recentlyCrossed.fill(-1);
    plane.reserve(pointCount > 0 ? pointCount : 0);
    edges.reserve(maxEdges > 0 ? maxEdges : 0);
    // The loops' own edges, one per point, come before the budget is checked.
    const size_t room = (static_cast<size_t>(std::max({maxEdges, pointCount, 1})) + kBlock - 1) / kBlock * kBlock;
    columns.reset(new double[9 * room]);
    double** column[] = {&fromX, &fromY, &alongX, &alongY, &seenAlongX, &seenAlongY, &seenFromX, &seenFromY, &seenSNum};
    for (size_t c = 0; c < 9; ++c)
        *column[c] = columns.get() + c * room;
    units.reserve(maxEdges > 0 ? maxEdges : 0);
    blocks.reserve(maxEdges > 0 ? maxEdges / kBlock + 1 : 1);
}

void VelEdgeGraph::AddProjectedPoints(const DorVector3* points, int count, const DorMatrix4x4& projection)
{
    loopStarts.push_back(LoopStart{static_cast<int>(plane.size()), static_cast<int>(runs.size()), VelBox(), -1});
    for (int k = 0; k < count; ++k) {
        DorVector3 p = DorTransformPoint(points[k], projection);
        if (k % kBlock == 0)
            runs.push_back(VelRun{k, k, VelBox()});
        if (plane.size() % (kBlock * kGroup) == 0)
            pointGroups.push_back(VelBox());
        if (plane.size() % kBlock == 0)
            pointBlocks.push_back(VelBox());
        plane.push_back(DorVector2(p.x, p.y));
        pointBlocks.back().Grow(plane.back());
        pointGroups.back().Grow(plane.back());
        runs.back().end = k + 1;
        runs.back().box.Grow(plane.back());
        loopStarts.back().box.Grow(plane.back());
        finite = finite && std::isfinite(p.x) && std::isfinite(p.y);
        extent = std::max(extent, std::max(std::fabs(p.x), std::fabs(p.y)));
    }
    LoopStart& loop = loopStarts.back();
    if (count < VelLoopBands::kLeastPoints)
        return;
    VelLoopBands bands(plane.data() + loop.point, count, loop.box);
    if (!bands.Empty()) {
        loop.bands = static_cast<int>(loopBands.size());
        loopBands.push_back(std::move(bands));
    }
}

void VelEdgeGraph::AddSegment(int start, int end)
{
    edges.push_back(Edge{start, end, 0});
    const size_t at = edges.size() - 1;
    if (at % kBlock == 0) {  // a new block of zero-length edges at 0, which cross nothing
        for (double* column : {fromX, fromY, alongX, alongY})
            std::fill(column + at, column + at + kBlock, 0.0);
        blocks.push_back(Block{VelBox(), start, end, -1});
    }
    Block& block = blocks.back();
    block.box.Grow(plane[start]);
    block.box.Grow(plane[end]);
    for (int* v : {&block.a, &block.b}) {
        if (*v != start && *v != end)
            *v = -1;
    }
    block.seenFrom = -1;
    if ((at + 1) % (kBlock * kGroup) == 0) {  // a group's last edge: its blocks are complete
        edgeGroups.push_back(VelBox());
        for (size_t b = blocks.size() - kGroup; b < blocks.size(); ++b)
            edgeGroups.back().Grow(blocks[b].box);
    }
    DorVector2 unit = VelSub2(plane[end], plane[start]);
    fromX[at] = plane[start].x;
    fromY[at] = plane[start].y;
    alongX[at] = unit.x;
    alongY[at] = unit.y;
    VelNormalize2(unit);
    units.push_back(unit);
}

void VelEdgeGraph::AddLoopEdges(int first, int count)
{
    for (int k = 0; k < count; ++k)
        AddSegment(first + k, first + (k + 1 < count ? k + 1 : 0));
    loopEdgeCount = static_cast<int>(edges.size());
}

// Whether segment from-from+along crosses edge at, which has neither i nor j as an end.
inline bool VelEdgeGraph::CrossesEdge(const DorVector2& from, const DorVector2& along, int i, int j, int at) const
{
    const Edge& e = edges[at];
    return VelSegmentsCrossAlong(from, along, DorVector2(fromX[at], fromY[at]), DorVector2(alongX[at], alongY[at])) &&
           e.start != i && e.start != j && e.end != i && e.end != j;
}

bool VelEdgeGraph::CrossesRecentlyCrossed(int i, int j) const
{
    const DorVector2 from = plane[i], along = VelSub2(plane[j], from);
    for (int at : recentlyCrossed) {
        if (at >= 0 && CrossesEdge(from, along, i, j, at))
            return true;
    }
    return false;
}

// Whether the answer is yes does not depend on the order the edges are tried in. The edge that
// crossed the last crossing candidate is tried first. Then the edges go by blocks, each
// screened at once (side by side, without branches) by the test's own first stage; only a block
// with an edge that may cross is gone through one edge at a time.
bool VelEdgeGraph::CrossesListedEdge(int i, int j) const
{
    const DorVector2 from = plane[i], along = VelSub2(plane[j], from);
    if (along.x == 0.0 && along.y == 0.0)
        return false;  // every determinant would be 0 (or NaN)
    const int count = static_cast<int>(edges.size());
    // A block whose points all lie on one side of the segment's line, farther from it than the
    // rounding of the test (below 30 ulps of |along.x| + |along.y| times the extent), holds no
    // crossing edge: for each of its edges t's numerator keeps that side's sign and t's
    // denominator minus its numerator the other, so t is outside (0, 1).
    const double reach = std::fabs(along.x) + std::fabs(along.y);
    const bool boxes = finite && extent < 1e150 && reach * extent > 1e-200;
    const double margin = 1e-14 * reach * extent;
    auto oneSide = [&](const VelBox& box) {
        double least, most;  // of cross(along, p - from)
        box.Extremes(from, DorVector2(-along.y, along.x), least, most);
        return least > margin || most < -margin;
    };
    // Among a few groups, each spans so much of the outline that it seldom keeps clear of a segment.
    const bool groups = boxes && count >= 4 * kBlock * kGroup;
    for (int block = 0; block < count; block += kBlock) {
        // A whole group first, where there is one, as in the point search.
        if (groups && block % (kBlock * kGroup) == 0 && block + kBlock * kGroup <= count &&
            oneSide(edgeGroups[block / (kBlock * kGroup)])) {
            block += kBlock * (kGroup - 1);
            continue;
        }
        const Block& ends = blocks[block / kBlock];
        if (ends.a == i || ends.a == j || ends.b == i || ends.b == j)
            continue;  // every edge of the block has i or j as an end
        if (boxes && oneSide(ends.box))
            continue;
        if (ends.seenFrom != i)
            SeeBlockFrom(block, i);
        // Both quotients lie in (0, 1) only where both numerators are smaller than det and of its
        // sign: so here, with every term times the sign of s's numerator (exact, as that only
        // flips signs).
        bool may = false;
        for (int at = block; at < block + kBlock; ++at) {
            double det = seenAlongX[at] * along.y - seenAlongY[at] * along.x;
            double tNum = along.x * seenFromY[at] - along.y * seenFromX[at];
            may |= (det > seenSNum[at]) & (tNum > 0.0) & (tNum < det);
        }
        if (!may)
            continue;
        for (int at = block; at < std::min(block + kBlock, count); ++at) {
            if (CrossesEdge(from, along, i, j, at)) {
                std::rotate(recentlyCrossed.begin(), recentlyCrossed.end() - 1, recentlyCrossed.end());
                recentlyCrossed[0] = at;
                return true;
            }
        }
    }
    return false;
}

void VelEdgeGraph::SeeBlockFrom(int block, int i) const
{
    blocks[block / kBlock].seenFrom = i;
    for (int at = block; at < block + kBlock; ++at) {
        const DorVector2 along(alongX[at], alongY[at]), from = VelSub2(DorVector2(fromX[at], fromY[at]), plane[i]);
        const double sNum = VelCross2(along, from), sign = sNum < 0.0 ? -1.0 : 1.0;
        seenAlongX[at] = sign * along.x;
        seenAlongY[at] = sign * along.y;
        seenFromX[at] = sign * from.x;
        seenFromY[at] = sign * from.y;
        seenSNum[at] = sNum != 0.0 && !std::isnan(sNum) ? std::fabs(sNum) : std::numeric_limits<double>::infinity();
    }
}

bool VelEdgeGraph::PassesThroughRecentPoint(int i, int j) const
{
    return recentPoint >= 0 && recentPoint != i && recentPoint != j &&
           VelPointOnSegment(plane[recentPoint], plane[i], plane[j]);
}

// A point is looked at closely only when it lies across the segment's slab and near its line:
// there the rounding of the foot and the distance is below 1e-14 of the extent, so a point
// farther than 1e-6 plus that from the line is never taken to be on it.
bool VelEdgeGraph::PassesThroughPoint(int i, int j) const
{
    const DorVector2 a = plane[i], d = VelSub2(plane[j], a);
    const double lengthSquared = VelDot2(d, d);
    if (lengthSquared == 0.0)
        return false;  // a zero-length segment holds no point
    const int count = static_cast<int>(plane.size());
    auto onSegment = [&](int k) {
        const bool on = k != i && k != j && VelPointOnSegment(plane[k], a, plane[j]);
        if (on)
            recentPoint = k;
        return on;
    };
    if (!(finite && extent < 1e150 && lengthSquared > 1e-200)) {
        for (int k = 0; k < count; ++k) {
            if (onSegment(k))
                return true;
        }
        return false;
    }
    const double reach = 1.000001e-6 + 1e-14 * extent, reachSquared = reach * reach * 1.000001;
    // A block of points all beyond an end of the slab, or farther than reach from the line, by
    // more than the rounding of the screen below and of the extremes, holds no point near.
    const double margin = 1e-14 * (std::fabs(d.x) + std::fabs(d.y)) * extent;
    const double farAcross = reach * 1.000001 * std::sqrt(lengthSquared) + margin;
    auto away = [&](const VelBox& box) {
        double least, most;
        box.Extremes(a, d, least, most);  // of along
        if (most < -margin || least > lengthSquared + margin)
            return true;
        box.Extremes(a, DorVector2(-d.y, d.x), least, most);  // of -across
        return least > farAcross || most < -farAcross;
    };
    // Across the slab (t = along / lengthSquared in (0, 1)) and near the line; i and j never are.
    auto near = [&](int k) {
        DorVector2 w = VelSub2(plane[k], a);
        double along = VelDot2(w, d), across = VelCross2(w, d);
        return (along > 0.0) & (along < lengthSquared) & !(across * across > reachSquared * lengthSquared);
    };
    // By groups and blocks, each block screened without branches, as in the crossing search.
    for (int first = 0; first < count; first += kBlock) {
        // A whole group first, where there is one: a part of one holds too few points to pay.
        if (first % (kBlock * kGroup) == 0 && first + kBlock * kGroup <= count &&
            away(pointGroups[first / (kBlock * kGroup)])) {
            first += kBlock * (kGroup - 1);
            continue;
        }
        if (away(pointBlocks[first / kBlock]))
            continue;
        const int end = std::min(first + kBlock, count);
        bool any = end - first < kBlock;
        if (!any) {
            for (int k = first; k < first + kBlock; ++k)
                any |= near(k);
        }
        if (!any)
            continue;
        for (int k = first; k < end; ++k) {
            if (near(k) && onSegment(k))
                return true;
        }
    }
    return false;
}

bool VelEdgeGraph::Blocked(int i, int j) const
{
    if (PassesThroughRecentPoint(i, j))
        return true;
    if (pointsFirst ? PassesThroughPoint(i, j) : CrossesListedEdge(i, j))
        return true;
    if (pointsFirst ? CrossesListedEdge(i, j) : PassesThroughPoint(i, j)) {
        pointsFirst = !pointsFirst;
        return true;
    }
    return false;
}

bool VelEdgeGraph::InsideLoop(const DorVector2& q, int loop) const
{
    const LoopStart& start = loopStarts[loop];
    const bool last = loop + 1 == static_cast<int>(loopStarts.size());
    const int end = last ? static_cast<int>(plane.size()) : loopStarts[loop + 1].point;
    const int endRun = last ? static_cast<int>(runs.size()) : loopStarts[loop + 1].run;
    return VelInsideLoop(q, plane.data() + start.point, end - start.point, runs.data() + start.run, endRun - start.run,
                         &start.box, start.bands >= 0 ? &loopBands[start.bands] : nullptr);
}

// A counting sort of the edges by their ends, in list order within each point: each point's
// count summed up to it gives where its list ends, and the edges, last to first, fill it from there.
void VelEdgeGraph::ListEdgesAtPoints()
{
    const int n = static_cast<int>(plane.size());
    edgesAtStart.assign(n + 1, 0);
    for (const Edge& e : edges) {
        ++edgesAtStart[e.start];
        if (e.end != e.start)
            ++edgesAtStart[e.end];
    }
    int total = 0;
    for (int& end : edgesAtStart)
        end = total += end;
    edgesAt.resize(total);
    for (int k = static_cast<int>(edges.size()) - 1; k >= 0; --k) {
        const Edge& e = edges[k];
        // From the end, the negated unit: the same numbers as normalising P_start - P_end.
        edgesAt[--edgesAtStart[e.start]] = EdgeAt{k, e.end, units[k]};
        if (e.end != e.start)
            edgesAt[--edgesAtStart[e.end]] = EdgeAt{k, e.start, DorVector2(-units[k].x, -units[k].y)};
    }
}

// The other end of the edge at s whose direction is nearest to u on the wanted side of it,
// or -1. Among equals the earliest edge wins.
int VelEdgeGraph::BestNeighbour(int c, int s, const DorVector2& u, bool clockwise) const
{
    double best = -1024.0;
    int found = -1;
    for (int at = edgesAtStart[s]; at < edgesAtStart[s + 1]; ++at) {
        const EdgeAt& near = edgesAt[at];
        if (near.edge == c)
            continue;
        double cross = VelCross2(u, near.unit);
        if (clockwise ? !(cross < 0.0) : !(cross > 0.0))
            continue;
        double dot = VelDot2(u, near.unit);
        if (dot > best) {
            best = dot;
            found = near.other;
        }
    }
    return found;
}

// The earliest edge between p and q, or -1: the first one in either point's list.
int VelEdgeGraph::FindEdge(int p, int q) const
{
    if (edgesAtStart[p + 1] - edgesAtStart[p] > edgesAtStart[q + 1] - edgesAtStart[q])
        std::swap(p, q);
    for (int at = edgesAtStart[p]; at < edgesAtStart[p + 1]; ++at) {
        if (edgesAt[at].other == q)
            return edgesAt[at].edge;
    }
    return -1;
}

// Marks the side of the edge on which the counter-clockwise triangle (a, b, x) lies: its left
// when the edge runs the way the triangle goes round, its right otherwise.
void VelEdgeGraph::MarkSide(int edge, int a, int b, int x)
{
    const Edge& e = edges[edge];
    bool alongTriangle = (e.start == a && e.end == b) || (e.start == b && e.end == x) || (e.start == x && e.end == a);
    edges[edge].sides |= alongTriangle ? kLeftMade : kRightMade;
}

// Marks the two closing edges of the counter-clockwise triangle (a, b, x) that the edge a-b
// opens; returns whether both exist.
bool VelEdgeGraph::CloseTriangle(int a, int b, int x)
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

void VelEdgeGraph::CloseTrianglesOnAddedEdges(bool finishOnOpenRight)
{
    ListEdgesAtPoints();
    candidates.reserve(6 * (edges.size() - loopEdgeCount));  // at most two triangles an edge
    for (int c = loopEdgeCount; c < static_cast<int>(edges.size()); ++c) {
        if (edges[c].sides == (kRightMade | kLeftMade))
            continue;
        int s = edges[c].start, e = edges[c].end;
        const DorVector2 u = units[c];
        if (!(edges[c].sides & kRightMade)) {
            int x = BestNeighbour(c, s, u, true);
            if (x >= 0) {
                if (CloseTriangle(e, s, x))
                    edges[c].sides |= kRightMade;
                else if (finishOnOpenRight)
                    continue;
            }
        }
        if (!(edges[c].sides & kLeftMade)) {
            int x = BestNeighbour(c, s, u, false);
            if (x >= 0 && CloseTriangle(s, e, x))
                edges[c].sides |= kLeftMade;
        }
    }
}

bool VelEdgeGraph::IsSliver(int a, int b, int c) const
{
    double twiceArea = VelCross2(VelSub2(plane[b], plane[a]), VelSub2(plane[c], plane[a]));
    return std::sqrt(std::fabs(twiceArea)) <= 1e-5;
}

namespace {
// The rotation of a triangle that comes first in index order: equal for triangles equal up to
// rotation.
std::array<int, 3> LeastRotation(int a, int b, int c)
{
    return std::min({std::array<int, 3>{a, b, c}, std::array<int, 3>{b, c, a}, std::array<int, 3>{c, a, b}});
}

size_t Hash(const std::array<int, 3>& t)
{
    return static_cast<size_t>(t[0]) * 73856093u ^ static_cast<size_t>(t[1]) * 19349663u ^
           static_cast<size_t>(t[2]) * 83492791u;
}
}  // namespace

// The triangles already in indices, then each one appended, go into an open-addressed table of
// their positions, by least rotation: a repeat is found without going through them all.
void VelEdgeGraph::EmitDistinct(CDorArray<int, int>& indices, bool dropSlivers) const
{
    size_t size = 16;
    while (size < 2 * static_cast<size_t>(indices.GetSize()) + candidates.size())
        size *= 2;
    std::vector<int> table(size, -1);
    // The slot of t's position if t is there, else the free slot where it would go.
    auto slotOf = [&](const std::array<int, 3>& t) {
        size_t h = Hash(t) & (size - 1);
        for (; table[h] >= 0; h = (h + 1) & (size - 1)) {
            const int o = table[h];
            if (LeastRotation(indices[o], indices[o + 1], indices[o + 2]) == t)
                break;
        }
        return h;
    };
    for (int o = 0; o + 2 < indices.GetSize(); o += 3) {
        size_t h = slotOf(LeastRotation(indices[o], indices[o + 1], indices[o + 2]));
        if (table[h] < 0)
            table[h] = o;
    }
    for (size_t t = 0; t + 2 < candidates.size(); t += 3) {
        int a = candidates[t], b = candidates[t + 1], c = candidates[t + 2];
        size_t h = slotOf(LeastRotation(a, b, c));
        if (table[h] >= 0 || (dropSlivers && IsSliver(a, b, c)))
            continue;
        table[h] = indices.GetSize();
        indices.Add(a);
        indices.Add(b);
        indices.Add(c);
    }
}
