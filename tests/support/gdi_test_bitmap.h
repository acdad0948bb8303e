#pragma once
// GDI bitmaps made from _DorBitmap records, for tests of code that reads GDI bitmaps.
#include <windows.h>

#include "model/dor_types.h"

// A DIB section with a copy of bitmap's header, colour table and pixels; the caller deletes it.
HBITMAP CreateDibSectionOf(const _DorBitmap& bitmap);
