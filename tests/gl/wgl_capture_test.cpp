// ToBitmap on a live modeller: the captured pixels, the window afterwards, sizes and leaks.
#include <gtest/gtest.h>
#include <windows.h>

#include <cstdint>
#include <cstdlib>

#include "support/gl_live_modeller.h"

namespace {
// Committed memory of the whole address space.
// NOTE: under Wine the process memory counters read 0, so the pages are counted here.
size_t CommittedBytes()
{
    size_t total = 0;
    MEMORY_BASIC_INFORMATION info;
    for (const char* p = nullptr; VirtualQuery(p, &info, sizeof(info)) == sizeof(info);) {
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

// A red square up and right of the centre and a textured rectangle down left, on blue.
class Capture : public LiveModeller {
protected:
    void SetUp() override
    {
        LiveModeller::SetUp();
        DorColorValue blue(0, 0, 1, 1);
        karvel.SetBkColor(blue);
        Add(Rectangle(2, 1, 6, 5, 0, Matte(1, 0, 0)));
        Add(Rectangle(-6, -4, -2, -2, 0, Matte(1, 0, 0), true));
    }

    _DorBitmap Take(int left, int top, int right, int bottom)
    {
        _DORRECT rect = {left, top, right, bottom};
        _DorBitmap bitmap;
        karvel.ToBitmap(bitmap, rect);
        return bitmap;
    }
};

TEST_F(Capture, PicturesOfEachSizeShowTheModelAndTheWindowDrawsAsBefore)
{
    Rgb before = Draw(4, 3);
    // Odd width (padded rows), corners in the other order away from the origin, larger than
    // the window; then sizes that give an empty bitmap.
    const int rects[][4] = {{0, 0, 101, 50}, {301, 250, 200, 200}, {0, 0, 640, 480}, {0, 0, 0, 50}, {0, 0, 100000, 10}};
    for (const auto& r : rects) {
        _DorBitmap bitmap = Take(r[0], r[1], r[2], r[3]);
        int w = std::abs(r[2] - r[0]), h = std::abs(r[3] - r[1]);
        SCOPED_TRACE(testing::Message() << w << "x" << h);
        EXPECT_EQ(karvel.GetCurrent(), window.dc);
        if (w == 0 || w > 10000) {
            EXPECT_EQ(bitmap.bits.GetSize() + bitmap.info.width, 0);
            continue;
        }
        ASSERT_EQ(bitmap.info.width, w);
        ASSERT_EQ(bitmap.bits.GetSize(), DorBitmapRowBytes(w, 24) * h);
        // Model point (x, 0, z) in the picture, as a red, blue or black (white texel) pixel.
        auto expect = [&](double x, double z, char colour) {
            int col = static_cast<int>(w / 2.0 + x / 10 * h / 2.0), row = static_cast<int>(h / 2.0 - z / 10 * h / 2.0);
            const unsigned char* p = bitmap.bits.GetData() + (h - 1 - row) * DorBitmapRowBytes(w, 24) + 3 * col;
            bool red = p[2] > 150 && p[0] < 30, blue = p[0] == 255 && p[2] == 0, black = p[0] < 20 && p[2] < 20;
            EXPECT_TRUE(colour == 'r' ? red : colour == 'b' ? blue : black) << x << ", " << z << " " << colour;
        };
        expect(4, 3, 'r');
        expect(-5, -3, 'r');  // the black texels show the lit red
        expect(-3, -3, 'k');  // the white ones blend it away
        const double beside[][2] = {{1.5, 3}, {6.5, 3}, {4, 0.5}, {4, 5.5}, {-4, 3}, {4, -3}};  // and mirrored
        for (const auto& spot : beside)
            expect(spot[0], spot[1], 'b');
    }
    _VelCamera camera;
    karvel.GetCamera(camera);
    EXPECT_DOUBLE_EQ(camera.aspect, static_cast<double>(kWidth) / kHeight);
    Rgb after = Draw(4, 3);
    EXPECT_EQ(after.r, before.r);
    EXPECT_EQ(At(1.5, 3).b, 255);
    EXPECT_TRUE(glIsTexture(1));  // uploaded again in the window's context
}

// One leaked DIB section per capture would be 1 MB at this size, a leaked context far more.
TEST_F(Capture, CapturesLeaveGdiObjectsAndMemoryFlat)
{
    Take(0, 0, 512, 512);
    DWORD gdiObjects = GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS);
    unsigned int slot = NextGdiSlot();
    size_t memory = CommittedBytes();
    for (int i = 0; i < 10; ++i)
        Take(0, 0, 512, 512);
    EXPECT_EQ(GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS), gdiObjects);
    EXPECT_EQ(NextGdiSlot(), slot);
    EXPECT_LT(CommittedBytes(), memory + 4 * 1024 * 1024) << memory << " -> " << CommittedBytes();
}
