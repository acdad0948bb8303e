// The plain and the holed face converters.
#include <cmath>
#include <limits>

#include "convert/vel_polygon_to_primitive.h"
#include "geometry_checks.h"

namespace {
// Front and flipped conversions of a face in z = 0: one indexed group each over the same
// vertices, the flipped one with the normal turned and every triple reversed, both covering
// area counter-clockwise about their normal.
void ExpectSolidFace(const CVelGroupArray& front, const CVelGroupArray& back, int vertices, int triangles, double area)
{
    ASSERT_EQ(front.GetSize(), 1);
    ASSERT_EQ(back.GetSize(), 1);
    for (const CVelTrianglePolys* g : {&front[0], &back[0]}) {
        EXPECT_EQ(g->GroupType, VelGroupIndexed);
        ASSERT_EQ(g->vertices.GetSize(), vertices);
        ASSERT_EQ(g->triangles.GetSize(), triangles);
        double z = g == &front[0] ? 1 : -1;
        EXPECT_NEAR(CheckTriangles(MeshOf(*g), DorVector3(0, 0, z)), area, 1e-12);
        for (int k = 0; k < vertices; ++k) {
            EXPECT_TRUE(Near(g->vertices[k].normal, 0, 0, z)) << k;
            EXPECT_TRUE(SamePoint(g->vertices[k].position, front[0].vertices[k].position));
        }
    }
    for (int t = 0; t < triangles; ++t) {
        EXPECT_EQ(back[0].triangles[t].a, front[0].triangles[t].c);
        EXPECT_EQ(back[0].triangles[t].b, front[0].triangles[t].b);
        EXPECT_EQ(back[0].triangles[t].c, front[0].triangles[t].a);
    }
}

// One line group per loop, each closed by repeating its first point, every normal along z.
void ExpectWireLoops(const CVelGroupArray& groups, const std::vector<Loop>& loops, double z, float shininess)
{
    ASSERT_EQ(groups.GetSize(), static_cast<int>(loops.size()));
    for (size_t l = 0; l < loops.size(); ++l) {
        const CVelTrianglePolys& g = groups[static_cast<int>(l)];
        EXPECT_EQ(g.GroupType, VelGroupLines);
        ASSERT_EQ(g.vertices.GetSize(), static_cast<int>(loops[l].size()) + 1);
        for (int k = 0; k < g.vertices.GetSize(); ++k) {
            EXPECT_TRUE(SamePoint(g.vertices[k].position, loops[l][k % loops[l].size()])) << l << ", " << k;
            EXPECT_TRUE(Near(g.vertices[k].normal, 0, 0, z));
        }
        EXPECT_EQ(g.material.shininess, shininess);
        EXPECT_EQ(g.RenderKind, VelRenderLit);
        EXPECT_EQ(g.texture, 0u);
    }
}

// A counter-clockwise unit square in z = 0.
class UnitSquare : public ::testing::Test {
protected:
    void SetUp() override { square.material.shininess = 12; }
    CVelGroupArray Convert(int reverse)
    {
        CVelGroupArray groups;
        CVelPolygonToPrimitive().ConvertPolygon(&square, groups, reverse);
        return groups;
    }
    CDorPolygon square = Polygon(Square(0, 0, 1));
};

// The 4 x 4 face with a triangular hole, in a shininess of its own.
class FaceWithTriangularHole : public ::testing::Test {
protected:
    void SetUp() override { shape.material.shininess = 9; }
    CVelGroupArray Convert(int flip)
    {
        CVelGroupArray groups;
        CVelHolePolygonToPrimitive().ConvertHolePolygon(&shape, groups, flip);
        return groups;
    }
    Loop hole = {DorVector3(1, 1, 0), DorVector3(3, 1, 0), DorVector3(2, 3, 0)};
    CDorHolePolygon shape = HolePolygon(Square(0, 0, 4), {hole});
};
}  // namespace

TEST_F(UnitSquare, SolidIsOneLitGroupAndReverseOneTurnsIt)
{
    CVelGroupArray front = Convert(0), other = Convert(7);  // any other value counts as front
    ExpectSolidFace(front, Convert(1), 4, 2, 1.0);
    EXPECT_EQ(MeshOf(other[0]).i, MeshOf(front[0]).i);
    EXPECT_TRUE(Near(other[0].vertices[0].normal, 0, 0, 1));
    for (int k = 0; k < 4; ++k) {
        EXPECT_TRUE(SamePoint(front[0].vertices[k].position, square.points[k]));
        EXPECT_NEAR(front[0].vertices[k].texcoord.x, square.points[k].x, 1e-12);
        EXPECT_NEAR(front[0].vertices[k].texcoord.y, square.points[k].y, 1e-12);
    }
    EXPECT_EQ(front[0].material.shininess, 12.0f);
    EXPECT_EQ(front[0].RenderKind, VelRenderLit);
    EXPECT_EQ(front[0].texture, 0u);
}

// Texture coordinates u, v as du.x * x + du.y * y + du.z (and dv) of the unit square's corner (x, y).
TEST_F(UnitSquare, TextureCoordinatesUnderScalesAxesAndOrigins)
{
    const struct {
        DorVector3 offset, axis, origin;
        double scaleU, scaleV;
        DorVector3 du, dv;
    } cases[] = {
        {DorVector3(), DorVector3(), DorVector3(), 2.0, 0.5, DorVector3(0.5, 0, 0), DorVector3(0, 2, 0)},
        {DorVector3(), DorVector3(), DorVector3(0.3, 0.3, 0), 1, 1, DorVector3(1, 0, 0), DorVector3(0, 1, 0)},  // no axis: no origin
        {DorVector3(), DorVector3(0, 1, 0), DorVector3(), 1, 1, DorVector3(0, -1, 0), DorVector3(1, 0, 0)},  // a quarter turn
        {DorVector3(), DorVector3(1, 0, 0), DorVector3(0.5, 0.25, 0), 2, 1, DorVector3(0.5, 0, 0.25), DorVector3(0, 1, 0.25)},
        {DorVector3(5, 5, 0), DorVector3(5, 6, 0), DorVector3(5, 5, 0), 1, 1, DorVector3(0, -1, 0), DorVector3(1, 0, 0)},  // points
    };
    for (const auto& c : cases) {
        square = Polygon(Square(c.offset.x, c.offset.y, 1));
        square.textureAxis = c.axis;
        square.textureOrigin = c.origin;
        square.SetTexture(5, c.scaleU, c.scaleV);
        CVelGroupArray groups = Convert(0);
        EXPECT_EQ(groups[0].RenderKind, VelRenderTextured);
        EXPECT_EQ(groups[0].texture, 5u);
        for (int k = 0; k < 4; ++k) {
            double x = square.points[k].x - c.offset.x, y = square.points[k].y - c.offset.y;
            EXPECT_NEAR(groups[0].vertices[k].texcoord.x, c.du.x * x + c.du.y * y + c.du.z, 1e-12) << k;
            EXPECT_NEAR(groups[0].vertices[k].texcoord.y, c.dv.x * x + c.dv.y * y + c.dv.z, 1e-12) << k;
        }
    }
    square.textureAxis = DorVector3(0, 1, 0);  // behind point 0 at (5, 5), not "up": u at corner 1 is not 0
    EXPECT_GT(std::fabs(Convert(0)[0].vertices[1].texcoord.x), 0.1);
    square.SetTexture(1, 0.0, 0.0);
    EXPECT_FALSE(std::isfinite(Convert(0)[0].vertices[1].texcoord.x));
}

TEST_F(UnitSquare, WireIsTheOutlineTwiceUntexturedAndOnlyTheNormalTurns)
{
    square.SetStyle(DorStyleWire);
    square.SetTexture(9);
    ExpectWireLoops(Convert(0), {Square(0, 0, 1), Square(0, 0, 1)}, 1, 12);
    ExpectWireLoops(Convert(1), {Square(0, 0, 1), Square(0, 0, 1)}, -1, 12);
    for (int style : {2, -1, 100}) {
        square.SetStyle(style);
        EXPECT_EQ(Convert(0).GetSize(), 0) << style;
    }
}

TEST(PolygonToPrimitive, DegenerateOutlinesAndAppending)
{
    CVelPolygonToPrimitive converter;
    CDorPolygon line({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0)}), empty, dot({DorVector3(1, 2, 3)});
    CVelGroupArray groups;
    for (CDorPolygon* p : {&line, &empty, static_cast<CDorPolygon*>(nullptr)})
        converter.ConvertPolygon(p, groups, 0);
    EXPECT_EQ(groups.GetSize(), 0);
    empty.SetStyle(DorStyleWire);
    converter.ConvertPolygon(&empty, groups, 0);
    EXPECT_EQ(groups.GetSize(), 0);
    line.SetStyle(DorStyleWire);
    converter.ConvertPolygon(&line, groups, 1);
    ASSERT_EQ(groups.GetSize(), 2);
    EXPECT_EQ(DorLength(groups[0].vertices[0].normal), 0.0);
    dot.SetStyle(DorStyleWire);
    converter.ConvertPolygon(&dot, groups, 0);  // appended after what is there
    ASSERT_EQ(groups.GetSize(), 4);
    EXPECT_EQ(groups[3].vertices.GetSize(), 2);
    CDorPolygon square = Polygon(Square(0, 0, 1));
    converter.ConvertPolygon(&square, groups, 0);
    ASSERT_EQ(groups.GetSize(), 5);
    EXPECT_EQ(groups[4].GroupType, VelGroupIndexed);
    EXPECT_EQ(groups[0].vertices.GetSize(), 4);
    const double nan = std::numeric_limits<double>::quiet_NaN();
    CDorPolygon bad({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, nan, 0), DorVector3(0, 1, 0)});
    groups.SetSize(0);
    converter.ConvertPolygon(&bad, groups, 0);
    for (int g = 0; g < groups.GetSize(); ++g)
        for (int t = 0; t < groups[g].triangles.GetSize(); ++t)
            EXPECT_LT(groups[g].triangles[t].a, groups[g].vertices.GetSize());
}

TEST_F(FaceWithTriangularHole, SolidIsOneLitGroupOverOutlineThenHoleAndFlipTurnsIt)
{
    CVelGroupArray front = Convert(0);
    ExpectSolidFace(front, Convert(1), 7, 7, 14.0);
    for (int k = 0; k < 7; ++k) {
        EXPECT_EQ(front[0].vertices[k].texcoord.x, 0.0);  // untextured: no coordinates
        EXPECT_EQ(front[0].vertices[k].colour.a, 1.0f);
    }
    EXPECT_TRUE(SamePoint(front[0].vertices[4].position, hole[0]));
    EXPECT_EQ(front[0].material.shininess, 9.0f);
    EXPECT_EQ(front[0].RenderKind, VelRenderLit);
    shape.style = 2;
    EXPECT_EQ(Convert(0).GetSize(), 0);
    CVelHolePolygonToPrimitive().ConvertHolePolygon(nullptr, front, 0);
    EXPECT_EQ(front.GetSize(), 1);
}

// The holed face reads its own texture vectors, never the plain polygon's: an axis along +y
// turns the texture a quarter turn, then the origin is added in scaled units.
TEST_F(FaceWithTriangularHole, TextureCoordinatesUseTheHoleTextureVectors)
{
    shape.textureAxis = DorVector3(1, 1, 0);
    shape.textureOrigin = DorVector3(9, 9, 0);
    for (bool turned : {false, true}) {
        shape.SetTexture(5, turned ? 1.0 : 2.0, turned ? 1.0 : 4.0);
        shape.holeTextureAxis = turned ? DorVector3(0, 1, 0) : DorVector3();
        shape.holeTextureOrigin = turned ? DorVector3(1, 2, 0) : DorVector3();
        CVelGroupArray groups = Convert(0);
        const CVelTrianglePolys& g = groups[0];
        EXPECT_EQ(g.RenderKind, VelRenderTextured);
        EXPECT_EQ(g.texture, 5u);
        for (int k = 0; k < g.vertices.GetSize(); ++k) {
            const DorVector3& p = g.vertices[k].position;
            EXPECT_NEAR(g.vertices[k].texcoord.x, turned ? -p.y + 1 : p.x / 2, 1e-12) << k;
            EXPECT_NEAR(g.vertices[k].texcoord.y, turned ? p.x + 2 : p.y / 4, 1e-12) << k;
        }
    }
    shape.SetTexture(5, 0.0, 0.0);
    shape.holeTextureAxis = DorVector3(1, 1, 0);
    EXPECT_FALSE(std::isfinite(Convert(1)[0].vertices[1].texcoord.x));
}

TEST_F(FaceWithTriangularHole, WireIsOneLoopPerOutlineAndHoleAndOnlyTheNormalTurns)
{
    shape.style = DorStyleWire;
    ExpectWireLoops(Convert(0), {Square(0, 0, 4), hole}, 1, 9);
    ExpectWireLoops(Convert(1), {Square(0, 0, 4), hole}, -1, 9);
}

TEST(HoleFaceToPrimitive, FallbacksAndBadHoles)
{
    CVelHolePolygonToPrimitive converter;
    CVelGroupArray groups;
    // Without holes a bare triangle is drawn as the triangle 0, 1, 2 itself.
    CDorHolePolygon triangle = HolePolygon({DorVector3(0, 0, 0), DorVector3(3, 0, 0), DorVector3(1, 2, 0)}, {});
    converter.ConvertHolePolygon(&triangle, groups, 0);
    ASSERT_EQ(groups.GetSize(), 1);
    ASSERT_EQ(groups[0].triangles.GetSize(), 1);
    EXPECT_EQ(MeshOf(groups[0]).i, std::vector<int>({0, 1, 2}));
    // A nearly collinear one keeps its normal unnormalised.
    CDorHolePolygon sliver = HolePolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 1e-6, 0)}, {});
    converter.ConvertHolePolygon(&sliver, groups, 1);
    ASSERT_EQ(groups.GetSize(), 2);
    EXPECT_EQ(MeshOf(groups[1]).i, std::vector<int>({2, 1, 0}));
    EXPECT_TRUE(Near(groups[1].vertices[0].normal, 0, 0, -1e-6, 1e-18));
    CDorHolePolygon segment = HolePolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0)}, {});
    converter.ConvertHolePolygon(&segment, groups, 0);
    EXPECT_EQ(groups.GetSize(), 2);

    CDorHolePolygon holes = HolePolygon(Square(0, 0, 4), {{}, {DorVector3(2, 2, 0)}, Square(1, 1, 1)});
    groups.SetSize(0);
    converter.ConvertHolePolygon(&holes, groups, 0);
    ASSERT_EQ(groups.GetSize(), 1);
    EXPECT_EQ(groups[0].vertices.GetSize(), 9);
    CheckTriangles(MeshOf(groups[0]), DorVector3(0, 0, 1));
    holes.style = DorStyleWire;
    groups.SetSize(0);
    converter.ConvertHolePolygon(&holes, groups, 0);
    ASSERT_EQ(groups.GetSize(), 4);
    EXPECT_EQ(groups[1].vertices.GetSize(), 0);  // nothing to close an empty loop with
    EXPECT_EQ(groups[2].vertices.GetSize(), 2);  // a point drawn as a zero-length segment
    EXPECT_EQ(groups[3].vertices.GetSize(), 5);
}
