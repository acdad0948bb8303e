#pragma once
/// @file
/// CVelPolygonToPrimitive, the converter of plain polygons (the caps of extrusions).
#include "../convert/dor_shape.h"
#include "../convert/vel_group_array.h"
#include "../model/export.h"

/// Converts one polygon into groups: an indexed triangle group (solid) or an outline (wire).
/// In practice these are the caps of extrusions. `reverse` 1 means the polygon is seen from its
/// back (a bottom cap): the normal and the winding are turned over; any other value counts as 0.
///
/// The solid form triangulates by diagonals, not ear clipping, with a budget of 100 added edges:
/// a convex polygon of up to about 60 points is complete, larger ones lose triangles (of 120
/// points only the fan from point 0 over points 1..100 is made). A polygon whose Newell normal is
/// shorter than 0.0001 (collinear, fewer than three points, areas that cancel) gives no group.
class KARVEL_API CVelPolygonToPrimitive {
public:
    ///@{
    /// A converter holds no state: make one on the stack for a call; copies copy nothing.
    CVelPolygonToPrimitive() {}
    CVelPolygonToPrimitive(const CVelPolygonToPrimitive&) {}
    CVelPolygonToPrimitive& operator=(const CVelPolygonToPrimitive&) { return *this; }
    virtual ~CVelPolygonToPrimitive() {}
    ///@}

    /// By the polygon's style: 0 solid, 1 wire, anything else nothing. Appends to groups and
    /// never writes into polygon.
    void ConvertPolygon(CDorPolygon* polygon, CVelGroupArray& groups, int reverse);

protected:
    /// At most one group of type 6, wound to agree with its normal, with planar texture
    /// coordinates (computed even when untextured).
    void ConvertSolidPolygon(CDorPolygon* polygon, CVelGroupArray& groups, int reverse);
    /// Two identical groups of separate segments (type 1) over the closed outline: the n + 1
    /// points pair up, so every other side shows. Both duplicates are intended.
    void ConvertWirePolygon(CDorPolygon* polygon, CVelGroupArray& groups, int reverse);
};
