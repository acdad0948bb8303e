#pragma once
// Ready-made line primitives: a single segment and a grid in the z = 0 plane, each appended as
// one group of separate segments (group type 1) to a primitive the caller owns.
#include "../model/dor_types.h"
#include "../model/export.h"
#include "../model/vel_primitive.h"

class KARVEL_API CVelMathPrimitive {
public:
    virtual ~CVelMathPrimitive() {}

    // Appends the segment from-to in a white material; returns the new group's index.
    static int MakeLine(DorVector3 from, DorVector3 to, CVelPrimitive& primitive);
    // Appends divisions + 1 lines parallel to X interleaved with divisions + 1 parallel to Y,
    // spanning the rectangle between the corners whatever their order, in a grey material.
    // Returns the new group's index; divisions of 0 or below -1 are refused with -1 and the
    // primitive is left untouched (-1 itself appends a group without vertices).
    static int MakeGrid(DorVector2 corner0, DorVector2 corner1, int divisions, CVelPrimitive& primitive);
};
