#include "camera/vel_camera_motion.h"

#include <cmath>

#include "camera/vel_math_camera.h"
#include "model/dor_math.h"

_VelCamera VelGlideCamera(const _VelCamera& from, const _VelCamera& to, double duration, unsigned int elapsed)
{
    const double k = -1.0 / (duration * duration);
    const double remaining = duration - elapsed;
    double f = k * (remaining * remaining) + 1.0;
    // A duration whose square underflows makes k infinite; the quotient form stays exact.
    if (!std::isfinite(f))
        f = 1.0 - (remaining / duration) * (remaining / duration);
    _VelCamera camera = from;
    camera.eye = from.eye + (to.eye - from.eye) * f;
    camera.target = from.target + (to.target - from.target) * f;
    return camera;
}

_VelCamera VelOrbitCamera(const _VelCamera& start, int degreesPerSecond, unsigned int elapsed)
{
    _VelCamera camera = start;
    double degrees = std::fmod(degreesPerSecond * (elapsed / 1000.0), 360.0);
    CVelMathCamera::RoundDolly(camera, 0.0, degrees);
    return camera;
}
