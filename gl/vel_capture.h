#pragma once
// The bitmap side of ToBitmap: the size a capture request asks for, whether the GL
// implementation can render it, and the 24-bit bitmap built from the rendered 32-bit rows.
//
// NOTE: the picture is rendered into a 32-bit DIB section (Wine's bridge to Mesa garbles a
// 24-bit one) and its rows are packed into the 24-bit bitmap that hosts receive.
#include "model/dor_types.h"

// The largest pixel count a capture may have: the 32-bit rows must stay addressable by int.
const long long VelCaptureMaxPixels = 0x7FFFFFFF / 4;

// Whether a width x height capture can be made when the GL implementation renders at most
// maxWidth x maxHeight pixels.
bool VelCaptureSizeAllowed(int width, int height, int maxWidth, int maxHeight);

// Sets the header fields of a capture about to be made: "BM", 24 bits, 54-byte offset, width and
// height 0, file size 0.
void VelBeginCaptureBitmap(_DorBitmap& bitmap);

// Sizes bitmap's pixel array for a width x height capture ahead of the rendering; false when the
// memory cannot be had, when a size is not positive, or when the pixel bytes would not fit in an
// int (the array is then left as it was).
bool VelReserveCaptureBits(_DorBitmap& bitmap, int width, int height);

// Completes an empty capture: no pixels, no palette, width and height 0, file size 54.
void VelEmptyCaptureBitmap(_DorBitmap& bitmap);

// Completes the capture of width x height pixels from bottom-up 32-bit rows (blue, green, red,
// unused; 4 x width bytes each): 24-bit rows padded to 4 bytes with zeros, file size pixel bytes
// + 54, no palette. A size that VelReserveCaptureBits refuses gives the empty capture.
void VelCompleteCaptureBitmap(_DorBitmap& bitmap, int width, int height, const unsigned char* rows32);
