// BMP textures read by the viewer.
#include <gtest/gtest.h>

#include <cstdlib>

#include "bmp_file.h"
#include "viewer_test_support.h"

using viewer_test::BmpFile;

// Bottom-up and top-down rows, padded rows and 32 bits: every pixel lands where BmpFile put it,
// rows stored bottom-up at their padded stride.
TEST(BmpFile, PixelsAreReadBottomUpAtTheirStride)
{
    const struct {
        int width, height, bitCount, stride;
    } cases[] = {{33, 17, 24, 100}, {4, -4, 32, 16}};
    for (const auto& c : cases) {
        _DorBitmap bitmap;
        std::string expected;
        ASSERT_TRUE(DecodeBmp(BmpFile(c.width, c.height, c.bitCount), bitmap, expected)) << expected;
        const int rows = std::abs(c.height), pixel = c.bitCount / 8;
        EXPECT_TRUE(bitmap.info.width == c.width && bitmap.info.height == rows && bitmap.bits.GetSize() == c.stride * rows);
        for (int i = 0; i < rows * c.width; ++i) {
            const unsigned char* p = &bitmap.bits[i / c.width * c.stride + i % c.width * pixel];
            EXPECT_TRUE(p[0] == i % c.width && p[1] == i / c.width && p[2] == 200 && (pixel == 3 || p[3] == 255)) << c.height << ": " << i;
        }
    }
}

// Each case changes one header field of a valid 4 x 4 file; every prefix of a valid file is
// refused without reading past the bytes given.
TEST(BmpFile, RefusalsSayWhatTheFileShouldHaveBeen)
{
    const struct {
        size_t at;
        uint32_t value;
        bool wide;
        const char* expected;
    } cases[] = {{28, 8, false, "24 or 32 bits"}, {30, 1, true, "uncompressed"},        {0, 'P' | 'M' << 8, false, "starts with \"BM\""},
                 {18, 0, true, "positive width"}, {10, 0xFFFFFFF0u, true, "cut short"}, {22, 0x80000000u, true, "non-zero height"}};
    for (const auto& c : cases) {
        std::vector<unsigned char> file = BmpFile(4, 4, 24);
        c.wide ? viewer_test::PutU32(file, c.at, c.value) : viewer_test::PutU16(file, c.at, c.value);
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
        EXPECT_TRUE(n + 1 == file.size() ? expected.find("cut short") != std::string::npos : !expected.empty()) << n << ": " << expected;
    }
}
