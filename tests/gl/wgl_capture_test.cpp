// ToBitmap on a live modeller: the captured pixels, the window afterwards, sizes and leaks.
#include <gtest/gtest.h>
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
// NOTE: under Wine GetGuiResources reads 0, so the slots are probed instead.
unsigned int NextGdiSlot()
{
    HDC probe = CreateCompatibleDC(nullptr);
    unsigned int slot = LOWORD(reinterpret_cast<UINT_PTR>(probe));
    DeleteDC(probe);
    return slot;
}
}  // namespace

// A red square up and right of the centre and a textured rectangle down left, on blue, captured
// at several sizes; then the window draws as before, and captures leak nothing.
TEST_F(LiveModeller, CapturesShowTheModelLeaveTheWindowAsItWasAndLeakNothing)
{
    DorColorValue blue(0, 0, 1, 1);
    karvel.SetBkColor(blue);
    Add(Rectangle(2, 1, 6, 5, 0, Matte(1, 0, 0)));
    Add(Rectangle(-6, -4, -2, -2, 0, Matte(1, 0, 0), true));
    auto take = [&](int left, int top, int right, int bottom) {
        _DORRECT rect = {left, top, right, bottom};
        _DorBitmap bitmap;
        karvel.ToBitmap(bitmap, rect);
        return bitmap;
    };
    karvel.DrawModel(window.dc);
    Rgb before = At(4, 3);
    // Odd width (padded rows), corners in the other order away from the origin, larger than
    // the window; then sizes that give an empty bitmap.
    const int rects[][4] = {{0, 0, 101, 50}, {301, 250, 200, 200}, {0, 0, 640, 480}, {0, 0, 0, 50}, {0, 0, 100000, 10}};
    // Model points (x, 0, z): the square, black and white texels, and beside the square and mirrored.
    const struct {
        double x, z;
        char colour;
    } spots[] = {{4, 3, 'r'}, {-5, -3, 'r'}, {-3, -3, 'k'}, {1.5, 3, 'b'}, {6.5, 3, 'b'},
                 {4, 0.5, 'b'}, {4, 5.5, 'b'}, {-4, 3, 'b'}, {4, -3, 'b'}};
    for (const auto& r : rects) {
        _DorBitmap bitmap = take(r[0], r[1], r[2], r[3]);
        int w = std::abs(r[2] - r[0]), h = std::abs(r[3] - r[1]);
        SCOPED_TRACE(testing::Message() << w << "x" << h);
        EXPECT_EQ(karvel.GetCurrent(), window.dc);
        if (w == 0 || w > 10000) {
            EXPECT_EQ(bitmap.bits.GetSize() + bitmap.info.width, 0);
            continue;
        }
        ASSERT_EQ(bitmap.info.width, w);
        ASSERT_EQ(bitmap.bits.GetSize(), DorBitmapRowBytes(w, 24) * h);
        for (const auto& s : spots) {
            int col = static_cast<int>(w / 2.0 + s.x / 10 * h / 2.0), row = static_cast<int>(h / 2.0 - s.z / 10 * h / 2.0);
            const unsigned char* p = bitmap.bits.GetData() + (h - 1 - row) * DorBitmapRowBytes(w, 24) + 3 * col;
            bool red = p[2] > 150 && p[0] < 30, blue = p[0] == 255 && p[2] == 0, black = p[0] < 20 && p[2] < 20;
            EXPECT_TRUE(s.colour == 'r' ? red : s.colour == 'b' ? blue : black) << s.x << ", " << s.z;
        }
    }
    karvel.DrawModel(window.dc);
    EXPECT_EQ(At(4, 3).r, before.r);
    EXPECT_EQ(At(1.5, 3).b, 255);
    EXPECT_TRUE(glIsTexture(1));  // uploaded again in the window's context

    // One leaked DIB section per capture would be 2 MB at this size.
    take(0, 0, 1024, 512);
    unsigned int slot = NextGdiSlot();
    size_t memory = CommittedBytes();
    for (int i = 0; i < 10; ++i)
        take(0, 0, 1024, 512);
    EXPECT_EQ(NextGdiSlot(), slot);
    EXPECT_LT(CommittedBytes(), memory + 4 * 1024 * 1024) << memory << " -> " << CommittedBytes();
}
