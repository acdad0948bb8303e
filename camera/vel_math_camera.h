#pragma once
// Camera maths: view and perspective matrices, the interactive moves, rubber-band zoom,
// click-to-approach and the eased camera glide. Everything here is stateless.
//
// Conventions: angles in degrees, lengths in model units, world up +Z (see dor_types.h for the
// matrix convention). A move that cannot be made leaves the camera exactly as it was and says
// nothing; a move whose result would hold a non-finite number is refused the same way.
#include "../camera/vel_camera.h"
#include "../model/dor_types.h"
#include "../model/export.h"
#include "../model/platform.h"

class CVelKarvel;

class KARVEL_API CVelMathMatrix {
public:
    virtual ~CVelMathMatrix() {}

    // World to view: the eye at the origin looking down -Z with world +Z toward screen-up, then
    // everything shifted by dist along +Z (a point dist in front of the eye lands on z = 0).
    static void GetToViewMatrix(const _VelCamera& camera, double dist, DorMatrix4x4& out);
    // The view matrix followed by a projection that maps the upper edge of the field of view to
    // y = 1 after division by w; no aspect ratio enters it.
    static void GetPerspectiveMatrix(const _VelCamera& camera, double dist, DorMatrix4x4& out);
};

class KARVEL_API CVelMathCamera {
public:
    virtual ~CVelMathCamera() {}

    // Turns the view about the eye: elevation rises by tilt, azimuth falls by pan.
    static void PanTilt(_VelCamera& camera, double pan, double tilt);
    // Moves along the ground: forward along the horizontal view direction, left across it, up.
    static void Dolly(_VelCamera& camera, double forward, double left, double up, int eyeOnly);
    // Moves along the camera's own forward, right and up axes.
    static void Fly(_VelCamera& camera, double forward, double right, double up, int eyeOnly);
    // Orbits the eye about the target: climbs by elevation, circles counter-clockwise by azimuth.
    static void RoundDolly(_VelCamera& camera, double elevation, double azimuth);

    // The viewport that makes the dragged rectangle (top-left, bottom-right; y down) fill the
    // window. Returns 1 and replaces viewport, or 0 (viewport width and height may then already
    // hold the clamped rectangle's size: callers discard it).
    static int ViewportZoom(const _VelCamera& camera, _VelViewport& viewport, DorVector2 corner0, DorVector2 corner1);

    // point: pixels from the viewport centre, y up. With depth 0 the view turns toward the point;
    // otherwise the eye moves forward so that things at depth grow by viewHeight / height.
    static void ApproachCamera(_VelCamera& camera, DorVector2 point, double viewHeight, double height, double depth);

    // Glides modeler's camera from `from` toward `to` over duration milliseconds, drawing a frame
    // on dc after each step. Blocks the calling thread; stops a frame short of `to`.
    static void AnimationCamera_Sec(CVelKarvel* modeler, _VelCamera from, _VelCamera to, double duration, HDC dc);

    // Orbits modeler's camera about its target, degreesPerSecond counter-clockwise seen from
    // above (negative: clockwise), drawing on window's DC and dispatching this thread's messages
    // between frames (about 60 a second). Returns when the host clears running (from a message
    // handler), when the window is gone, or on WM_QUIT, which is posted again for the host's own
    // loop. The camera stays where the orbit stopped; a view straight up or down does not orbit.
    static void RoundAnimationStart(CVelKarvel* modeler, int& running, HWND window, int degreesPerSecond);

    // Fit-all placements of a camera on the axis-aligned box low..high. Both keep the direction
    // of view, the field of view and zNear, aim at the box centre and move the eye along the
    // view line; a camera that cannot be fitted (no direction, a field of view outside 0..180
    // degrees) is left as it was.
    // - FitViewToSphere: the sphere around the box touches the narrower of the vertical and
    //   horizontal field of view. A box without extent keeps the eye's distance.
    // - FitViewToBox: tighter: the box corners, projected by GetPerspectiveMatrix, touch the
    //   edge of the view (the vertical edge at 1, the horizontal one at aspect) and none lies
    //   outside it.
    // Either way the eye stays far enough back for the whole sphere to lie beyond zNear, and
    // zFar is pushed out when the sphere would reach past it.
    static void FitViewToSphere(_VelCamera& camera, const DorVector3& low, const DorVector3& high);
    static void FitViewToBox(_VelCamera& camera, const DorVector3& low, const DorVector3& high);
};

// Whether every field of the camera is a finite number.
bool VelCameraIsFinite(const _VelCamera& camera);
