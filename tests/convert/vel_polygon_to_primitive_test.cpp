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
    ASSERT_EQ(Layout(front), "I" + std::to_string(vertices));
    ASSERT_EQ(Layout(back), Layout(front));
    ASSERT_EQ(front[0].triangles.GetSize(), triangles);
    Mesh m = MeshOf(front[0]), flipped = MeshOf(back[0]);
    for (size_t t = 0; t < m.i.size(); t += 3)
        std::swap(m.i[t], m.i[t + 2]);
    EXPECT_EQ(flipped.i, m.i);
    for (double z : {1, -1}) {
        const CVelTrianglePolys& g = z > 0 ? front[0] : back[0];
        EXPECT_NEAR(CheckTriangles(MeshOf(g), DorVector3(0, 0, z)), area, 1e-12);
        for (int k = 0; k < vertices; ++k)
            EXPECT_TRUE(Near(g.vertices[k].normal, 0, 0, z) && SamePoint(g.vertices[k].position, flipped.v[k])) << k;
    }
}

// One line group per loop, each closed by repeating its first point, every normal along z.
void ExpectWireLoops(const CVelGroupArray& groups, const std::vector<Loop>& loops, double z, float shininess)
{
    ASSERT_EQ(groups.GetSize(), static_cast<int>(loops.size()));
    for (size_t l = 0; l < loops.size(); ++l) {
        const CVelTrianglePolys& g = groups[static_cast<int>(l)];
        ASSERT_EQ(Layout(groups).substr(3 * l, 2), "L" + std::to_string(loops[l].size() + 1));
        for (int k = 0; k < g.vertices.GetSize(); ++k)
            EXPECT_TRUE(SamePoint(g.vertices[k].position, loops[l][k % loops[l].size()]) && Near(g.vertices[k].normal, 0, 0, z)) << l << ", " << k;
        EXPECT_TRUE(g.material.shininess == shininess && g.RenderKind == VelRenderLit && g.texture == 0u);
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
    EXPECT_TRUE(front[0].material.shininess == 12.0f && front[0].RenderKind == VelRenderLit && front[0].texture == 0u);
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
        EXPECT_TRUE(groups[0].RenderKind == VelRenderTextured && groups[0].texture == 5u);
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

// Collinear, empty, missing and one-point outlines; groups appended after what is there.
TEST(PolygonToPrimitive, DegenerateOutlinesAndAppending)
{
    CVelPolygonToPrimitive converter;
    CDorPolygon line({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0)}), empty, dot({DorVector3(1, 2, 3)});
    CDorPolygon square = Polygon(Square(0, 0, 1));
    CVelGroupArray groups;
    for (CDorPolygon* p : {&line, &empty, static_cast<CDorPolygon*>(nullptr)})
        converter.ConvertPolygon(p, groups, 0);
    EXPECT_EQ(groups.GetSize(), 0);
    line.style = empty.style = dot.style = DorStyleWire;
    for (CDorPolygon* p : {&line, &empty, &dot, &square})
        converter.ConvertPolygon(p, groups, 1);
    EXPECT_EQ(Layout(groups), "L4 L4 L2 L2 I4");
    EXPECT_EQ(DorLength(groups[0].vertices[0].normal), 0.0);
    const double nan = std::numeric_limits<double>::quiet_NaN();
    CDorPolygon bad({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, nan, 0), DorVector3(0, 1, 0)});
    groups.SetSize(0);
    converter.ConvertPolygon(&bad, groups, 0);
    for (int g = 0; g < groups.GetSize(); ++g)
        for (int k : MeshOf(groups[g]).i)
            EXPECT_LT(k, groups[g].vertices.GetSize());
}

TEST_F(FaceWithTriangularHole, SolidIsOneLitGroupOverOutlineThenHoleAndFlipTurnsIt)
{
    CVelGroupArray front = Convert(0);
    ExpectSolidFace(front, Convert(1), 7, 7, 14.0);
    for (int k = 0; k < 7; ++k)  // untextured: no coordinates
        EXPECT_TRUE(front[0].vertices[k].texcoord.x == 0.0 && front[0].vertices[k].colour.a == 1.0f);
    EXPECT_TRUE(SamePoint(front[0].vertices[4].position, hole[0]));
    EXPECT_TRUE(front[0].material.shininess == 9.0f && front[0].RenderKind == VelRenderLit);
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
        EXPECT_TRUE(groups[0].RenderKind == VelRenderTextured && groups[0].texture == 5u);
        for (int k = 0; k < groups[0].vertices.GetSize(); ++k) {
            const DorVector3& p = groups[0].vertices[k].position;
            EXPECT_NEAR(groups[0].vertices[k].texcoord.x, turned ? -p.y + 1 : p.x / 2, 1e-12) << k;
            EXPECT_NEAR(groups[0].vertices[k].texcoord.y, turned ? p.x + 2 : p.y / 4, 1e-12) << k;
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

// Without holes a bare triangle is drawn as the triangle 0, 1, 2 itself, a nearly collinear one
// with its normal unnormalised; fewer than three vertices give nothing; bad holes stay safe.
TEST(HoleFaceToPrimitive, FallbacksAndBadHoles)
{
    CVelHolePolygonToPrimitive converter;
    CVelGroupArray groups;
    CDorHolePolygon triangle = HolePolygon({DorVector3(0, 0, 0), DorVector3(3, 0, 0), DorVector3(1, 2, 0)}, {});
    CDorHolePolygon sliver = HolePolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 1e-6, 0)}, {});
    CDorHolePolygon segment = HolePolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0)}, {});
    converter.ConvertHolePolygon(&triangle, groups, 0);
    converter.ConvertHolePolygon(&sliver, groups, 1);
    converter.ConvertHolePolygon(&segment, groups, 0);
    ASSERT_EQ(Layout(groups), "I3 I3");
    EXPECT_EQ(MeshOf(groups[0]).i, std::vector<int>({0, 1, 2}));
    EXPECT_EQ(MeshOf(groups[1]).i, std::vector<int>({2, 1, 0}));
    EXPECT_TRUE(Near(groups[1].vertices[0].normal, 0, 0, -1e-6, 1e-18));

    CDorHolePolygon holes = HolePolygon(Square(0, 0, 4), {{}, {DorVector3(2, 2, 0)}, Square(1, 1, 1)});
    groups.SetSize(0);
    converter.ConvertHolePolygon(&holes, groups, 0);
    ASSERT_EQ(Layout(groups), "I9");
    CheckTriangles(MeshOf(groups[0]), DorVector3(0, 0, 1));
    holes.style = DorStyleWire;
    groups.SetSize(0);
    converter.ConvertHolePolygon(&holes, groups, 0);
    EXPECT_EQ(Layout(groups), "L5 S0 L2 L5");  // an empty loop has nothing to close; a point is a zero-length segment
}
