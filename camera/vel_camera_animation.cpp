#include <cmath>

#include "camera/vel_clock.h"
#include "camera/vel_math_camera.h"
#include "gl/vel_karvel.h"
#include "model/dor_math.h"

void CVelMathCamera::AnimationCamera_Sec(CVelKarvel* modeler, _VelCamera from, _VelCamera to, double duration, HDC dc)
{
    // An infinite or NaN duration would never end the loop.
    if (modeler == nullptr || duration == 0.0 || !std::isfinite(duration))
        return;
    const unsigned int start = VelClockMilliseconds();
    const double k = -1.0 / (duration * duration);
    const DorVector3 eyeDelta = to.eye - from.eye;
    const DorVector3 targetDelta = to.target - from.target;
    for (;;) {
        const unsigned int elapsed = VelClockMilliseconds() - start;
        if (duration <= elapsed)
            break;
        // Ease-out: 0 at the start, 1 with zero speed at the end.
        const double remaining = duration - elapsed;
        const double f = k * (remaining * remaining) + 1.0;
        _VelCamera camera = from;
        camera.eye = from.eye + eyeDelta * f;
        camera.target = from.target + targetDelta * f;
        if (VelCameraIsFinite(camera))
            modeler->SetCamera(camera);
        modeler->DrawModel(dc);
    }
}

void CVelKarvel::AnimationCamera(_VelCamera from, _VelCamera to, double duration, HDC dc)
{
    CVelMathCamera::AnimationCamera_Sec(this, from, to, duration, dc);
}
