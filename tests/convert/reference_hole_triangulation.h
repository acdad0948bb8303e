#pragma once
// A deliberately plain transcription of the triangulation with holes, step by step as the rules
// read, with none of the production routine's shortcuts or shared pieces (it tests every pair,
// in order, against the whole table). Only for differential tests.
#include <cmath>
#include <vector>

#include "convert/dor_shape.h"
#include "model/dor_math.h"

namespace reference {

inline std::vector<int> TriangulateHoles(const CDorHolePolygon& shape)
{
    const double pi = 3.14159265358979323846;
    std::vector<int> out;
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
        return out;
    DorMatrix4x4 M = DorPlaneProjection(DorVector3(nx / len, ny / len, nz / len), P[0]);
    std::vector<double> X(N), Y(N);
    for (int k = 0; k < N; ++k) {
        DorVector3 q = DorTransformPoint(P[k], M);
        X[k] = q.x;
        Y[k] = q.y;
    }

    std::vector<int> S, E, F;
    for (int k = 0; k < N; ++k) {
        int first = k;
        while (startFlag[first] != 0)
            --first;
        S.push_back(k);
        E.push_back(startFlag[k + 1] == 1 ? k + 1 : first);
        F.push_back(0);
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
            double dx = X[j] - X[i], dy = Y[j] - Y[i];
            bool ok = true;
            for (size_t c = 0; c < S.size() && ok; ++c) {
                int a = S[c], b = E[c];
                if (a == i || a == j || b == i || b == j)
                    continue;
                double ex = X[b] - X[a], ey = Y[b] - Y[a];
                double det = ex * dy - ey * dx;
                if (det == 0.0)
                    continue;
                double wx = X[a] - X[i], wy = Y[a] - Y[i];
                double s = (ex * wy - ey * wx) / det, t = (dx * wy - dy * wx) / det;
                if (s > 0 && s < 1 && t > 0 && t < 1)
                    ok = false;
            }
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
            double dd = dx * dx + dy * dy;
            for (int k = 0; k < N && ok; ++k) {
                if (k == i || k == j)
                    continue;
                double t = ((X[k] - X[i]) * dx + (Y[k] - Y[i]) * dy) / dd;
                double fx = X[i] + t * dx - X[k], fy = Y[i] + t * dy - Y[k];
                if (std::fabs(t) >= 1e-6 && std::fabs(1 - t) >= 1e-6 && t > 0 && t < 1 && std::sqrt(fx * fx + fy * fy) < 1e-6)
                    ok = false;
            }
            if (ok && static_cast<int>(S.size()) + 2 <= N + 100) {
                S.push_back(i);
                E.push_back(j);
                F.push_back(0);
            }
        }
    }

    std::vector<int> cand;
    auto find = [&](int p, int q) {
        for (size_t c = 0; c < S.size(); ++c)
            if ((S[c] == p && E[c] == q) || (S[c] == q && E[c] == p))
                return static_cast<int>(c);
        return -1;
    };
    // Bit 1 when the triangle's centroid lies right of start->end, bit 2 when left.
    auto mark = [&](int c, int ta, int tb, int tc) {
        double cr = (X[E[c]] - X[S[c]]) * (Y[ta] + Y[tb] + Y[tc] - 3 * Y[S[c]]) -
                    (Y[E[c]] - Y[S[c]]) * (X[ta] + X[tb] + X[tc] - 3 * X[S[c]]);
        F[c] |= cr < 0 ? 1 : 2;
    };
    for (size_t c = N; c < S.size(); ++c) {
        if (F[c] == 3)
            continue;
        int s = S[c], t = E[c];
        double ux = X[t] - X[s], uy = Y[t] - Y[s], ul = std::sqrt(ux * ux + uy * uy);
        if (ul >= 0.0001) {
            ux /= ul;
            uy /= ul;
        }
        for (int side = 1; side <= 2; ++side) {
            if (F[c] & side)
                continue;
            double best = -1024.0;
            int x = -1;
            for (size_t k = 0; k < S.size(); ++k) {
                if (k == c || (S[k] != s && E[k] != s))
                    continue;
                int o = S[k] == s ? E[k] : S[k];
                double vx = X[o] - X[s], vy = Y[o] - Y[s], vl = std::sqrt(vx * vx + vy * vy);
                if (vl >= 0.0001) {
                    vx /= vl;
                    vy /= vl;
                }
                double cr = ux * vy - uy * vx;
                if (((side == 1 && cr < 0) || (side == 2 && cr > 0)) && ux * vx + uy * vy > best) {
                    best = ux * vx + uy * vy;
                    x = o;
                }
            }
            if (x < 0)
                continue;
            int a = side == 1 ? t : s, b = side == 1 ? s : t;
            int xt = find(x, t), xs = find(x, s);
            if (xt >= 0)
                mark(xt, a, b, x);
            if (xs >= 0)
                mark(xs, a, b, x);
            if (xt < 0 || xs < 0) {
                if (side == 1)
                    break;  // side 1 finishes the edge early
                continue;
            }
            F[c] |= side;
            cand.insert(cand.end(), {a, b, x});
        }
    }

    for (size_t k = 0; k < cand.size(); k += 3) {
        int p = cand[k], q = cand[k + 1], r = cand[k + 2];
        bool repeat = false;
        for (size_t o = 0; o < out.size(); o += 3)
            if ((out[o] == p && out[o + 1] == q && out[o + 2] == r) || (out[o] == q && out[o + 1] == r && out[o + 2] == p) ||
                (out[o] == r && out[o + 1] == p && out[o + 2] == q))
                repeat = true;
        double area = (X[q] - X[p]) * (Y[r] - Y[p]) - (Y[q] - Y[p]) * (X[r] - X[p]);
        if (!repeat && !(std::sqrt(std::fabs(area)) <= 1e-5))
            out.insert(out.end(), {p, q, r});
    }
    return out;
}

}  // namespace reference
