#include "primitives/vel_math_primitive.h"

#include <climits>

namespace {
// The line material derived from one base colour; products in double, stored as float.
_DorMaterial LineMaterial(const DorColorValue& c)
{
    _DorMaterial m;
    m.diffuse = DorColorValue(static_cast<float>(0.8 * c.r), static_cast<float>(0.8 * c.g),
                              static_cast<float>(0.8 * c.b), c.a);
    m.ambient = DorColorValue(static_cast<float>(1.0 * c.r), static_cast<float>(1.0 * c.g),
                              static_cast<float>(1.0 * c.b), c.a);
    m.specular = DorColorValue(0.2f, 0.2f, 0.2f, 1.0f);
    m.emission = DorColorValue(1.0f, 1.0f, 1.0f, 1.0f);
    m.shininess = 70.0f;
    return m;
}

int AppendLineGroup(CVelTrianglePolys& group, const DorColorValue& base, CVelPrimitive& primitive)
{
    group.GroupType = VelGroupLines;
    group.material = LineMaterial(base);
    int index = primitive.groups.GetSize();
    primitive.groups.SetAtGrow(index, group);
    return index;
}
}  // namespace

int CVelMathPrimitive::MakeLine(DorVector3 from, DorVector3 to, CVelPrimitive& primitive)
{
    CVelTrianglePolys group;
    group.vertices.SetSize(2);
    group.vertices[0].position = from;
    group.vertices[1].position = to;
    return AppendLineGroup(group, DorColorValue(1.0f, 1.0f, 1.0f, 1.0f), primitive);
}

int CVelMathPrimitive::MakeGrid(DorVector2 corner0, DorVector2 corner1, int divisions, CVelPrimitive& primitive)
{
    // 4 (divisions + 1) vertices must fit in an int.
    if (divisions == 0 || divisions < -1 || divisions >= INT_MAX / 4)
        return -1;
    double x0 = corner0.x, y0 = corner0.y, x1 = corner1.x, y1 = corner1.y;
    double stepX = (x1 - x0) / static_cast<double>(divisions);
    double stepY = (y1 - y0) / static_cast<double>(divisions);
    CVelTrianglePolys group;
    group.vertices.SetSize(4 * (divisions + 1));
    for (int i = 0; i <= divisions; ++i) {
        double yi = i * stepY + y0;
        double xi = i * stepX + x0;
        group.vertices[4 * i + 0].position = DorVector3(x0, yi, 0);
        group.vertices[4 * i + 1].position = DorVector3(x1, yi, 0);
        group.vertices[4 * i + 2].position = DorVector3(xi, y0, 0);
        group.vertices[4 * i + 3].position = DorVector3(xi, y1, 0);
    }
    return AppendLineGroup(group, DorColorValue(0.8f, 0.8f, 0.8f, 1.0f), primitive);
}
