#include "convert/vel_extruded_to_primitive.h"

#include "convert/vel_extrusion_geometry.h"
#include "convert/vel_polygon_to_primitive.h"

void CVelExtrudedToPrimitive::ConvertExtruded(CDorExtruded* extruded, CVelGroupArray& groups)
{
    if (!extruded)
        return;
    if (extruded->style == DorStyleSolid)
        ConvertSolidExtruded(extruded, groups);
    else if (extruded->style == DorStyleWire)
        ConvertWireExtruded(extruded, groups);
}

void CVelExtrudedToPrimitive::ConvertSolidExtruded(CDorExtruded* extruded, CVelGroupArray& groups)
{
    DorPointArray& bottomPoints = extruded->bottom.points;
    DorPointArray& topPoints = extruded->top.points;
    const int n = bottomPoints.GetSize();
    if (topPoints.GetSize() != n)
        return;
    DorVector3 direction = VelExtrusionDirection(bottomPoints, topPoints);
    VelOrientProfile(bottomPoints, direction);
    VelOrientProfile(topPoints, direction);
    std::vector<DorVector3> bottom = VelClosedLoop(bottomPoints), top = VelClosedLoop(topPoints);

    // Every wall's texture frame is anchored at bottom point 0.
    groups.SetSize(n, -1);
    for (int i = 0; i < n; ++i) {
        const DorVector3 quad[4] = {top[i], bottom[i], top[i + 1], bottom[i + 1]};
        VelFillSolidWall(*extruded, extruded->textureAxis, quad, bottom[0], true, groups[i]);
    }

    CVelPolygonToPrimitive caps;
    if (extruded->bottomCap)
        caps.ConvertPolygon(&extruded->bottom, groups, 1);
    if (extruded->topCap)
        caps.ConvertPolygon(&extruded->top, groups, 0);
}

void CVelExtrudedToPrimitive::ConvertWireExtruded(CDorExtruded* extruded, CVelGroupArray& groups)
{
    const int n = extruded->bottom.points.GetSize();
    if (extruded->top.points.GetSize() != n || n == 0)  // empty profiles have no point 0 to close with
        return;
    groups.SetSize(n + 2, -1);
    VelFillWireFrame(*extruded, extruded->bottom.points, extruded->top.points, false, &groups[0]);
}
