// The production triangulation with holes against the plain transcription in
// reference_hole_triangulation.h: the same triangles in the same order, for holed outlines in
// arbitrary planes, at the budget, at the tolerances and for ill-formed holes.
#include <gtest/gtest.h>

#include <limits>
#include <random>

#include "hole_test_support.h"
#include "reference_hole_triangulation.h"

using namespace hole_test;

namespace {
void ExpectSameAsReference(const CDorHolePolygon& shape, const char* what, int trial)
{
    std::vector<int> expected = reference::TriangulateHoles(shape);
    Triangulated t;
    Triangulate(shape, t);
    std::vector<int> actual(t.indices.GetData(), t.indices.GetData() + t.indices.GetSize());
    ASSERT_EQ(actual, expected) << what << " trial " << trial << ", " << shape.holes.GetSize() << " holes";
}

// Points at sorted random angles and random radii about a centre: simple, often with reflex points.
Loop RandomStarShaped(std::mt19937& rng, int n, double cx, double cy, double rMin, double rMax)
{
    std::uniform_real_distribution<double> radius(rMin, rMax), jitter(0.0, 0.9);
    Loop points;
    for (int k = 0; k < n; ++k) {
        double a = 2 * convert_test::kPi * (k + jitter(rng)) / n, r = radius(rng);
        points.push_back(DorVector3(cx + r * std::cos(a), cy + r * std::sin(a), 0));
    }
    return points;
}

// An outline of radius about 10 with up to four holes on a 2 x 2 grid of cells, each hole
// either way round.
CDorHolePolygon RandomHoled(std::mt19937& rng, int maxHoles)
{
    std::uniform_int_distribution<int> outlineCount(3, 24), holeCount(0, maxHoles), holeSize(1, 7), coin(0, 1);
    Loop outline = RandomStarShaped(rng, outlineCount(rng), 0, 0, 8.0, 11.0);
    std::vector<Loop> holes;
    const int h = holeCount(rng);
    for (int k = 0; k < h; ++k) {
        Loop hole = RandomStarShaped(rng, holeSize(rng) + 2, k % 2 ? 2.5 : -2.5, k / 2 ? 2.5 : -2.5, 0.6, 2.0);
        if (coin(rng))
            std::reverse(hole.begin(), hole.end());
        holes.push_back(hole);
    }
    return HolePolygon(outline, holes);
}

CDorHolePolygon Moved(const CDorHolePolygon& shape, const DorMatrix4x4& m)
{
    CDorHolePolygon moved(shape);
    for (int k = 0; k < moved.points.GetSize(); ++k)
        moved.points[k] = DorTransformPoint(moved.points[k], m);
    for (int h = 0; h < moved.holes.GetSize(); ++h)
        for (int k = 0; k < moved.holes[h].points.GetSize(); ++k)
            moved.holes[h].points[k] = DorTransformPoint(moved.holes[h].points[k], m);
    return moved;
}
}  // namespace

TEST(HoleTriangulationReference, RandomHoledOutlinesInRandomPlanes)
{
    std::mt19937 rng(77);
    std::uniform_real_distribution<double> angle(-convert_test::kPi, convert_test::kPi);
    for (int trial = 0; trial < 300; ++trial) {
        CDorHolePolygon shape = RandomHoled(rng, 4);
        if (trial % 2)
            shape = Moved(shape, convert_test::RotationXYZ(angle(rng), angle(rng), angle(rng)) * DorTranslate(1, 2, 3));
        ExpectSameAsReference(shape, "random", trial);
    }
}

TEST(HoleTriangulationReference, GridsBudgetAndTolerances)
{
    for (int k : {1, 2, 3, 4})
        ExpectSameAsReference(HolePolygon(Square(0, 0, 3 * k + 1), HoleGrid(k)), "hole grid", k);
    for (int n : {3, 60, 100, 120})
        ExpectSameAsReference(HolePolygon(convert_test::RegularPolygon(n), {}), "convex", n);
    ExpectSameAsReference(HolePolygon(convert_test::Star(20, 2.0, 1.0), {Square(-0.3, -0.3, 0.6), Square(0.5, 0.5, 0.2)}),
                          "star", 0);
    ExpectSameAsReference(HolePolygon({DorVector3(0, 0, 0), DorVector3(4, 0, 0), DorVector3(8, 1e-5, 0),
                                       DorVector3(9, 0, 0), DorVector3(10, 0, 0), DorVector3(10, 10, 0),
                                       DorVector3(0, 10, 0)},
                                      {{DorVector3(4, 5, 0), DorVector3(8, 5 - 1e-5, 0), DorVector3(9, 5, 0),
                                        DorVector3(6, 7, 0)}}),
                          "near the tolerances", 0);
}

TEST(HoleTriangulationReference, IllFormedHoles)
{
    const Loop outline = Square(0, 0, 10);
    const std::vector<std::vector<Loop>> holeSets = {
        {{}, {DorVector3(5, 5, 0)}, Square(2, 2, 2)},
        {Square(20, 20, 2)},
        {Square(2, 2, 4), Square(4, 4, 4)},
        {Square(-2, -2, 4)},
        {{DorVector3(3, 3, 0), DorVector3(6, 6, 0)}},
        {Square(2, 2, 2), Square(2, 2, 2)},
        {{DorVector3(std::numeric_limits<double>::quiet_NaN(), 1, 0), DorVector3(2, 2, 0), DorVector3(1, 3, 0)}},
    };
    for (size_t k = 0; k < holeSets.size(); ++k)
        ExpectSameAsReference(HolePolygon(outline, holeSets[k]), "ill-formed", static_cast<int>(k));
}
