// The 24-bit bitmap a capture returns, built from 32-bit rendered rows.
#include <gtest/gtest.h>

#include <vector>

#include "gl/vel_capture.h"

namespace {
// Bottom-up 32-bit rows whose pixel (col, row) is blue = col, green = row, red = 200, pad 255.
std::vector<unsigned char> Rows32(int width, int height)
{
    std::vector<unsigned char> rows(static_cast<size_t>(width) * height * 4);
    for (int row = 0; row < height; ++row)
        for (int col = 0; col < width; ++col) {
            unsigned char* p = &rows[(static_cast<size_t>(row) * width + col) * 4];
            p[0] = static_cast<unsigned char>(col);
            p[1] = static_cast<unsigned char>(row);
            p[2] = 200;
            p[3] = 255;
        }
    return rows;
}
}  // namespace

TEST(CaptureBitmap, OddWidthRowsArePaddedToFourBytes)
{
    const int width = 101, height = 50;
    std::vector<unsigned char> rows = Rows32(width, height);
    _DorBitmap bitmap;
    bitmap.bits.SetSize(99999, 0);  // leftovers of an earlier picture
    for (int i = 0; i < bitmap.bits.GetSize(); ++i)
        bitmap.bits[i] = 0xAB;
    VelBeginCaptureBitmap(bitmap);
    VelCompleteCaptureBitmap(bitmap, width, height, rows.data());
    EXPECT_EQ(bitmap.info.width, 101);
    EXPECT_EQ(bitmap.info.height, 50);
    EXPECT_EQ(bitmap.info.bitCount, 24);
    EXPECT_EQ(bitmap.bits.GetSize(), 304 * 50);
    EXPECT_EQ(bitmap.fileSize, 15254u);
    EXPECT_EQ(bitmap.offBits, 54u);
    EXPECT_EQ(bitmap.type, 0x4D42);
    EXPECT_EQ(bitmap.palette.GetSize(), 0);
    for (int row : {0, 17, 49}) {
        const unsigned char* r = bitmap.bits.GetData() + row * 304;
        for (int col : {0, 1, 100}) {
            EXPECT_EQ(r[3 * col + 0], col);
            EXPECT_EQ(r[3 * col + 1], row);
            EXPECT_EQ(r[3 * col + 2], 200);
        }
        EXPECT_EQ(r[303], 0);  // the padding byte
    }
}

TEST(CaptureBitmap, EmptyCaptureHasAHeaderAndNoPixels)
{
    _DorBitmap bitmap;
    bitmap.bits.SetSize(10);
    bitmap.info.width = 5;
    bitmap.info.height = 2;
    VelEmptyCaptureBitmap(bitmap);
    EXPECT_EQ(bitmap.bits.GetSize(), 0);
    EXPECT_EQ(bitmap.info.width, 0);
    EXPECT_EQ(bitmap.info.height, 0);
    EXPECT_EQ(bitmap.info.bitCount, 24);
    EXPECT_EQ(bitmap.fileSize, 54u);
}

TEST(CaptureSize, ZeroOversizedAndUnaddressableAreRefused)
{
    EXPECT_TRUE(VelCaptureSizeAllowed(1, 1, 16384, 16384));
    EXPECT_TRUE(VelCaptureSizeAllowed(16384, 100, 16384, 16384));
    EXPECT_FALSE(VelCaptureSizeAllowed(0, 10, 16384, 16384));
    EXPECT_FALSE(VelCaptureSizeAllowed(10, 0, 16384, 16384));
    EXPECT_FALSE(VelCaptureSizeAllowed(16385, 10, 16384, 16384));
    EXPECT_FALSE(VelCaptureSizeAllowed(10, 16385, 16384, 16384));
    EXPECT_FALSE(VelCaptureSizeAllowed(30000, 30000, 65536, 65536));  // 3.6 GB of rows
    EXPECT_FALSE(VelCaptureSizeAllowed(10, 10, 0, 0));                 // no context to ask
}

TEST(CaptureBitmap, ReservedBitsAreTheCompletedSize)
{
    _DorBitmap bitmap;
    ASSERT_TRUE(VelReserveCaptureBits(bitmap, 101, 50));
    EXPECT_EQ(bitmap.bits.GetSize(), 15200);
    const unsigned char* reserved = bitmap.bits.GetData();
    std::vector<unsigned char> rows(101 * 50 * 4);
    VelCompleteCaptureBitmap(bitmap, 101, 50, rows.data());
    EXPECT_EQ(bitmap.bits.GetData(), reserved);  // no second allocation after the rendering
}
