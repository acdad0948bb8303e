// Uncompressed recording speed: 300 frames of 1280x720 at 24 bits (what a captured HD view
// gives), written to a file in the temporary folder, reported as frames per second.
#include <windows.h>

#include <cstdio>
#include <string>

#include "model/dor_bitmap.h"
#include "movie/vfw_math_movie.h"
#include "win32_bench.h"

namespace {
const int kFrames = 300;

void Record(const std::string& path, _DorBitmap& frame)
{
    CVelMathMovie_NoComp movie;
    movie.Start(frame, path.c_str(), 30, "b", kFrames);
    for (int i = 0; i < kFrames; ++i) {
        frame.bits[0] = static_cast<unsigned char>(i);
        movie.Add(frame);
    }
    movie.End();
}
}  // namespace

int main()
{
    char folder[MAX_PATH];
    GetTempPathA(MAX_PATH, folder);
    std::string path = std::string(folder) + "karvel_bench.avi";
    _DorBitmap frame;
    DorBitmapAllocate(frame, 1280, 720, 24);
    for (int i = 0; i < frame.bits.GetSize(); ++i)
        frame.bits[i] = static_cast<unsigned char>(i * 13);

    Win32BenchResult r = Win32Bench("record 300 uncompressed 1280x720x24 frames", 5, [&] { Record(path, frame); });
    std::printf("%-48s median %10.1f frames/s   best %10.1f frames/s\n", "  as frame rate", kFrames / (r.medianMs / 1000.0),
                kFrames / (r.minMs / 1000.0));
    DeleteFileA(path.c_str());
    return 0;
}
