#pragma once
// What every converted mesh must satisfy whatever diagonals the triangulation picked: indices in
// range, triangles counter-clockwise about the face's normal, in the material, none twice.
#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

#include "convert/vel_hole_polygon_to_primitive.h"
#include "convert/vel_plane2d.h"
#include "convert/vel_polygon_triangulation.h"
#include "convert_test_support.h"
#include "hole_shapes.h"

using namespace convert_test;
using namespace hole_test;

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

inline DorMatrix4x4 Tilt() { return DorRotateX(0.7) * DorRotateY(-1.1) * DorRotateZ(2.3) * DorTranslate(5, -3, 8); }

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

// Both triangulations are handed a stale index unless told otherwise: a result must replace it.
inline Mesh TriangulatePlain(const Loop& outline, bool stale = true)
{
    CDorPolygon polygon = Polygon(outline);
    CDorArray<int, int> indices;
    if (stale)
        indices.Add(7);
    TriangulatePolygon(&polygon, indices);
    return Mesh{outline, std::vector<int>(indices.GetData(), indices.GetData() + indices.GetSize())};
}

inline Mesh TriangulateHoled(const CDorHolePolygon& shape)
{
    CDorArray<DorVector3, DorVector3&> vertices;
    CDorArray<int, int> indices;
    indices.Add(7);
    CVelHolePolygonToPrimitive().TriangulateHolePolygon(&shape, vertices, indices);
    return Mesh{Loop(vertices.GetData(), vertices.GetData() + vertices.GetSize()),
                std::vector<int>(indices.GetData(), indices.GetData() + indices.GetSize())};
}

// Each group as its type and record count: P points, L lines, S line strip, T triangle strip,
// I indexed (others by number).
inline std::string Layout(const CVelGroupArray& groups)
{
    std::string out;
    for (int g = 0; g < groups.GetSize(); ++g) {
        int type = groups[g].GroupType;
        out += (g ? " " : "") + (type >= 0 && type <= 6 ? std::string(1, "PLS3T5I"[type]) : std::to_string(type)) +
               std::to_string(groups[g].vertices.GetSize());
    }
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

// CheckTriangles about the outline's normal, no triangle twice and, for an outline in z = 0,
// no triangle centred outside the outline or in a hole; returns the area.
inline double CheckRing(const Mesh& m, const Loop& outline, const std::vector<Loop>& holes = {})
{
    double area = CheckTriangles(m, UnitNormal(outline));
    std::set<std::set<int>> triangles;
    for (size_t t = 0; t + 2 < m.i.size(); t += 3)
        triangles.insert({m.i[t], m.i[t + 1], m.i[t + 2]});
    EXPECT_EQ(triangles.size(), static_cast<size_t>(m.Count())) << "a triangle appears twice";
    auto inside = [](const DorVector3& p, const Loop& loop) {
        std::vector<DorVector2> flat;
        for (const DorVector3& q : loop)
            flat.push_back(DorVector2(q.x, q.y));
        return VelWindingInside(VelWindingAngle(DorVector2(p.x, p.y), flat.data(), static_cast<int>(flat.size())));
    };
    bool flat = true;
    for (const DorVector3& p : outline)
        flat = flat && p.z == 0;
    for (size_t t = 0; flat && area >= 0 && t + 2 < m.i.size(); t += 3) {
        DorVector3 centre = (m.v[m.i[t]] + m.v[m.i[t + 1]] + m.v[m.i[t + 2]]) * (1.0 / 3);
        EXPECT_TRUE(inside(centre, outline)) << "triangle " << t / 3 << " lies outside the outline";
        for (size_t h = 0; h < holes.size(); ++h)
            EXPECT_FALSE(inside(centre, holes[h])) << "triangle " << t / 3 << " lies in hole " << h;
    }
    return area;
}
