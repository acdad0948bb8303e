#include <gtest/gtest.h>

#include <cmath>

#include "hole_test_support.h"

using namespace hole_test;

namespace {
void ExpectVector(const DorVector3& v, double x, double y, double z, double tolerance = 1e-12)
{
    EXPECT_NEAR(v.x, x, tolerance);
    EXPECT_NEAR(v.y, y, tolerance);
    EXPECT_NEAR(v.z, z, tolerance);
}

bool SamePosition(const DorVector3& a, const DorVector3& b) { return a.x == b.x && a.y == b.y && a.z == b.z; }

// The 4 x 4 face with a triangular hole, in a shininess of its own.
class FaceWithTriangularHole : public ::testing::Test {
protected:
    void SetUp() override
    {
        shape = HolePolygon(Square(0, 0, 4), {{DorVector3(1, 1, 0), DorVector3(3, 1, 0), DorVector3(2, 3, 0)}});
        shape.material.shininess = 9;
    }
    CVelGroupArray Convert(int flip)
    {
        CVelGroupArray groups;
        CVelHolePolygonToPrimitive().ConvertHolePolygon(&shape, groups, flip);
        return groups;
    }
    CDorHolePolygon shape;
};

// The area of a type 6 group's triangles, each checked counter-clockwise about its stored normal.
double FrontFacingArea(const CVelTrianglePolys& g)
{
    double area = 0;
    for (int t = 0; t < g.triangles.GetSize(); ++t) {
        const _VelTriangleIndex& tri = g.triangles[t];
        EXPECT_TRUE(tri.a >= 0 && tri.a < g.vertices.GetSize() && tri.b >= 0 && tri.b < g.vertices.GetSize() &&
                    tri.c >= 0 && tri.c < g.vertices.GetSize());
        double twice = convert_test::SignedDoubleArea(g.vertices[tri.a].position, g.vertices[tri.b].position,
                                                      g.vertices[tri.c].position, g.vertices[tri.a].normal);
        EXPECT_GT(twice, 0) << "triangle " << t << " faces away from its normal";
        area += twice / 2;
    }
    return area;
}
}  // namespace

TEST_F(FaceWithTriangularHole, SolidIsOneIndexedGroupOverAllSevenVertices)
{
    CVelGroupArray groups = Convert(0);
    ASSERT_EQ(groups.GetSize(), 1);
    const CVelTrianglePolys& g = groups[0];
    EXPECT_EQ(g.GroupType, VelGroupIndexed);
    ASSERT_EQ(g.vertices.GetSize(), 7);
    EXPECT_EQ(g.triangles.GetSize(), 7);
    EXPECT_NEAR(FrontFacingArea(g), 14.0, 1e-12);
    for (int k = 0; k < 7; ++k) {
        ExpectVector(g.vertices[k].normal, 0, 0, 1);
        EXPECT_EQ(g.vertices[k].texcoord.x, 0.0);  // untextured: no coordinates
        EXPECT_EQ(g.vertices[k].colour.a, 1.0f);
    }
    EXPECT_TRUE(SamePosition(g.vertices[4].position, shape.holes[0].points[0]));
    EXPECT_EQ(g.material.shininess, 9.0f);
    EXPECT_EQ(g.RenderKind, VelRenderLit);
    EXPECT_EQ(g.texture, 0u);
}

TEST_F(FaceWithTriangularHole, FlipTurnsTheNormalAndReversesEveryTriple)
{
    CVelGroupArray front = Convert(0), back = Convert(1);
    ASSERT_EQ(back.GetSize(), 1);
    ASSERT_EQ(back[0].triangles.GetSize(), front[0].triangles.GetSize());
    for (int t = 0; t < back[0].triangles.GetSize(); ++t) {
        EXPECT_EQ(back[0].triangles[t].a, front[0].triangles[t].c);
        EXPECT_EQ(back[0].triangles[t].b, front[0].triangles[t].b);
        EXPECT_EQ(back[0].triangles[t].c, front[0].triangles[t].a);
    }
    for (int k = 0; k < 7; ++k) {
        ExpectVector(back[0].vertices[k].normal, 0, 0, -1);
        EXPECT_TRUE(SamePosition(back[0].vertices[k].position, front[0].vertices[k].position));
    }
    EXPECT_NEAR(FrontFacingArea(back[0]), 14.0, 1e-12);
}

TEST_F(FaceWithTriangularHole, OtherStylesProduceNothing)
{
    shape.style = 2;
    EXPECT_EQ(Convert(0).GetSize(), 0);
    CVelGroupArray groups;
    CVelHolePolygonToPrimitive().ConvertHolePolygon(nullptr, groups, 0);
    EXPECT_EQ(groups.GetSize(), 0);
}

TEST_F(FaceWithTriangularHole, ZeroTextureAxisGivesPlaneCoordinatesOverTheScales)
{
    shape.SetTexture(5, 2.0, 4.0);
    CVelGroupArray groups = Convert(0);
    ASSERT_EQ(groups.GetSize(), 1);
    const CVelTrianglePolys& g = groups[0];
    EXPECT_EQ(g.RenderKind, VelRenderTextured);
    EXPECT_EQ(g.texture, 5u);
    for (int k = 0; k < g.vertices.GetSize(); ++k) {
        EXPECT_NEAR(g.vertices[k].texcoord.x, g.vertices[k].position.x / 2.0, 1e-12);
        EXPECT_NEAR(g.vertices[k].texcoord.y, g.vertices[k].position.y / 4.0, 1e-12);
    }
}

// An axis along +y turns the texture a quarter turn; the origin is then added in scaled units.
TEST_F(FaceWithTriangularHole, HoleTextureAxisTurnsAndOriginShifts)
{
    shape.SetTexture(5, 1.0, 1.0);
    shape.holeTextureAxis = DorVector3(0, 1, 0);
    shape.holeTextureOrigin = DorVector3(1, 2, 0);
    shape.textureAxis = DorVector3(1, 1, 0);  // the plain polygon's vectors are not read
    shape.textureOrigin = DorVector3(9, 9, 0);
    CVelGroupArray groups = Convert(0);
    const CVelTrianglePolys& g = groups[0];
    for (int k = 0; k < g.vertices.GetSize(); ++k) {
        const DorVector3& p = g.vertices[k].position;
        EXPECT_NEAR(g.vertices[k].texcoord.x, -p.y + 1, 1e-12);
        EXPECT_NEAR(g.vertices[k].texcoord.y, p.x + 2, 1e-12);
    }
}

TEST_F(FaceWithTriangularHole, ZeroTextureScaleDoesNotCrash)
{
    shape.SetTexture(5, 0.0, 0.0);
    shape.holeTextureAxis = DorVector3(1, 1, 0);
    CVelGroupArray groups = Convert(1);
    ASSERT_EQ(groups.GetSize(), 1);
    EXPECT_FALSE(std::isfinite(groups[0].vertices[1].texcoord.x));
}

TEST_F(FaceWithTriangularHole, WireIsOneClosedLoopPerOutlineAndHole)
{
    shape.style = DorStyleWire;
    CVelGroupArray groups = Convert(0);
    ASSERT_EQ(groups.GetSize(), 2);
    const int sizes[2] = {5, 4};
    const CDorArray<DorVector3, DorVector3&>* loops[2] = {&shape.points, &shape.holes[0].points};
    for (int l = 0; l < 2; ++l) {
        const CVelTrianglePolys& g = groups[l];
        EXPECT_EQ(g.GroupType, VelGroupLines);
        ASSERT_EQ(g.vertices.GetSize(), sizes[l]);
        for (int k = 0; k < sizes[l]; ++k) {
            EXPECT_TRUE(SamePosition(g.vertices[k].position, (*loops[l])[k < sizes[l] - 1 ? k : 0]));
            ExpectVector(g.vertices[k].normal, 0, 0, 1);
        }
        EXPECT_EQ(g.material.shininess, 9.0f);
        EXPECT_EQ(g.RenderKind, VelRenderLit);
    }
}

TEST_F(FaceWithTriangularHole, WireFlipTurnsTheNormalOnly)
{
    shape.style = DorStyleWire;
    CVelGroupArray front = Convert(0), back = Convert(1);
    ASSERT_EQ(back.GetSize(), 2);
    for (int l = 0; l < 2; ++l) {
        for (int k = 0; k < back[l].vertices.GetSize(); ++k) {
            EXPECT_TRUE(SamePosition(back[l].vertices[k].position, front[l].vertices[k].position));
            ExpectVector(back[l].vertices[k].normal, 0, 0, -1);
        }
    }
}

TEST(HoledFaceFallback, ATriangleWithoutHolesIsTheTriangleZeroOneTwo)
{
    CDorHolePolygon triangle = HolePolygon({DorVector3(0, 0, 0), DorVector3(3, 0, 0), DorVector3(1, 2, 0)}, {});
    CVelGroupArray groups;
    CVelHolePolygonToPrimitive().ConvertHolePolygon(&triangle, groups, 0);
    ASSERT_EQ(groups.GetSize(), 1);
    ASSERT_EQ(groups[0].triangles.GetSize(), 1);
    EXPECT_EQ(groups[0].triangles[0].a, 0);
    EXPECT_EQ(groups[0].triangles[0].b, 1);
    EXPECT_EQ(groups[0].triangles[0].c, 2);
}

TEST(HoledFaceFallback, NearlyCollinearOutlineKeepsItsUnnormalisedNormal)
{
    CDorHolePolygon sliver = HolePolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 1e-6, 0)}, {});
    CVelGroupArray groups;
    CVelHolePolygonToPrimitive().ConvertHolePolygon(&sliver, groups, 1);
    ASSERT_EQ(groups.GetSize(), 1);
    ASSERT_EQ(groups[0].triangles.GetSize(), 1);
    EXPECT_EQ(groups[0].triangles[0].a, 2);  // flipped
    ExpectVector(groups[0].vertices[0].normal, 0, 0, -1e-6, 1e-18);
}

TEST(HoledFaceFallback, FewerThanThreeVerticesGiveNoGroup)
{
    CDorHolePolygon segment = HolePolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0)}, {});
    CVelGroupArray groups;
    CVelHolePolygonToPrimitive().ConvertHolePolygon(&segment, groups, 0);
    EXPECT_EQ(groups.GetSize(), 0);
}

TEST(HoledFaceBadInput, EmptyAndOnePointHolesStaySafe)
{
    CDorHolePolygon shape = HolePolygon(Square(0, 0, 4), {{}, {DorVector3(2, 2, 0)}, Square(1, 1, 1)});
    CVelGroupArray groups;
    CVelHolePolygonToPrimitive().ConvertHolePolygon(&shape, groups, 0);
    ASSERT_EQ(groups.GetSize(), 1);
    EXPECT_EQ(groups[0].vertices.GetSize(), 9);
    FrontFacingArea(groups[0]);

    shape.style = DorStyleWire;
    groups.SetSize(0);
    CVelHolePolygonToPrimitive().ConvertHolePolygon(&shape, groups, 0);
    ASSERT_EQ(groups.GetSize(), 4);
    EXPECT_EQ(groups[1].vertices.GetSize(), 0);  // nothing to close an empty loop with
    EXPECT_EQ(groups[2].vertices.GetSize(), 2);  // a point drawn as a zero-length segment
    EXPECT_EQ(groups[3].vertices.GetSize(), 5);
}
