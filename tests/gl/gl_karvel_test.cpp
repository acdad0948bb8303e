// The OpenGL modeller in real windows: what a host sees after DrawModel, read back from the
// front buffer.
#include <gtest/gtest.h>
#include <windows.h>
#include <GL/gl.h>

#include <cmath>
#include <utility>

#include "camera/vel_math_camera.h"
#include "gl/vel_gl_karvel.h"
#include "model/dor_math.h"
#include "support/gl_live_modeller.h"

// Scenes read at several places per drawn frame.
class LiveScene : public LiveModeller {
protected:
    Rgb At(double x, double z)
    {
        int col, row;
        PixelOf(x, 0, z, col, row);
        return PixelAt(col, row);
    }
};

TEST_F(LiveModeller, ClearsToTheBackgroundColour)
{
    DorColorValue colour(0.2f, 0.4f, 0.6f, 0.25f);
    karvel.SetBkColor(colour);
    Rgb c = Draw(0, 0, 0);
    EXPECT_NEAR(c.r, 51, 1);
    EXPECT_NEAR(c.g, 102, 1);
    EXPECT_NEAR(c.b, 153, 1);
    DorColorValue back;
    karvel.GetBkColor(back);
    EXPECT_EQ(back.a, 0.25f);  // kept as given; frames clear opaque
}

TEST_F(LiveModeller, TriangleFacingASlopedCameraAppearsWhereTheViewMatrixPutsIt)
{
    _VelCamera camera;
    karvel.GetCamera(camera);
    camera.eye = DorVector3(6, -8, 5);
    camera.target = DorVector3(1, 1, 0);
    camera.fovy = 40;
    karvel.SetCamera(camera);
    karvel.GetCamera(camera);
    DorMatrix4x4 view;
    CVelMathMatrix::GetToViewMatrix(camera, 0, view);
    // The world directions that the view turns onto screen right and screen up.
    DorVector3 right(view.m[0][0], view.m[1][0], view.m[2][0]);
    DorVector3 up(view.m[0][1], view.m[1][1], view.m[2][1]);
    DorVector3 towardsEye = camera.eye - camera.target;
    DorNormalize(towardsEye);

    const DorVector3& centre = camera.target;
    DorVector3 corners[] = {centre - right * 1.5 - up * 1.5, centre + right * 1.5 - up * 1.5, centre + up * 1.5};
    CVelTrianglePolys g;
    g.GroupType = VelGroupTriangles;
    g.material = Matte(1, 0, 0);
    for (const DorVector3& c : corners) {
        AddVertex(g, c.x, c.y, c.z);
        g.vertices[g.vertices.GetSize() - 1].normal = towardsEye;
    }
    CVelPrimitive p;
    p.groups.Add(g);
    Add(p);
    karvel.DrawModel(window.dc);

    // Perspective division of the view coordinates, one pixel per kHeight / 2 of the tangent.
    double t = std::tan(camera.fovy / 2 / 180 * 3.14159265358979323846);
    auto pixel = [&](const DorVector3& world) {
        DorVector3 v = DorTransformPoint(world, view);
        double scale = kHeight / 2.0 / (-v.z * t);
        return PixelAt(static_cast<int>(kWidth / 2.0 + v.x * scale), static_cast<int>(kHeight / 2.0 - v.y * scale));
    };
    EXPECT_GT(pixel(centre).r, 150);
    EXPECT_GT(pixel(centre - up * 1.2).r, 150);
    for (const DorVector3& beside : {centre + right * 2, centre - right * 2, centre + up * 2, centre - up * 2})
        EXPECT_TRUE(IsBackground(pixel(beside)));
}

TEST_F(LiveModeller, InitializeWithAViewportDrawsIntoItAndResetLeavesGLUntilTheNextSet)
{
    karvel.Finalize();
    HDC dc = window.dc;
    _VelViewport quarter = {0, 0, kWidth / 2, kHeight / 2};
    ASSERT_EQ(karvel.Initialize(dc, quarter), 1);
    GLint gl[4];
    glGetIntegerv(GL_VIEWPORT, gl);
    EXPECT_EQ(gl[2], kWidth / 2);
    EXPECT_EQ(gl[3], kHeight / 2);
    _VelViewport now;
    karvel.GetViewport(now);
    EXPECT_EQ(now.width, kWidth / 2);
    _VelCamera camera;
    karvel.GetCamera(camera);
    EXPECT_DOUBLE_EQ(camera.aspect, 80.0 / 60.0);
    LookAlongY(karvel);
    Add(Rectangle(-1, -1, 1, 1, 0, Matte(0, 1, 0)));
    karvel.DrawModel(dc);
    EXPECT_GT(PixelAt(kWidth / 4, kHeight * 3 / 4).g, 150);  // centre of the lower-left quarter
    EXPECT_TRUE(IsBackground(PixelAt(kWidth / 2, kHeight / 2)));

    _VelViewport upperHalf = {0, 0, kWidth, kHeight / 2};
    karvel.SetViewport(upperHalf);
    karvel.GetCamera(camera);
    EXPECT_DOUBLE_EQ(camera.aspect, 160.0 / 60.0);
    karvel.ResetViewport();  // back to the viewport Initialize was given
    karvel.GetViewport(now);
    EXPECT_EQ(now.width, kWidth / 2);
    EXPECT_EQ(now.height, kHeight / 2);
    karvel.DrawModel(dc);
    glGetIntegerv(GL_VIEWPORT, gl);
    EXPECT_EQ(gl[2], kWidth);
    karvel.GetCamera(camera);
    EXPECT_DOUBLE_EQ(camera.aspect, 160.0 / 60.0);
}

TEST_F(LiveModeller, EachLineGroupSetsItsOwnWidth)
{
    // Vertical segments through the centres of pixel columns 80 and 100 (6 pixels per unit).
    CVelPrimitive p;
    const double columns[] = {80.5, 100.5};
    const float widths[] = {3, 1};
    for (int i = 0; i < 2; ++i) {
        CVelTrianglePolys g;
        g.GroupType = VelGroupLines;
        g.lineWidth = widths[i];
        g.material = Matte(1, 1, 1);
        double x = (columns[i] - kWidth / 2.0) / 6;
        AddVertex(g, x, 0, -3);
        AddVertex(g, x, 0, 3);
        p.groups.Add(g);
    }
    Add(p);
    karvel.DrawModel(window.dc);
    const int row = kHeight / 2 + 5;
    for (int col : {79, 80, 81, 100})
        EXPECT_GT(PixelAt(col, row).r, 150) << col;
    for (int col : {78, 82, 99, 101})
        EXPECT_TRUE(IsBackground(PixelAt(col, row))) << col;
}

TEST_F(LiveModeller, HiddenEntitiesDrawNothing)
{
    _DorPosition* rect = Add(Rectangle(-2, -2, 2, 2, 0, Matte(0, 1, 0)));
    const long hidden[] = {1, 3};
    for (long mode : hidden) {
        karvel.SetDrawMode(rect, mode);
        EXPECT_TRUE(IsBackground(Draw(0, 0, 0))) << "DrawMode " << mode;
    }
    const long shown[] = {0, 2};
    for (long mode : shown) {
        karvel.SetDrawMode(rect, mode);
        EXPECT_GT(Draw(0, 0, 0).g, 150) << "DrawMode " << mode;
    }
    EXPECT_EQ(karvel.GetDrawMode(rect), 2);
}

// On the left two opaque rectangles at equal depth; on the right a half-transparent red one
// in front of a far opaque blue one.
TEST_F(LiveScene, ListOrderDecidesOverlapAndTransparentGroupsBlendWithoutDepth)
{
    _DorPosition* red = Add(Rectangle(-8, -2, -4, 2, 0, Matte(1, 0, 0)));
    Add(Rectangle(-8, -2, -4, 2, 0, Matte(0, 1, 0)));
    Add(Rectangle(2, -4, 10, 4, 5, Matte(0, 0, 1)));
    Add(Rectangle(4, -2, 8, 2, 0, Matte(1, 0, 0, 0.5f)));
    karvel.DrawModel(window.dc);
    Rgb first = At(-6, 0);
    EXPECT_GT(first.r, 150);
    EXPECT_LT(first.g, 30);
    Rgb blended = At(6, 0);
    EXPECT_GT(blended.r, 60);
    EXPECT_GT(blended.b, 40);

    karvel.MoveDepthToTail(red);
    // Green behind the red one but drawn after it still shows: the red wrote no depth.
    Add(Rectangle(5, -1, 9, 1, 2, Matte(0, 1, 0)));
    karvel.DrawModel(window.dc);
    Rgb second = At(-6, 0);
    EXPECT_GT(second.g, 150);
    EXPECT_LT(second.r, 30);
    Rgb behind = At(6, 0);
    EXPECT_GT(behind.g, 150);
    EXPECT_LT(behind.r, 30);
}

TEST_F(LiveModeller, OverlayGroupIsPlacedInWindowPixelsUnlit)
{
    CVelTrianglePolys dot;
    dot.GroupType = VelGroupPoints;
    dot.OverlayFlag = 1;
    dot.lineWidth = 3;
    dot.material = Matte(0, 0, 0);
    dot.material.ambient = DorColorValue(0, 1, 0, 1);
    AddVertex(dot, 10, 20, 0);
    CVelPrimitive p;
    p.groups.Add(dot);
    Add(p);
    karvel.DrawModel(window.dc);
    Rgb at = PixelAt(10, 20);
    EXPECT_EQ(at.g, 255);
    EXPECT_EQ(at.r, 0);
    EXPECT_TRUE(IsBackground(PixelAt(14, 20)));
    EXPECT_TRUE(IsBackground(PixelAt(10, 24)));
    EXPECT_TRUE(IsBackground(PixelAt(kWidth - 10, 20)));
    EXPECT_TRUE(IsBackground(PixelAt(10, kHeight - 20)));
}

// Three rectangles side by side, read in the same frames: per-vertex blue on the left, a
// yellow back face in the middle, green on the right beside groups whose indices leave the
// vertex array.
TEST_F(LiveScene, VertexColourBackFaceAndBadIndicesInOneScene)
{
    CVelPrimitive coloured = Rectangle(-9, -3, -5, 3, 0, Matte(0, 0, 0));
    CVelTrianglePolys& g = coloured.groups[0];
    g.RenderKind = VelRenderVertexColour;
    for (int i = 0; i < g.vertices.GetSize(); ++i)
        g.vertices[i].colour = DorColorValue(0, 0, 1, 1);
    Add(coloured);

    CVelPrimitive back = Rectangle(-2, -2, 2, 2, 0, Matte(1, 1, 0));
    std::swap(back.groups[0].vertices[1], back.groups[0].vertices[2]);  // clockwise
    Add(back);

    CVelPrimitive valid = Rectangle(5, -2, 9, 2, 0, Matte(0, 1, 0));
    CVelTrianglePolys bad = valid.groups[0];
    bad.GroupType = VelGroupIndexed;
    bad.material = Matte(1, 0, 0);
    _VelTriangleIndex t(0, 1, 4000000);
    bad.triangles.Add(t);
    CVelTrianglePolys wrapped = bad;
    wrapped.triangles[0] = _VelTriangleIndex(0, -1, 2);
    valid.groups.Add(bad);
    valid.groups.Add(wrapped);
    Add(valid);

    EXPECT_EQ(karvel.GetCullMode(), 0);
    for (int cull : {0, 5}) {
        karvel.SetCullMode(cull);
        EXPECT_EQ(karvel.GetCullMode(), cull);
        karvel.DrawModel(window.dc);
        Rgb left = At(-7, 0);
        EXPECT_GT(left.b, 30) << cull;  // the vertex colour, through the ambient terms only
        EXPECT_LT(left.r, 5) << cull;
        EXPECT_TRUE(IsBackground(At(0, 0))) << cull;  // back faces stay culled in both modes
        EXPECT_GT(At(7, 0).g, 150) << cull;  // the valid group still draws
    }
    GLint twoSided = 0;
    glGetIntegerv(GL_LIGHT_MODEL_TWO_SIDE, &twoSided);
    EXPECT_EQ(twoSided, 1);
}

TEST_F(LiveScene, TexturedRectangleShowsItsTexture)
{
    ASSERT_NO_FATAL_FAILURE(ShowHalfWhiteTexture());
    // The texture environment blends: black texels show the lit colour, white ones black.
    karvel.DrawModel(window.dc);
    Rgb left = At(-2, 0);
    Rgb right = At(2, 0);
    EXPECT_GT(left.r, 150);
    EXPECT_LT(right.r, 20);
    EXPECT_LT(right.g, 20);
}

TEST_F(LiveModeller, LightZeroFollowsTheCameraAtEveryFrame)
{
    DorLight light;
    karvel.GetLight(0, light);
    light.position = DorVector3(7, 7, 7);
    light.diffuse = DorColorValue(0.5f, 0.5f, 0.5f, 1);
    karvel.SetLight(0, light);
    karvel.DrawModel(window.dc);
    DorLight now;
    karvel.GetLight(0, now);
    EXPECT_NEAR(now.position.y, -10, 1e-6);
    EXPECT_NEAR(now.position.x, 0, 1e-6);
    EXPECT_NEAR(now.direction.y, 1, 1e-6);  // it shines along the view
    EXPECT_EQ(now.diffuse.r, 0.5f);
}

TEST(ModellerLifecycle, UninitialisedModellerKeepsItsStoreAndRefusesSceneCalls)
{
    CVelGLKarvel karvel;
    karvel.Finalize();
    karvel.Finalize();
    EXPECT_EQ(karvel.GetCullMode(), 0);
    karvel.SetCullMode(5);
    EXPECT_EQ(karvel.GetCullMode(), 0);
    _VelCamera camera = {};
    camera.fovy = 33;
    karvel.GetCamera(camera);
    EXPECT_EQ(camera.fovy, 33);
    TestWindow window(kWidth, kHeight);
    HDC dc = window.dc;
    EXPECT_EQ(karvel.SetCurrent(dc), dc);
    EXPECT_EQ(karvel.renderState, nullptr);
    CVelPrimitive p = Rectangle(0, 0, 1, 1, 0, Matte(1, 0, 0));
    _DorPosition* handle = karvel.AddPrimitive(p);
    EXPECT_NE(handle, nullptr);
    EXPECT_NE(karvel.GetFreeProperty(handle), nullptr);
    _DorPosition* none = nullptr;
    EXPECT_EQ(karvel.GetFreeProperty(none), nullptr);
    EXPECT_EQ(karvel.GetDrawMode(none), -1);
}

TEST(ModellerStore, TheTwoMoveShapesTreatNormalsDifferently)
{
    CVelGLKarvel karvel;
    CVelPrimitive p = Rectangle(0, 0, 1, 1, 0, Matte(1, 0, 0));
    _DorPosition* own = karvel.AddPrimitive(p);
    _DorPosition* base = karvel.AddPrimitive(p);
    DorMatrix4x4 shift = DorTranslate(10, 0, 0);
    karvel.MoveShape(own, shift);
    static_cast<CVelKarvel&>(karvel).MoveShape(base, shift);
    CVelPrimitive a, b;
    karvel.GetPrimitive(own, a, 1);
    karvel.GetPrimitive(base, b, 1);
    EXPECT_EQ(a.groups[0].vertices[1].position.x, 11.0);
    EXPECT_EQ(b.groups[0].vertices[1].position.x, 11.0);
    // The modeller's own turns the normal only; the interface's translates it too.
    EXPECT_FLOAT_EQ(a.groups[0].vertices[1].normal.y, -1);
    EXPECT_NEAR(b.groups[0].vertices[1].normal.x, 10 / std::sqrt(101.0), 1e-6);
}

TEST(ModellerStore, CopyTakesTheModelAndStartsUninitialised)
{
    CVelGLKarvel karvel;
    CVelPrimitive p = Rectangle(0, 0, 1, 1, 0, Matte(1, 0, 0));
    karvel.AddPrimitive(p);
    DorColorValue blue(0, 0, 1, 1);
    karvel.SetBkColor(blue);
    TestWindow window(kWidth, kHeight);
    HDC dc = window.dc;
    ASSERT_EQ(karvel.Initialize(dc), 1);
    karvel.AddPrimitive(p);
    CVelGLKarvel copy(karvel);
    EXPECT_EQ(copy.renderState, nullptr);
    EXPECT_EQ(copy.context.handle, nullptr);
    EXPECT_EQ(copy.model.entities.GetCount(), 1);
    DorColorValue colour;
    copy.GetBkColor(colour);
    EXPECT_EQ(colour.b, 1.0f);
    copy = copy;
    EXPECT_EQ(copy.model.entities.GetCount(), 1);
}

TEST(ModellerLifecycle, FirstStartEmptiesTheModelThenASecondWindowKeepsModelTexturesAndCamera)
{
    TestWindow first(kWidth, kHeight);
    TestWindow second(2 * kWidth, kHeight);
    CVelGLKarvel karvel;
    HDC dc1 = first.dc;
    HDC dc2 = second.dc;
    _DorBitmap texture = HalfWhite(4);
    karvel.AddTexture(texture);
    CVelPrimitive p = Rectangle(-4, -2, 4, 2, 0, Matte(1, 0, 0));
    karvel.AddPrimitive(p);
    ASSERT_EQ(karvel.Initialize(dc1), 1);
    EXPECT_EQ(karvel.model.entities.GetCount(), 0);  // the first start empties the model
    EXPECT_EQ(karvel.GetTextureList()->GetSize(), 1);  // but keeps and uploads the textures
    EXPECT_TRUE(glIsTexture(1));
    _VelCamera camera;
    karvel.GetCamera(camera);
    EXPECT_DOUBLE_EQ(camera.aspect, 160.0 / 120.0);
    LookAlongY(karvel);
    p.groups[0].RenderKind = VelRenderTextured;
    p.groups[0].texture = 1;
    karvel.AddPrimitive(p);
    HGLRC firstContext = karvel.context.handle;

    EXPECT_EQ(karvel.SetCurrent(dc1), dc1);  // already current: nothing is re-created
    EXPECT_EQ(karvel.context.handle, firstContext);

    EXPECT_EQ(karvel.SetCurrent(dc2), dc1);
    EXPECT_EQ(karvel.GetCurrent(), dc2);
    _VelViewport viewport;
    karvel.GetViewport(viewport);
    EXPECT_EQ(viewport.width, kWidth);  // the viewport travels with the modeller
    _VelCamera moved;
    karvel.GetCamera(moved);
    EXPECT_EQ(moved.eye.y, -10);
    EXPECT_DOUBLE_EQ(moved.aspect, 160.0 / 120.0);
    karvel.DrawModel(dc2);
    EXPECT_GT(PixelAt(68, 60).r, 150);  // the black texels show the lit red
    EXPECT_LT(PixelAt(92, 60).r, 20);   // the white ones blend it away

    // Initialising on the second window takes its viewport and aspect ratio.
    ASSERT_EQ(karvel.Initialize(dc2), 1);
    karvel.GetViewport(viewport);
    EXPECT_EQ(viewport.width, 2 * kWidth);
    karvel.GetCamera(moved);
    EXPECT_DOUBLE_EQ(moved.aspect, 320.0 / 120.0);
    EXPECT_EQ(karvel.model.entities.GetCount(), 1);
    EXPECT_TRUE(glIsTexture(1));
    karvel.DrawModel(dc2);
    EXPECT_GT(PixelAt(148, 60).r, 150);
    EXPECT_LT(PixelAt(172, 60).r, 20);

    EXPECT_EQ(karvel.SetCurrent(dc1), dc2);  // and back
    karvel.DrawModel(dc1);
    EXPECT_EQ(karvel.GetCurrent(), dc1);
}
