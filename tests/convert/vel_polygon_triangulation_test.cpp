#include <limits>

#include "geometry_checks.h"
#include "reference_triangulations.h"

// Whatever the orientation or plane, with a point on a chord (the pentagon's point 1 lies on
// 0-2), and for a triangle under random rigid moves: n - 2 counter-clockwise triangles covering
// the outline once, the stale index replaced.
TEST(PolygonTriangulation, CompleteOutlinesCoverTheirAreaOnce)
{
    const Loop pentagon = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0), DorVector3(2, 2, 0), DorVector3(0, 2, 0)};
    std::vector<Loop> outlines = {Square(0, 0, 1), Square(0, 0, 1, true), LShape(), Transformed(LShape(), Tilt()),
                                  pentagon,        RegularPolygon(60),    Star(5, 2.0, 0.8)};
    std::mt19937 rng(11);
    std::uniform_real_distribution<double> angle(-kPi, kPi), shift(-50, 50);
    for (int trial = 0; trial < 5000; ++trial)
        outlines.push_back(Transformed({DorVector3(0, 0, 0), DorVector3(3, 0, 0), DorVector3(1, 2, 0)},
                                       DorRotateX(angle(rng)) * DorRotateY(angle(rng)) * DorRotateZ(angle(rng)) *
                                           DorTranslate(shift(rng), shift(rng), shift(rng))));
    for (size_t k = 0; k < outlines.size(); ++k) {
        Mesh m = TriangulatePlain(outlines[k]);
        ASSERT_EQ(m.Count(), static_cast<int>(outlines[k].size()) - 2) << "outline " << k;
        ASSERT_NEAR(CheckRing(m, outlines[k]), LoopArea(outlines[k]), 1e-9 * LoopArea(outlines[k])) << "outline " << k;
    }
}

// Without a normal the indices handed in stay; a non-finite point still gives indices in range.
TEST(PolygonTriangulation, WithoutANormalTheIndicesStayAsHandedIn)
{
    const std::vector<Loop> outlines = {
        {}, {DorVector3(1, 2, 3)}, {DorVector3(0, 0, 0), DorVector3(1, 0, 0)},
        {DorVector3(0, 0, 0), DorVector3(1, 1, 1), DorVector3(2, 2, 2)},
        {DorVector3(4, 4, 4), DorVector3(4, 4, 4), DorVector3(4, 4, 4), DorVector3(4, 4, 4)},
        {DorVector3(0, 0, 0), DorVector3(1, 1, 0), DorVector3(1, 0, 0), DorVector3(0, 1, 0)},  // figure eight
    };
    for (const Loop& outline : outlines)
        EXPECT_EQ(TriangulatePlain(outline).i, std::vector<int>{7}) << outline.size() << " points";
    for (double bad : {std::numeric_limits<double>::quiet_NaN(), HUGE_VAL, -HUGE_VAL})
        for (int k : TriangulatePlain({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(bad, 1, 0), DorVector3(0, 1, 0)}, false).i)
            EXPECT_TRUE(k >= 0 && k < 4) << k;
    CDorArray<int, int> untouched;
    TriangulatePolygon(nullptr, untouched);
    EXPECT_EQ(untouched.GetSize(), 0);
}

// Random outlines in random planes, the budget of 100 added edges (large outlines stay partly
// triangulated), reflex and collinear points (a staircase), a repeated first point.
TEST(PolygonTriangulation, SameTrianglesAsThePlainTranscription)
{
    std::vector<Loop> outlines = {LShape(), Square(0, 0, 1)};
    outlines.back().push_back(outlines.back()[0]);
    for (int n : {60, 61, 100, 120, 150})
        outlines.push_back(RegularPolygon(n));
    for (int tips : {5, 12, 20, 30})
        outlines.push_back(Star(tips, 2.0, 1.0));
    for (int steps : {1, 3, 8, 20}) {
        Loop stairs = {DorVector3(0, 0, 0)};
        for (int s = 0; s < steps; ++s)
            stairs.insert(stairs.end(), {DorVector3(s + 1, s, 0), DorVector3(s + 1, s + 1, 0)});
        stairs.push_back(DorVector3(0, steps, 0));
        outlines.push_back(stairs);
    }
    std::mt19937 rng(2024);
    std::uniform_int_distribution<int> count(3, 48);
    std::uniform_real_distribution<double> angle(-kPi, kPi);
    for (int trial = 0; trial < 300; ++trial) {
        Loop outline = RandomStarShaped(rng, count(rng), 0, 0, 0.3, 2.0);
        outlines.push_back(trial % 2 ? Transformed(outline, DorRotateX(angle(rng)) * DorRotateY(angle(rng)) *
                                                                DorRotateZ(angle(rng)) * DorTranslate(1, 2, 3))
                                     : outline);
    }
    for (size_t k = 0; k < outlines.size(); ++k) {
        ASSERT_EQ(TriangulatePlain(outlines[k], false).i, reference::Triangulate(Polygon(outlines[k]))) << "outline " << k;
    }
}
