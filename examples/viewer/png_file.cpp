#include "png_file.h"

#define STB_IMAGE_WRITE_IMPLEMENTATION
#include <stb/stb_image_write.h>

std::vector<unsigned char> BitmapToRgbRows(const _DorBitmap& bitmap)
{
    int width = bitmap.info.width, height = bitmap.info.height;
    if (bitmap.info.bitCount != 24 || width <= 0 || height <= 0)
        return {};
    int rowBytes = DorBitmapRowBytes(width, 24);
    if (static_cast<long long>(rowBytes) * height > bitmap.bits.GetSize())
        return {};
    std::vector<unsigned char> rgb(static_cast<size_t>(width) * 3 * static_cast<size_t>(height));
    const unsigned char* bits = bitmap.bits.GetData();
    for (int y = 0; y < height; ++y) {
        const unsigned char* from = bits + static_cast<size_t>(height - 1 - y) * rowBytes;  // bottom-up
        unsigned char* to = &rgb[static_cast<size_t>(y) * width * 3];
        for (int x = 0; x < width; ++x) {
            to[3 * x + 0] = from[3 * x + 2];
            to[3 * x + 1] = from[3 * x + 1];
            to[3 * x + 2] = from[3 * x + 0];
        }
    }
    return rgb;
}

bool WritePng(const std::string& path, const _DorBitmap& bitmap)
{
    std::vector<unsigned char> rgb = BitmapToRgbRows(bitmap);
    if (rgb.empty())
        return false;
    int width = bitmap.info.width;
    return stbi_write_png(path.c_str(), width, bitmap.info.height, 3, rgb.data(), width * 3) != 0;
}
