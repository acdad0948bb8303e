// Shape conversion: the cap triangulation on typical outlines and a whole scene of extrusions.
#include <benchmark/benchmark.h>

#include <memory>

#include "convert/convert_test_support.h"
#include "convert/vel_polygon_triangulation.h"
#include "convert_bench_support.h"

using namespace convert_test;

namespace {
void Triangulate(benchmark::State& state, const std::vector<DorVector3>& outline)
{
    CDorPolygon polygon = Polygon(outline);
    CDorArray<int, int> indices;
    for (auto _ : state) {
        TriangulatePolygon(&polygon, indices);
        benchmark::DoNotOptimize(indices.data);
    }
    state.counters["triangles"] = indices.GetSize() / 3;
}

void TriangulateConvex(benchmark::State& state) { Triangulate(state, RegularPolygon(static_cast<int>(state.range(0)))); }
void TriangulateStar40(benchmark::State& state) { Triangulate(state, Star(20, 2.0, 1.0)); }
void TriangulateLShape(benchmark::State& state) { Triangulate(state, LShape()); }

// 1,000 solid extrusions with both caps: boxes, L-shaped and octagonal prisms in a row.
void ConvertScene(benchmark::State& state)
{
    std::vector<std::unique_ptr<CDorExtruded>> solids;
    CDorShape shape;
    const std::vector<DorVector3> profiles[3] = {RegularPolygon(4), LShape(), RegularPolygon(8)};
    for (int i = 0; i < 1000; ++i) {
        CDorPolygon base = Polygon(profiles[i % 3]).Translated(DorVector3(3.0 * i, 0, 0));
        solids.push_back(std::make_unique<CDorExtruded>(base, DorVector3(0, 0, 1 + i % 5)));
        shape.Add(solids.back().get());
    }
    ConvertShapeRepeatedly(state, shape);
}
}  // namespace

BENCHMARK(TriangulateConvex)->Arg(8)->Arg(32)->Arg(60)->Arg(120)->Unit(benchmark::kMicrosecond);
BENCHMARK(TriangulateStar40)->Unit(benchmark::kMicrosecond);
BENCHMARK(TriangulateLShape)->Unit(benchmark::kMicrosecond);
BENCHMARK(ConvertScene)->Unit(benchmark::kMillisecond);
