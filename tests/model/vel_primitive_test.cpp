#include <gtest/gtest.h>

#include "model/vel_primitive.h"

namespace {
void ExpectColour(const DorColorValue& c, float r, float g, float b, float a)
{
    EXPECT_EQ(c.r, r);
    EXPECT_EQ(c.g, g);
    EXPECT_EQ(c.b, b);
    EXPECT_EQ(c.a, a);
}

CVelTrianglePolys IndexedGroup(int triangleCount)
{
    CVelTrianglePolys g;
    g.GroupType = VelGroupIndexed;
    g.vertices.SetSize(3);
    g.triangles.SetSize(triangleCount);
    g.RenderKind = VelRenderTextured;
    g.texture = 4;
    g.lineWidth = 3.0f;
    g.OverlayFlag = 1;
    g.material.shininess = 5.0f;
    return g;
}
}  // namespace

TEST(RecordDefaults, VectorsColourAndVertex)
{
    DorVector3 v3;
    EXPECT_EQ(v3.dimension, 3);
    EXPECT_EQ(v3.x, 0.0);
    EXPECT_EQ(v3.z, 0.0);
    DorVector2 v2;
    EXPECT_EQ(v2.dimension, 2);
    ExpectColour(DorColorValue(), 1, 1, 1, 1);

    CDorArray<_VelVertex, _VelVertex&> vertices;
    vertices.SetSize(2);
    EXPECT_EQ(vertices[1].position.dimension, 3);
    EXPECT_EQ(vertices[1].normal.dimension, 3);
    EXPECT_EQ(vertices[1].texcoord.dimension, 2);
    ExpectColour(vertices[1].colour, 1, 1, 1, 1);
}

TEST(RecordDefaults, RectangleSizeIgnoresCornerOrder)
{
    _DORRECT r = {100, 80, 20, 10};
    EXPECT_EQ(r.Width(), 80);
    EXPECT_EQ(r.Height(), 70);
}

TEST(TrianglePolys, DefaultGroupAndItsCopy)
{
    CVelTrianglePolys g;
    EXPECT_EQ(g.GroupType, 4);
    EXPECT_EQ(g.vertices.GetSize(), 0);
    EXPECT_EQ(g.lineWidth, 1.0f);
    EXPECT_EQ(g.RenderKind, 0);
    ExpectColour(g.material.diffuse, 0.8f, 0.8f, 0.0f, 1.0f);
    ExpectColour(g.material.ambient, 0.4f, 0.4f, 0.0f, 1.0f);
    ExpectColour(g.material.specular, 1.0f, 1.0f, 0.0f, 1.0f);
    ExpectColour(g.material.emission, 0.0f, 0.0f, 0.0f, 0.0f);
    EXPECT_EQ(g.material.shininess, 80.0f);

    CVelTrianglePolys copy(g);
    EXPECT_EQ(copy.GroupType, 4);
    EXPECT_EQ(0, std::memcmp(&copy.material, &g.material, sizeof(_DorMaterial)));
}

TEST(TrianglePolys, RemoveAllResetsTypeKindTextureButKeepsMaterialWidthOverlay)
{
    CVelTrianglePolys g = IndexedGroup(10);
    g.RemoveAll();
    EXPECT_EQ(g.GroupType, 4);
    EXPECT_EQ(g.vertices.GetSize(), 0);
    EXPECT_EQ(g.triangles.GetSize(), 0);
    EXPECT_EQ(g.triangles.maxSize, 0);
    EXPECT_EQ(g.vertices.data, nullptr);
    EXPECT_EQ(g.RenderKind, 0);
    EXPECT_EQ(g.texture, 0u);
    EXPECT_EQ(g.material.shininess, 5.0f);
    EXPECT_EQ(g.lineWidth, 3.0f);
    EXPECT_EQ(g.OverlayFlag, 1);
}

TEST(TrianglePolys, AssignmentIsDeepAndKeepsDestinationCapacity)
{
    CVelTrianglePolys src = IndexedGroup(2);
    src.vertices[1].position = DorVector3(1, 2, 3);
    src.triangles[1] = _VelTriangleIndex(0, 2, 1);
    CVelTrianglePolys dst;
    dst.vertices.SetSize(40);
    dst = src;
    EXPECT_EQ(dst.vertices.GetSize(), 3);
    EXPECT_EQ(dst.vertices.maxSize, 40);
    EXPECT_NE(dst.vertices.data, src.vertices.data);
    EXPECT_EQ(dst.vertices[1].position.y, 2.0);
    EXPECT_EQ(dst.triangles[1].b, 2);
    EXPECT_EQ(dst.texture, 4u);
    EXPECT_EQ(dst.OverlayFlag, 1);
    src.vertices[1].position.y = -1;
    EXPECT_EQ(dst.vertices[1].position.y, 2.0);
}

TEST(Primitive, AssigningFewerGroupsDestroysSurplusAndKeepsStorage)
{
    CVelPrimitive five;
    five.groups.SetSize(5);
    five.groups[4].vertices.SetSize(9);
    CVelPrimitive two;
    two.groups.SetSize(2);
    two.groups[1].GroupType = VelGroupLines;
    two.DrawMode = 3;
    five = two;
    EXPECT_EQ(five.groups.GetSize(), 2);
    EXPECT_EQ(five.groups.maxSize, 5);
    EXPECT_EQ(five.groups[1].GroupType, 1);
    EXPECT_EQ(five.DrawMode, 3);
}

TEST(Primitive, DeleteAllKeepsDrawModeAndDefaultIsPickable)
{
    CVelPrimitive p;
    EXPECT_EQ(p.DrawMode, 2);
    p.groups.SetSize(3);
    p.DrawMode = 1;
    p.DeleteAll();
    EXPECT_EQ(p.groups.GetSize(), 0);
    EXPECT_EQ(p.groups.maxSize, 0);
    EXPECT_EQ(p.DrawMode, 1);
}

TEST(DrawnElementCount, FollowsTheGroupType)
{
    struct Case {
        int type, vertices, triangles, expected;
    } cases[] = {
        {0, 5, 0, 5}, {1, 7, 0, 3}, {1, 8, 0, 4}, {2, 1, 0, 0}, {2, 0, 0, -1}, {3, 7, 0, 2},
        {3, 3, 0, 1}, {3, 2, 0, 0}, {4, 1, 0, -1}, {5, 6, 0, 4}, {6, 3, 10, 10},
    };
    for (const Case& c : cases) {
        int count = 12345;
        EXPECT_TRUE(VelDrawnElementCount(c.type, c.vertices, c.triangles, count));
        EXPECT_EQ(count, c.expected) << "type " << c.type << " with " << c.vertices << " vertices";
    }
    int untouched = 12345;
    EXPECT_FALSE(VelDrawnElementCount(7, 9, 0, untouched));
    EXPECT_FALSE(VelDrawnElementCount(-1, 9, 0, untouched));
    EXPECT_EQ(untouched, 12345);
}
