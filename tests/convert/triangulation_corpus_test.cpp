// Both triangulations against their plain transcriptions: the benchmark's outline families, the
// budget of 100 added edges (large outlines stay partly triangulated), staircases of reflex and
// collinear points, random outlines with holes either way round, near-degenerate outlines (points
// snapped to a coarse lattice, a repeated point, holes touching each other and the outline,
// ill-formed and non-finite holes) and the holed tolerances; flat and in random planes.
#include <cmath>
#include <limits>
#include <random>

#include "convert/vel_plane2d.h"
#include "convert/vel_polygon_triangulation.h"
#include "geometry_checks.h"
#include "reference_triangulations.h"
#include "triangulation_families.h"

namespace {
typedef std::pair<Loop, std::vector<Loop>> Shape;

// Both triangulations are handed a stale index unless told otherwise: a result must replace it.
Mesh TriangulatePlain(const Loop& outline, bool stale = true)
{
    CDorPolygon polygon = Polygon(outline);
    CDorArray<int, int> indices;
    if (stale)
        indices.Add(7);
    TriangulatePolygon(&polygon, indices);
    return Mesh{outline, std::vector<int>(indices.GetData(), indices.GetData() + indices.GetSize())};
}

// Points at sorted random angles and random radii about a centre: simple, often with reflex points.
Loop RandomStarShaped(std::mt19937& rng, int n, double cx, double cy, double rMin, double rMax)
{
    std::uniform_real_distribution<double> radius(rMin, rMax), jitter(0.0, 0.9);
    Loop points;
    for (int k = 0; k < n; ++k) {
        double a = 2 * kPi * (k + jitter(rng)) / n, r = radius(rng);
        points.push_back(DorVector3(cx + r * std::cos(a), cy + r * std::sin(a), 0));
    }
    return points;
}

Loop Snapped(std::mt19937& rng, int n, double cx, double cy, double rMin, double rMax)
{
    Loop loop = RandomStarShaped(rng, n, cx, cy, rMin, rMax);
    for (DorVector3& p : loop)
        p = DorVector3(std::round(2 * p.x) / 2, std::round(2 * p.y) / 2, 0);
    size_t at = rng() % loop.size();
    loop.insert(loop.begin() + at, loop[at]);
    return loop;
}

Loop Stairs(int steps)
{
    Loop stairs = {DorVector3(0, 0, 0)};
    for (int s = 0; s < steps; ++s)
        stairs.insert(stairs.end(), {DorVector3(s + 1, s, 0), DorVector3(s + 1, s + 1, 0)});
    stairs.push_back(DorVector3(0, steps, 0));
    return stairs;
}

// Shapes whose slivers are decided differently once tilted (the transcription marks a side by the
// centroid, the production by the direction the triangle runs along the edge): compared flat only.
std::vector<Shape> FlatOnlyShapes()
{
    // Vertex 2 sits 1e-5 above the chord 1-3: its midpoint is just outside, but loosely on edge 1-2.
    const Loop notched = {DorVector3(0, 0, 0), DorVector3(4, 0, 0), DorVector3(8, 1e-5, 0), DorVector3(9, 0, 0),
                          DorVector3(10, 0, 0), DorVector3(10, 10, 0), DorVector3(0, 10, 0)};
    const Loop bumped = {DorVector3(0, 0, 0), DorVector3(100 - 5e-6, 0, 0), DorVector3(100 + 5e-6, -5e-6, 0),
                         DorVector3(100, 5e-6, 0), DorVector3(100, 100, 0), DorVector3(0, 100, 0)};
    const Loop nearHole = {DorVector3(4, 5, 0), DorVector3(8, 5 - 1e-5, 0), DorVector3(9, 5, 0), DorVector3(6, 7, 0)};
    Loop closed = Square(0, 0, 1);
    closed.push_back(closed[0]);
    std::vector<Shape> shapes = {{notched, {}}, {bumped, {}}, {Square(0, 0, 12), {nearHole}}, {notched, {nearHole}}, {closed, {}},
                                 {Square(0, 0, 8), {Square(0, 0, 2), Square(2, 2, 2), Square(4, 2, 2), Square(6, 6, 2)}}};
    // Empty, one-point, outside, overlapping, crossing, two-point, repeated and non-finite holes.
    for (const std::vector<Loop>& holes : std::vector<std::vector<Loop>>{
             {{}, {DorVector3(5, 5, 0)}, Square(2, 2, 2)}, {Square(20, 20, 2)}, {Square(2, 2, 4), Square(4, 4, 4)}, {Square(-2, -2, 4)},
             {{DorVector3(3, 3, 0), DorVector3(6, 6, 0)}}, {Square(2, 2, 2), Square(2, 2, 2)},
             {{DorVector3(std::numeric_limits<double>::quiet_NaN(), 1, 0), DorVector3(2, 2, 0), DorVector3(1, 3, 0)}}})
        shapes.push_back({Square(0, 0, 10), holes});
    // A NaN point amid a long hole: the winding count must not pass over it with its neighbours.
    Loop ring = Transformed(RegularPolygon(24, 3.0), DorTranslate(5, 5, 0));
    ring[12].y = std::numeric_limits<double>::quiet_NaN();
    shapes.push_back({Square(0, 0, 10), {ring}});
    return shapes;
}

// The random outlines of the old per-triangulator tests: star-shaped, up to one hole per cell of a
// 2 x 2 grid either way round, every other one in a random plane.
std::vector<Shape> RandomHoledShapes()
{
    std::vector<Shape> shapes;
    std::mt19937 rng(77);
    std::uniform_real_distribution<double> angle(-kPi, kPi);
    for (int trial = 0; trial < 300; ++trial) {
        Shape shape = {RandomStarShaped(rng, 3 + rng() % 46, 0, 0, 8.0, 11.0), std::vector<Loop>(rng() % 5)};
        for (size_t k = 0; k < shape.second.size(); ++k) {
            shape.second[k] = RandomStarShaped(rng, 3 + rng() % 7, k % 2 ? 2.5 : -2.5, k / 2 ? 2.5 : -2.5, 0.6, 2.0);
            if (rng() % 2)
                std::reverse(shape.second[k].begin(), shape.second[k].end());
        }
        if (trial % 2) {
            DorMatrix4x4 m = DorRotateX(angle(rng)) * DorRotateY(angle(rng)) * DorRotateZ(angle(rng)) * DorTranslate(1, 2, 3);
            shape.first = Transformed(shape.first, m);
            for (Loop& hole : shape.second)
                hole = Transformed(hole, m);
        }
        shapes.push_back(shape);
    }
    return shapes;
}
}  // namespace

// Besides matching the transcriptions, well-formed rings whatever the way their loops run or their
// plane, with a point on a chord (the pentagon's point 1 lies on 0-2), and triangles under random
// rigid moves: n - 2 plain triangles cover the outline once, V + 2 H - 2 holed ones the ring, each
// counter-clockwise about the outline's normal, stale indices replaced; the holed triangulation
// lists the outline's vertices then the holes', unchanged, and leaves a bare triangle to its caller.
TEST(TriangulationCorpus, SameTrianglesAsThePlainTranscriptions)
{
    const Loop triangle = {DorVector3(1, 1, 0), DorVector3(3, 1, 0), DorVector3(2, 3, 0)};
    const DorMatrix4x4 tilt = DorRotateX(0.7) * DorRotateY(-1.1) * DorRotateZ(2.3) * DorTranslate(5, -3, 8);
    const Loop pentagon = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0), DorVector3(2, 2, 0), DorVector3(0, 2, 0)};
    std::vector<Shape> shapes = {
        {Square(0, 0, 1), {}}, {Square(0, 0, 1, true), {}}, {LShape(), {}}, {Transformed(LShape(), tilt), {}}, {pentagon, {}},
        {RegularPolygon(60), {}}, {Star(5, 2.0, 0.8), {}}, {Square(0, 0, 4), {triangle}},
        {Square(0, 0, 4), {{triangle[0], triangle[2], triangle[1]}}}, {Square(0, 0, 4, true), {triangle}},
        {Transformed(Square(0, 0, 4), tilt), {Transformed(triangle, tilt)}}, {Square(0, 0, 4), {Square(1, 1, 2)}},
        {Square(0, 0, 7), HoleGrid(2)}, {Square(0, 0, 10), HoleGrid(3)}};
    std::mt19937 moves(11);
    std::uniform_real_distribution<double> angle(-kPi, kPi), shift(-50, 50);
    for (int trial = 0; trial < 5000; ++trial)
        shapes.push_back({Transformed({DorVector3(0, 0, 0), DorVector3(3, 0, 0), DorVector3(1, 2, 0)},
                                      DorRotateX(angle(moves)) * DorRotateY(angle(moves)) * DorRotateZ(angle(moves)) *
                                          DorTranslate(shift(moves), shift(moves), shift(moves))),
                          {}});
    const size_t wellFormed = shapes.size();
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
    for (size_t k = wellFormed, count = shapes.size(); k < count; ++k) {  // every shape again in a random plane
        DorMatrix4x4 m = DorRotateX(angle(rng)) * DorRotateY(angle(rng)) * DorRotateZ(angle(rng)) * DorTranslate(1, 2, 3);
        Shape moved = {Transformed(shapes[k].first, m), {}};
        for (const Loop& hole : shapes[k].second)
            moved.second.push_back(Transformed(hole, m));
        shapes.push_back(moved);
    }
    shapes.push_back({LShape(), {}});
    for (int n : {61, 120, 150})
        shapes.push_back({RegularPolygon(n), {}});
    for (int tips : {5, 12, 20, 30})
        shapes.push_back({Star(tips, 2.0, 1.0), {}});
    for (int steps : {1, 3, 8, 20})
        shapes.push_back({Stairs(steps), {}});
    shapes.push_back({Square(0, 0, 13), HoleGrid(4)});
    // Over 128 points with many on the candidates: they lie in several groups of the point search.
    // Over 256 edges, crossing at every turn: the crossing search checks groups of edges.
    shapes.push_back({Square(0, 0, 19), HoleGrid(6)});
    shapes.push_back({families::LPlan(150), {}});
    shapes.push_back({families::CrossingStar(301, 3), {}});
    shapes.push_back({Star(20, 2.0, 1.0), {Square(-0.3, -0.3, 0.6), Square(0.5, 0.5, 0.2)}});
    for (const std::vector<Shape>& more : {RandomHoledShapes(), FlatOnlyShapes()})
        shapes.insert(shapes.end(), more.begin(), more.end());
    for (size_t k = 0; k < shapes.size(); ++k) {
        const Loop& outline = shapes[k].first;
        const std::vector<Loop>& holes = shapes[k].second;
        CDorHolePolygon holed = HolePolygon(outline, holes);
        CDorArray<DorVector3, DorVector3&> points;
        CDorArray<int, int> indices;
        indices.Add(7);
        CVelHolePolygonToPrimitive().TriangulateHolePolygon(&holed, points, indices);
        Mesh m{Loop(points.GetData(), points.GetData() + points.GetSize()),
               std::vector<int>(indices.GetData(), indices.GetData() + indices.GetSize())};
        ASSERT_EQ(m.i, reference::TriangulateHoles(holed)) << "shape " << k;
        ASSERT_EQ(TriangulatePlain(outline, false).i, reference::Triangulate(Polygon(outline))) << "shape " << k;
        if (k >= wellFormed)
            continue;
        Mesh plain = TriangulatePlain(outline);
        ASSERT_EQ(plain.Count(), static_cast<int>(outline.size()) - 2) << "shape " << k;
        ASSERT_NEAR(CheckTriangles(plain, UnitNormal(outline)), LoopArea(outline), 1e-9 * LoopArea(outline)) << "shape " << k;
        Loop vertices = outline;
        for (const Loop& hole : holes)
            vertices.insert(vertices.end(), hole.begin(), hole.end());
        ASSERT_EQ(m.Count(), vertices.size() > 3 ? static_cast<int>(vertices.size() + 2 * holes.size()) - 2 : 0) << "shape " << k;
        EXPECT_NEAR(CheckTriangles(m, UnitNormal(outline)), m.i.empty() ? 0 : RingArea(outline, holes), 1e-9) << "shape " << k;
        EXPECT_TRUE(std::equal(m.v.begin(), m.v.end(), vertices.begin(), vertices.end(), SamePoint)) << "shape " << k;
    }
}

// The winding angle behind the inside test's exact fallback (the segment and edge predicates are
// exercised by the corpus above): a full turn inside, none outside, and at a corner the two edges
// that meet there add nothing while the others subtend the right angle.
TEST(Plane2d, WindingAngleInsideOutsideAndOnTheOutline)
{
    const DorVector2 square[4] = {DorVector2(0, 0), DorVector2(2, 0), DorVector2(2, 2), DorVector2(0, 2)};
    const struct { DorVector2 q; double angle; } rows[] = {{{1, 1}, 2 * kPi}, {{3, 1}, 0}, {{2, 2}, kPi / 2}};
    for (const auto& r : rows) {
        EXPECT_NEAR(VelWindingAngle(r.q, square, 4), r.angle, 1e-12) << r.q.x << "," << r.q.y;
        EXPECT_EQ(VelWindingInside(VelWindingAngle(r.q, square, 4)), r.angle > kPi) << r.q.x << "," << r.q.y;
    }
}
