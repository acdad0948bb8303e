#include "convert/vel_plane2d.h"

#include <cmath>

namespace {
const double kPi = 3.14159265358979323846;

double EdgeAngle(const DorVector2& q, const DorVector2& a, const DorVector2& b)
{
    DorVector2 u = VelSub2(a, q), v = VelSub2(b, q);
    double cross = VelCross2(u, v), dot = VelDot2(u, v);
    if (cross == 0.0 && dot == 0.0)
        return 0.0;
    return std::atan2(cross, dot);
}
}  // namespace

void VelNormalize2(DorVector2& v)
{
    double length = std::sqrt(v.x * v.x + v.y * v.y);
    if (length >= 0.0001) {
        v.x /= length;
        v.y /= length;
    }
}

double VelWindingAngle(const DorVector2& q, const DorVector2* loop, int count)
{
    double sum = 0.0;
    for (int k = 0; k < count; ++k)
        sum += EdgeAngle(q, loop[k], loop[k + 1 < count ? k + 1 : 0]);
    return sum;
}

bool VelWindingInside(double angleSum) { return std::fabs(angleSum) > kPi; }

namespace {
enum Verdict { kOutside, kInside, kUnsure };

// Where every edge's term is clear of atan2's cut at +-pi, each computed term is within 1e-14 of
// the exact angle between the same rounded vectors u = P - q, and the exact angles add up to 2 pi
// times the winding number of the u loop about 0 (a repeated point's term is exactly 0, and clear).
// The sum's rounding stays below n^2 * 2e-16, so
// |sum| > pi exactly when that number, counted by signed crossings of the ray y = 0, x > 0, is not
// 0. A term is clear when its cross product is far above its rounding (then its sign is exact) or
// its dot product is positive and the edge does not meet the ray's line. With q on one vertex the
// two terms at it drop out; the rest of the loop, closed by the chord between the neighbours,
// winds about 0, and the chord's own angle must then keep off +-pi by more than the rounding.
// NaN, infinity and extreme magnitudes are never clear.
struct Term {
    double cross, dot, size;
    Term(const DorVector2& u, const DorVector2& v)
        : cross(VelCross2(u, v)), dot(VelDot2(u, v)),
          size((std::fabs(u.x) + std::fabs(u.y)) * (std::fabs(v.x) + std::fabs(v.y)))
    {
    }
    bool InRange() const { return size > 1e-250 && size < 1e250; }
};

const double kClear = 1e-12;

bool IsZero(const DorVector2& u) { return u.x == 0.0 && u.y == 0.0; }

// The signed crossing of the ray by u->v, or kUnsure.
int RayCrossing(const DorVector2& u, const DorVector2& v, double margin)
{
    Term term(u, v);
    if (!term.InRange())
        return kUnsure;
    if (!(std::fabs(term.cross) > margin * term.size)) {
        bool meetsLine = (u.y <= 0.0) != (v.y <= 0.0);
        return term.dot > kClear * term.size && !meetsLine ? 0 : kUnsure;
    }
    if (u.y <= 0.0 && v.y > 0.0)
        return term.cross > 0.0 ? 1 : 0;
    if (v.y <= 0.0 && u.y > 0.0)
        return term.cross < 0.0 ? -1 : 0;
    return 0;
}

// The vectors from q to the loop's points, seen a quarter turn round when turned: the ray of the
// count then runs along +y. Exact, and every cross product, dot product and size is the same.
DorVector2 Seen(const DorVector2& p, const DorVector2& q, bool turned)
{
    DorVector2 u = VelSub2(p, q);
    return turned ? DorVector2(u.y, -u.x) : u;
}

// Whether u -> v is an edge with q on it: its term is near +-pi, where the computed atan2 may
// take either sign, and both vectors keep more than 45 degrees from the ray's line, on either
// side of it.
bool AcrossQ(const DorVector2& u, const DorVector2& v)
{
    Term term(u, v);
    return term.InRange() && term.dot < 0.0 && std::fabs(u.y) > std::fabs(u.x) && std::fabs(v.y) > std::fabs(v.x) &&
           (u.y > 0.0) != (v.y > 0.0);
}

const double kFar = 1e100, kNear = 1e-100;

// Whether the box and q are finite and within magnitudes where no term's products overflow or
// underflow.
bool InRange(const VelBox& box, const DorVector2& q)
{
    const double largest = std::max(std::max(std::fabs(box.minX), std::fabs(box.maxX)),
                                    std::max(std::fabs(box.minY), std::fabs(box.maxY)));
    return box.finite && largest < kFar && std::fabs(q.x) < kFar && std::fabs(q.y) < kFar;
}

// Whether seen vectors u and v, in range, lie both strictly above, below or behind the ray. Then
// the edge between them does not cross the ray, and they lie in one open half-plane, where the
// cross product's sign is exact or the angle is below pi / 2: its term is within a few ulps of
// the exact angle, whatever its size.
bool OneSide(const DorVector2& u, const DorVector2& v)
{
    return (u.y > kNear && v.y > kNear) || (u.y < -kNear && v.y < -kNear) || (u.x < -kNear && v.x < -kNear);
}

// Whether every point of the box, in range, lies strictly above, below or behind the ray, as
// seen: OneSide holds for every edge between two of them.
bool Settled(const VelBox& box, const DorVector2& q, bool turned)
{
    if (turned)  // seen x is y, seen y is -x
        return q.x - box.maxX > kNear || box.minX - q.x > kNear || q.y - box.maxY > kNear;
    return box.minY - q.y > kNear || q.y - box.maxY > kNear || q.x - box.maxX > kNear;
}

// The signed crossings of the ray, edge by edge, and the vertex and the edge with q on them.
// One edge m with q on it may be left out of the count: the rest of the loop runs from v_m round
// to u_m, so its exact angles add up to phi(u_m) - phi(v_m) + 2 pi C, C its signed crossings of
// the ray and phi measured from the ray in [0, 2 pi). With u_m and v_m nearly opposite and on
// either side of the ray's line, that difference is within 1e-11 of -pi when u_m is above the
// line, +pi otherwise; the term of m itself is computed as the angle sum computes it, within
// 1e-11 of +-pi. The sum is then within 1e-10 plus its rounding of 2 pi times an integer.
class RayCount {
public:
    RayCount(const DorVector2& q, const DorVector2* loop, int count, bool turned)
        : q(q), loop(loop), count(count), turned(turned)
    {
    }
    // Counts edge k, from u to v as seen; false once the verdict is unsure.
    bool Add(int k, const DorVector2& u, const DorVector2& v)
    {
        const int next = k + 1 < count ? k + 1 : 0;
        if (IsZero(u) || IsZero(v)) {
            int at = IsZero(u) ? k : next;
            if ((IsZero(u) && IsZero(v)) || (onVertex >= 0 && onVertex != at))
                return false;
            onVertex = at;
            return true;
        }
        int crossing = RayCrossing(u, v, kClear);
        if (crossing == kUnsure) {
            if (onEdge >= 0 || !AcrossQ(u, v))
                return false;
            onEdge = k;
            // Half a turn each way, as the term and the rest of the loop go round.
            bool termPositive = EdgeAngle(q, loop[k], loop[next]) > 0.0;
            winding += (termPositive ? 1 : -1) + (u.y > 0.0 ? -1 : 1);
            crossing = 0;
        }
        winding += crossing * 2;
        return true;
    }
    Verdict Finish() const
    {
        int total = winding;
        if (onVertex >= 0) {
            if (onEdge >= 0)
                return kUnsure;
            const double sumError = count * 1e-14 + static_cast<double>(count) * count * 2e-16;
            DorVector2 before = Seen(loop[onVertex > 0 ? onVertex - 1 : count - 1], q, turned);
            DorVector2 after = Seen(loop[onVertex + 1 < count ? onVertex + 1 : 0], q, turned);
            int crossing = RayCrossing(before, after, kClear + 8 * sumError);
            if (crossing == kUnsure)
                return kUnsure;
            total += crossing * 2;
        }
        return total != 0 ? kInside : kOutside;
    }

private:
    const DorVector2& q;
    const DorVector2* loop;
    int count;
    bool turned;
    int winding = 0, onVertex = -1, onEdge = -1;
};

bool CountableSize(int count) { return count >= 3 && count <= 1000000; }

Verdict WindingVerdict(const DorVector2& q, const DorVector2* loop, int count, bool turned, const VelRun* runs, int runCount)
{
    if (!CountableSize(count))
        return kUnsure;
    RayCount rays(q, loop, count, turned);
    for (int r = 0; r < (runs ? runCount : 1); ++r) {
        const int end = runs ? runs[r].end : count;
        const bool inRange = runs && InRange(runs[r].box, q);
        // A settled run's inner edges add nothing: only the one to the next run is left.
        int k = !runs ? 0 : inRange && Settled(runs[r].box, q, turned) ? end - 1 : runs[r].first;
        DorVector2 u = Seen(loop[k], q, turned);
        for (; k < end; ++k) {
            DorVector2 v = Seen(loop[k + 1 < count ? k + 1 : 0], q, turned);
            // Like a settled run's, an inner edge on one side adds nothing.
            if (!(inRange && k + 1 < end && OneSide(u, v)) && !rays.Add(k, u, v))
                return kUnsure;
            u = v;
        }
    }
    return rays.Finish();
}

// The count along the unturned ray over the edges of q's band alone: every other edge lies
// strictly above or below q, by more than kNear (Covers), so OneSide holds for it.
Verdict BandVerdict(const DorVector2& q, const DorVector2* loop, int count, const VelLoopBands& bands)
{
    RayCount rays(q, loop, count, false);
    const int *k, *last;
    bands.EdgesNear(q.y, k, last);
    for (; k < last; ++k) {
        DorVector2 u = VelSub2(loop[*k], q), v = VelSub2(loop[*k + 1 < count ? *k + 1 : 0], q);
        if (!OneSide(u, v) && !rays.Add(*k, u, v))
            return kUnsure;
    }
    return rays.Finish();
}

// Differences of distinct numbers at least kTiny in magnitude (or 0) are far above kNear.
const double kTiny = 1e-80;

bool TinyButNotZero(double y) { return y != 0.0 && std::fabs(y) < kTiny; }
}  // namespace

// The band of y, the same function of y for the edges and the points asked about: as it never
// decreases with y, an edge listed under bands that all come before (after) y's has both ends below
// (above) y.
int VelLoopBands::Band(double y) const
{
    const double at = (y - low) * scale;
    return !(at >= 1.0) ? 0 : at >= bandCount ? bandCount - 1 : static_cast<int>(at);
}

VelLoopBands::VelLoopBands(const DorVector2* loop, int count, const VelBox& bounds)
{
    const double height = bounds.maxY - bounds.minY;
    if (!CountableSize(count) || count < kLeastPoints || !InRange(bounds, DorVector2(0.0, 0.0)) || !(height > 0.0))
        return;
    for (int k = 0; k < count; ++k) {
        if (TinyButNotZero(loop[k].y))
            return;
    }
    low = bounds.minY;
    bandCount = std::min(count / 2, 4096);
    scale = bandCount / height;
    if (!std::isfinite(scale)) {
        bandCount = 0;
        return;
    }
    auto span = [&](int k, int& first, int& last) {
        const double a = loop[k].y, b = loop[k + 1 < count ? k + 1 : 0].y;
        first = Band(std::min(a, b));
        last = Band(std::max(a, b));
    };
    size_t total = 0;
    for (int k = 0; k < count; ++k) {
        int first, last;
        span(k, first, last);
        total += last - first + 1;
    }
    if (total > 16 * static_cast<size_t>(count)) {  // long edges across many bands: no gain
        bandCount = 0;
        return;
    }
    // Counted, then filled from each band's end, last edge first: each band in edge order.
    starts.assign(bandCount + 1, 0);
    for (int k = 0; k < count; ++k) {
        int first, last;
        span(k, first, last);
        for (int b = first; b <= last; ++b)
            ++starts[b];
    }
    for (int b = 0, sum = 0; b <= bandCount; ++b)
        starts[b] = sum += starts[b];
    edges.resize(total);
    for (int k = count - 1; k >= 0; --k) {
        int first, last;
        span(k, first, last);
        for (int b = first; b <= last; ++b)
            edges[--starts[b]] = k;
    }
}

bool VelLoopBands::Covers(double y) const { return !Empty() && !TinyButNotZero(y); }

void VelLoopBands::EdgesNear(double y, const int*& first, const int*& last) const
{
    const int b = Band(y);
    first = edges.data() + starts[b];
    last = edges.data() + starts[b + 1];
}

// Where one ray leaves the count unsure (an edge or a vertex along it), the ray a quarter turn
// round usually does not. A q beyond one side of the bounds, by more than kNear, sees every
// edge's two vectors in one open half-plane, as in OneSide, so each term is within a few ulps of
// its exact angle; those add up to 0.
bool VelInsideLoop(const DorVector2& q, const DorVector2* loop, int count, const VelRun* runs, int runCount,
                   const VelBox* bounds, const VelLoopBands* bands)
{
    const bool inRange = bounds && count <= 1000000 && InRange(*bounds, q);
    if (inRange && (bounds->minX - q.x > kNear || q.x - bounds->maxX > kNear || bounds->minY - q.y > kNear ||
                    q.y - bounds->maxY > kNear))
        return false;
    Verdict verdict = inRange && bands && bands->Covers(q.y) ? BandVerdict(q, loop, count, *bands)
                                                              : WindingVerdict(q, loop, count, false, runs, runCount);
    if (verdict == kUnsure)
        verdict = WindingVerdict(q, loop, count, true, runs, runCount);
    if (verdict != kUnsure)
        return verdict == kInside;
    return VelWindingInside(VelWindingAngle(q, loop, count));
}

bool VelOnLoopEdge(const DorVector2& q, const DorVector2* loop, int count)
{
    for (int k = 0; k < count; ++k) {
        DorVector2 u = VelSub2(loop[k], q), v = VelSub2(loop[k + 1 < count ? k + 1 : 0], q);
        if (!(std::fabs(VelCross2(u, v)) < 0.0001))
            continue;
        VelNormalize2(u);
        VelNormalize2(v);
        double dot = VelDot2(u, v);
        if (dot > -1.0001 && dot < -0.0009)
            return true;
    }
    return false;
}

bool VelPointOnSegment(const DorVector2& p, const DorVector2& a, const DorVector2& b)
{
    DorVector2 d = VelSub2(b, a);
    double lengthSquared = VelDot2(d, d);
    if (lengthSquared == 0.0)
        return false;
    double t = VelDot2(VelSub2(p, a), d) / lengthSquared;
    if (!(std::fabs(t) >= 1e-6 && std::fabs(1.0 - t) >= 1e-6 && t > 0.0 && t < 1.0))
        return false;
    DorVector2 foot(a.x + t * d.x, a.y + t * d.y);
    DorVector2 off = VelSub2(p, foot);
    return std::sqrt(VelDot2(off, off)) < 1e-6;
}
