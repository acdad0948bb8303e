// Both triangulations against their plain transcriptions on the benchmark's outline families and
// on near-degenerate outlines: points snapped to a coarse lattice (collinear runs), a repeated
// point, holes touching each other and the outline, non-finite points; flat and in random planes.
#include <cmath>
#include <limits>

#include "geometry_checks.h"
#include "reference_triangulations.h"
#include "triangulation_families.h"

namespace {
Loop Snapped(std::mt19937& rng, int n, double cx, double cy, double rMin, double rMax)
{
    Loop loop = RandomStarShaped(rng, n, cx, cy, rMin, rMax);
    for (DorVector3& p : loop)
        p = DorVector3(std::round(2 * p.x) / 2, std::round(2 * p.y) / 2, 0);
    size_t at = rng() % loop.size();
    loop.insert(loop.begin() + at, loop[at]);
    return loop;
}
}  // namespace

TEST(TriangulationCorpus, SameTrianglesAsThePlainTranscriptions)
{
    typedef std::pair<Loop, std::vector<Loop>> Shape;
    std::vector<Shape> shapes;
    for (int n : {8, 13, 40, 42, 60, 100})
        for (const Loop& outline : {RegularPolygon(n), Star(n / 2, 2.0, 1.0), families::Comb(n), families::LPlan(n),
                                    families::SubdividedSquare(n), families::CrossingStar(n + 1, 3)})
            shapes.push_back({outline, {}});
    for (int k : {1, 2, 3})
        shapes.push_back({Square(0, 0, 3 * k + 1), HoleGrid(k)});
    const double inf = std::numeric_limits<double>::infinity();
    for (double bad : {std::numeric_limits<double>::quiet_NaN(), inf, -inf, 1e300})
        shapes.push_back({{DorVector3(0, 0, 0), DorVector3(4, 0, 0), DorVector3(bad, 2, 0), DorVector3(4, 4, 0), DorVector3(0, 4, 0)},
                          {{DorVector3(1, 1, 0), DorVector3(2, 1, 0), DorVector3(1, bad, 0)}}});
    std::mt19937 rng(1717);
    for (int trial = 0; trial < 240; ++trial) {
        Shape shape = {Snapped(rng, 3 + rng() % 30, 0, 0, 3.0, 8.0), {}};
        for (int h = trial % 3; h > 0; --h)
            shape.second.push_back(Snapped(rng, 3 + rng() % 5, h == 1 ? -1.5 : 1.0, 0, 0.5, 1.5));
        shapes.push_back(shape);
    }
    std::uniform_real_distribution<double> angle(-kPi, kPi);
    for (size_t k = 0, count = shapes.size(); k < count; ++k) {  // every shape again in a random plane
        DorMatrix4x4 m = DorRotateX(angle(rng)) * DorRotateY(angle(rng)) * DorRotateZ(angle(rng)) * DorTranslate(1, 2, 3);
        Shape moved = {Transformed(shapes[k].first, m), {}};
        for (const Loop& hole : shapes[k].second)
            moved.second.push_back(Transformed(hole, m));
        shapes.push_back(moved);
    }
    // Flat only: tilted, its slivers' side marks differ (the transcription marks a side by the
    // centroid, the production by the direction the triangle runs along the edge).
    shapes.push_back({Square(0, 0, 8), {Square(0, 0, 2), Square(2, 2, 2), Square(4, 2, 2), Square(6, 6, 2)}});
    for (size_t k = 0; k < shapes.size(); ++k) {
        CDorHolePolygon holed = HolePolygon(shapes[k].first, shapes[k].second);
        ASSERT_EQ(TriangulateHoled(holed).i, reference::TriangulateHoles(holed)) << "shape " << k;
        ASSERT_EQ(TriangulatePlain(shapes[k].first, false).i, reference::Triangulate(Polygon(shapes[k].first))) << "shape " << k;
    }
}
