#pragma once
/// @file
/// Camera maths: view and perspective matrices, the interactive moves, rubber-band zoom,
/// click-to-approach, fit-all placements and the camera glides. Everything here is stateless
/// and, except the two animations, touches no modeller and no OpenGL state: the functions
/// change a _VelCamera (or _VelViewport) the caller owns and may run on any thread.
///
/// Conventions: angles in degrees, lengths in model units, world up +Z (see dor_types.h for the
/// matrix convention). A move that cannot be made leaves the camera exactly as it was and says
/// nothing: a direction of view shorter than 0.0001, a vertical one (straight up or down), a
/// new elevation at or beyond +-90 degrees, or a result that would hold a non-finite number.
/// No move reads or changes fovy, zNear, zFar or aspect.
#include "../camera/vel_camera.h"
#include "../model/dor_types.h"
#include "../model/export.h"
#include "../model/platform.h"

class CVelKarvel;

/// The camera's matrices, for hosts that project points themselves.
class KARVEL_API CVelMathMatrix {
public:
    /// Only static operations; nothing to free.
    virtual ~CVelMathMatrix() {}

    /// World to view: the eye at the origin looking down -Z with world +Z toward screen-up, then
    /// everything shifted by dist along +Z (a point dist in front of the eye lands on z = 0).
    /// Overwrites out. A camera whose eye and target coincide gives no meaningful matrix.
    static void GetToViewMatrix(const _VelCamera& camera, double dist, DorMatrix4x4& out);
    /// The view matrix followed by a projection that maps the upper edge of the field of view to
    /// y = 1 after division by w; no aspect ratio enters it. dist 0 gives NaN in the depth terms.
    static void GetPerspectiveMatrix(const _VelCamera& camera, double dist, DorMatrix4x4& out);
};

/// Camera moves and placements on a _VelCamera; CVelKarvel's camera operations apply them to the
/// modeller's own camera.
class KARVEL_API CVelMathCamera {
public:
    /// Only static operations; nothing to free.
    virtual ~CVelMathCamera() {}

    /// Turns the view about the eye (the target moves): elevation rises by tilt degrees, azimuth
    /// falls by pan degrees (positive pan turns right). Refused whole, pan included, when the new
    /// elevation would reach +-90.
    static void PanTilt(_VelCamera& camera, double pan, double tilt);
    /// Moves along the ground: forward along the horizontal view direction, left across it, up
    /// along +Z, in model units. eyeOnly 0 moves the target too; otherwise the view turns to keep
    /// looking at it.
    static void Dolly(_VelCamera& camera, double forward, double left, double up, int eyeOnly);
    /// Moves along the camera's own forward, right and up axes, in model units; eyeOnly as Dolly.
    static void Fly(_VelCamera& camera, double forward, double right, double up, int eyeOnly);
    /// Orbits the eye about the target: climbs by elevation degrees, circles counter-clockwise
    /// seen from above by azimuth degrees. Note the argument order and the turning sense are the
    /// reverse of PanTilt's. Refused when the new elevation would reach +-90.
    static void RoundDolly(_VelCamera& camera, double elevation, double azimuth);

    /// The viewport that makes the dragged rectangle (corner0 top-left, corner1 bottom-right, in
    /// window pixels, y down) fill the window, fitted to the camera's aspect. Returns 1 and
    /// replaces viewport, or 0 for a rectangle without width or height after clamping to the
    /// viewport, or one that would magnify more than 5 times (viewport width and height may then
    /// already hold the clamped rectangle's size: callers discard it). Also 0 for a negative scale,
    /// which only a negative aspect gives, and for a result that no int holds.
    static int ViewportZoom(const _VelCamera& camera, _VelViewport& viewport, DorVector2 corner0, DorVector2 corner1);

    /// point: pixels from the viewport centre, y up; viewHeight: the viewport's height in pixels.
    /// With depth 0 the view turns (eye fixed, distance kept) toward half the pointed offset from
    /// the centre of view. Otherwise the eye alone moves forward by depth x (1 - height /
    /// viewHeight) model units, so that things at depth grow by viewHeight / height.
    static void ApproachCamera(_VelCamera& camera, DorVector2 point, double viewHeight, double height, double depth);

    /// Glides modeler's camera from `from` toward `to` over duration milliseconds with an
    /// ease-out, calling its SetCamera and DrawModel(dc) for every frame as fast as drawing
    /// allows. Blocks the calling thread (the modeller's) and dispatches no messages meanwhile.
    /// Stops a frame short of `to`: set `to` afterwards to end exactly on it. fovy, zNear, zFar
    /// and aspect stay from's. A null modeler, a duration of 0 or not finite does nothing; a
    /// negative one draws nothing. A frame that is not finite is drawn but not set.
    static void AnimationCamera_Sec(CVelKarvel* modeler, _VelCamera from, _VelCamera to, double duration, HDC dc);

    /// Orbits modeler's camera about its target, degreesPerSecond counter-clockwise seen from
    /// above (negative: clockwise), drawing on window's DC and dispatching this thread's messages
    /// between frames (about 60 a second). Returns when the host clears running (from a message
    /// handler), when the window is gone, or on WM_QUIT, which is posted again for the host's own
    /// loop. The camera stays where the orbit stopped; a view straight up or down does not orbit.
    /// Windows only; call it on the modeller's thread.
    static void RoundAnimationStart(CVelKarvel* modeler, int& running, HWND window, int degreesPerSecond);

    /// Fit-all placements of a camera on the axis-aligned box low..high (model units). Both keep
    /// the direction of view, the field of view and zNear, aim at the box centre and move the eye
    /// along the view line; a camera that cannot be fitted (no direction, a field of view outside
    /// 0..180 degrees) is left as it was, as is every camera on a box with a corner that is not
    /// finite; a fit that would not be finite (a box too large for doubles) is refused whole.
    /// - FitViewToSphere: the sphere around the box touches the narrower of the vertical and
    ///   horizontal field of view. A box without extent keeps the eye's distance.
    /// - FitViewToBox: tighter: the box corners, projected by GetPerspectiveMatrix, touch the
    ///   edge of the view (the vertical edge at 1, the horizontal one at aspect) and none lies
    ///   outside it.
    ///
    /// Either way the eye stays far enough back for the whole sphere to lie beyond zNear, and
    /// zFar is pushed out when the sphere would reach past it.
    ///@{
    static void FitViewToSphere(_VelCamera& camera, const DorVector3& low, const DorVector3& high);
    static void FitViewToBox(_VelCamera& camera, const DorVector3& low, const DorVector3& high);
    ///@}
};

/// @cond KARVEL_INTERNAL
// Whether every field of the camera is a finite number.
bool VelCameraIsFinite(const _VelCamera& camera);
/// @endcond
