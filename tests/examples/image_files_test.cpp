// BMP textures read and PNG pictures written by the viewer.
#include <gtest/gtest.h>

// The reading half of stb, to check what the viewer wrote.
#define STB_IMAGE_IMPLEMENTATION
#include <stb/stb_image.h>

#include "bmp_file.h"
#include "png_file.h"
#include "viewer_test_support.h"

using viewer_test::BmpFile;
using viewer_test::PutU16;
using viewer_test::PutU32;

// Bottom-up and top-down rows, padded rows, 32 bits with and without plain BGRA masks: every
// pixel lands where BmpFile put it, rows stored bottom-up at their padded stride.
TEST(BmpDecode, EveryPixelIsReadBottomUpAtItsStride)
{
    const unsigned char masks[12] = {0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0};  // red, green, blue
    const struct {
        int width, height, bitCount, bytes;
        bool masked;
    } cases[] = {{4, 8, 24, 12 * 8, false}, {4, -4, 32, 16 * 4, false}, {3, 2, 24, 12 * 2, false}, {2, 2, 32, 8 * 2, true}};
    for (const auto& c : cases) {
        std::vector<unsigned char> file = BmpFile(c.width, c.height, c.bitCount);
        if (c.masked) {
            file.insert(file.begin() + 54, masks, masks + 12);
            PutU32(file, 10, 66);
            PutU32(file, 30, 3);
        }
        _DorBitmap bitmap;
        std::string expected;
        ASSERT_TRUE(DecodeBmp(file, bitmap, expected)) << expected;
        int rows = c.height < 0 ? -c.height : c.height, stride = c.bytes / rows, pixel = c.bitCount / 8;
        EXPECT_TRUE(bitmap.info.width == c.width && bitmap.info.height == rows && bitmap.info.bitCount == c.bitCount);
        EXPECT_TRUE(bitmap.bits.GetSize() == c.bytes && bitmap.fileSize == c.bytes + 54u);
        for (int y = 0; y < rows; ++y)
            for (int x = 0; x < c.width; ++x) {
                const unsigned char* p = &bitmap.bits[y * stride + x * pixel];
                EXPECT_TRUE(p[0] == x && p[1] == y && p[2] == 200 && (pixel == 3 || p[3] == 255)) << c.height << ": " << x << "," << y;
            }
    }
}

// Each case changes one header field of a valid 4 x 4 file (or the red mask of a masked one);
// every prefix of a valid file is refused without reading past the bytes given.
TEST(BmpDecode, RefusalsSayWhatTheFileShouldHaveBeen)
{
    const struct {
        size_t at;
        uint32_t value;
        bool wide;
        const char* expected;
    } cases[] = {
        {28, 8, false, "24 or 32 bits"},       {30, 1, true, "uncompressed"},
        {0, 'P' | 'M' << 8, false, "starts with \"BM\""}, {18, 0, true, "positive width"},
        {10, 0xFFFFFFF0u, true, "cut short"},  {22, 0x80000000u, true, "non-zero height"},
        {30, 3, true, "uncompressed"},  // bit fields whose red mask is blue's
    };
    for (const auto& c : cases) {
        std::vector<unsigned char> file = BmpFile(4, 4, c.value == 3 ? 32 : 24);
        c.wide ? PutU32(file, c.at, c.value) : PutU16(file, c.at, c.value);
        _DorBitmap bitmap;
        std::string expected;
        EXPECT_FALSE(DecodeBmp(file, bitmap, expected)) << c.expected;
        EXPECT_NE(expected.find(c.expected), std::string::npos) << expected;
    }
    std::vector<unsigned char> file = BmpFile(4, 2, 24);
    for (size_t n = 0; n < file.size(); ++n) {
        _DorBitmap bitmap;
        std::string expected;
        EXPECT_FALSE(DecodeBmp(std::vector<unsigned char>(file.begin(), file.begin() + n), bitmap, expected)) << n;
        EXPECT_NE(expected.find(n == file.size() - 1 ? "cut short" : ""), std::string::npos) << expected;
        EXPECT_FALSE(expected.empty());
    }
}

// Top row first, in red, green, blue order; only whole 24-bit bitmaps convert.
TEST(PngFile, WrittenFileReadsBackPixelForPixel)
{
    viewer_test::ScratchDir dir("png_file_test");
    _DorBitmap bitmap;
    std::string ignored;
    ASSERT_TRUE(DecodeBmp(BmpFile(33, 17, 24), bitmap, ignored));  // green counts rows up from the bottom
    ASSERT_TRUE(WritePng(dir.Path("g.png"), bitmap));
    int width = 0, height = 0, channels = 0;
    unsigned char* pixels = stbi_load(dir.Path("g.png").c_str(), &width, &height, &channels, 3);
    ASSERT_NE(pixels, nullptr);
    EXPECT_TRUE(width == 33 && height == 17);
    for (int i = 0; i < 33 * 17; ++i)
        EXPECT_TRUE(pixels[3 * i] == 200 && pixels[3 * i + 1] == 16 - i / 33 && pixels[3 * i + 2] == i % 33) << i;
    stbi_image_free(pixels);
    EXPECT_FALSE(WritePng(dir.Path("missing/folder/g.png"), bitmap));

    _DorBitmap deep = bitmap, cut = bitmap;
    deep.info.bitCount = 32;
    cut.bits.SetSize(cut.bits.GetSize() - 1);
    EXPECT_TRUE(BitmapToRgbRows(deep).empty() && BitmapToRgbRows(cut).empty() && BitmapToRgbRows(_DorBitmap()).empty());
}
