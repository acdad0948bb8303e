#pragma once
// Cameras for the camera tests, and a bit-for-bit comparison that treats NaN as equal to itself:
// a refused move must leave every field exactly as it was.
#include <cstring>

#include "camera/vel_camera.h"

// Clip range 1..1000.
inline _VelCamera Camera(DorVector3 eye, DorVector3 target, double fovy = 45.0, double aspect = 4.0 / 3.0)
{
    return _VelCamera{eye, target, fovy, 1.0, 1000.0, aspect};
}

inline bool SameCameraBits(const _VelCamera& a, const _VelCamera& b)
{
    const double fa[] = {a.eye.x, a.eye.y, a.eye.z, a.target.x, a.target.y, a.target.z, a.fovy, a.zNear, a.zFar, a.aspect};
    const double fb[] = {b.eye.x, b.eye.y, b.eye.z, b.target.x, b.target.y, b.target.z, b.fovy, b.zNear, b.zFar, b.aspect};
    return std::memcmp(fa, fb, sizeof fa) == 0;
}
