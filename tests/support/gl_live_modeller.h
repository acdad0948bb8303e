#pragma once
// A live OpenGL modeller in a real window for tests, and what they draw and read back. Windows
// only; the modeller's context must be current when pixels are read.
#include <gtest/gtest.h>
#include <windows.h>
#include <GL/gl.h>

#include "gl/vel_gl_karvel.h"
#include "model/dor_bitmap.h"
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
    RECT client;
    GetClientRect(WindowFromDC(wglGetCurrentDC()), &client);
    unsigned char rgba[4] = {};
    glReadPixels(col, client.bottom - 1 - row, 1, 1, GL_RGBA, GL_UNSIGNED_BYTE, rgba);
    return Rgb{rgba[0], rgba[1], rgba[2]};
}

inline _DorMaterial Matte(float r, float g, float b, float alpha = 1)
{
    _DorMaterial m;
    m.diffuse = DorColorValue(r, g, b, alpha);
    m.ambient = DorColorValue(r, g, b, 1);
    m.specular = m.emission = DorColorValue(0, 0, 0, 1);
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

// A rectangle facing -y (counter-clockwise seen from there) at depth y over x0..x1, z0..z1: a
// triangle strip with texture coordinates 0..1; textured, it wears texture 1.
inline CVelPrimitive Rectangle(double x0, double z0, double x1, double z1, double y, const _DorMaterial& material,
                               bool textured = false)
{
    CVelTrianglePolys g;
    g.GroupType = VelGroupTriangleStrip;
    g.material = material;
    if (textured) {
        g.RenderKind = VelRenderTextured;
        g.texture = 1;
    }
    for (int i = 0; i < 4; ++i)
        AddVertex(g, i % 2 ? x1 : x0, y, i < 2 ? z0 : z1, i % 2, i / 2);
    CVelPrimitive p;
    p.groups.Add(g);
    return p;
}

// The camera 10 units in front of the origin on -y, looking along +y with a 90 degree field of
// view: x to the right, z up, 6 pixels per unit at y = 0 in a kWidth x kHeight window.
inline void LookAlongY(CVelGLKarvel& karvel)
{
    karvel.SetCamera(_VelCamera{DorVector3(0, -10, 0), DorVector3(0, 0, 0), 90, 1, 1000, double(kWidth) / kHeight});
}

// A modeller live in a 160 x 120 window, its camera along +y (LookAlongY). Texture 1 is four
// texels in a row, black on the left half and white on the right.
class LiveModeller : public ::testing::Test {
protected:
    // One window for the suite: creating one under Wine takes about two seconds.
    static void SetUpTestSuite() { shared = new TestWindow(kWidth, kHeight); }
    static void TearDownTestSuite() { delete shared; }

    void SetUp() override
    {
        _DorBitmap texture;
        DorBitmapAllocate(texture, 4, 1, 24);
        for (int i = 6; i < 12; ++i)
            texture.bits[i] = 255;
        ASSERT_EQ(karvel.AddTexture(texture), 1u);
        ASSERT_EQ(karvel.Initialize(window.dc), 1);
        ASSERT_NE(karvel.GetCurrent(), nullptr);
        LookAlongY(karvel);
    }
    void TearDown() override { karvel.Finalize(); }

    // Where the camera puts model point (x, 0, z): column and row from the top-left.
    static void PixelOf(double x, double z, int& col, int& row)
    {
        col = static_cast<int>(kWidth / 2.0 + x * kHeight / 20.0);
        row = static_cast<int>(kHeight / 2.0 - z * kHeight / 20.0);
    }
    Rgb At(double x, double z)
    {
        int col, row;
        PixelOf(x, z, col, row);
        return PixelAt(col, row);
    }
    _DorPosition* Add(CVelPrimitive p) { return karvel.AddPrimitive(p); }

    inline static TestWindow* shared = nullptr;
    TestWindow& window = *shared;
    CVelGLKarvel karvel;
};
