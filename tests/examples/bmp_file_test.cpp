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

TEST(BmpDecode, BottomUpRowsKeepTheirOrderAndEveryPixel)
{
    _DorBitmap bitmap;
    std::string expected;
    ASSERT_TRUE(DecodeBmp(BmpFile(4, 8, 24), bitmap, expected)) << expected;
    EXPECT_EQ(bitmap.type, 0x4D42);
    EXPECT_EQ(bitmap.info.width, 4);
    EXPECT_EQ(bitmap.info.height, 8);
    EXPECT_EQ(bitmap.info.bitCount, 24);
    EXPECT_EQ(bitmap.bits.GetSize(), 12 * 8);
    EXPECT_EQ(bitmap.fileSize, 12u * 8u + 54u);
    for (int y = 0; y < 8; ++y)
        for (int x = 0; x < 4; ++x)
            EXPECT_EQ(PixelAt(bitmap, x, y), (std::vector<int>{x, y, 200})) << x << "," << y;
}

TEST(BmpDecode, TopDownRowsAreTurnedBottomUp)
{
    _DorBitmap bitmap;
    std::string expected;
    ASSERT_TRUE(DecodeBmp(BmpFile(4, -4, 32), bitmap, expected)) << expected;
    EXPECT_EQ(bitmap.info.height, 4);
    EXPECT_EQ(bitmap.info.bitCount, 32);
    EXPECT_EQ(PixelAt(bitmap, 3, 0), (std::vector<int>{3, 0, 200}));
    EXPECT_EQ(PixelAt(bitmap, 1, 3), (std::vector<int>{1, 3, 200}));
    EXPECT_EQ(bitmap.bits[3 * 4 * 4 + 3], 255);  // alpha kept
}

TEST(BmpDecode, PaddedRowsAreReadAtTheirStride)
{
    _DorBitmap bitmap;
    std::string expected;
    ASSERT_TRUE(DecodeBmp(BmpFile(3, 2, 24), bitmap, expected)) << expected;
    EXPECT_EQ(bitmap.bits.GetSize(), 24);  // 9 bytes padded to 12, two rows
    EXPECT_EQ(PixelAt(bitmap, 2, 1), (std::vector<int>{2, 1, 200}));
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

TEST(BmpDecode, RefusalsSayWhatTheFileShouldHaveBeen)
{
    struct Case {
        const char* what;
        std::vector<unsigned char> file;
        const char* expected;
    };
    std::vector<unsigned char> eightBit = BmpFile(4, 4, 24);
    PutU16(eightBit, 28, 8);
    std::vector<unsigned char> runLength = BmpFile(4, 4, 24);
    PutU32(runLength, 30, 1);
    std::vector<unsigned char> cutShort = BmpFile(4, 4, 24);
    cutShort.pop_back();
    std::vector<unsigned char> notBmp = BmpFile(4, 4, 24);
    notBmp[0] = 'P';
    std::vector<unsigned char> zeroWidth = BmpFile(4, 4, 24);
    PutU32(zeroWidth, 18, 0);
    std::vector<unsigned char> offsetPastEnd = BmpFile(4, 4, 24);
    PutU32(offsetPastEnd, 10, 0xFFFFFFF0u);
    std::vector<unsigned char> hugeHeight = BmpFile(4, 4, 24);
    PutU32(hugeHeight, 22, 0x80000000u);
    std::vector<Case> cases = {
        {"8 bits", eightBit, "24 or 32 bits"},
        {"run-length", runLength, "uncompressed"},
        {"cut short", cutShort, "cut short"},
        {"not BM", notBmp, "starts with \"BM\""},
        {"zero width", zeroWidth, "positive width"},
        {"offset past end", offsetPastEnd, "cut short"},
        {"INT_MIN height", hugeHeight, "non-zero height"},
    };
    for (const Case& c : cases) {
        _DorBitmap bitmap;
        std::string expected;
        EXPECT_FALSE(DecodeBmp(c.file, bitmap, expected)) << c.what;
        EXPECT_NE(expected.find(c.expected), std::string::npos) << c.what << ": " << expected;
    }
}

// Every prefix of a valid file is refused without reading past the bytes given.
TEST(BmpDecode, EveryTruncationIsRefusedSafely)
{
    std::vector<unsigned char> file = BmpFile(4, 2, 24);
    for (size_t n = 0; n < file.size(); ++n) {
        std::vector<unsigned char> prefix(file.begin(), file.begin() + n);
        _DorBitmap bitmap;
        std::string expected;
        EXPECT_FALSE(DecodeBmp(prefix, bitmap, expected)) << n;
        EXPECT_FALSE(expected.empty());
    }
}
