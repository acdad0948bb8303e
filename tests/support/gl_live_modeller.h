#pragma once
// A live OpenGL modeller in a real window for tests, and what they draw and read back. Windows
// only; the modeller's context must be current when pixels are read.
#include <gtest/gtest.h>
#include <windows.h>
#include <GL/gl.h>

#include <cmath>

#include "gl/vel_gl_karvel.h"
#include "support/win32_test_window.h"

const int kWidth = 160;
const int kHeight = 120;

struct Rgb {
    int r, g, b;
};

// The pixel at col, row (row 0 at the top) of the last presented frame.
inline Rgb PixelAt(int col, int row)
{
    glFinish();
    // NOTE: under Wine the front buffer reads back as zeros; Mesa swaps by copying, so the back
    // buffer still holds the presented frame.
    glReadBuffer(GL_BACK);
    GLint viewport[4];
    glGetIntegerv(GL_VIEWPORT, viewport);
    unsigned char rgba[4] = {};
    HWND window = WindowFromDC(wglGetCurrentDC());
    RECT client;
    GetClientRect(window, &client);
    glReadPixels(col, client.bottom - 1 - row, 1, 1, GL_RGBA, GL_UNSIGNED_BYTE, rgba);
    return Rgb{rgba[0], rgba[1], rgba[2]};
}

inline bool IsBackground(const Rgb& c) { return c.r == 0 && c.g == 0 && c.b == 0; }

inline _DorMaterial Matte(float r, float g, float b, float alpha = 1)
{
    _DorMaterial m;
    m.diffuse = DorColorValue(r, g, b, alpha);
    m.ambient = DorColorValue(r, g, b, 1);
    m.specular = DorColorValue(0, 0, 0, 1);
    m.emission = DorColorValue(0, 0, 0, 1);
    m.shininess = 0;
    return m;
}

inline void AddVertex(CVelTrianglePolys& g, double x, double y, double z, double s = 0, double t = 0)
{
    _VelVertex v;
    v.position = DorVector3(x, y, z);
    v.normal = DorVector3(0, -1, 0);
    v.texcoord = DorVector2(s, t);
    g.vertices.Add(v);
}

// A rectangle facing the camera (counter-clockwise seen from -y) in the plane at depth y,
// spanning x0..x1 and z0..z1, as a triangle strip with texture coordinates 0..1.
inline CVelPrimitive Rectangle(double x0, double z0, double x1, double z1, double y, const _DorMaterial& material)
{
    CVelTrianglePolys g;
    g.GroupType = VelGroupTriangleStrip;
    g.material = material;
    AddVertex(g, x0, y, z0, 0, 0);
    AddVertex(g, x1, y, z0, 1, 0);
    AddVertex(g, x0, y, z1, 0, 1);
    AddVertex(g, x1, y, z1, 1, 1);
    CVelPrimitive p;
    p.groups.Add(g);
    return p;
}

// A 24-bit bitmap of width texels in one row: black on the left half, white on the right.
inline _DorBitmap HalfWhite(int width)
{
    _DorBitmap b;
    b.info.width = width;
    b.info.height = 1;
    b.info.bitCount = 24;
    b.bits.SetSize(DorBitmapRowBytes(width, 24));
    for (int i = width / 2 * 3; i < width * 3; ++i)
        b.bits[i] = 255;
    return b;
}

// Puts the camera 10 units in front of the origin on -y, looking along +y with a 90 degree
// field of view: x to the right, z up.
inline void LookAlongY(CVelGLKarvel& karvel)
{
    _VelCamera camera;
    karvel.GetCamera(camera);
    camera.eye = DorVector3(0, -10, 0);
    camera.target = DorVector3(0, 0, 0);
    camera.fovy = 90;
    camera.zNear = 1;
    camera.zFar = 1000;
    karvel.SetCamera(camera);
}

// A modeller live in a 160 x 120 window, its camera along +y (LookAlongY).
class LiveModeller : public ::testing::Test {
protected:
    // One window for the suite: creating one under Wine takes about two seconds.
    static void SetUpTestSuite() { shared = new TestWindow(kWidth, kHeight); }
    static void TearDownTestSuite()
    {
        delete shared;
        shared = nullptr;
    }

    void SetUp() override
    {
        ASSERT_EQ(karvel.Initialize(window.dc), 1);
        ASSERT_NE(karvel.GetCurrent(), nullptr);
        LookAlongY(karvel);
    }

    void TearDown() override { karvel.Finalize(); }

    // Where the camera maths puts model point (x, y, z): column and row from the top-left.
    static void PixelOf(double x, double y, double z, int& col, int& row)
    {
        double distance = 10 + y;
        double halfHeight = distance * std::tan(45.0 / 180.0 * 3.14159265358979323846);
        col = static_cast<int>(kWidth / 2.0 + x / halfHeight * kHeight / 2.0);
        row = static_cast<int>(kHeight / 2.0 - z / halfHeight * kHeight / 2.0);
    }

    Rgb Draw(double x, double y, double z)
    {
        karvel.DrawModel(window.dc);
        int col, row;
        PixelOf(x, y, z, col, row);
        return PixelAt(col, row);
    }

    _DorPosition* Add(CVelPrimitive p) { return karvel.AddPrimitive(p); }

    // Starts the modeller again with HalfWhite(4) as texture 1 and a grey background, and adds
    // a red rectangle over x -4..4, z -2..2 wearing the texture.
    void ShowHalfWhiteTexture()
    {
        karvel.Finalize();
        _DorBitmap texture = HalfWhite(4);
        ASSERT_EQ(karvel.AddTexture(texture), 1u);
        ASSERT_EQ(karvel.Initialize(window.dc), 1);
        LookAlongY(karvel);
        DorColorValue grey(0.5f, 0.5f, 0.5f, 1);
        karvel.SetBkColor(grey);
        CVelPrimitive p = Rectangle(-4, -2, 4, 2, 0, Matte(1, 0, 0));
        p.groups[0].RenderKind = VelRenderTextured;
        p.groups[0].texture = 1;
        Add(p);
    }

    inline static TestWindow* shared = nullptr;
    TestWindow& window = *shared;
    CVelGLKarvel karvel;
};

