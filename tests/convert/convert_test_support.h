#pragma once
// Outlines, plain and holed, shared by the converter tests and the conversion benchmarks.
#include <cmath>
#include <utility>
#include <vector>

#include "convert/dor_shape.h"
#include "model/dor_math.h"

namespace convert_test {

const double kPi = 3.14159265358979323846;

typedef std::vector<DorVector3> Loop;

// An axis-aligned square in z = 0 with its lower left corner at (x, y).
inline Loop Square(double x, double y, double side, bool clockwise = false)
{
    Loop loop = {DorVector3(x, y, 0), DorVector3(x + side, y, 0), DorVector3(x + side, y + side, 0),
                 DorVector3(x, y + side, 0)};
    if (clockwise)
        std::swap(loop[1], loop[3]);
    return loop;
}

inline CDorHolePolygon HolePolygon(const Loop& outline, const std::vector<Loop>& holes)
{
    CDorHolePolygon shape;
    shape.SetPoints(outline.data(), static_cast<int>(outline.size()));
    for (const Loop& hole : holes)
        shape.AddHole(hole.data(), static_cast<int>(hole.size()));
    return shape;
}

// A square of side 3k + 1 with k x k square holes of side 2, one unit apart.
inline std::vector<Loop> HoleGrid(int k)
{
    std::vector<Loop> holes;
    for (int a = 0; a < k; ++a)
        for (int b = 0; b < k; ++b)
            holes.push_back(Square(1 + 3 * a, 1 + 3 * b, 2));
    return holes;
}

inline std::vector<DorVector3> RegularPolygon(int n, double radius = 1.0)
{
    std::vector<DorVector3> points;
    for (int k = 0; k < n; ++k)
        points.push_back(DorVector3(radius * std::cos(2 * kPi * k / n), radius * std::sin(2 * kPi * k / n), 0));
    return points;
}

// Alternating outer and inner radii, counter-clockwise.
inline std::vector<DorVector3> Star(int tips, double outer, double inner)
{
    std::vector<DorVector3> points;
    for (int k = 0; k < 2 * tips; ++k) {
        double r = k % 2 ? inner : outer, a = kPi * k / tips;
        points.push_back(DorVector3(r * std::cos(a), r * std::sin(a), 0));
    }
    return points;
}

// A 2 x 2 square without its upper right unit square.
inline std::vector<DorVector3> LShape()
{
    return {DorVector3(0, 0, 0), DorVector3(2, 0, 0), DorVector3(2, 1, 0),
            DorVector3(1, 1, 0), DorVector3(1, 2, 0), DorVector3(0, 2, 0)};
}

inline CDorPolygon Polygon(const std::vector<DorVector3>& points)
{
    return CDorPolygon(points.data(), static_cast<int>(points.size()));
}

}  // namespace convert_test
