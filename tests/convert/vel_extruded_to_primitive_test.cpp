// The plain and the holed extrusion converters.
#include <cmath>

#include "convert/vel_extruded_to_primitive.h"
#include "convert/vel_hole_extruded_to_primitive.h"
#include "convert/vel_shape_to_primitive.h"
#include "geometry_checks.h"

namespace {
// Either extrusion, through the shape converter's per-kind dispatch.
CVelGroupArray Convert(CDorGeometry& shape, CVelGroupArray groups = CVelGroupArray())
{
    CVelShapeToPrimitive().ConvertGeometry(&shape, groups);
    return groups;
}

// Solid: a wall per outline edge (top record first), then per edge of the last hole (bottom
// first), then the caps over every vertex. Wire, per loop: its side edges (top, bottom, top,
// bottom), then its bottom and top loops closed by their first point. Walls and sides face out
// of their loop as it runs about the height, holes' the other way; loops along their own normal
// with the bottom one turned; the caps likewise.
void ExpectPrism(const CVelGroupArray& groups, const std::vector<Loop>& loops, const DorVector3& height, bool wire, int caps)
{
    DorVector3 up = height;
    DorNormalize(up);
    int g = 0, vertices = 0;
    for (size_t l = 0; l < loops.size(); ++l) {
        const Loop& loop = loops[l];
        const int n = static_cast<int>(loop.size());
        vertices += n;
        for (int k = 0; k < n && (wire || l == 0 || l + 1 == loops.size()); ++k, ++g) {
            SCOPED_TRACE(::testing::Message() << "loop " << l << ", wall " << k);
            ASSERT_LT(g, groups.GetSize());
            const DorVector3 &a = loop[k], &b = loop[(k + 1) % n];
            DorVector3 out = DorCross(b - a, up) * (l ? -1.0 : 1.0);
            DorNormalize(out);
            const bool topFirst = wire || l == 0;
            const DorVector3 corners[4] = {topFirst ? a + height : a, topFirst ? a : a + height, topFirst ? b + height : b,
                                           topFirst ? b : b + height};
            ASSERT_TRUE(groups[g].GroupType == (wire ? VelGroupLines : VelGroupTriangleStrip) && groups[g].vertices.GetSize() == 4);
            for (int v = 0; v < 4; ++v)
                EXPECT_TRUE(Near(groups[g].vertices[v].position, corners[v]) && Near(groups[g].vertices[v].normal, out)) << v;
        }
        for (int c = 0; wire && c < 2; ++c, ++g) {
            ASSERT_LT(g, groups.GetSize());
            ASSERT_TRUE(groups[g].GroupType == VelGroupLineStrip && groups[g].vertices.GetSize() == n + 1) << g;
            for (int k = 0; k <= n; ++k)
                EXPECT_TRUE(Near(groups[g].vertices[k].position, loop[k % n] + height * c) &&
                            Near(groups[g].vertices[k].normal, UnitNormal(loop) * (c ? 1.0 : -1.0))) << g;
        }
    }
    for (int c = 0; !wire && c < 2; ++c) {
        if (!(caps & (1 << c)))
            continue;
        ASSERT_LT(g, groups.GetSize());
        const CVelTrianglePolys& cap = groups[g++];
        ASSERT_TRUE(cap.GroupType == VelGroupIndexed && cap.vertices.GetSize() == vertices) << "cap " << c;
        for (int k = 0; k < vertices; ++k)
            EXPECT_TRUE(Near(cap.vertices[k].normal, UnitNormal(loops[0]) * (c ? 1.0 : -1.0)) &&
                        std::fabs(DorDot(cap.vertices[k].position - loops[0][0] - height * c, up)) < 1e-12);
        EXPECT_NEAR(CheckTriangles(MeshOf(cap), UnitNormal(loops[0]) * (c ? 1.0 : -1.0)), RingArea(loops[0], {loops.begin() + 1, loops.end()}), 1e-9);
    }
    EXPECT_EQ(g, groups.GetSize());
}

}  // namespace

// Solid extrusions turn a clockwise outline counter-clockwise about the height in the host's own
// points, keeping point 0, but never a hole; along y each outline is its own reference, so there
// nothing is turned. Wire extrusions never turn anything and ignore the cap flags.
TEST(ExtrudedToPrimitive, PrismsWhicheverWayTheirLoopsRun)
{
    const Loop triangle = {DorVector3(0.5, 3, 0), DorVector3(1.5, 3, 0), DorVector3(1, 3.5, 0)};
    const Loop wall = {DorVector3(0, 0, 0), DorVector3(0, 0, 3), DorVector3(4, 0, 3), DorVector3(4, 0, 0)};
    const Loop window = {DorVector3(1, 0, 1), DorVector3(1, 0, 2), DorVector3(2, 0, 2), DorVector3(2, 0, 1)};
    const Loop reversedWall = {wall[0], wall[3], wall[2], wall[1]};
    const DorVector3 z(0, 0, 1), y(0, 0.2, 0);
    // after: the outline as the host holds it afterwards
    const struct { Loop outline; std::vector<Loop> holes; DorVector3 height; int style, caps; Loop after; } cases[] = {
        {Square(0, 0, 1, true), {}, z, DorStyleSolid, 3, Square(0, 0, 1)},
        {Square(0, 0, 1), {}, z, DorStyleSolid, 2, Square(0, 0, 1)},
        {Square(0, 0, 1, true), {}, z, DorStyleWire, 3, Square(0, 0, 1, true)},
        {wall, {}, y, DorStyleSolid, 3, wall},
        {Square(0, 0, 4, true), {Square(1, 1, 2, true)}, z, DorStyleSolid, 3, Square(0, 0, 4)},
        {Square(0, 0, 4), {Square(1, 1, 2)}, z, DorStyleSolid, 1, Square(0, 0, 4)},
        {Square(0, 0, 4), {Square(1, 1, 1), triangle}, z, DorStyleSolid, 3, Square(0, 0, 4)},
        {Square(0, 0, 4, true), {Square(1, 1, 1), triangle}, z, DorStyleWire, 3, Square(0, 0, 4, true)},
        {wall, {window}, y, DorStyleSolid, 3, wall},
        {reversedWall, {window}, y, DorStyleSolid, 3, reversedWall}};
    for (size_t k = 0; k < sizeof cases / sizeof cases[0]; ++k) {
        SCOPED_TRACE(::testing::Message() << "case " << k);
        const auto& c = cases[k];
        CDorExtruded plain(Polygon(c.outline), c.height);
        CDorHoleExtruded holed(HolePolygon(c.outline, c.holes), c.height);
        plain.style = holed.style = c.style;
        plain.bottomCap = holed.bottomCap = c.caps & 1;
        plain.topCap = holed.topCap = c.caps & 2;
        CVelGroupArray groups = c.holes.empty() ? Convert(plain) : Convert(holed);
        const CDorArray<DorVector3, DorVector3&>& after = c.holes.empty() ? plain.bottom.points : holed.bottom.points;
        std::vector<Loop> loops = {c.after};
        loops.insert(loops.end(), c.holes.begin(), c.holes.end());
        ExpectPrism(groups, loops, c.height, c.style == DorStyleWire, c.caps);
        EXPECT_TRUE(std::equal(after.GetData(), after.GetData() + after.GetSize(), c.after.begin(), c.after.end(), SamePoint));
    }
}

// Walls carry the head's look, caps their own profile's; groups already in the array are reused
// as they are.
TEST(ExtrudedToPrimitive, WallsTakeTheHeadsLookAndCapsTheirProfiles)
{
    CDorExtruded cube(Polygon(Square(0, 0, 1)), DorVector3(0, 0, 1));
    cube.material.shininess = 5;
    cube.top.SetStyle(DorStyleWire);
    cube.bottom.material.shininess = 3;
    CVelGroupArray groups = Convert(cube);
    EXPECT_EQ(Layout(groups), "T4 T4 T4 T4 I4 L5 L5");
    EXPECT_TRUE(groups[3].material.shininess == 5.0f && groups[4].material.shininess == 3.0f && groups[5].material.shininess != 5.0f);
    cube.bottomCap = cube.topCap = 0;
    groups.SetSize(6);
    groups[0].lineWidth = 3;
    groups[0].OverlayFlag = 1;
    groups = Convert(cube, groups);
    EXPECT_TRUE(Layout(groups) == "T4 T4 T4 T4" && groups[0].lineWidth == 3.0f && groups[0].OverlayFlag == 1);
}

// Outlines of unequal size leave the array alone; hole pairs that cannot be joined (an empty
// loop, unequal loops, no top loop) add nothing; an empty profile has no point 0 to close a wire
// with; a single point still makes a wall, a flat profile a whole prism. Unknown styles give nothing.
TEST(ExtrudedToPrimitive, ProfilesThatCannotBeJoined)
{
    CDorExtruded unequal(Polygon(Square(0, 0, 1)), DorVector3(0, 0, 1)), empty;
    CDorExtruded dot(CDorPolygon({DorVector3(1, 1, 1)}), DorVector3(0, 0, 1)), flat(Polygon(Square(0, 0, 1)), DorVector3());
    unequal.top.AddPoint(DorVector3(0.5, 0.5, 1));
    CDorHoleExtruded block(HolePolygon(Square(0, 0, 4), {{}, Square(1, 1, 1), Square(2.5, 2.5, 1)}), DorVector3(0, 0, 1));
    CDorHoleExtruded unequalHoled = block;
    unequalHoled.top.points.SetSize(5);
    block.material.shininess = 3;
    block.top.holes[1].points.SetSize(3);
    block.top.holes.SetSize(2);  // the third pair has no top loop
    const struct { CDorGeometry* shape; const char *solid, *wire; } cases[] = {
        {&unequal, "", ""}, {&unequalHoled, "", ""}, {&empty, "", ""}, {&dot, "T4", "L4 S2 S2"},
        {&flat, "T4 T4 T4 T4 I4 I4", "L4 L4 L4 L4 S5 S5"}, {&block, "T4 T4 T4 T4 I12 I7", "L4 L4 L4 L4 S5 S5"}};
    CVelGroupArray two;
    two.SetSize(2);
    two[1].GroupType = VelGroupPoints;
    for (int style : {0, 1, 3}) {  // solid, wire, unknown
        for (size_t k = 0; k < sizeof cases / sizeof cases[0]; ++k) {
            cases[k].shape->style = style;
            const char* expected = style == DorStyleSolid ? cases[k].solid : style == DorStyleWire ? cases[k].wire : "";
            EXPECT_EQ(Layout(Convert(*cases[k].shape)), expected) << "case " << k << ", style " << style;
        }
        EXPECT_TRUE(Layout(Convert(unequal, two)) == "T0 P0" && Layout(Convert(unequalHoled, two)) == "T0 P0");
        CVelGroupArray walls = Convert(block);
        for (int g = 0; g < walls.GetSize() && (style == DorStyleWire || g < 4); ++g)
            EXPECT_TRUE(walls[g].material.shininess == 3.0f && walls[g].RenderKind == VelRenderLit && walls[g].texture == 0u) << g;
    }
    CVelGroupArray groups;
    CVelExtrudedToPrimitive().ConvertExtruded(nullptr, groups);
    CVelHoleExtrudedToPrimitive().ConvertHoleExtruded(nullptr, groups);
    EXPECT_EQ(groups.GetSize(), 0);
}

// A textured head textures the walls, not the caps: a wall spans its size / scale along each
// texture direction; an axis turns the texture so that u runs up the wall. A frustum's walls
// follow the actual point pairs.
TEST(ExtrudedToPrimitive, WallsCarryTheHeadsTexture)
{
    CDorExtruded cube(Polygon(Square(0, 0, 1)), DorVector3(0, 0, 1));
    CDorHoleExtruded block(HolePolygon(Square(0, 0, 4), {Square(1, 1, 2)}), DorVector3(0, 0, 1));
    cube.SetTexture(4, 0.5, 0.25);
    block.SetTexture(4, 2.0, 0.5);
    CVelGroupArray walls = Convert(cube), holed = Convert(block);
    for (int i = 0; i < 8; ++i) {
        const CVelTrianglePolys& g = i < 4 ? walls[i] : holed[i - 4];
        EXPECT_TRUE(g.RenderKind == VelRenderTextured && g.texture == 4u) << i;
        const DorVector2 &t0 = g.vertices[0].texcoord, &t1 = g.vertices[1].texcoord, &t2 = g.vertices[2].texcoord;
        EXPECT_NEAR(std::fabs(t0.x - t1.x) + std::fabs(t0.x - t2.x) + std::fabs(t0.y - t1.y) + std::fabs(t0.y - t2.y), i < 4 ? 6.0 : 4.0, 1e-9) << i;
    }
    EXPECT_TRUE(walls[4].RenderKind == VelRenderLit && holed[8].RenderKind == VelRenderLit && Layout(holed) == "T4 T4 T4 T4 T4 T4 T4 T4 I8 I8");
    cube.SetTexture(4, 0.5, 1.0);
    cube.textureAxis = DorVector3(0, 0, 3);
    walls = Convert(cube);
    for (int i = 0; i < 4; ++i)  // vertex 0 is top i, vertex 1 bottom i: one unit up the axis
        EXPECT_TRUE(Near(DorVector3(walls[i].vertices[0].texcoord.x, walls[i].vertices[0].texcoord.y, 0),
                         DorVector3(walls[i].vertices[1].texcoord.x + 2, walls[i].vertices[1].texcoord.y, 0), 1e-9)) << i;
    CDorExtruded frustum(Polygon(Square(0, 0, 1)), Polygon(Transformed(Square(0.25, 0.25, 0.5), DorTranslate(0, 0, 1))));
    DorVector3 n = Convert(frustum)[0].vertices[0].normal;  // wall 0 leans outward and up
    EXPECT_TRUE(n.y < 0 && n.z > 0 && std::fabs(DorLength(n) - 1) < 1e-12);
}
