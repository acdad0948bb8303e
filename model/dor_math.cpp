#include "model/dor_math.h"

#include <cmath>

namespace {
double Snap(double v) { return std::fabs(v) < 1e-6 ? 0.0 : v; }
}  // namespace

double DorLength(const DorVector3& v) { return std::sqrt(v.x * v.x + v.y * v.y + v.z * v.z); }

bool DorNormalize(DorVector3& v)
{
    double length = DorLength(v);
    if (!(length >= 0.0001))
        return false;
    v.x /= length;
    v.y /= length;
    v.z /= length;
    return true;
}

DorVector3 DorNewellNormal(const DorVector3* points, int count)
{
    DorVector3 n;
    for (int i = 0; i < count; ++i) {
        const DorVector3& a = points[i];
        const DorVector3& b = points[i + 1 < count ? i + 1 : 0];
        n.x += (a.y - b.y) * (a.z + b.z);
        n.y += (a.z - b.z) * (a.x + b.x);
        n.z += (a.x - b.x) * (a.y + b.y);
    }
    return n;
}

DorDirectionKind DorDirectionAngles(const DorVector3& d, double& elevation, double& azimuth)
{
    double length = DorLength(d);
    if (!(length >= 0.0001))
        return DorDirectionTooShort;
    elevation = std::asin(d.z / length);
    if (d.x != 0.0) {
        azimuth = std::atan(d.y / d.x);
        if (d.x < 0.0)
            azimuth += DorPi;
    } else if (d.y < 0.0) {
        azimuth = -DorPi / 2;
    } else if (d.y > 0.0) {
        azimuth = DorPi / 2;
    } else {
        azimuth = 0.0;
        return DorDirectionVertical;
    }
    return DorDirectionSloped;
}

DorMatrix4x4 DorRotateX(double a)
{
    DorMatrix4x4 m;
    double c = Snap(std::cos(a)), s = Snap(std::sin(a));
    m.m[1][1] = c;
    m.m[1][2] = s;
    m.m[2][1] = -s;
    m.m[2][2] = c;
    return m;
}

DorMatrix4x4 DorRotateY(double a)
{
    DorMatrix4x4 m;
    double c = Snap(std::cos(a)), s = Snap(std::sin(a));
    m.m[0][0] = c;
    m.m[0][2] = -s;
    m.m[2][0] = s;
    m.m[2][2] = c;
    return m;
}

DorMatrix4x4 DorRotateZ(double a)
{
    DorMatrix4x4 m;
    double c = Snap(std::cos(a)), s = Snap(std::sin(a));
    m.m[0][0] = c;
    m.m[0][1] = s;
    m.m[1][0] = -s;
    m.m[1][1] = c;
    return m;
}

DorMatrix4x4 DorTranslate(double x, double y, double z)
{
    DorMatrix4x4 m;
    m.m[3][0] = x;
    m.m[3][1] = y;
    m.m[3][2] = z;
    return m;
}

DorMatrix4x4 operator*(const DorMatrix4x4& a, const DorMatrix4x4& b)
{
    DorMatrix4x4 r;
    for (int i = 0; i < 4; ++i)
        for (int j = 0; j < 4; ++j)
            r.m[i][j] = a.m[i][0] * b.m[0][j] + a.m[i][1] * b.m[1][j] + a.m[i][2] * b.m[2][j] + a.m[i][3] * b.m[3][j];
    return r;
}

bool DorTruncateToInt(double value, int& out)
{
    if (!(value > -2147483649.0 && value < 2147483648.0))
        return false;
    out = static_cast<int>(value);
    return true;
}

bool DorInvert(const DorMatrix4x4& matrix, double minDeterminant, DorMatrix4x4& out)
{
    const double* a = &matrix.m[0][0];
    double inv[16];
    // Cofactors of the transposed matrix (the adjugate), laid out like the input.
    inv[0] = a[5] * a[10] * a[15] - a[5] * a[11] * a[14] - a[9] * a[6] * a[15] + a[9] * a[7] * a[14] + a[13] * a[6] * a[11] - a[13] * a[7] * a[10];
    inv[4] = -a[4] * a[10] * a[15] + a[4] * a[11] * a[14] + a[8] * a[6] * a[15] - a[8] * a[7] * a[14] - a[12] * a[6] * a[11] + a[12] * a[7] * a[10];
    inv[8] = a[4] * a[9] * a[15] - a[4] * a[11] * a[13] - a[8] * a[5] * a[15] + a[8] * a[7] * a[13] + a[12] * a[5] * a[11] - a[12] * a[7] * a[9];
    inv[12] = -a[4] * a[9] * a[14] + a[4] * a[10] * a[13] + a[8] * a[5] * a[14] - a[8] * a[6] * a[13] - a[12] * a[5] * a[10] + a[12] * a[6] * a[9];
    inv[1] = -a[1] * a[10] * a[15] + a[1] * a[11] * a[14] + a[9] * a[2] * a[15] - a[9] * a[3] * a[14] - a[13] * a[2] * a[11] + a[13] * a[3] * a[10];
    inv[5] = a[0] * a[10] * a[15] - a[0] * a[11] * a[14] - a[8] * a[2] * a[15] + a[8] * a[3] * a[14] + a[12] * a[2] * a[11] - a[12] * a[3] * a[10];
    inv[9] = -a[0] * a[9] * a[15] + a[0] * a[11] * a[13] + a[8] * a[1] * a[15] - a[8] * a[3] * a[13] - a[12] * a[1] * a[11] + a[12] * a[3] * a[9];
    inv[13] = a[0] * a[9] * a[14] - a[0] * a[10] * a[13] - a[8] * a[1] * a[14] + a[8] * a[2] * a[13] + a[12] * a[1] * a[10] - a[12] * a[2] * a[9];
    inv[2] = a[1] * a[6] * a[15] - a[1] * a[7] * a[14] - a[5] * a[2] * a[15] + a[5] * a[3] * a[14] + a[13] * a[2] * a[7] - a[13] * a[3] * a[6];
    inv[6] = -a[0] * a[6] * a[15] + a[0] * a[7] * a[14] + a[4] * a[2] * a[15] - a[4] * a[3] * a[14] - a[12] * a[2] * a[7] + a[12] * a[3] * a[6];
    inv[10] = a[0] * a[5] * a[15] - a[0] * a[7] * a[13] - a[4] * a[1] * a[15] + a[4] * a[3] * a[13] + a[12] * a[1] * a[7] - a[12] * a[3] * a[5];
    inv[14] = -a[0] * a[5] * a[14] + a[0] * a[6] * a[13] + a[4] * a[1] * a[14] - a[4] * a[2] * a[13] - a[12] * a[1] * a[6] + a[12] * a[2] * a[5];
    inv[3] = -a[1] * a[6] * a[11] + a[1] * a[7] * a[10] + a[5] * a[2] * a[11] - a[5] * a[3] * a[10] - a[9] * a[2] * a[7] + a[9] * a[3] * a[6];
    inv[7] = a[0] * a[6] * a[11] - a[0] * a[7] * a[10] - a[4] * a[2] * a[11] + a[4] * a[3] * a[10] + a[8] * a[2] * a[7] - a[8] * a[3] * a[6];
    inv[11] = -a[0] * a[5] * a[11] + a[0] * a[7] * a[9] + a[4] * a[1] * a[11] - a[4] * a[3] * a[9] - a[8] * a[1] * a[7] + a[8] * a[3] * a[5];
    inv[15] = a[0] * a[5] * a[10] - a[0] * a[6] * a[9] - a[4] * a[1] * a[10] + a[4] * a[2] * a[9] + a[8] * a[1] * a[6] - a[8] * a[2] * a[5];

    double determinant = a[0] * inv[0] + a[1] * inv[4] + a[2] * inv[8] + a[3] * inv[12];
    if (!(std::fabs(determinant) >= minDeterminant) || !std::isfinite(determinant))
        return false;
    for (int k = 0; k < 16; ++k)
        out.m[k / 4][k % 4] = inv[k] / determinant;
    return true;
}

DorVector3 DorTransformPoint(const DorVector3& p, const DorMatrix4x4& m)
{
    return DorVector3(p.x * m.m[0][0] + p.y * m.m[1][0] + p.z * m.m[2][0] + m.m[3][0],
                      p.x * m.m[0][1] + p.y * m.m[1][1] + p.z * m.m[2][1] + m.m[3][1],
                      p.x * m.m[0][2] + p.y * m.m[1][2] + p.z * m.m[2][2] + m.m[3][2]);
}

DorVector3 DorTransformDirection(const DorVector3& d, const DorMatrix4x4& m)
{
    return DorVector3(d.x * m.m[0][0] + d.y * m.m[1][0] + d.z * m.m[2][0],
                      d.x * m.m[0][1] + d.y * m.m[1][1] + d.z * m.m[2][1],
                      d.x * m.m[0][2] + d.y * m.m[1][2] + d.z * m.m[2][2]);
}

DorMatrix4x4 DorPlaneProjection(const DorVector3& normal, const DorVector3& anchor)
{
    DorMatrix4x4 translation = DorTranslate(-anchor.x, -anchor.y, -anchor.z);
    double elevation = 0, azimuth = 0;
    switch (DorDirectionAngles(normal, elevation, azimuth)) {
    case DorDirectionSloped:
        return translation * (DorRotateZ(-DorPi / 2 - azimuth) * DorRotateX(elevation - DorPi / 2));
    case DorDirectionVertical:
        return translation * DorRotateY(DorPi / 2 - elevation);
    default:
        return translation;
    }
}
