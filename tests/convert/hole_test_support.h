#pragma once
// Checks shared by the holed converter tests.
#include <gtest/gtest.h>

#include <set>
#include <vector>

#include "convert/vel_hole_polygon_to_primitive.h"
#include "convert/vel_plane2d.h"
#include "convert_test_support.h"
#include "hole_shapes.h"

namespace hole_test {

using convert_test::LoopArea;

struct Triangulated {
    CDorArray<DorVector3, DorVector3&> vertices;
    CDorArray<int, int> indices;
    int Count() const { return indices.GetSize() / 3; }
};

inline void Triangulate(const CDorHolePolygon& shape, Triangulated& out)
{
    CVelHolePolygonToPrimitive().TriangulateHolePolygon(&shape, out.vertices, out.indices);
}

inline std::set<std::set<int>> TriangleSet(const CDorArray<int, int>& indices)
{
    std::set<std::set<int>> triangles;
    for (int t = 0; t + 2 < indices.GetSize(); t += 3)
        triangles.insert({indices[t], indices[t + 1], indices[t + 2]});
    return triangles;
}

// Every index in range and every triangle strictly counter-clockwise about normal; returns the
// triangles' total area.
inline double CheckTriangles(const Triangulated& t, const DorVector3& normal)
{
    EXPECT_EQ(t.indices.GetSize() % 3, 0);
    double area = 0;
    for (int k = 0; k + 2 < t.indices.GetSize(); k += 3) {
        for (int c = 0; c < 3; ++c) {
            EXPECT_GE(t.indices[k + c], 0);
            EXPECT_LT(t.indices[k + c], t.vertices.GetSize());
            if (t.indices[k + c] < 0 || t.indices[k + c] >= t.vertices.GetSize())
                return -1;
        }
        const DorVector3 &a = t.vertices[t.indices[k]], &b = t.vertices[t.indices[k + 1]], &c = t.vertices[t.indices[k + 2]];
        double twice = convert_test::SignedDoubleArea(a, b, c, normal);
        EXPECT_GT(twice, 1e-12) << "triangle " << k / 3 << " is clockwise or degenerate";
        area += twice * 0.5;
    }
    return area;
}

// Whether p (in z = 0) lies strictly inside the loop.
inline bool InsideFlatLoop(const DorVector3& p, const Loop& loop)
{
    std::vector<DorVector2> flat;
    for (const DorVector3& q : loop)
        flat.push_back(DorVector2(q.x, q.y));
    return VelWindingInside(VelWindingAngle(DorVector2(p.x, p.y), flat.data(), static_cast<int>(flat.size())));
}

// For a flat outline in z = 0: counter-clockwise about +z, no triangle centred in a hole or
// outside the outline, no triangle twice; returns the area.
inline double CheckFlatRing(const Loop& outline, const std::vector<Loop>& holes, const Triangulated& t)
{
    double area = CheckTriangles(t, DorVector3(0, 0, 1));
    for (int k = 0; k + 2 < t.indices.GetSize(); k += 3) {
        DorVector3 centre = (t.vertices[t.indices[k]] + t.vertices[t.indices[k + 1]] + t.vertices[t.indices[k + 2]]) *
                            (1.0 / 3);
        EXPECT_TRUE(InsideFlatLoop(centre, outline)) << "triangle " << k / 3 << " lies outside the outline";
        for (size_t h = 0; h < holes.size(); ++h)
            EXPECT_FALSE(InsideFlatLoop(centre, holes[h])) << "triangle " << k / 3 << " lies in hole " << h;
    }
    EXPECT_EQ(TriangleSet(t.indices).size(), static_cast<size_t>(t.Count())) << "a triangle appears twice";
    return area;
}

inline double RingArea(const Loop& outline, const std::vector<Loop>& holes)
{
    double area = LoopArea(outline);
    for (const Loop& hole : holes)
        area -= LoopArea(hole);
    return area;
}

}  // namespace hole_test
