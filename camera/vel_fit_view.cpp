// Fit-all: camera placements that bring a bounding box into view.
#include <cmath>

#include "camera/vel_math_camera.h"
#include "model/dor_math.h"

namespace {
// Keeps the nearest point of the sphere off the near plane.
const double kClipMargin = 1.01;

struct Sphere {
    DorVector3 centre;
    double radius;
};

Sphere SphereAround(const DorVector3& low, const DorVector3& high)
{
    return Sphere{(low + high) * 0.5, DorLength(high - low) * 0.5};
}

// The tangent of the narrower half field of view, or 0 when the camera has none.
double NarrowerHalfTangent(const _VelCamera& camera)
{
    double t = std::tan(camera.fovy * 0.5 / 180.0 * DorPi);
    if (!(camera.fovy > 0.0 && camera.fovy < 180.0) || !std::isfinite(t))
        return 0.0;
    if (camera.aspect > 0.0 && camera.aspect < 1.0)
        return t * camera.aspect;
    return t;
}

bool BoxIsFinite(const DorVector3& low, const DorVector3& high)
{
    const double corners[] = {low.x, low.y, low.z, high.x, high.y, high.z};
    for (double v : corners)
        if (!std::isfinite(v))
            return false;
    return true;
}

// A box too large for doubles makes an infinite sphere: such a fit is refused whole.
void Commit(_VelCamera& camera, const _VelCamera& fitted)
{
    if (VelCameraIsFinite(fitted))
        camera = fitted;
}

// Eye on the view line through the sphere's centre at distance, never closer than the near
// plane allows, with zFar reaching past the sphere.
void PlaceOnViewLine(_VelCamera& camera, const DorVector3& forward, const Sphere& sphere, double distance)
{
    double nearest = (camera.zNear + sphere.radius) * kClipMargin;
    if (distance < nearest)
        distance = nearest;
    camera.target = sphere.centre;
    camera.eye = sphere.centre - forward * distance;
    if (distance + sphere.radius > camera.zFar)
        camera.zFar = (distance + sphere.radius) * kClipMargin;
}

// The unit direction of view, or false when the camera has none.
bool Forward(const _VelCamera& camera, DorVector3& forward)
{
    forward = camera.target - camera.eye;
    return DorNormalize(forward);
}

// p through GetPerspectiveMatrix as seen from the eye itself: x and y after the division, and the
// depth along the view. The matrix projects from dist in front of the camera it is given, so it
// is given the camera backed off by that much.
void ProjectFromEye(const DorMatrix4x4& m, double tangent, const DorVector3& p, double& x, double& y, double& depth)
{
    double w = p.x * m.m[0][3] + p.y * m.m[1][3] + p.z * m.m[2][3] + m.m[3][3];
    DorVector3 q = DorTransformPoint(p, m);
    x = q.x / w;
    y = q.y / w;
    depth = w / tangent;
}

void PerspectiveFromEye(const _VelCamera& camera, const DorVector3& forward, DorMatrix4x4& m)
{
    double back = DorLength(camera.target - camera.eye);
    _VelCamera backedOff = camera;
    backedOff.eye = camera.eye - forward * back;
    CVelMathMatrix::GetPerspectiveMatrix(backedOff, back, m);
}
}  // namespace

void CVelMathCamera::FitViewToSphere(_VelCamera& camera, const DorVector3& low, const DorVector3& high)
{
    DorVector3 forward;
    double tangent = NarrowerHalfTangent(camera);
    if (!BoxIsFinite(low, high) || !Forward(camera, forward) || tangent <= 0.0)
        return;
    Sphere sphere = SphereAround(low, high);
    double distance = DorLength(camera.target - camera.eye);
    if (sphere.radius >= 0.0001)
        distance = sphere.radius * std::sqrt(1.0 + tangent * tangent) / tangent;  // radius / sin
    _VelCamera fitted = camera;
    PlaceOnViewLine(fitted, forward, sphere, distance);
    Commit(camera, fitted);
}

void CVelMathCamera::FitViewToBox(_VelCamera& camera, const DorVector3& low, const DorVector3& high)
{
    if (!BoxIsFinite(low, high))
        return;
    FitViewToSphere(camera, low, high);
    DorVector3 forward;
    double tangent = std::tan(camera.fovy * 0.5 / 180.0 * DorPi);
    Sphere sphere = SphereAround(low, high);
    if (!Forward(camera, forward) || !(camera.aspect > 0.0) || sphere.radius < 0.0001 ||
        NarrowerHalfTangent(camera) <= 0.0)
        return;
    DorMatrix4x4 m;
    PerspectiveFromEye(camera, forward, m);
    // A corner's lateral offset is the same from every eye on the view line; it needs the depth
    // at which that offset reaches the edge. The eye moves by the largest shortfall.
    double shift = -HUGE_VAL;
    for (int corner = 0; corner < 8; ++corner) {
        DorVector3 p((corner & 1) ? high.x : low.x, (corner & 2) ? high.y : low.y, (corner & 4) ? high.z : low.z);
        double x, y, depth;
        ProjectFromEye(m, tangent, p, x, y, depth);
        double needed = depth * std::fmax(std::fabs(x) / camera.aspect, std::fabs(y));
        shift = std::fmax(shift, needed - depth);
    }
    _VelCamera fitted = camera;
    PlaceOnViewLine(fitted, forward, sphere, DorLength(camera.target - camera.eye) + shift);
    Commit(camera, fitted);
}
