// ToBitmap on a live modeller: the captured pixels, the window afterwards, sizes and leaks.
#include <gtest/gtest.h>
#include <windows.h>

#include <cstdint>
#include <cstring>

#include "gl/vel_gl_karvel.h"
#include "support/gl_live_modeller.h"

namespace {
struct Bgr {
    int b, g, r;
};

// The pixel at col, row (row 0 at the top) of a bottom-up 24-bit bitmap.
Bgr BitmapPixel(const _DorBitmap& bitmap, int col, int row)
{
    int rowBytes = DorBitmapRowBytes(bitmap.info.width, 24);
    const unsigned char* p = bitmap.bits.GetData() + (bitmap.info.height - 1 - row) * rowBytes + 3 * col;
    return Bgr{p[0], p[1], p[2]};
}

// Where the fixture's camera puts model point (x, 0, z) in a picture of width x height.
void PictureSpot(int width, int height, double x, double z, int& col, int& row)
{
    col = static_cast<int>(width / 2.0 + x / 10 * height / 2.0);
    row = static_cast<int>(height / 2.0 - z / 10 * height / 2.0);
}

// Committed memory of the whole address space.
// NOTE: under Wine the process memory counters read 0, so the pages are counted here.
size_t CommittedBytes()
{
    size_t total = 0;
    MEMORY_BASIC_INFORMATION info;
    const char* p = nullptr;
    while (VirtualQuery(p, &info, sizeof(info)) == sizeof(info)) {
        if (info.State == MEM_COMMIT)
            total += info.RegionSize;
        const char* next = static_cast<const char*>(info.BaseAddress) + info.RegionSize;
        if (next <= p)
            break;
        p = next;
    }
    return total;
}

// The slot of the next GDI handle. Freed slots are reused first, so a GDI object leaked in
// between moves it.
// NOTE: under Wine GetGuiResources reads 0; this probe is what shows a leak there.
unsigned int NextGdiSlot()
{
    HDC probe = CreateCompatibleDC(nullptr);
    unsigned int slot = LOWORD(reinterpret_cast<uintptr_t>(probe));
    DeleteDC(probe);
    return slot;
}
}  // namespace

// A red square up and right of the centre, on a blue background.
class Capture : public LiveModeller {
protected:
    void SetUp() override
    {
        LiveModeller::SetUp();
        DorColorValue blue(0, 0, 1, 1);
        karvel.SetBkColor(blue);
        Add(Rectangle(2, 1, 6, 5, 0, Matte(1, 0, 0)));
    }

    _DorBitmap Take(int left, int top, int right, int bottom)
    {
        _DORRECT rect = {left, top, right, bottom};
        _DorBitmap bitmap;
        karvel.ToBitmap(bitmap, rect);
        return bitmap;
    }

    // The square's inside is red, and the spots just beside it and its mirror images are blue.
    void ExpectPicture(const _DorBitmap& bitmap)
    {
        int w = bitmap.info.width, h = bitmap.info.height;
        int col, row;
        PictureSpot(w, h, 4, 3, col, row);
        Bgr inside = BitmapPixel(bitmap, col, row);
        EXPECT_GT(inside.r, 150) << w << "x" << h;
        EXPECT_LT(inside.b, 30);
        const double outside[][2] = {{1.5, 3}, {6.5, 3}, {4, 0.5}, {4, 5.5}, {-4, 3}, {4, -3}};
        for (const auto& spot : outside) {
            PictureSpot(w, h, spot[0], spot[1], col, row);
            Bgr c = BitmapPixel(bitmap, col, row);
            EXPECT_EQ(c.b, 255) << spot[0] << ", " << spot[1];
            EXPECT_EQ(c.r, 0) << spot[0] << ", " << spot[1];
        }
    }
};

TEST_F(Capture, OddWidthGivesPaddedRowsAndTheModelsColours)
{
    _DorBitmap bitmap = Take(0, 0, 101, 50);
    // The header fields are checked natively on the same 101 x 50 picture.
    EXPECT_EQ(bitmap.info.width, 101);
    EXPECT_EQ(bitmap.bits.GetSize(), 15200);
    for (int row = 0; row < 50; ++row)
        EXPECT_EQ(bitmap.bits[row * 304 + 303], 0) << row;  // padding
    ExpectPicture(bitmap);
    // Corners in the other order, and a position away from the origin: the same picture.
    _DorBitmap reversed = Take(301, 250, 200, 200);
    ASSERT_EQ(reversed.bits.GetSize(), bitmap.bits.GetSize());
    EXPECT_EQ(0, memcmp(reversed.bits.GetData(), bitmap.bits.GetData(), 15200));
}

TEST_F(Capture, WindowDrawsAsBeforeAfterwards)
{
    Rgb before = Draw(4, 0, 3);
    Rgb beside = Draw(1.5, 0, 3);
    HDC windowDC = window.dc;
    Take(0, 0, 101, 50);
    EXPECT_EQ(karvel.GetCurrent(), windowDC);
    _VelCamera camera;
    karvel.GetCamera(camera);
    EXPECT_DOUBLE_EQ(camera.aspect, static_cast<double>(kWidth) / kHeight);
    _VelViewport viewport;
    karvel.GetViewport(viewport);
    EXPECT_EQ(viewport.width, kWidth);
    Rgb after = Draw(4, 0, 3);
    EXPECT_EQ(after.r, before.r);
    EXPECT_EQ(after.b, before.b);
    Rgb besideAfter = Draw(1.5, 0, 3);
    EXPECT_EQ(besideAfter.b, beside.b);
}

TEST_F(Capture, LargerThanTheWindow)
{
    _DorBitmap bitmap = Take(0, 0, 640, 480);
    ASSERT_EQ(bitmap.info.width, 640);
    ASSERT_EQ(bitmap.bits.GetSize(), 640 * 3 * 480);
    ExpectPicture(bitmap);
}

TEST_F(Capture, TexturesAreUploadedIntoTheBitmapsContext)
{
    ASSERT_NO_FATAL_FAILURE(ShowHalfWhiteTexture());
    _DorBitmap bitmap = Take(0, 0, 200, 100);
    int col, row;
    PictureSpot(200, 100, -2, 0, col, row);
    EXPECT_GT(BitmapPixel(bitmap, col, row).r, 150);  // black texels show the lit red
    PictureSpot(200, 100, 2, 0, col, row);
    EXPECT_LT(BitmapPixel(bitmap, col, row).r, 20);  // white ones blend it away
    EXPECT_TRUE(glIsTexture(1));                     // and again in the window's context
}

TEST_F(Capture, ZeroOrImpossibleSizeGivesAnEmptyBitmapAndKeepsTheWindow)
{
    const int sizes[][2] = {{0, 50}, {50, 0}, {0, 0}, {100000, 10}, {10, 100000}};
    for (const auto& size : sizes) {
        _DorBitmap bitmap = Take(0, 0, size[0], size[1]);
        // The empty bitmap's header is checked natively.
        EXPECT_EQ(bitmap.bits.GetSize(), 0) << size[0] << "x" << size[1];
        EXPECT_EQ(bitmap.info.width, 0);
        EXPECT_EQ(karvel.GetCurrent(), window.dc);
    }
    EXPECT_GT(Draw(4, 0, 3).r, 150);
}

TEST_F(Capture, ThousandCapturesLeaveGdiObjectsAndMemoryFlat)
{
    for (int i = 0; i < 20; ++i)
        Take(0, 0, 64, 48);
    DWORD gdiBefore = GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS);
    unsigned int slotBefore = NextGdiSlot();
    size_t memoryBefore = CommittedBytes();
    _DorBitmap last;
    for (int i = 0; i < 1000; ++i)
        last = Take(0, 0, 64, 48);
    EXPECT_EQ(GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS), gdiBefore);
    EXPECT_EQ(NextGdiSlot(), slotBefore);
    // One leaked DIB section per call would be 12 MB; a leaked context far more.
    size_t memoryAfter = CommittedBytes();
    EXPECT_LT(memoryAfter, memoryBefore + 4 * 1024 * 1024) << memoryBefore << " -> " << memoryAfter;
    ExpectPicture(last);
    EXPECT_EQ(karvel.GetCurrent(), window.dc);
}
