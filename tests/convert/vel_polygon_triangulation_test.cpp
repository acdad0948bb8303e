#include <limits>

#include "geometry_checks.h"
#include "reference_triangulations.h"

TEST(PolygonTriangulation, CompleteOutlinesCoverTheirAreaOnce)
{
    // The pentagon's point 1 lies on the chord 0-2; the clockwise square follows its own normal.
    const Loop pentagon = {DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(2, 0, 0), DorVector3(2, 2, 0), DorVector3(0, 2, 0)};
    for (const Loop& outline : {Square(0, 0, 1), Square(0, 0, 1, true), LShape(), Transformed(LShape(), Tilt()), pentagon,
                                RegularPolygon(60), Star(5, 2.0, 0.8)}) {
        Mesh m = TriangulatePlain(outline);
        EXPECT_EQ(m.Count(), static_cast<int>(outline.size()) - 2) << outline.size() << " points";
        EXPECT_NEAR(CheckRing(m, outline), LoopArea(outline), 1e-9 * LoopArea(outline)) << outline.size() << " points";
    }
}

TEST(PolygonTriangulation, OneTriangleWhateverTheRotation)
{
    std::mt19937 rng(11);
    std::uniform_real_distribution<double> angle(-kPi, kPi), shift(-50, 50);
    for (int trial = 0; trial < 20000; ++trial) {
        DorMatrix4x4 m = DorRotateX(angle(rng)) * DorRotateY(angle(rng)) * DorRotateZ(angle(rng)) *
                         DorTranslate(shift(rng), shift(rng), shift(rng));
        Loop moved = Transformed({DorVector3(0, 0, 0), DorVector3(3, 0, 0), DorVector3(1, 2, 0)}, m);
        Mesh t = TriangulatePlain(moved);
        ASSERT_EQ(t.Count(), 1) << "trial " << trial;
        ASSERT_GT(CheckTriangles(t, UnitNormal(moved)), 0);
    }
}

// The list's budget of 100 added edges leaves large outlines partly triangulated.
TEST(PolygonTriangulation, PartialAtTheBudget)
{
    Mesh fan = TriangulatePlain(RegularPolygon(120));
    CheckRing(fan, RegularPolygon(120));
    EXPECT_EQ(fan.Triangles(), FanFromZero(99));
    Loop star = Star(20, 2.0, 1.0);
    Mesh partial = TriangulatePlain(star);
    ASSERT_GT(partial.Count(), 0);
    EXPECT_LE(CheckRing(partial, star), LoopArea(star) * (1 + 1e-12));
    Loop closed = Square(0, 0, 1);
    closed.push_back(closed[0]);
    EXPECT_NEAR(CheckRing(TriangulatePlain(closed), closed), 1.0, 1e-12);
}

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
    const double nan = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
    for (double bad : {nan, inf, -inf})
        for (int k : TriangulatePlain({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(bad, 1, 0), DorVector3(0, 1, 0)}, false).i)
            EXPECT_TRUE(k >= 0 && k < 4) << k;
    CDorArray<int, int> untouched;
    TriangulatePolygon(nullptr, untouched);
    EXPECT_EQ(untouched.GetSize(), 0);
}

// Random outlines in random planes, the budget, reflex and collinear points (a staircase).
TEST(PolygonTriangulation, SameTrianglesAsThePlainTranscription)
{
    std::vector<Loop> outlines = {LShape()};
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
