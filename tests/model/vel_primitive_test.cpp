#include <gtest/gtest.h>

#include "model/vel_primitive.h"

namespace {
bool IsColour(const DorColorValue& c, float r, float g, float b, float a)
{
    return c.r == r && c.g == g && c.b == b && c.a == a;
}
}  // namespace

TEST(RecordDefaults, VectorsVertexRectangleAndGroup)
{
    EXPECT_EQ(DorVector2().dimension, 2);
    CDorArray<_VelVertex, _VelVertex&> vertices;
    vertices.SetSize(2);  // zero-filled, then constructed
    const _VelVertex& v = vertices[1];
    EXPECT_TRUE(v.position.dimension == 3 && v.normal.dimension == 3 && v.texcoord.dimension == 2);
    EXPECT_TRUE(v.position.x == 0.0 && v.position.z == 0.0 && IsColour(v.colour, 1, 1, 1, 1));
    _DORRECT r = {100, 80, 20, 10};  // corner order does not matter
    EXPECT_EQ(r.Width(), 80);
    EXPECT_EQ(r.Height(), 70);

    CVelTrianglePolys g;
    EXPECT_TRUE(g.GroupType == 4 && g.lineWidth == 1.0f && g.RenderKind == 0);
    const CVelTrianglePolys copy(g);
    const _DorMaterial& m = copy.material;
    EXPECT_TRUE(IsColour(m.diffuse, 0.8f, 0.8f, 0.0f, 1.0f) && IsColour(m.ambient, 0.4f, 0.4f, 0.0f, 1.0f));
    EXPECT_TRUE(IsColour(m.specular, 1.0f, 1.0f, 0.0f, 1.0f) && IsColour(m.emission, 0.0f, 0.0f, 0.0f, 0.0f));
    EXPECT_EQ(m.shininess, 80.0f);
}

TEST(TrianglePolys, AssignmentIsDeepAndRemoveAllKeepsMaterialWidthAndOverlay)
{
    CVelTrianglePolys src;
    src.GroupType = VelGroupIndexed;
    src.vertices.SetSize(3);
    src.triangles.SetSize(2);
    src.RenderKind = VelRenderTextured;
    src.texture = 4;
    src.lineWidth = 3.0f;
    src.OverlayFlag = 1;
    src.material.shininess = 5.0f;
    src.vertices[1].position = DorVector3(1, 2, 3);
    src.triangles[1] = _VelTriangleIndex(0, 2, 1);
    CVelTrianglePolys dst;
    dst.vertices.SetSize(40);
    dst = src;
    src.vertices[1].position.y = -1;  // a deep copy does not follow
    EXPECT_TRUE(dst.vertices.GetSize() == 3 && dst.vertices.maxSize == 40 && dst.vertices[1].position.y == 2.0);
    EXPECT_TRUE(dst.triangles[1].b == 2 && dst.texture == 4u && dst.OverlayFlag == 1 && dst.GroupType == 6);

    dst.RemoveAll();
    EXPECT_TRUE(dst.GroupType == 4 && dst.RenderKind == 0 && dst.texture == 0u);
    EXPECT_TRUE(dst.vertices.GetSize() == 0 && dst.triangles.GetSize() == 0 && dst.triangles.maxSize == 0);
    EXPECT_TRUE(dst.material.shininess == 5.0f && dst.lineWidth == 3.0f && dst.OverlayFlag == 1);
}

TEST(Primitive, AssigningFewerGroupsKeepsStorageAndDeleteAllKeepsDrawMode)
{
    CVelPrimitive five;
    EXPECT_EQ(five.DrawMode, 2);  // pickable by default
    five.groups.SetSize(5);
    five.groups[4].vertices.SetSize(9);
    CVelPrimitive two;
    two.groups.SetSize(2);
    two.groups[1].GroupType = VelGroupLines;
    two.DrawMode = 3;
    five = two;
    EXPECT_TRUE(five.groups.GetSize() == 2 && five.groups.maxSize == 5 && five.groups[1].GroupType == 1);
    EXPECT_EQ(five.DrawMode, 3);
    five.DeleteAll();
    EXPECT_TRUE(five.groups.GetSize() == 0 && five.groups.maxSize == 0 && five.DrawMode == 3);
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
