#pragma once
/// @file
/// CVelHolePolygonToPrimitive, the converter of polygons with holes (the caps of holed extrusions).
#include "../convert/dor_shape.h"
#include "../convert/vel_group_array.h"
#include "../model/export.h"

/// Converts one polygon with holes into groups: an indexed triangle group (solid) or one closed
/// outline per loop (wire). The holed extrusion converts its caps here; `flip` 1 turns a face
/// over (a bottom cap), any other value keeps the outline's own orientation.
///
/// All loops share one vertex list: the outline first, then each hole in stored order. Holes are
/// expected inside the outline and in its plane; nothing checks this. A hole's winding does not
/// matter to the cap; it matters to the walls of a holed extrusion (see CDorHoleExtruded).
class KARVEL_API CVelHolePolygonToPrimitive {
public:
    ///@{
    /// A converter holds no state: make one on the stack for a call; copies copy nothing.
    CVelHolePolygonToPrimitive() {}
    CVelHolePolygonToPrimitive(const CVelHolePolygonToPrimitive&) {}
    CVelHolePolygonToPrimitive& operator=(const CVelHolePolygonToPrimitive&) { return *this; }
    virtual ~CVelHolePolygonToPrimitive() {}
    ///@}

    /// By the shape's style: 0 solid, 1 wire, anything else nothing. Appends to groups and never
    /// writes into shape.
    void ConvertHolePolygon(CDorHolePolygon* shape, CVelGroupArray& groups, int flip);

    /// Sets vertices to the outline's points followed by every hole's, and replaces indices with
    /// three vertex indices per triangle, each counter-clockwise about the outline's Newell
    /// normal. Not ear clipping: every admissible segment between two vertices enters an edge
    /// list (at most N + 98 of them besides the loops' own N edges), and a triangle is closed on
    /// each side of every segment. Fails with indices empty: a degenerate outline, a triangle
    /// without holes (it has no diagonal), or the budget spent before a region got its segments.
    /// Meant for tens of vertices: the work grows with the cube of N or faster.
    void TriangulateHolePolygon(const CDorHolePolygon* shape, CDorArray<DorVector3, DorVector3&>& vertices,
                                CDorArray<int, int>& indices);

protected:
    /// At most one group of type 6 wound to agree with its normal; falls back to the triangle
    /// (0, 1, 2) when the triangulation gives nothing. Planar texture coordinates when textured.
    void ConvertSolidHolePolygon(CDorHolePolygon* shape, CVelGroupArray& groups, int flip);
    /// One group of separate segments per loop, the outline's first, each closed on its first
    /// point: every other side shows. Flip turns the normal only.
    void ConvertWireHolePolygon(CDorHolePolygon* shape, CVelGroupArray& groups, int flip);
};
