#pragma once
/// @file
/// CVelExtrudedToPrimitive, the converter of extrusions.
#include "../convert/dor_shape.h"
#include "../convert/vel_group_array.h"
#include "../model/export.h"

/// Converts one extrusion into groups: n flat-shaded side walls (triangle strips of 4 vertices),
/// then its caps (solid), or n wall edge pairs and the two profile outlines, no caps (wire).
/// Different point counts in the two profiles give nothing. The workers resize the group array
/// to their wall count, reusing what is there; hand them an empty array.
class KARVEL_API CVelExtrudedToPrimitive {
public:
    ///@{
    /// A converter holds no state: make one on the stack for a call; copies copy nothing.
    CVelExtrudedToPrimitive() {}
    CVelExtrudedToPrimitive(const CVelExtrudedToPrimitive&) {}
    CVelExtrudedToPrimitive& operator=(const CVelExtrudedToPrimitive&) { return *this; }
    virtual ~CVelExtrudedToPrimitive() {}
    ///@}

    /// By the extrusion's style: 0 solid, 1 wire, anything else nothing.
    void ConvertExtruded(CDorExtruded* extruded, CVelGroupArray& groups);

protected:
    /// Walls, then the bottom cap (turned over) and the top cap, each converted by its own
    /// profile's style, material and texture. Reorders the host's profiles in place so both run
    /// counter-clockwise about bottom-to-top.
    void ConvertSolidExtruded(CDorExtruded* extruded, CVelGroupArray& groups);
    /// n + 2 line groups; never reorders the profiles, so a clockwise profile gets inward normals.
    void ConvertWireExtruded(CDorExtruded* extruded, CVelGroupArray& groups);
};
