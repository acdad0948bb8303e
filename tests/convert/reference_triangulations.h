#pragma once
// Deliberately plain transcriptions of both triangulations, step by step as the rules read and
// without the production shortcuts: every candidate pair is tested, in order, against the whole
// edge list. Only for differential tests.
#include <cmath>
#include <vector>

#include "convert/dor_shape.h"
#include "model/dor_math.h"

namespace reference {

const double kPi = 3.14159265358979323846;

struct EdgeList {
    std::vector<double> X, Y;
    std::vector<int> S, E, F;  // start, end, side bits: 1 right of start->end made, 2 left

    // Projects P into the plane of the Newell normal of its first n0 points; false without one.
    bool Project(const std::vector<DorVector3>& P, int n0)
    {
        DorVector3 N = DorNewellNormal(P.data(), n0);
        double L = std::sqrt(N.x * N.x + N.y * N.y + N.z * N.z);
        if (!(L >= 0.0001))
            return false;
        DorMatrix4x4 M = DorPlaneProjection(DorVector3(N.x / L, N.y / L, N.z / L), P[0]);
        for (const DorVector3& p : P) {
            X.push_back(DorTransformPoint(p, M).x);
            Y.push_back(DorTransformPoint(p, M).y);
        }
        return true;
    }
    void Add(int s, int e) { S.push_back(s), E.push_back(e), F.push_back(0); }

    // Winding angle about (qx, qy) of the loop [first, first + count); onEdge when q lies
    // (loosely) inside one of its edges.
    double Winding(double qx, double qy, int first, int count, bool& onEdge) const
    {
        double sum = 0;
        onEdge = false;
        for (int k = 0; k < count; ++k) {
            int a = first + k, b = first + (k + 1) % count;
            double ux = X[a] - qx, uy = Y[a] - qy, vx = X[b] - qx, vy = Y[b] - qy;
            double cr = ux * vy - uy * vx, dt = ux * vx + uy * vy;
            if (!(cr == 0 && dt == 0))
                sum += std::atan2(cr, dt);
            double ul = std::sqrt(ux * ux + uy * uy), vl = std::sqrt(vx * vx + vy * vy);
            double nd = (ul >= 0.0001 ? ux / ul : ux) * (vl >= 0.0001 ? vx / vl : vx) +
                        (ul >= 0.0001 ? uy / ul : uy) * (vl >= 0.0001 ? vy / vl : vy);
            if (std::fabs(cr) < 0.0001 && nd > -1.0001 && nd < -0.0009)
                onEdge = true;
        }
        return sum;
    }

    // Crosses a listed edge with no end equal to i or j, strictly inside both.
    bool Crosses(int i, int j) const
    {
        double dx = X[j] - X[i], dy = Y[j] - Y[i];
        for (size_t c = 0; c < S.size(); ++c) {
            int a = S[c], b = E[c];
            double ex = X[b] - X[a], ey = Y[b] - Y[a], det = ex * dy - ey * dx, wx = X[a] - X[i], wy = Y[a] - Y[i];
            if (a == i || a == j || b == i || b == j || det == 0.0)
                continue;
            double s = (ex * wy - ey * wx) / det, t = (dx * wy - dy * wx) / det;
            if (s > 0 && s < 1 && t > 0 && t < 1)
                return true;
        }
        return false;
    }

    // A point other than i and j lies on segment i-j.
    bool ThroughPoint(int i, int j) const
    {
        double dx = X[j] - X[i], dy = Y[j] - Y[i], dd = dx * dx + dy * dy;
        for (int k = 0; k < static_cast<int>(X.size()) && dd != 0; ++k) {
            double t = ((X[k] - X[i]) * dx + (Y[k] - Y[i]) * dy) / dd;
            double fx = X[i] + t * dx - X[k], fy = Y[i] + t * dy - Y[k];
            if (k != i && k != j && std::fabs(t) >= 1e-6 && std::fabs(1 - t) >= 1e-6 && t > 0 && t < 1 &&
                std::sqrt(fx * fx + fy * fy) < 1e-6)
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
    void Mark(int c, int ta, int tb, int tc)
    {
        double cr = (X[E[c]] - X[S[c]]) * (Y[ta] + Y[tb] + Y[tc] - 3 * Y[S[c]]) -
                    (Y[E[c]] - Y[S[c]]) * (X[ta] + X[tb] + X[tc] - 3 * X[S[c]]);
        F[c] |= cr < 0 ? 1 : 2;
    }

    // Candidate triangles on the edges from position first; with finishEarly, a right side that
    // has a neighbour but lacks a closing edge ends the edge.
    std::vector<int> CloseTriangles(size_t first, bool finishEarly)
    {
        std::vector<int> cand;
        for (size_t c = first; c < S.size(); ++c) {
            int s = S[c], e = E[c];
            double ux = X[e] - X[s], uy = Y[e] - Y[s], ul = std::sqrt(ux * ux + uy * uy);
            ux /= ul >= 0.0001 ? ul : 1;
            uy /= ul >= 0.0001 ? ul : 1;
            for (int side = 1; side <= 2 && F[c] != 3; ++side) {
                double best = -1024.0;
                int x = -1;
                for (size_t k = 0; k < S.size() && !(F[c] & side); ++k) {
                    if (k == c || (S[k] != s && E[k] != s))
                        continue;
                    int o = S[k] == s ? E[k] : S[k];
                    double vx = X[o] - X[s], vy = Y[o] - Y[s], vl = std::sqrt(vx * vx + vy * vy);
                    vx /= vl >= 0.0001 ? vl : 1;
                    vy /= vl >= 0.0001 ? vl : 1;
                    double cr = ux * vy - uy * vx;
                    if (((side == 1 && cr < 0) || (side == 2 && cr > 0)) && ux * vx + uy * vy > best)
                        best = ux * vx + uy * vy, x = o;
                }
                if (x < 0)
                    continue;
                int a = side == 1 ? e : s, b = side == 1 ? s : e, xe = Find(x, e), xs = Find(x, s);
                if (xe >= 0)
                    Mark(xe, a, b, x);
                if (xs >= 0)
                    Mark(xs, a, b, x);
                if (xe >= 0 && xs >= 0)
                    F[c] |= side, cand.insert(cand.end(), {a, b, x});
                else if (side == 1 && finishEarly)
                    break;
            }
        }
        return cand;
    }

    // Without repeats (equal up to rotation) and, with dropSlivers, without triangles whose root
    // of twice the area is at most 1e-5.
    std::vector<int> Distinct(const std::vector<int>& cand, bool dropSlivers) const
    {
        std::vector<int> out;
        for (size_t t = 0; t < cand.size(); t += 3) {
            int a = cand[t], b = cand[t + 1], c = cand[t + 2];
            bool repeat = false;
            for (size_t o = 0; o < out.size(); o += 3)
                for (int r = 0; r < 3; ++r)
                    repeat = repeat || (out[o + r] == a && out[o + (r + 1) % 3] == b && out[o + (r + 2) % 3] == c);
            double twice = (X[b] - X[a]) * (Y[c] - Y[a]) - (Y[b] - Y[a]) * (X[c] - X[a]);
            if (!repeat && !(dropSlivers && std::sqrt(std::fabs(twice)) <= 1e-5))
                out.insert(out.end(), {a, b, c});
        }
        return out;
    }
};

// Every ordered pair whose midpoint is inside the outline, while the list has room for 100.
inline std::vector<int> Triangulate(const CDorPolygon& polygon)
{
    const int n = polygon.points.GetSize();
    EdgeList edges;
    bool onEdge;
    if (!edges.Project(std::vector<DorVector3>(polygon.points.GetData(), polygon.points.GetData() + n), n))
        return {};
    for (int i = 0; i < n; ++i)
        edges.Add(i, (i + 1) % n);
    for (int i = 0; i < n; ++i)
        for (int j = 0; j < n; ++j)
            if (!edges.Crosses(i, j) &&
                std::fabs(edges.Winding((edges.X[i] + edges.X[j]) * 0.5, (edges.Y[i] + edges.Y[j]) * 0.5, 0, n, onEdge)) > kPi &&
                !edges.ThroughPoint(i, j) && static_cast<int>(edges.S.size()) < n + 100)
                edges.Add(i, j);
    return edges.Distinct(edges.CloseTriangles(n, false), false);
}

// Unordered pairs, neither a loop edge nor a loop's closing pair, whose midpoint is in the
// outline (its edge counting as in) and in no hole (its edge counting as out), while two of
// the N + 100 slots stay free.
inline std::vector<int> TriangulateHoles(const CDorHolePolygon& shape)
{
    std::vector<DorVector3> P;
    std::vector<int> first, count;  // per point: its loop's first point and size
    std::vector<const CDorArray<DorVector3, DorVector3&>*> loops = {&shape.points};
    for (int h = 0; h < shape.holes.GetSize(); ++h)
        loops.push_back(&shape.holes[h].points);
    for (const CDorArray<DorVector3, DorVector3&>* loop : loops) {
        int at = static_cast<int>(P.size());
        for (int k = 0; k < loop->GetSize(); ++k)
            P.push_back((*loop)[k]), first.push_back(at), count.push_back(loop->GetSize());
    }
    const int N = static_cast<int>(P.size()), n0 = shape.points.GetSize();
    EdgeList edges;
    if (!edges.Project(P, n0))
        return {};
    for (int k = 0; k < N; ++k)
        edges.Add(k, k + 1 < first[k] + count[k] ? k + 1 : first[k]);
    for (int i = 0; i < N; ++i) {
        for (int j = i + 1 < first[i] + count[i] ? i + 2 : i + 1; j < N; ++j) {
            if (i == first[i] && j == first[i] + count[i] - 1)
                continue;
            double qx = (edges.X[i] + edges.X[j]) * 0.5, qy = (edges.Y[i] + edges.Y[j]) * 0.5;
            bool onEdge, ok = !edges.Crosses(i, j) && (std::fabs(edges.Winding(qx, qy, 0, n0, onEdge)) > kPi || onEdge);
            for (int h = n0; h < N; h += count[h])
                ok = ok && !(std::fabs(edges.Winding(qx, qy, h, count[h], onEdge)) > kPi && !onEdge);
            if (ok && !edges.ThroughPoint(i, j) && static_cast<int>(edges.S.size()) + 2 <= N + 100)
                edges.Add(i, j);
        }
    }
    return edges.Distinct(edges.CloseTriangles(N, true), true);
}

}  // namespace reference
