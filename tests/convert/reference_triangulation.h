#pragma once
// A deliberately plain transcription of the polygon triangulation, step by step as the rules
// read, without the production routine's shortcuts (it tests every candidate, in list order).
// Only for differential tests.
#include <cmath>
#include <vector>

#include "convert/dor_shape.h"
#include "model/dor_math.h"

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

    std::vector<int> S, E, F;
    for (int i = 0; i < n; ++i) {
        S.push_back(i);
        E.push_back((i + 1) % n);
        F.push_back(0);
    }
    for (int i = 0; i < n; ++i) {
        for (int j = 0; j < n; ++j) {
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
            double qx = (X[i] + X[j]) * 0.5, qy = (Y[i] + Y[j]) * 0.5, sum = 0;
            for (int k = 0; k < n; ++k) {
                double ux = X[k] - qx, uy = Y[k] - qy, vx = X[k + 1] - qx, vy = Y[k + 1] - qy;
                double cr = ux * vy - uy * vx, dt = ux * vx + uy * vy;
                if (!(cr == 0 && dt == 0))
                    sum += std::atan2(cr, dt);
            }
            if (!(std::fabs(sum) > pi))
                ok = false;
            double dd = dx * dx + dy * dy;
            for (int k = 0; k < n && ok && dd != 0; ++k) {
                if (k == i || k == j)
                    continue;
                double t = ((X[k] - X[i]) * dx + (Y[k] - Y[i]) * dy) / dd;
                double fx = X[i] + t * dx - X[k], fy = Y[i] + t * dy - Y[k];
                if (std::fabs(t) >= 1e-6 && std::fabs(1 - t) >= 1e-6 && t > 0 && t < 1 && std::sqrt(fx * fx + fy * fy) < 1e-6)
                    ok = false;
            }
            if (ok && static_cast<int>(S.size()) < n + 100) {
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
    // Bit 1 when the triangle lies right of start->end, bit 2 when left.
    auto mark = [&](int c, int tx, int ty, int tz) {
        double cr = (X[E[c]] - X[S[c]]) * (Y[ty] + Y[tz] + Y[tx] - 3 * Y[S[c]]) -
                    (Y[E[c]] - Y[S[c]]) * (X[ty] + X[tz] + X[tx] - 3 * X[S[c]]);
        F[c] |= cr < 0 ? 1 : 2;
    };
    for (size_t c = n; c < S.size(); ++c) {
        if (F[c] == 3)
            continue;
        int s = S[c], e = E[c];
        double ux = X[e] - X[s], uy = Y[e] - Y[s], ul = std::sqrt(ux * ux + uy * uy);
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
                if ((side == 1 && cr < 0) || (side == 2 && cr > 0)) {
                    if (ux * vx + uy * vy > best) {
                        best = ux * vx + uy * vy;
                        x = o;
                    }
                }
            }
            if (x < 0)
                continue;
            int a = side == 1 ? e : s, b = side == 1 ? s : e;
            int xe = find(x, e), xs = find(x, s);
            if (xe >= 0)
                mark(xe, a, b, x);
            if (xs >= 0)
                mark(xs, a, b, x);
            if (xe >= 0 && xs >= 0) {
                F[c] |= side;
                cand.insert(cand.end(), {a, b, x});
            }
        }
    }

    for (size_t t = 0; t < cand.size(); t += 3) {
        int a = cand[t], b = cand[t + 1], c = cand[t + 2];
        bool repeat = false;
        for (size_t o = 0; o < out.size(); o += 3)
            if ((out[o] == a && out[o + 1] == b && out[o + 2] == c) || (out[o] == b && out[o + 1] == c && out[o + 2] == a) ||
                (out[o] == c && out[o + 1] == a && out[o + 2] == b))
                repeat = true;
        if (!repeat)
            out.insert(out.end(), {a, b, c});
    }
    return out;
}

}  // namespace reference
