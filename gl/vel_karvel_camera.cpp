// The modeller's camera glide and fit-all. The glide's static lives with the modeller rather than
// in camera/ because it drives one; the easing and the fit are camera maths.
#include "gl/vel_karvel.h"

#include <cmath>

#include "camera/vel_camera_motion.h"
#include "camera/vel_clock.h"
#include "camera/vel_math_camera.h"
#include "model/dor_math.h"

void CVelMathCamera::AnimationCamera_Sec(CVelKarvel* modeler, _VelCamera from, _VelCamera to, double duration, HDC dc)
{
    // An infinite or NaN duration would never end the loop.
    if (modeler == nullptr || duration == 0.0 || !std::isfinite(duration))
        return;
    const unsigned int start = VelClockMilliseconds();
    for (;;) {
        const unsigned int elapsed = VelClockMilliseconds() - start;
        if (duration <= elapsed)
            break;
        _VelCamera camera = VelGlideCamera(from, to, duration, elapsed);
        if (VelCameraIsFinite(camera))
            modeler->SetCamera(camera);
        modeler->DrawModel(dc);
    }
}

void CVelKarvel::AnimationCamera(_VelCamera from, _VelCamera to, double duration, HDC dc)
{
    CVelMathCamera::AnimationCamera_Sec(this, from, to, duration, dc);
}

void CVelKarvel::KarvelAllmodelView(HDC dc, int filter, double duration)
{
    _VelCamera from{};
    GetCamera(from);
    SetCameraForAllView_Hi(filter);
    _VelCamera to = from;
    GetCamera(to);
    // A camera holding inf or NaN differs from every other (its differences are NaN): with no
    // fit to go to nothing is drawn, and from such a camera there is no glide, only the jump.
    if (!VelCameraIsFinite(to))
        return;
    DorVector3 eyeMove = to.eye - from.eye;
    DorVector3 targetMove = to.target - from.target;
    if (DorDot(eyeMove, eyeMove) == 0.0 && DorDot(targetMove, targetMove) == 0.0 && to.zFar == from.zFar)
        return;
    if (VelCameraIsFinite(from))
        AnimationCamera(from, to, duration, dc);
    SetCamera(to);
    DrawModel(dc);
}

void CVelKarvel::KarvelAllmodelView_vp(HDC dc, int filter, double duration)
{
    ResetViewport();
    _VelViewport viewport = {0, 0, 0, 0};
    GetViewport(viewport);
    if (viewport.width > 0 && viewport.height > 0)
        SetViewport(viewport);
    KarvelAllmodelView(dc, filter, duration);
}
