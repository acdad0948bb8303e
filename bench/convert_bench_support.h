#pragma once
// The shape conversion loop shared by the conversion benchmarks.
#include <benchmark/benchmark.h>

#include "convert/vel_shape_to_primitive.h"

// Converts the whole shape once per iteration and reports the groups it made.
inline void ConvertShapeRepeatedly(benchmark::State& state, const CDorShape& shape)
{
    int groups = 0;
    for (auto _ : state) {
        CVelPrimitive primitive;
        CVelShapeToPrimitive().ConvertShape(shape, primitive);
        groups = primitive.groups.GetSize();
        benchmark::DoNotOptimize(primitive.groups.data);
    }
    state.counters["groups"] = groups;
}
