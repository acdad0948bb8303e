#include <gtest/gtest.h>

#include <cstdlib>

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

TEST(DorBitmapAllocate, RowsArePaddedToWordsAndPalettedDepthsGetAFullColourTable)
{
    struct Case {
        int width, height, bitCount, rowBytes, entries;
    } cases[] = {{101, 50, 24, 304, 0}, {33, 7, 1, 8, 2}, {5, 7, 4, 4, 16}, {3, 7, 8, 4, 256}, {9, 7, 8, 12, 256},
                 {3, 7, 16, 8, 0}, {3, 7, 32, 12, 0}, {4, -5, 24, 12, 0}};  // top-down keeps its sign
    for (const Case& c : cases) {
        _DorBitmap b;
        ASSERT_TRUE(DorBitmapAllocate(b, c.width, c.height, c.bitCount)) << c.bitCount;
        EXPECT_EQ(b.bits.GetSize(), c.rowBytes * std::abs(c.height)) << c.width << "x" << c.bitCount;
        EXPECT_EQ(b.palette.GetSize(), c.entries) << c.bitCount;
        EXPECT_EQ(b.fileSize, FileBytesHeld(b)) << c.bitCount;
        EXPECT_TRUE(b.type == 0x4D42 && b.info.compression == 0u && b.info.bitCount == c.bitCount &&
                    b.info.width == c.width && b.info.height == c.height && AllZero(b));
    }
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
