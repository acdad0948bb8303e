// DrawModel of a 200,000-triangle model against a bare loop issuing the same glDrawElements
// calls on the same arrays in the same context, under Wine.
#include <windows.h>
#include <GL/gl.h>

#include <cstdio>

#include "gl/vel_gl_karvel.h"
#include "gl_bench_model.h"
#include "support/win32_test_window.h"
#include "win32_bench.h"

namespace {
const int kEntities = 20;
}  // namespace

int main()
{
    TestWindow window(640, 480);
    HDC dc = window.dc;
    CVelGLKarvel karvel;
    if (!LoadBenchModel(karvel, dc, kEntities)) {
        std::printf("no context\n");
        return 0;
    }

    const int runs = 30;
    Win32BenchResult model = Win32Bench("DrawModel, 200,000 triangles", runs, [&] {
        karvel.DrawModel(dc);
        glFinish();
    }, 3);
    Win32BenchResult bare = Win32Bench("bare glDrawElements loop, same arrays", runs, [&] {
        glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
        for (_DorPosition* p = karvel.model.entities.GetHeadPosition(); p; p = CDorList::GetNextPosition(p)) {
            const CVelGLTrianglePolygons& g = CVelGLStructure::ListedEntity(p)->groups[0];
            glVertexPointer(3, GL_FLOAT, 0, g.positions.GetData());
            glNormalPointer(GL_FLOAT, 0, g.normals.GetData());
            glDrawElements(GL_TRIANGLES, g.indices.GetSize(), GL_UNSIGNED_INT, g.indices.GetData());
        }
        SwapBuffers(dc);
        glFinish();
    }, 3);
    std::printf("DrawModel / bare loop: %.3f\n", model.medianMs / bare.medianMs);
    return 0;
}
