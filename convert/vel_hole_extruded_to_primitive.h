#pragma once
/// @file
/// CVelHoleExtrudedToPrimitive, the converter of holed extrusions.
#include "../convert/dor_shape.h"
#include "../convert/vel_group_array.h"
#include "../model/export.h"

/// Converts one holed extrusion into groups, solid or wire by its style. Different outline point
/// counts in the two profiles give nothing. Holes are paired by index, bottom hole h with top
/// hole h (pairs beyond the top profile's hole count are skipped); a pair whose counts differ, or
/// that is empty, gets no walls. The workers resize the group array to their outline wall count,
/// reusing what is there; hand them an empty array.
class KARVEL_API CVelHoleExtrudedToPrimitive {
public:
    ///@{
    /// A converter holds no state: make one on the stack for a call; copies copy nothing.
    CVelHoleExtrudedToPrimitive() {}
    CVelHoleExtrudedToPrimitive(const CVelHoleExtrudedToPrimitive&) {}
    CVelHoleExtrudedToPrimitive& operator=(const CVelHoleExtrudedToPrimitive&) { return *this; }
    virtual ~CVelHoleExtrudedToPrimitive() {}
    ///@}

    /// By the extrusion's style: 0 solid, 1 wire, anything else nothing.
    void ConvertHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups);

protected:
    /// The outline walls, the walls of the last hole pair that has any (each pair replaces the
    /// previous one's: hosts rely on it), then the caps. Reorders the host's outlines in place so
    /// both run counter-clockwise about bottom-to-top; hole loops are never reordered, so only a
    /// hole running the outline's way gets walls facing into it (the other way they face into
    /// the material and are culled).
    void ConvertSolidHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups);
    /// The outline's side edges and loops, then those of every hole pair (all of them, unlike the
    /// solid form); no caps, no reordering. A hole's side lines shade like its solid walls (their
    /// corner normals turned round: facing into a hole that runs the outline's way); its loops
    /// shade like the caps around it, as the outline's do.
    void ConvertWireHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups);
};
