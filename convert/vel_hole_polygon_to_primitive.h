#pragma once
// Converts one polygon with holes into groups: an indexed triangle group (solid) or one closed
// outline per loop (wire). The holed extrusion converts its caps here; `flip` 1 turns a face
// over (a bottom cap), any other value keeps the outline's own orientation.
//
// All loops share one vertex list: the outline first, then each hole in stored order. Holes are
// expected inside the outline and in its plane; nothing checks this.
#include "../convert/dor_shape.h"
#include "../convert/vel_group_array.h"
#include "../model/export.h"

class KARVEL_API CVelHolePolygonToPrimitive {
public:
    CVelHolePolygonToPrimitive() {}
    CVelHolePolygonToPrimitive(const CVelHolePolygonToPrimitive&) {}
    CVelHolePolygonToPrimitive& operator=(const CVelHolePolygonToPrimitive&) { return *this; }
    virtual ~CVelHolePolygonToPrimitive() {}

    // Style 0 solid, 1 wire, anything else nothing. Appends to groups.
    void ConvertHolePolygon(CDorHolePolygon* shape, CVelGroupArray& groups, int flip);

    // Sets vertices to the outline's points followed by every hole's, and replaces indices with
    // three vertex indices per triangle, each counter-clockwise about the outline's Newell
    // normal. Not ear clipping: every admissible segment between two vertices enters an edge
    // list (at most N + 98 of them besides the loops' own N edges), and a triangle is closed on
    // each side of every segment. Fails with indices empty: a degenerate outline, a triangle
    // without holes (it has no diagonal), or the budget spent before a region got its segments.
    void TriangulateHolePolygon(const CDorHolePolygon* shape, CDorArray<DorVector3, DorVector3&>& vertices,
                                CDorArray<int, int>& indices);

protected:
    // At most one group of type 6 wound to agree with its normal; falls back to the triangle
    // (0, 1, 2) when the triangulation gives nothing. Planar texture coordinates when textured.
    void ConvertSolidHolePolygon(CDorHolePolygon* shape, CVelGroupArray& groups, int flip);
    // One group of separate segments per loop, the outline's first, each closed on its first
    // point: every other side shows. Flip turns the normal only.
    void ConvertWireHolePolygon(CDorHolePolygon* shape, CVelGroupArray& groups, int flip);
};
