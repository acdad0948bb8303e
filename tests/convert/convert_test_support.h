#pragma once
// Outlines shared by the converter tests and the conversion benchmarks.
#include <cmath>
#include <vector>

#include "convert/dor_shape.h"
#include "model/dor_math.h"

namespace convert_test {

const double kPi = 3.14159265358979323846;

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
