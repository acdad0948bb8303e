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

double DorAzimuth(const DorVector3& d)
{
    double elevation = 0.0, azimuth = 0.0;
    return DorDirectionAngles(d, elevation, azimuth) == DorDirectionTooShort ? 0.0 : azimuth;
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

namespace {
// Determinant of the 3x3 matrix left when row `row` and column `column` are struck out.
double Minor(const DorMatrix4x4& matrix, int row, int column)
{
    int rows[3], columns[3];
    for (int i = 0, k = 0; i < 4; ++i)
        if (i != row)
            rows[k++] = i;
    for (int j = 0, k = 0; j < 4; ++j)
        if (j != column)
            columns[k++] = j;
    auto at = [&](int i, int j) { return matrix.m[rows[i]][columns[j]]; };
    return at(0, 0) * (at(1, 1) * at(2, 2) - at(1, 2) * at(2, 1)) -
           at(0, 1) * (at(1, 0) * at(2, 2) - at(1, 2) * at(2, 0)) +
           at(0, 2) * (at(1, 0) * at(2, 1) - at(1, 1) * at(2, 0));
}
}  // namespace

bool DorInvert(const DorMatrix4x4& matrix, double minDeterminant, DorMatrix4x4& out)
{
    DorMatrix4x4 adjugate;  // the transposed cofactors
    for (int r = 0; r < 4; ++r)
        for (int c = 0; c < 4; ++c)
            adjugate.m[c][r] = ((r + c) % 2 ? -1.0 : 1.0) * Minor(matrix, r, c);
    double determinant = 0.0;
    for (int c = 0; c < 4; ++c)
        determinant += matrix.m[0][c] * adjugate.m[c][0];
    if (!(std::fabs(determinant) >= minDeterminant) || !std::isfinite(determinant))
        return false;
    for (int r = 0; r < 4; ++r)
        for (int c = 0; c < 4; ++c)
            out.m[r][c] = adjugate.m[r][c] / determinant;
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
