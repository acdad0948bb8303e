#include <algorithm>
#include <limits>

#include "geometry_checks.h"
#include "reference_triangulations.h"

namespace {
// A 4 x 4 square with a triangular hole: seven vertices, seven triangles around the hole.
class SquareWithTriangularHole : public ::testing::Test {
protected:
    Loop outline = Square(0, 0, 4);
    Loop hole = {DorVector3(1, 1, 0), DorVector3(3, 1, 0), DorVector3(2, 3, 0)};
};

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

TEST_F(SquareWithTriangularHole, SevenTrianglesCoverTheRingWhateverTheOrientation)
{
    Loop clockwiseHole = {hole[0], hole[2], hole[1]};
    const std::vector<std::pair<Loop, Loop>> cases = {
        {outline, hole}, {outline, clockwiseHole}, {Square(0, 0, 4, true), hole}, {Transformed(outline, Tilt()), Transformed(hole, Tilt())}};
    for (size_t k = 0; k < cases.size(); ++k) {
        Mesh m = TriangulateHoled(HolePolygon(cases[k].first, {cases[k].second}));
        EXPECT_EQ(m.Count(), 7) << "case " << k;
        EXPECT_NEAR(CheckRing(m, cases[k].first, {cases[k].second}), 14.0, 1e-9) << "case " << k;
    }
    Loop expected = outline;  // the outline's vertices then the hole's, unchanged
    expected.insert(expected.end(), hole.begin(), hole.end());
    Mesh m = TriangulateHoled(HolePolygon(outline, {hole}));
    EXPECT_TRUE(std::equal(m.v.begin(), m.v.end(), expected.begin(), expected.end(), SamePoint));
}

TEST(HoleTriangulation, RingsAreTriangulatedCompletely)
{
    const Loop pentagon = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0), DorVector3(2, 2, 0), DorVector3(0, 2, 0)};
    const struct {
        Loop outline;
        std::vector<Loop> holes;
        int triangles;
    } rings[] = {{Square(0, 0, 4), {Square(1, 1, 2)}, 8},
                 {Square(0, 0, 7), HoleGrid(2), 20 + 8 - 2},
                 {Square(0, 0, 10), HoleGrid(3), 40 + 18 - 2},
                 {RegularPolygon(60), {}, 58},
                 {pentagon, {}, 3}};
    for (const auto& r : rings) {
        Mesh m = TriangulateHoled(HolePolygon(r.outline, r.holes));
        EXPECT_EQ(m.Count(), r.triangles) << r.outline.size() << " points, " << r.holes.size() << " holes";
        EXPECT_NEAR(CheckRing(m, r.outline, r.holes), RingArea(r.outline, r.holes), 1e-9) << r.triangles;
    }
    // A bare triangle has no diagonal to close a triangle on: no triangles, only its vertices.
    Mesh triangle = TriangulateHoled(HolePolygon({DorVector3(0, 0, 0), DorVector3(3, 0, 0), DorVector3(1, 2, 0)}, {}));
    EXPECT_EQ(triangle.Count(), 0);
    EXPECT_EQ(triangle.v.size(), 3u);
    // Point 0's pass spends the budget of N + 98 diagonals: the fan stops at point 100.
    Mesh fan = TriangulateHoled(HolePolygon(RegularPolygon(120), {}));
    CheckRing(fan, RegularPolygon(120));
    EXPECT_EQ(fan.Triangles(), FanFromZero(99));
}

// Midpoints loosely on an edge count as in the material, which the plain triangulation does not
// do; slivers are dropped, which it does not do either.
TEST(HoleTriangulation, TolerancesDifferFromThePlainTriangulation)
{
    const Loop bumped = {DorVector3(0, 0, 0), DorVector3(100 - 5e-6, 0, 0), DorVector3(100 + 5e-6, -5e-6, 0),
                         DorVector3(100, 5e-6, 0), DorVector3(100, 100, 0), DorVector3(0, 100, 0)};
    const Loop nearHole = {DorVector3(4, 5, 0), DorVector3(8, 5 - 1e-5, 0), DorVector3(9, 5, 0), DorVector3(6, 7, 0)};
    const struct {
        Loop outline;
        std::vector<Loop> holes;
        std::set<int> triangle;
        size_t holed, plain;  // how often the triangle appears
    } cases[] = {{kNotched, {}, {1, 2, 3}, 1, 0}, {bumped, {}, {1, 2, 3}, 0, 1}, {Square(0, 0, 12), {nearHole}, {4, 5, 6}, 1, 0}};
    for (const auto& c : cases) {
        Mesh m = TriangulateHoled(HolePolygon(c.outline, c.holes));
        double area = CheckTriangles(m, DorVector3(0, 0, 1));
        EXPECT_EQ(m.Triangles().count(c.triangle), c.holed) << c.outline.size() << " points";
        EXPECT_TRUE(!c.holes.empty() || TriangulatePlain(c.outline).Triangles().count(c.triangle) == c.plain) << c.outline.size();
        EXPECT_TRUE(c.holed != 0 || std::fabs(area - LoopArea(c.outline)) < 1e-9) << area;
    }
}

TEST(HoleTriangulation, BadInputGivesNoTrianglesOrIndicesInRange)
{
    const std::vector<Loop> noNormal = {{}, {DorVector3(1, 2, 3)}, {DorVector3(0, 0, 0), DorVector3(1, 1, 1), DorVector3(2, 2, 2)},
                                        {DorVector3(0, 0, 0), DorVector3(1, 1, 0), DorVector3(1, 0, 0), DorVector3(0, 1, 0)}};
    for (const Loop& outline : noNormal) {
        Mesh m = TriangulateHoled(HolePolygon(outline, {Square(0.2, 0.2, 0.1)}));
        EXPECT_TRUE(m.i.empty()) << outline.size() << " points";
        EXPECT_EQ(m.v.size(), outline.size() + 4);
    }
    for (const std::vector<Loop>& holes : IllFormedHoles())
        CheckTriangles(TriangulateHoled(HolePolygon(Square(0, 0, 10), holes)), DorVector3(0, 0, 1));
    Loop nanOutline = Square(0, 0, 10);
    nanOutline[2].x = std::numeric_limits<double>::quiet_NaN();
    EXPECT_TRUE(TriangulateHoled(HolePolygon(nanOutline, {Square(2, 2, 2)})).i.empty());
    CDorArray<DorVector3, DorVector3&> vertices;
    CDorArray<int, int> indices;
    indices.Add(7);
    CVelHolePolygonToPrimitive().TriangulateHolePolygon(nullptr, vertices, indices);
    EXPECT_EQ(indices.GetSize(), 0);
}

// Random holed outlines in random planes, hole grids, the budget, the tolerances, ill-formed holes.
TEST(HoleTriangulation, SameTrianglesAsThePlainTranscription)
{
    std::vector<CDorHolePolygon> shapes;
    for (int k : {1, 2, 3, 4})
        shapes.push_back(HolePolygon(Square(0, 0, 3 * k + 1), HoleGrid(k)));
    for (int n : {3, 60, 100, 120})
        shapes.push_back(HolePolygon(RegularPolygon(n), {}));
    shapes.push_back(HolePolygon(Star(20, 2.0, 1.0), {Square(-0.3, -0.3, 0.6), Square(0.5, 0.5, 0.2)}));
    shapes.push_back(HolePolygon(kNotched, {{DorVector3(4, 5, 0), DorVector3(8, 5 - 1e-5, 0), DorVector3(9, 5, 0), DorVector3(6, 7, 0)}}));
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
