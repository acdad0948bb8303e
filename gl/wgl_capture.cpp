// ToBitmap: the model rendered once into a memory bitmap, then the context back on the window.
#include "gl/vel_capture.h"
#include "gl/vel_gl_karvel.h"

#include <windows.h>
#include <GL/gl.h>

namespace {
// NOTE: 32 bits per pixel, not the 24 that hosts receive: Wine's bridge to Mesa swaps red and
// blue and smears 4-byte pixels over 3-byte rows in a 24-bit DIB section.
BITMAPINFO RenderTargetInfo(int width, int height)
{
    BITMAPINFO info = {};
    info.bmiHeader.biSize = sizeof(BITMAPINFOHEADER);
    info.bmiHeader.biWidth = width;
    info.bmiHeader.biHeight = height;
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    info.bmiHeader.biCompression = BI_RGB;
    return info;
}

// Whether the current context can render width x height pixels.
bool RenderableSize(int width, int height)
{
    GLint maxDims[2] = {0, 0};
    glGetIntegerv(GL_MAX_VIEWPORT_DIMS, maxDims);
    return VelCaptureSizeAllowed(width, height, maxDims[0], maxDims[1]);
}
}  // namespace

void CVelGLKarvel::ToBitmap(_DorBitmap& bitmap, _DORRECT& rect)
{
    CheckDrawing("ToBitmap");
    if (!renderState)
        return;
    HDC windowDC = wglGetCurrentDC();
    DeviceSetting();
    const int width = rect.Width();
    const int height = rect.Height();
    if (!RenderableSize(width, height)) {
        VelEmptyCaptureBitmap(bitmap);
        return;
    }

    BITMAPINFO info = RenderTargetInfo(width, height);
    HDC memoryDC = CreateCompatibleDC(nullptr);
    void* pixels = nullptr;
    HBITMAP dib = memoryDC ? CreateDIBSection(memoryDC, &info, DIB_RGB_COLORS, &pixels, nullptr, 0) : nullptr;
    // Everything that can fail for want of memory fails here, while the window keeps its context.
    if (!dib || !pixels || !VelReserveCaptureBits(bitmap, width, height)) {
        if (dib)
            DeleteObject(dib);
        if (memoryDC)
            DeleteDC(memoryDC);
        VelEmptyCaptureBitmap(bitmap);
        return;
    }
    HGDIOBJ previous = SelectObject(memoryDC, dib);

    context.Release();
    VelBeginCaptureBitmap(bitmap);
    // NOTE: when the bitmap format cannot be set there is no current context and the calls
    // below do nothing: the bitmap gets the DIB section's initial (black) pixels.
    context.CreateOnBitmap(memoryDC);
    StartUpContext();
    UploadTextures();
    FollowViewportAspect();
    DrawModel(memoryDC);
    glFinish();
    VelCompleteCaptureBitmap(bitmap, width, height, static_cast<const unsigned char*>(pixels));

    // The window context comes back before the DIB section goes: a bitmap still selected into a
    // DC, or still rendered to, is not deleted by Windows and would leak.
    Initialize(windowDC);
    SelectObject(memoryDC, previous);
    DeleteObject(dib);
    DeleteDC(memoryDC);
}
