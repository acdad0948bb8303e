#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "convert/vel_polygon_to_primitive.h"
#include "convert_test_support.h"

using namespace convert_test;

namespace {
_DorMaterial Red()
{
    _DorMaterial m;
    m.diffuse = DorColorValue(1, 0, 0, 1);
    m.shininess = 12;
    return m;
}

void ExpectSameMaterial(const _DorMaterial& a, const _DorMaterial& b)
{
    EXPECT_EQ(a.diffuse.r, b.diffuse.r);
    EXPECT_EQ(a.diffuse.g, b.diffuse.g);
    EXPECT_EQ(a.ambient.b, b.ambient.b);
    EXPECT_EQ(a.shininess, b.shininess);
}

void ExpectVector(const DorVector3& v, double x, double y, double z)
{
    EXPECT_NEAR(v.x, x, 1e-12);
    EXPECT_NEAR(v.y, y, 1e-12);
    EXPECT_NEAR(v.z, z, 1e-12);
}

// A counter-clockwise unit square in z = 0, anchored at offset.
class UnitSquare : public ::testing::Test {
protected:
    void SetUp() override { MakeAt(DorVector3(0, 0, 0)); }
    void MakeAt(const DorVector3& offset)
    {
        square = CDorPolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 1, 0), DorVector3(0, 1, 0)});
        square = square.Translated(offset);
        square.material = Red();
    }
    CVelGroupArray Convert(int reverse)
    {
        CVelGroupArray groups;
        CVelPolygonToPrimitive().ConvertPolygon(&square, groups, reverse);
        return groups;
    }
    CDorPolygon square;
};
}  // namespace

TEST_F(UnitSquare, SolidFrontFaceIsCounterClockwiseAboutPlusZ)
{
    CVelGroupArray groups = Convert(0);
    ASSERT_EQ(groups.GetSize(), 1);
    const CVelTrianglePolys& g = groups[0];
    EXPECT_EQ(g.GroupType, VelGroupIndexed);
    ASSERT_EQ(g.vertices.GetSize(), 4);
    ASSERT_EQ(g.triangles.GetSize(), 2);
    double area = 0;
    for (int t = 0; t < 2; ++t) {
        const _VelTriangleIndex& tri = g.triangles[t];
        double twice = SignedDoubleArea(g.vertices[tri.a].position, g.vertices[tri.b].position,
                                        g.vertices[tri.c].position, DorVector3(0, 0, 1));
        EXPECT_GT(twice, 0);
        area += twice / 2;
    }
    EXPECT_DOUBLE_EQ(area, 1.0);
    for (int i = 0; i < 4; ++i) {
        ExpectVector(g.vertices[i].normal, 0, 0, 1);
        EXPECT_EQ(g.vertices[i].position.x, square.points[i].x);
        EXPECT_EQ(g.vertices[i].position.y, square.points[i].y);
        EXPECT_NEAR(g.vertices[i].texcoord.x, square.points[i].x, 1e-12);
        EXPECT_NEAR(g.vertices[i].texcoord.y, square.points[i].y, 1e-12);
    }
    ExpectSameMaterial(g.material, Red());
    EXPECT_EQ(g.RenderKind, VelRenderLit);
    EXPECT_EQ(g.texture, 0u);
}

TEST_F(UnitSquare, SolidBackFaceTurnsNormalAndWinding)
{
    CVelGroupArray front = Convert(0), back = Convert(1);
    ASSERT_EQ(back.GetSize(), 1);
    ASSERT_EQ(back[0].triangles.GetSize(), 2);
    for (int t = 0; t < 2; ++t) {
        EXPECT_EQ(back[0].triangles[t].a, front[0].triangles[t].c);
        EXPECT_EQ(back[0].triangles[t].b, front[0].triangles[t].b);
        EXPECT_EQ(back[0].triangles[t].c, front[0].triangles[t].a);
    }
    for (int i = 0; i < 4; ++i)
        ExpectVector(back[0].vertices[i].normal, 0, 0, -1);
}

TEST_F(UnitSquare, OtherReverseValuesCountAsFront)
{
    CVelGroupArray front = Convert(0), other = Convert(7);
    ExpectVector(other[0].vertices[0].normal, 0, 0, 1);
    EXPECT_EQ(other[0].triangles[0].a, front[0].triangles[0].a);
}

TEST_F(UnitSquare, TextureScalesDivideThePlaneCoordinates)
{
    square.SetTexture(5, 2.0, 0.5);
    CVelGroupArray groups = Convert(0);
    const CVelTrianglePolys& g = groups[0];
    EXPECT_EQ(g.RenderKind, VelRenderTextured);
    EXPECT_EQ(g.texture, 5u);
    for (int i = 0; i < 4; ++i) {
        EXPECT_NEAR(g.vertices[i].texcoord.x, square.points[i].x / 2.0, 1e-12);
        EXPECT_NEAR(g.vertices[i].texcoord.y, square.points[i].y * 2.0, 1e-12);
    }
}

TEST_F(UnitSquare, TextureAxisTurnsUAndOriginIsIgnoredWithoutIt)
{
    square.textureOrigin = DorVector3(0.3, 0.3, 0);
    CVelGroupArray plain = Convert(0);
    EXPECT_NEAR(plain[0].vertices[1].texcoord.x, 1.0, 1e-12);  // the origin needs an axis

    square.textureAxis = DorVector3(0, 1, 0);
    square.textureOrigin = DorVector3(0, 0, 0);
    CVelGroupArray turned = Convert(0);
    for (int i = 0; i < 4; ++i) {  // a quarter turn: (x, y) -> (-y, x)
        EXPECT_NEAR(turned[0].vertices[i].texcoord.x, -square.points[i].y, 1e-12);
        EXPECT_NEAR(turned[0].vertices[i].texcoord.y, square.points[i].x, 1e-12);
    }
}

TEST_F(UnitSquare, TextureOriginShiftsByItsScaledPosition)
{
    square.textureAxis = DorVector3(1, 0, 0);
    square.textureOrigin = DorVector3(0.5, 0.25, 0);
    square.SetTexture(1, 2.0, 1.0);
    CVelGroupArray groups = Convert(0);
    for (int i = 0; i < 4; ++i) {
        EXPECT_NEAR(groups[0].vertices[i].texcoord.x, square.points[i].x / 2.0 + 0.25, 1e-12);
        EXPECT_NEAR(groups[0].vertices[i].texcoord.y, square.points[i].y + 0.25, 1e-12);
    }
}

TEST_F(UnitSquare, TextureAxisIsAPointThatMovesWithThePolygon)
{
    square.textureAxis = DorVector3(0, 1, 0);
    CVelGroupArray atOrigin = Convert(0);
    MakeAt(DorVector3(5, 5, 0));
    square.textureAxis = DorVector3(5, 6, 0);  // the same point relative to point 0
    CVelGroupArray moved = Convert(0);
    for (int i = 0; i < 4; ++i) {
        EXPECT_NEAR(moved[0].vertices[i].texcoord.x, atOrigin[0].vertices[i].texcoord.x, 1e-12);
        EXPECT_NEAR(moved[0].vertices[i].texcoord.y, atOrigin[0].vertices[i].texcoord.y, 1e-12);
    }
    square.textureAxis = DorVector3(0, 1, 0);  // now a point behind point 0, not "up"
    CVelGroupArray asPoint = Convert(0);
    EXPECT_GT(std::fabs(asPoint[0].vertices[1].texcoord.x - atOrigin[0].vertices[1].texcoord.x), 0.1);
}

TEST_F(UnitSquare, ZeroTextureScaleGivesNonFiniteCoordinatesWithoutHarm)
{
    square.SetTexture(1, 0.0, 0.0);
    CVelGroupArray groups = Convert(0);
    ASSERT_EQ(groups.GetSize(), 1);
    EXPECT_FALSE(std::isfinite(groups[0].vertices[1].texcoord.x));
}

TEST_F(UnitSquare, WireGivesTwoIdenticalGroupsOfSeparateSegments)
{
    square.SetStyle(DorStyleWire);
    square.SetTexture(9);
    CVelGroupArray groups = Convert(0);
    ASSERT_EQ(groups.GetSize(), 2);
    for (int k = 0; k < 2; ++k) {
        const CVelTrianglePolys& g = groups[k];
        EXPECT_EQ(g.GroupType, VelGroupLines);
        ASSERT_EQ(g.vertices.GetSize(), 5);
        for (int i = 0; i < 5; ++i) {
            EXPECT_EQ(g.vertices[i].position.x, square.points[i % 4].x);
            EXPECT_EQ(g.vertices[i].position.y, square.points[i % 4].y);
            ExpectVector(g.vertices[i].normal, 0, 0, 1);
        }
        ExpectSameMaterial(g.material, Red());
        EXPECT_EQ(g.RenderKind, VelRenderLit);
        EXPECT_EQ(g.texture, 0u);
    }
}

TEST_F(UnitSquare, WireBackFaceTurnsOnlyTheNormal)
{
    square.SetStyle(DorStyleWire);
    CVelGroupArray groups = Convert(1);
    ASSERT_EQ(groups.GetSize(), 2);
    EXPECT_EQ(groups[1].vertices[2].position.x, 1.0);
    ExpectVector(groups[1].vertices[2].normal, 0, 0, -1);
}

TEST_F(UnitSquare, OtherStylesProduceNothing)
{
    for (int style : {2, -1, 100}) {
        square.SetStyle(style);
        EXPECT_EQ(Convert(0).GetSize(), 0);
    }
}

TEST(PolygonDegenerate, CollinearSolidNothingWireZeroNormal)
{
    CDorPolygon line({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0)});
    CVelGroupArray groups;
    CVelPolygonToPrimitive converter;
    converter.ConvertPolygon(&line, groups, 0);
    EXPECT_EQ(groups.GetSize(), 0);
    line.SetStyle(DorStyleWire);
    converter.ConvertPolygon(&line, groups, 1);
    ASSERT_EQ(groups.GetSize(), 2);
    EXPECT_EQ(DorLength(groups[0].vertices[0].normal), 0.0);
}

TEST(PolygonDegenerate, EmptyAndSinglePointOutlines)
{
    CVelPolygonToPrimitive converter;
    for (int style : {DorStyleSolid, DorStyleWire}) {
        CDorPolygon empty;
        empty.SetStyle(style);
        CVelGroupArray groups;
        converter.ConvertPolygon(&empty, groups, 0);
        EXPECT_EQ(groups.GetSize(), 0);
        converter.ConvertPolygon(nullptr, groups, 0);
        EXPECT_EQ(groups.GetSize(), 0);
    }
    CDorPolygon dot({DorVector3(1, 2, 3)});
    dot.SetStyle(DorStyleWire);
    CVelGroupArray groups;
    converter.ConvertPolygon(&dot, groups, 0);
    ASSERT_EQ(groups.GetSize(), 2);
    EXPECT_EQ(groups[0].vertices.GetSize(), 2);
}

TEST(PolygonDegenerate, NaNCornerDoesNotReadOutOfBounds)
{
    const double nan = std::numeric_limits<double>::quiet_NaN();
    CDorPolygon bad({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, nan, 0), DorVector3(0, 1, 0)});
    CVelGroupArray groups;
    CVelPolygonToPrimitive().ConvertPolygon(&bad, groups, 0);
    for (int g = 0; g < groups.GetSize(); ++g)
        for (int t = 0; t < groups[g].triangles.GetSize(); ++t)
            EXPECT_LT(groups[g].triangles[t].a, groups[g].vertices.GetSize());
}

TEST(PolygonCaps, AppendsAfterWhatIsThere)
{
    CDorPolygon square({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 1, 0), DorVector3(0, 1, 0)});
    CVelGroupArray groups;
    groups.SetSize(3);
    CVelPolygonToPrimitive().ConvertPolygon(&square, groups, 0);
    ASSERT_EQ(groups.GetSize(), 4);
    EXPECT_EQ(groups[3].GroupType, VelGroupIndexed);
    EXPECT_EQ(groups[0].GroupType, VelGroupTriangleStrip);
}
