#pragma once
// The steps that the plain transcriptions of both triangulations share, written out as the rules
// read: the crossing and point-on-segment tests of a candidate, the closing of triangles on the
// added edges, and the removal of repeats. Only for differential tests.
#include <cmath>
#include <vector>

namespace reference {

struct EdgeList {
    const std::vector<double>& X;
    const std::vector<double>& Y;
    std::vector<int> S, E, F;  // start, end, side bits

    void Add(int s, int e)
    {
        S.push_back(s);
        E.push_back(e);
        F.push_back(0);
    }

    // Crosses a listed edge with no end equal to i or j, strictly inside both.
    bool Crosses(int i, int j) const
    {
        double dx = X[j] - X[i], dy = Y[j] - Y[i];
        for (size_t c = 0; c < S.size(); ++c) {
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
                return true;
        }
        return false;
    }

    // A point k < count other than i and j lies on segment i-j.
    bool ThroughPoint(int i, int j, int count) const
    {
        double dx = X[j] - X[i], dy = Y[j] - Y[i], dd = dx * dx + dy * dy;
        for (int k = 0; k < count && dd != 0; ++k) {
            if (k == i || k == j)
                continue;
            double t = ((X[k] - X[i]) * dx + (Y[k] - Y[i]) * dy) / dd;
            double fx = X[i] + t * dx - X[k], fy = Y[i] + t * dy - Y[k];
            if (std::fabs(t) >= 1e-6 && std::fabs(1 - t) >= 1e-6 && t > 0 && t < 1 && std::sqrt(fx * fx + fy * fy) < 1e-6)
                return true;
        }
        return false;
    }

    int Find(int p, int q) const
    {
        for (size_t c = 0; c < S.size(); ++c)
            if ((S[c] == p && E[c] == q) || (S[c] == q && E[c] == p))
                return static_cast<int>(c);
        return -1;
    }

    // Bit 1 when the triangle lies right of start->end, bit 2 when left.
    void Mark(int c, int ta, int tb, int tc)
    {
        double cr = (X[E[c]] - X[S[c]]) * (Y[ta] + Y[tb] + Y[tc] - 3 * Y[S[c]]) -
                    (Y[E[c]] - Y[S[c]]) * (X[ta] + X[tb] + X[tc] - 3 * X[S[c]]);
        F[c] |= cr < 0 ? 1 : 2;
    }

    // Candidate triangles from the edges at positions first and up; with finishEarly, a right
    // side that has a neighbour but lacks a closing edge ends the edge.
    std::vector<int> CloseTriangles(size_t first, bool finishEarly)
    {
        std::vector<int> cand;
        for (size_t c = first; c < S.size(); ++c) {
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
                    if (((side == 1 && cr < 0) || (side == 2 && cr > 0)) && ux * vx + uy * vy > best) {
                        best = ux * vx + uy * vy;
                        x = o;
                    }
                }
                if (x < 0)
                    continue;
                int a = side == 1 ? e : s, b = side == 1 ? s : e;
                int xe = Find(x, e), xs = Find(x, s);
                if (xe >= 0)
                    Mark(xe, a, b, x);
                if (xs >= 0)
                    Mark(xs, a, b, x);
                if (xe >= 0 && xs >= 0) {
                    F[c] |= side;
                    cand.insert(cand.end(), {a, b, x});
                } else if (side == 1 && finishEarly) {
                    break;
                }
            }
        }
        return cand;
    }

    // The candidates without repeats (equal up to rotation) and, with dropSlivers, without
    // triangles whose root of twice the area is at most 1e-5.
    std::vector<int> Distinct(const std::vector<int>& cand, bool dropSlivers) const
    {
        std::vector<int> out;
        for (size_t t = 0; t < cand.size(); t += 3) {
            int a = cand[t], b = cand[t + 1], c = cand[t + 2];
            bool repeat = false;
            for (size_t o = 0; o < out.size(); o += 3)
                if ((out[o] == a && out[o + 1] == b && out[o + 2] == c) ||
                    (out[o] == b && out[o + 1] == c && out[o + 2] == a) || (out[o] == c && out[o + 1] == a && out[o + 2] == b))
                    repeat = true;
            double twice = (X[b] - X[a]) * (Y[c] - Y[a]) - (Y[b] - Y[a]) * (X[c] - X[a]);
            if (!repeat && !(dropSlivers && std::sqrt(std::fabs(twice)) <= 1e-5))
                out.insert(out.end(), {a, b, c});
        }
        return out;
    }
};

}  // namespace reference
