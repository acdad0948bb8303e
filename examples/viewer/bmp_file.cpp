#include "bmp_file.h"

#include <cstdint>
#include <cstdio>
#include <cstring>

namespace {
const size_t FileHeaderBytes = 14;
const size_t InfoHeaderBytes = 40;
const uint32_t CompressionRgb = 0;
const uint32_t CompressionBitFields = 3;

uint32_t ReadU32(const unsigned char* p) { return p[0] | (p[1] << 8) | (p[2] << 16) | (uint32_t(p[3]) << 24); }
uint16_t ReadU16(const unsigned char* p) { return static_cast<uint16_t>(p[0] | (p[1] << 8)); }

// 32-bit files are often written with explicit channel masks; only the plain BGRA order is
// the layout the texture upload reads.
bool HasBgraMasks(const std::vector<unsigned char>& bytes, uint32_t infoSize)
{
    size_t masks = FileHeaderBytes + InfoHeaderBytes;  // after the header, or inside a v4/v5 one
    if (infoSize < InfoHeaderBytes || bytes.size() < masks + 12)
        return false;
    return ReadU32(&bytes[masks]) == 0x00FF0000u && ReadU32(&bytes[masks + 4]) == 0x0000FF00u &&
           ReadU32(&bytes[masks + 8]) == 0x000000FFu;
}
}  // namespace

bool DecodeBmp(const std::vector<unsigned char>& bytes, _DorBitmap& bitmap, std::string& expected)
{
    if (bytes.size() < FileHeaderBytes + InfoHeaderBytes || bytes[0] != 'B' || bytes[1] != 'M') {
        expected = "a BMP file (it starts with \"BM\" and a 40-byte information header)";
        return false;
    }
    const unsigned char* info = &bytes[FileHeaderBytes];
    uint32_t offBits = ReadU32(&bytes[10]);
    uint32_t infoSize = ReadU32(info);
    int32_t width = static_cast<int32_t>(ReadU32(info + 4));
    int32_t height = static_cast<int32_t>(ReadU32(info + 8));
    uint16_t planes = ReadU16(info + 12);
    uint16_t bitCount = ReadU16(info + 14);
    uint32_t compression = ReadU32(info + 16);

    if (infoSize < InfoHeaderBytes || planes != 1) {
        expected = "a BMP file with a Windows information header of at least 40 bytes and 1 plane";
        return false;
    }
    if (bitCount != 24 && bitCount != 32) {
        expected = "a BMP file of 24 or 32 bits per pixel";
        return false;
    }
    bool plainLayout = compression == CompressionRgb ||
                       (bitCount == 32 && compression == CompressionBitFields && HasBgraMasks(bytes, infoSize));
    if (!plainLayout) {
        expected = "an uncompressed BMP file (blue-green-red pixels)";
        return false;
    }
    // Widths and heights beyond 65536 are no texture and would overflow the size arithmetic.
    if (width <= 0 || height == 0 || height == INT32_MIN || width > 65536 || height > 65536 || height < -65536) {
        expected = "a BMP file of positive width and non-zero height up to 65536 pixels";
        return false;
    }
    bool topDown = height < 0;
    int rows = topDown ? -height : height;
    int rowBytes = DorBitmapRowBytes(width, bitCount);
    size_t pixelBytes = static_cast<size_t>(rowBytes) * static_cast<size_t>(rows);
    if (offBits < FileHeaderBytes + infoSize || offBits > bytes.size() || bytes.size() - offBits < pixelBytes ||
        pixelBytes > 0x7FFFFFFFu) {
        expected = "a complete BMP file (its pixel rows are cut short)";
        return false;
    }

    bitmap = _DorBitmap();
    bitmap.info.width = width;
    bitmap.info.height = rows;
    bitmap.info.bitCount = bitCount;
    bitmap.info.sizeImage = static_cast<uint32_t>(pixelBytes);
    bitmap.fileSize = static_cast<uint32_t>(pixelBytes + 54);
    bitmap.bits.SetSize(static_cast<int>(pixelBytes));
    // Stored bottom row first, whatever order the file used.
    for (int r = 0; r < rows; ++r) {
        int fileRow = topDown ? rows - 1 - r : r;
        std::memcpy(&bitmap.bits[0] + static_cast<size_t>(r) * rowBytes,
                    &bytes[offBits + static_cast<size_t>(fileRow) * rowBytes], static_cast<size_t>(rowBytes));
    }
    return true;
}

bool ReadFileBytes(const std::string& path, std::vector<unsigned char>& bytes)
{
    std::FILE* file = std::fopen(path.c_str(), "rb");
    if (!file)
        return false;
    bytes.clear();
    unsigned char buffer[65536];
    size_t got;
    while ((got = std::fread(buffer, 1, sizeof buffer, file)) > 0)
        bytes.insert(bytes.end(), buffer, buffer + got);
    bool ok = !std::ferror(file);
    std::fclose(file);
    return ok;
}
