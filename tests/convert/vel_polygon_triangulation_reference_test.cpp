// The production triangulation against the plain transcription in reference_triangulation.h:
// the same triangles in the same order, for outlines that exercise the budget, reflex points,
// collinear points and arbitrary planes.
#include <gtest/gtest.h>

#include <random>

#include "convert/vel_polygon_triangulation.h"
#include "convert_test_support.h"
#include "reference_triangulation.h"

using namespace convert_test;

namespace {
void ExpectSameAsReference(const std::vector<DorVector3>& outline, const char* what, int trial)
{
    CDorPolygon polygon = Polygon(outline);
    bool hasNormal = false;
    std::vector<int> expected = reference::Triangulate(polygon, hasNormal);
    CDorArray<int, int> indices;
    TriangulatePolygon(&polygon, indices);
    std::vector<int> actual(indices.GetData(), indices.GetData() + indices.GetSize());
    ASSERT_EQ(actual, expected) << what << " trial " << trial << ", " << outline.size() << " points";
}

// Points at sorted random angles and random radii: simple, usually with reflex points.
std::vector<DorVector3> RandomStarShaped(std::mt19937& rng, int n)
{
    std::uniform_real_distribution<double> radius(0.3, 2.0), jitter(0.0, 1.0);
    std::vector<DorVector3> points;
    for (int k = 0; k < n; ++k) {
        double a = 2 * kPi * (k + jitter(rng) * 0.9) / n;
        double r = radius(rng);
        points.push_back(DorVector3(r * std::cos(a), r * std::sin(a), 0));
    }
    return points;
}

// A staircase on the integer grid: many collinear points and exactly parallel edges.
std::vector<DorVector3> Staircase(int steps)
{
    std::vector<DorVector3> points = {DorVector3(0, 0, 0)};
    for (int s = 0; s < steps; ++s) {
        points.push_back(DorVector3(s + 1, s, 0));
        points.push_back(DorVector3(s + 1, s + 1, 0));
    }
    points.push_back(DorVector3(0, steps, 0));
    return points;
}
}  // namespace

TEST(TriangulationReference, RandomStarShapedOutlinesInRandomPlanes)
{
    std::mt19937 rng(2024);
    std::uniform_int_distribution<int> count(3, 48);
    std::uniform_real_distribution<double> angle(-kPi, kPi);
    for (int trial = 0; trial < 300; ++trial) {
        std::vector<DorVector3> outline = RandomStarShaped(rng, count(rng));
        if (trial % 2)
            outline = Transformed(outline, RotationXYZ(angle(rng), angle(rng), angle(rng)) * DorTranslate(1, 2, 3));
        ExpectSameAsReference(outline, "star-shaped", trial);
    }
}

TEST(TriangulationReference, BudgetLimitedAndCollinearOutlines)
{
    for (int n : {60, 61, 100, 120, 150})
        ExpectSameAsReference(RegularPolygon(n), "convex", n);
    for (int tips : {5, 12, 20, 30})
        ExpectSameAsReference(Star(tips, 2.0, 1.0), "star", tips);
    for (int steps : {1, 3, 8, 20})
        ExpectSameAsReference(Staircase(steps), "staircase", steps);
    ExpectSameAsReference(LShape(), "L", 0);
}
