// The foundation containers against std::vector doing the same work.
#include <benchmark/benchmark.h>

#include <vector>

#include "model/vel_primitive.h"

namespace {
const int kCount = 1000000;

template <class T>
void DorArrayAdd(benchmark::State& state)
{
    T value{};
    for (auto _ : state) {
        CDorArray<T, const T&> a;
        for (int i = 0; i < kCount; ++i)
            a.Add(value);
        benchmark::DoNotOptimize(a.data);
    }
}

template <class T>
void StdVectorPushBack(benchmark::State& state)
{
    T value{};
    for (auto _ : state) {
        std::vector<T> v;
        for (int i = 0; i < kCount; ++i)
            v.push_back(value);
        benchmark::DoNotOptimize(v.data());
    }
}

void PrimitiveCopy(benchmark::State& state)
{
    CVelPrimitive source;
    source.groups.SetSize(1);
    source.groups[0].vertices.SetSize(kCount);
    for (auto _ : state) {
        CVelPrimitive copy(source);
        benchmark::DoNotOptimize(copy.groups[0].vertices.data);
    }
}

void StdVectorCopy(benchmark::State& state)
{
    std::vector<_VelVertex> source(kCount);
    for (auto _ : state) {
        std::vector<_VelVertex> copy(source);
        benchmark::DoNotOptimize(copy.data());
    }
}
}  // namespace

BENCHMARK_TEMPLATE(DorArrayAdd, int)->Unit(benchmark::kMillisecond);
BENCHMARK_TEMPLATE(StdVectorPushBack, int)->Unit(benchmark::kMillisecond);
BENCHMARK_TEMPLATE(DorArrayAdd, _VelVertex)->Unit(benchmark::kMillisecond);
BENCHMARK_TEMPLATE(StdVectorPushBack, _VelVertex)->Unit(benchmark::kMillisecond);
BENCHMARK(PrimitiveCopy)->Unit(benchmark::kMillisecond);
BENCHMARK(StdVectorCopy)->Unit(benchmark::kMillisecond);
