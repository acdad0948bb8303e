#include <gtest/gtest.h>

#include "bmp_file.h"
#include "viewer_test_support.h"

using viewer_test::BmpFile;
using viewer_test::PutU16;
using viewer_test::PutU32;

namespace {
// Blue, green and red of pixel (x, y) of a decoded bitmap, y counted from the bottom row.
std::vector<int> PixelAt(const _DorBitmap& bitmap, int x, int y)
{
    int bytes = bitmap.info.bitCount / 8;
    int at = y * DorBitmapRowBytes(bitmap.info.width, bitmap.info.bitCount) + x * bytes;
    return {bitmap.bits[at], bitmap.bits[at + 1], bitmap.bits[at + 2]};
}
}  // namespace

// Bottom-up and top-down row order, padded rows and 32 bits: every pixel lands where
// BmpFile put it, rows stored bottom-up at their padded stride.
TEST(BmpDecode, EveryPixelIsReadBottomUpAtItsStride)
{
    struct Case {
        int width, height, bitCount, bytes;
    } cases[] = {{4, 8, 24, 12 * 8}, {4, -4, 32, 16 * 4}, {3, 2, 24, 12 * 2}};
    for (const Case& c : cases) {
        _DorBitmap bitmap;
        std::string expected;
        ASSERT_TRUE(DecodeBmp(BmpFile(c.width, c.height, c.bitCount), bitmap, expected)) << expected;
        int rows = c.height < 0 ? -c.height : c.height;
        EXPECT_EQ(bitmap.type, 0x4D42);
        EXPECT_EQ(bitmap.info.width, c.width);
        EXPECT_EQ(bitmap.info.height, rows);
        EXPECT_EQ(bitmap.info.bitCount, c.bitCount);
        EXPECT_EQ(bitmap.bits.GetSize(), c.bytes);
        EXPECT_EQ(bitmap.fileSize, c.bytes + 54u);
        if (c.bitCount == 32)
            EXPECT_EQ(bitmap.bits[c.bytes - 1], 255);  // alpha kept
        for (int y = 0; y < rows; ++y)
            for (int x = 0; x < c.width; ++x)
                EXPECT_EQ(PixelAt(bitmap, x, y), (std::vector<int>{x, y, 200})) << c.height << ": " << x << "," << y;
    }
}

TEST(BmpDecode, ThirtyTwoBitsWithPlainBgraMasksAreAccepted)
{
    std::vector<unsigned char> file = BmpFile(2, 2, 32);
    const unsigned char masks[12] = {0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0};  // red, green, blue
    std::vector<unsigned char> masked = file;
    masked.insert(masked.begin() + 54, masks, masks + 12);
    PutU32(masked, 10, 66);
    PutU32(masked, 30, 3);
    _DorBitmap bitmap;
    std::string expected;
    ASSERT_TRUE(DecodeBmp(masked, bitmap, expected)) << expected;
    EXPECT_EQ(PixelAt(bitmap, 1, 1), (std::vector<int>{1, 1, 200}));

    PutU32(masked, 54, 0x000000FF);  // red and blue swapped: not the layout textures read
    EXPECT_FALSE(DecodeBmp(masked, bitmap, expected));
    EXPECT_NE(expected.find("uncompressed"), std::string::npos);
}

// Each case changes one header field of a valid 4 x 4 file.
TEST(BmpDecode, RefusalsSayWhatTheFileShouldHaveBeen)
{
    struct Case {
        const char* what;
        size_t at;
        uint32_t value;
        bool wide;
        const char* expected;
    } cases[] = {
        {"8 bits", 28, 8, false, "24 or 32 bits"},
        {"run-length", 30, 1, true, "uncompressed"},
        {"not BM", 0, 'P' | 'M' << 8, false, "starts with \"BM\""},
        {"zero width", 18, 0, true, "positive width"},
        {"offset past end", 10, 0xFFFFFFF0u, true, "cut short"},
        {"INT_MIN height", 22, 0x80000000u, true, "non-zero height"},
    };
    for (const Case& c : cases) {
        std::vector<unsigned char> file = BmpFile(4, 4, 24);
        c.wide ? PutU32(file, c.at, c.value) : PutU16(file, c.at, c.value);
        _DorBitmap bitmap;
        std::string expected;
        EXPECT_FALSE(DecodeBmp(file, bitmap, expected)) << c.what;
        EXPECT_NE(expected.find(c.expected), std::string::npos) << c.what << ": " << expected;
    }
}

// Every prefix of a valid file is refused without reading past the bytes given, and the
// one a byte short says so.
TEST(BmpDecode, EveryTruncationIsRefusedSafely)
{
    std::vector<unsigned char> file = BmpFile(4, 2, 24);
    for (size_t n = 0; n < file.size(); ++n) {
        std::vector<unsigned char> prefix(file.begin(), file.begin() + n);
        _DorBitmap bitmap;
        std::string expected;
        EXPECT_FALSE(DecodeBmp(prefix, bitmap, expected)) << n;
        EXPECT_FALSE(expected.empty());
        if (n == file.size() - 1)
            EXPECT_NE(expected.find("cut short"), std::string::npos) << expected;
    }
}
