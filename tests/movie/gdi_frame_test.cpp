// Reading GDI bitmaps at every depth is checked through the recorders in vfw_math_movie_test.cpp;
// what only shows here is the frame left empty when there is nothing to read.
#include <gtest/gtest.h>
#include <windows.h>

#include "model/dor_bitmap.h"
#include "movie/gdi_frame.h"

TEST(GdiFrame, NoBitmapOrADeletedOneGivesAnEmptyFrame)
{
    HBITMAP deleted = CreateBitmap(4, 4, 1, 32, nullptr);
    DeleteObject(deleted);
    for (HBITMAP bitmap : {HBITMAP(nullptr), deleted}) {
        _DorBitmap frame;
        DorBitmapAllocate(frame, 4, 4, 24);
        EXPECT_FALSE(VelReadGdiBitmap(bitmap, frame));
        EXPECT_EQ(frame.bits.GetSize(), 0);
    }
}
