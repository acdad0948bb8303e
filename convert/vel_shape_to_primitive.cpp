#include "convert/vel_shape_to_primitive.h"

#include "convert/vel_extruded_to_primitive.h"
#include "convert/vel_hole_extruded_to_primitive.h"

void CVelShapeToPrimitive::ConvertShape(const CDorShape& shape, CVelPrimitive& primitive)
{
    CVelGroupArray local;
    for (_DorPosition* at = shape.geometries.GetHeadPosition(); at; at = CDorList::GetNextPosition(at)) {
        const CDorGeometry* geometry = static_cast<const CDorGeometry*>(CDorList::GetAt(at));
        if (!geometry)
            continue;
        local.SetSize(0, -1);
        ConvertGeometry(geometry, local);
        int first = primitive.groups.GetSize();
        primitive.groups.SetSize(first + local.GetSize(), -1);
        for (int i = 0; i < local.GetSize(); ++i)
            primitive.groups[first + i] = local[i];
    }
}

// The solid extrusions reorder the host's profiles in place, hence the const_cast: the shape is
// const only in that its list is not changed.
void CVelShapeToPrimitive::ConvertGeometry(const CDorGeometry* geometry, CVelGroupArray& groups)
{
    if (!geometry)
        return;
    CDorGeometry* writable = const_cast<CDorGeometry*>(geometry);
    // The kind selects the class; the checked cast keeps a mislabelled object from being misread.
    if (geometry->kind == DorKindExtruded) {
        if (CDorExtruded* extruded = dynamic_cast<CDorExtruded*>(writable))
            ConvertExtruded(extruded, groups);
    } else if (geometry->kind == DorKindHoleExtruded) {
        if (CDorHoleExtruded* extruded = dynamic_cast<CDorHoleExtruded*>(writable))
            ConvertHoleExtruded(extruded, groups);
    }
}

void CVelShapeToPrimitive::ConvertExtruded(CDorExtruded* extruded, CVelGroupArray& groups)
{
    CVelExtrudedToPrimitive converter;
    converter.ConvertExtruded(extruded, groups);
}

void CVelShapeToPrimitive::ConvertHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups)
{
    CVelHoleExtrudedToPrimitive converter;
    converter.ConvertHoleExtruded(extruded, groups);
}
