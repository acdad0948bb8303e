#pragma once
/// @file
/// CVelShapeToPrimitive, the converter of whole shapes.
#include "../convert/dor_shape.h"
#include "../convert/vel_group_array.h"
#include "../model/export.h"
#include "../model/vel_primitive.h"

/// Turns a whole shape into one primitive: each geometry in list order is converted by the
/// converter for its kind, and its groups are appended. Only extrusions (kinds 7 and 8) produce
/// groups; bare polygons, null entries, unknown kinds and styles are skipped silently. Failures
/// show only as missing groups. Reentrant: conversions share nothing and may run on any thread,
/// as long as no two of them touch the same shape.
///
/// Coordinates, texture axes and scales that are NaN or infinite are not refused here: they
/// convert without undefined behaviour, into groups whose vertices may be NaN or infinite, or into
/// fewer groups. Indices always lie within their group's vertices.
class KARVEL_API CVelShapeToPrimitive {
public:
    ///@{
    /// A converter holds no state: make one on the stack for a call; copies copy nothing.
    CVelShapeToPrimitive() {}
    CVelShapeToPrimitive(const CVelShapeToPrimitive&) {}
    CVelShapeToPrimitive& operator=(const CVelShapeToPrimitive&) { return *this; }
    virtual ~CVelShapeToPrimitive() {}
    ///@}

    /// Appends the groups of every geometry of shape to primitive; its existing groups and
    /// DrawMode are kept, so converting twice doubles the groups. The solid extrusions may
    /// reorder the points of the shape's profiles in place (the shape is const, its geometries
    /// are not).
    void ConvertShape(const CDorShape& shape, CVelPrimitive& primitive);
    /// Converts one geometry by its kind (7 extrusion, 8 holed extrusion; others and null do
    /// nothing) into groups, under the contract of the extrusion converters: hand an empty array.
    void ConvertGeometry(const CDorGeometry* geometry, CVelGroupArray& groups);

protected:
    /// CVelExtrudedToPrimitive::ConvertExtruded on a local converter.
    void ConvertExtruded(CDorExtruded* extruded, CVelGroupArray& groups);
    /// CVelHoleExtrudedToPrimitive::ConvertHoleExtruded on a local converter.
    void ConvertHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups);
};

/// @cond KARVEL_INTERNAL
// Whether every point and texture vector of the extrusions of shape (the geometries it converts;
// of holed profiles the vectors the holed converters read) is finite. Null entries and other
// kinds are not read.
bool VelShapeIsFinite(const CDorShape& shape);
/// @endcond
