#include <gtest/gtest.h>

#include <climits>

#include "primitives/vel_math_primitive.h"

TEST(MathPrimitive, LinesAndGridsAppendLineGroupsAndBadDivisionsAreRefused)
{
    CVelPrimitive p;
    p.groups.SetSize(1);
    EXPECT_EQ(CVelMathPrimitive::MakeLine(DorVector3(1, 2, 3), DorVector3(1, 2, 3), p), 1);  // equal ends too
    EXPECT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(10, 10), 2, p), 2);
    EXPECT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(4, 4), DorVector2(0, 0), 1, p), 3);  // reversed corners
    EXPECT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(1, 1), -1, p), 4);  // an empty group
    EXPECT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(1, 1), 0, p), -1);
    for (int divisions : {-2, 536870911, INT_MAX})  // 4 (divisions + 1) vertices past an int
        EXPECT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(1, 1), divisions, p), -1) << divisions;
    ASSERT_EQ(p.groups.GetSize(), 5);
    const int sizes[] = {0, 2, 12, 8, 0};
    const double xy[][3] = {{1, 2, 3}, {1, 2, 3}, {0, 0}, {10, 0}, {0, 0}, {0, 10}, {0, 5}, {10, 5}, {5, 0}, {5, 10},
                            {0, 10}, {10, 10}, {10, 0}, {10, 10}, {4, 4}, {0, 4}, {4, 4}, {4, 0}, {4, 0}, {0, 0},
                            {0, 4}, {0, 0}};
    for (int g = 0, k = 0; g < 5; ++g) {
        ASSERT_EQ(p.groups[g].vertices.GetSize(), sizes[g]);
        EXPECT_EQ(p.groups[g].GroupType, g ? 1 : 4);
        for (int i = 0; i < sizes[g]; ++i, ++k) {
            const DorVector3& v = p.groups[g].vertices[i].position;
            EXPECT_TRUE(v.x == xy[k][0] && v.y == xy[k][1] && v.z == xy[k][2]) << g << " " << i;
        }
    }
    // A line is white, a grid grey, each as 0.8 of its colour in diffuse, all of it in ambient.
    const _DorMaterial &line = p.groups[1].material, &grid = p.groups[2].material;
    EXPECT_TRUE(line.diffuse.r == 0.8f && line.diffuse.a == 1.0f && line.ambient.r == 1.0f && grid.ambient.g == 0.8f);
    EXPECT_EQ(grid.diffuse.r, static_cast<float>(0.8 * static_cast<double>(0.8f)));
    EXPECT_TRUE(grid.specular.b == 0.2f && grid.emission.r == 1.0f && grid.shininess == 70.0f);
}
