// Frames read from GDI bitmaps: DIB sections of known pixels and device bitmaps drawn with GDI.
#include <gtest/gtest.h>
#include <windows.h>

#include <cstring>

#include "model/dor_bitmap.h"
#include "movie/gdi_frame.h"
#include "support/gdi_test_bitmap.h"

namespace {

_DorBitmap Gradient(int width, int height, int bitCount)
{
    _DorBitmap b;
    DorBitmapAllocate(b, width, height, bitCount);
    int rowBytes = DorBitmapRowBytes(width, bitCount);
    int used = width * bitCount / 8;  // whole bytes only: padding bits are not the bitmap's to keep
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < used; ++x)
            b.bits[y * rowBytes + x] = static_cast<unsigned char>(x * 5 + y * 11);
    for (int i = 0; i < b.palette.GetSize(); ++i)
        b.palette[i] = DorRgbQuad{uint8_t(255 - i), uint8_t(i), uint8_t(i * 7), 0};
    return b;
}

bool SamePixels(const _DorBitmap& a, const _DorBitmap& b)
{
    return a.bits.GetSize() == b.bits.GetSize() &&
           std::memcmp(a.bits.GetData(), b.bits.GetData(), a.bits.GetSize()) == 0;
}

}  // namespace

TEST(GdiFrame, DibSectionReadsBackAtItsOwnSizeAndDepth)
{
    for (int bits : {1, 8, 16, 24, 32}) {
        _DorBitmap source = Gradient(29, 13, bits);
        HBITMAP dib = CreateDibSectionOf(source);
        ASSERT_NE(dib, nullptr) << bits;
        _DorBitmap frame;
        ASSERT_TRUE(VelReadGdiBitmap(dib, frame)) << bits;
        DeleteObject(dib);
        EXPECT_EQ(frame.info.width, 29);
        EXPECT_EQ(frame.info.height, 13);  // bottom-up, as the recorders write it
        EXPECT_EQ(frame.info.bitCount, bits);
        EXPECT_TRUE(SamePixels(frame, source)) << bits << " bits";
        ASSERT_EQ(frame.palette.GetSize(), source.palette.GetSize()) << bits;
        if (source.palette.GetSize() > 0) {
            EXPECT_EQ(std::memcmp(frame.palette.GetData(), source.palette.GetData(), source.palette.GetSize() * 4), 0)
                << bits << " bits";
        }
        EXPECT_EQ(frame.fileSize, 54u + frame.bits.GetSize() + 4u * frame.palette.GetSize());
    }
}

TEST(GdiFrame, DeviceBitmapDrawnWithGdiReadsBackItsColours)
{
    HDC screen = GetDC(nullptr);
    HBITMAP device = CreateCompatibleBitmap(screen, 40, 30);
    int depth = GetDeviceCaps(screen, BITSPIXEL);
    ReleaseDC(nullptr, screen);
    ASSERT_NE(device, nullptr);
    HDC dc = CreateCompatibleDC(nullptr);
    HGDIOBJ old = SelectObject(dc, device);
    RECT all = {0, 0, 40, 30}, topLeft = {0, 0, 10, 10};
    HBRUSH blue = CreateSolidBrush(RGB(0, 0, 255)), red = CreateSolidBrush(RGB(255, 0, 0));
    FillRect(dc, &all, blue);
    FillRect(dc, &topLeft, red);
    SelectObject(dc, old);  // GetDIBits wants the bitmap out of any DC
    DeleteDC(dc);
    DeleteObject(blue);
    DeleteObject(red);

    _DorBitmap frame;
    ASSERT_TRUE(VelReadGdiBitmap(device, frame));
    DeleteObject(device);
    ASSERT_EQ(frame.info.bitCount, depth);
    ASSERT_EQ(depth, 32) << "the colour checks below assume a true-colour display";
    int rowBytes = DorBitmapRowBytes(40, 32);
    const unsigned char* topRow = frame.bits.GetData() + 29 * rowBytes;  // rows are bottom-up
    const unsigned char* bottomRow = frame.bits.GetData();
    EXPECT_EQ(topRow[2], 255);  // red, in blue-green-red order
    EXPECT_EQ(topRow[0], 0);
    EXPECT_EQ(bottomRow[0], 255);  // blue
    EXPECT_EQ(bottomRow[2], 0);
    EXPECT_EQ(topRow[4 * 20 + 0], 255);  // blue right of the red square
}

TEST(GdiFrame, NoBitmapGivesAnEmptyFrame)
{
    _DorBitmap frame;
    DorBitmapAllocate(frame, 4, 4, 24);
    EXPECT_FALSE(VelReadGdiBitmap(nullptr, frame));
    EXPECT_EQ(frame.bits.GetSize(), 0);
    HBITMAP deleted = CreateBitmap(4, 4, 1, 32, nullptr);
    DeleteObject(deleted);
    EXPECT_FALSE(VelReadGdiBitmap(deleted, frame));
    EXPECT_EQ(frame.bits.GetSize(), 0);
}
