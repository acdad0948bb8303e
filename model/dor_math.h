#pragma once
// Vector and matrix pieces shared by the converters and the camera (conventions in dor_types.h).
// Rotations snap a sine or cosine below 1e-6 to exactly 0, so right angles give exact matrices.
#include "model/dor_types.h"

const double DorPi = 3.14159265358979323846;

inline DorVector3 operator+(const DorVector3& a, const DorVector3& b) { return DorVector3(a.x + b.x, a.y + b.y, a.z + b.z); }
inline DorVector3 operator-(const DorVector3& a, const DorVector3& b) { return DorVector3(a.x - b.x, a.y - b.y, a.z - b.z); }
inline DorVector3 operator*(const DorVector3& a, double s) { return DorVector3(a.x * s, a.y * s, a.z * s); }
inline double DorDot(const DorVector3& a, const DorVector3& b) { return a.x * b.x + a.y * b.y + a.z * b.z; }
inline DorVector3 DorCross(const DorVector3& a, const DorVector3& b)
{
    return DorVector3(a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x);
}

double DorLength(const DorVector3& v);
// Divides v by its length when that is at least 0.0001; returns whether it did.
bool DorNormalize(DorVector3& v);

// Newell normal of the closed loop points[0..count-1] (last joined to first), not normalised.
// It points toward a viewer who sees the loop run counter-clockwise.
DorVector3 DorNewellNormal(const DorVector3* points, int count);

enum DorDirectionKind { DorDirectionTooShort = 0, DorDirectionSloped = 1, DorDirectionVertical = 2 };

// Elevation asin(z/|d|) and azimuth of d in radians. The azimuth is atan(y/x), plus pi for x < 0,
// +-pi/2 for x = 0; a vertical direction (x = y = 0) gets azimuth 0.
DorDirectionKind DorDirectionAngles(const DorVector3& d, double& elevation, double& azimuth);
// The azimuth of DorDirectionAngles, or 0 when d is too short to give one.
double DorAzimuth(const DorVector3& d);

DorMatrix4x4 DorRotateX(double radians);
DorMatrix4x4 DorRotateY(double radians);
DorMatrix4x4 DorRotateZ(double radians);
DorMatrix4x4 DorTranslate(double x, double y, double z);
DorMatrix4x4 operator*(const DorMatrix4x4& a, const DorMatrix4x4& b);

// Truncates toward zero into an int; false (out untouched) for NaN or a value no int holds.
bool DorTruncateToInt(double value, int& out);

// Inverse as the adjugate over the determinant; false (out untouched) when |determinant| is
// below minDeterminant or not finite.
bool DorInvert(const DorMatrix4x4& m, double minDeterminant, DorMatrix4x4& out);

DorVector3 DorTransformPoint(const DorVector3& p, const DorMatrix4x4& m);
// The rotation part only: no translation.
DorVector3 DorTransformDirection(const DorVector3& d, const DorMatrix4x4& m);

// The plane projection: moves anchor to the origin and turns the plane's unit normal onto +z,
// so a loop counter-clockwise about the normal is counter-clockwise in x, y. The rotations are
// composed before the translation is prepended, which maps anchor to exactly (0, 0, 0).
// A normal too short to give angles yields the translation alone.
DorMatrix4x4 DorPlaneProjection(const DorVector3& normal, const DorVector3& anchor);
