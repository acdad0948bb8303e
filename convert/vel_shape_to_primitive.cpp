#include "convert/vel_shape_to_primitive.h"

#include "convert/vel_extruded_to_primitive.h"
#include "convert/vel_hole_extruded_to_primitive.h"

#include <cmath>

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

namespace {
bool IsFinite(const DorVector3& v) { return std::isfinite(v.x) && std::isfinite(v.y) && std::isfinite(v.z); }

bool PointsAreFinite(const CDorArray<DorVector3, DorVector3&>& points)
{
    for (int i = 0; i < points.GetSize(); ++i)
        if (!IsFinite(points[i]))
            return false;
    return true;
}

bool PolygonIsFinite(const CDorPolygon& p)
{
    return PointsAreFinite(p.points) && IsFinite(p.textureAxis) && IsFinite(p.textureOrigin);
}

bool HolePolygonIsFinite(const CDorHolePolygon& p)
{
    for (int h = 0; h < p.holes.GetSize(); ++h)
        if (!PointsAreFinite(p.holes[h].points))
            return false;
    return PointsAreFinite(p.points) && IsFinite(p.holeTextureAxis) && IsFinite(p.holeTextureOrigin);
}

// As ConvertGeometry, a geometry is read as the class its kind names only when it is one.
bool GeometryIsFinite(const CDorGeometry* geometry)
{
    if (const CDorExtruded* e = geometry->kind == DorKindExtruded ? dynamic_cast<const CDorExtruded*>(geometry) : nullptr)
        return PolygonIsFinite(e->bottom) && PolygonIsFinite(e->top) && IsFinite(e->textureAxis);
    if (const CDorHoleExtruded* e = geometry->kind == DorKindHoleExtruded ? dynamic_cast<const CDorHoleExtruded*>(geometry) : nullptr)
        return HolePolygonIsFinite(e->bottom) && HolePolygonIsFinite(e->top) && IsFinite(e->textureAxis);
    return true;
}
}  // namespace

bool VelShapeIsFinite(const CDorShape& shape)
{
    for (_DorPosition* at = shape.geometries.GetHeadPosition(); at; at = CDorList::GetNextPosition(at)) {
        const CDorGeometry* geometry = static_cast<const CDorGeometry*>(CDorList::GetAt(at));
        if (geometry && !GeometryIsFinite(geometry))
            return false;
    }
    return true;
}
