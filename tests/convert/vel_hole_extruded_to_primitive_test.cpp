#include <gtest/gtest.h>

#include <algorithm>
#include <limits>

#include "convert/vel_hole_extruded_to_primitive.h"
#include "hole_test_support.h"

using namespace hole_test;

namespace {
bool SamePosition(const DorVector3& a, const DorVector3& b) { return a.x == b.x && a.y == b.y && a.z == b.z; }

DorVector3 Centre(const CVelTrianglePolys& g)
{
    DorVector3 sum;
    for (int k = 0; k < g.vertices.GetSize(); ++k)
        sum = sum + g.vertices[k].position;
    return sum * (1.0 / g.vertices.GetSize());
}

// A flat wall: four records with one unit normal, both strip triangles facing it.
void ExpectFlatWallFacingItsNormal(const CVelTrianglePolys& wall)
{
    EXPECT_EQ(wall.GroupType, VelGroupTriangleStrip);
    ASSERT_EQ(wall.vertices.GetSize(), 4);
    const DorVector3& n = wall.vertices[0].normal;
    EXPECT_NEAR(DorLength(n), 1.0, 1e-12);
    for (int k = 1; k < 4; ++k)
        EXPECT_TRUE(SamePosition(wall.vertices[k].normal, n));
    const DorVector3 &v0 = wall.vertices[0].position, &v1 = wall.vertices[1].position,
                     &v2 = wall.vertices[2].position, &v3 = wall.vertices[3].position;
    EXPECT_GT(convert_test::SignedDoubleArea(v0, v1, v2, n), 0);
    EXPECT_GT(convert_test::SignedDoubleArea(v2, v1, v3, n), 0);
}

// Whether a group's normals (all of them) point toward p from the group's centre.
bool FacesToward(const CVelTrianglePolys& g, const DorVector3& p)
{
    for (int k = 0; k < g.vertices.GetSize(); ++k) {
        if (!(DorDot(g.vertices[k].normal, p - Centre(g)) > 0))
            return false;
    }
    return true;
}

// A 4 x 4 x 1 block with a 2 x 2 square hole through it, both caps on.
class BlockWithSquareHole : public ::testing::Test {
protected:
    void SetUp() override { Make(Square(0, 0, 4), {Square(1, 1, 2)}); }
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
    CDorHoleExtruded block;
};
}  // namespace

TEST_F(BlockWithSquareHole, SolidIsOutlineWallsHoleWallsAndTwoCaps)
{
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 10);
    for (int i = 0; i < 8; ++i) {
        ExpectFlatWallFacingItsNormal(groups[i]);
        EXPECT_EQ(groups[i].material.shininess, 3.0f);
    }
    for (int i = 0; i < 4; ++i) {
        EXPECT_FALSE(FacesToward(groups[i], holeCentre)) << "outline wall " << i << " faces inward";
        EXPECT_EQ(groups[i].vertices[0].position.z, 1.0);  // top, bottom, top, bottom
        EXPECT_EQ(groups[i].vertices[1].position.z, 0.0);
    }
    for (int i = 4; i < 8; ++i) {
        EXPECT_TRUE(FacesToward(groups[i], holeCentre)) << "hole wall " << i - 4 << " faces into the material";
        EXPECT_EQ(groups[i].vertices[0].position.z, 0.0);  // bottom, top, bottom, top
        EXPECT_EQ(groups[i].vertices[1].position.z, 1.0);
        EXPECT_TRUE(SamePosition(groups[i].vertices[0].position, block.bottom.holes[0].points[i - 4]));
    }
    for (int c = 8; c < 10; ++c) {
        EXPECT_EQ(groups[c].GroupType, VelGroupIndexed);
        EXPECT_EQ(groups[c].vertices.GetSize(), 8);
        EXPECT_EQ(groups[c].triangles.GetSize(), 8);
    }
    EXPECT_EQ(groups[8].vertices[0].normal.z, -1.0);  // bottom cap turned over
    EXPECT_EQ(groups[8].vertices[0].position.z, 0.0);
    EXPECT_EQ(groups[9].vertices[0].normal.z, 1.0);
    EXPECT_EQ(groups[9].vertices[0].position.z, 1.0);
}

TEST_F(BlockWithSquareHole, HoleGivenClockwiseGetsWallsFacingIntoTheMaterial)
{
    Make(Square(0, 0, 4), {Square(1, 1, 2, true)});
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 10);
    for (int i = 4; i < 8; ++i) {
        ExpectFlatWallFacingItsNormal(groups[i]);
        EXPECT_FALSE(FacesToward(groups[i], holeCentre));
    }
    EXPECT_EQ(block.bottom.holes[0].points[1].y, 3.0);  // the hole is never reordered
}

TEST_F(BlockWithSquareHole, ClockwiseOutlineIsReorderedInPlaceKeepingPointZero)
{
    Make(Square(0, 0, 4, true), {Square(1, 1, 2)});
    Loop clockwise = Square(0, 0, 4, true);
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 10);
    for (const CDorHolePolygon* profile : {&block.bottom, &block.top}) {
        EXPECT_TRUE(SamePosition(profile->points[0], profile == &block.bottom ? clockwise[0] : clockwise[0] + DorVector3(0, 0, 1)));
        for (int k = 1; k < 4; ++k) {
            EXPECT_EQ(profile->points[k].x, clockwise[4 - k].x);
            EXPECT_EQ(profile->points[k].y, clockwise[4 - k].y);
        }
    }
    for (int i = 0; i < 4; ++i)
        EXPECT_FALSE(FacesToward(groups[i], holeCentre));
}

TEST_F(BlockWithSquareHole, WithTwoHolesOnlyTheSecondHolesWallsRemain)
{
    Loop triangle = {DorVector3(0.5, 3, 0), DorVector3(1.5, 3, 0), DorVector3(1, 3.5, 0)};
    Make(Square(0, 0, 4), {Square(1, 1, 1), triangle});
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 4 + 3 + 2);
    for (int i = 4; i < 7; ++i) {
        ExpectFlatWallFacingItsNormal(groups[i]);
        EXPECT_TRUE(SamePosition(groups[i].vertices[0].position, triangle[i - 4]));
    }
    EXPECT_EQ(groups[7].vertices.GetSize(), 4 + 4 + 3);  // the caps keep both holes
}

TEST_F(BlockWithSquareHole, CapFlagsChooseTheCaps)
{
    block.bottomCap = 0;
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 9);
    EXPECT_EQ(groups[8].vertices[0].normal.z, 1.0);
    block.topCap = 0;
    EXPECT_EQ(Convert().GetSize(), 8);
}

TEST_F(BlockWithSquareHole, TexturedWallsGetCoordinatesUntexturedOnesNone)
{
    CVelGroupArray plain = Convert();
    for (int i = 0; i < 8; ++i) {
        EXPECT_EQ(plain[i].RenderKind, VelRenderLit);
        for (int k = 0; k < 4; ++k)
            EXPECT_EQ(plain[i].vertices[k].texcoord.x, 0.0);
    }
    block.SetTexture(4, 2.0, 0.5);
    CVelGroupArray textured = Convert();
    ASSERT_EQ(textured.GetSize(), 10);
    for (int i = 0; i < 8; ++i) {
        EXPECT_EQ(textured[i].RenderKind, VelRenderTextured);
        EXPECT_EQ(textured[i].texture, 4u);
        // Along the wall's height the texture runs 1 / 0.5 = 2 repeats; across it 2 units / 2.
        const DorVector2 &top = textured[i].vertices[i < 4 ? 0 : 1].texcoord,
                         &bottom = textured[i].vertices[i < 4 ? 1 : 0].texcoord;
        EXPECT_NEAR(std::fabs(top.y - bottom.y) + std::fabs(top.x - bottom.x), 2.0, 1e-12) << "wall " << i;
    }
    EXPECT_EQ(textured[8].RenderKind, VelRenderLit);  // the caps follow their own profiles
}

TEST_F(BlockWithSquareHole, WireDrawsSideEdgesAndLoopsOfOutlineAndHole)
{
    block.style = DorStyleWire;
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 6 + 6);
    for (int first : {0, 6}) {
        for (int i = first; i < first + 4; ++i) {
            EXPECT_EQ(groups[i].GroupType, VelGroupLines);
            ASSERT_EQ(groups[i].vertices.GetSize(), 4);
            EXPECT_EQ(groups[i].vertices[0].position.z, 1.0);  // top, bottom, top, bottom
            EXPECT_EQ(groups[i].vertices[1].position.z, 0.0);
            EXPECT_EQ(FacesToward(groups[i], holeCentre), first == 6) << "side group " << i;
        }
        for (int loop : {first + 4, first + 5}) {
            EXPECT_EQ(groups[loop].GroupType, VelGroupLineStrip);
            ASSERT_EQ(groups[loop].vertices.GetSize(), 5);
            EXPECT_TRUE(SamePosition(groups[loop].vertices[4].position, groups[loop].vertices[0].position));
            EXPECT_EQ(groups[loop].vertices[0].normal.z, loop == first + 4 ? -1.0 : 1.0);
            EXPECT_EQ(groups[loop].vertices[0].position.z, loop == first + 4 ? 0.0 : 1.0);
        }
    }
    EXPECT_EQ(groups[10].material.shininess, 3.0f);
}

TEST_F(BlockWithSquareHole, WireAppendsEveryHoleAndIgnoresTheCapFlags)
{
    Loop triangle = {DorVector3(0.5, 3, 0), DorVector3(1.5, 3, 0), DorVector3(1, 3.5, 0)};
    Make(Square(0, 0, 4), {Square(1, 1, 1), triangle});
    block.style = DorStyleWire;
    block.bottomCap = block.topCap = 0;
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 6 + 6 + 5);
    EXPECT_TRUE(SamePosition(groups[12].vertices[0].position, triangle[0] + DorVector3(0, 0, 1)));
    EXPECT_EQ(groups[16].vertices.GetSize(), 4);
}

TEST_F(BlockWithSquareHole, WireNeverReordersAClockwiseOutline)
{
    Make(Square(0, 0, 4, true), {Square(1, 1, 2)});
    block.style = DorStyleWire;
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 12);
    EXPECT_EQ(block.bottom.points[1].y, 4.0);
    EXPECT_TRUE(FacesToward(groups[0], holeCentre));  // a clockwise outline's sides face inward
}

TEST_F(BlockWithSquareHole, UnequalOutlinesLeaveTheGroupsUntouched)
{
    block.top.points.SetSize(5);
    for (int style : {DorStyleSolid, DorStyleWire}) {
        block.style = style;
        CVelGroupArray groups;
        groups.SetSize(2);
        groups[1].GroupType = VelGroupPoints;
        CVelHoleExtrudedToPrimitive().ConvertHoleExtruded(&block, groups);
        ASSERT_EQ(groups.GetSize(), 2);
        EXPECT_EQ(groups[1].GroupType, VelGroupPoints);
    }
}

TEST_F(BlockWithSquareHole, UnpairedHolesAreSkippedSafely)
{
    Make(Square(0, 0, 4), {{}, Square(1, 1, 1), Square(2.5, 2.5, 1)});
    block.top.holes[1].points.SetSize(3);  // differs from its bottom loop
    block.top.holes.SetSize(2);            // the third pair has no top loop
    for (int style : {DorStyleSolid, DorStyleWire}) {
        block.style = style;
        CVelGroupArray groups = Convert();
        EXPECT_EQ(groups.GetSize(), style == DorStyleSolid ? 4 + 2 : 6) << "style " << style;
    }
}

TEST_F(BlockWithSquareHole, NonFiniteCoordinatesAndZeroScalesStaySafe)
{
    block.bottom.holes[0].points[2].x = std::numeric_limits<double>::quiet_NaN();
    block.top.points[1].y = std::numeric_limits<double>::infinity();
    block.SetTexture(2, 0.0, 0.0);
    block.bottom.SetTexture(2, 0.0, 0.0);
    for (int style : {DorStyleSolid, DorStyleWire}) {
        block.style = style;
        CVelGroupArray groups = Convert();
        for (int g = 0; g < groups.GetSize(); ++g) {
            for (int t = 0; t < groups[g].triangles.GetSize(); ++t) {
                EXPECT_LT(groups[g].triangles[t].a, groups[g].vertices.GetSize());
                EXPECT_LT(groups[g].triangles[t].c, groups[g].vertices.GetSize());
            }
        }
    }
}

// A wall standing in the x-z plane, 20 cm thick along y, with a window opening: extruded
// straight along y, so each outline keeps its own orientation.
TEST(WallWithWindow, ExtrudedAlongYIsNeverReordered)
{
    Loop wall = {DorVector3(0, 0, 0), DorVector3(0, 0, 3), DorVector3(4, 0, 3), DorVector3(4, 0, 0)};
    Loop window = {DorVector3(1, 0, 1), DorVector3(1, 0, 2), DorVector3(2, 0, 2), DorVector3(2, 0, 1)};
    CDorHoleExtruded solid(HolePolygon(wall, {window}), DorVector3(0, 0.2, 0));
    CVelGroupArray groups;
    CVelHoleExtrudedToPrimitive().ConvertHoleExtruded(&solid, groups);
    ASSERT_EQ(groups.GetSize(), 10);
    EXPECT_EQ(solid.bottom.points[1].z, 3.0);
    for (int i = 0; i < 8; ++i)
        ExpectFlatWallFacingItsNormal(groups[i]);
    EXPECT_TRUE(FacesToward(groups[4], DorVector3(1.5, 0.1, 1.5)));  // the window's walls face into it
    EXPECT_EQ(groups[8].triangles.GetSize(), 8);

    // Given the other way round it is still not reordered: along y each outline is its own
    // reference, so its walls now face into the wall.
    std::reverse(wall.begin() + 1, wall.end());
    CDorHoleExtruded reversed(HolePolygon(wall, {window}), DorVector3(0, 0.2, 0));
    groups.SetSize(0);
    CVelHoleExtrudedToPrimitive().ConvertHoleExtruded(&reversed, groups);
    ASSERT_EQ(groups.GetSize(), 10);
    EXPECT_EQ(reversed.bottom.points[1].x, 4.0);
    EXPECT_TRUE(FacesToward(groups[0], DorVector3(2, 0.1, 1.5)));
}
