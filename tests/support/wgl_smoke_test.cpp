// Proves the Windows harness end to end: a real window, a pixel format, a WGL context, and a
// clear colour read back from the frame buffer.
#include <gtest/gtest.h>
#include <windows.h>
#include <GL/gl.h>

#include "support/win32_test_window.h"

TEST(WglHarness, ClearColourReadsBack)
{
    TestWindow window(160, 120);
    ASSERT_NE(window.dc, nullptr);

    PIXELFORMATDESCRIPTOR pfd = {};
    pfd.nSize = sizeof(pfd);
    pfd.nVersion = 1;
    pfd.dwFlags = PFD_DRAW_TO_WINDOW | PFD_SUPPORT_OPENGL | PFD_DOUBLEBUFFER;
    pfd.iPixelType = PFD_TYPE_RGBA;
    pfd.cColorBits = 24;
    pfd.cDepthBits = 24;
    int format = ChoosePixelFormat(window.dc, &pfd);
    ASSERT_NE(format, 0);
    ASSERT_TRUE(SetPixelFormat(window.dc, format, &pfd));
    HGLRC context = wglCreateContext(window.dc);
    ASSERT_NE(context, nullptr);
    ASSERT_TRUE(wglMakeCurrent(window.dc, context));

    GLint viewport[4] = {};
    glGetIntegerv(GL_VIEWPORT, viewport);
    EXPECT_EQ(viewport[2], 160);
    EXPECT_EQ(viewport[3], 120);

    glClearColor(1.0f, 0.5f, 0.0f, 1.0f);
    glClear(GL_COLOR_BUFFER_BIT);
    glFinish();
    unsigned char rgba[4] = {};
    glReadPixels(10, 10, 1, 1, GL_RGBA, GL_UNSIGNED_BYTE, rgba);
    EXPECT_EQ(rgba[0], 255);
    EXPECT_NEAR(rgba[1], 128, 1);
    EXPECT_EQ(rgba[2], 0);

    wglMakeCurrent(nullptr, nullptr);
    wglDeleteContext(context);
}
