#pragma once
/// @file
/// CVelMathPrimitive, ready-made line primitives.
#include "../model/dor_types.h"
#include "../model/export.h"
#include "../model/vel_primitive.h"

/// Ready-made line primitives: a single segment and a grid in the z = 0 plane, each appended as
/// one group of separate segments (group type 1) to a primitive the caller owns and then adds to
/// a modeller with CVelKarvel::AddPrimitive. Groups already in the primitive are kept.
/// Stateless; any thread.
class KARVEL_API CVelMathPrimitive {
public:
    /// Only static operations; nothing to free.
    virtual ~CVelMathPrimitive() {}

    /// Appends the segment from-to (model units) in a white material; returns the new group's
    /// index (the number of groups the primitive held before).
    static int MakeLine(DorVector3 from, DorVector3 to, CVelPrimitive& primitive);
    /// Appends divisions + 1 lines parallel to X interleaved with divisions + 1 parallel to Y,
    /// spanning the rectangle between the corners (model units, at z = 0) whatever their order,
    /// in a grey material. Returns the new group's index; divisions of 0, below -1, or of
    /// 536,870,911 and more (whose 4 (divisions + 1) vertices no int counts) are refused with -1
    /// and the primitive is left untouched (-1 itself appends a group without vertices).
    static int MakeGrid(DorVector2 corner0, DorVector2 corner1, int divisions, CVelPrimitive& primitive);
};
