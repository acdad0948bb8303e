// The 24-bit bitmap a capture returns, built from 32-bit rendered rows.
#include <gtest/gtest.h>

#include <vector>

#include "gl/vel_capture.h"

// Bottom-up 32-bit rows whose pixel (col, row) is blue = col, green = row, red = 200, pad 255,
// into bits reserved beforehand and full of an earlier picture's leftovers.
TEST(CaptureBitmap, OddWidthRowsArePaddedToFourBytesInTheReservedBits)
{
    const int width = 101, height = 50;
    std::vector<unsigned char> rows(width * height * 4, 255);
    for (int i = 0; i < width * height; ++i)
        rows[4 * i] = static_cast<unsigned char>(i % width), rows[4 * i + 1] = static_cast<unsigned char>(i / width), rows[4 * i + 2] = 200;
    _DorBitmap bitmap;
    VelEmptyCaptureBitmap(bitmap);
    EXPECT_TRUE(bitmap.bits.GetSize() == 0 && bitmap.info.width == 0 && bitmap.fileSize == 54u && bitmap.info.bitCount == 24);
    VelBeginCaptureBitmap(bitmap);
    ASSERT_TRUE(VelReserveCaptureBits(bitmap, width, height));
    ASSERT_EQ(bitmap.bits.GetSize(), 304 * 50);
    for (int i = 0; i < bitmap.bits.GetSize(); ++i)
        bitmap.bits[i] = 0xAB;
    const unsigned char* reserved = bitmap.bits.GetData();
    VelCompleteCaptureBitmap(bitmap, width, height, rows.data());
    EXPECT_EQ(bitmap.bits.GetData(), reserved);  // no second allocation after the rendering
    EXPECT_TRUE(bitmap.info.width == 101 && bitmap.info.height == 50 && bitmap.info.bitCount == 24);
    EXPECT_TRUE(bitmap.bits.GetSize() == 304 * 50 && bitmap.fileSize == 15254u && bitmap.offBits == 54u);
    for (int row : {0, 17, 49}) {
        const unsigned char* r = bitmap.bits.GetData() + row * 304;
        for (int col : {0, 1, 100})
            EXPECT_TRUE(r[3 * col] == col && r[3 * col + 1] == row && r[3 * col + 2] == 200) << col << "," << row;
        EXPECT_EQ(r[303], 0);  // the padding byte
    }
}

TEST(CaptureSize, ZeroOversizedAndUnaddressableAreRefused)
{
    const struct {
        int width, height, max;
        bool allowed;
    } rows[] = {{1, 1, 16384, true}, {16384, 100, 16384, true}, {100, 16384, 16384, true}, {0, 10, 16384, false},
                {10, 0, 16384, false}, {16385, 10, 16384, false}, {10, 16385, 16384, false},
                {30000, 30000, 65536, false},  // 3.6 GB of rows
                {10, 10, 0, false}};           // no context to ask
    for (const auto& r : rows)
        EXPECT_EQ(VelCaptureSizeAllowed(r.width, r.height, r.max, r.max), r.allowed) << r.width << "x" << r.height;
}
