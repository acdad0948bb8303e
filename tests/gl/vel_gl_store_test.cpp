#include <gtest/gtest.h>

#include <initializer_list>
#include <vector>

#include "gl/vel_gl_store.h"
#include "model/dor_math.h"

namespace {
// `count` vertices along x from x0 (y 1, z 2), each with its own normal, colour and texcoord;
// indexed groups get a fan of triangles over them.
CVelTrianglePolys Group(int type, int count, double x0, float alpha = 1)
{
    CVelTrianglePolys g;
    g.GroupType = type;
    g.material.diffuse = DorColorValue(0.9f, 0.2f, 0.3f, alpha);
    g.material.shininess = 12;
    g.RenderKind = type == VelGroupIndexed ? VelRenderTextured : VelRenderVertexColour;
    g.texture = 2;
    g.lineWidth = 3;
    g.OverlayFlag = 1;
    for (int i = 0; i < count; ++i) {
        _VelVertex v;
        v.position = DorVector3(x0 + i, 1, 2);
        v.normal = DorVector3(0, 0.6, 0.8);
        v.colour = DorColorValue(0.1f * static_cast<float>(i), 0.5f, 0.5f, 1);
        v.texcoord = DorVector2(i / 4.0, i / 8.0);
        g.vertices.Add(v);
        _VelTriangleIndex t(0, i - 1, i);
        if (type == VelGroupIndexed && i >= 2)
            g.triangles.Add(t);
    }
    return g;
}

CVelPrimitive Primitive(std::initializer_list<CVelTrianglePolys> groups, long drawMode = 2 | 8)
{
    CVelPrimitive p;
    for (CVelTrianglePolys g : groups)
        p.groups.Add(g);
    p.DrawMode = drawMode;
    return p;
}

// One VelChange* part of a primitive as a flat list, in single precision like the store.
std::vector<float> Part(const CVelPrimitive& p, long part)
{
    std::vector<float> v{static_cast<float>(p.groups.GetSize()), part == VelChangeDrawMode ? p.DrawMode : 0.0f};
    for (int g = 0; g < p.groups.GetSize(); ++g) {
        const CVelTrianglePolys& x = p.groups[g];
        auto add = [&v](std::initializer_list<double> values) { v.insert(v.end(), values.begin(), values.end()); };
        if (part == VelChangeMaterial) {
            v.insert(v.end(), &x.material.diffuse.r, &x.material.diffuse.r + 17);
            add({static_cast<double>(x.RenderKind)});
        }
        if (part == VelChangeTopology)
            add({static_cast<double>(x.GroupType), x.lineWidth, static_cast<double>(x.triangles.GetSize())});
        for (int i = 0; part == VelChangeTopology && i < x.triangles.GetSize(); ++i)
            add({static_cast<double>(x.triangles[i].a), static_cast<double>(x.triangles[i].b), static_cast<double>(x.triangles[i].c)});
        if (part == VelChangeTexture || part == VelChangeGeometry)
            add({static_cast<double>(part == VelChangeTexture ? x.texture : x.OverlayFlag), static_cast<double>(x.vertices.GetSize())});
        for (const _VelVertex& u : std::vector<_VelVertex>(x.vertices.GetData(), x.vertices.GetData() + x.vertices.GetSize()))
            if (part == VelChangeTexture)
                add({u.texcoord.x, u.texcoord.y});
            else if (part == VelChangeGeometry)
                add({u.position.x, u.position.y, u.position.z, u.normal.x, u.normal.y, u.normal.z, u.colour.r, u.colour.g, u.colour.b, u.colour.a});
    }
    return v;
}

// The parts in which two primitives differ.
long Differences(const CVelPrimitive& a, const CVelPrimitive& b)
{
    long parts = 0;
    for (long part = VelChangeGeometry; part <= VelChangeDrawMode; part <<= 1)
        parts |= Part(a, part) != Part(b, part) ? part : 0;
    return parts;
}
}  // namespace

// A model holding one entity: an indexed square of four corners, then a line strip of three.
class SquareAndStripEntity : public ::testing::Test {
protected:
    void SetUp() override { handle = model.AddPrimitive(original, scope); }
    const CVelGLTrianglePolygons& Stored(int group) { return CVelGLStructure::EntityAt(handle)->groups[group]; }

    CVelGLStructure model;
    CVelGLScope scope;
    CVelPrimitive original = Primitive({Group(VelGroupIndexed, 4, 0), Group(VelGroupLineStrip, 3, 10)});
    _DorPosition* handle = nullptr;
};

// Seven vertices of every group type: the OpenGL mode, the element count, and the type read back.
TEST(EntityStore, EveryGroupTypeConvertsToItsModeAndBack)
{
    const struct {
        int type, mode, elements;
    } rows[] = {{VelGroupPoints, VelGLPoints, 7},       {VelGroupLines, VelGLLines, 3},
                {VelGroupLineStrip, VelGLLineStrip, 6}, {VelGroupTriangles, VelGLTriangles, 2},
                {VelGroupTriangleStrip, VelGLTriangleStrip, 5}, {VelGroupTriangleFan, VelGLTriangleFan, 5},
                {VelGroupIndexed, VelGLTriangles, 5},   {9, VelGLModeNone, 0}};
    CVelGLStructure model;
    CVelGLScope scope;
    for (const auto& r : rows) {
        _DorPosition* handle = model.AddPrimitive(Primitive({Group(r.type, 7, 0)}), scope);
        const CVelGLTrianglePolygons& stored = CVelGLStructure::EntityAt(handle)->groups[0];
        EXPECT_EQ(stored.glMode, r.mode) << r.type;
        EXPECT_EQ(stored.elementCount, r.elements) << r.type;
        EXPECT_EQ(stored.indexed, r.type == VelGroupIndexed) << r.type;
        CVelPrimitive back;
        model.GetPrimitive(handle, back, VelChangeTopology, scope);
        EXPECT_TRUE(r.type == 9 || back.groups[0].GroupType == r.type) << r.type;
    }
}

TEST_F(SquareAndStripEntity, EachFlagReadsBackItsPartsAndOverwritesTheRest)
{
    for (long flags : {VelChangeGeometry, VelChangeMaterial, VelChangeTopology, VelChangeTexture, VelChangeDrawMode, VelChangeAll}) {
        // Read into a stale copy with a group too many: leftovers would show as "unchanged".
        CVelPrimitive out = original;
        CVelTrianglePolys extra = out.groups[1];
        out.groups.Add(extra);
        out.DrawMode = 2;
        model.GetPrimitive(handle, out, flags, scope);
        EXPECT_EQ(Differences(out, original), VelChangeAll & ~flags) << "flags " << flags;
    }
}

TEST_F(SquareAndStripEntity, EachFlagChangesOnlyItsParts)
{
    CVelPrimitive other = original;
    CVelTrianglePolys& g = other.groups[0];
    g.material.shininess = 50;
    g.RenderKind = VelRenderLit;
    g.GroupType = VelGroupTriangleFan;  // not indexed: reads back without triangles
    g.triangles.SetSize(0);
    g.texture = 9;
    g.vertices[1].texcoord = DorVector2(0.75, 0.25);
    g.vertices[1].position = DorVector3(-7, -7, -7);
    other.DrawMode = 1;
    ASSERT_EQ(Differences(other, original), VelChangeAll);
    // Same vertex counts: no in-place rewrite, so the geometry flag converts whole groups.
    for (long flags : {VelChangeGeometry, VelChangeMaterial, VelChangeTopology, VelChangeTexture, VelChangeDrawMode}) {
        const long changed = flags == VelChangeGeometry ? VelChangeAll & ~VelChangeDrawMode : flags;
        _DorPosition* entity = model.AddPrimitive(original, scope);
        model.ChangePrimitive(entity, other, flags, scope);
        CVelPrimitive now;
        model.GetPrimitive(entity, now, VelChangeAll, scope);
        EXPECT_EQ(Differences(now, other), VelChangeAll & ~changed) << "flags " << flags;
        EXPECT_EQ(Differences(now, original), changed) << "flags " << flags;
    }
    other.groups[0].RenderKind = 7;
    model.ChangePrimitive(handle, other, VelChangeMaterial, scope);
    EXPECT_EQ(Stored(0).RenderKind, VelRenderLit);  // unknown kinds are stored as lit
}

// Only a stored count three times the new one rewrites in place: the first vertices, nothing else.
TEST_F(SquareAndStripEntity, GeometryRewritesInPlaceOnlyAtThreeTimesTheCount)
{
    model.ChangePrimitive(handle, Primitive({original.groups[0], Group(VelGroupLineStrip, 6, 0)}), VelChangeAll, scope);
    CVelPrimitive two = Primitive({original.groups[0], Group(VelGroupLineStrip, 2, 50)});
    two.groups[1].material.diffuse.r = 0.05f;
    model.ChangePrimitive(handle, two, VelChangeGeometry, scope);
    EXPECT_EQ(Stored(1).vertexCount, 6);
    const float want[] = {50, 51, 2, 5}, got[] = {Stored(1).positions[0], Stored(1).positions[3], Stored(1).positions[6], Stored(1).positions[15]};
    EXPECT_EQ(std::vector<float>(got, got + 4), std::vector<float>(want, want + 4));
    EXPECT_EQ(Stored(1).material.diffuse.r, 0.9f);  // in place: the material is not taken

    CVelPrimitive one = Primitive({Group(VelGroupLineStrip, 12, 0)}, 0);  // another group count: all rebuilt
    model.ChangePrimitive(handle, one, VelChangeGeometry, scope);
    CVelPrimitive now;
    model.GetPrimitive(handle, now, VelChangeAll, scope);
    EXPECT_EQ(Differences(now, one), VelChangeDrawMode);
}

TEST_F(SquareAndStripEntity, TextureFromAShorterGroupKeepsTheRestAndNullHandlesDoNothing)
{
    CVelPrimitive shorter = original;
    shorter.groups[0].vertices.SetSize(1);
    shorter.groups[0].vertices[0].texcoord = DorVector2(0.5, 0.5);
    model.ChangePrimitive(handle, shorter, VelChangeTexture, scope);
    EXPECT_EQ(Stored(0).vertexCount, 4);
    EXPECT_EQ(Stored(0).texcoords[0], 0.5f);
    EXPECT_EQ(Stored(0).texcoords[7], 3 / 8.0f);

    model.GetPrimitive(nullptr, shorter, VelChangeAll, scope);
    model.ChangePrimitive(nullptr, shorter, VelChangeAll, scope);
    model.MoveEntity(nullptr, DorTranslate(1, 2, 3), scope);
    _DorPosition* none = nullptr;
    model.RemoveAt(none);
    model.MoveToHead(none);
    EXPECT_TRUE(none == nullptr && shorter.groups.GetSize() == 2 && model.entities.GetCount() == 1);
}

TEST(EntityStore, HandlesStayValidAcrossRemovalsMovesAndCopies)
{
    CVelGLStructure model;
    CVelGLScope scope;
    std::vector<_DorPosition*> handles;
    for (int i = 0; i < 23; ++i)  // three node blocks
        handles.push_back(model.AddPrimitive(Primitive({Group(VelGroupLineStrip, 2, i)}), scope));
    for (int i = 0; i < 23; i += 3)
        model.RemoveAt(handles[i]);
    EXPECT_EQ(handles[0], nullptr);
    model.MoveToHead(handles[22]);
    model.MoveToTail(handles[1]);
    CVelGLStructure copy(model);
    model.Destroy();
    copy = copy;
    std::vector<float> order;
    for (_DorPosition* p = copy.entities.GetHeadPosition(); p; p = CDorList::GetNextPosition(p))
        order.push_back(CVelGLStructure::EntityAt(p)->groups[0].positions[0]);
    std::vector<float> want = {22};
    for (int i = 2; i < 22; ++i)
        if (i % 3)
            want.push_back(static_cast<float>(i));
    want.push_back(1);
    EXPECT_EQ(order, want);

    _DorPosition* only = copy.AddPrimitive(Primitive({}), scope);
    for (int i = 0; i < 15; ++i) {
        _DorPosition* head = copy.entities.GetHeadPosition();
        copy.RemoveAt(head);
    }
    copy.MoveToHead(only);
    ASSERT_TRUE(only != nullptr && copy.entities.GetCount() == 1);
    EXPECT_EQ(CVelGLStructure::EntityAt(only)->groups.GetSize(), 0);
}

TEST(EntityStore, MoveEntityTurnsNormalsWithoutTranslatingThem)
{
    CVelGLStructure model;
    CVelGLScope scope;
    CVelPrimitive p = Primitive({Group(VelGroupPoints, 2, 0)});
    p.groups[0].vertices[1].normal = DorVector3(3, 0, 0);
    _DorPosition* handle = model.AddPrimitive(p, scope);
    model.MoveEntity(handle, DorRotateZ(DorPi / 2) * DorTranslate(10, 20, 30), scope);
    const CVelGLTrianglePolygons& moved = CVelGLStructure::EntityAt(handle)->groups[0];
    // Point (1, 1, 2) turns to (-1, 1, 2), then moves; its normal (3, 0, 0) turns to the unit +y.
    EXPECT_LE(DorLength(DorVector3(moved.positions[3], moved.positions[4], moved.positions[5]) - DorVector3(9, 21, 32)), 1e-5);
    EXPECT_LE(DorLength(DorVector3(moved.normals[3], moved.normals[4], moved.normals[5]) - DorVector3(0, 1, 0)), 1e-7);
}

// Each filter bit drops its groups from the box: 1 points, 2 lines (not strips), 4 everything,
// 8 the transparent; hidden (1) and unpickable (4) entities never count.
TEST(EntityStore, CentreAndBoundingBoxOfTheFilteredGroups)
{
    CVelGLStructure model;
    CVelGLScope scope;
    DorVector3 low, high, centre;
    EXPECT_FALSE(model.GetBoundingBox(low, high, 0, 1.0));
    centre = DorVector3(5, 5, 5);
    model.GetCenterPoint(centre, 0, 1.0);
    EXPECT_EQ(DorLength(centre), 0.0);
    model.AddPrimitive(Primitive({Group(VelGroupIndexed, 5, 2)}), scope);  // x 2..6
    model.AddPrimitive(Primitive({Group(VelGroupPoints, 2, -100)}), scope);
    model.AddPrimitive(Primitive({Group(VelGroupLines, 2, 100)}), scope);
    model.AddPrimitive(Primitive({Group(VelGroupLineStrip, 2, 300)}), scope);
    model.AddPrimitive(Primitive({Group(VelGroupTriangles, 3, 500, 0.5f)}), scope);
    model.AddPrimitive(Primitive({Group(VelGroupTriangles, 3, 900)}, 1 | 2), scope);
    model.AddPrimitive(Primitive({Group(VelGroupTriangles, 3, -900)}, 4), scope);
    const struct {
        int filter;
        double scale, low, high;
    } rows[] = {{0, 1, -100, 502}, {1, 1, 2, 502}, {1 | 2 | 8, 1, 2, 301}, {1 | 2, 2, 1, 251}, {2 | 8, 1, -100, 301}};
    for (const auto& r : rows) {
        ASSERT_TRUE(model.GetBoundingBox(low, high, r.filter, r.scale)) << r.filter;
        model.GetCenterPoint(centre, r.filter, r.scale);
        EXPECT_TRUE(low.x == r.low && high.x == r.high && low.z == 2 / r.scale && high.y == 1 / r.scale) << r.filter;
        EXPECT_TRUE(centre.x == (r.low + r.high) / 2 && centre.z == 2 / r.scale) << r.filter;
    }
    DorVector3 untouched(7, 7, 7);
    EXPECT_FALSE(model.GetBoundingBox(untouched, untouched, 4, 1.0));
    EXPECT_EQ(untouched.x, 7.0);
}

TEST(TextureList, PowerOfTwoPixelCountsWithinEachLimitWithWholePixelArrays)
{
    const struct {
        int width, height, bits, missing;
        bool add, change;
    } rows[] = {
        {16, 16, 24, 0, true, true},  {3, 5, 24, 0, false, false}, {512, 512, 24, 0, true, false},
        {1024, 512, 24, 0, false, false}, {1, 1, 24, 0, false, false}, {16, 16, 8, 0, false, false},
        {2, 8, 32, 0, true, true},    {1, 64, 1, 0, true, true},   {256, 256, 24, 0, true, true},
        {16, -16, 24, 0, false, false}, {4, 4, 24, 1, false, false},
    };
    for (const auto& r : rows) {
        _DorBitmap b;
        b.info.width = r.width;
        b.info.height = r.height;
        b.info.bitCount = static_cast<uint16_t>(r.bits);
        b.bits.SetSize(DorBitmapRowBytes(r.width, r.bits) * (r.height < 0 ? -r.height : r.height) - r.missing);
        EXPECT_EQ(VelTextureAcceptable(b, VelAddTextureLimit), r.add) << r.width << "x" << r.height;
        EXPECT_EQ(VelTextureAcceptable(b, VelChangeTextureLimit), r.change) << r.width << "x" << r.height;
        EXPECT_EQ(VelTexturePixelsPresent(b), r.missing == 0) << r.width << "x" << r.height;
        CVelGLStructure model;
        EXPECT_EQ(model.AddTexture(b), r.add ? 1u : 0u);
    }
}

TEST(TextureList, NamesFollowTheListAndChangeReplacesInPlace)
{
    CVelGLStructure model;
    _DorBitmap b;
    b.info.width = b.info.height = 16;
    b.bits.SetSize(16 * 48);
    b.bits[0] = 7;
    EXPECT_EQ(model.AddTexture(b), 1u);
    EXPECT_EQ(model.AddTexture(b), 2u);
    b.bits[0] = 9;
    EXPECT_EQ(model.ChangeTexture(2, b), 1);
    EXPECT_EQ(model.textures[1].bits[0] * 10 + model.textures[0].bits[0], 97);
    EXPECT_EQ(model.ChangeTexture(0, b) + model.ChangeTexture(3, b), 0);
    model.RemoveAllTexture();
    EXPECT_EQ(model.AddTexture(b), 1u);
}

TEST(IndexRange, EveryIndexMustNameAVertex)
{
    const unsigned int ok[] = {0, 1, 2, 2, 3, 0}, negative[] = {0, 0xFFFFFFFFu, 1};  // -1 as stored
    EXPECT_TRUE(VelIndicesInRange(ok, 6, 4));
    EXPECT_FALSE(VelIndicesInRange(ok, 6, 3));
    EXPECT_FALSE(VelIndicesInRange(negative, 3, 4));
    EXPECT_TRUE(VelIndicesInRange(nullptr, 0, 0));
    EXPECT_FALSE(VelIndicesInRange(ok, 3, 0));
}
