#include "model/dor_bitmap.h"

#include <climits>

bool DorBitmapAllocate(_DorBitmap& bitmap, int width, int height, int bitCount)
{
    bitmap = _DorBitmap();
    bool sane = bitCount >= 1 && bitCount <= 32 && width >= 0 && width <= (INT_MAX - 31) / 32 &&
                height != INT_MIN;
    if (!sane)
        return false;
    int entries = bitCount <= 8 ? 1 << bitCount : 0;
    long long rows = height < 0 ? -static_cast<long long>(height) : height;
    long long pixelBytes = DorBitmapRowBytes(width, bitCount) * rows;
    if (pixelBytes > INT_MAX - 54 - 4 * entries)
        return false;

    bitmap.info.width = width;
    bitmap.info.height = height;
    bitmap.info.bitCount = static_cast<uint16_t>(bitCount);
    bitmap.palette.SetSize(entries);
    bitmap.bits.SetSize(static_cast<int>(pixelBytes));
    bitmap.fileSize = static_cast<uint32_t>(pixelBytes + 4 * entries + 54);
    return true;
}
