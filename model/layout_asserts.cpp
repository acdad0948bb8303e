// The records' field order and widths are the library's binary interface: hosts built against
// one release must be able to load another. Any change here is a breaking change.
#include "model/dor_layout_check.h"
#include "model/dor_list.h"
#include "model/dor_types.h"
#include "model/platform.h"
#include "model/vel_primitive.h"

static_assert(sizeof(void*) == KARVEL_PICK(4, 8), "layout table does not match this target");

KARVEL_FIELD(DorVector2, dimension, 0);
KARVEL_FIELD(DorVector2, x, 8);
KARVEL_FIELD(DorVector2, y, 16);
KARVEL_SIZE(DorVector2, 24);

KARVEL_FIELD(DorVector3, dimension, 0);
KARVEL_FIELD(DorVector3, x, 8);
KARVEL_FIELD(DorVector3, y, 16);
KARVEL_FIELD(DorVector3, z, 24);
KARVEL_SIZE(DorVector3, 32);

KARVEL_SIZE(DorMatrix4x4, 128);

KARVEL_FIELD(DorColorValue, r, 0);
KARVEL_FIELD(DorColorValue, g, 4);
KARVEL_FIELD(DorColorValue, b, 8);
KARVEL_FIELD(DorColorValue, a, 12);
KARVEL_SIZE(DorColorValue, 16);

KARVEL_FIELD(_DorMaterial, diffuse, 0);
KARVEL_FIELD(_DorMaterial, ambient, 16);
KARVEL_FIELD(_DorMaterial, specular, 32);
KARVEL_FIELD(_DorMaterial, emission, 48);
KARVEL_FIELD(_DorMaterial, shininess, 64);
KARVEL_SIZE(_DorMaterial, 17 * 4);

KARVEL_FIELD(DorLight, type, 0);
KARVEL_FIELD(DorLight, diffuse, 4);
KARVEL_FIELD(DorLight, ambient, 20);
KARVEL_FIELD(DorLight, specular, 36);
KARVEL_FIELD(DorLight, position, 56);
KARVEL_FIELD(DorLight, direction, 88);
KARVEL_FIELD(DorLight, enabled, 120);
KARVEL_FIELD(DorLight, attenuation, 124);
KARVEL_SIZE(DorLight, 128);

KARVEL_FIELD(_DORRECT, left, 0);
KARVEL_FIELD(_DORRECT, top, 4);
KARVEL_FIELD(_DORRECT, right, 8);
KARVEL_FIELD(_DORRECT, bottom, 12);
KARVEL_SIZE(_DORRECT, 16);

KARVEL_FIELD(DorBitmapInfoHeader, width, 4);
KARVEL_FIELD(DorBitmapInfoHeader, height, 8);
KARVEL_FIELD(DorBitmapInfoHeader, planes, 12);
KARVEL_FIELD(DorBitmapInfoHeader, bitCount, 14);
KARVEL_FIELD(DorBitmapInfoHeader, compression, 16);
KARVEL_FIELD(DorBitmapInfoHeader, clrImportant, 36);
KARVEL_SIZE(DorBitmapInfoHeader, 40);
KARVEL_SIZE(DorRgbQuad, 4);

typedef CDorArray<int, int> AnyArray;
KARVEL_FIELD(AnyArray, data, 0);
KARVEL_FIELD(AnyArray, size, KARVEL_PICK(4, 8));
KARVEL_FIELD(AnyArray, maxSize, KARVEL_PICK(8, 12));
KARVEL_FIELD(AnyArray, growBy, KARVEL_PICK(12, 16));
KARVEL_SIZE(AnyArray, KARVEL_PICK(16, 24));

KARVEL_FIELD(_DorBitmap, type, 0);
KARVEL_FIELD(_DorBitmap, fileSize, 4);
KARVEL_FIELD(_DorBitmap, reserved1, 8);
KARVEL_FIELD(_DorBitmap, reserved2, 10);
KARVEL_FIELD(_DorBitmap, offBits, 12);
KARVEL_FIELD(_DorBitmap, info, 16);
KARVEL_FIELD(_DorBitmap, palette, 56);
KARVEL_FIELD(_DorBitmap, bits, KARVEL_PICK(72, 80));
KARVEL_SIZE(_DorBitmap, KARVEL_PICK(88, 104));

KARVEL_FIELD(CDorList::Node, next, 0);
KARVEL_FIELD(CDorList::Node, prev, KARVEL_PICK(4, 8));
KARVEL_FIELD(CDorList::Node, data, KARVEL_PICK(8, 16));
KARVEL_FIELD(CDorList, head, 0);
KARVEL_FIELD(CDorList, tail, KARVEL_PICK(4, 8));
KARVEL_FIELD(CDorList, count, KARVEL_PICK(8, 16));
KARVEL_FIELD(CDorList, freeList, KARVEL_PICK(12, 24));
KARVEL_FIELD(CDorList, blocks, KARVEL_PICK(16, 32));
KARVEL_FIELD(CDorList, blockSize, KARVEL_PICK(20, 40));

KARVEL_FIELD(_VelVertex, position, 0);
KARVEL_FIELD(_VelVertex, normal, 32);
KARVEL_FIELD(_VelVertex, colour, 64);
KARVEL_FIELD(_VelVertex, texcoord, 80);
KARVEL_SIZE(_VelVertex, 104);

KARVEL_FIELD(_VelTriangleIndex, a, 0);
KARVEL_FIELD(_VelTriangleIndex, b, 4);
KARVEL_FIELD(_VelTriangleIndex, c, 8);
KARVEL_SIZE(_VelTriangleIndex, 12);

KARVEL_FIELD(CVelTrianglePolys, GroupType, KARVEL_PICK(4, 8));
KARVEL_FIELD(CVelTrianglePolys, material, KARVEL_PICK(8, 12));
KARVEL_FIELD(CVelTrianglePolys, vertices, KARVEL_PICK(76, 80));
KARVEL_FIELD(CVelTrianglePolys, triangles, KARVEL_PICK(92, 104));
KARVEL_FIELD(CVelTrianglePolys, RenderKind, KARVEL_PICK(108, 128));
KARVEL_FIELD(CVelTrianglePolys, lineWidth, KARVEL_PICK(112, 132));
KARVEL_FIELD(CVelTrianglePolys, texture, KARVEL_PICK(116, 136));
KARVEL_FIELD(CVelTrianglePolys, OverlayFlag, KARVEL_PICK(120, 140));
KARVEL_SIZE(CVelTrianglePolys, KARVEL_PICK(124, 144));

KARVEL_FIELD(CVelPrimitive, groups, KARVEL_PICK(4, 8));
KARVEL_FIELD(CVelPrimitive, DrawMode, KARVEL_PICK(20, 32));

#if defined(_WIN32)
static_assert(sizeof(DorBitmapInfoHeader) == sizeof(BITMAPINFOHEADER), "info header differs from Windows'");
static_assert(offsetof(DorBitmapInfoHeader, clrImportant) == offsetof(BITMAPINFOHEADER, biClrImportant),
              "info header differs from Windows'");
static_assert(sizeof(DorRgbQuad) == sizeof(RGBQUAD), "palette entry differs from Windows'");
#endif
