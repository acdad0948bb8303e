// The interface's own behaviour: the defaults of the virtual operations, and the members built
// only on the virtual table, so that they work for any modeller.
#include "gl/vel_karvel.h"

#include "camera/vel_math_camera.h"
#include "model/dor_math.h"

namespace {
// The wrappers' scratch camera: eye and target at the origin, the rest zero, so that a modeller
// whose GetCamera does nothing yields a camera every move refuses.
_VelCamera BlankCamera()
{
    _VelCamera camera;
    camera.fovy = camera.zNear = camera.zFar = camera.aspect = 0.0;
    return camera;
}

// Reads the modeller's camera, moves it, writes it back. A camera that is not finite (only
// possible when the modeller handed one out) is never written back.
template <class Move>
void MoveOwnCamera(CVelKarvel& modeller, Move move)
{
    _VelCamera camera = BlankCamera();
    modeller.GetCamera(camera);
    move(camera);
    if (VelCameraIsFinite(camera))
        modeller.SetCamera(camera);
}
}  // namespace

CVelKarvel::~CVelKarvel() {}

HDC CVelKarvel::SetCurrent(HDC& dc) { return dc; }
HDC CVelKarvel::GetCurrent() { return nullptr; }
void CVelKarvel::MoveDepthToTail(_DorPosition*&) {}
void CVelKarvel::MoveDepthToHead(_DorPosition*&) {}
void CVelKarvel::GetCenterPoint(DorVector3&, int) {}
void CVelKarvel::SetOffset(DorVector3&) {}
void CVelKarvel::HitTest(HDC, int, int, CDorArray<_VelSelect, _VelSelect&>&) {}
void CVelKarvel::GetDepthToPoint3(HDC, int, int, double&, DorVector3&) {}
void CVelKarvel::DrawModel(HDC&) {}
void CVelKarvel::DeviceSetting() {}
void CVelKarvel::GetBkColor(DorColorValue&) {}
void CVelKarvel::SetBkColor(DorColorValue&) {}
void CVelKarvel::ToBitmap(_DorBitmap&, _DORRECT&) {}
void CVelKarvel::SetCullMode(int) {}
int CVelKarvel::GetCullMode() { return 1; }
void CVelKarvel::GetCamera(_VelCamera&) {}
void CVelKarvel::SetCamera(const _VelCamera&) {}
void CVelKarvel::SetCameraForAllView_Low(int) {}
void CVelKarvel::SetCameraForAllView_Hi(int) {}
void CVelKarvel::GetViewport(_VelViewport&) {}
void CVelKarvel::SetViewport(_VelViewport&) {}
void CVelKarvel::ResetViewport() {}
void CVelKarvel::GetLight(int, DorLight&) {}
void CVelKarvel::SetLight(int, DorLight) {}
_DorPosition* CVelKarvel::AddPrimitive(CVelPrimitive&) { return nullptr; }
void CVelKarvel::ChangePrimitive(_DorPosition*, CVelPrimitive&, long) {}
void CVelKarvel::GetPrimitive(_DorPosition*, CVelPrimitive&, long) {}
unsigned int CVelKarvel::AddTexture(_DorBitmap&) { return 0; }
int CVelKarvel::ChangeTexture(unsigned int, _DorBitmap&) { return 0; }
void CVelKarvel::RemoveAllTexture() {}
CDorArray<_DorBitmap, _DorBitmap&>* CVelKarvel::GetTextureList() { return nullptr; }

void CVelKarvel::PanTilt(double pan, double tilt)
{
    MoveOwnCamera(*this, [&](_VelCamera& c) { CVelMathCamera::PanTilt(c, pan, tilt); });
}

void CVelKarvel::Dolly(double forward, double left, double up, int eyeOnly)
{
    MoveOwnCamera(*this, [&](_VelCamera& c) { CVelMathCamera::Dolly(c, forward, left, up, eyeOnly); });
}

void CVelKarvel::Fly(double forward, double right, double up, int eyeOnly)
{
    MoveOwnCamera(*this, [&](_VelCamera& c) { CVelMathCamera::Fly(c, forward, right, up, eyeOnly); });
}

void CVelKarvel::RoundDolly(double elevation, double azimuth)
{
    MoveOwnCamera(*this, [&](_VelCamera& c) { CVelMathCamera::RoundDolly(c, elevation, azimuth); });
}

int CVelKarvel::ViewportZoom(DorVector2 corner0, DorVector2 corner1)
{
    _VelCamera camera = BlankCamera();
    GetCamera(camera);
    _VelViewport viewport = {0, 0, 0, 0};
    GetViewport(viewport);
    int zoomed = CVelMathCamera::ViewportZoom(camera, viewport, corner0, corner1);
    if (zoomed)
        SetViewport(viewport);
    return zoomed;
}

void CVelKarvel::ApproachCamera(DorVector2 point, double height, int useDepth)
{
    _VelViewport viewport = {0, 0, 0, 0};
    GetViewport(viewport);
    _VelCamera camera = BlankCamera();
    GetCamera(camera);
    DorVector2 fromCentre(point.x - viewport.width * 0.5, viewport.height * 0.5 - point.y);

    double depth = 0.0;
    HDC dc = useDepth ? GetCurrent() : nullptr;
    int x = 0, y = 0;
    if (dc != nullptr && DorTruncateToInt(point.x, x) && DorTruncateToInt(point.y, y)) {
        CDorArray<_VelSelect, _VelSelect&> hits;
        HitTest(dc, x, y, hits);
        if (hits.GetSize() > 0) {
            double hitDepth = hits[0].depth;
            DorVector3 picked;
            GetDepthToPoint3_Hi(dc, hits[0].position, x, y, hitDepth, picked);
            depth = DorLength(picked - camera.eye);
        }
    }
    CVelMathCamera::ApproachCamera(camera, fromCentre, viewport.height, height, depth);
    if (VelCameraIsFinite(camera))
        SetCamera(camera);
}

_DorPosition* CVelKarvel::HitTestS(HDC dc, int x, int y)
{
    CDorArray<_VelSelect, _VelSelect&> hits;
    HitTest(dc, x, y, hits);
    return hits.GetSize() > 0 ? hits[0].position : nullptr;
}

// A first estimate at the caller's depth, then a second pick with the clip range narrowed to
// 1000 units either side of it, for a depth with more bits where the target is.
void CVelKarvel::GetDepthToPoint3_Hi(HDC dc, _DorPosition* target, int x, int y, double& depth, DorVector3& point)
{
    _VelCamera saved = BlankCamera();
    GetCamera(saved);
    GetDepthToPoint3(dc, x, y, depth, point);

    _VelCamera narrowed = saved;
    double distance = DorLength(point - saved.eye);
    if (distance - 1000.0 > narrowed.zNear)
        narrowed.zNear = distance - 1000.0;
    if (distance + 1000.0 < narrowed.zFar)
        narrowed.zFar = distance + 1000.0;
    SetCamera(narrowed);

    CDorArray<_VelSelect, _VelSelect&> hits;
    HitTest(dc, x, y, hits);
    for (int i = 0; i < hits.GetSize(); ++i) {
        if (hits[i].position == target) {
            double hitDepth = hits[i].depth;
            GetDepthToPoint3(dc, x, y, hitDepth, point);
            break;
        }
    }
    SetCamera(saved);
}

// Entity edits through GetPrimitive / ChangePrimitive with the flag bits of the part they touch.
namespace {
const long kGeometryPart = 1;
const long kMaterialPart = 2;
const long kDrawModePart = 16;
}  // namespace

long CVelKarvel::GetDrawMode(_DorPosition*& position)
{
    CVelPrimitive primitive;
    primitive.DrawMode = -1;  // stays when the node holds no entity
    if (position != nullptr)
        GetPrimitive(position, primitive, kDrawModePart);
    return primitive.DrawMode;
}

void CVelKarvel::SetDrawMode(_DorPosition*& position, long mode)
{
    if (position == nullptr)
        return;
    CVelPrimitive primitive;
    primitive.DrawMode = mode;
    ChangePrimitive(position, primitive, kDrawModePart);
}

void CVelKarvel::ChangeMaterial(_DorPosition* position, _DorMaterial& material)
{
    if (position == nullptr)
        return;
    CVelPrimitive primitive;
    GetPrimitive(position, primitive, kMaterialPart);
    for (int g = 0; g < primitive.groups.GetSize(); ++g)
        primitive.groups[g].material = material;
    ChangePrimitive(position, primitive, kMaterialPart);
}

// NOTE: normals go through the full matrix, translation included, before renormalising; this
// differs from the OpenGL modeller's own MoveShape and hosts depend on it.
void CVelKarvel::MoveShape(_DorPosition* position, DorMatrix4x4& matrix)
{
    if (position == nullptr)
        return;
    CVelPrimitive primitive;
    GetPrimitive(position, primitive, kGeometryPart);
    for (int g = 0; g < primitive.groups.GetSize(); ++g) {
        CDorArray<_VelVertex, _VelVertex&>& vertices = primitive.groups[g].vertices;
        for (int v = 0; v < vertices.GetSize(); ++v) {
            vertices[v].position = DorTransformPoint(vertices[v].position, matrix);
            vertices[v].normal = DorTransformPoint(vertices[v].normal, matrix);
            DorNormalize(vertices[v].normal);
        }
    }
    ChangePrimitive(position, primitive, kGeometryPart);
}
