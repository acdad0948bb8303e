#pragma once
// Converts one extrusion into groups: n side walls, then its caps (solid), or n wall edge pairs
// and the two profile outlines (wire). Different point counts in the two profiles give nothing.
// The workers resize the group array to their wall count, reusing what is there; hand them an
// empty array.
#include "../convert/dor_shape.h"
#include "../convert/vel_group_array.h"
#include "../model/export.h"

class KARVEL_API CVelExtrudedToPrimitive {
public:
    CVelExtrudedToPrimitive() {}
    CVelExtrudedToPrimitive(const CVelExtrudedToPrimitive&) {}
    CVelExtrudedToPrimitive& operator=(const CVelExtrudedToPrimitive&) { return *this; }
    virtual ~CVelExtrudedToPrimitive() {}

    // Style 0 solid, 1 wire, anything else nothing.
    void ConvertExtruded(CDorExtruded* extruded, CVelGroupArray& groups);

protected:
    // Reorders the host's profiles in place so both run counter-clockwise about bottom-to-top.
    void ConvertSolidExtruded(CDorExtruded* extruded, CVelGroupArray& groups);
    void ConvertWireExtruded(CDorExtruded* extruded, CVelGroupArray& groups);
};
