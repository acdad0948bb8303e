#include <gtest/gtest.h>

#include <cstdlib>
#include <initializer_list>
#include <vector>

#include "gl/vel_gl_store.h"
#include "model/dor_math.h"

namespace {
// `count` vertices along x from x0 (y 1, z 2), each with its own colour and texcoord; indexed
// groups get a fan of triangles over them.
CVelTrianglePolys Group(int type, int count, double x0, float alpha = 1)
{
    CVelTrianglePolys g;
    g.GroupType = type;
    g.material.diffuse.a = alpha;
    g.material.shininess = 12;
    g.RenderKind = VelRenderTextured;
    g.texture = 2;
    g.lineWidth = 3;
    g.OverlayFlag = 1;
    g.vertices.SetSize(count);
    g.triangles.SetSize(type == VelGroupIndexed && count > 2 ? count - 2 : 0);
    for (int i = 0; i < count; ++i) {
        g.vertices[i].position = DorVector3(x0 + i, 1, 2);
        g.vertices[i].normal = DorVector3(0, 0.6, 0.8);
        g.vertices[i].colour = DorColorValue(0.1f * static_cast<float>(i), 0.5f, 0.5f, 1);
        g.vertices[i].texcoord = DorVector2(i / 4.0, i / 8.0);
    }
    for (int t = 0; t < g.triangles.GetSize(); ++t)
        g.triangles[t] = _VelTriangleIndex(0, t + 1, t + 2);
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
    auto add = [&v](std::initializer_list<double> values) { v.insert(v.end(), values.begin(), values.end()); };
    for (int g = 0; g < p.groups.GetSize(); ++g) {
        const CVelTrianglePolys& x = p.groups[g];
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
        for (int i = 0; i < x.vertices.GetSize(); ++i) {
            const _VelVertex& u = x.vertices[i];
            if (part == VelChangeTexture)
                add({u.texcoord.x, u.texcoord.y});
            if (part == VelChangeGeometry)
                add({u.position.x, u.position.y, u.position.z, u.normal.x, u.normal.y, u.normal.z, u.colour.r, u.colour.g, u.colour.b, u.colour.a});
        }
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
    CVelGLStructure model;
    CVelGLScope scope;
    CVelPrimitive original = Primitive({Group(VelGroupIndexed, 4, 0), Group(VelGroupLineStrip, 3, 10)});
    _DorPosition* handle = nullptr;
};

// Each flag reads back its parts and overwrites the rest (read into a stale copy with a group too
// many, leftovers would show as "unchanged"), and changes only its parts. Same vertex counts take
// no in-place rewrite, so the geometry flag converts whole groups.
TEST_F(SquareAndStripEntity, EachFlagReadsAndChangesOnlyItsParts)
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
    for (long flags : {VelChangeGeometry, VelChangeMaterial, VelChangeTopology, VelChangeTexture, VelChangeDrawMode, VelChangeAll}) {
        CVelPrimitive stale = Primitive({Group(VelGroupPoints, 5, 0), Group(VelGroupPoints, 5, 0), Group(VelGroupPoints, 5, 0)}, 2), now;
        model.GetPrimitive(handle, stale, flags, scope);
        const long changed = flags == VelChangeGeometry ? VelChangeAll & ~VelChangeDrawMode : flags;
        _DorPosition* entity = model.AddPrimitive(original, scope);
        model.ChangePrimitive(entity, other, flags, scope);
        model.GetPrimitive(entity, now, VelChangeAll, scope);
        EXPECT_EQ(Differences(stale, original), VelChangeAll & ~flags) << flags;
        EXPECT_TRUE(Differences(now, other) == (VelChangeAll & ~changed) && Differences(now, original) == changed) << flags;
    }
    other.groups[0].RenderKind = 7;
    model.ChangePrimitive(handle, other, VelChangeMaterial, scope);
    EXPECT_EQ(model.EntityAt(handle)->groups[0].RenderKind, VelRenderLit);  // unknown kinds are stored as lit
}

// Only a stored count three times the new one rewrites in place: the first vertices, nothing else.
TEST_F(SquareAndStripEntity, GeometryRewritesInPlaceOnlyAtThreeTimesTheCount)
{
    model.ChangePrimitive(handle, Primitive({original.groups[0], Group(VelGroupLineStrip, 6, 0)}), VelChangeAll, scope);
    CVelPrimitive two = Primitive({original.groups[0], Group(VelGroupLineStrip, 2, 50)});
    two.groups[1].material.diffuse.r = 0.05f;
    model.ChangePrimitive(handle, two, VelChangeGeometry, scope);
    const CVelGLTrianglePolygons& stored = model.EntityAt(handle)->groups[1];
    EXPECT_TRUE(stored.vertexCount == 6 && stored.material.diffuse.r != 0.05f);  // in place: the material is not taken
    EXPECT_TRUE(stored.positions[0] == 50 && stored.positions[3] == 51 && stored.positions[6] == 2 && stored.positions[15] == 5);
}

TEST(EntityStore, MoveEntityTurnsNormalsWithoutTranslatingThem)
{
    CVelGLStructure model;
    CVelGLScope scope;
    CVelPrimitive p = Primitive({Group(VelGroupPoints, 2, 0)});
    p.groups[0].vertices[1].normal = DorVector3(3, 0, 0);
    _DorPosition* handle = model.AddPrimitive(p, scope);
    model.MoveEntity(handle, DorRotateZ(DorPi / 2) * DorTranslate(10, 20, 30), scope);
    const float* moved = &model.EntityAt(handle)->groups[0].positions[3];
    const float* normal = &model.EntityAt(handle)->groups[0].normals[3];
    // Point (1, 1, 2) turns to (-1, 1, 2), then moves; its normal (3, 0, 0) turns to the unit +y.
    EXPECT_LE(DorLength(DorVector3(moved[0], moved[1], moved[2]) - DorVector3(9, 21, 32)) + DorLength(DorVector3(normal[0], normal[1], normal[2]) - DorVector3(0, 1, 0)), 1e-5);
}

// Each filter bit drops its groups from the box: 1 points, 2 lines (not strips), 4 everything,
// 8 the transparent; hidden (1) and unpickable (4) entities never count.
TEST(EntityStore, CentreAndBoundingBoxOfTheFilteredGroups)
{
    CVelGLStructure model;
    CVelGLScope scope;
    DorVector3 low, high, centre(5, 5, 5);
    model.GetCenterPoint(centre, 0, 1.0);
    EXPECT_TRUE(DorLength(centre) == 0.0 && !model.GetBoundingBox(low, high, 0, 1.0));
    const struct { int type; double x; float alpha; long drawMode; } entities[] = {
        {VelGroupIndexed, 2, 1, 2}, {VelGroupPoints, -100, 1, 2}, {VelGroupLines, 700, 1, 2}, {VelGroupLineStrip, 300, 1, 2},
        {VelGroupTriangles, 500, 0.5f, 2}, {VelGroupTriangles, 900, 1, 1 | 2}, {VelGroupTriangles, -900, 1, 4}};
    for (const auto& e : entities)
        model.AddPrimitive(Primitive({Group(e.type, 3, e.x, e.alpha)}, e.drawMode), scope);
    const struct { int filter; double scale, low, high; } rows[] = {
        {0, 1, -100, 702}, {1, 1, 2, 702}, {1 | 2 | 8, 1, 2, 302}, {1 | 2, 2, 1, 251}, {2 | 8, 1, -100, 302}};
    for (const auto& r : rows) {
        ASSERT_TRUE(model.GetBoundingBox(low, high, r.filter, r.scale)) << r.filter;
        model.GetCenterPoint(centre, r.filter, r.scale);
        EXPECT_TRUE(low.x == r.low && high.x == r.high && low.z == 2 / r.scale && high.y == 1 / r.scale &&
                    centre.x == (r.low + r.high) / 2 && centre.z == 2 / r.scale) << r.filter;
    }
    DorVector3 untouched(7, 7, 7);
    EXPECT_TRUE(!model.GetBoundingBox(untouched, untouched, 4, 1.0) && untouched.x == 7.0);
    _DorPosition* none = nullptr;  // null handles change nothing
    model.RemoveAt(none);
    model.MoveEntity(nullptr, DorTranslate(1, 2, 3), scope);
    EXPECT_TRUE(model.GetBoundingBox(low, high, 0, 1.0) && low.x == -100 && high.x == 702 && model.entities.GetCount() == 7);
}

// A handle that is not live in the model (removed, another model's, from a model emptied since,
// never issued) is refused by every operation without being read (ASan would see the emptied
// model's freed node). A copy's handles are its own; a reused node address is live again.
TEST(EntityStore, HandlesThatAreNotLiveAreRefusedUntilTheirAddressIsReused)
{
    CVelGLStructure model, other, emptied;
    CVelGLScope scope;
    const CVelPrimitive p = Primitive({Group(VelGroupTriangles, 3, 0)});
    _DorPosition* live = model.AddPrimitive(p, scope);
    _DorPosition* removed = model.AddPrimitive(p, scope);
    _DorPosition* alias = removed;
    model.RemoveAt(alias);
    _DorPosition* destroyed = emptied.AddPrimitive(p, scope);
    emptied.Destroy();
    char unrelated[64] = {};
    for (_DorPosition* stale : {removed, other.AddPrimitive(p, scope), destroyed, reinterpret_cast<_DorPosition*>(unrelated)}) {
        _DorPosition* handle = stale;
        CVelPrimitive read = Primitive({Group(VelGroupPoints, 5, 0)});
        model.ChangePrimitive(handle, read, VelChangeAll, scope);
        model.GetPrimitive(handle, read, VelChangeAll, scope);
        model.MoveEntity(handle, DorTranslate(1, 2, 3), scope);
        model.MoveToHead(handle);
        model.MoveToTail(handle);
        model.RemoveAt(handle);
        EXPECT_TRUE(handle == stale && !model.EntityAt(stale) && read.groups[0].vertices.GetSize() == 5);
    }
    CVelPrimitive now;
    model.GetPrimitive(live, now, VelChangeAll, scope);
    EXPECT_TRUE(Differences(now, p) == 0 && model.entities.GetCount() == 1);
    EXPECT_FALSE(CVelGLStructure(model).IsLive(live));
    EXPECT_TRUE(model.AddPrimitive(now, scope) == removed && model.IsLive(removed));
    model.MoveToTail(live);  // the handle written back is live
    EXPECT_TRUE(model.IsLive(live) && model.entities.GetTailPosition() == live);
    model.Destroy();
    EXPECT_FALSE(model.IsLive(live) || model.IsLive(removed));
}

// Texture names count from 1 along the list; a change needs a name in it and the smaller limit.
TEST(TextureList, PowerOfTwoPixelCountsWithinEachLimitWithWholePixelArrays)
{
    const struct { int width, height, bits, missing; bool add, change; } rows[] = {
        {16, 16, 24, 0, true, true},    {2, 8, 32, 0, true, true},     {1, 64, 1, 0, true, true},
        {1, 2, 24, 0, true, true},      {512, 512, 24, 0, true, false}, {3, 5, 24, 0, false, false},
        {1, 1, 24, 0, false, false},    {1024, 512, 24, 0, false, false}, {16, 16, 8, 0, false, false},
        {16, -16, 24, 0, false, false}, {4, 4, 24, 1, false, false}};
    CVelGLStructure model;
    _DorBitmap first;
    first.info.width = first.info.height = 2;
    first.bits.SetSize(16);
    ASSERT_EQ(model.AddTexture(first), 1u);
    for (const auto& r : rows) {
        _DorBitmap b;
        b.info = DorBitmapInfoHeader{40, r.width, r.height, 1, static_cast<uint16_t>(r.bits), 0, 0, 0, 0, 0, 0};
        b.bits.SetSize(DorBitmapRowBytes(r.width, r.bits) * std::abs(r.height) - r.missing);
        SCOPED_TRACE(::testing::Message() << r.width << "x" << r.height << " at " << r.bits);
        EXPECT_TRUE(VelTexturePixelsPresent(b) == (r.missing == 0) && model.AddTexture(b) == (r.add ? 2u : 0u));
        EXPECT_EQ(model.ChangeTexture(1, b) + 10 * (model.ChangeTexture(0, b) + model.ChangeTexture(3, b)), r.change);
        EXPECT_TRUE(model.textures[r.add].info.width == (r.add || r.change ? r.width : 2));
        model.textures.SetSize(1);
        model.textures[0] = first;
    }
}
