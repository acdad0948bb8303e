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

// Top row first, in red, green, blue order.
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
    for (int y = 0; y < 17; ++y)  // rows top first, padded 99-byte rows read at their stride
        for (int x = 0; x < 33; ++x) {
            const unsigned char* p = &pixels[(y * 33 + x) * 3];
            EXPECT_EQ(p[0] * 10000 + p[1] * 100 + p[2], x * 10000 + y * 100 + 7) << x << "," << y;
        }
    stbi_image_free(pixels);

    EXPECT_FALSE(WritePng(dir.Path("missing/folder/g.png"), bitmap));
}
