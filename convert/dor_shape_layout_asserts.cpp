// The shape classes' field order and widths are part of the binary interface: hosts fill the
// fields directly. Any change here is a breaking change.
#include "convert/dor_shape.h"
#include "model/dor_layout_check.h"

// NOTE: Microsoft's 32-bit ABI pads the virtual table pointer to the class's alignment (8, for
// its doubles); GCC's does not. The fields from textureScaleU on agree again.
KARVEL_FIELD(CDorGeometry, tag, KARVEL_PICK_ABI(4, 8, 8, 8));
KARVEL_FIELD(CDorGeometry, kind, KARVEL_PICK_ABI(8, 12, 12, 12));
KARVEL_FIELD(CDorGeometry, material, KARVEL_PICK_ABI(12, 16, 16, 16));
KARVEL_FIELD(CDorGeometry, style, KARVEL_PICK_ABI(80, 84, 84, 84));
KARVEL_FIELD(CDorGeometry, textureScaleU, 88);
KARVEL_FIELD(CDorGeometry, textureScaleV, 96);
KARVEL_FIELD(CDorGeometry, texture, 104);
KARVEL_SIZE(CDorGeometry, 112);

KARVEL_FIELD(CDorPolygon, points, 112);
KARVEL_FIELD(CDorPolygon, textureAxis, KARVEL_PICK(128, 136));
KARVEL_FIELD(CDorPolygon, textureOrigin, KARVEL_PICK(160, 168));
KARVEL_SIZE(CDorPolygon, KARVEL_PICK(192, 200));

KARVEL_FIELD(CDorHolePolygon, points, 112);
KARVEL_FIELD(CDorHolePolygon, textureAxis, KARVEL_PICK(128, 136));
KARVEL_FIELD(CDorHolePolygon, textureOrigin, KARVEL_PICK(160, 168));
KARVEL_FIELD(CDorHolePolygon, holes, KARVEL_PICK(192, 200));
KARVEL_FIELD(CDorHolePolygon, holeTextureAxis, KARVEL_PICK(208, 224));
KARVEL_FIELD(CDorHolePolygon, holeTextureOrigin, KARVEL_PICK(240, 256));
KARVEL_SIZE(CDorHolePolygon, KARVEL_PICK(272, 288));

KARVEL_FIELD(CDorExtruded, bottom, 112);
KARVEL_FIELD(CDorExtruded, top, KARVEL_PICK(304, 312));
KARVEL_FIELD(CDorExtruded, bottomCap, KARVEL_PICK(496, 512));
KARVEL_FIELD(CDorExtruded, topCap, KARVEL_PICK(500, 516));
KARVEL_FIELD(CDorExtruded, textureAxis, KARVEL_PICK(504, 520));
KARVEL_SIZE(CDorExtruded, KARVEL_PICK(536, 552));

KARVEL_FIELD(CDorHoleExtruded, bottom, 112);
KARVEL_FIELD(CDorHoleExtruded, top, KARVEL_PICK(384, 400));
KARVEL_FIELD(CDorHoleExtruded, bottomCap, KARVEL_PICK(656, 688));
KARVEL_FIELD(CDorHoleExtruded, topCap, KARVEL_PICK(660, 692));
KARVEL_FIELD(CDorHoleExtruded, textureAxis, KARVEL_PICK(664, 696));
KARVEL_SIZE(CDorHoleExtruded, KARVEL_PICK(696, 728));

KARVEL_FIELD(CDorShape, geometries, KARVEL_PICK(4, 8));
