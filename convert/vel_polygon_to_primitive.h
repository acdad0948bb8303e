#pragma once
// Converts one polygon into groups: an indexed triangle group (solid) or an outline (wire).
// In practice these are the caps of extrusions. `reverse` 1 means the polygon is seen from its
// back (a bottom cap); any other value counts as 0.
#include "../convert/dor_shape.h"
#include "../convert/vel_group_array.h"
#include "../model/export.h"

class KARVEL_API CVelPolygonToPrimitive {
public:
    CVelPolygonToPrimitive() {}
    CVelPolygonToPrimitive(const CVelPolygonToPrimitive&) {}
    CVelPolygonToPrimitive& operator=(const CVelPolygonToPrimitive&) { return *this; }
    virtual ~CVelPolygonToPrimitive() {}

    // Style 0 solid, 1 wire, anything else nothing. Appends to groups.
    void ConvertPolygon(CDorPolygon* polygon, CVelGroupArray& groups, int reverse);

protected:
    // At most one group of type 6, wound to agree with its normal, with planar texture coordinates.
    void ConvertSolidPolygon(CDorPolygon* polygon, CVelGroupArray& groups, int reverse);
    // Two identical groups of separate segments over the closed outline: every other side shows.
    void ConvertWirePolygon(CDorPolygon* polygon, CVelGroupArray& groups, int reverse);
};
