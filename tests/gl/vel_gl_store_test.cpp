#include <gtest/gtest.h>

#include <initializer_list>
#include <vector>

#include "gl/vel_gl_store.h"
#include "model/dor_math.h"

namespace {
void AddVertex(CVelTrianglePolys& g, double x, double y, double z, float shade)
{
    _VelVertex v;
    v.position = DorVector3(x, y, z);
    v.normal = DorVector3(0, 0.6, 0.8);
    v.colour = DorColorValue(shade, 1 - shade, 0.5f, 1);
    v.texcoord = DorVector2(x / 4, y / 8);
    g.vertices.Add(v);
}

void AddTriangle(CVelTrianglePolys& g, int a, int b, int c)
{
    _VelTriangleIndex t(a, b, c);
    g.triangles.Add(t);
}

_DorMaterial Material(float red, float alpha)
{
    _DorMaterial m;
    m.diffuse = DorColorValue(red, 0.2f, 0.3f, alpha);
    m.ambient = DorColorValue(red / 2, 0.1f, 0.1f, 1);
    m.specular = DorColorValue(0.5f, 0.5f, 0.5f, 1);
    m.emission = DorColorValue(0.25f, 0, 0, 1);
    m.shininess = 12;
    return m;
}

// A textured square of side `side` at height z, as two indexed triangles over four corners.
CVelTrianglePolys Square(double side, double z)
{
    CVelTrianglePolys g;
    g.GroupType = VelGroupIndexed;
    g.material = Material(0.9f, 1);
    g.RenderKind = VelRenderTextured;
    g.texture = 2;
    AddVertex(g, 0, 0, z, 0.1f);
    AddVertex(g, side, 0, z, 0.2f);
    AddVertex(g, side, side, z, 0.3f);
    AddVertex(g, 0, side, z, 0.4f);
    AddTriangle(g, 0, 1, 2);
    AddTriangle(g, 0, 2, 3);
    return g;
}

// A per-vertex coloured line strip through `count` points along x, drawn 3 pixels wide.
CVelTrianglePolys Strip(int count, double x0)
{
    CVelTrianglePolys g;
    g.GroupType = VelGroupLineStrip;
    g.material = Material(0.1f, 0.5f);
    g.RenderKind = VelRenderVertexColour;
    g.lineWidth = 3;
    g.OverlayFlag = 1;
    for (int i = 0; i < count; ++i)
        AddVertex(g, x0 + i, 1, 2, 0.1f * static_cast<float>(i));
    return g;
}

// The square, then a strip of three points.
CVelPrimitive SquareAndStrip()
{
    CVelPrimitive p;
    CVelTrianglePolys square = Square(4, 1);
    CVelTrianglePolys strip = Strip(3, 10);
    p.groups.Add(square);
    p.groups.Add(strip);
    p.DrawMode = 2 | 8;
    return p;
}

// One VelChange* part of a primitive as a flat list, in single precision like the store.
std::vector<float> Part(const CVelPrimitive& p, long part)
{
    std::vector<float> v{static_cast<float>(p.groups.GetSize())};
    if (part == VelChangeDrawMode)
        v.push_back(static_cast<float>(p.DrawMode));
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
        for (int i = 0; i < x.vertices.GetSize(); ++i) {
            const _VelVertex& u = x.vertices[i];
            if (part == VelChangeTexture)
                add({u.texcoord.x, u.texcoord.y});
            if (part == VelChangeGeometry)
                add({u.position.x, u.position.y, u.position.z, u.normal.x, u.normal.y, u.normal.z,
                     u.colour.r, u.colour.g, u.colour.b, u.colour.a});
        }
    }
    return v;
}

// The parts in which two primitives differ.
long Differences(const CVelPrimitive& a, const CVelPrimitive& b)
{
    long parts = 0;
    for (long part = VelChangeGeometry; part <= VelChangeDrawMode; part <<= 1)
        if (Part(a, part) != Part(b, part))
            parts |= part;
    return parts;
}

// A bitmap whose pixel array is `missing` bytes shorter than its header claims.
_DorBitmap Bitmap(int width, int height, int bits = 24, int missing = 0)
{
    _DorBitmap b;
    b.info.width = width;
    b.info.height = height;
    b.info.bitCount = static_cast<uint16_t>(bits);
    b.bits.SetSize(DorBitmapRowBytes(width, bits) * (height < 0 ? -height : height) - missing);
    return b;
}

std::vector<CVelGLEntity*> ListOrder(const CVelGLStructure& model)
{
    std::vector<CVelGLEntity*> out;
    for (_DorPosition* p = model.entities.GetHeadPosition(); p; p = CDorList::GetNextPosition(p))
        out.push_back(CVelGLStructure::EntityAt(p));
    return out;
}
}  // namespace

// A model holding one square-and-strip entity, read back and changed under each flag.
class SquareAndStripEntity : public ::testing::Test {
protected:
    void SetUp() override { handle = model.AddPrimitive(original, scope); }

    CVelPrimitive ReadBack(long flags) const
    {
        CVelPrimitive out;
        model.GetPrimitive(handle, out, flags, scope);
        return out;
    }

    CVelGLStructure model;
    CVelGLScope scope;
    CVelPrimitive original = SquareAndStrip();
    _DorPosition* handle = nullptr;
};

TEST_F(SquareAndStripEntity, ConversionGivesOpenGLModesAndCounts)
{
    const CVelGLEntity* entity = CVelGLStructure::EntityAt(handle);
    ASSERT_EQ(entity->groups.GetSize(), 2);
    const CVelGLTrianglePolygons& square = entity->groups[0];
    EXPECT_EQ(square.indexed, 1);
    EXPECT_EQ(square.glMode, VelGLTriangles);
    EXPECT_EQ(square.elementCount, 2);
    const CVelGLTrianglePolygons& strip = entity->groups[1];
    EXPECT_EQ(strip.glMode, VelGLLineStrip);
    EXPECT_EQ(strip.elementCount, 2);
    EXPECT_EQ(strip.indexed, 0);
}

TEST_F(SquareAndStripEntity, EachFlagReadsBackItsPartsAndOverwritesTheRest)
{
    for (long flags : {VelChangeGeometry, VelChangeMaterial, VelChangeTopology, VelChangeTexture,
                       VelChangeDrawMode, VelChangeAll}) {
        // Read into a stale copy with a group too many: leftovers would show as "unchanged".
        CVelPrimitive out = original;
        CVelTrianglePolys extra = Strip(5, 0);
        out.groups.Add(extra);
        out.DrawMode = 2;
        model.GetPrimitive(handle, out, flags, scope);
        ASSERT_EQ(out.groups.GetSize(), 2) << "flags " << flags;
        EXPECT_EQ(Differences(out, original), VelChangeAll & ~flags) << "flags " << flags;
    }
}

TEST_F(SquareAndStripEntity, EachFlagChangesOnlyItsParts)
{
    CVelPrimitive other = SquareAndStrip();
    other.groups[0].material = Material(0.3f, 0.5f);
    other.groups[0].RenderKind = VelRenderLit;
    other.groups[0].GroupType = VelGroupTriangleFan;  // not indexed: reads back without triangles
    other.groups[0].triangles.SetSize(0);
    other.groups[0].lineWidth = 5;
    other.groups[0].texture = 9;
    other.groups[0].vertices[1].texcoord = DorVector2(0.75, 0.25);
    other.groups[0].vertices[1].position = DorVector3(-7, -7, -7);
    other.DrawMode = 1;
    ASSERT_EQ(Differences(other, original), VelChangeAll);
    const struct {
        long flags, changed;
    } cases[] = {
        // Same vertex counts: no in-place rewrite, so the geometry flag converts whole groups.
        {VelChangeGeometry, VelChangeAll & ~VelChangeDrawMode},
        {VelChangeMaterial, VelChangeMaterial},
        {VelChangeTopology, VelChangeTopology},
        {VelChangeTexture, VelChangeTexture},
        {VelChangeDrawMode, VelChangeDrawMode},
        {VelChangeAll, VelChangeAll},
    };
    for (const auto& c : cases) {
        _DorPosition* entity = model.AddPrimitive(original, scope);
        model.ChangePrimitive(entity, other, c.flags, scope);
        CVelPrimitive now;
        model.GetPrimitive(entity, now, VelChangeAll, scope);
        EXPECT_EQ(Differences(now, other), VelChangeAll & ~c.changed) << "flags " << c.flags;
        EXPECT_EQ(Differences(now, original), c.changed) << "flags " << c.flags;
        if (c.flags == VelChangeTopology) {
            EXPECT_EQ(CVelGLStructure::EntityAt(entity)->groups[0].elementCount, 2);  // fan of 4
        }
    }

    other.groups[0].RenderKind = 7;
    model.ChangePrimitive(handle, other, VelChangeMaterial, scope);
    EXPECT_EQ(CVelGLStructure::EntityAt(handle)->groups[0].RenderKind, VelRenderLit);  // unknown kinds are stored as lit
}

TEST_F(SquareAndStripEntity, GeometryFlagRewritesInPlaceWhenStoredCountIsThreeTimesTheNew)
{
    CVelPrimitive six;
    six.groups.Add(original.groups[0]);
    CVelTrianglePolys longStrip = Strip(6, 0);
    six.groups.Add(longStrip);
    model.ChangePrimitive(handle, six, VelChangeAll, scope);
    ASSERT_EQ(CVelGLStructure::EntityAt(handle)->groups[1].vertexCount, 6);

    CVelPrimitive two = six;
    two.groups[1] = Strip(2, 50);
    two.groups[1].material = Material(0.05f, 1);
    model.ChangePrimitive(handle, two, VelChangeGeometry, scope);
    const CVelGLTrianglePolygons& stored = CVelGLStructure::EntityAt(handle)->groups[1];
    EXPECT_EQ(stored.vertexCount, 6);
    EXPECT_EQ(stored.positions[0], 50.0f);  // rewritten from the two new vertices
    EXPECT_EQ(stored.positions[3], 51.0f);
    EXPECT_EQ(stored.positions[6], 2.0f);  // the rest kept
    EXPECT_EQ(stored.positions[15], 5.0f);
    EXPECT_EQ(stored.material.diffuse.r, 0.1f);  // in place: the material is not taken
}

TEST_F(SquareAndStripEntity, GeometryFlagWithAnotherGroupCountRebuildsEveryGroup)
{
    CVelPrimitive one;
    CVelTrianglePolys strip = Strip(12, 0);
    one.groups.Add(strip);
    model.ChangePrimitive(handle, one, VelChangeGeometry, scope);
    CVelPrimitive now = ReadBack(VelChangeAll);
    ASSERT_EQ(now.groups.GetSize(), 1);
    EXPECT_EQ(Differences(now, one), VelChangeDrawMode);
}

TEST_F(SquareAndStripEntity, TextureFlagFromAShorterGroupKeepsTheRest)
{
    CVelPrimitive shorter = SquareAndStrip();
    shorter.groups[0].vertices.SetSize(1);
    shorter.groups[0].vertices[0].texcoord = DorVector2(0.5, 0.5);
    model.ChangePrimitive(handle, shorter, VelChangeTexture, scope);
    CVelPrimitive now = ReadBack(VelChangeTexture);
    ASSERT_EQ(now.groups[0].vertices.GetSize(), 4);
    EXPECT_EQ(now.groups[0].vertices[0].texcoord.x, 0.5);
    EXPECT_EQ(now.groups[0].vertices[3].texcoord.y, original.groups[0].vertices[3].texcoord.y);
}

TEST_F(SquareAndStripEntity, NullHandleDoesNothing)
{
    CVelPrimitive untouched = SquareAndStrip();
    model.GetPrimitive(nullptr, untouched, VelChangeAll, scope);
    EXPECT_EQ(untouched.groups.GetSize(), 2);
    model.ChangePrimitive(nullptr, untouched, VelChangeAll, scope);
    _DorPosition* none = nullptr;
    model.RemoveAt(none);
    model.MoveToHead(none);
    EXPECT_EQ(none, nullptr);
    DorMatrix4x4 shift = DorTranslate(1, 2, 3);
    model.MoveEntity(nullptr, shift, scope);
    EXPECT_EQ(model.entities.GetCount(), 1);
}

TEST(EntityStore, HandlesStayValidAcrossRemovalsAndMoves)
{
    CVelGLStructure model;
    CVelGLScope scope;
    std::vector<_DorPosition*> handles;
    for (int i = 0; i < 23; ++i) {  // three node blocks
        CVelPrimitive p;
        CVelTrianglePolys strip = Strip(2, i);
        p.groups.Add(strip);
        handles.push_back(model.AddPrimitive(p, scope));
    }
    for (int i = 0; i < 23; i += 3)
        model.RemoveAt(handles[i]);
    EXPECT_EQ(handles[0], nullptr);
    model.MoveToHead(handles[22]);
    model.MoveToTail(handles[1]);
    for (int i = 1; i < 23; ++i) {
        if (i % 3 == 0)
            continue;
        CVelPrimitive out;
        model.GetPrimitive(handles[i], out, VelChangeGeometry, scope);
        ASSERT_EQ(out.groups.GetSize(), 1);
        EXPECT_EQ(out.groups[0].vertices[0].position.x, i) << "entity " << i;
    }
    std::vector<CVelGLEntity*> order = ListOrder(model);
    ASSERT_EQ(order.size(), 15u);
    EXPECT_EQ(order.front(), CVelGLStructure::EntityAt(handles[22]));
    EXPECT_EQ(order.back(), CVelGLStructure::EntityAt(handles[1]));
}

TEST_F(SquareAndStripEntity, MovingTheOnlyEntityWritesBackAUsableHandle)
{
    CVelGLEntity* entity = CVelGLStructure::EntityAt(handle);
    model.MoveToHead(handle);
    ASSERT_NE(handle, nullptr);
    EXPECT_EQ(CVelGLStructure::EntityAt(handle), entity);
    EXPECT_EQ(model.entities.GetCount(), 1);
    model.RemoveAt(handle);
    EXPECT_EQ(handle, nullptr);
    EXPECT_EQ(model.entities.GetCount(), 0);
}

TEST(EntityStore, EmptyPrimitiveAndUnknownGroupType)
{
    CVelGLStructure model;
    CVelGLScope scope;
    CVelPrimitive empty;
    _DorPosition* handle = model.AddPrimitive(empty, scope);
    ASSERT_NE(handle, nullptr);
    EXPECT_EQ(CVelGLStructure::EntityAt(handle)->groups.GetSize(), 0);

    CVelPrimitive odd;
    CVelTrianglePolys strip = Strip(7, 0);
    strip.GroupType = 9;
    odd.groups.Add(strip);
    const CVelGLTrianglePolygons& stored = CVelGLStructure::EntityAt(model.AddPrimitive(odd, scope))->groups[0];
    EXPECT_EQ(stored.glMode, VelGLModeNone);
    EXPECT_EQ(stored.indexed, 0);

    odd.groups[0].GroupType = VelGroupTriangles;
    CVelPrimitive copy = odd;
    model.ChangePrimitive(model.entities.GetTailPosition(), copy, VelChangeTopology, scope);
    EXPECT_EQ(stored.glMode, VelGLTriangles);
    EXPECT_EQ(stored.elementCount, 2);  // 7 vertices make 2 triangles
}

TEST_F(SquareAndStripEntity, CopiesOwnTheirEntities)
{
    CVelGLStructure copy(model);
    model.Destroy();
    ASSERT_EQ(copy.entities.GetCount(), 1);
    EXPECT_EQ(CVelGLStructure::EntityAt(copy.entities.GetHeadPosition())->groups[0].vertexCount, 4);
    copy = copy;
    EXPECT_EQ(copy.entities.GetCount(), 1);
}

TEST(EntityStore, MoveEntityTurnsNormalsWithoutTranslatingThem)
{
    CVelGLStructure model;
    CVelGLScope scope;
    CVelPrimitive p;
    CVelTrianglePolys g = Square(2, 0);
    g.vertices[1].normal = DorVector3(3, 0, 0);
    p.groups.Add(g);
    _DorPosition* handle = model.AddPrimitive(p, scope);
    const double quarter = 3.14159265358979323846 / 2;
    DorMatrix4x4 m = DorRotateZ(quarter) * DorTranslate(10, 20, 30);
    model.MoveEntity(handle, m, scope);
    const CVelGLTrianglePolygons& moved = CVelGLStructure::EntityAt(handle)->groups[0];
    // Corner (2, 0, 0) turns to (0, 2, 0), then moves.
    EXPECT_FLOAT_EQ(moved.positions[3], 10);
    EXPECT_FLOAT_EQ(moved.positions[4], 22);
    EXPECT_FLOAT_EQ(moved.positions[5], 30);
    // Its normal (3, 0, 0) turns to the unit (0, 1, 0), untranslated.
    EXPECT_NEAR(moved.normals[3], 0, 1e-7);
    EXPECT_FLOAT_EQ(moved.normals[4], 1);
    EXPECT_FLOAT_EQ(moved.normals[5], 0);
}

// Entities along x from 2 to 6, with extra groups that each filter bit removes.
class FilteredCentre : public ::testing::Test {
protected:
    void SetUp() override
    {
        CVelPrimitive p;
        CVelTrianglePolys square = Square(4, 0);  // x and y 0..4
        for (int i = 0; i < 4; ++i)
            square.vertices[i].position.x += 2;   // x 2..6
        p.groups.Add(square);
        model.AddPrimitive(p, scope);
    }

    DorVector3 Centre(int filter, double scale = 1.0) const
    {
        DorVector3 c(-1, -1, -1);
        model.GetCenterPoint(c, filter, scale);
        return c;
    }

    void AddGroup(int type, double x, float alpha, long drawMode = 2)
    {
        CVelPrimitive p;
        CVelTrianglePolys g = Strip(2, x);
        g.GroupType = type;
        g.material.diffuse.a = alpha;
        p.groups.Add(g);
        p.DrawMode = drawMode;
        model.AddPrimitive(p, scope);
    }

    CVelGLStructure model;
    CVelGLScope scope;
};

TEST_F(FilteredCentre, BoxOfTheVisibleGroups)
{
    DorVector3 c = Centre(0);
    EXPECT_EQ(c.x, 4.0);
    EXPECT_EQ(c.y, 2.0);
    EXPECT_EQ(Centre(0, 2.0).x, 2.0);
    EXPECT_EQ(Centre(4).x, 0.0);
    EXPECT_EQ(Centre(4).y, 0.0);
    CVelGLStructure empty;
    DorVector3 none(5, 5, 5);
    empty.GetCenterPoint(none, 0, 1.0);
    EXPECT_EQ(none.x, 0.0);
    EXPECT_EQ(none.z, 0.0);
}

TEST_F(FilteredCentre, EachFilterBitSkipsItsGroups)
{
    AddGroup(VelGroupPoints, -100, 1);      // x -100..-99
    EXPECT_EQ(Centre(1).x, 4.0);
    EXPECT_EQ(Centre(0).x, (-100.0 + 6) / 2);
    AddGroup(VelGroupLines, 100, 1);       // x 100..101
    EXPECT_EQ(Centre(1 | 2).x, 4.0);
    AddGroup(VelGroupLineStrip, 300, 1);   // line strips pass filter 2
    EXPECT_EQ(Centre(1 | 2).x, (2.0 + 301) / 2);
    AddGroup(VelGroupTriangles, 500, 0.5f);
    EXPECT_EQ(Centre(1 | 2 | 8).x, (2.0 + 301) / 2);
    EXPECT_EQ(Centre(1 | 2).x, (2.0 + 501) / 2);
}

TEST(TextureList, AcceptsPowerOfTwoPixelCountsWithinEachLimit)
{
    struct Case {
        int width, height, bits;
        bool add, change;
    } cases[] = {
        {16, 16, 24, true, true},    {3, 5, 24, false, false},  {512, 512, 24, true, false},
        {1024, 512, 24, false, false}, {1, 1, 24, false, false}, {16, 16, 8, false, false},
        {2, 8, 32, true, true},      {1, 64, 1, true, true},    {256, 256, 24, true, true},
        {16, -16, 24, false, false},
    };
    for (const Case& c : cases) {
        _DorBitmap b = Bitmap(c.width, c.height, c.bits);
        EXPECT_EQ(VelTextureAcceptable(b, VelAddTextureLimit), c.add) << c.width << "x" << c.height;
        EXPECT_EQ(VelTextureAcceptable(b, VelChangeTextureLimit), c.change) << c.width << "x" << c.height;
    }
}

TEST(TextureList, ShortPixelArrayIsRefused)
{
    _DorBitmap shortBy1 = Bitmap(4, 4, 24, 1);
    EXPECT_FALSE(VelTexturePixelsPresent(shortBy1));
    CVelGLStructure model;
    EXPECT_EQ(model.AddTexture(shortBy1), 0u);
    _DorBitmap full = Bitmap(4, 4);
    EXPECT_EQ(model.AddTexture(full), 1u);
}

TEST(TextureList, NamesFollowTheListAndChangeReplacesInPlace)
{
    CVelGLStructure model;
    _DorBitmap b = Bitmap(16, 16);
    b.bits[0] = 7;
    EXPECT_EQ(model.AddTexture(b), 1u);
    EXPECT_EQ(model.AddTexture(b), 2u);
    b.bits[0] = 9;
    EXPECT_EQ(model.ChangeTexture(2, b), 1);
    EXPECT_EQ(model.textures[1].bits[0], 9);
    EXPECT_EQ(model.textures[0].bits[0], 7);
    EXPECT_EQ(model.ChangeTexture(0, b), 0);
    EXPECT_EQ(model.ChangeTexture(3, b), 0);
    model.RemoveAllTexture();
    EXPECT_EQ(model.textures.GetSize(), 0);
    EXPECT_EQ(model.AddTexture(b), 1u);
}

TEST(IndexRange, EveryIndexMustNameAVertex)
{
    const unsigned int ok[] = {0, 1, 2, 2, 3, 0};
    EXPECT_TRUE(VelIndicesInRange(ok, 6, 4));
    EXPECT_FALSE(VelIndicesInRange(ok, 6, 3));
    const unsigned int negative[] = {0, 0xFFFFFFFFu, 1};  // -1 as stored
    EXPECT_FALSE(VelIndicesInRange(negative, 3, 4));
    EXPECT_TRUE(VelIndicesInRange(nullptr, 0, 0));
    EXPECT_FALSE(VelIndicesInRange(ok, 3, 0));
}

TEST_F(FilteredCentre, BoundingBoxIsTheBoxBehindTheCentre)
{
    AddGroup(VelGroupPoints, -100, 1);
    AddGroup(VelGroupTriangles, 200, 1, 1 | 2);  // hidden and unpickable entities never count
    AddGroup(VelGroupTriangles, 300, 1, 4);
    DorVector3 low, high;
    ASSERT_TRUE(model.GetBoundingBox(low, high, 0, 1.0));
    DorVector3 centre = Centre(0);
    EXPECT_EQ((low.x + high.x) / 2, centre.x);
    EXPECT_EQ((low.y + high.y) / 2, centre.y);
    EXPECT_EQ(low.x, -100.0);
    EXPECT_EQ(high.x, 6.0);
    ASSERT_TRUE(model.GetBoundingBox(low, high, 1, 2.0));  // the points filtered out, scale 2
    EXPECT_EQ(low.x, 1.0);
    EXPECT_EQ(high.x, 3.0);

    DorVector3 untouched(7, 7, 7);
    EXPECT_FALSE(model.GetBoundingBox(untouched, untouched, 4, 1.0));
    EXPECT_EQ(untouched.x, 7.0);
    CVelGLStructure empty;
    EXPECT_FALSE(empty.GetBoundingBox(untouched, untouched, 0, 1.0));
}
