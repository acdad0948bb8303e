#pragma once
// The plain polygon triangulation behind the solid polygon converter (internal, not exported).
//
// Not ear clipping: every admissible non-crossing segment between two outline points (ordered
// pairs, neighbours and i = j included) enters an edge list, a triangle is closed on each side
// of every added edge, and repeats are removed. The list holds at most 100 added edges, so large
// outlines come out partly triangulated; a convex 120-gon yields the 99-triangle fan from point 0.
#include "convert/dor_shape.h"

// Replaces indices with three point indices per triangle, each counter-clockwise about the
// outline's Newell normal. A normal shorter than 0.0001 (fewer than three points, collinear or
// cancelling outlines) leaves indices as handed in.
void TriangulatePolygon(const CDorPolygon* polygon, CDorArray<int, int>& indices);
