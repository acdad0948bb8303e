#include <gtest/gtest.h>

#include "model/vel_primitive.h"

// RemoveAll resets the kind of group and empties it, but keeps its look.
TEST(TrianglePolys, ClearingKeepsTheLook)
{
    CVelTrianglePolys g;
    g.GroupType = VelGroupIndexed;
    g.vertices.SetSize(3);
    g.triangles.SetSize(2);
    g.RenderKind = VelRenderTextured;
    g.texture = 4;
    g.lineWidth = 3.0f;
    g.OverlayFlag = 1;
    g.material.shininess = 5.0f;
    g.RemoveAll();
    EXPECT_TRUE(g.GroupType == 4 && g.RenderKind == 0 && g.texture == 0u && g.vertices.GetSize() == 0 && g.triangles.maxSize == 0);
    EXPECT_TRUE(g.material.shininess == 5.0f && g.lineWidth == 3.0f && g.OverlayFlag == 1);
}

TEST(DrawnElementCount, FollowsTheGroupType)
{
    // expected 12345: refused, count untouched
    const struct { int type, vertices, triangles, expected; } cases[] = {
        {0, 5, 0, 5}, {1, 7, 0, 3}, {1, 8, 0, 4}, {2, 1, 0, 0}, {2, 0, 0, -1}, {3, 7, 0, 2}, {3, 3, 0, 1},
        {3, 2, 0, 0}, {4, 1, 0, -1}, {5, 6, 0, 4}, {6, 3, 10, 10}, {7, 9, 0, 12345}, {-1, 9, 0, 12345}};
    for (const auto& c : cases) {
        int count = 12345;
        EXPECT_EQ(VelDrawnElementCount(c.type, c.vertices, c.triangles, count), c.expected != 12345) << c.type;
        EXPECT_EQ(count, c.expected) << "type " << c.type << " with " << c.vertices << " vertices";
    }
}
