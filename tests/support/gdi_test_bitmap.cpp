#include "support/gdi_test_bitmap.h"

#include <cstring>

HBITMAP CreateDibSectionOf(const _DorBitmap& bitmap)
{
    struct {
        BITMAPINFOHEADER header;
        RGBQUAD colours[256];
    } info = {};
    std::memcpy(&info.header, &bitmap.info, sizeof(info.header));
    int entries = bitmap.palette.GetSize() < 256 ? bitmap.palette.GetSize() : 256;
    if (entries > 0)
        std::memcpy(info.colours, bitmap.palette.GetData(), entries * sizeof(RGBQUAD));
    void* pixels = nullptr;
    HBITMAP dib = CreateDIBSection(nullptr, reinterpret_cast<BITMAPINFO*>(&info), DIB_RGB_COLORS, &pixels, nullptr, 0);
    if (dib && pixels)
        std::memcpy(pixels, bitmap.bits.GetData(), bitmap.bits.GetSize());
    return dib;
}
