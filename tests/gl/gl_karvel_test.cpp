// The OpenGL modeller in real windows: what a host sees after DrawModel, and what checked mode
// reports to it.
#include <gtest/gtest.h>

#include <cstdlib>
#include <functional>
#include <limits>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include "convert/dor_shape.h"
#include "support/gl_live_modeller.h"

namespace {
void Collect(const char* message, void* reports) { static_cast<std::vector<std::string>*>(reports)->push_back(message); }

// k: the background, r/g: lit red/green, b: blue through the ambient terms only, m: half-
// transparent red over blue, d: a white texel (blended to black), o: the overlay's own green.
bool Shows(char kind, const Rgb& c)
{
    switch (kind) {
    case 'k': return std::abs(c.r - 51) <= 1 && std::abs(c.g - 102) <= 1 && std::abs(c.b - 153) <= 1;
    case 'r': return c.r > 150 && c.g < 30;
    case 'g': return c.g > 150 && c.r < 30;
    case 'b': return c.b > 30 && c.r < 5;
    case 'm': return c.r > 60 && c.b > 40 && c.g < 30;
    case 'd': return c.r < 20 && c.g < 20 && c.b < 20;
    case 'o': return c.g == 255 && c.r == 0;
    }
    return false;
}
}  // namespace

// Every kind of group in one scene, drawn twice: the second time the first red rectangle has
// gone to the tail, the hidden one is shown again, and the cull mode is two-sided.
TEST_F(LiveModeller, EachKindOfGroupDrawsInOneFrame)
{
    DorColorValue background(0.2f, 0.4f, 0.6f, 0.25f);  // frames clear opaque
    karvel.SetBkColor(background);
    _DorPosition* first = Add(Rectangle(-12, 4, -8, 8, 0, Matte(1, 0, 0)));
    Add(Rectangle(-12, 4, -8, 8, 0, Matte(0, 1, 0)));  // equal depth: the first drawn stays
    Add(Rectangle(-12, 2, 0, 14, 5, Matte(0, 0, 1)));
    Add(Rectangle(-6, 4, -2, 8, 0, Matte(1, 0, 0, 0.5f)));
    Add(Rectangle(-4, 5, 0, 9, 2, Matte(0, 1, 0)));  // behind the transparent one, drawn after it
    CVelPrimitive coloured = Rectangle(1, 4, 5, 8, 0, Matte(0, 0, 0));
    coloured.groups[0].RenderKind = VelRenderVertexColour;
    for (int i = 0; i < 4; ++i)
        coloured.groups[0].vertices[i].colour = DorColorValue(0, 0, 1, 1);
    Add(coloured);
    CVelPrimitive back = Rectangle(8, 4, 12, 8, 0, Matte(1, 1, 0));
    std::swap(back.groups[0].vertices[1], back.groups[0].vertices[2]);  // clockwise
    Add(back);
    Add(Rectangle(-12, -2, -4, 2, 0, Matte(1, 0, 0), true));
    // Indexed: two red groups whose indices leave the vertex array, then a green one.
    CVelPrimitive indexed = Rectangle(-1, -2, 3, 2, 0, Matte(1, 0, 0));
    CVelTrianglePolys& bad = indexed.groups[0];
    bad.GroupType = VelGroupIndexed;
    _VelTriangleIndex upper(2, 1, 3), lower(0, 1, 2), outside(0, 1, 4000000), negative(0, -1, 2);
    bad.triangles.Add(upper);
    bad.triangles.Add(outside);
    CVelTrianglePolys wrapped = bad, valid = bad;
    wrapped.triangles[1] = negative;
    valid.triangles[1] = lower;
    valid.material = Matte(0, 1, 0);
    indexed.groups.Add(wrapped);
    indexed.groups.Add(valid);
    Add(indexed);
    _DorPosition* hidden = Add(Rectangle(6, -2, 10, 2, 0, Matte(0, 1, 0)));
    karvel.SetDrawMode(hidden, 1);
    // Overlay lines, placed in window pixels and unlit: down the centres of columns 20 and 40,
    // 3 and 1 pixels wide.
    CVelPrimitive lines;
    for (double col : {20.5, 40.5}) {
        CVelTrianglePolys g;
        g.GroupType = VelGroupLines;
        g.OverlayFlag = 1;
        g.lineWidth = col < 30 ? 3 : 1;
        g.material = Matte(0, 1, 0);
        AddVertex(g, col, 78, 0);
        AddVertex(g, col, 114, 0);
        lines.groups.Add(g);
    }
    Add(lines);

    struct Spot {
        int col, row;
        char before, after;
    } spots[] = {{20, 24, 'r', 'g'}, {50, 24, 'm', 'm'},  {62, 24, 'g', 'g'}, {98, 24, 'b', 'b'}, {140, 24, 'k', 'k'},
                 {20, 60, 'r', 'r'}, {44, 60, 'd', 'd'},  {92, 54, 'g', 'g'}, {128, 60, 'k', 'g'}, {152, 108, 'k', 'k'},
                 {19, 96, 'o', 'o'}, {21, 96, 'o', 'o'},  {40, 96, 'o', 'o'}, {18, 96, 'k', 'k'},  {22, 96, 'k', 'k'},
                 {39, 96, 'k', 'k'}, {41, 96, 'k', 'k'}};
    for (int frame = 0; frame < 2; ++frame) {
        karvel.DrawModel(window.dc);
        for (const Spot& s : spots) {
            Rgb c = PixelAt(s.col, s.row);
            EXPECT_TRUE(Shows(frame ? s.after : s.before, c))
                << "frame " << frame << " at " << s.col << "," << s.row << ": " << c.r << " " << c.g << " " << c.b;
        }
        GLint twoSided = -1;
        glGetIntegerv(GL_LIGHT_MODEL_TWO_SIDE, &twoSided);
        EXPECT_EQ(twoSided, frame);
        karvel.MoveDepthToTail(first);
        karvel.SetDrawMode(hidden, 2);
        karvel.SetCullMode(5);
    }
}

TEST_F(LiveModeller, UninitialisedDoesNothingAndASecondWindowKeepsModelTexturesAndCamera)
{
    CVelGLKarvel idle;  // the frame, pick and capture calls return at once
    CDorArray<_VelSelect, _VelSelect&> hits;
    _DorBitmap bitmap;
    _DORRECT rect = {0, 0, 8, 8};
    idle.DrawModel(window.dc);
    idle.HitTest(window.dc, 80, 60, hits);
    idle.ToBitmap(bitmap, rect);
    EXPECT_EQ(hits.GetSize() + bitmap.bits.GetSize(), 0);
    EXPECT_EQ(idle.SetCurrent(window.dc), window.dc);

    karvel.Finalize();
    Add(Rectangle(0, 0, 1, 1, 0, Matte(1, 0, 0)));
    ASSERT_EQ(karvel.Initialize(window.dc), 1);
    EXPECT_EQ(karvel.model.entities.GetCount(), 0);  // the first start empties the model
    EXPECT_TRUE(glIsTexture(1));                       // but keeps and uploads the textures
    LookAlongY(karvel);
    Add(Rectangle(-4, -2, 4, 2, 0, Matte(1, 0, 0), true));
    HGLRC context = karvel.context.handle;
    EXPECT_EQ(karvel.SetCurrent(window.dc), window.dc);  // already current: nothing is re-created
    EXPECT_EQ(karvel.context.handle, context);

    TestWindow second(2 * kWidth, kHeight);
    EXPECT_EQ(karvel.SetCurrent(second.dc), window.dc);
    EXPECT_EQ(karvel.GetCurrent(), second.dc);
    karvel.DrawModel(second.dc);  // the viewport and camera travel with the modeller
    EXPECT_GT(PixelAt(68, 60).r, 150);  // the black texels show the lit red
    EXPECT_LT(PixelAt(92, 60).r, 20);   // the white ones blend it away
    ASSERT_EQ(karvel.Initialize(second.dc), 1);  // takes the second window's viewport and aspect ratio
    karvel.DrawModel(second.dc);
    EXPECT_GT(PixelAt(148, 60).r, 150);
    EXPECT_LT(PixelAt(172, 60).r, 20);

    EXPECT_EQ(karvel.SetCurrent(window.dc), second.dc);  // and back, with the wide viewport
    karvel.DrawModel(window.dc);
    EXPECT_GT(PixelAt(148, 60).r, 150);
}

// Each misuse the library can see is reported to the host's callback, once, and nothing is
// reported with the mode off.
TEST_F(LiveModeller, CheckedModeReportsEachMisuseOnce)
{
    const double nan = std::numeric_limits<double>::quiet_NaN();
    _DorPosition* removed = Add(Rectangle(0, 0, 1, 1, 0, Matte(1, 0, 0)));
    _DorPosition* alias = removed;
    karvel.RemoveShapeAt(alias);
    CDorExtruded box(CDorPolygon({{0, 0, 0}, {1, 0, 0}, {1, 1, nan}, {0, 1, 0}}), DorVector3(0, 0, 1));
    CDorShape shape;
    shape.Add(&box);
    _VelCamera camera;
    karvel.GetCamera(camera);
    _DorBitmap oneBit;
    DorBitmapAllocate(oneBit, 8, 8, 1);
    CVelGLKarvel other;
    CDorArray<_VelSelect, _VelSelect&> hits;
    const struct {
        std::vector<const char*> reports;
        std::function<void()> misuse;
    } rows[] = {
        {{"not live"}, [&] { karvel.SetDrawMode(removed, 0); }},
        {{"non-finite coordinate"}, [&] { karvel.AddShape(shape); }},
        {{"non-finite camera"}, [&] { karvel.SetCamera(_VelCamera{camera.eye, camera.target, nan, 1, 100, 1}), LookAlongY(karvel); }},
        {{"SetCamera called from a thread other"}, [&] { std::thread([&] { LookAlongY(karvel); }).join(); }},
        {{"AddTexture while live", "texture 2 gets no image"}, [&] { karvel.AddTexture(oneBit), karvel.Initialize(window.dc); }},
        {{"DrawModel while the modeller's context is not current"}, [&] { other.Initialize(window.dc), karvel.DrawModel(window.dc); }},
        {{"HitTest while the modeller's context is not current"}, [&] { other.Finalize(), karvel.HitTest(window.dc, 1, 1, hits); }},
    };
    for (int on : {1, 0}) {
        std::vector<std::string> reports;
        CVelKarvel::SetCheckedMode(on, Collect, &reports);
        for (const auto& row : rows) {
            reports.clear();
            row.misuse();
            EXPECT_EQ(reports.size(), on ? row.reports.size() : 0u) << row.reports[0] << (reports.empty() ? "" : ": " + reports[0]);
            for (size_t i = 0; i < reports.size() && i < row.reports.size(); ++i)
                EXPECT_NE(reports[i].find(row.reports[i]), std::string::npos) << reports[i];
        }
        karvel.Initialize(window.dc);
    }
    CVelKarvel::SetCheckedMode(0, nullptr, nullptr);
}
