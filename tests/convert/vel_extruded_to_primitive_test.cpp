// The plain and the holed extrusion converters.
#include <algorithm>
#include <cmath>
#include <limits>

#include "convert/vel_extruded_to_primitive.h"
#include "convert/vel_hole_extruded_to_primitive.h"
#include "geometry_checks.h"

namespace {
// A flat wall strip: one unit normal that both strip triangles face, the first record at height
// firstZ (unless negative) and the second at the other end.
void ExpectWall(const CVelTrianglePolys& wall, double firstZ)
{
    ASSERT_EQ(wall.vertices.GetSize(), 4);
    const DorVector3& n = wall.vertices[0].normal;
    EXPECT_NEAR(DorLength(n), 1.0, 1e-12);
    for (int k = 1; k < 4; ++k)
        EXPECT_TRUE(SamePoint(wall.vertices[k].normal, n));
    Mesh strip = MeshOf(wall);
    strip.i = {0, 1, 2, 2, 1, 3};
    CheckTriangles(strip, n);
    EXPECT_TRUE(firstZ < 0 || (wall.vertices[0].position.z == firstZ && wall.vertices[1].position.z == 1 - firstZ));
}

// A cap in z = 0 facing down or in z = 1 facing up, covering area.
void ExpectCap(const CVelTrianglePolys& cap, double z, double area)
{
    for (int k = 0; k < cap.vertices.GetSize(); ++k)
        EXPECT_TRUE(Near(cap.vertices[k].normal, 0, 0, 2 * z - 1) && cap.vertices[k].position.z == z);
    EXPECT_NEAR(CheckTriangles(MeshOf(cap), DorVector3(0, 0, 2 * z - 1)), area, 1e-12);
}

// Whether all of a group's normals point toward p from the group's centre.
bool FacesToward(const CVelTrianglePolys& g, const DorVector3& p)
{
    DorVector3 centre;
    for (int k = 0; k < g.vertices.GetSize(); ++k)
        centre = centre + g.vertices[k].position * (1.0 / g.vertices.GetSize());
    for (int k = 0; k < g.vertices.GetSize(); ++k)
        if (!(DorDot(g.vertices[k].normal, p - centre) > 0))
            return false;
    return true;
}

bool AllIndicesInRange(const CVelGroupArray& groups)
{
    for (int g = 0; g < groups.GetSize(); ++g)
        for (int k : MeshOf(groups[g]).i)
            if (k < 0 || k >= groups[g].vertices.GetSize())
                return false;
    return true;
}

template <class Shape> CVelGroupArray Convert(Shape& shape, CVelGroupArray groups = CVelGroupArray())
{
    CVelExtrudedToPrimitive().ConvertExtruded(&shape, groups);
    return groups;
}
template <> CVelGroupArray Convert(CDorHoleExtruded& shape, CVelGroupArray groups)
{
    CVelHoleExtrudedToPrimitive().ConvertHoleExtruded(&shape, groups);
    return groups;
}

// Outward normals of the unit cube's walls, wall i from point i to i + 1.
const DorVector3 kWallNormals[4] = {DorVector3(0, -1, 0), DorVector3(1, 0, 0), DorVector3(0, 1, 0), DorVector3(-1, 0, 0)};

// The unit cube between z = 0 and z = 1, both caps on.
class UnitCube : public ::testing::Test {
protected:
    void Make(bool bottomClockwise, bool topClockwise)
    {
        cube = CDorExtruded(Polygon(Square(0, 0, 1, bottomClockwise)), Polygon(Transformed(Square(0, 0, 1, topClockwise), DorTranslate(0, 0, 1))));
    }
    CDorExtruded cube = CDorExtruded(Polygon(Square(0, 0, 1)), DorVector3(0, 0, 1));
};

// A 4 x 4 x 1 block with a 2 x 2 square hole through it, both caps on; or with a 1 x 1 square
// and a triangle.
class BlockWithSquareHole : public ::testing::Test {
protected:
    void Make(const Loop& outline, const std::vector<Loop>& holes)
    {
        block = CDorHoleExtruded(HolePolygon(outline, holes), DorVector3(0, 0, 1));
        block.material.shininess = 3;
    }
    const DorVector3 holeCentre = DorVector3(2, 2, 0.5);
    const Loop triangle = {DorVector3(0.5, 3, 0), DorVector3(1.5, 3, 0), DorVector3(1, 3.5, 0)};
    CDorHoleExtruded block;
};
}  // namespace

// Solid extrusions turn a clockwise profile counter-clockwise in the host's own points,
// keeping point 0.
TEST_F(UnitCube, SolidIsOutwardWallsThenBottomAndTopCapsWhicheverWayTheProfilesRun)
{
    for (int clockwise = 0; clockwise < 3; ++clockwise) {
        Make(clockwise > 0, clockwise > 1);
        CVelGroupArray groups = Convert(cube);
        ASSERT_EQ(Layout(groups), "T4 T4 T4 T4 I4 I4");
        for (int i = 0; i < 4; ++i) {
            ExpectWall(groups[i], 1);
            EXPECT_TRUE(Near(groups[i].vertices[0].normal, kWallNormals[i].x, kWallNormals[i].y, kWallNormals[i].z)) << i;
        }
        ExpectCap(groups[4], 0, 1);
        ExpectCap(groups[5], 1, 1);
        for (int k = 0; k < 4; ++k)
            EXPECT_TRUE(SamePoint(cube.bottom.points[k], Square(0, 0, 1)[k]) &&
                        SamePoint(cube.top.points[k], Square(0, 0, 1)[k] + DorVector3(0, 0, 1))) << clockwise;
    }
}

// Caps follow their flags, style and material; groups already in the array are reused as they
// are; unequal profiles leave the array alone.
TEST_F(UnitCube, CapsAndTheGroupsArray)
{
    cube.bottomCap = cube.topCap = 0;
    EXPECT_EQ(Layout(Convert(cube)), "T4 T4 T4 T4");
    cube.topCap = 1;
    ExpectCap(Convert(cube)[4], 1, 1);
    cube.bottomCap = 1;
    cube.top.SetStyle(DorStyleWire);
    cube.bottom.material.shininess = 3;
    CVelGroupArray groups = Convert(cube);
    EXPECT_EQ(Layout(groups), "T4 T4 T4 T4 I4 L5 L5");
    EXPECT_EQ(groups[4].material.shininess, 3.0f);

    cube.bottomCap = cube.topCap = 0;
    groups.SetSize(6);
    groups[0].lineWidth = 3;
    groups[0].OverlayFlag = 1;
    groups = Convert(cube, groups);
    EXPECT_EQ(Layout(groups), "T4 T4 T4 T4");
    EXPECT_TRUE(groups[0].lineWidth == 3.0f && groups[0].OverlayFlag == 1);
    cube.top.AddPoint(DorVector3(0.5, 0.5, 1));
    for (int style : {DorStyleSolid, DorStyleWire}) {
        cube.SetStyle(style);
        EXPECT_EQ(Layout(Convert(cube, groups)), "T4 T4 T4 T4");
    }
}

TEST_F(UnitCube, WallsCarryTheExtrusionsTextureAlongItsAxis)
{
    cube.SetTexture(4, 0.5, 0.25);
    CVelGroupArray groups = Convert(cube);
    for (int i = 0; i < 4; ++i) {
        EXPECT_TRUE(groups[i].RenderKind == VelRenderTextured && groups[i].texture == 4u);
        // A unit wall spans 1 / scale along each texture direction, in whichever orientation.
        const DorVector2 &t0 = groups[i].vertices[0].texcoord, &t1 = groups[i].vertices[1].texcoord, &t2 = groups[i].vertices[2].texcoord;
        EXPECT_NEAR(std::fabs(t0.x - t1.x) + std::fabs(t0.x - t2.x) + std::fabs(t0.y - t1.y) + std::fabs(t0.y - t2.y), 6.0, 1e-9) << i;
    }
    EXPECT_EQ(groups[4].RenderKind, VelRenderLit);  // the caps keep their own (none)
    cube.SetTexture(4, 0.5, 1.0);
    cube.textureAxis = DorVector3(0, 0, 3);
    groups = Convert(cube);
    for (int i = 0; i < 4; ++i) {  // vertex 0 is top i, vertex 1 bottom i: one unit up the axis
        EXPECT_NEAR(groups[i].vertices[0].texcoord.x - groups[i].vertices[1].texcoord.x, 2.0, 1e-9) << i;
        EXPECT_NEAR(groups[i].vertices[0].texcoord.y - groups[i].vertices[1].texcoord.y, 0.0, 1e-9) << i;
    }
}

// Wire extrusions ignore the cap flags and never reorder: a clockwise cube's walls face in.
TEST_F(UnitCube, WireIsWallEdgesAndBothOutlines)
{
    cube.SetStyle(DorStyleWire);
    for (int caps : {0, 1}) {
        cube.bottomCap = cube.topCap = caps;
        CVelGroupArray groups = Convert(cube);
        ASSERT_EQ(Layout(groups), "L4 L4 L4 L4 S5 S5");
        for (int i = 0; i < 4; ++i) {
            for (int k = 0; k < 4; ++k)
                EXPECT_TRUE(Near(groups[i].vertices[k].normal, kWallNormals[i].x, kWallNormals[i].y, kWallNormals[i].z));
            EXPECT_TRUE(SamePoint(groups[i].vertices[2].position, cube.top.points[(i + 1) % 4]));
            EXPECT_TRUE(SamePoint(groups[i].vertices[3].position, cube.bottom.points[(i + 1) % 4]));
        }
        for (int o = 4; o < 6; ++o) {
            EXPECT_TRUE(SamePoint(groups[o].vertices[4].position, groups[o].vertices[0].position));
            EXPECT_TRUE(Near(groups[o].vertices[2].normal, 0, 0, o == 4 ? -1 : 1));
            EXPECT_EQ(groups[o].RenderKind, VelRenderLit);
        }
    }
    Make(true, true);
    cube.SetStyle(DorStyleWire);
    CVelGroupArray groups = Convert(cube);
    EXPECT_TRUE(SamePoint(cube.bottom.points[1], Square(0, 0, 1, true)[1]));
    EXPECT_LT(DorDot(groups[0].vertices[0].normal, DorVector3(-1, 0, 0)), 0);
}

TEST(ExtrudedToPrimitive, AlongYTaperedAndDegenerateProfiles)
{
    // Profiles in y = 0 and y = 2, the bottom clockwise about +y: not reordered along y.
    CDorPolygon bottom({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 0, 1), DorVector3(0, 0, 1)});
    CDorExtruded along(bottom, DorVector3(0, 2, 0));
    EXPECT_EQ(Convert(along).GetSize(), 6);
    for (int i = 0; i < 4; ++i)
        EXPECT_TRUE(SamePoint(along.bottom.points[i], bottom.points[i]));
    // A frustum's walls follow the actual point pairs: wall 0 leans outward and up.
    CDorExtruded frustum(Polygon(Square(0, 0, 1)), Polygon(Transformed(Square(0.25, 0.25, 0.5), DorTranslate(0, 0, 1))));
    DorVector3 n = Convert(frustum)[0].vertices[0].normal;
    EXPECT_TRUE(n.y < 0 && n.z > 0);
    EXPECT_NEAR(DorLength(n), 1.0, 1e-12);

    const double nan = std::numeric_limits<double>::quiet_NaN();
    const struct {
        CDorExtruded shape;
        int solid, wire;  // groups made; negative: any
    } cases[] = {{CDorExtruded(), 0, 0},
                 {CDorExtruded(CDorPolygon({DorVector3(1, 1, 1)}), DorVector3(0, 0, 1)), 1, 3},
                 {CDorExtruded(Polygon(Square(0, 0, 1)), DorVector3(0, 0, 0)), 6, 6},
                 {CDorExtruded(CDorPolygon({DorVector3(0, 0, 0), DorVector3(nan, 0, 0), DorVector3(1, 1, 0)}), DorVector3(0, 0, 1)), -1, -1}};
    for (const auto& c : cases) {
        for (int style : {0, 1, 3}) {
            CDorExtruded shape = c.shape;
            shape.SetStyle(style);
            CVelGroupArray groups = Convert(shape);
            int expected = style == DorStyleSolid ? c.solid : style == DorStyleWire ? c.wire : 0;
            EXPECT_TRUE(expected < 0 || groups.GetSize() == expected) << style << ", " << c.shape.bottom.points.GetSize() << " points";
            EXPECT_TRUE(AllIndicesInRange(groups));
        }
    }
    CVelGroupArray groups;
    CVelExtrudedToPrimitive().ConvertExtruded(nullptr, groups);
    EXPECT_EQ(groups.GetSize(), 0);
}

// Outline walls face out of the material, a counter-clockwise hole's walls into the opening;
// only the outline is ever reordered, in the host's own points keeping point 0.
TEST_F(BlockWithSquareHole, SolidIsOutlineWallsHoleWallsAndCapsWhicheverWayTheLoopsRun)
{
    for (int clockwise = 0; clockwise < 4; ++clockwise) {
        bool outlineClockwise = clockwise & 1, holeClockwise = clockwise & 2;
        Make(Square(0, 0, 4, outlineClockwise), {Square(1, 1, 2, holeClockwise)});
        CVelGroupArray groups = Convert(block);
        ASSERT_EQ(Layout(groups), "T4 T4 T4 T4 T4 T4 T4 T4 I8 I8");
        for (int i = 0; i < 8; ++i) {
            ExpectWall(groups[i], i < 4 ? 1 : 0);  // outline walls top first, hole walls bottom first
            EXPECT_EQ(groups[i].material.shininess, 3.0f);
            EXPECT_EQ(FacesToward(groups[i], holeCentre), i >= 4 && !holeClockwise) << "wall " << i;
            EXPECT_TRUE(i < 4 || SamePoint(groups[i].vertices[0].position, Square(1, 1, 2, holeClockwise)[i - 4]));
        }
        ExpectCap(groups[8], 0, 12);
        ExpectCap(groups[9], 1, 12);
        for (int k = 0; k < 4; ++k)
            EXPECT_TRUE(SamePoint(block.bottom.points[k], Square(0, 0, 4)[k]) &&
                        SamePoint(block.top.points[k], Square(0, 0, 4)[k] + DorVector3(0, 0, 1)));
        EXPECT_EQ(block.bottom.holes[0].points[1].y, holeClockwise ? 3.0 : 1.0);
    }
}

// Solid: the walls of only the last hole, caps with every hole. Wire: every hole, caps or not.
TEST_F(BlockWithSquareHole, WithTwoHolesOnlyTheSecondHolesWallsRemainInTheSolid)
{
    Make(Square(0, 0, 4), {Square(1, 1, 1), triangle});
    CVelGroupArray groups = Convert(block);
    ASSERT_EQ(Layout(groups), "T4 T4 T4 T4 T4 T4 T4 I11 I11");
    for (int i = 4; i < 7; ++i) {
        ExpectWall(groups[i], 0);
        EXPECT_TRUE(SamePoint(groups[i].vertices[0].position, triangle[i - 4]));
    }
    block.style = DorStyleWire;
    block.bottomCap = block.topCap = 0;
    groups = Convert(block);
    ASSERT_EQ(Layout(groups), "L4 L4 L4 L4 S5 S5 L4 L4 L4 L4 S5 S5 L4 L4 L4 S4 S4");
    EXPECT_TRUE(SamePoint(groups[12].vertices[0].position, triangle[0] + DorVector3(0, 0, 1)));
}

TEST_F(BlockWithSquareHole, CapFlagsAndTexture)
{
    Make(Square(0, 0, 4), {Square(1, 1, 2)});
    block.bottomCap = 0;
    ExpectCap(Convert(block)[8], 1, 12);
    block.topCap = 0;
    CVelGroupArray plain = Convert(block);
    ASSERT_EQ(plain.GetSize(), 8);
    for (int i = 0; i < 8; ++i)
        for (int k = 0; k < 4; ++k)
            EXPECT_TRUE(plain[i].RenderKind == VelRenderLit && plain[i].vertices[k].texcoord.x == 0.0);
    block.bottomCap = block.topCap = 1;
    block.SetTexture(4, 2.0, 0.5);
    CVelGroupArray textured = Convert(block);
    for (int i = 0; i < 8; ++i) {
        EXPECT_TRUE(textured[i].RenderKind == VelRenderTextured && textured[i].texture == 4u);
        // Along the wall's height the texture runs 1 / 0.5 = 2 repeats; across it 2 units / 2.
        const DorVector2 &top = textured[i].vertices[i < 4 ? 0 : 1].texcoord, &bottom = textured[i].vertices[i < 4 ? 1 : 0].texcoord;
        EXPECT_NEAR(std::fabs(top.y - bottom.y) + std::fabs(top.x - bottom.x), 2.0, 1e-12) << "wall " << i;
    }
    EXPECT_EQ(textured[8].RenderKind, VelRenderLit);  // the caps follow their own profiles
}

// Wire never reorders: a clockwise outline's side edges face inward.
TEST_F(BlockWithSquareHole, WireIsSideEdgesAndLoopsOfOutlineThenHole)
{
    for (bool clockwise : {false, true}) {
        Make(Square(0, 0, 4, clockwise), {Square(1, 1, 2)});
        block.style = DorStyleWire;
        CVelGroupArray groups = Convert(block);
        ASSERT_EQ(Layout(groups), "L4 L4 L4 L4 S5 S5 L4 L4 L4 L4 S5 S5");
        for (int i = 0; i < 12; ++i) {
            const CVelTrianglePolys& g = groups[i];
            bool outline = i < 6, side = i % 6 < 4, bottomLoop = i % 6 == 4;
            EXPECT_EQ(g.vertices[0].position.z, bottomLoop ? 0.0 : 1.0) << i;  // sides run top, bottom, top, bottom
            EXPECT_TRUE(side ? g.vertices[1].position.z == 0.0 : SamePoint(g.vertices[4].position, g.vertices[0].position));
            EXPECT_TRUE(side ? FacesToward(g, holeCentre) == (!outline || clockwise)
                             : g.vertices[0].normal.z == (bottomLoop != (clockwise && outline) ? -1.0 : 1.0)) << i;
        }
        EXPECT_EQ(groups[10].material.shininess, 3.0f);
        EXPECT_EQ(block.bottom.points[1].y, clockwise ? 4.0 : 0.0);
    }
}

TEST_F(BlockWithSquareHole, UnequalLoopsAndNonFiniteCoordinatesStaySafe)
{
    Make(Square(0, 0, 4), {{}, Square(1, 1, 1), Square(2.5, 2.5, 1)});
    block.top.holes[1].points.SetSize(3);  // differs from its bottom loop
    block.top.holes.SetSize(2);            // the third pair has no top loop
    EXPECT_EQ(Convert(block).GetSize(), 4 + 2);
    block.style = DorStyleWire;
    EXPECT_EQ(Convert(block).GetSize(), 6);
    Make(Square(0, 0, 4), {Square(1, 1, 2)});
    block.top.points.SetSize(5);
    CVelGroupArray two;
    two.SetSize(2);
    two[1].GroupType = VelGroupPoints;
    for (int style : {DorStyleSolid, DorStyleWire}) {  // unequal outlines: the groups untouched
        block.style = style;
        EXPECT_EQ(Layout(Convert(block, two)), "T0 P0");
    }
    Make(Square(0, 0, 4), {Square(1, 1, 2)});
    block.bottom.holes[0].points[2].x = std::numeric_limits<double>::quiet_NaN();
    block.top.points[1].y = std::numeric_limits<double>::infinity();
    block.SetTexture(2, 0.0, 0.0);
    block.bottom.SetTexture(2, 0.0, 0.0);
    for (int style : {DorStyleSolid, DorStyleWire}) {
        block.style = style;
        EXPECT_TRUE(AllIndicesInRange(Convert(block))) << "style " << style;
    }
}

// A wall in the x-z plane, 0.2 thick along y, with a window: along y each outline is its own
// reference, so neither way round is reordered and a reversed outline's walls face into the wall.
TEST(WallWithWindow, ExtrudedAlongYIsNeverReordered)
{
    Loop wall = {DorVector3(0, 0, 0), DorVector3(0, 0, 3), DorVector3(4, 0, 3), DorVector3(4, 0, 0)};
    Loop window = {DorVector3(1, 0, 1), DorVector3(1, 0, 2), DorVector3(2, 0, 2), DorVector3(2, 0, 1)};
    for (bool reversed : {false, true}) {
        if (reversed)
            std::reverse(wall.begin() + 1, wall.end());
        CDorHoleExtruded solid(HolePolygon(wall, {window}), DorVector3(0, 0.2, 0));
        CVelGroupArray groups = Convert(solid);
        ASSERT_EQ(groups.GetSize(), 10);
        for (int i = 0; !reversed && i < 8; ++i)
            ExpectWall(groups[i], -1);
        EXPECT_TRUE(SamePoint(solid.bottom.points[1], wall[1]));
        EXPECT_EQ(FacesToward(groups[0], DorVector3(2, 0.1, 1.5)), reversed);
        EXPECT_TRUE(FacesToward(groups[4], DorVector3(1.5, 0.1, 1.5)));  // the window's walls face into it
        EXPECT_EQ(groups[8].triangles.GetSize(), 8);
    }
}
