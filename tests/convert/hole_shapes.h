#pragma once
// Holed outlines for the holed converter tests and benchmarks.
#include <utility>
#include <vector>

#include "convert/dor_shape.h"

namespace hole_test {

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

}  // namespace hole_test
