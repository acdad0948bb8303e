#include <algorithm>
#include <limits>

#include "geometry_checks.h"


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
