#include <algorithm>
#include <limits>

#include "geometry_checks.h"
#include "reference_triangulations.h"

namespace {
// Empty, one-point, outside, overlapping, crossing, two-point, repeated and non-finite holes.
std::vector<std::vector<Loop>> IllFormedHoles()
{
    return {{{}, {DorVector3(5, 5, 0)}, Square(2, 2, 2)},
            {Square(20, 20, 2)},
            {Square(2, 2, 4), Square(4, 4, 4)},
            {Square(-2, -2, 4)},
            {{DorVector3(3, 3, 0), DorVector3(6, 6, 0)}},
            {Square(2, 2, 2), Square(2, 2, 2)},
            {{DorVector3(std::numeric_limits<double>::quiet_NaN(), 1, 0), DorVector3(2, 2, 0), DorVector3(1, 3, 0)}}};
}

// Vertex 2 sits 1e-5 above the chord 1-3: its midpoint is just outside, but loosely on edge 1-2.
const Loop kNotched = {DorVector3(0, 0, 0), DorVector3(4, 0, 0), DorVector3(8, 1e-5, 0), DorVector3(9, 0, 0),
                       DorVector3(10, 0, 0), DorVector3(10, 10, 0), DorVector3(0, 10, 0)};
}  // namespace

// Every ring whatever the way its loops run or its plane: the triangles cover it once, over the
// outline's vertices then the holes', unchanged.
TEST(HoleTriangulation, RingsAreTriangulatedCompletely)
{
    const Loop triangle = {DorVector3(1, 1, 0), DorVector3(3, 1, 0), DorVector3(2, 3, 0)};
    const Loop pentagon = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0), DorVector3(2, 2, 0), DorVector3(0, 2, 0)};
    const struct {
        Loop outline;
        std::vector<Loop> holes;
        int triangles;
    } rings[] = {{Square(0, 0, 4), {triangle}, 7},
                 {Square(0, 0, 4), {{triangle[0], triangle[2], triangle[1]}}, 7},
                 {Square(0, 0, 4, true), {triangle}, 7},
                 {Transformed(Square(0, 0, 4), Tilt()), {Transformed(triangle, Tilt())}, 7},
                 {Square(0, 0, 4), {Square(1, 1, 2)}, 8},
                 {Square(0, 0, 7), HoleGrid(2), 20 + 8 - 2},
                 {Square(0, 0, 10), HoleGrid(3), 40 + 18 - 2},
                 {RegularPolygon(60), {}, 58},
                 {pentagon, {}, 3}};
    for (const auto& r : rings) {
        SCOPED_TRACE(::testing::Message() << r.outline.size() << " points, " << r.holes.size() << " holes");
        Mesh m = TriangulateHoled(HolePolygon(r.outline, r.holes));
        EXPECT_EQ(m.Count(), r.triangles);
        EXPECT_NEAR(CheckRing(m, r.outline, r.holes), RingArea(r.outline, r.holes), 1e-9);
        Loop expected = r.outline;
        for (const Loop& hole : r.holes)
            expected.insert(expected.end(), hole.begin(), hole.end());
        EXPECT_TRUE(std::equal(m.v.begin(), m.v.end(), expected.begin(), expected.end(), SamePoint));
    }
}

// Unlike the plain triangulation a stale index never survives: no normal or a non-finite
// outline give no triangles, over every vertex still.
TEST(HoleTriangulation, BadInputGivesNoTriangles)
{
    Loop nanOutline = Square(0, 0, 10);
    nanOutline[2].x = std::numeric_limits<double>::quiet_NaN();
    const std::vector<Loop> outlines = {{}, {DorVector3(1, 2, 3)}, {DorVector3(0, 0, 0), DorVector3(1, 1, 1), DorVector3(2, 2, 2)},
                                        {DorVector3(0, 0, 0), DorVector3(1, 1, 0), DorVector3(1, 0, 0), DorVector3(0, 1, 0)}, nanOutline};
    for (const Loop& outline : outlines) {
        Mesh m = TriangulateHoled(HolePolygon(outline, {Square(0.2, 0.2, 0.1)}));
        EXPECT_TRUE(m.i.empty() && m.v.size() == outline.size() + 4) << outline.size() << " points";
    }
    CDorArray<DorVector3, DorVector3&> vertices;
    CDorArray<int, int> indices;
    indices.Add(7);
    CVelHolePolygonToPrimitive().TriangulateHolePolygon(nullptr, vertices, indices);
    EXPECT_EQ(indices.GetSize(), 0);
}

// Random holed outlines in random planes, hole grids, the budget, ill-formed holes and the
// tolerances: midpoints loosely on an edge count as in the material and slivers are dropped,
// unlike the plain triangulation.
TEST(HoleTriangulation, SameTrianglesAsThePlainTranscription)
{
    const Loop bumped = {DorVector3(0, 0, 0), DorVector3(100 - 5e-6, 0, 0), DorVector3(100 + 5e-6, -5e-6, 0),
                         DorVector3(100, 5e-6, 0), DorVector3(100, 100, 0), DorVector3(0, 100, 0)};
    const Loop nearHole = {DorVector3(4, 5, 0), DorVector3(8, 5 - 1e-5, 0), DorVector3(9, 5, 0), DorVector3(6, 7, 0)};
    std::vector<CDorHolePolygon> shapes = {HolePolygon(kNotched, {}), HolePolygon(bumped, {}), HolePolygon(Square(0, 0, 12), {nearHole})};
    for (int k : {1, 2, 3, 4})
        shapes.push_back(HolePolygon(Square(0, 0, 3 * k + 1), HoleGrid(k)));
    for (int n : {3, 60, 100, 120})
        shapes.push_back(HolePolygon(RegularPolygon(n), {}));
    shapes.push_back(HolePolygon(Star(20, 2.0, 1.0), {Square(-0.3, -0.3, 0.6), Square(0.5, 0.5, 0.2)}));
    shapes.push_back(HolePolygon(kNotched, {nearHole}));
    for (const std::vector<Loop>& holes : IllFormedHoles())
        shapes.push_back(HolePolygon(Square(0, 0, 10), holes));
    std::mt19937 rng(77);
    std::uniform_int_distribution<int> outlineCount(3, 24), holeCount(0, 4), holeSize(1, 7), coin(0, 1);
    std::uniform_real_distribution<double> angle(-kPi, kPi);
    for (int trial = 0; trial < 300; ++trial) {
        Loop outline = RandomStarShaped(rng, outlineCount(rng), 0, 0, 8.0, 11.0);
        std::vector<Loop> holes(holeCount(rng));
        for (size_t k = 0; k < holes.size(); ++k) {  // one per cell of a 2 x 2 grid, either way round
            holes[k] = RandomStarShaped(rng, holeSize(rng) + 2, k % 2 ? 2.5 : -2.5, k / 2 ? 2.5 : -2.5, 0.6, 2.0);
            if (coin(rng))
                std::reverse(holes[k].begin(), holes[k].end());
        }
        if (trial % 2) {
            DorMatrix4x4 m = DorRotateX(angle(rng)) * DorRotateY(angle(rng)) * DorRotateZ(angle(rng)) * DorTranslate(1, 2, 3);
            outline = Transformed(outline, m);
            for (Loop& hole : holes)
                hole = Transformed(hole, m);
        }
        shapes.push_back(HolePolygon(outline, holes));
    }
    for (size_t k = 0; k < shapes.size(); ++k) {
        CDorArray<DorVector3, DorVector3&> vertices;
        CDorArray<int, int> indices;
        CVelHolePolygonToPrimitive().TriangulateHolePolygon(&shapes[k], vertices, indices);
        ASSERT_EQ(std::vector<int>(indices.GetData(), indices.GetData() + indices.GetSize()), reference::TriangulateHoles(shapes[k]))
            << "shape " << k;
    }
}
