#pragma once
// What every converted mesh must satisfy whatever diagonals the triangulation picked: indices in
// range, triangles counter-clockwise about the face's normal.
#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "convert/vel_hole_polygon_to_primitive.h"
#include "convert_test_support.h"

using namespace convert_test;

inline bool SamePoint(const DorVector3& a, const DorVector3& b) { return a.x == b.x && a.y == b.y && a.z == b.z; }

inline bool Near(const DorVector3& a, const DorVector3& b, double tolerance = 1e-12) { return DorLength(a - b) <= tolerance; }

inline DorVector3 UnitNormal(const Loop& loop)
{
    DorVector3 n = DorNewellNormal(loop.data(), static_cast<int>(loop.size()));
    DorNormalize(n);
    return n;
}

inline double LoopArea(const Loop& loop) { return DorLength(DorNewellNormal(loop.data(), static_cast<int>(loop.size()))) / 2; }

inline double RingArea(const Loop& outline, const std::vector<Loop>& holes)
{
    double area = LoopArea(outline);
    for (const Loop& hole : holes)
        area -= LoopArea(hole);
    return area;
}

inline Loop Transformed(const Loop& points, const DorMatrix4x4& m)
{
    Loop out;
    for (const DorVector3& p : points)
        out.push_back(DorTransformPoint(p, m));
    return out;
}

struct Mesh {
    Loop v;
    std::vector<int> i;
    int Count() const { return static_cast<int>(i.size()) / 3; }
};

inline Mesh MeshOf(const CVelTrianglePolys& g)
{
    Mesh m;
    for (int k = 0; k < g.vertices.GetSize(); ++k)
        m.v.push_back(g.vertices[k].position);
    for (int t = 0; t < g.triangles.GetSize(); ++t)
        m.i.insert(m.i.end(), {g.triangles[t].a, g.triangles[t].b, g.triangles[t].c});
    return m;
}

// Each group as its type and record count: P points, L lines, S line strip, T triangle strip,
// I indexed, ? any other type.
inline std::string Layout(const CVelGroupArray& groups)
{
    std::string out;
    for (int g = 0; g < groups.GetSize(); ++g)
        out += (g ? " " : "") + std::string(1, "PLS3T5I?"[std::min(static_cast<unsigned>(groups[g].GroupType), 7u)]) +
               std::to_string(groups[g].vertices.GetSize());
    return out;
}

// Indices in range and every triangle strictly counter-clockwise about normal; returns the area.
inline double CheckTriangles(const Mesh& m, const DorVector3& normal)
{
    EXPECT_EQ(m.i.size() % 3, 0u);
    double area = 0;
    for (size_t t = 0; t + 2 < m.i.size(); t += 3) {
        for (int c = 0; c < 3; ++c)
            if (m.i[t + c] < 0 || m.i[t + c] >= static_cast<int>(m.v.size())) {
                ADD_FAILURE() << "index " << m.i[t + c] << " out of range";
                return -1;
            }
        const DorVector3 &a = m.v[m.i[t]], &b = m.v[m.i[t + 1]], &c = m.v[m.i[t + 2]];
        double twice = DorDot(DorCross(b - a, c - a), normal);
        EXPECT_GT(twice, 1e-12) << "triangle " << t / 3 << " is clockwise or degenerate";
        area += twice / 2;
    }
    return area;
}
