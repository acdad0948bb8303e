#pragma once
// Timed camera moves as pure functions of the elapsed time. The modeller draws the frames
// (gl/vel_karvel_camera.cpp, gl/win32_round_animation.cpp).
#include "camera/vel_camera.h"

// The camera after elapsed of duration milliseconds of a glide from `from` to `to`: eye and
// target eased out (0 at the start, 1 with zero speed at the end), every other field from `from`.
_VelCamera VelGlideCamera(const _VelCamera& from, const _VelCamera& to, double duration, unsigned int elapsed);

// start turned about its target by the angle reached after elapsed milliseconds.
_VelCamera VelOrbitCamera(const _VelCamera& start, int degreesPerSecond, unsigned int elapsed);
