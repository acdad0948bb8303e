// Holed shape conversion: the triangulation with holes on typical faces and a whole scene of
// holed extrusions.
#include <benchmark/benchmark.h>

#include <memory>

#include "convert/convert_test_support.h"
#include "convert/vel_hole_polygon_to_primitive.h"
#include "convert_bench_support.h"

using namespace convert_test;

namespace {
void Triangulate(benchmark::State& state, const CDorHolePolygon& shape)
{
    CDorArray<DorVector3, DorVector3&> vertices;
    CDorArray<int, int> indices;
    CVelHolePolygonToPrimitive converter;
    for (auto _ : state) {
        converter.TriangulateHolePolygon(&shape, vertices, indices);
        benchmark::DoNotOptimize(indices.data);
    }
    state.counters["triangles"] = indices.GetSize() / 3;
}

// A square with k x k square holes (1, 4, 9 holes).
void TriangulateHoleGrid(benchmark::State& state)
{
    const int k = static_cast<int>(state.range(0));
    Triangulate(state, HolePolygon(Square(0, 0, 3 * k + 1), HoleGrid(k)));
}

// A 40-point star with three small holes about its centre.
void TriangulateStar40With3Holes(benchmark::State& state)
{
    Triangulate(state, HolePolygon(Star(20, 4.0, 3.0),
                                   {Square(-1.5, -0.5, 1), Square(0.5, -0.5, 1), Square(-0.5, 1, 1)}));
}

// 1,000 solid holed extrusions with both caps: walls with a window, blocks with two holes.
void ConvertHoledScene(benchmark::State& state)
{
    std::vector<std::unique_ptr<CDorHoleExtruded>> solids;
    CDorShape shape;
    for (int i = 0; i < 1000; ++i) {
        const double x = 6.0 * i;
        CDorHolePolygon face = i % 2 ? HolePolygon(Square(x, 0, 4), {Square(x + 1, 1, 2)})
                                     : HolePolygon(Square(x, 0, 5), {Square(x + 1, 1, 1), Square(x + 3, 3, 1)});
        solids.push_back(std::make_unique<CDorHoleExtruded>(face, DorVector3(0, 0, 1 + i % 3)));
        shape.Add(solids.back().get());
    }
    ConvertShapeRepeatedly(state, shape);
}
}  // namespace

BENCHMARK(TriangulateHoleGrid)->Arg(1)->Arg(2)->Arg(3)->Unit(benchmark::kMicrosecond);
BENCHMARK(TriangulateStar40With3Holes)->Unit(benchmark::kMicrosecond);
BENCHMARK(ConvertHoledScene)->Unit(benchmark::kMillisecond);
