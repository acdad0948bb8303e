#pragma once
// A deliberately plain transcription of the polygon triangulation, step by step as the rules
// read, without the production routine's shortcuts (it tests every candidate, in list order).
// Only for differential tests.
#include <cmath>
#include <vector>

#include "convert/dor_shape.h"
#include "model/dor_math.h"
#include "reference_edge_list.h"

namespace reference {

inline std::vector<int> Triangulate(const CDorPolygon& polygon, bool& hasNormal)
{
    const double pi = 3.14159265358979323846;
    const int n = polygon.points.GetSize();
    std::vector<int> out;
    DorVector3 N = DorNewellNormal(polygon.points.GetData(), n);
    double L = std::sqrt(N.x * N.x + N.y * N.y + N.z * N.z);
    hasNormal = L >= 0.0001;
    if (!hasNormal)
        return out;
    N = DorVector3(N.x / L, N.y / L, N.z / L);
    DorMatrix4x4 M = DorPlaneProjection(N, polygon.points[0]);
    std::vector<double> X(n + 1), Y(n + 1);
    for (int k = 0; k < n; ++k) {
        DorVector3 p = DorTransformPoint(polygon.points[k], M);
        X[k] = p.x;
        Y[k] = p.y;
    }
    X[n] = X[0];
    Y[n] = Y[0];

    EdgeList edges{X, Y, {}, {}, {}};
    for (int i = 0; i < n; ++i)
        edges.Add(i, (i + 1) % n);
    for (int i = 0; i < n; ++i) {
        for (int j = 0; j < n; ++j) {
            bool ok = !edges.Crosses(i, j);
            double qx = (X[i] + X[j]) * 0.5, qy = (Y[i] + Y[j]) * 0.5, sum = 0;
            for (int k = 0; k < n; ++k) {
                double ux = X[k] - qx, uy = Y[k] - qy, vx = X[k + 1] - qx, vy = Y[k + 1] - qy;
                double cr = ux * vy - uy * vx, dt = ux * vx + uy * vy;
                if (!(cr == 0 && dt == 0))
                    sum += std::atan2(cr, dt);
            }
            if (!(std::fabs(sum) > pi))
                ok = false;
            if (ok && !edges.ThroughPoint(i, j, n) && static_cast<int>(edges.S.size()) < n + 100)
                edges.Add(i, j);
        }
    }
    return edges.Distinct(edges.CloseTriangles(n, false), false);
}

}  // namespace reference
