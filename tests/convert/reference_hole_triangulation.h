#pragma once
// A deliberately plain transcription of the triangulation with holes, step by step as the rules
// read, without the production routine's shortcuts (it tests every pair, in order, against the
// whole table). Only for differential tests.
#include <cmath>
#include <vector>

#include "convert/dor_shape.h"
#include "model/dor_math.h"
#include "reference_edge_list.h"

namespace reference {

inline std::vector<int> TriangulateHoles(const CDorHolePolygon& shape)
{
    const double pi = 3.14159265358979323846;
    std::vector<DorVector3> P;
    std::vector<int> startFlag, loopNo;
    std::vector<const CDorArray<DorVector3, DorVector3&>*> loops = {&shape.points};
    for (int h = 0; h < shape.holes.GetSize(); ++h)
        loops.push_back(&shape.holes[h].points);
    for (size_t l = 0; l < loops.size(); ++l) {
        for (int k = 0; k < loops[l]->GetSize(); ++k) {
            P.push_back((*loops[l])[k]);
            startFlag.push_back(k == 0 ? 0 : 1);
            loopNo.push_back(static_cast<int>(l));
        }
    }
    const int N = static_cast<int>(P.size()), n0 = shape.points.GetSize();
    startFlag.push_back(0);

    double nx = 0, ny = 0, nz = 0;
    for (int i = 0; i < n0; ++i) {
        const DorVector3 &a = P[i], &b = P[(i + 1) % n0];
        nx += (a.y - b.y) * (a.z + b.z);
        ny += (a.z - b.z) * (a.x + b.x);
        nz += (a.x - b.x) * (a.y + b.y);
    }
    double len = std::sqrt(nx * nx + ny * ny + nz * nz);
    if (!(len >= 0.0001))
        return {};
    DorMatrix4x4 M = DorPlaneProjection(DorVector3(nx / len, ny / len, nz / len), P[0]);
    std::vector<double> X(N), Y(N);
    for (int k = 0; k < N; ++k) {
        DorVector3 q = DorTransformPoint(P[k], M);
        X[k] = q.x;
        Y[k] = q.y;
    }

    EdgeList edges{X, Y, {}, {}, {}};
    for (int k = 0; k < N; ++k) {
        int first = k;
        while (startFlag[first] != 0)
            --first;
        edges.Add(k, startFlag[k + 1] == 1 ? k + 1 : first);
    }

    // Winding sum about (qx, qy) over the loop [first, first + count); sets onEdge.
    auto winding = [&](double qx, double qy, int first, int count, bool& onEdge) {
        double sum = 0;
        onEdge = false;
        for (int k = 0; k < count; ++k) {
            int a = first + k, b = first + (k + 1) % count;
            double ux = X[a] - qx, uy = Y[a] - qy, vx = X[b] - qx, vy = Y[b] - qy;
            double cr = ux * vy - uy * vx, dt = ux * vx + uy * vy;
            if (!(cr == 0 && dt == 0))
                sum += std::atan2(cr, dt);
            double ul = std::sqrt(ux * ux + uy * uy), vl = std::sqrt(vx * vx + vy * vy);
            if (ul >= 0.0001) {
                ux /= ul;
                uy /= ul;
            }
            if (vl >= 0.0001) {
                vx /= vl;
                vy /= vl;
            }
            double nd = ux * vx + uy * vy;
            if (std::fabs(cr) < 0.0001 && nd > -1.0001 && nd < -0.0009)
                onEdge = true;
        }
        return sum;
    };

    for (int i = 0; i < N; ++i) {
        int j0 = (i + 1 < N && startFlag[i + 1] == 1) ? i + 2 : i + 1;
        for (int j = j0; j < N; ++j) {
            if (startFlag[i] == 0 && startFlag[j + 1] == 0 && loopNo[i] == loopNo[j])
                continue;
            bool ok = !edges.Crosses(i, j);
            double qx = (X[i] + X[j]) * 0.5, qy = (Y[i] + Y[j]) * 0.5;
            bool onEdge = false;
            double sum = winding(qx, qy, 0, n0, onEdge);
            if (!onEdge && !(std::fabs(sum) > pi))
                ok = false;
            for (int first = n0, h = 0; h < shape.holes.GetSize(); first += shape.holes[h].points.GetSize(), ++h) {
                sum = winding(qx, qy, first, shape.holes[h].points.GetSize(), onEdge);
                if (!onEdge && std::fabs(sum) > pi)
                    ok = false;
            }
            if (ok && !edges.ThroughPoint(i, j, N) && static_cast<int>(edges.S.size()) + 2 <= N + 100)
                edges.Add(i, j);
        }
    }
    return edges.Distinct(edges.CloseTriangles(N, true), true);
}

}  // namespace reference
