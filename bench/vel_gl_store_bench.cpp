// Adding a large primitive to the entity store against a bare loop narrowing the same doubles
// into float arrays of the same sizes.
#include <benchmark/benchmark.h>

#include <vector>

#include "gl/vel_gl_store.h"

namespace {
const int kVertices = 1000000;

CVelPrimitive MillionVertexStrip()
{
    CVelPrimitive p;
    p.groups.SetSize(1);
    CDorArray<_VelVertex, _VelVertex&>& v = p.groups[0].vertices;
    v.SetSize(kVertices);
    for (int i = 0; i < kVertices; ++i) {
        v[i].position = DorVector3(i * 0.001, i % 7, 1.5);
        v[i].normal = DorVector3(0, 0, 1);
        v[i].texcoord = DorVector2(i * 0.5, 0.25);
    }
    return p;
}

void AddPrimitiveMillionVertices(benchmark::State& state)
{
    CVelPrimitive p = MillionVertexStrip();
    CVelGLStructure model;
    CVelGLScope scope;
    for (auto _ : state) {
        _DorPosition* handle = model.AddPrimitive(p, scope);
        benchmark::DoNotOptimize(handle);
        model.RemoveAt(handle);
    }
}

void NarrowingLoopMillionVertices(benchmark::State& state)
{
    CVelPrimitive p = MillionVertexStrip();
    const _VelVertex* v = p.groups[0].vertices.GetData();
    for (auto _ : state) {
        std::vector<float> positions(3 * kVertices), normals(3 * kVertices), colours(4 * kVertices),
            texcoords(2 * kVertices);
        for (int i = 0; i < kVertices; ++i) {
            positions[3 * i] = static_cast<float>(v[i].position.x);
            positions[3 * i + 1] = static_cast<float>(v[i].position.y);
            positions[3 * i + 2] = static_cast<float>(v[i].position.z);
            normals[3 * i] = static_cast<float>(v[i].normal.x);
            normals[3 * i + 1] = static_cast<float>(v[i].normal.y);
            normals[3 * i + 2] = static_cast<float>(v[i].normal.z);
            colours[4 * i] = v[i].colour.r;
            colours[4 * i + 1] = v[i].colour.g;
            colours[4 * i + 2] = v[i].colour.b;
            colours[4 * i + 3] = v[i].colour.a;
            texcoords[2 * i] = static_cast<float>(v[i].texcoord.x);
            texcoords[2 * i + 1] = static_cast<float>(v[i].texcoord.y);
        }
        benchmark::DoNotOptimize(positions.data());
        benchmark::DoNotOptimize(texcoords.data());
    }
}
}  // namespace

BENCHMARK(AddPrimitiveMillionVertices)->Unit(benchmark::kMillisecond);
BENCHMARK(NarrowingLoopMillionVertices)->Unit(benchmark::kMillisecond);
