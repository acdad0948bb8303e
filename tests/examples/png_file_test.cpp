#include <gtest/gtest.h>

// The reading half of stb, to check what the viewer wrote.
#define STB_IMAGE_IMPLEMENTATION
#include <stb/stb_image.h>

#include "png_file.h"
#include "viewer_test_support.h"

namespace {
// A 24-bit bitmap whose pixel (x, y), y counted from the top, is red x, green y, blue 7.
_DorBitmap Gradient(int width, int height)
{
    _DorBitmap bitmap;
    bitmap.info.width = width;
    bitmap.info.height = height;
    int rowBytes = DorBitmapRowBytes(width, 24);
    bitmap.bits.SetSize(rowBytes * height);
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x) {
            unsigned char* p = &bitmap.bits[(height - 1 - y) * rowBytes + 3 * x];
            p[0] = 7;
            p[1] = static_cast<unsigned char>(y);
            p[2] = static_cast<unsigned char>(x);
        }
    return bitmap;
}
}  // namespace

TEST(PngFile, RowsComeOutTopFirstInRedGreenBlue)
{
    _DorBitmap bitmap = Gradient(5, 3);  // 15-byte rows padded to 16
    std::vector<unsigned char> rgb = BitmapToRgbRows(bitmap);
    ASSERT_EQ(rgb.size(), 5u * 3u * 3u);
    for (int y = 0; y < 3; ++y)
        for (int x = 0; x < 5; ++x) {
            const unsigned char* p = &rgb[(y * 5 + x) * 3];
            EXPECT_EQ(p[0], x);
            EXPECT_EQ(p[1], y);
            EXPECT_EQ(p[2], 7);
        }
}

TEST(PngFile, OnlyWhole24BitBitmapsConvert)
{
    _DorBitmap deep = Gradient(4, 4);
    deep.info.bitCount = 32;
    EXPECT_TRUE(BitmapToRgbRows(deep).empty());
    _DorBitmap cut = Gradient(4, 4);
    cut.bits.SetSize(cut.bits.GetSize() - 1);
    EXPECT_TRUE(BitmapToRgbRows(cut).empty());
    EXPECT_TRUE(BitmapToRgbRows(_DorBitmap()).empty());
}

TEST(PngFile, WrittenFileReadsBackPixelForPixel)
{
    viewer_test::ScratchDir dir("png_file_test");
    _DorBitmap bitmap = Gradient(33, 17);
    ASSERT_TRUE(WritePng(dir.Path("g.png"), bitmap));
    int width = 0, height = 0, channels = 0;
    unsigned char* pixels = stbi_load(dir.Path("g.png").c_str(), &width, &height, &channels, 3);
    ASSERT_NE(pixels, nullptr);
    EXPECT_EQ(width, 33);
    EXPECT_EQ(height, 17);
    EXPECT_EQ(pixels[(16 * 33 + 32) * 3 + 0], 32);  // bottom right: red x, green y
    EXPECT_EQ(pixels[(16 * 33 + 32) * 3 + 1], 16);
    EXPECT_EQ(pixels[2], 7);
    stbi_image_free(pixels);

    EXPECT_FALSE(WritePng(dir.Path("missing/folder/g.png"), bitmap));
}
