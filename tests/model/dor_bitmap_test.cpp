#include <gtest/gtest.h>

#include <cstdlib>

#include "model/dor_bitmap.h"

// Rows padded to words, a full colour table for paletted depths, zeroed pixels and the file
// header a bitmap file needs; impossible requests leave the empty bitmap, previous pixels gone.
TEST(DorBitmapAllocate, PaddedRowsPaletteAndHeaderOrAnEmptyBitmap)
{
    // rowBytes < 0: refused
    const struct { int width, height, bitCount, rowBytes, entries; } cases[] = {
        {101, 50, 24, 304, 0}, {33, 7, 1, 8, 2},  {5, 7, 4, 4, 16},   {3, 7, 8, 4, 256},  {9, 7, 8, 12, 256},
        {3, 7, 16, 8, 0},      {3, 7, 32, 12, 0}, {4, -5, 24, 12, 0}, {-1, 10, 24, -1, 0}, {10, 10, 0, -1, 0},
        {10, 10, 33, -1, 0},   {10, 10, -8, -1, 0}, {60000, 60000, 32, -1, 0}, {2147483647, 1, 1, -1, 0}};
    for (const auto& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.width << "x" << c.height << "x" << c.bitCount);
        _DorBitmap b;
        DorBitmapAllocate(b, 8, 8, 8);  // something to be cleared
        bool ok = c.rowBytes > 0;
        ASSERT_EQ(DorBitmapAllocate(b, c.width, c.height, c.bitCount), ok);
        EXPECT_EQ(b.bits.GetSize(), ok ? c.rowBytes * std::abs(c.height) : 0);
        EXPECT_EQ(b.palette.GetSize(), c.entries);
        EXPECT_EQ(b.fileSize, 54u + 4 * b.palette.GetSize() + b.bits.GetSize());
        EXPECT_TRUE(b.type == 0x4D42 && b.offBits == 54u && b.reserved1 == 0 && b.reserved2 == 0 && b.info.compression == 0u);
        EXPECT_TRUE(ok ? b.info.bitCount == c.bitCount && b.info.width == c.width && b.info.height == c.height
                       : b.info.width == 0);
        for (int i = 0; i < b.bits.GetSize(); ++i)
            ASSERT_EQ(b.bits[i], 0);
    }
}
