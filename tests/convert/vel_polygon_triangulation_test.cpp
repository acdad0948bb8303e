#include "geometry_checks.h"

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

// Without a normal the indices handed in stay.
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
    CDorArray<int, int> untouched;
    TriangulatePolygon(nullptr, untouched);
    EXPECT_EQ(untouched.GetSize(), 0);
}
