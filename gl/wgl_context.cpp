#include "gl/vel_gl_context.h"

#include <windows.h>
#include <GL/gl.h>

namespace {
// Double-buffered RGBA on a window, 24 colour and 24 depth bits, nothing else.
PIXELFORMATDESCRIPTOR WindowFormat()
{
    PIXELFORMATDESCRIPTOR pfd = {};
    pfd.nSize = sizeof(PIXELFORMATDESCRIPTOR);
    pfd.nVersion = 1;
    pfd.dwFlags = PFD_DRAW_TO_WINDOW | PFD_SUPPORT_OPENGL | PFD_DOUBLEBUFFER;
    pfd.iPixelType = PFD_TYPE_RGBA;
    pfd.cColorBits = 24;
    pfd.cDepthBits = 24;
    pfd.iLayerType = PFD_MAIN_PLANE;
    return pfd;
}

// Single-buffered RGBA on a bitmap, 24 depth bits.
// NOTE: 32 colour bits, not 24: Wine's bridge to Mesa garbles a 24-bit DIB section.
PIXELFORMATDESCRIPTOR BitmapFormat()
{
    PIXELFORMATDESCRIPTOR pfd = {};
    pfd.nSize = sizeof(PIXELFORMATDESCRIPTOR);
    pfd.nVersion = 1;
    pfd.dwFlags = PFD_DRAW_TO_BITMAP | PFD_SUPPORT_OPENGL;
    pfd.iPixelType = PFD_TYPE_RGBA;
    pfd.cColorBits = 32;
    pfd.cDepthBits = 24;
    pfd.iLayerType = PFD_MAIN_PLANE;
    return pfd;
}
}  // namespace

CVelGLContext::~CVelGLContext() { Release(); }

int CVelGLContext::Create(HDC dc)
{
    Release();
    PIXELFORMATDESCRIPTOR pfd = WindowFormat();
    int format = ChoosePixelFormat(dc, &pfd);
    if (format == 0)
        return 0;
    if (!SetPixelFormat(dc, format, &pfd))
        return 0;
    if (!DescribePixelFormat(dc, format, sizeof(PIXELFORMATDESCRIPTOR), &pfd))
        return 0;
    return MakeCurrentOn(dc);
}

int CVelGLContext::CreateOnBitmap(HDC memoryDC)
{
    Release();
    PIXELFORMATDESCRIPTOR pfd = BitmapFormat();
    int format = ChoosePixelFormat(memoryDC, &pfd);
    if (format == 0)
        return 0;
    if (!DescribePixelFormat(memoryDC, format, sizeof(PIXELFORMATDESCRIPTOR), &pfd))
        return 0;
    if (!SetPixelFormat(memoryDC, format, &pfd))
        return 0;
    return MakeCurrentOn(memoryDC);
}

int CVelGLContext::MakeCurrentOn(HDC dc)
{
    // NOTE: issued before the new context is current, so it reaches whichever context is (or
    // none); the new context keeps OpenGL's default alignment, which is also 4.
    glPixelStorei(GL_UNPACK_ALIGNMENT, 4);
    handle = wglCreateContext(dc);
    wglMakeCurrent(dc, handle);
    return 1;
}

void CVelGLContext::Release()
{
    if (!handle)
        return;
    // Only our own context is made non-current: another modeller's may be current here.
    if (wglGetCurrentContext() == handle)
        wglMakeCurrent(nullptr, nullptr);
    wglDeleteContext(handle);
    handle = nullptr;
}
