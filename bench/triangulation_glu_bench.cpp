// Our triangulations beside the GLU tessellator (odd winding, triangles only) on the same
// outlines in the same process. Each benchmark times ours; the counters add both triangle counts
// and, from batches of each in turn, the fastest time per call of ours (ours_us) and of GLU's
// (glu_us) and their ratio. Without GLU only ours is timed.
#include <benchmark/benchmark.h>

#include <time.h>

#include <algorithm>
#include <deque>
#include <vector>

#include "convert/triangulation_families.h"
#include "convert/vel_hole_polygon_to_primitive.h"
#include "convert/vel_polygon_triangulation.h"

#ifdef KARVEL_HAVE_GLU
#include <GL/glu.h>
#endif

namespace {
typedef std::vector<DorVector3> Loop;

// Processor time of this thread: the machine is shared, wall time would count the others' work.
double Seconds()
{
    timespec t;
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &t);
    return t.tv_sec + t.tv_nsec * 1e-9;
}

struct Input {
    Loop outline;
    std::vector<Loop> holes;
};

#ifdef KARVEL_HAVE_GLU
struct Point {
    GLdouble c[3];
};

struct GluOutput {
    std::vector<const void*> corners;
    std::deque<Point> made;  // points where edges cross; stable addresses
};

void GLAPIENTRY OnVertex(void* vertex, void* out) { static_cast<GluOutput*>(out)->corners.push_back(vertex); }
void GLAPIENTRY OnEdgeFlag(GLboolean, void*) {}  // its presence alone keeps fans and strips out
void GLAPIENTRY OnCombine(GLdouble coords[3], void*[4], GLfloat[4], void** result, void* out)
{
    std::deque<Point>& made = static_cast<GluOutput*>(out)->made;
    made.push_back(Point{{coords[0], coords[1], coords[2]}});
    *result = made.back().c;
}

class GluTessellator {
public:
    explicit GluTessellator(const Input& input) : tess(gluNewTess())
    {
        for (const Loop* loop = &input.outline; loop; loop = NextLoop(input, loop)) {
            coords.emplace_back();
            for (const DorVector3& p : *loop)
                coords.back().insert(coords.back().end(), {p.x, p.y, p.z});
        }
        gluTessProperty(tess, GLU_TESS_WINDING_RULE, GLU_TESS_WINDING_ODD);
        gluTessCallback(tess, GLU_TESS_VERTEX_DATA, reinterpret_cast<_GLUfuncptr>(OnVertex));
        gluTessCallback(tess, GLU_TESS_EDGE_FLAG_DATA, reinterpret_cast<_GLUfuncptr>(OnEdgeFlag));
        gluTessCallback(tess, GLU_TESS_COMBINE_DATA, reinterpret_cast<_GLUfuncptr>(OnCombine));
    }
    ~GluTessellator() { gluDeleteTess(tess); }

    int Run()
    {
        out.corners.clear();
        out.made.clear();
        gluTessBeginPolygon(tess, &out);
        for (std::vector<GLdouble>& loop : coords) {
            gluTessBeginContour(tess);
            for (size_t k = 0; k < loop.size(); k += 3)
                gluTessVertex(tess, &loop[k], &loop[k]);
            gluTessEndContour(tess);
        }
        gluTessEndPolygon(tess);
        return static_cast<int>(out.corners.size() / 3);
    }

private:
    static const Loop* NextLoop(const Input& input, const Loop* loop)
    {
        size_t next = loop == &input.outline ? 0 : static_cast<size_t>(loop - input.holes.data()) + 1;
        return next < input.holes.size() ? &input.holes[next] : nullptr;
    }

    GLUtesselator* tess;
    std::vector<std::vector<GLdouble>> coords;
    GluOutput out;
};
#endif

// Ours on the plain path for an outline alone, on the holed path otherwise.
class Ours {
public:
    explicit Ours(const Input& input)
        : plain(input.outline.data(), static_cast<int>(input.outline.size())),
          holed(convert_test::HolePolygon(input.outline, input.holes)), withHoles(!input.holes.empty())
    {
    }
    int Run()
    {
        if (withHoles)
            CVelHolePolygonToPrimitive().TriangulateHolePolygon(&holed, vertices, indices);
        else
            TriangulatePolygon(&plain, indices);
        return indices.GetSize() / 3;
    }

private:
    CDorPolygon plain;
    CDorHolePolygon holed;
    bool withHoles;
    CDorArray<DorVector3, DorVector3&> vertices;
    CDorArray<int, int> indices;
};

// Seconds per call of f over a batch of at least 2 ms (at least one call).
template <typename F>
double BatchSeconds(F f)
{
    int calls = 0;
    double start = Seconds(), elapsed = 0.0;
    for (; calls < 1 || elapsed < 0.002; ++calls, elapsed = Seconds() - start)
        f();
    return elapsed / calls;
}

void Compare(benchmark::State& state, const Input& input)
{
    Ours ours(input);
    int triangles = 0;
    for (auto _ : state)
        benchmark::DoNotOptimize(triangles = ours.Run());
    state.counters["points"] = static_cast<double>(input.outline.size() + 4 * input.holes.size());
    state.counters["triangles"] = triangles;
#ifdef KARVEL_HAVE_GLU
    // Batches of ours and GLU's in turn, the fastest of each kept: other work on a shared machine
    // slows whichever batch it lands on, so the fastest is what the code itself costs, and taking
    // both from the same stretch of time keeps their ratio steady.
    GluTessellator glu(input);
    int gluTriangles = 0;
    double oursBest = 1e300, gluBest = 1e300;
    const double start = Seconds();
    for (int batch = 0; batch < 3 || (batch < 25 && Seconds() - start < 0.5); ++batch) {
        oursBest = std::min(oursBest, BatchSeconds([&] { benchmark::DoNotOptimize(triangles = ours.Run()); }));
        gluBest = std::min(gluBest, BatchSeconds([&] { benchmark::DoNotOptimize(gluTriangles = glu.Run()); }));
    }
    state.counters["glu_triangles"] = gluTriangles;
    state.counters["ours_us"] = oursBest * 1e6;
    state.counters["glu_us"] = gluBest * 1e6;
    state.counters["ratio"] = oursBest / gluBest;
#endif
}

int N(const benchmark::State& state) { return static_cast<int>(state.range(0)); }

void Convex(benchmark::State& state) { Compare(state, {convert_test::RegularPolygon(N(state)), {}}); }
void Star(benchmark::State& state) { Compare(state, {convert_test::Star(N(state) / 2, 2.0, 1.0), {}}); }
void Comb(benchmark::State& state) { Compare(state, {families::Comb(N(state)), {}}); }
void LPlan(benchmark::State& state) { Compare(state, {families::LPlan(N(state)), {}}); }
void SubdividedSquare(benchmark::State& state) { Compare(state, {families::SubdividedSquare(N(state)), {}}); }
void CrossingStar(benchmark::State& state) { Compare(state, {families::CrossingStar(N(state), 3), {}}); }
// The argument is k, for k x k holes: 4 + 4k^2 points.
void SquareWithHoles(benchmark::State& state)
{
    const int k = N(state);
    Compare(state, {convert_test::Square(0, 0, 3 * k + 1), convert_test::HoleGrid(k)});
}

void Sizes(benchmark::internal::Benchmark* b, int extra)
{
    for (int n = 8; n <= 1024; n *= 2)
        b->Arg(n);
    b->Arg(extra)->Unit(benchmark::kMicrosecond);
}
}  // namespace

BENCHMARK(Convex)->Apply([](benchmark::internal::Benchmark* b) { Sizes(b, 60); });
BENCHMARK(Star)->Apply([](benchmark::internal::Benchmark* b) { Sizes(b, 60); });
BENCHMARK(Comb)->Apply([](benchmark::internal::Benchmark* b) { Sizes(b, 40); });
BENCHMARK(LPlan)->Apply([](benchmark::internal::Benchmark* b) { Sizes(b, 42); });
BENCHMARK(SquareWithHoles)->DenseRange(1, 5)->Arg(8)->Arg(11)->Arg(16)->Unit(benchmark::kMicrosecond);
BENCHMARK(SubdividedSquare)->Arg(1000)->Arg(5000)->Arg(20000)->Unit(benchmark::kMillisecond);
BENCHMARK(CrossingStar)->Arg(5000)->Unit(benchmark::kMillisecond);
