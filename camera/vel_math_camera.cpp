#include "camera/vel_math_camera.h"

#include <cmath>

#include "model/dor_math.h"

namespace {
const double kDegreesPerRadian = 57.29577951308232;

double Radians(double degrees) { return degrees * (1.0 / 180.0) * DorPi; }

// A new elevation must stay strictly between the poles; NaN fails too.
bool ElevationAllowed(double degrees) { return degrees > -90.0 && degrees < 90.0; }

// Raises v's elevation by rise degrees and turns it counter-clockwise about +Z by turn degrees,
// keeping its length. False, v untouched, when v is short or vertical or would reach a pole.
bool TurnDirection(DorVector3& v, double rise, double turn)
{
    double elevation = 0.0, azimuth = 0.0;
    if (DorDirectionAngles(v, elevation, azimuth) != DorDirectionSloped)
        return false;
    if (!ElevationAllowed(elevation * kDegreesPerRadian + rise))
        return false;
    DorMatrix4x4 m = DorRotateZ(-azimuth) * DorRotateY(-Radians(rise)) * DorRotateZ(azimuth + Radians(turn));
    v = DorTransformDirection(v, m);
    return true;
}

// Every move works on a copy and lands here: a non-finite result is refused like any other.
void Commit(_VelCamera& camera, const _VelCamera& moved)
{
    if (VelCameraIsFinite(moved))
        camera = moved;
}

// T(-eye), the turn that puts the view direction on -Z, then the shift by dist along +Z.
DorMatrix4x4 ToView(const _VelCamera& camera, double dist)
{
    double elevation = 0.0, azimuth = 0.0;
    DorDirectionKind kind = DorDirectionAngles(camera.target - camera.eye, elevation, azimuth);
    DorMatrix4x4 out = DorTranslate(-camera.eye.x, -camera.eye.y, -camera.eye.z);
    if (kind == DorDirectionSloped)
        out = out * DorRotateZ(DorPi / 2 - azimuth);
    out = out * DorRotateX(-(elevation + DorPi / 2));
    return out * DorTranslate(0.0, 0.0, dist);
}
}  // namespace

bool VelCameraIsFinite(const _VelCamera& c)
{
    const double fields[] = {c.eye.x, c.eye.y, c.eye.z, c.target.x, c.target.y, c.target.z,
                             c.fovy,  c.zNear, c.zFar, c.aspect};
    for (double v : fields)
        if (!std::isfinite(v))
            return false;
    return true;
}

void CVelMathMatrix::GetToViewMatrix(const _VelCamera& camera, double dist, DorMatrix4x4& out)
{
    out = ToView(camera, dist);
}

void CVelMathMatrix::GetPerspectiveMatrix(const _VelCamera& camera, double dist, DorMatrix4x4& out)
{
    DorMatrix4x4 mirror;
    mirror.m[2][2] = -1.0;
    double t = std::tan(camera.fovy * (1.0 / 180.0) * DorPi * 0.5);
    DorMatrix4x4 projection;
    projection.m[0][0] = 1.0;
    projection.m[1][1] = 1.0;
    // NOTE: (t * dist) / dist rather than t, so that dist = 0 gives NaN here as hosts expect.
    projection.m[2][2] = (t * dist) / dist;
    projection.m[2][3] = (t * dist) / dist;
    projection.m[3][2] = -(t * dist);
    projection.m[3][3] = 0.0;
    out = ToView(camera, dist) * mirror * projection;
}

void CVelMathCamera::PanTilt(_VelCamera& camera, double pan, double tilt)
{
    DorVector3 d = camera.target - camera.eye;
    if (!TurnDirection(d, tilt, -pan))
        return;
    _VelCamera moved = camera;
    moved.target = camera.eye + d;
    Commit(camera, moved);
}

void CVelMathCamera::Dolly(_VelCamera& camera, double forward, double left, double up, int eyeOnly)
{
    double elevation = 0.0, azimuth = 0.0;
    if (DorDirectionAngles(camera.target - camera.eye, elevation, azimuth) != DorDirectionSloped)
        return;
    DorVector3 ground = DorTransformDirection(DorVector3(forward, left, 0.0), DorRotateZ(azimuth));
    DorVector3 offset(ground.x, ground.y, up);
    _VelCamera moved = camera;
    moved.eye = camera.eye + offset;
    if (!eyeOnly)
        moved.target = camera.target + offset;
    Commit(camera, moved);
}

void CVelMathCamera::Fly(_VelCamera& camera, double forward, double right, double up, int eyeOnly)
{
    double elevation = 0.0, azimuth = 0.0;
    if (DorDirectionAngles(camera.target - camera.eye, elevation, azimuth) != DorDirectionSloped)
        return;
    DorMatrix4x4 shift = DorRotateZ(-azimuth) * DorRotateY(elevation) * DorTranslate(forward, -right, up) *
                         DorRotateY(-elevation) * DorRotateZ(azimuth);
    _VelCamera moved = camera;
    moved.eye = DorTransformPoint(camera.eye, shift);
    if (!eyeOnly)
        moved.target = DorTransformPoint(camera.target, shift);
    Commit(camera, moved);
}

void CVelMathCamera::RoundDolly(_VelCamera& camera, double elevation, double azimuth)
{
    DorVector3 e = camera.eye - camera.target;
    if (!TurnDirection(e, elevation, azimuth))
        return;
    _VelCamera moved = camera;
    moved.eye = camera.target + e;
    Commit(camera, moved);
}

int CVelMathCamera::ViewportZoom(const _VelCamera& camera, _VelViewport& viewport, DorVector2 corner0,
                                 DorVector2 corner1)
{
    const double vx = viewport.x, vy = viewport.y, vw = viewport.width, vh = viewport.height;
    // Clamped to zero on the left and top (not to vx, vy); a NaN corner stays NaN and is refused.
    double x0 = corner0.x < 0.0 ? 0.0 : corner0.x, y0 = corner0.y < 0.0 ? 0.0 : corner0.y;
    double x1 = corner1.x > vx + vw ? vx + vw : corner1.x, y1 = corner1.y > vy + vh ? vy + vh : corner1.y;
    int w = 0, h = 0;
    if (!DorTruncateToInt(x1 - x0, w) || !DorTruncateToInt(y1 - y0, h))
        return 0;
    viewport.width = w;
    viewport.height = h;
    if (w <= 0 || h <= 0)
        return 0;

    // Fit to the camera's aspect. NOTE: the test uses the integer quotient w / h on purpose.
    const double aspect = camera.aspect;
    const int quotient = w / h;
    double fitW = 0.0, fitH = 0.0;
    if (quotient <= aspect) {
        fitW = w;
        fitH = w / aspect;
    } else {
        fitW = h * aspect;
        fitH = h;
    }
    if (x0 + fitW > vx + vw)
        x0 = x1 - fitW;
    if (y0 + fitH > vy + vh)
        y0 = y1 - fitH;

    // No single zoom magnifies more than five times. A negative scale only comes from a negative
    // aspect and is refused too (-0 from an aspect of -inf included), as is a result that no int
    // holds.
    const double scale = vw / fitW;
    if (!(scale >= 0.0 && scale <= 5.0) || std::signbit(scale))
        return 0;
    const double bottom = vy + vh - y0 - fitH;  // window rows below the box, y counted upward
    _VelViewport zoomed;
    if (!DorTruncateToInt((vx - x0) * scale, zoomed.x) || !DorTruncateToInt((vy - bottom) * scale, zoomed.y) ||
        !DorTruncateToInt(vw * scale, zoomed.width) || !DorTruncateToInt(vh * scale, zoomed.height))
        return 0;
    viewport = zoomed;
    return 1;
}

void CVelMathCamera::ApproachCamera(_VelCamera& camera, DorVector2 point, double viewHeight, double height,
                                    double depth)
{
    const double t = std::tan(camera.fovy * 0.5 * (1.0 / 180.0) * DorPi);
    const double pixelDistance = viewHeight / (t + t);
    DorMatrix4x4 fromView;
    if (!DorInvert(ToView(camera, pixelDistance), 1e-7, fromView))
        return;
    // NOTE: the view matrix already holds the shift by pixelDistance, so this spot lies twice as
    // far ahead as q does: a turn goes to half the pointed offset. Hosts rely on that.
    DorVector3 spot = DorTransformPoint(DorVector3(point.x, point.y, -pixelDistance), fromView);
    const double length = DorLength(camera.target - camera.eye);

    if (depth != 0.0) {
        const double heightDistance = height / (t + t);
        Fly(camera, depth - heightDistance * (depth / pixelDistance), 0.0, 0.0, 1);
        return;
    }
    DorVector3 toward = spot - camera.eye;
    DorNormalize(toward);
    _VelCamera moved = camera;
    moved.target = camera.eye + toward * length;
    Commit(camera, moved);
}
