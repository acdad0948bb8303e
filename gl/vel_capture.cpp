#include "gl/vel_capture.h"

#include <climits>
#include <cstring>
#include <new>

bool VelCaptureSizeAllowed(int width, int height, int maxWidth, int maxHeight)
{
    return width > 0 && height > 0 && width <= maxWidth && height <= maxHeight &&
           static_cast<long long>(width) * height <= VelCaptureMaxPixels;
}

void VelBeginCaptureBitmap(_DorBitmap& bitmap)
{
    bitmap.type = 0x4D42;
    bitmap.fileSize = 0;
    bitmap.reserved1 = 0;
    bitmap.reserved2 = 0;
    bitmap.offBits = 54;
    bitmap.info = DorBitmapInfoHeader{40, 0, 0, 1, 24, 0, 0, 0, 0, 0, 0};
}

namespace {
// 24-bit rows padded to 4 bytes, times height, in a width that cannot overflow; -1 when the
// count is not positive or no int holds it.
long long CaptureBytes(int width, int height)
{
    const long long bytes = (static_cast<long long>(width) * 3 + 3) / 4 * 4 * height;
    return width > 0 && height > 0 && bytes <= INT_MAX ? bytes : -1;
}
}  // namespace

bool VelReserveCaptureBits(_DorBitmap& bitmap, int width, int height)
{
    const long long bytes = CaptureBytes(width, height);
    if (bytes < 0)
        return false;
    try {
        bitmap.bits.SetSize(static_cast<int>(bytes));
    } catch (const std::bad_alloc&) {
        return false;
    }
    return true;
}

void VelEmptyCaptureBitmap(_DorBitmap& bitmap)
{
    VelBeginCaptureBitmap(bitmap);
    bitmap.bits.SetSize(0);
    bitmap.palette.SetSize(0);
    bitmap.fileSize = 54;
}

void VelCompleteCaptureBitmap(_DorBitmap& bitmap, int width, int height, const unsigned char* rows32)
{
    const long long bytes = CaptureBytes(width, height);
    if (bytes < 0) {
        VelEmptyCaptureBitmap(bitmap);
        return;
    }
    const int pixelBytes = static_cast<int>(bytes);
    const int rowBytes = pixelBytes / height;
    bitmap.info.bitCount = 24;
    bitmap.info.width = width;
    bitmap.info.height = height;
    bitmap.bits.SetSize(pixelBytes);
    bitmap.palette.SetSize(0);
    bitmap.fileSize = static_cast<uint32_t>(pixelBytes) + 54;
    unsigned char* out = bitmap.bits.GetData();
    for (int row = 0; row < height; ++row) {
        const unsigned char* in = rows32 + static_cast<size_t>(row) * width * 4;
        unsigned char* o = out + static_cast<size_t>(row) * rowBytes;
        for (int col = 0; col < width; ++col) {
            o[3 * col + 0] = in[4 * col + 0];
            o[3 * col + 1] = in[4 * col + 1];
            o[3 * col + 2] = in[4 * col + 2];
        }
        std::memset(o + 3 * width, 0, static_cast<size_t>(rowBytes - 3 * width));
    }
}
