// The camera maths a host calls on every mouse move: matrices, moves, zoom and approach.
#include <benchmark/benchmark.h>

#include "camera/vel_math_camera.h"

namespace {
_VelCamera SlopedCamera()
{
    _VelCamera c;
    c.eye = DorVector3(10, -20, 5);
    c.target = DorVector3(1, 2, 3);
    c.fovy = 45.0;
    c.zNear = 1.0;
    c.zFar = 1000.0;
    c.aspect = 4.0 / 3.0;
    return c;
}

void ToViewMatrix(benchmark::State& state)
{
    _VelCamera c = SlopedCamera();
    DorMatrix4x4 m;
    for (auto _ : state) {
        CVelMathMatrix::GetToViewMatrix(c, 100.0, m);
        benchmark::DoNotOptimize(m);
    }
}

void PerspectiveMatrix(benchmark::State& state)
{
    _VelCamera c = SlopedCamera();
    DorMatrix4x4 m;
    for (auto _ : state) {
        CVelMathMatrix::GetPerspectiveMatrix(c, 100.0, m);
        benchmark::DoNotOptimize(m);
    }
}

// Small back-and-forth moves keep the camera in range however many iterations run.
void PanTiltBackAndForth(benchmark::State& state)
{
    _VelCamera c = SlopedCamera();
    for (auto _ : state) {
        CVelMathCamera::PanTilt(c, 1.0, 0.5);
        CVelMathCamera::PanTilt(c, -1.0, -0.5);
        benchmark::DoNotOptimize(c);
    }
}

void FlyBackAndForth(benchmark::State& state)
{
    _VelCamera c = SlopedCamera();
    for (auto _ : state) {
        CVelMathCamera::Fly(c, 1.0, 0.5, 0.25, 0);
        CVelMathCamera::Fly(c, -1.0, -0.5, -0.25, 0);
        benchmark::DoNotOptimize(c);
    }
}

void RoundDollyBackAndForth(benchmark::State& state)
{
    _VelCamera c = SlopedCamera();
    for (auto _ : state) {
        CVelMathCamera::RoundDolly(c, 1.0, 2.0);
        CVelMathCamera::RoundDolly(c, -1.0, -2.0);
        benchmark::DoNotOptimize(c);
    }
}

void ViewportZoom(benchmark::State& state)
{
    _VelCamera c = SlopedCamera();
    for (auto _ : state) {
        _VelViewport v = {0, 0, 400, 300};
        benchmark::DoNotOptimize(CVelMathCamera::ViewportZoom(c, v, DorVector2(100, 75), DorVector2(300, 225)));
        benchmark::DoNotOptimize(v);
    }
}

void ApproachTurn(benchmark::State& state)
{
    const _VelCamera start = SlopedCamera();
    for (auto _ : state) {
        _VelCamera c = start;
        CVelMathCamera::ApproachCamera(c, DorVector2(40, -30), 300, 150, 0);
        benchmark::DoNotOptimize(c);
    }
}
}  // namespace

BENCHMARK(ToViewMatrix);
BENCHMARK(PerspectiveMatrix);
BENCHMARK(PanTiltBackAndForth);
BENCHMARK(FlyBackAndForth);
BENCHMARK(RoundDollyBackAndForth);
BENCHMARK(ViewportZoom);
BENCHMARK(ApproachTurn);
