#include "viewer_controls.h"

#include <cmath>
#include <cstdio>
#include <cstdlib>

#include "model/dor_math.h"
#include "viewer_math.h"

namespace {
const double OrbitDegreesPerPixel = 0.4;
const double WheelNotch = 120.0;
const double WheelFlyFraction = 0.1;

std::string FormatPoint(const DorVector3& p)
{
    char text[96];
    std::snprintf(text, sizeof text, "(%.3f, %.3f, %.3f)", p.x, p.y, p.z);
    return text;
}

std::string FormatDepth(double depth)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.6f", depth);
    return text;
}
}  // namespace

bool IsClick(int fromX, int fromY, int toX, int toY)
{
    return std::abs(toX - fromX) < ViewerClickSlop && std::abs(toY - fromY) < ViewerClickSlop;
}

OrbitStep OrbitForDrag(int dx, int dy)
{
    // Dragging right turns the model to the right: the eye goes left, clockwise seen from
    // above. Dragging down tips the model toward the user: the eye rises.
    return {dy * OrbitDegreesPerPixel, -dx * OrbitDegreesPerPixel};
}

PanStep PanForDrag(int dx, int dy, const _VelCamera& camera, int viewHeight)
{
    if (viewHeight <= 0)
        return {0.0, 0.0};
    double distance = Length(camera.target - camera.eye);
    double unitsPerPixel = 2.0 * distance * std::tan(camera.fovy * DorPi / 360.0) / viewHeight;
    // The scene follows the cursor, so the camera moves against it (window y grows downward).
    return {-dx * unitsPerPixel, dy * unitsPerPixel};
}

double FlyForWheel(int wheelDelta, const _VelCamera& camera)
{
    return wheelDelta / WheelNotch * WheelFlyFraction * Length(camera.target - camera.eye);
}

void ZoomCorners(int x0, int y0, int x1, int y1, DorVector2& topLeft, DorVector2& bottomRight)
{
    topLeft = DorVector2(x0 < x1 ? x0 : x1, y0 < y1 ? y0 : y1);
    bottomRight = DorVector2(x0 < x1 ? x1 : x0, y0 < y1 ? y1 : y0);
}

double OrbitFrameAzimuth(int frames) { return frames > 0 ? 360.0 / frames : 0.0; }

_DorMaterial HighlightMaterial(const _DorMaterial& material)
{
    _DorMaterial lit = material;
    float alpha = material.diffuse.a;
    lit.diffuse = DorColorValue(1.0f, 0.55f, 0.1f, alpha);
    lit.ambient = DorColorValue(0.7f, 0.35f, 0.05f, alpha);
    lit.specular = DorColorValue(1.0f, 1.0f, 0.8f, 1.0f);
    lit.shininess = 60.0f;
    return lit;
}

bool ProgressLineDue(int done, int total)
{
    return total > 0 && done * 10LL / total != (done - 1) * 10LL / total;
}

std::vector<std::string> DescribePick(int x, int y, const std::vector<PickedEntity>& hits, const DorVector3& point)
{
    std::string at = "pick " + std::to_string(x) + "," + std::to_string(y) + ": ";
    if (hits.empty())
        return {at + "no entity"};
    std::vector<std::string> lines;
    lines.push_back(at + std::to_string(hits.size()) + (hits.size() == 1 ? " entity" : " entities") + ", nearest first");
    for (size_t i = 0; i < hits.size(); ++i)
        lines.push_back("  " + std::to_string(i + 1) + ". " + hits[i].name + " (depth " + FormatDepth(hits[i].depth) + ")");
    lines.push_back("point " + FormatPoint(point));
    return lines;
}

std::string DescribeClick(const std::vector<PickedEntity>& hits, const DorVector3& point)
{
    if (hits.empty())
        return "Nothing here";
    return hits[0].name + " at " + FormatPoint(point);
}
