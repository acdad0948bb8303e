#pragma once
// Bit-for-bit camera comparison that ignores padding and treats NaN as equal to itself: a
// refused move must leave every field exactly as it was.
#include <cstring>

#include "camera/vel_camera.h"

inline bool SameCameraBits(const _VelCamera& a, const _VelCamera& b)
{
    const double fa[] = {a.eye.x, a.eye.y, a.eye.z, a.target.x, a.target.y, a.target.z, a.fovy, a.zNear, a.zFar, a.aspect};
    const double fb[] = {b.eye.x, b.eye.y, b.eye.z, b.target.x, b.target.y, b.target.z, b.fovy, b.zNear, b.zFar, b.aspect};
    return std::memcmp(fa, fb, sizeof fa) == 0 && a.eye.dimension == b.eye.dimension &&
           a.target.dimension == b.target.dimension;
}
