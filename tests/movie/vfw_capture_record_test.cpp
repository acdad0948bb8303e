// Frames captured by ToBitmap go straight into a movie: each one is accepted and its pixels are
// written to the file as they were captured.
#include <gtest/gtest.h>
#include <windows.h>

#include <algorithm>
#include <cstdio>
#include <string>
#include <vector>

#include "movie/vfw_math_movie.h"
#include "support/gl_live_modeller.h"

namespace {
std::vector<unsigned char> FileBytes(const std::string& path)
{
    std::vector<unsigned char> bytes;
    if (std::FILE* f = std::fopen(path.c_str(), "rb")) {
        unsigned char buffer[65536];
        for (size_t n; (n = std::fread(buffer, 1, sizeof(buffer), f)) > 0;)
            bytes.insert(bytes.end(), buffer, buffer + n);
        std::fclose(f);
    }
    return bytes;
}
}  // namespace

TEST_F(LiveModeller, CapturedFramesAreRecordedIntoAMovie)
{
    Add(Rectangle(-2, -2, 2, 2, 0, Matte(1, 0, 0)));
    char folder[MAX_PATH];
    GetTempPathA(MAX_PATH, folder);
    std::string path = std::string(folder) + "karvel_captured_frames.avi";
    DeleteFileA(path.c_str());

    // Three frames of an odd width while the camera turns, so that every frame differs.
    std::vector<_DorBitmap> frames(3);
    _DORRECT rect = {0, 0, 101, 50};
    for (_DorBitmap& frame : frames) {
        karvel.ToBitmap(frame, rect);
        karvel.RoundDolly(0, 20);
    }
    CVelMathMovie_NoComp movie;
    ASSERT_EQ(movie.Start(frames[0], path.c_str(), 10, "k", 3), 1);
    for (_DorBitmap& frame : frames)
        EXPECT_EQ(movie.Add(frame), 1);
    movie.End();

    std::vector<unsigned char> file = FileBytes(path);
    DeleteFileA(path.c_str());
    ASSERT_GT(file.size(), 3u * 15200);
    for (size_t i = 0; i < frames.size(); ++i) {
        const unsigned char* bits = frames[i].bits.GetData();
        EXPECT_NE(std::search(file.begin(), file.end(), bits, bits + frames[i].bits.GetSize()), file.end()) << i;
    }
    EXPECT_NE(memcmp(frames[0].bits.GetData(), frames[2].bits.GetData(), 15200), 0);
}
