#include <gtest/gtest.h>

#include "model/dor_bitmap.h"

namespace {
// Bytes a bitmap file of this record would have, counted from what the record holds.
long long FileBytesHeld(const _DorBitmap& b)
{
    return 54LL + 4LL * b.palette.GetSize() + b.bits.GetSize();
}

bool AllZero(const _DorBitmap& b)
{
    for (int i = 0; i < b.bits.GetSize(); ++i)
        if (b.bits[i] != 0)
            return false;
    return true;
}
}  // namespace

TEST(DorBitmapAllocate, OddWidthTrueColourRowsArePaddedToWords)
{
    _DorBitmap b;
    ASSERT_TRUE(DorBitmapAllocate(b, 101, 50, 24));
    EXPECT_EQ(b.bits.GetSize(), 304 * 50);  // 303 bytes of pixels per row, padded
    EXPECT_EQ(b.fileSize, 15254u);
    EXPECT_EQ(b.palette.GetSize(), 0);
    EXPECT_EQ(b.info.width, 101);
    EXPECT_EQ(b.info.height, 50);
    EXPECT_EQ(b.info.bitCount, 24);
    EXPECT_EQ(b.info.compression, 0u);
    EXPECT_EQ(b.type, 0x4D42);
    EXPECT_TRUE(AllZero(b));
}

TEST(DorBitmapAllocate, PalettedDepthsGetAFullColourTable)
{
    struct Case {
        int width, bitCount, rowBytes, entries;
    } cases[] = {{33, 1, 8, 2}, {5, 4, 4, 16}, {3, 8, 4, 256}, {9, 8, 12, 256}, {3, 16, 8, 0}, {3, 32, 12, 0}};
    for (const Case& c : cases) {
        _DorBitmap b;
        ASSERT_TRUE(DorBitmapAllocate(b, c.width, 7, c.bitCount)) << c.bitCount;
        EXPECT_EQ(b.bits.GetSize(), c.rowBytes * 7) << c.width << "x" << c.bitCount;
        EXPECT_EQ(b.palette.GetSize(), c.entries) << c.bitCount;
        EXPECT_EQ(b.fileSize, FileBytesHeld(b)) << c.bitCount;
    }
}

TEST(DorBitmapAllocate, TopDownHeightKeepsItsSignAndSizesByMagnitude)
{
    _DorBitmap b;
    ASSERT_TRUE(DorBitmapAllocate(b, 4, -5, 24));
    EXPECT_EQ(b.info.height, -5);
    EXPECT_EQ(b.bits.GetSize(), 12 * 5);
}

TEST(DorBitmapAllocate, ImpossibleRequestsLeaveAnEmptyBitmap)
{
    struct Case {
        int width, height, bitCount;
    } cases[] = {{-1, 10, 24}, {10, 10, 0}, {10, 10, 33}, {10, 10, -8}, {60000, 60000, 32}, {2147483647, 1, 1}};
    for (const Case& c : cases) {
        _DorBitmap b;
        DorBitmapAllocate(b, 8, 8, 8);  // something to be cleared
        EXPECT_FALSE(DorBitmapAllocate(b, c.width, c.height, c.bitCount)) << c.width << "x" << c.height;
        EXPECT_EQ(b.bits.GetSize(), 0);
        EXPECT_EQ(b.palette.GetSize(), 0);
        EXPECT_EQ(b.info.width, 0);
    }
}
