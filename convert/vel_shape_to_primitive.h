#pragma once
// Turns a whole shape into one primitive: each geometry in list order is converted by the
// converter for its kind, and its groups are appended. Only extrusions (kinds 7 and 8) produce
// groups; bare polygons, null entries, unknown kinds and styles are skipped silently.
#include "../convert/dor_shape.h"
#include "../convert/vel_group_array.h"
#include "../model/export.h"
#include "../model/vel_primitive.h"

class KARVEL_API CVelShapeToPrimitive {
public:
    CVelShapeToPrimitive() {}
    CVelShapeToPrimitive(const CVelShapeToPrimitive&) {}
    CVelShapeToPrimitive& operator=(const CVelShapeToPrimitive&) { return *this; }
    virtual ~CVelShapeToPrimitive() {}

    // Appends; the primitive's existing groups and DrawMode are kept. The solid extrusions may
    // reorder the points of the shape's profiles in place.
    void ConvertShape(const CDorShape& shape, CVelPrimitive& primitive);
    void ConvertGeometry(const CDorGeometry* geometry, CVelGroupArray& groups);

protected:
    void ConvertExtruded(CDorExtruded* extruded, CVelGroupArray& groups);
    void ConvertHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups);
};
