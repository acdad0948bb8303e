#pragma once
// Converts one holed extrusion into groups, solid or wire by its style.
#include "convert/dor_shape.h"
#include "convert/vel_group_array.h"
#include "model/export.h"

class KARVEL_API CVelHoleExtrudedToPrimitive {
public:
    CVelHoleExtrudedToPrimitive() {}
    CVelHoleExtrudedToPrimitive(const CVelHoleExtrudedToPrimitive&) {}
    CVelHoleExtrudedToPrimitive& operator=(const CVelHoleExtrudedToPrimitive&) { return *this; }
    virtual ~CVelHoleExtrudedToPrimitive() {}

    // Style 0 solid, 1 wire, anything else nothing.
    void ConvertHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups);

protected:
    // NOTE: not converted yet: both workers produce nothing until the holed triangulation lands.
    void ConvertSolidHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups);
    void ConvertWireHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups);
};
