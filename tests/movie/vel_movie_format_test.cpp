// What the recorders write, decided apart from Video for Windows so that it runs under the
// sanitizers too; vfw_math_movie_test.cpp reads real files back (the format block of each depth
// among them) and shows which frames and starts are refused.
#include <gtest/gtest.h>

#include <cstring>

#include "movie/vel_movie_format.h"

// Every field: an uncompressed video stream framed to the picture, the codec's default quality
// (not the worst), named by the first character only; everything else zero.
TEST(MovieStreamInfo, DescribesAnUncompressedStreamNamedByItsFirstCharacter)
{
    const char* names[] = {"Camera", "", nullptr};
    for (const char* name : names) {
        // "vids" and "DIB " as they are stored, a frame per 1/25 s, 300 frames.
        VelAviStreamInfo expected = {0x73646976, 0x20424944, 0, 0, 0, 0, 1, 25, 0, 300, 0, 0, 0xFFFFFFFFu, 0, 0, 0, 640, 360, 0, 0, {}};
        expected.name[0] = name && *name ? 'C' : '\0';
        DorBitmapInfoHeader frame = {40, 640, 360, 1, 24, 0, 0, 0, 0, 0, 0};
        VelAviStreamInfo info = VelMovieStreamInfo(frame, 25, name, 300);
        EXPECT_EQ(std::memcmp(&info, &expected, sizeof(info)), 0) << (name ? name : "null");
    }
}

TEST(MovieCompressFlags, DataRateWinsOverKeyFrames)
{
    long cases[][3] = {{300, 15, kVelCompressDataRate}, {1, 0, kVelCompressDataRate}, {0, 15, kVelCompressKeyFrames},
                       {-1, 1, kVelCompressKeyFrames},  {0, 0, 0},                    {-1, -1, 0}};
    for (auto& c : cases)
        EXPECT_EQ(VelMovieCompressFlags(c[0], c[1]), uint32_t(c[2])) << c[0] << ", " << c[1];
}
