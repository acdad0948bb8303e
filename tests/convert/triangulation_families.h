#pragma once
// Outline families of n points shared by the triangulation corpus test and the speed benchmark
// against the GLU tessellator. All lie in z = 0 and run counter-clockwise unless told.
#include <vector>

#include "convert_test_support.h"

namespace families {

typedef std::vector<DorVector3> Loop;

// n / 4 teeth of width 1, gaps of 1, on a base of height 1.
inline Loop Comb(int n)
{
    const int teeth = n / 4;
    Loop points = {DorVector3(0, 0, 0), DorVector3(2 * teeth - 1, 0, 0)};
    for (int k = teeth - 1; k >= 0; --k) {
        points.insert(points.end(), {DorVector3(2 * k + 1, 5, 0), DorVector3(2 * k, 5, 0)});
        if (k > 0)
            points.insert(points.end(), {DorVector3(2 * k, 1, 0), DorVector3(2 * k - 1, 1, 0)});
    }
    return points;
}

// The points of a closed polyline spread over its sides, every corner kept: a wall outline with
// door and window jambs on it, so long collinear runs.
inline Loop Subdivided(const Loop& corners, int n)
{
    Loop points;
    const int sides = static_cast<int>(corners.size());
    for (int s = 0; s < sides; ++s) {
        const DorVector3 &a = corners[s], &b = corners[(s + 1) % sides];
        const int parts = n * (s + 1) / sides - n * s / sides;
        for (int k = 0; k < parts; ++k)
            points.push_back(a + (b - a) * (static_cast<double>(k) / parts));
    }
    return points;
}

// A 12 x 10 L-shaped floor plan.
inline Loop LPlan(int n)
{
    return Subdivided({DorVector3(0, 0, 0), DorVector3(12, 0, 0), DorVector3(12, 4, 0), DorVector3(5, 4, 0),
                       DorVector3(5, 10, 0), DorVector3(0, 10, 0)},
                      n);
}

inline Loop SubdividedSquare(int n) { return Subdivided(convert_test::Square(0, 0, 100), n); }

// Every point joined to the one `step` places on round a circle: each edge crosses 2 (step - 1)
// others.
inline Loop CrossingStar(int n, int step)
{
    Loop points;
    for (int k = 0; k < n; ++k) {
        double a = 2 * convert_test::kPi * (static_cast<double>(k) * step / n);
        points.push_back(DorVector3(100 * std::cos(a), 100 * std::sin(a), 0));
    }
    return points;
}

}  // namespace families
