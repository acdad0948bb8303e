#include "convert/vel_hole_extruded_to_primitive.h"

void CVelHoleExtrudedToPrimitive::ConvertHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups)
{
    if (!extruded)
        return;
    if (extruded->style == DorStyleSolid)
        ConvertSolidHoleExtruded(extruded, groups);
    else if (extruded->style == DorStyleWire)
        ConvertWireHoleExtruded(extruded, groups);
}

void CVelHoleExtrudedToPrimitive::ConvertSolidHoleExtruded(CDorHoleExtruded*, CVelGroupArray&) {}

void CVelHoleExtrudedToPrimitive::ConvertWireHoleExtruded(CDorHoleExtruded*, CVelGroupArray&) {}
