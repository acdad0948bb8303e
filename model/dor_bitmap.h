#pragma once
/// @file
/// Sizing of _DorBitmap records: headers, palette and pixel storage for an uncompressed bitmap.
#include "model/dor_types.h"

/// Makes bitmap an uncompressed, zero-filled picture of width x |height| pixels at bitCount bits:
/// both headers, a full colour table for 8 bits and below (none above), and the pixel rows.
/// Returns false, leaving a default (empty) bitmap, for a negative width, a bit count outside
/// 1..32 or pixels that would not fit in the array.
bool DorBitmapAllocate(_DorBitmap& bitmap, int width, int height, int bitCount);
