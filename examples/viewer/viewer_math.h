#pragma once
// The vector length the viewer needs. The library's own vector maths is internal to the DLL.
#include <cmath>

#include "model/dor_types.h"

inline double Length(const DorVector3& v) { return std::sqrt(v.x * v.x + v.y * v.y + v.z * v.z); }
