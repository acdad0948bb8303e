#include "convert/vel_hole_extruded_to_primitive.h"

#include "convert/vel_extrusion_geometry.h"
#include "convert/vel_hole_polygon_to_primitive.h"

namespace {
// The number of hole pairs to look at: the bottom profile's holes that the top one also has.
int HolePairCount(const CDorHoleExtruded& extruded)
{
    int bottom = extruded.bottom.holes.GetSize(), top = extruded.top.holes.GetSize();
    return bottom < top ? bottom : top;
}

// The loops of hole pair h; whether they can be joined point to point.
bool JoinableHole(const CDorHoleExtruded& extruded, int h, const DorPointArray*& bottom, const DorPointArray*& top)
{
    bottom = &extruded.bottom.holes[h].points;
    top = &extruded.top.holes[h].points;
    return bottom->GetSize() > 0 && bottom->GetSize() == top->GetSize();
}

void OrientOutlines(CDorHoleExtruded& extruded, const DorVector3& direction)
{
    VelOrientProfile(extruded.bottom.points, direction);
    VelOrientProfile(extruded.top.points, direction);
}

// One wall per bottom point between two loops of the same count, into walls[0..], every
// texture frame anchored at the bottom loop's point 0.
// Outline walls run top, bottom, top, bottom; hole walls the other way round, so that they face
// into a hole that runs the outline's way.
void FillSolidWalls(const CDorHoleExtruded& extruded, const DorPointArray& bottomPoints,
                    const DorPointArray& topPoints, bool holeWalls, CVelTrianglePolys* walls)
{
    std::vector<DorVector3> bottom = VelClosedLoop(bottomPoints), top = VelClosedLoop(topPoints);
    const bool textured = extruded.texture != 0;
    for (int k = 0; k + 1 < static_cast<int>(bottom.size()); ++k) {
        const DorVector3 outlineQuad[4] = {top[k], bottom[k], top[k + 1], bottom[k + 1]};
        const DorVector3 holeQuad[4] = {bottom[k], top[k], bottom[k + 1], top[k + 1]};
        VelFillSolidWall(extruded, extruded.textureAxis, holeWalls ? holeQuad : outlineQuad, bottom[0], textured,
                         walls[k]);
    }
}
}  // namespace

void CVelHoleExtrudedToPrimitive::ConvertHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups)
{
    if (!extruded)
        return;
    if (extruded->style == DorStyleSolid)
        ConvertSolidHoleExtruded(extruded, groups);
    else if (extruded->style == DorStyleWire)
        ConvertWireHoleExtruded(extruded, groups);
}

void CVelHoleExtrudedToPrimitive::ConvertSolidHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups)
{
    const int n = extruded->bottom.points.GetSize();
    if (extruded->top.points.GetSize() != n)
        return;
    OrientOutlines(*extruded, VelExtrusionDirection(extruded->bottom.points, extruded->top.points));
    groups.SetSize(n, -1);
    if (n > 0)
        FillSolidWalls(*extruded, extruded->bottom.points, extruded->top.points, false, &groups[0]);

    const DorPointArray *bottomHole = nullptr, *topHole = nullptr;
    for (int h = 0; h < HolePairCount(*extruded); ++h) {
        if (!JoinableHole(*extruded, h, bottomHole, topHole))
            continue;
        // The hole's own direction re-orients the outlines, never the hole loops.
        OrientOutlines(*extruded, VelExtrusionDirection(*bottomHole, *topHole));
        const int m = bottomHole->GetSize();
        groups.SetSize(n, -1);  // drops the previous pair's walls
        groups.SetSize(n + m, -1);
        FillSolidWalls(*extruded, *bottomHole, *topHole, true, &groups[n]);
    }

    CVelHolePolygonToPrimitive caps;
    if (extruded->bottomCap)
        caps.ConvertHolePolygon(&extruded->bottom, groups, 1);
    if (extruded->topCap)
        caps.ConvertHolePolygon(&extruded->top, groups, 0);
}

void CVelHoleExtrudedToPrimitive::ConvertWireHoleExtruded(CDorHoleExtruded* extruded, CVelGroupArray& groups)
{
    const int n = extruded->bottom.points.GetSize();
    if (extruded->top.points.GetSize() != n || n == 0)  // empty outlines have no point 0 to close with
        return;
    groups.SetSize(n + 2, -1);
    VelFillWireFrame(*extruded, extruded->bottom.points, extruded->top.points, false, &groups[0]);

    const DorPointArray *bottomHole = nullptr, *topHole = nullptr;
    for (int h = 0; h < HolePairCount(*extruded); ++h) {
        if (!JoinableHole(*extruded, h, bottomHole, topHole))
            continue;
        const int first = groups.GetSize(), m = bottomHole->GetSize();
        groups.SetSize(first + m + 2, -1);
        VelFillWireFrame(*extruded, *bottomHole, *topHole, true, &groups[first]);
    }
}
