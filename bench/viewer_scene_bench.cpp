// The sample viewer's own work around the library: reading the sample scenes (JSON, BMP
// texture, profiles) and turning a captured frame into PNG rows and a PNG file.
#include <benchmark/benchmark.h>

#include <cstdio>
#include <string>

#include "png_file.h"
#include "scene.h"

namespace {
const std::string kScenes = std::string(KARVEL_SOURCE_DIR) + "/examples/scenes/";

void LoadScene(benchmark::State& state, const char* file)
{
    for (auto _ : state) {
        Scene scene;
        std::string error;
        bool ok = LoadSceneFile(kScenes + file, scene, error);
        benchmark::DoNotOptimize(ok);
    }
}
BENCHMARK_CAPTURE(LoadScene, house, "house.json")->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(LoadScene, part, "part.json")->Unit(benchmark::kMicrosecond);

_DorBitmap Frame(int width, int height)
{
    _DorBitmap bitmap;
    bitmap.info.width = width;
    bitmap.info.height = height;
    bitmap.bits.SetSize(DorBitmapRowBytes(width, 24) * height);
    for (int i = 0; i < bitmap.bits.GetSize(); ++i)
        bitmap.bits[i] = static_cast<unsigned char>((i * 7) ^ (i >> 9));
    return bitmap;
}

void RgbRows800x600(benchmark::State& state)
{
    _DorBitmap frame = Frame(800, 600);
    for (auto _ : state)
        benchmark::DoNotOptimize(BitmapToRgbRows(frame));
}
BENCHMARK(RgbRows800x600)->Unit(benchmark::kMicrosecond);

void WritePng800x600(benchmark::State& state)
{
    _DorBitmap frame = Frame(800, 600);
    std::string path = std::string(P_tmpdir) + "/karvel_bench.png";
    for (auto _ : state)
        benchmark::DoNotOptimize(WritePng(path, frame));
    std::remove(path.c_str());
}
BENCHMARK(WritePng800x600)->Unit(benchmark::kMillisecond);
}  // namespace
