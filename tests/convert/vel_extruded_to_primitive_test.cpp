// The plain and the holed extrusion converters.
#include <algorithm>
#include <cmath>
#include <limits>

#include "convert/vel_extruded_to_primitive.h"
#include "convert/vel_hole_extruded_to_primitive.h"
#include "geometry_checks.h"

namespace {
// A flat wall strip: four records sharing one unit normal that both strip triangles face; the
// first record at height firstZ (unless negative), the second at the other end.
void ExpectWall(const CVelTrianglePolys& wall, double firstZ)
{
    EXPECT_EQ(wall.GroupType, VelGroupTriangleStrip);
    ASSERT_EQ(wall.vertices.GetSize(), 4);
    const DorVector3& n = wall.vertices[0].normal;
    EXPECT_NEAR(DorLength(n), 1.0, 1e-12);
    for (int k = 1; k < 4; ++k)
        EXPECT_TRUE(SamePoint(wall.vertices[k].normal, n));
    Mesh strip = MeshOf(wall);
    strip.i = {0, 1, 2, 2, 1, 3};
    CheckTriangles(strip, n);
    if (firstZ >= 0) {
        EXPECT_EQ(wall.vertices[0].position.z, firstZ);
        EXPECT_EQ(wall.vertices[1].position.z, 1 - firstZ);
    }
}

// A cap at height z in z = 0 or 1, facing away from the other: down at 0, up at 1.
void ExpectCap(const CVelTrianglePolys& cap, double z, double area)
{
    EXPECT_EQ(cap.GroupType, VelGroupIndexed);
    for (int k = 0; k < cap.vertices.GetSize(); ++k) {
        EXPECT_TRUE(Near(cap.vertices[k].normal, 0, 0, 2 * z - 1));
        EXPECT_EQ(cap.vertices[k].position.z, z);
    }
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

// Outward normals of the unit cube's walls, wall i from point i to i + 1.
const DorVector3 kWallNormals[4] = {DorVector3(0, -1, 0), DorVector3(1, 0, 0), DorVector3(0, 1, 0), DorVector3(-1, 0, 0)};

// The unit cube between z = 0 and z = 1, both caps on.
class UnitCube : public ::testing::Test {
protected:
    void Make(bool bottomClockwise, bool topClockwise)
    {
        cube = CDorExtruded(Polygon(Square(0, 0, 1, bottomClockwise)), Polygon(Transformed(Square(0, 0, 1, topClockwise), DorTranslate(0, 0, 1))));
    }
    CVelGroupArray Convert()
    {
        CVelGroupArray groups;
        CVelExtrudedToPrimitive().ConvertExtruded(&cube, groups);
        return groups;
    }
    CDorExtruded cube = CDorExtruded(Polygon(Square(0, 0, 1)), DorVector3(0, 0, 1));
};

// A 4 x 4 x 1 block with a 2 x 2 square hole through it, both caps on.
class BlockWithSquareHole : public ::testing::Test {
protected:
    void Make(const Loop& outline, const std::vector<Loop>& holes)
    {
        block = CDorHoleExtruded(HolePolygon(outline, holes), DorVector3(0, 0, 1));
        block.material.shininess = 3;
    }
    CVelGroupArray Convert()
    {
        CVelGroupArray groups;
        CVelHoleExtrudedToPrimitive().ConvertHoleExtruded(&block, groups);
        return groups;
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
        CVelGroupArray groups = Convert();
        ASSERT_EQ(groups.GetSize(), 6);
        for (int i = 0; i < 4; ++i) {
            ExpectWall(groups[i], 1);
            EXPECT_TRUE(Near(groups[i].vertices[0].normal, kWallNormals[i].x, kWallNormals[i].y, kWallNormals[i].z)) << i;
        }
        ExpectCap(groups[4], 0, 1);
        ExpectCap(groups[5], 1, 1);
        for (int k = 0; k < 4; ++k) {
            EXPECT_TRUE(SamePoint(cube.bottom.points[k], Square(0, 0, 1)[k])) << clockwise;
            EXPECT_TRUE(SamePoint(cube.top.points[k], Square(0, 0, 1)[k] + DorVector3(0, 0, 1))) << clockwise;
        }
    }
}

TEST_F(UnitCube, CapsFollowTheirFlagsStyleAndMaterial)
{
    cube.bottomCap = cube.topCap = 0;
    EXPECT_EQ(Convert().GetSize(), 4);
    cube.topCap = 1;
    ASSERT_EQ(Convert().GetSize(), 5);
    ExpectCap(Convert()[4], 1, 1);
    cube.bottomCap = 1;
    cube.top.SetStyle(DorStyleWire);
    cube.bottom.material.shininess = 3;
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 4 + 1 + 2);
    EXPECT_EQ(groups[4].material.shininess, 3.0f);
    EXPECT_EQ(groups[5].GroupType, VelGroupLines);
    EXPECT_EQ(groups[6].GroupType, VelGroupLines);
}

TEST_F(UnitCube, WallsCarryTheExtrusionsTextureAlongItsAxis)
{
    cube.SetTexture(4, 0.5, 0.25);
    CVelGroupArray groups = Convert();
    for (int i = 0; i < 4; ++i) {
        const CVelTrianglePolys& wall = groups[i];
        EXPECT_EQ(wall.RenderKind, VelRenderTextured);
        EXPECT_EQ(wall.texture, 4u);
        // A unit wall spans 1 / scale along each texture direction, in whichever orientation.
        const DorVector2 &t0 = wall.vertices[0].texcoord, &t1 = wall.vertices[1].texcoord, &t2 = wall.vertices[2].texcoord;
        EXPECT_NEAR(std::fabs(t0.x - t1.x) + std::fabs(t0.x - t2.x) + std::fabs(t0.y - t1.y) + std::fabs(t0.y - t2.y), 6.0, 1e-9) << i;
    }
    EXPECT_EQ(groups[4].RenderKind, VelRenderLit);  // the caps keep their own (none)
    cube.SetTexture(4, 0.5, 1.0);
    cube.textureAxis = DorVector3(0, 0, 3);
    groups = Convert();
    for (int i = 0; i < 4; ++i) {  // vertex 0 is top i, vertex 1 bottom i: one unit up the axis
        EXPECT_NEAR(groups[i].vertices[0].texcoord.x - groups[i].vertices[1].texcoord.x, 2.0, 1e-9) << i;
        EXPECT_NEAR(groups[i].vertices[0].texcoord.y - groups[i].vertices[1].texcoord.y, 0.0, 1e-9) << i;
    }
}

// Groups already in the array are reused as they are; unequal profiles leave the array alone.
TEST_F(UnitCube, ReusesTheArraysGroupsAndRefusesUnequalProfiles)
{
    cube.bottomCap = cube.topCap = 0;
    CVelGroupArray groups;
    groups.SetSize(6);
    groups[0].lineWidth = 3;
    groups[0].OverlayFlag = 1;
    CVelExtrudedToPrimitive().ConvertExtruded(&cube, groups);
    ASSERT_EQ(groups.GetSize(), 4);
    EXPECT_EQ(groups[0].lineWidth, 3.0f);
    EXPECT_EQ(groups[0].OverlayFlag, 1);
    EXPECT_EQ(groups[0].vertices.GetSize(), 4);
    cube.top.AddPoint(DorVector3(0.5, 0.5, 1));
    for (int style : {DorStyleSolid, DorStyleWire}) {
        cube.SetStyle(style);
        CVelExtrudedToPrimitive().ConvertExtruded(&cube, groups);
        EXPECT_EQ(groups.GetSize(), 4);
    }
}

// Wire extrusions ignore the cap flags and never reorder: a clockwise cube's walls face in.
TEST_F(UnitCube, WireIsWallEdgesAndBothOutlines)
{
    cube.SetStyle(DorStyleWire);
    for (int caps : {0, 1}) {
        cube.bottomCap = cube.topCap = caps;
        CVelGroupArray groups = Convert();
        ASSERT_EQ(groups.GetSize(), 6);
        for (int i = 0; i < 4; ++i) {
            EXPECT_EQ(groups[i].GroupType, VelGroupLines);
            ASSERT_EQ(groups[i].vertices.GetSize(), 4);
            for (int k = 0; k < 4; ++k)
                EXPECT_TRUE(Near(groups[i].vertices[k].normal, kWallNormals[i].x, kWallNormals[i].y, kWallNormals[i].z));
            EXPECT_TRUE(SamePoint(groups[i].vertices[2].position, cube.top.points[(i + 1) % 4]));
            EXPECT_TRUE(SamePoint(groups[i].vertices[3].position, cube.bottom.points[(i + 1) % 4]));
        }
        for (int o = 4; o < 6; ++o) {
            EXPECT_EQ(groups[o].GroupType, VelGroupLineStrip);
            ASSERT_EQ(groups[o].vertices.GetSize(), 5);
            EXPECT_TRUE(SamePoint(groups[o].vertices[4].position, groups[o].vertices[0].position));
            EXPECT_TRUE(Near(groups[o].vertices[2].normal, 0, 0, o == 4 ? -1 : 1));
            EXPECT_EQ(groups[o].RenderKind, VelRenderLit);
        }
    }
    Make(true, true);
    cube.SetStyle(DorStyleWire);
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 6);
    EXPECT_TRUE(SamePoint(cube.bottom.points[1], Square(0, 0, 1, true)[1]));
    EXPECT_LT(DorDot(groups[0].vertices[0].normal, DorVector3(-1, 0, 0)), 0);
}

TEST(ExtrudedToPrimitive, AlongYTaperedAndDegenerateProfiles)
{
    // Profiles in y = 0 and y = 2, the bottom clockwise about +y: not reordered along y.
    CDorPolygon bottom({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 0, 1), DorVector3(0, 0, 1)});
    CDorExtruded along(bottom, DorVector3(0, 2, 0));
    CVelGroupArray groups;
    CVelExtrudedToPrimitive().ConvertExtruded(&along, groups);
    ASSERT_EQ(groups.GetSize(), 6);
    for (int i = 0; i < 4; ++i)
        EXPECT_TRUE(SamePoint(along.bottom.points[i], bottom.points[i]));
    // A frustum's walls follow the actual point pairs: wall 0 leans outward and up.
    CDorExtruded frustum(Polygon(Square(0, 0, 1)), Polygon(Transformed(Square(0.25, 0.25, 0.5), DorTranslate(0, 0, 1))));
    groups.SetSize(0);
    CVelExtrudedToPrimitive().ConvertExtruded(&frustum, groups);
    ASSERT_EQ(groups.GetSize(), 6);
    DorVector3 n = groups[0].vertices[0].normal;
    EXPECT_TRUE(n.y < 0 && n.z > 0);
    EXPECT_NEAR(DorLength(n), 1.0, 1e-12);

    const double nan = std::numeric_limits<double>::quiet_NaN();
    const struct {
        CDorExtruded shape;
        int solid, wire;  // groups made
    } cases[] = {{CDorExtruded(), 0, 0},
                 {CDorExtruded(CDorPolygon({DorVector3(1, 1, 1)}), DorVector3(0, 0, 1)), 1, 3},
                 {CDorExtruded(Polygon(Square(0, 0, 1)), DorVector3(0, 0, 0)), 6, 6},
                 {CDorExtruded(CDorPolygon({DorVector3(0, 0, 0), DorVector3(nan, 0, 0), DorVector3(1, 1, 0)}), DorVector3(0, 0, 1)), -1, -1}};
    for (const auto& c : cases) {
        for (int style : {0, 1, 3}) {
            CDorExtruded shape = c.shape;
            shape.SetStyle(style);
            groups.SetSize(0);
            CVelExtrudedToPrimitive().ConvertExtruded(&shape, groups);
            int expected = style == DorStyleSolid ? c.solid : style == DorStyleWire ? c.wire : 0;
            if (expected >= 0)
                EXPECT_EQ(groups.GetSize(), expected) << "style " << style << ", " << c.shape.bottom.points.GetSize() << " points";
            EXPECT_TRUE(AllIndicesInRange(groups));
        }
    }
    groups.SetSize(0);
    CVelExtrudedToPrimitive().ConvertExtruded(nullptr, groups);
    EXPECT_EQ(groups.GetSize(), 0);
}

// Outline walls face out of the material, a counter-clockwise hole's walls into the opening;
// only the outline is ever reordered, in the host's own points keeping point 0.
TEST_F(BlockWithSquareHole, SolidIsOutlineWallsHoleWallsAndCapsWhicheverWayTheLoopsRun)
{
    for (bool clockwiseOutline : {false, true}) {
        for (bool clockwiseHole : {false, true}) {
            Make(Square(0, 0, 4, clockwiseOutline), {Square(1, 1, 2, clockwiseHole)});
            CVelGroupArray groups = Convert();
            ASSERT_EQ(groups.GetSize(), 10);
            for (int i = 0; i < 8; ++i) {
                ExpectWall(groups[i], i < 4 ? 1 : 0);  // outline walls top first, hole walls bottom first
                EXPECT_EQ(groups[i].material.shininess, 3.0f);
                EXPECT_EQ(FacesToward(groups[i], holeCentre), i >= 4 && !clockwiseHole) << "wall " << i;
            }
            for (int i = 4; i < 8; ++i)
                EXPECT_TRUE(SamePoint(groups[i].vertices[0].position, Square(1, 1, 2, clockwiseHole)[i - 4]));
            ExpectCap(groups[8], 0, 12);
            ExpectCap(groups[9], 1, 12);
            EXPECT_EQ(groups[8].vertices.GetSize(), 8);
            for (int k = 0; k < 4; ++k) {
                EXPECT_TRUE(SamePoint(block.bottom.points[k], Square(0, 0, 4)[k]));
                EXPECT_TRUE(SamePoint(block.top.points[k], Square(0, 0, 4)[k] + DorVector3(0, 0, 1)));
            }
            EXPECT_EQ(block.bottom.holes[0].points[1].y, clockwiseHole ? 3.0 : 1.0);
        }
    }
}

// Solid: the walls of only the last hole, caps with every hole. Wire: every hole, caps or not.
TEST_F(BlockWithSquareHole, WithTwoHolesOnlyTheSecondHolesWallsRemainInTheSolid)
{
    Make(Square(0, 0, 4), {Square(1, 1, 1), triangle});
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 4 + 3 + 2);
    for (int i = 4; i < 7; ++i) {
        ExpectWall(groups[i], 0);
        EXPECT_TRUE(SamePoint(groups[i].vertices[0].position, triangle[i - 4]));
    }
    EXPECT_EQ(groups[7].vertices.GetSize(), 4 + 4 + 3);
    block.style = DorStyleWire;
    block.bottomCap = block.topCap = 0;
    groups = Convert();
    ASSERT_EQ(groups.GetSize(), 6 + 6 + 5);
    EXPECT_TRUE(SamePoint(groups[12].vertices[0].position, triangle[0] + DorVector3(0, 0, 1)));
    EXPECT_EQ(groups[16].vertices.GetSize(), 4);
}

TEST_F(BlockWithSquareHole, CapFlagsAndTexture)
{
    Make(Square(0, 0, 4), {Square(1, 1, 2)});
    block.bottomCap = 0;
    ASSERT_EQ(Convert().GetSize(), 9);
    ExpectCap(Convert()[8], 1, 12);
    block.topCap = 0;
    CVelGroupArray plain = Convert();
    ASSERT_EQ(plain.GetSize(), 8);
    for (int i = 0; i < 8; ++i) {
        EXPECT_EQ(plain[i].RenderKind, VelRenderLit);
        for (int k = 0; k < 4; ++k)
            EXPECT_EQ(plain[i].vertices[k].texcoord.x, 0.0);
    }
    block.bottomCap = block.topCap = 1;
    block.SetTexture(4, 2.0, 0.5);
    CVelGroupArray textured = Convert();
    ASSERT_EQ(textured.GetSize(), 10);
    for (int i = 0; i < 8; ++i) {
        EXPECT_EQ(textured[i].RenderKind, VelRenderTextured);
        EXPECT_EQ(textured[i].texture, 4u);
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
        CVelGroupArray groups = Convert();
        ASSERT_EQ(groups.GetSize(), 6 + 6);
        for (int first : {0, 6}) {
            for (int i = first; i < first + 4; ++i) {
                EXPECT_EQ(groups[i].GroupType, VelGroupLines);
                ASSERT_EQ(groups[i].vertices.GetSize(), 4);
                EXPECT_EQ(groups[i].vertices[0].position.z, 1.0);
                EXPECT_EQ(groups[i].vertices[1].position.z, 0.0);
                EXPECT_EQ(FacesToward(groups[i], holeCentre), first == 6 || clockwise) << "side group " << i;
            }
            for (int loop : {first + 4, first + 5}) {
                EXPECT_EQ(groups[loop].GroupType, VelGroupLineStrip);
                ASSERT_EQ(groups[loop].vertices.GetSize(), 5);
                EXPECT_TRUE(SamePoint(groups[loop].vertices[4].position, groups[loop].vertices[0].position));
                EXPECT_EQ(groups[loop].vertices[0].normal.z, (loop == first + 4) != (clockwise && first == 0) ? -1.0 : 1.0);
                EXPECT_EQ(groups[loop].vertices[0].position.z, loop == first + 4 ? 0.0 : 1.0);
            }
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
    for (int style : {DorStyleSolid, DorStyleWire}) {
        block.style = style;
        EXPECT_EQ(Convert().GetSize(), style == DorStyleSolid ? 4 + 2 : 6) << "style " << style;
    }
    Make(Square(0, 0, 4), {Square(1, 1, 2)});
    block.top.points.SetSize(5);
    for (int style : {DorStyleSolid, DorStyleWire}) {  // unequal outlines: the groups untouched
        block.style = style;
        CVelGroupArray groups;
        groups.SetSize(2);
        groups[1].GroupType = VelGroupPoints;
        CVelHoleExtrudedToPrimitive().ConvertHoleExtruded(&block, groups);
        ASSERT_EQ(groups.GetSize(), 2);
        EXPECT_EQ(groups[1].GroupType, VelGroupPoints);
    }
    Make(Square(0, 0, 4), {Square(1, 1, 2)});
    block.bottom.holes[0].points[2].x = std::numeric_limits<double>::quiet_NaN();
    block.top.points[1].y = std::numeric_limits<double>::infinity();
    block.SetTexture(2, 0.0, 0.0);
    block.bottom.SetTexture(2, 0.0, 0.0);
    for (int style : {DorStyleSolid, DorStyleWire}) {
        block.style = style;
        EXPECT_TRUE(AllIndicesInRange(Convert())) << "style " << style;
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
        CVelGroupArray groups;
        CVelHoleExtrudedToPrimitive().ConvertHoleExtruded(&solid, groups);
        ASSERT_EQ(groups.GetSize(), 10);
        for (int i = 0; !reversed && i < 8; ++i)
            ExpectWall(groups[i], -1);
        EXPECT_TRUE(SamePoint(solid.bottom.points[1], wall[1]));
        EXPECT_EQ(FacesToward(groups[0], DorVector3(2, 0.1, 1.5)), reversed);
        EXPECT_TRUE(FacesToward(groups[4], DorVector3(1.5, 0.1, 1.5)));  // the window's walls face into it
        EXPECT_EQ(groups[8].triangles.GetSize(), 8);
    }
}
