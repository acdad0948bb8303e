// The modeller's operations that need no OpenGL call: the entity store, textures, lights,
// camera, cull mode, background and offset.
#include "gl/vel_gl_karvel.h"

#include <string>

#include "camera/vel_math_camera.h"
#include "gl/vel_misuse.h"

CVelGLKarvel::CVelGLKarvel(const CVelGLKarvel& other)
    : CVelKarvel(other), model(other.model), renderState(nullptr), context(other.context), modelScale(other.modelScale)
{
}

CVelGLKarvel& CVelGLKarvel::operator=(const CVelGLKarvel& other)
{
    if (this != &other) {
        Finalize();
        model = other.model;
        context = other.context;
        modelScale = other.modelScale;
    }
    return *this;
}

void CVelGLKarvel::CheckThread(const char* operation) const
{
    if (renderState)
        VelCheckThread(renderState->ownerThread, operation);
}

void CVelGLKarvel::RemoveShapeAt(_DorPosition*& position)
{
    CheckThread("RemoveShapeAt");
    model.RemoveAt(position);
}

void CVelGLKarvel::RemoveShapeAll()
{
    CheckThread("RemoveShapeAll");
    model.Destroy();
}

void CVelGLKarvel::MoveDepthToTail(_DorPosition*& position)
{
    CheckThread("MoveDepthToTail");
    model.MoveToTail(position);
}

void CVelGLKarvel::MoveDepthToHead(_DorPosition*& position)
{
    CheckThread("MoveDepthToHead");
    model.MoveToHead(position);
}

CDorArray<long, long>* CVelGLKarvel::GetFreeProperty(_DorPosition*& position)
{
    CVelGLEntity* entity = model.EntityAt(position);
    return entity ? &entity->freeProperty : nullptr;
}

void CVelGLKarvel::GetCenterPoint(DorVector3& centre, int filter) { model.GetCenterPoint(centre, filter, modelScale); }

void CVelGLKarvel::SetOffset(DorVector3& offset)
{
    model.offset.x = offset.x * modelScale;
    model.offset.y = offset.y * modelScale;
    model.offset.z = offset.z * modelScale;
}

void CVelGLKarvel::DeviceSetting() {}

void CVelGLKarvel::GetBkColor(DorColorValue& colour) { colour = context.background; }

void CVelGLKarvel::SetBkColor(DorColorValue& colour) { context.background = colour; }

void CVelGLKarvel::SetCullMode(int mode)
{
    if (renderState)
        renderState->cullMode = mode;
}

int CVelGLKarvel::GetCullMode() { return renderState ? renderState->cullMode : 0; }

void CVelGLKarvel::GetCamera(_VelCamera& camera)
{
    if (renderState)
        renderState->GetCamera(camera, modelScale);
}

void CVelGLKarvel::SetCamera(const _VelCamera& camera)
{
    CheckThread("SetCamera");
    if (!VelCameraIsFinite(camera))
        VelReportMisuse("SetCamera with a non-finite camera");
    if (renderState)
        renderState->SetCamera(camera, modelScale);
}

// Places the camera on the box of the counted entities with one of the fit-all placements.
template <class Fit>
static void FitCameraToModel(CVelGLKarvel& karvel, int filter, Fit fit)
{
    DorVector3 low, high;
    if (!karvel.renderState || !karvel.model.GetBoundingBox(low, high, filter, karvel.modelScale))
        return;
    _VelCamera camera;
    karvel.GetCamera(camera);
    fit(camera, low, high);
    if (VelCameraIsFinite(camera))
        karvel.SetCamera(camera);
}

void CVelGLKarvel::SetCameraForAllView_Low(int filter) { FitCameraToModel(*this, filter, CVelMathCamera::FitViewToSphere); }

void CVelGLKarvel::SetCameraForAllView_Hi(int filter) { FitCameraToModel(*this, filter, CVelMathCamera::FitViewToBox); }

void CVelGLKarvel::GetViewport(_VelViewport& viewport)
{
    if (renderState)
        viewport = renderState->viewport;
}

void CVelGLKarvel::ResetViewport()
{
    // NOTE: only the record: glViewport and the aspect ratio wait for the next SetViewport or
    // Initialize, which hosts rely on.
    if (renderState)
        renderState->viewport = renderState->resetViewport;
}

void CVelGLKarvel::GetLight(int index, DorLight& light)
{
    if (renderState)
        renderState->GetLight(index, light, modelScale);
}

void CVelGLKarvel::SetLight(int index, DorLight light)
{
    if (renderState)
        renderState->SetLight(index, light, modelScale);
}

void CVelGLKarvel::FollowViewportAspect()
{
    _VelViewport viewport = {0, 0, 0, 0};
    GetViewport(viewport);
    if (viewport.height == 0)
        return;  // a minimised window: keep the last usable ratio
    _VelCamera camera;
    GetCamera(camera);
    camera.aspect = static_cast<double>(viewport.width) / static_cast<double>(viewport.height);
    SetCamera(camera);
}

_DorPosition* CVelGLKarvel::AddPrimitive(CVelPrimitive& primitive)
{
    CheckThread("AddPrimitive");
    CVelGLScope scope(renderState);
    return model.AddPrimitive(primitive, scope);
}

void CVelGLKarvel::ChangePrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags)
{
    CheckThread("ChangePrimitive");
    CVelGLScope scope(renderState);
    model.ChangePrimitive(position, primitive, flags, scope);
}

void CVelGLKarvel::GetPrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags)
{
    CVelGLScope scope(renderState);
    model.GetPrimitive(position, primitive, flags, scope);
}

void CVelGLKarvel::MoveShape(_DorPosition* position, DorMatrix4x4& matrix)
{
    CheckThread("MoveShape");
    CVelGLScope scope(renderState);
    model.MoveEntity(position, matrix, scope);
}

long CVelGLKarvel::GetDrawMode(_DorPosition*& position)
{
    CVelGLEntity* entity = model.EntityAt(position);
    return entity ? entity->DrawMode : -1;
}

void CVelGLKarvel::SetDrawMode(_DorPosition*& position, long mode)
{
    CheckThread("SetDrawMode");
    if (CVelGLEntity* entity = model.EntityAt(position))
        entity->DrawMode = mode;
}

namespace {
// A texture stored while a context is live reaches OpenGL only at the next context start-up.
template <class Result>
Result UploadedLater(Result stored, const CVelGLRenderState* renderState, const char* operation)
{
    if (stored && renderState && VelCheckedMode())
        VelReportMisuse((std::string(operation) + " while live: the image waits for the next Initialize or SetCurrent").c_str());
    return stored;
}
}  // namespace

unsigned int CVelGLKarvel::AddTexture(_DorBitmap& bitmap)
{
    return UploadedLater(model.AddTexture(bitmap), renderState, "AddTexture");
}

int CVelGLKarvel::ChangeTexture(unsigned int name, _DorBitmap& bitmap)
{
    return UploadedLater(model.ChangeTexture(name, bitmap), renderState, "ChangeTexture");
}

void CVelGLKarvel::RemoveAllTexture() { model.RemoveAllTexture(); }

CDorArray<_DorBitmap, _DorBitmap&>* CVelGLKarvel::GetTextureList() { return &model.textures; }
