// The plain and the holed face converters.
#include <cmath>

#include "convert/vel_polygon_to_primitive.h"
#include "geometry_checks.h"

namespace {
CVelGroupArray ConvertFace(CDorGeometry& face, int reverse, CVelGroupArray groups = CVelGroupArray())
{
    if (face.kind == DorKindPolygon)
        CVelPolygonToPrimitive().ConvertPolygon(static_cast<CDorPolygon*>(&face), groups, reverse);
    else
        CVelHolePolygonToPrimitive().ConvertHolePolygon(static_cast<CDorHolePolygon*>(&face), groups, reverse);
    return groups;
}

typedef std::vector<Loop> Loops;
const Loop kHole = {DorVector3(1, 1, 0), DorVector3(3, 1, 0), DorVector3(2, 3, 0)};
}  // namespace

// Solid, then wire, appended. Solid: one lit indexed group over the outline's then the holes'
// vertices, counter-clockwise about the face's normal and covering it; reverse 1 turns the normal
// and every triple, any other value is the front. Without a normal the plain converter makes no
// face, the holed one still gives hosts the first three points and the normal unnormalised. Wire:
// a line loop per outline (the plain polygon's twice) and per hole, closed by its first point,
// untextured; an empty holed loop stays an empty strip. Other styles give nothing.
TEST(FaceToPrimitive, SolidThenWireFrontAndBack)
{
    const Loop line = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0)};
    const DorVector3 up(0, 0, 1);
    // plain, holed: the layouts made; normal: that of the front
    const struct { Loop outline; std::vector<Loop> holes; const char *plain, *holed; DorVector3 normal; } cases[] = {
        {{}, {}, "", "S0", DorVector3()}, {{DorVector3(1, 2, 3)}, {}, "L2 L2", "L2", DorVector3()},
        {{line[0], line[1]}, {}, "L3 L3", "L3", DorVector3()}, {line, {}, "L4 L4", "I3 L4", DorVector3()},
        {{line[0], line[1], DorVector3(2, 1e-6, 0)}, {}, "L4 L4", "I3 L4", up * 1e-6},
        {{line[0], DorVector3(3, 0, 0), DorVector3(1, 2, 0)}, {}, "I3 L4 L4", "I3 L4", up},
        {Square(0, 0, 1), {}, "I4 L5 L5", "I4 L5", up}, {Square(0, 0, 4), {kHole}, "I4 L5 L5", "I7 L5 L4", up},
        {Square(0, 0, 4), {{}, {DorVector3(2, 2, 0)}, Square(1, 1, 1)}, "I4 L5 L5", "I9 L5 S0 L2 L5", up}};
    for (const auto& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.outline.size() << " points, " << c.holes.size() << " holes");
        CDorPolygon plain = Polygon(c.outline);
        CDorHolePolygon holed = HolePolygon(c.outline, c.holes);
        for (int run = 0; run < 6; ++run) {  // front, back, front again, plain then holed
            const int reverse = run % 3 == 2 ? 7 : run % 3;
            CDorGeometry* face = run < 3 ? static_cast<CDorGeometry*>(&plain) : &holed;
            std::vector<Loop> loops = {c.outline, c.outline};  // drawn as wire
            Loop vertices = c.outline;
            if (face == &holed) {
                loops.assign(1, c.outline);
                loops.insert(loops.end(), c.holes.begin(), c.holes.end());
                for (const Loop& hole : c.holes)
                    vertices.insert(vertices.end(), hole.begin(), hole.end());
            }
            face->material.shininess = 9;
            face->SetStyle(DorStyleSolid);
            face->SetTexture(0);
            CVelGroupArray groups = ConvertFace(*face, reverse);
            face->SetStyle(DorStyleWire);
            face->SetTexture(9);
            groups = ConvertFace(*face, reverse, groups);
            face->SetStyle(2);
            EXPECT_EQ(Layout(ConvertFace(*face, reverse, groups)), face == &plain ? c.plain : c.holed) << reverse;
            const DorVector3 normal = c.normal * (reverse == 1 ? -1.0 : 1.0);
            for (int g = 0, l = 0; g < groups.GetSize(); ++g) {
                const CVelTrianglePolys& group = groups[g];
                EXPECT_TRUE(group.material.shininess == 9.0f && group.RenderKind == VelRenderLit && group.texture == 0u);
                const bool solid = group.GroupType == VelGroupIndexed;
                const Loop& points = solid ? vertices : loops[l++];
                for (int k = 0; k < group.vertices.GetSize(); ++k) {  // an untextured polygon still gets planar coordinates
                    const _VelVertex& v = group.vertices[k];
                    EXPECT_TRUE(SamePoint(v.position, points[k % points.size()]) && Near(v.normal, normal, 1e-15) &&
                                (!solid || reverse == 1 || v.texcoord.x == (face == &plain ? points[k].x : 0.0))) << g << ", " << k;
                }
                const bool firstThree = solid && DorLength(normal) < 1, covering = solid && !firstThree && c.holes.size() < 3;
                const std::vector<int> firstThreeIndices = reverse == 1 ? std::vector<int>{2, 1, 0} : std::vector<int>{0, 1, 2};
                EXPECT_TRUE(!firstThree || MeshOf(group).i == firstThreeIndices);
                const double area = solid && !firstThree ? CheckTriangles(MeshOf(group), normal) : 0;  // bad holes: only safe
                EXPECT_TRUE(!covering || std::fabs(area - RingArea(c.outline, face == &holed ? c.holes : Loops())) < 1e-12) << area;
            }
        }
    }
    CVelGroupArray groups;
    CVelPolygonToPrimitive().ConvertPolygon(nullptr, groups, 0);
    CVelHolePolygonToPrimitive().ConvertHolePolygon(nullptr, groups, 0);
    EXPECT_EQ(groups.GetSize(), 0);
}

// u, v = du.x * x + du.y * y + du.z (and dv) at the corner (x, y) of the face; the holed face
// reads its own texture vectors, never the plain polygon's.
TEST(FaceToPrimitive, TextureCoordinatesUnderScalesAxesAndOrigins)
{
    const struct { bool holed; DorVector3 offset, axis, origin; double scaleU, scaleV; DorVector3 du, dv; } cases[] = {
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
