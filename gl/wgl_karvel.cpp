// The modeller's context lifecycle: creation on a device context, moves to another one, release.
#include "gl/vel_gl_karvel.h"

#include <windows.h>
#include <GL/gl.h>

#include <string>
#include <vector>

#include "gl/vel_misuse.h"

CVelGLKarvel::CVelGLKarvel() : renderState(nullptr), modelScale(1.0) {}

CVelGLKarvel::~CVelGLKarvel() { Finalize(); }

int CVelGLKarvel::Initialize(HDC& dc, _VelViewport viewport) { return InitializeOn(dc, &viewport); }

int CVelGLKarvel::Initialize(HDC& dc) { return InitializeOn(dc, nullptr); }

int CVelGLKarvel::InitializeOn(HDC dc, const _VelViewport* viewport)
{
    if (!renderState) {
        Finalize();
        renderState = new CVelGLRenderState(model);
        if (viewport)
            renderState->ApplyViewport(*viewport);
        // NOTE: a failed creation is not reported here: the start-up goes on without a context,
        // as it always has; hosts check GetCurrent.
        context.Create(dc);
    } else {
        DeviceSetting();
        context.Release();
        context.Create(dc);
    }
    renderState->ownerThread = VelThreadId();
    if (viewport)
        renderState->ApplyViewport(*viewport);
    StartUpContext();
    UploadTextures();
    FollowViewportAspect();
    return 1;
}

void CVelGLKarvel::Finalize()
{
    model.Destroy();
    delete renderState;
    renderState = nullptr;
    context.Release();
}

HDC CVelGLKarvel::SetCurrent(HDC& dc)
{
    if (!renderState)
        return dc;
    HDC current = wglGetCurrentDC();
    if (dc == current)
        return dc;
    _VelViewport viewport = {0, 0, 0, 0};
    GetViewport(viewport);
    Initialize(dc, viewport);
    return current;
}

HDC CVelGLKarvel::GetCurrent() { return wglGetCurrentDC(); }

void CVelGLKarvel::CheckDrawing(const char* operation) const
{
    CheckThread(operation);
    if (renderState && VelCheckedMode() && (!context.handle || wglGetCurrentContext() != context.handle))
        VelReportMisuse((std::string(operation) + " while the modeller's context is not current").c_str());
}

void CVelGLKarvel::SetViewport(_VelViewport& viewport)
{
    CheckDrawing("SetViewport");
    if (!renderState)
        return;
    renderState->ApplyViewport(viewport);
    FollowViewportAspect();
}

void CVelGLKarvel::StartUpContext()
{
    DeviceSetting();
    renderState->StartUp();
}

void CVelGLKarvel::UploadTextures()
{
    // NOTE: the names are not kept: a fresh context hands out 1..n, which is what groups carry.
    int count = model.textures.GetSize();
    std::vector<GLuint> names(static_cast<size_t>(count));
    glGenTextures(count, names.data());
    for (int drained = 0; VelCheckedMode() && drained < 8 && glGetError() != GL_NO_ERROR; ++drained) {
    }
    if (count > 0)
        glEnable(GL_TEXTURE_2D);
    else
        glDisable(GL_TEXTURE_2D);
    for (int i = 0; i < count; ++i) {
        const _DorBitmap& bitmap = model.textures[i];
        glBindTexture(GL_TEXTURE_2D, names[static_cast<size_t>(i)]);
        // The host may have edited the list in place since the image was accepted.
        bool present = VelTexturePixelsPresent(bitmap);
        if (present && bitmap.info.bitCount == 24)
            glTexImage2D(GL_TEXTURE_2D, 0, GL_RGB, bitmap.info.width, bitmap.info.height, 0, GL_BGR_EXT,
                         GL_UNSIGNED_BYTE, bitmap.bits.GetData());
        else if (present && bitmap.info.bitCount == 32)
            glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, bitmap.info.width, bitmap.info.height, 0, GL_BGRA_EXT,
                         GL_UNSIGNED_BYTE, bitmap.bits.GetData());
        if (VelCheckedMode() && (!present || bitmap.info.bitCount == 1 || glGetError() != GL_NO_ERROR))
            VelReportMisuse(("texture " + std::to_string(i + 1) + " gets no image (1 bit, missing pixels or refused by OpenGL)").c_str());
    }
}
