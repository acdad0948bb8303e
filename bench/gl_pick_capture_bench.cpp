// HitTest on a 100,000-triangle model and ToBitmap at 1920 x 1080 and 4000 x 3000, under Wine.
#include <windows.h>
#include <GL/gl.h>

#include <cstdio>

#include "gl/vel_gl_karvel.h"
#include "gl_bench_model.h"
#include "support/win32_test_window.h"
#include "win32_bench.h"

int main()
{
    TestWindow window(640, 480);
    HDC dc = window.dc;
    CVelGLKarvel karvel;
    if (!LoadBenchModel(karvel, dc, 10)) {
        std::printf("no context\n");
        return 0;
    }

    CDorArray<_VelSelect, _VelSelect&> hits;
    Win32Bench("HitTest, 100,000 triangles", 20, [&] { karvel.HitTest(dc, 320, 240, hits); });
    std::printf("  hits under the centre: %d\n", hits.GetSize());
    Win32Bench("DrawModel, same model", 20, [&] {
        karvel.DrawModel(dc);
        glFinish();
    });

    const int sizes[][2] = {{640, 480}, {1920, 1080}, {4000, 3000}};
    for (const auto& size : sizes) {
        char name[64];
        std::snprintf(name, sizeof(name), "ToBitmap %d x %d, 100,000 triangles", size[0], size[1]);
        _DORRECT rect = {0, 0, size[0], size[1]};
        _DorBitmap bitmap;
        Win32Bench(name, size[0] > 2000 ? 3 : 5, [&] { karvel.ToBitmap(bitmap, rect); });
        std::printf("  %d x %d, %d pixel bytes\n", static_cast<int>(bitmap.info.width),
                    static_cast<int>(bitmap.info.height), bitmap.bits.GetSize());
    }
    return 0;
}
