#pragma once
// Reading Windows BMP files into _DorBitmap records, as the viewer does for textures.
#include <string>
#include <vector>

#include "model/dor_types.h"

// Decodes an uncompressed 24- or 32-bit BMP file held in bytes into bitmap: bottom-up rows,
// 4-byte aligned, blue-green-red(-alpha), as the modeller's textures expect. On failure returns
// false and says in expected what the file should have been; bitmap is then unspecified.
bool DecodeBmp(const std::vector<unsigned char>& bytes, _DorBitmap& bitmap, std::string& expected);

// Reads a whole file; false when it cannot be opened or read.
bool ReadFileBytes(const std::string& path, std::vector<unsigned char>& bytes);
