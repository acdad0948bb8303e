// What the recorders write, decided apart from Video for Windows so that it runs under the
// sanitizers too; vfw_math_movie_test.cpp reads real files back.
#include <gtest/gtest.h>

#include <cstring>

#include "movie/vel_movie_format.h"

namespace {
_DorBitmap Frame(int width, int height, int bitCount, int paletteSize = 0)
{
    _DorBitmap b;
    b.info.width = width;
    b.info.height = height;
    b.info.bitCount = static_cast<uint16_t>(bitCount);
    b.palette.SetSize(paletteSize);
    for (int i = 0; i < paletteSize; ++i)
        b.palette[i] = DorRgbQuad{uint8_t(i), uint8_t(255 - i), uint8_t(i * 3), 0};
    return b;
}
}  // namespace

// Every field: an uncompressed video stream framed to the picture, the codec's default quality
// (not the worst), named by the first character only; everything else zero.
TEST(MovieStreamInfo, DescribesAnUncompressedStreamNamedByItsFirstCharacter)
{
    const char* names[] = {"Camera", "", nullptr};
    for (const char* name : names) {
        // "vids" and "DIB " as they are stored, a frame per 1/25 s, 300 frames.
        VelAviStreamInfo expected = {0x73646976, 0x20424944, 0, 0, 0, 0, 1, 25, 0, 300, 0, 0, 0xFFFFFFFFu, 0, 0, 0, 640, 360};
        expected.name[0] = name && *name ? 'C' : '\0';
        VelAviStreamInfo info = VelMovieStreamInfo(Frame(640, 360, 24).info, 25, name, 300);
        EXPECT_EQ(std::memcmp(&info, &expected, sizeof(info)), 0) << (name ? name : "null");
    }
}

TEST(MovieFormatBlock, TakesOnlyPlayableDepthsWithTheirPaletteUpTo16Bits)
{
    for (int bits = 0; bits <= 40; ++bits) {
        _DorBitmap frame = Frame(5, 5, bits, 16);  // true colour ignores a stray palette
        CDorArray<unsigned char, unsigned char> block;
        bool playable = bits == 1 || bits == 8 || bits == 16 || bits == 24 || bits == 32;
        ASSERT_EQ(VelMovieFormatBlock(frame, block), playable) << bits << " bits";
        if (!playable)
            continue;
        int paletteBytes = bits <= 16 ? 16 * 4 : 0;
        ASSERT_EQ(block.GetSize(), 40 + paletteBytes) << bits;
        EXPECT_EQ(std::memcmp(block.GetData(), &frame.info, 40), 0) << bits;
        EXPECT_EQ(std::memcmp(block.GetData() + 40, frame.palette.GetData(), paletteBytes), 0) << bits;
    }
}

TEST(MovieFrameFits, OnlyTheStartingSizeAndDepthAreTaken)
{
    DorBitmapInfoHeader format = Frame(320, 240, 24).info;
    EXPECT_TRUE(VelMovieFrameFits(format, Frame(320, 240, 24)));
    for (const _DorBitmap& other :
         {Frame(321, 240, 24), Frame(320, 239, 24), Frame(320, -240, 24), Frame(320, 240, 32)})
        EXPECT_FALSE(VelMovieFrameFits(format, other)) << other.info.width << "x" << other.info.height;
}

// Start is refused while recording, whatever the frame, and for a frame without pixels.
TEST(MovieMayStart, OnlyAnIdleRecorderOnAFrameWithPixels)
{
    const struct {
        int started, width, height;
        bool may;
    } rows[] = {{0, 320, 240, true}, {0, 320, -240, true}, {1, 320, 240, false}, {0, 0, 240, false},
                {0, 320, 0, false},  {0, -320, 240, false}};
    for (const auto& r : rows)
        EXPECT_EQ(VelMovieMayStart(r.started, Frame(r.width, r.height, 24).info), r.may) << r.started << " " << r.width << "x" << r.height;
}

TEST(MovieCompressFlags, DataRateWinsOverKeyFrames)
{
    long cases[][3] = {{300, 15, kVelCompressDataRate}, {1, 0, kVelCompressDataRate}, {0, 15, kVelCompressKeyFrames},
                       {-1, 1, kVelCompressKeyFrames},  {0, 0, 0},                    {-1, -1, 0}};
    for (auto& c : cases)
        EXPECT_EQ(VelMovieCompressFlags(c[0], c[1]), uint32_t(c[2])) << c[0] << ", " << c[1];
}
