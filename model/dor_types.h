#pragma once
// Value types of the foundation library. Their field order and widths are the library's binary
// interface (pinned in layout_asserts.cpp).
//
// Conventions used throughout the library:
// - model units are double precision; angles at the interfaces are degrees;
// - DorMatrix4x4 is row-major, points are row vectors (p' = p * M), the translation sits in
//   row 3, and A * B applies A first (the memory order of an OpenGL matrix);
// - the world's up axis is +Z;
// - lengths below 0.0001 count as zero; 1e-6 is the snapping and collinearity tolerance.
#include "../model/dor_array.h"

#include <cstdint>

struct DorVector2 {
    int dimension;  // always 2; carried along, never tested
    double x, y;

    DorVector2() : dimension(2), x(0), y(0) {}
    DorVector2(double x_, double y_) : dimension(2), x(x_), y(y_) {}
};

struct DorVector3 {
    int dimension;  // always 3; carried along, never tested
    double x, y, z;

    DorVector3() : dimension(3), x(0), y(0), z(0) {}
    DorVector3(double x_, double y_, double z_) : dimension(3), x(x_), y(y_), z(z_) {}
};

struct DorMatrix4x4 {
    double m[4][4];  // m[row][column]

    DorMatrix4x4()  // identity
    {
        for (int r = 0; r < 4; ++r)
            for (int c = 0; c < 4; ++c)
                m[r][c] = r == c ? 1.0 : 0.0;
    }
};

struct DorColorValue {
    float r, g, b, a;

    DorColorValue() : r(1.0f), g(1.0f), b(1.0f), a(1.0f) {}
    DorColorValue(float r_, float g_, float b_, float a_) : r(r_), g(g_), b(b_), a(a_) {}
};

// Copied as one block of 17 words. A diffuse alpha below 1 makes a group transparent;
// emission is carried along but never drawn.
struct _DorMaterial {
    DorColorValue diffuse;
    DorColorValue ambient;
    DorColorValue specular;
    DorColorValue emission;
    float shininess;  // OpenGL specular exponent, 0..128

    _DorMaterial() : shininess(0.0f) {}
};

struct DorLight {
    int type;  // 0 positional, 1 directional; other values keep the stored kind
    DorColorValue diffuse;
    DorColorValue ambient;
    DorColorValue specular;
    DorVector3 position;   // model units, positional lights
    DorVector3 direction;  // the way a directional light shines; need not be unit length
    int enabled;
    float attenuation;  // linear attenuation of a positional light

    DorLight() : type(1), enabled(0), attenuation(0.0f) {}
};

// Window pixels; the corners may come in either order.
struct _DORRECT {
    int left, top, right, bottom;

    int Width() const { return left > right ? left - right : right - left; }
    int Height() const { return top > bottom ? top - bottom : bottom - top; }
};

// Field for field the Windows BITMAPINFOHEADER.
struct DorBitmapInfoHeader {
    uint32_t size;  // 40
    int32_t width;
    int32_t height;  // positive: bottom-up rows
    uint16_t planes;
    uint16_t bitCount;
    uint32_t compression;
    uint32_t sizeImage;
    int32_t xPelsPerMeter;
    int32_t yPelsPerMeter;
    uint32_t clrUsed;
    uint32_t clrImportant;
};

// One palette entry, in the byte order of the Windows RGBQUAD.
struct DorRgbQuad {
    uint8_t blue, green, red, reserved;
};

// An in-memory Windows bitmap: the file header fields, the information header, the palette and
// the pixel rows (bottom row first, each row padded to 4 bytes, blue-green-red).
struct _DorBitmap {
    uint16_t type;  // "BM"
    uint32_t fileSize;  // pixel bytes + palette bytes + 54
    uint16_t reserved1;
    uint16_t reserved2;
    uint32_t offBits;  // 54
    DorBitmapInfoHeader info;
    CDorArray<DorRgbQuad, const DorRgbQuad&> palette;
    CDorArray<unsigned char, unsigned char> bits;

    _DorBitmap()
        : type(0x4D42), fileSize(54), reserved1(0), reserved2(0), offBits(54),
          info{40, 0, 0, 1, 24, 0, 0, 0, 0, 0, 0}
    {
    }
};

// Bytes in one pixel row of a bitmap: bits per row rounded up to whole 4-byte words.
inline int DorBitmapRowBytes(int width, int bitCount)
{
    return static_cast<int>(((static_cast<long long>(width) * bitCount + 31) / 32) * 4);
}

// The opaque entity handle: the address of a CDorList node.
struct _DorPosition;
