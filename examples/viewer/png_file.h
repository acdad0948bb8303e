#pragma once
// Saving captured pictures as PNG files.
#include <string>
#include <vector>

#include "model/dor_types.h"

// The pixels of a 24-bit bitmap as tightly packed red-green-blue rows, top row first, as image
// files store them. Empty for a bitmap of another depth or whose bits are cut short.
std::vector<unsigned char> BitmapToRgbRows(const _DorBitmap& bitmap);

// Writes a 24-bit bitmap as a PNG file; false when the bitmap or the file will not do.
bool WritePng(const std::string& path, const _DorBitmap& bitmap);
