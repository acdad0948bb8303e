#pragma once
/// @file
/// Value types of the foundation library: vectors, matrix, colour, material, light, rectangle,
/// bitmap and the entity handle. Their field order and widths are the library's binary
/// interface (pinned in layout_asserts.cpp). They are plain values, copied member-wise, usable on
/// any thread.
///
/// Conventions used throughout the library:
/// - geometry, cameras and lights are in model units, double precision; the library attaches no
///   physical unit to them;
/// - angles at the interfaces are degrees (the camera's field of view and every camera move);
/// - window pixels count from the window's top-left corner with y growing downward wherever the
///   host gives a cursor position or a dragged rectangle; only _VelViewport uses OpenGL's
///   bottom-up y;
/// - DorMatrix4x4 is row-major, points are row vectors (p' = p * M), the translation sits in
///   row 3, and A * B applies A first (the memory order of an OpenGL matrix);
/// - the world's up axis is +Z;
/// - lengths below 0.0001 count as zero; 1e-6 is the snapping and collinearity tolerance.
#include "../model/dor_array.h"

#include <cstdint>

/// A 2-D vector or point (pixels or plane coordinates, as the operation says).
struct DorVector2 {
    int dimension;  ///< Always 2; carried along, never tested.
    ///@{
    double x, y;    ///< The coordinates.
    ///@}

    /// (0, 0).
    DorVector2() : dimension(2), x(0), y(0) {}
    /// (x_, y_).
    DorVector2(double x_, double y_) : dimension(2), x(x_), y(y_) {}
};

/// A 3-D vector or point in model units.
struct DorVector3 {
    int dimension;  ///< Always 3; carried along, never tested.
    ///@{
    double x, y, z;  ///< The coordinates; +Z is the world's up.
    ///@}

    /// (0, 0, 0).
    DorVector3() : dimension(3), x(0), y(0), z(0) {}
    /// (x_, y_, z_).
    DorVector3(double x_, double y_, double z_) : dimension(3), x(x_), y(y_), z(z_) {}
};

/// A 4 x 4 transform, row-major, applied to row vectors (see the file's conventions): the
/// translation is m[3][0..2].
struct DorMatrix4x4 {
    double m[4][4];  ///< m[row][column].

    /// The identity.
    DorMatrix4x4()
    {
        for (int r = 0; r < 4; ++r)
            for (int c = 0; c < 4; ++c)
                m[r][c] = r == c ? 1.0 : 0.0;
    }
};

/// An RGBA colour, each component 0..1 in single precision.
struct DorColorValue {
    ///@{
    float r, g, b, a;  ///< Red, green, blue, alpha (1 is opaque).
    ///@}

    /// Opaque white (1, 1, 1, 1).
    DorColorValue() : r(1.0f), g(1.0f), b(1.0f), a(1.0f) {}
    /// (r_, g_, b_, a_).
    DorColorValue(float r_, float g_, float b_, float a_) : r(r_), g(g_), b(b_), a(a_) {}
};

/// An OpenGL material, copied as one block of 17 words.
struct _DorMaterial {
    DorColorValue diffuse;   ///< Its alpha below 1 makes a group transparent: drawn without depth writes.
    DorColorValue ambient;   ///< Ambient colour; also the flat colour of an overlay group.
    DorColorValue specular;  ///< Specular colour.
    DorColorValue emission;  ///< Carried along with the material but never sent to OpenGL.
    float shininess;         ///< OpenGL specular exponent, 0..128.

    /// White colours, shininess 0. (A new group's default material is a yellow of its own.)
    _DorMaterial() : shininess(0.0f) {}
};

/// One light as the host sets and reads it (CVelKarvel::SetLight, CVelKarvel::GetLight).
struct DorLight {
    int type;                ///< 0 positional, 1 directional; other values keep the stored kind.
    DorColorValue diffuse;   ///< Diffuse colour.
    DorColorValue ambient;   ///< Ambient colour.
    DorColorValue specular;  ///< Specular colour.
    DorVector3 position;     ///< Model units; used by a positional light.
    DorVector3 direction;    ///< The way a directional light shines; need not be unit length.
    int enabled;             ///< Non-zero: the light is on.
    float attenuation;       ///< Linear attenuation of a positional light.

    /// A directional light, switched off, in white, without attenuation.
    DorLight() : type(1), enabled(0), attenuation(0.0f) {}
};

/// A rectangle in window pixels; the corners may come in either order.
struct _DORRECT {
    ///@{
    int left, top, right, bottom;  ///< The edges, in window pixels.
    ///@}

    /// |left - right|.
    int Width() const { return left > right ? left - right : right - left; }
    /// |top - bottom|.
    int Height() const { return top > bottom ? top - bottom : bottom - top; }
};

/// Field for field the Windows BITMAPINFOHEADER.
struct DorBitmapInfoHeader {
    uint32_t size;           ///< 40.
    int32_t width;           ///< Pixels.
    int32_t height;          ///< Pixels; positive: bottom-up rows.
    uint16_t planes;         ///< 1.
    uint16_t bitCount;       ///< Bits per pixel; 24 for every bitmap the library makes.
    uint32_t compression;    ///< 0 (BI_RGB) for every bitmap the library makes.
    uint32_t sizeImage;      ///< As in BITMAPINFOHEADER; the library writes 0.
    int32_t xPelsPerMeter;   ///< As in BITMAPINFOHEADER; the library writes 0.
    int32_t yPelsPerMeter;   ///< As in BITMAPINFOHEADER; the library writes 0.
    uint32_t clrUsed;        ///< As in BITMAPINFOHEADER.
    uint32_t clrImportant;   ///< As in BITMAPINFOHEADER.
};

/// One palette entry, in the byte order of the Windows RGBQUAD.
struct DorRgbQuad {
    ///@{
    uint8_t blue, green, red, reserved;  ///< The colour; reserved is 0.
    ///@}
};

/// An in-memory Windows bitmap: the file header fields, the information header, the palette and
/// the pixel rows (bottom row first, each row padded to 4 bytes, blue-green-red). Textures,
/// ToBitmap and the movie recorders exchange images in it. It owns its arrays; copies are deep.
struct _DorBitmap {
    uint16_t type;               ///< "BM" (0x4D42).
    uint32_t fileSize;           ///< Size of the equivalent file: pixel bytes + palette bytes + 54.
    uint16_t reserved1;          ///< 0.
    uint16_t reserved2;          ///< 0.
    uint32_t offBits;            ///< 54.
    DorBitmapInfoHeader info;    ///< Width, height, depth.
    CDorArray<DorRgbQuad, const DorRgbQuad&> palette;  ///< Empty for 24 and 32 bits.
    CDorArray<unsigned char, unsigned char> bits;      ///< The pixel rows.

    /// An empty 24-bit bitmap: headers set, width and height 0, no pixels.
    _DorBitmap()
        : type(0x4D42), fileSize(54), reserved1(0), reserved2(0), offBits(54),
          info{40, 0, 0, 1, 24, 0, 0, 0, 0, 0, 0}
    {
    }
};

/// Bytes in one pixel row of a bitmap: bits per row rounded up to whole 4-byte words.
inline int DorBitmapRowBytes(int width, int bitCount)
{
    return static_cast<int>(((static_cast<long long>(width) * bitCount + 31) / 32) * 4);
}

/// The opaque entity handle: a `_DorPosition*` is the address of a CDorList node, null for "no
/// entity". The modeller hands one out for every entity it stores; it stays valid until that
/// entity is removed (or the model emptied), whatever happens to other entities. Operations that
/// may move an entity take `_DorPosition*&` and write the new handle back. The modeller refuses a
/// handle that is not live in it; a node address is reused for a later entity, whose handle it
/// then is.
struct _DorPosition;
