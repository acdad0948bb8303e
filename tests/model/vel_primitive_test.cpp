#include <gtest/gtest.h>

#include "model/vel_primitive.h"

// Assignment takes every field (the arrays' copies are the array's own tests); RemoveAll resets the
// kind of group but keeps its look.
TEST(TrianglePolys, AssignmentIsDeepAndClearingKeepsTheLook)
{
    CVelTrianglePolys src, dst;
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
    dst = src;
    EXPECT_TRUE(dst.vertices.GetSize() == 3 && dst.vertices[1].position.y == 2.0);
    EXPECT_TRUE(dst.triangles[1].b == 2 && dst.texture == 4u && dst.OverlayFlag == 1 && dst.GroupType == 6);
    dst.RemoveAll();
    EXPECT_TRUE(dst.GroupType == 4 && dst.RenderKind == 0 && dst.texture == 0u);
    EXPECT_TRUE(dst.vertices.GetSize() == 0 && dst.triangles.GetSize() == 0 && dst.triangles.maxSize == 0);
    EXPECT_TRUE(dst.material.shininess == 5.0f && dst.lineWidth == 3.0f && dst.OverlayFlag == 1);
}

TEST(DrawnElementCount, FollowsTheGroupType)
{
    const struct {
        int type, vertices, triangles, expected;  // expected 12345: refused, count untouched
    } cases[] = {{0, 5, 0, 5}, {1, 7, 0, 3}, {1, 8, 0, 4}, {2, 1, 0, 0}, {2, 0, 0, -1}, {3, 7, 0, 2}, {3, 3, 0, 1},
                 {3, 2, 0, 0}, {4, 1, 0, -1}, {5, 6, 0, 4}, {6, 3, 10, 10}, {7, 9, 0, 12345}, {-1, 9, 0, 12345}};
    for (const auto& c : cases) {
        int count = 12345;
        EXPECT_EQ(VelDrawnElementCount(c.type, c.vertices, c.triangles, count), c.expected != 12345) << c.type;
        EXPECT_EQ(count, c.expected) << "type " << c.type << " with " << c.vertices << " vertices";
    }
}
