#include <gtest/gtest.h>

#include <cstring>

#include "model/dor_bitmap.h"
#include "movie/vel_movie_format.h"

namespace {
_DorBitmap Frame(int width, int height, int bitCount)
{
    _DorBitmap b;
    b.info.width = width;
    b.info.height = height;
    b.info.bitCount = static_cast<uint16_t>(bitCount);
    return b;
}
}  // namespace

TEST(MovieStreamInfo, DescribesAnUncompressedVideoStreamOfTheFrameSize)
{
    DorBitmapInfoHeader header = Frame(640, 360, 24).info;
    VelAviStreamInfo info = VelMovieStreamInfo(header, 25, "Camera", 300);
    EXPECT_EQ(std::memcmp(&info.fccType, "vids", 4), 0);
    EXPECT_EQ(std::memcmp(&info.fccHandler, "DIB ", 4), 0);
    EXPECT_EQ(info.scale, 1u);
    EXPECT_EQ(info.rate, 25u);  // rate / scale frames per second
    EXPECT_EQ(info.length, 300u);
    EXPECT_EQ(info.quality, 0xFFFFFFFFu);
    EXPECT_EQ(info.start, 0u);
    EXPECT_EQ(info.sampleSize, 0u);
    EXPECT_EQ(info.flags | info.caps | info.priority | info.language | info.initialFrames, 0u);
    EXPECT_EQ(info.frameLeft, 0);
    EXPECT_EQ(info.frameTop, 0);
    EXPECT_EQ(info.frameRight, 640);
    EXPECT_EQ(info.frameBottom, 360);
}

TEST(MovieStreamInfo, NameKeepsOnlyItsFirstCharacter)
{
    DorBitmapInfoHeader header = Frame(8, 8, 24).info;
    const char* names[] = {"Camera", "C", "", nullptr};
    const char expected[] = {'C', 'C', 0, 0};
    for (int i = 0; i < 4; ++i) {
        VelAviStreamInfo info = VelMovieStreamInfo(header, 30, names[i], 1);
        EXPECT_EQ(info.name[0], expected[i]) << i;
        for (int k = 1; k < 64; ++k)
            ASSERT_EQ(info.name[k], 0) << "name " << i << " byte " << k;
    }
}

TEST(MovieFormatBlock, AcceptsExactlyTheDepthsAPlayerCanShowUncompressed)
{
    for (int bits = 0; bits <= 40; ++bits) {
        CDorArray<unsigned char, unsigned char> block;
        bool accepted = bits == 1 || bits == 8 || bits == 16 || bits == 24 || bits == 32;
        EXPECT_EQ(VelMovieFormatBlock(Frame(4, 4, bits), block), accepted) << bits << " bits";
    }
}

TEST(MovieFormatBlock, PalettedFrameCarriesItsPaletteInOrderAfterTheHeader)
{
    _DorBitmap frame;
    ASSERT_TRUE(DorBitmapAllocate(frame, 6, 3, 8));
    for (int i = 0; i < 256; ++i)
        frame.palette[i] = DorRgbQuad{uint8_t(i), uint8_t(255 - i), uint8_t(i * 3), 0};
    CDorArray<unsigned char, unsigned char> block;
    ASSERT_TRUE(VelMovieFormatBlock(frame, block));
    ASSERT_EQ(block.GetSize(), 40 + 256 * 4);
    EXPECT_EQ(std::memcmp(block.GetData(), &frame.info, 40), 0);
    EXPECT_EQ(block[40 + 4 * 200 + 0], 200);      // blue of entry 200
    EXPECT_EQ(block[40 + 4 * 200 + 1], 55);       // green
    EXPECT_EQ(block[40 + 4 * 200 + 2], (600 & 0xFF));  // red
}

TEST(MovieFormatBlock, TrueColourFrameIsTheHeaderAloneEvenWithAStrayPalette)
{
    for (int bits : {24, 32}) {
        _DorBitmap frame = Frame(5, 5, bits);
        frame.palette.SetSize(16);
        CDorArray<unsigned char, unsigned char> block;
        ASSERT_TRUE(VelMovieFormatBlock(frame, block));
        EXPECT_EQ(block.GetSize(), 40) << bits;
    }
    _DorBitmap highColour = Frame(5, 5, 16);  // no palette: nothing follows the header
    CDorArray<unsigned char, unsigned char> block;
    ASSERT_TRUE(VelMovieFormatBlock(highColour, block));
    EXPECT_EQ(block.GetSize(), 40);
}

TEST(MovieFrameFits, OnlyTheStartingSizeAndDepthAreTaken)
{
    DorBitmapInfoHeader format = Frame(320, 240, 24).info;
    EXPECT_TRUE(VelMovieFrameFits(format, Frame(320, 240, 24)));
    EXPECT_FALSE(VelMovieFrameFits(format, Frame(321, 240, 24)));
    EXPECT_FALSE(VelMovieFrameFits(format, Frame(320, 239, 24)));
    EXPECT_FALSE(VelMovieFrameFits(format, Frame(320, -240, 24)));
    EXPECT_FALSE(VelMovieFrameFits(format, Frame(320, 240, 32)));
}

TEST(MovieCompressFlags, DataRateWinsOverKeyFrames)
{
    EXPECT_EQ(VelMovieCompressFlags(300, 15), kVelCompressDataRate);
    EXPECT_EQ(VelMovieCompressFlags(1, 0), kVelCompressDataRate);
    EXPECT_EQ(VelMovieCompressFlags(0, 15), kVelCompressKeyFrames);
    EXPECT_EQ(VelMovieCompressFlags(-1, 1), kVelCompressKeyFrames);
    EXPECT_EQ(VelMovieCompressFlags(0, 0), 0u);
    EXPECT_EQ(VelMovieCompressFlags(-1, -1), 0u);
}
