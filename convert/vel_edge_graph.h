#pragma once
// The edge list shared by both triangulations (internal, not exported). Points are projected
// into their plane first; the list starts with the loops' own edges, admissible segments are
// appended after them, and a triangle is closed on each side of every appended edge.
//
// Side marks: bit 1, the triangle to the right of start->end has been made; bit 2, the one to
// its left. Every closed triangle is counter-clockwise in the plane.
#include <array>
#include <memory>
#include <vector>

#include "convert/vel_plane2d.h"
#include "model/dor_types.h"

class VelEdgeGraph {
public:
    // Room for at most maxEdges edges, loops' own included.
    VelEdgeGraph(int pointCount, int maxEdges);

    // Projects points[0..count-1] by projection and appends their x, y.
    void AddProjectedPoints(const DorVector3* points, int count, const DorMatrix4x4& projection);
    // The closed loop of points first..first+count-1, each point joined to the next.
    void AddLoopEdges(int first, int count);

    bool HasRoom() const { return static_cast<int>(edges.size()) < maxEdges; }
    void AddSegment(int start, int end);

    // Whether segment i-j crosses a listed edge that has neither i nor j as an end, or some point
    // other than i and j lies on it.
    bool Blocked(int i, int j) const;
    // Whether it crosses one of the few edges that crossed the last crossing segments: the next
    // pairs in the search usually cross them too, so they are worth a look before dearer tests.
    bool CrossesRecentlyCrossed(int i, int j) const;
    // VelInsideLoop for the points added by the loop-th AddProjectedPoints, counted from 0.
    bool InsideLoop(const DorVector2& q, int loop) const;

    // Closes the triangles on each side of every appended edge, first to last. With
    // finishOnOpenRight, an edge whose right triangle has a neighbour but lacks a closing edge
    // is left without its left triangle too.
    void CloseTrianglesOnAddedEdges(bool finishOnOpenRight);
    // Appends the closed triangles to indices, leaving out repeats (equal up to rotation; a
    // reversed triangle is distinct) and, with dropSlivers, triangles whose root of twice the
    // area is at most 1e-5.
    void EmitDistinct(CDorArray<int, int>& indices, bool dropSlivers) const;

    std::vector<DorVector2> plane;

private:
    struct Edge {
        int start, end, sides;
    };
    static constexpr int kBlock = 8;  // edges or points screened together
    static constexpr int kGroup = 8;  // blocks passed over together
    static constexpr int kRecent = 8;

    // Blocked's two searches, and the point last found on a segment, which along a straight wall
    // the next pairs usually pass through too. Of the two searches, the one that said yes last
    // goes first: combs and walls of many points reject runs of pairs by their points, which
    // cross nothing, and a field of holes rejects them by its edges.
    bool CrossesListedEdge(int i, int j) const;
    bool PassesThroughPoint(int i, int j) const;
    bool PassesThroughRecentPoint(int i, int j) const;
    bool CrossesEdge(const DorVector2& from, const DorVector2& along, int i, int j, int at) const;
    void ListEdgesAtPoints();
    int BestNeighbour(int c, int s, const DorVector2& u, bool clockwise) const;
    bool CloseTriangle(int a, int b, int x);
    void MarkSide(int edge, int a, int b, int x);
    int FindEdge(int p, int q) const;
    bool IsSliver(int a, int b, int c) const;

    int maxEdges;
    int loopEdgeCount = 0;
    std::vector<Edge> edges;
    // Nine columns of room for maxEdges padded to whole blocks, in one allocation, each filled a
    // block at a time.
    std::unique_ptr<double[]> columns;
    // Per edge: its start and its end minus its start, as the crossing test forms them.
    double *fromX, *fromY, *alongX, *alongY;
    // Per edge, the crossing test's terms that depend only on the segment's start, worked out
    // a block at a time for the start that asks: the edge's direction and its start seen from
    // there, both times the sign of s's numerator, and that numerator's magnitude, or infinity
    // where it is 0 or NaN (s is then never in (0, 1); every edge with that start as an end).
    double *seenAlongX, *seenAlongY, *seenFromX, *seenFromY, *seenSNum;
    struct Block {
        VelBox box;      // the bounds of its edges' ends
        int a, b;        // points that are an end of every edge of the block, -1 for none
        int seenFrom;    // the start the seen terms are for, -1 for none
    };
    mutable std::vector<Block> blocks;
    std::vector<VelBox> edgeGroups;  // the bounds of each complete group of kGroup blocks
    void SeeBlockFrom(int block, int i) const;
    // Each loop's points, as added, cut into runs of a block; its first point, first run and bounds.
    std::vector<VelRun> runs;
    // The bounds of each block of points, loops run together, and of each group of kGroup blocks.
    std::vector<VelBox> pointBlocks, pointGroups;
    struct LoopStart {
        int point, run;
        VelBox box;
        int bands;  // in loopBands, -1 for a loop without
    };
    std::vector<LoopStart> loopStarts;
    std::vector<VelLoopBands> loopBands;
    std::vector<DorVector2> units;  // per edge: end minus start, normalised as the closing step needs
    // Per point, the edges with it as an end in list order, each once, for the closing step:
    // point v's are at [edgesAtStart[v], edgesAtStart[v + 1]).
    struct EdgeAt {
        int edge, other;
        DorVector2 unit;  // from v: the normalised direction, negated for an edge that ends at v
    };
    std::vector<EdgeAt> edgesAt;
    std::vector<int> edgesAtStart;
    // The largest coordinate magnitude, and whether every coordinate is finite.
    double extent = 0.0;
    bool finite = true;
    // A search hint only: the edges that crossed last, latest first, -1 for none.
    mutable std::array<int, kRecent> recentlyCrossed;
    mutable int recentPoint = -1;  // the same for the point last found on a segment
    mutable bool pointsFirst = true;  // the same for the search Blocked goes through first
    std::vector<int> candidates;  // three per triangle
};
