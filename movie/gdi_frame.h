#pragma once
// Frames read from GDI bitmaps, for the recorders' HBITMAP (and MFC CBitmap) overloads.
#include <windows.h>

#include "model/dor_types.h"

// Copies a GDI bitmap into a bottom-up frame of the same size and depth, with its colour table
// at 8 bits and below. Returns false, leaving frame empty, when the bitmap cannot be read.
bool VelReadGdiBitmap(HBITMAP bitmap, _DorBitmap& frame);
