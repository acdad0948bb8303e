#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "convert/vel_extruded_to_primitive.h"
#include "convert_test_support.h"

using namespace convert_test;

namespace {
void ExpectVector(const DorVector3& v, double x, double y, double z)
{
    EXPECT_NEAR(v.x, x, 1e-12);
    EXPECT_NEAR(v.y, y, 1e-12);
    EXPECT_NEAR(v.z, z, 1e-12);
}

bool SamePoint(const DorVector3& a, const DorVector3& b) { return a.x == b.x && a.y == b.y && a.z == b.z; }

const DorVector3 kSquare[4] = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 1, 0), DorVector3(0, 1, 0)};
const DorVector3 kClockwiseSquare[4] = {DorVector3(0, 0, 0), DorVector3(0, 1, 0), DorVector3(1, 1, 0), DorVector3(1, 0, 0)};
// Outward normals of the walls of the counter-clockwise unit cube, wall i from point i to i+1.
const double kWallNormals[4][3] = {{0, -1, 0}, {1, 0, 0}, {0, 1, 0}, {-1, 0, 0}};

// The unit cube between z = 0 and z = 1, both caps on.
class UnitCube : public ::testing::Test {
protected:
    void SetUp() override { Make(kSquare, kSquare); }
    void Make(const DorVector3* bottom, const DorVector3* top)
    {
        cube = CDorExtruded(CDorPolygon(bottom, 4), CDorPolygon(top, 4).Translated(DorVector3(0, 0, 1)));
    }
    CVelGroupArray Convert()
    {
        CVelGroupArray groups;
        CVelExtrudedToPrimitive().ConvertExtruded(&cube, groups);
        return groups;
    }
    void ExpectCubeSolid(const CVelGroupArray& groups)
    {
        ASSERT_EQ(groups.GetSize(), 6);
        for (int i = 0; i < 4; ++i) {
            const CVelTrianglePolys& wall = groups[i];
            EXPECT_EQ(wall.GroupType, VelGroupTriangleStrip);
            ASSERT_EQ(wall.vertices.GetSize(), 4);
            DorVector3 outward(kWallNormals[i][0], kWallNormals[i][1], kWallNormals[i][2]);
            for (int k = 0; k < 4; ++k)
                ExpectVector(wall.vertices[k].normal, outward.x, outward.y, outward.z);
            // top i, bottom i, top i+1: the strip's first triangle faces outward.
            EXPECT_EQ(wall.vertices[0].position.z, 1.0);
            EXPECT_EQ(wall.vertices[1].position.z, 0.0);
            EXPECT_GT(SignedDoubleArea(wall.vertices[0].position, wall.vertices[1].position,
                                       wall.vertices[2].position, outward), 0);
        }
        EXPECT_EQ(groups[4].GroupType, VelGroupIndexed);
        ExpectVector(groups[4].vertices[0].normal, 0, 0, -1);
        EXPECT_EQ(groups[4].vertices[0].position.z, 0.0);
        ExpectVector(groups[5].vertices[0].normal, 0, 0, 1);
        EXPECT_EQ(groups[5].vertices[0].position.z, 1.0);
        for (int c = 4; c < 6; ++c) {
            const CVelTrianglePolys& cap = groups[c];
            for (int t = 0; t < cap.triangles.GetSize(); ++t) {
                const _VelTriangleIndex& tri = cap.triangles[t];
                EXPECT_GT(SignedDoubleArea(cap.vertices[tri.a].position, cap.vertices[tri.b].position,
                                           cap.vertices[tri.c].position, cap.vertices[0].normal), 0);
            }
        }
    }
    CDorExtruded cube;
};
}  // namespace

TEST_F(UnitCube, SolidWallsFaceOutwardThenBottomAndTopCaps) { ExpectCubeSolid(Convert()); }

TEST_F(UnitCube, ClockwiseBottomIsReorderedInTheHostsOwnPoints)
{
    Make(kClockwiseSquare, kSquare);
    ExpectCubeSolid(Convert());
    const int expected[4] = {0, 1, 2, 3};  // point 0 kept, the rest reversed: now counter-clockwise
    for (int i = 0; i < 4; ++i)
        EXPECT_TRUE(SamePoint(cube.bottom.points[i], kSquare[expected[i]])) << i;
}

TEST_F(UnitCube, BothProfilesClockwiseAreBothReordered)
{
    Make(kClockwiseSquare, kClockwiseSquare);
    ExpectCubeSolid(Convert());
    EXPECT_TRUE(SamePoint(cube.top.points[1], DorVector3(1, 0, 1)));
}

TEST_F(UnitCube, CapsOffLeavesOpenWalls)
{
    cube.bottomCap = 0;
    cube.topCap = 0;
    EXPECT_EQ(Convert().GetSize(), 4);
    cube.topCap = 1;
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 5);
    ExpectVector(groups[4].vertices[0].normal, 0, 0, 1);
}

TEST_F(UnitCube, CapsFollowTheirOwnStyleAndMaterial)
{
    cube.top.SetStyle(DorStyleWire);
    cube.bottom.material.shininess = 3;
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 4 + 1 + 2);
    EXPECT_EQ(groups[4].material.shininess, 3.0f);
    EXPECT_EQ(groups[5].GroupType, VelGroupLines);
    EXPECT_EQ(groups[6].GroupType, VelGroupLines);
}

TEST_F(UnitCube, WallsCarryTheExtrusionsTexture)
{
    cube.SetTexture(4, 0.5, 0.25);
    CVelGroupArray groups = Convert();
    for (int i = 0; i < 4; ++i) {
        const CVelTrianglePolys& wall = groups[i];
        EXPECT_EQ(wall.RenderKind, VelRenderTextured);
        EXPECT_EQ(wall.texture, 4u);
        // A unit wall spans 1 / scale along each texture direction, in whichever orientation.
        double du = std::fabs(wall.vertices[0].texcoord.x - wall.vertices[1].texcoord.x) +
                    std::fabs(wall.vertices[0].texcoord.x - wall.vertices[2].texcoord.x);
        double dv = std::fabs(wall.vertices[0].texcoord.y - wall.vertices[1].texcoord.y) +
                    std::fabs(wall.vertices[0].texcoord.y - wall.vertices[2].texcoord.y);
        EXPECT_NEAR(du + dv, 2.0 + 4.0, 1e-9) << "wall " << i;
    }
    EXPECT_EQ(groups[4].RenderKind, VelRenderLit);  // the caps keep their own (none)
}

TEST_F(UnitCube, TextureAxisRunsAlongUOnEveryWall)
{
    cube.SetTexture(4, 0.5, 1.0);
    cube.textureAxis = DorVector3(0, 0, 3);
    CVelGroupArray groups = Convert();
    for (int i = 0; i < 4; ++i) {
        const CVelTrianglePolys& wall = groups[i];
        // Vertex 0 is top i and vertex 1 bottom i: one unit up the axis.
        EXPECT_NEAR(wall.vertices[0].texcoord.x - wall.vertices[1].texcoord.x, 2.0, 1e-9) << "wall " << i;
        EXPECT_NEAR(wall.vertices[0].texcoord.y - wall.vertices[1].texcoord.y, 0.0, 1e-9) << "wall " << i;
    }
}

TEST_F(UnitCube, ReusesTheGroupsAlreadyInTheArray)
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
}

TEST_F(UnitCube, DifferentPointCountsGiveNothingAndLeaveTheArray)
{
    cube.top.AddPoint(DorVector3(0.5, 0.5, 1));
    for (int style : {DorStyleSolid, DorStyleWire}) {
        cube.SetStyle(style);
        CVelGroupArray groups;
        groups.SetSize(2);
        CVelExtrudedToPrimitive().ConvertExtruded(&cube, groups);
        EXPECT_EQ(groups.GetSize(), 2);
    }
}

TEST_F(UnitCube, WireGivesWallEdgesAndTwoOutlines)
{
    cube.SetStyle(DorStyleWire);
    for (int caps : {0, 1}) {
        cube.bottomCap = cube.topCap = caps;
        CVelGroupArray groups = Convert();
        ASSERT_EQ(groups.GetSize(), 6);
        for (int i = 0; i < 4; ++i) {
            const CVelTrianglePolys& wall = groups[i];
            EXPECT_EQ(wall.GroupType, VelGroupLines);
            ASSERT_EQ(wall.vertices.GetSize(), 4);
            for (int k = 0; k < 4; ++k)
                ExpectVector(wall.vertices[k].normal, kWallNormals[i][0], kWallNormals[i][1], kWallNormals[i][2]);
            EXPECT_TRUE(SamePoint(wall.vertices[2].position, cube.top.points[(i + 1) % 4]));
            EXPECT_TRUE(SamePoint(wall.vertices[3].position, cube.bottom.points[(i + 1) % 4]));
        }
        for (int o = 4; o < 6; ++o) {
            EXPECT_EQ(groups[o].GroupType, VelGroupLineStrip);
            ASSERT_EQ(groups[o].vertices.GetSize(), 5);
            EXPECT_TRUE(SamePoint(groups[o].vertices[4].position, groups[o].vertices[0].position));
            EXPECT_EQ(groups[o].RenderKind, VelRenderLit);
        }
        ExpectVector(groups[4].vertices[2].normal, 0, 0, -1);
        ExpectVector(groups[5].vertices[2].normal, 0, 0, 1);
    }
}

TEST_F(UnitCube, WireNeverReordersTheProfiles)
{
    Make(kClockwiseSquare, kClockwiseSquare);
    cube.SetStyle(DorStyleWire);
    CVelGroupArray groups = Convert();
    ASSERT_EQ(groups.GetSize(), 6);
    EXPECT_TRUE(SamePoint(cube.bottom.points[1], kClockwiseSquare[1]));
    EXPECT_LT(DorDot(groups[0].vertices[0].normal, DorVector3(-1, 0, 0)), 0);  // wall 0 at x = 0 faces in
}

TEST(ExtrusionAlongY, ProfilesAreNotReorderedWhateverTheirOrder)
{
    // Profiles in the planes y = 0 and y = 2; the bottom is clockwise about +y.
    CDorPolygon bottom({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 0, 1), DorVector3(0, 0, 1)});
    ASSERT_LT(DorNewellNormal(bottom.points.GetData(), 4).y, 0);
    CDorExtruded along(bottom, DorVector3(0, 2, 0));
    CVelGroupArray groups;
    CVelExtrudedToPrimitive().ConvertExtruded(&along, groups);
    ASSERT_EQ(groups.GetSize(), 6);
    for (int i = 0; i < 4; ++i)
        EXPECT_TRUE(SamePoint(along.bottom.points[i], bottom.points[i]));
}

TEST(ExtrusionTapered, WallsFollowTheActualPointPairs)
{
    CDorPolygon bottom(kSquare, 4);
    CDorPolygon top({DorVector3(0.25, 0.25, 1), DorVector3(0.75, 0.25, 1), DorVector3(0.75, 0.75, 1),
                     DorVector3(0.25, 0.75, 1)});
    CDorExtruded frustum(bottom, top);
    CVelGroupArray groups;
    CVelExtrudedToPrimitive().ConvertExtruded(&frustum, groups);
    ASSERT_EQ(groups.GetSize(), 6);
    DorVector3 n = groups[0].vertices[0].normal;  // leans outward and up
    EXPECT_LT(n.y, 0);
    EXPECT_GT(n.z, 0);
    EXPECT_NEAR(DorLength(n), 1.0, 1e-12);
}

TEST(ExtrusionDegenerate, EmptySingleZeroHeightAndNonFiniteProfiles)
{
    const double nan = std::numeric_limits<double>::quiet_NaN();
    for (int style : {0, 1, 3}) {
        CDorExtruded empty;
        empty.SetStyle(style);
        CVelGroupArray groups;
        CVelExtrudedToPrimitive().ConvertExtruded(&empty, groups);
        EXPECT_EQ(groups.GetSize(), 0);

        CDorExtruded single(CDorPolygon({DorVector3(1, 1, 1)}), DorVector3(0, 0, 1));
        single.SetStyle(style);
        CVelExtrudedToPrimitive().ConvertExtruded(&single, groups);
        EXPECT_EQ(groups.GetSize(), style == DorStyleSolid ? 1 : style == DorStyleWire ? 3 : 0);

        CDorExtruded flat(CDorPolygon(kSquare, 4), DorVector3(0, 0, 0));
        flat.SetStyle(style);
        groups.SetSize(0);
        CVelExtrudedToPrimitive().ConvertExtruded(&flat, groups);
        EXPECT_EQ(groups.GetSize(), style == DorStyleSolid ? 6 : style == DorStyleWire ? 6 : 0);

        CDorExtruded broken(CDorPolygon({DorVector3(0, 0, 0), DorVector3(nan, 0, 0), DorVector3(1, 1, 0)}),
                            DorVector3(0, 0, 1));
        broken.SetStyle(style);
        groups.SetSize(0);
        CVelExtrudedToPrimitive().ConvertExtruded(&broken, groups);
        for (int g = 0; g < groups.GetSize(); ++g)
            for (int t = 0; t < groups[g].triangles.GetSize(); ++t)
                EXPECT_LT(groups[g].triangles[t].c, groups[g].vertices.GetSize());
    }
    CVelGroupArray groups;
    CVelExtrudedToPrimitive().ConvertExtruded(nullptr, groups);
    EXPECT_EQ(groups.GetSize(), 0);
}
