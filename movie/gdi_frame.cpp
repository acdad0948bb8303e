#include "movie/gdi_frame.h"

#include <cstring>

#include "model/dor_bitmap.h"

namespace {

// An information header with room for the largest colour table GetDIBits can write.
struct DibInfo {
    BITMAPINFOHEADER header;
    RGBQUAD colours[256];
};

// GetDIBits through a memory DC of its own, which is gone again whatever the outcome.
bool CopyDibits(HBITMAP bitmap, _DorBitmap& frame, DibInfo& info)
{
    HDC dc = CreateCompatibleDC(nullptr);
    if (!dc)
        return false;
    int lines = GetDIBits(dc, bitmap, 0, static_cast<UINT>(frame.info.height), frame.bits.GetData(),
                          reinterpret_cast<BITMAPINFO*>(&info), DIB_RGB_COLORS);
    DeleteDC(dc);
    return lines == frame.info.height;
}

}  // namespace

bool VelReadGdiBitmap(HBITMAP bitmap, _DorBitmap& frame)
{
    frame = _DorBitmap();
    BITMAP object;
    if (!bitmap || GetObjectA(bitmap, sizeof(object), &object) != sizeof(object))
        return false;
    if (object.bmWidth <= 0 || object.bmHeight <= 0 ||
        !DorBitmapAllocate(frame, object.bmWidth, object.bmHeight, object.bmBitsPixel))
        return false;

    DibInfo info = {};
    std::memcpy(&info.header, &frame.info, sizeof(info.header));
    if (!CopyDibits(bitmap, frame, info)) {
        frame = _DorBitmap();
        return false;
    }
    if (frame.palette.GetSize() > 0)
        std::memcpy(frame.palette.GetData(), info.colours, frame.palette.GetSize() * sizeof(RGBQUAD));
    return true;
}
