// The plain and the holed face converters.
#include <cmath>

#include "convert/vel_polygon_to_primitive.h"
#include "geometry_checks.h"

namespace {
CVelGroupArray ConvertFace(CDorGeometry& face, int reverse)
{
    CVelGroupArray groups;
    if (face.kind == DorKindPolygon)
        CVelPolygonToPrimitive().ConvertPolygon(static_cast<CDorPolygon*>(&face), groups, reverse);
    else
        CVelHolePolygonToPrimitive().ConvertHolePolygon(static_cast<CDorHolePolygon*>(&face), groups, reverse);
    return groups;
}

const Loop kHole = {DorVector3(1, 1, 0), DorVector3(3, 1, 0), DorVector3(2, 3, 0)};
}  // namespace

// Solid: one lit indexed group over the outline's then the holes' vertices, counter-clockwise
// about the face's normal and covering it; reverse 1 turns the normal and every triple, any other
// value is the front. Wire: a line loop per outline (the plain polygon's twice) and per hole,
// closed by its first point, untextured; only the normal turns. Other styles give nothing.
TEST(FaceToPrimitive, SolidAndWireFrontAndBack)
{
    CDorPolygon square = Polygon(Square(0, 0, 1));
    CDorHolePolygon holed = HolePolygon(Square(0, 0, 4), {kHole});
    square.material.shininess = 12;
    holed.material.shininess = 9;
    const struct {
        CDorGeometry* face;
        std::vector<Loop> loops, wire;
        int triangles;
        double area;
    } faces[] = {{&square, {Square(0, 0, 1)}, {Square(0, 0, 1), Square(0, 0, 1)}, 2, 1.0},
                 {&holed, {Square(0, 0, 4), kHole}, {Square(0, 0, 4), kHole}, 7, 14.0}};
    for (const auto& f : faces) {
        SCOPED_TRACE(f.triangles);
        Loop points;
        for (const Loop& loop : f.loops)
            points.insert(points.end(), loop.begin(), loop.end());
        f.face->style = DorStyleSolid;
        CVelGroupArray front = ConvertFace(*f.face, 0), back = ConvertFace(*f.face, 1), other = ConvertFace(*f.face, 7);
        ASSERT_TRUE(Layout(front) == "I" + std::to_string(points.size()) && Layout(back) == Layout(front));
        Mesh m = MeshOf(front[0]);
        EXPECT_TRUE(m.Count() == f.triangles && MeshOf(other[0]).i == m.i);
        for (size_t t = 0; t < m.i.size(); t += 3)
            std::swap(m.i[t], m.i[t + 2]);
        EXPECT_EQ(MeshOf(back[0]).i, m.i);
        for (double z : {1, -1}) {
            const CVelTrianglePolys& g = z > 0 ? front[0] : back[0];
            EXPECT_NEAR(CheckTriangles(MeshOf(g), DorVector3(0, 0, z)), f.area, 1e-12);
            EXPECT_TRUE(g.material.shininess == f.face->material.shininess && g.RenderKind == VelRenderLit && g.texture == 0u);
            for (size_t k = 0; k < points.size(); ++k)  // an untextured polygon still gets planar coordinates, a holed one none
                EXPECT_TRUE(Near(g.vertices[k].normal, DorVector3(0, 0, z)) && SamePoint(g.vertices[k].position, points[k]) &&
                            (z < 0 || g.vertices[k].texcoord.x == (f.face == &square ? points[k].x : 0.0))) << k;
        }
        f.face->style = DorStyleWire;
        f.face->SetTexture(9);
        for (int reverse : {0, 1}) {
            CVelGroupArray groups = ConvertFace(*f.face, reverse);
            ASSERT_EQ(groups.GetSize(), static_cast<int>(f.wire.size()));
            for (size_t l = 0; l < f.wire.size(); ++l) {
                const CVelTrianglePolys& g = groups[static_cast<int>(l)];
                ASSERT_TRUE(g.GroupType == VelGroupLines && g.vertices.GetSize() == static_cast<int>(f.wire[l].size()) + 1) << l;
                for (int k = 0; k < g.vertices.GetSize(); ++k)
                    EXPECT_TRUE(SamePoint(g.vertices[k].position, f.wire[l][k % f.wire[l].size()]) &&
                                Near(g.vertices[k].normal, DorVector3(0, 0, reverse ? -1 : 1))) << l << ", " << k;
                EXPECT_TRUE(g.material.shininess == f.face->material.shininess && g.RenderKind == VelRenderLit && g.texture == 0u);
            }
        }
        f.face->SetTexture(0);
        for (int style : {2, -1}) {
            f.face->style = style;
            EXPECT_EQ(ConvertFace(*f.face, 0).GetSize(), 0);
        }
    }
}

// u, v = du.x * x + du.y * y + du.z (and dv) at the corner (x, y) of the face; the holed face
// reads its own texture vectors, never the plain polygon's.
TEST(FaceToPrimitive, TextureCoordinatesUnderScalesAxesAndOrigins)
{
    const struct {
        bool holed;
        DorVector3 offset, axis, origin;
        double scaleU, scaleV;
        DorVector3 du, dv;
    } cases[] = {
        {false, DorVector3(), DorVector3(), DorVector3(), 2.0, 0.5, DorVector3(0.5, 0, 0), DorVector3(0, 2, 0)},
        {false, DorVector3(), DorVector3(), DorVector3(0.3, 0.3, 0), 1, 1, DorVector3(1, 0, 0), DorVector3(0, 1, 0)},  // no axis: no origin
        {false, DorVector3(), DorVector3(0, 1, 0), DorVector3(), 1, 1, DorVector3(0, -1, 0), DorVector3(1, 0, 0)},  // a quarter turn
        {false, DorVector3(), DorVector3(1, 0, 0), DorVector3(0.5, 0.25, 0), 2, 1, DorVector3(0.5, 0, 0.25), DorVector3(0, 1, 0.25)},
        {false, DorVector3(5, 5, 0), DorVector3(5, 6, 0), DorVector3(5, 5, 0), 1, 1, DorVector3(0, -1, 0), DorVector3(1, 0, 0)},  // points
        {true, DorVector3(), DorVector3(), DorVector3(), 2.0, 4.0, DorVector3(0.5, 0, 0), DorVector3(0, 0.25, 0)},
        {true, DorVector3(), DorVector3(0, 1, 0), DorVector3(1, 2, 0), 1, 1, DorVector3(0, -1, 1), DorVector3(1, 0, 2)},
    };
    for (const auto& c : cases) {
        CDorPolygon square = Polygon(Square(c.offset.x, c.offset.y, 1));
        CDorHolePolygon holed = HolePolygon(Square(0, 0, 4), {kHole});
        square.textureAxis = holed.holeTextureAxis = c.axis;
        square.textureOrigin = holed.holeTextureOrigin = c.origin;
        holed.textureAxis = holed.textureOrigin = DorVector3(9, 9, 0);
        CDorGeometry& face = c.holed ? static_cast<CDorGeometry&>(holed) : square;
        face.SetTexture(5, c.scaleU, c.scaleV);
        CVelGroupArray groups = ConvertFace(face, 0);
        EXPECT_TRUE(groups[0].RenderKind == VelRenderTextured && groups[0].texture == 5u);
        for (int k = 0; k < groups[0].vertices.GetSize(); ++k) {
            double x = groups[0].vertices[k].position.x - c.offset.x, y = groups[0].vertices[k].position.y - c.offset.y;
            const DorVector2& t = groups[0].vertices[k].texcoord;
            EXPECT_TRUE(std::fabs(t.x - c.du.x * x - c.du.y * y - c.du.z) < 1e-12 && std::fabs(t.y - c.dv.x * x - c.dv.y * y - c.dv.z) < 1e-12)
                << k << " of case with scale " << c.scaleU;
        }
        face.SetTexture(1, 0.0, 0.0);
        EXPECT_FALSE(std::isfinite(ConvertFace(face, 1)[0].vertices[1].texcoord.x));
    }
}

// Degenerate plain outlines give nothing solid; wire draws whatever points there are. Groups are
// appended after what is there.
TEST(FaceToPrimitive, DegenerateOutlinesAndAppending)
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
}

// Without holes a bare triangle is drawn as the triangle 0, 1, 2 itself, a nearly collinear one
// with its normal unnormalised; fewer than three vertices give nothing; bad holes stay safe.
TEST(FaceToPrimitive, HoledFallbacksAndBadHoles)
{
    CVelHolePolygonToPrimitive converter;
    CVelGroupArray groups;
    CDorHolePolygon triangle = HolePolygon({DorVector3(0, 0, 0), DorVector3(3, 0, 0), DorVector3(1, 2, 0)}, {});
    CDorHolePolygon sliver = HolePolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 1e-6, 0)}, {});
    CDorHolePolygon segment = HolePolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0)}, {});
    converter.ConvertHolePolygon(&triangle, groups, 0);
    converter.ConvertHolePolygon(&sliver, groups, 1);
    converter.ConvertHolePolygon(&segment, groups, 0);
    converter.ConvertHolePolygon(nullptr, groups, 0);
    ASSERT_EQ(Layout(groups), "I3 I3");
    EXPECT_EQ(MeshOf(groups[0]).i, std::vector<int>({0, 1, 2}));
    EXPECT_EQ(MeshOf(groups[1]).i, std::vector<int>({2, 1, 0}));
    EXPECT_TRUE(Near(groups[1].vertices[0].normal, DorVector3(0, 0, -1e-6), 1e-18));
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
