// The 24-bit bitmap a capture returns, built from 32-bit rendered rows.
#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <vector>

#include "gl/vel_capture.h"

// Bottom-up 32-bit rows whose pixel i is blue = column, green = row, red = 200, pad 255, copied
// into bits reserved beforehand and full of an earlier picture's leftovers; odd-width rows are
// padded with zeros to four bytes.
TEST(CaptureBitmap, OddWidthRowsArePaddedToFourBytesInTheReservedBits)
{
    std::vector<unsigned char> rows(101 * 50 * 4, 255);
    for (int i = 0; i < 101 * 50; ++i) {
        rows[4 * i] = static_cast<unsigned char>(i % 101);
        rows[4 * i + 1] = static_cast<unsigned char>(i / 101);
        rows[4 * i + 2] = 200;
    }
    _DorBitmap bitmap;
    bitmap.palette.SetSize(2);  // a bitmap handed in with a colour table leaves without one
    VelEmptyCaptureBitmap(bitmap);
    EXPECT_TRUE(bitmap.palette.GetSize() == 0 && bitmap.bits.GetSize() == 0 && bitmap.info.width == 0 && bitmap.fileSize == 54u && bitmap.info.bitCount == 24);
    ASSERT_TRUE(VelReserveCaptureBits(bitmap, 101, 50) && bitmap.bits.GetSize() == 304 * 50);
    const unsigned char* reserved = bitmap.bits.GetData();
    std::fill(bitmap.bits.GetData(), bitmap.bits.GetData() + 304 * 50, 0xAB);
    VelCompleteCaptureBitmap(bitmap, 101, 50, rows.data());
    EXPECT_TRUE(bitmap.bits.GetData() == reserved && bitmap.info.width == 101 && bitmap.info.height == 50 && bitmap.fileSize == 15254u);  // no second allocation
    for (int i = 0; i < 304 * 50; ++i) {
        const int row = i / 304, column = i % 304 / 3, part = i % 304 % 3;
        EXPECT_EQ(bitmap.bits[i], column == 101 ? 0 : part == 0 ? column : part == 1 ? row : 200) << row << "," << column;
    }
    _DorBitmap unreserved;  // completing sizes the bits itself
    VelCompleteCaptureBitmap(unreserved, 101, 50, rows.data());
    EXPECT_TRUE(unreserved.bits.GetSize() == 304 * 50 && unreserved.bits[304 * 50 - 2] == 200);
}

TEST(CaptureSize, ZeroOversizedAndUnaddressableAreRefused)
{
    const struct { int width, height, max; bool allowed; } rows[] = {
        {1, 1, 16384, true}, {16384, 16384, 16384, true}, {0, 10, 16384, false}, {10, 0, 16384, false},
        {16385, 10, 16384, false}, {10, 16385, 16384, false}, {30000, 30000, 65536, false}, {10, 10, 0, false}};
    for (const auto& r : rows)  // 30000 x 30000 would be 3.6 GB of rows; a maximum of 0: no context to ask
        EXPECT_EQ(VelCaptureSizeAllowed(r.width, r.height, r.max, r.max), r.allowed) << r.width << "x" << r.height;
    // Whose 24-bit rows no int counts, or not positive: no bits reserved, the array as it was.
    const int unreserved[][2] = {{INT_MAX, 1}, {26755, 26755}, {0, 1}, {1, -1}};
    for (const auto& size : unreserved) {
        _DorBitmap bitmap;
        bitmap.bits.SetSize(3);
        EXPECT_TRUE(!VelReserveCaptureBits(bitmap, size[0], size[1]) && bitmap.bits.GetSize() == 3) << size[0] << "x" << size[1];
        VelCompleteCaptureBitmap(bitmap, size[0], size[1], nullptr);  // nor completed: emptied
        EXPECT_TRUE(bitmap.bits.GetSize() == 0 && bitmap.info.width == 0) << size[0] << "x" << size[1];
    }
}
